#include "host/application/EditorApplication.h"

#include <cstdio>
#include <cstring>

#include <Alert.h>
#include <AppDefs.h>
#include <Entry.h>
#include <FilePanel.h>
#include <Message.h>
#include <Path.h>

#include "host/application/Codes.h"
#include "host/application/FileWindow.h"
#include "host/application/RecentFiles.h"
#include "host/application/ResourceDocument.h"
#include "host/application/StatusText.h"

namespace {


constexpr const char* kSignature = "application/x-vnd.Archway";
constexpr float kWindowWidth = 520;
constexpr float kWindowHeight = 300;
const BPoint kFirstWindow(60, 60);
constexpr float kCascade = 24;


} // namespace


EditorApplication::EditorApplication(const Options& options) :
	BApplication(kSignature), fOptions(options)
{
}


EditorApplication::~EditorApplication()
{
}


void
EditorApplication::ReadyToRun()
{
	_OpenOptions();
	if (fWindows.empty())
		_ShowWindow(std::make_unique<ResourceDocument>());
}


void
EditorApplication::RefsReceived(BMessage* message)
{
	entry_ref ref;
	for (int32 i = 0; message->FindRef("refs", i, &ref) == B_OK; i++) {
		BPath path(&ref);
		if (path.InitCheck() == B_OK)
			_OpenFile(path.Path());
	}
}


void
EditorApplication::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kNewFile:
			_ShowWindow(std::make_unique<ResourceDocument>());
			break;
		case kOpenFile:
			_ShowOpenPanel(message);
			break;
		case kFileWindowClosed:
			_WindowClosed(message);
			break;
		default:
			BApplication::MessageReceived(message);
	}
}


// The file windows ask their questions in threads of their own; the program goes with the last.
bool
EditorApplication::QuitRequested()
{
	if (fWindows.empty())
		return true;

	for (FileWindow* window : fWindows)
		window->PostMessage(B_QUIT_REQUESTED);
	return false;
}


// Begins in the folder of the file whose window asks, later on where the user was last.
void
EditorApplication::_ShowOpenPanel(const BMessage* message)
{
	const bool isFirst = fOpenPanel == nullptr;
	if (isFirst)
		fOpenPanel = std::make_unique<BFilePanel>();
	BPath folder;
	const char* path = message->GetString("path", "");
	if (isFirst && path[0] != '\0' && BPath(path).GetParent(&folder) == B_OK)
		fOpenPanel->SetPanelDirectory(folder.Path());
	fOpenPanel->Show();
}


FileWindow*
EditorApplication::_OpenFile(const std::string& path)
{
	const BPath absolute(path.c_str(), NULL, true);
	for (FileWindow* window : fWindows) {
		if (!window->Lock())
			continue;
		const bool isOpen = strcmp(window->Path(), absolute.Path()) == 0;
		if (isOpen)
			window->Activate(true);
		window->Unlock();
		if (isOpen)
			return window;
	}

	auto document = std::make_unique<ResourceDocument>();
	const status_t status = document->Load(absolute.Path());
	if (status == B_OK) {
		RecentFiles::Add(absolute.Path());
		return _ShowWindow(std::move(document));
	}

	const std::string text = "\"" + path + "\" could not be opened: " + StatusText(status) + ".";
	fprintf(stderr, "archway: %s\n", text.c_str());
	(new BAlert("Archway", text.c_str(), "OK", NULL, NULL, B_WIDTH_AS_USUAL, B_STOP_ALERT))
		->Go(NULL);
	return nullptr;
}


FileWindow*
EditorApplication::_ShowWindow(std::unique_ptr<ResourceDocument> document)
{
	const float offset = kCascade * static_cast<float>(fWindows.size() % 8);
	const BRect frame = BRect(0, 0, kWindowWidth, kWindowHeight)
							.OffsetToCopy(kFirstWindow + BPoint(offset, offset));
	FileWindow* window = new FileWindow(frame, std::move(document));
	fWindows.push_back(window);
	window->Show();
	return window;
}


void
EditorApplication::_OpenOptions()
{
	for (size_t i = 0; i < fOptions.files.size(); i++) {
		FileWindow* window = _OpenFile(fOptions.files[i]);
		if (i > 0 || window == nullptr || !window->Lock())
			continue;
		if (fOptions.openItem)
			window->OpenItem(fOptions.itemType, fOptions.itemID);
		else if (fOptions.openFirstArchive)
			window->OpenFirstArchive();
		window->Unlock();
	}
}


void
EditorApplication::_WindowClosed(const BMessage* message)
{
	void* window;
	if (message->FindPointer("window", &window) != B_OK)
		return;
	std::erase(fWindows, static_cast<FileWindow*>(window));
	if (fWindows.empty())
		PostMessage(B_QUIT_REQUESTED);
}
