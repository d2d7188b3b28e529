// FileWindow: lists the items of one resource file and opens them.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <FilePanel.h>
#include <Messenger.h>
#include <Window.h>

#include "host/library/ResourceAddonBase.h"

class BMenu;
class BMenuBar;
class BMenuItem;
class HandlerSet;
class ItemList;
class ItemWindow;
class ResourceDocument;


// Owns the document and the windows of its items. Tells the application when it goes.
class FileWindow : public BWindow {
public:
	FileWindow(BRect frame, std::unique_ptr<ResourceDocument> document);
	~FileWindow() override;

	void MessageReceived(BMessage* message) override;
	void MenusBeginning() override;
	void WindowActivated(bool active) override;
	bool QuitRequested() override;
	void Quit() override;

	// The path of the document's file, or "". Any thread, under this window's lock.
	const char* Path() const;

	// Opens the item in a window of its own, or brings that forward. False when there is none.
	bool OpenItem(type_code type, int32 id);
	bool OpenFirstArchive();

private:
	struct OpenWindow {
		ItemWindow* window; // ours until it sends kItemClosed
		BMessenger messenger;
		BResEditor::BResourceHandle handle;
	};

	void _AddMenuBar();
	BMenu* _FileMenu();
	BMenu* _EditMenu();
	BMenu* _ResourceMenu();
	void _AddList(float top);
	void _AddNewMenu(BMenu* menu);
	void _ShowRecentFiles();
	bool _TakeItemCommand(uint32 what);
	void _ReadChanges();
	void _UpdateTitle();

	void _OpenHandle(const BResEditor::BResourceHandle& handle);
	void _OpenSelection();
	void _DeleteSelection(const char* operation);
	void _DuplicateSelection();
	bool _CopySelection();
	void _Paste();
	void _AskForAttributes();
	void _SetAttributes(const BMessage* message);
	void _CloseAttributes();
	void _Generate(BMessage* request);

	void _ApplyItemsThen(std::function<void()> next);
	void _ItemAnswered();
	void _ItemClosed(const BMessage* message);
	void _Save();
	void _SaveAs(const std::string& path);
	void _Saved();
	void _AskForPath();
	void _PlaceChosen(const BMessage* message);
	bool _MayReplaceFile();
	void _AskAndRevert();
	void _AskAboutChangeOnDisk();
	void _ReadFile();
	void _AskAndClose();
	void _CloseItemsThen(std::function<void()> next);
	std::unique_ptr<BFilePanel> _MakePanel(file_panel_mode mode, uint32 what, const char* verb);
	static std::string _ChosenPath(const BMessage* message);
	void _Tell(const std::string& text);
	bool _Ask(const char* title, const std::string& text, const char* verb);

	void _AskForImport();
	void _Import(const BMessage* message);
	status_t _ImportFile(const entry_ref& ref);
	void _AskForExport();
	void _Export(const BMessage* message);

	std::unique_ptr<ResourceDocument> fDocument;
	BResEditor::BResourceAddonArgs fArgs;
	BResEditor::BResourceAddonBase fAccess; // our use of the document
	std::unique_ptr<HandlerSet> fHandlers;
	BMenuBar* fMenuBar; // child
	ItemList* fList; // child of a scroll view
	BMenu* fRecentMenu; // in the menu bar
	std::vector<OpenWindow> fItemWindows;
	std::unique_ptr<BFilePanel> fSavePanel; // each NULL until it is needed
	std::unique_ptr<BFilePanel> fImportPanel;
	std::unique_ptr<BFilePanel> fExportPanel;
	BResEditor::BResourceHandle fExported; // what the export panel was opened for
	BResEditor::BResourceHandle fDescribed; // what the attributes window was opened for
	BMessenger fAttributesWindow; // valid while it is open
	std::function<void()> fAfterApply; // what waits for the item windows' answers
	size_t fAnswersMissing;
	std::function<void()> fAfterClosing; // what waits for the item windows to close
	bool fSaveBeforeClosing;
	bool fAskedAboutDisk; // since the file was last read or saved
};
