// EditorApplication: the resource editor: its files and their windows.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <Application.h>
#include <Messenger.h>

class BFilePanel;
class FileWindow;


class EditorApplication : public BApplication {
public:
	// What the command line asks for.
	struct Options {
		std::vector<std::string> files;
		bool openItem = false; // of the first file
		type_code itemType = 0;
		int32 itemID = 0;
		bool openFirstArchive = false; // of the first file
	};

	explicit EditorApplication(const Options& options);
	~EditorApplication() override;

	void ReadyToRun() override;
	void RefsReceived(BMessage* message) override;
	void MessageReceived(BMessage* message) override;
	bool QuitRequested() override;

private:
	// NULL when the file cannot be read, of which the user is told.
	FileWindow* _OpenFile(const std::string& path);
	FileWindow* _ShowWindow(std::unique_ptr<class ResourceDocument> document);
	void _ShowOpenPanel(const BMessage* message);
	void _OpenOptions();
	void _WindowClosed(const BMessage* message);

	Options fOptions;
	std::unique_ptr<BFilePanel> fOpenPanel; // NULL until it is needed
	std::vector<FileWindow*> fWindows; // each until it tells that it goes
};
