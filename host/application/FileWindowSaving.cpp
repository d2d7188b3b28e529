// FileWindow: saving, going back to what was saved, and closing.
#include "host/application/FileWindow.h"

#include <utility>

#include <Alert.h>
#include <AppDefs.h>
#include <Message.h>
#include <Path.h>

#include "host/application/Codes.h"
#include "host/application/RecentFiles.h"
#include "host/application/ResourceDocument.h"
#include "host/application/StatusText.h"

using namespace BResEditor;


// Has every item window take over what is being typed and write it into its item; then goes on.
void
FileWindow::_ApplyItemsThen(std::function<void()> next)
{
	if (fAnswersMissing > 0)
		return;

	fAfterApply = std::move(next);
	fAnswersMissing = fItemWindows.size() + 1;
	for (const OpenWindow& open : fItemWindows) {
		BMessage apply(kApplyItem);
		open.messenger.SendMessage(&apply, BMessenger(this));
	}
	_ItemAnswered(); // our own one, for the case that no window is open
}


void
FileWindow::_ItemAnswered()
{
	if (fAnswersMissing == 0 || --fAnswersMissing > 0)
		return;
	const std::function<void()> next = std::move(fAfterApply);
	next();
}


void
FileWindow::_ItemClosed(const BMessage* message)
{
	void* window;
	if (message->FindPointer("window", &window) != B_OK)
		return;
	std::erase_if(fItemWindows, [window](const OpenWindow& open) { return open.window == window; });
	_ItemAnswered(); // it will not answer any more
	_UpdateTitle();
	if (fItemWindows.empty() && fAfterClosing)
		std::exchange(fAfterClosing, nullptr)();
}


void
FileWindow::_Save()
{
	if (!_MayReplaceFile()) {
		fSaveBeforeClosing = false;
		return;
	}
	const status_t status = fDocument->Save();
	if (status == B_OK) {
		_Saved();
		return;
	}
	fSaveBeforeClosing = false;
	_Tell(std::string("\"") + fDocument->Path() + "\" could not be saved: " + StatusText(status)
		+ ". The file is as it was.");
}


void
FileWindow::_SaveAs(const std::string& path)
{
	const status_t status = fDocument->SaveAs(path.c_str());
	if (status == B_OK) {
		_Saved();
		return;
	}
	fSaveBeforeClosing = false;
	_Tell("\"" + path + "\" could not be written: " + StatusText(status) + ".");
}


void
FileWindow::_Saved()
{
	fAskedAboutDisk = false;
	RecentFiles::Add(fDocument->Path());
	_UpdateTitle();
	if (fSaveBeforeClosing)
		_CloseItemsThen([this] { Quit(); });
}


void
FileWindow::_AskForPath()
{
	const BPath path(fDocument->Path());
	if (fSavePanel == nullptr)
		fSavePanel = _MakePanel(B_SAVE_PANEL, B_SAVE_REQUESTED, "Save");
	fSavePanel->SetSaveText(path.InitCheck() == B_OK ? path.Leaf() : "Untitled.rsrc");
	fSavePanel->Show();
}


void
FileWindow::_PlaceChosen(const BMessage* message)
{
	const std::string chosen = _ChosenPath(message);
	if (!chosen.empty())
		_ApplyItemsThen([this, chosen] { _SaveAs(chosen); });
}


bool
FileWindow::_MayReplaceFile()
{
	if (!fDocument->IsChangedOnDisk())
		return true;

	const std::string text = std::string("\"") + fDocument->Name()
		+ "\" has been changed by another program since it was opened. Saving writes this window's "
		  "changes into the new file.";
	return _Ask("Changed on disk", text, "Save");
}


void
FileWindow::_AskAndRevert()
{
	if (fDocument->Path()[0] == '\0' || fAfterClosing)
		return;
	const std::string text = std::string("Go back to \"") + fDocument->Name()
		+ "\" as it was last saved? All changes since then are lost.";
	if (_Ask("Revert", text, "Revert"))
		_CloseItemsThen([this] { _ReadFile(); });
}


// Once only, until the file is read or saved again; saving asks in any case.
void
FileWindow::_AskAboutChangeOnDisk()
{
	if (fAskedAboutDisk || fAfterClosing || !fDocument->IsChangedOnDisk())
		return;

	fAskedAboutDisk = true;
	std::string text =
		std::string("\"") + fDocument->Name() + "\" has been changed by another program.";
	if (fDocument->IsModified() || !fItemWindows.empty())
		text += " Reading it again loses what was changed here.";
	if (_Ask("Changed on disk", text, "Read Again"))
		_CloseItemsThen([this] { _ReadFile(); });
}


void
FileWindow::_ReadFile()
{
	const status_t status = fDocument->Load(std::string(fDocument->Path()).c_str());
	if (status == B_OK)
		fAskedAboutDisk = false;
	else
		_Tell(std::string("\"") + fDocument->Path() + "\" could not be read: " + StatusText(status)
			+ ". This window keeps what it has.");
	_UpdateTitle();
}


void
FileWindow::_AskAndClose()
{
	if (!fDocument->IsModified()) {
		_CloseItemsThen([this] { Quit(); });
		return;
	}

	const std::string text =
		std::string("Save the changes to \"") + fDocument->Name() + "\" before closing?";
	BAlert* alert = new BAlert("Unsaved changes", text.c_str(), "Cancel", "Don't Save", "Save",
		B_WIDTH_AS_USUAL, B_WARNING_ALERT);
	alert->SetShortcut(0, B_ESCAPE);
	switch (alert->Go()) {
		case 1:
			_CloseItemsThen([this] { Quit(); });
			break;
		case 2:
			fSaveBeforeClosing = true;
			if (fDocument->Path()[0] == '\0')
				_AskForPath();
			else
				_Save();
			break;
	}
}


// The last item window that goes calls the function, or we do when none is open.
void
FileWindow::_CloseItemsThen(std::function<void()> next)
{
	if (fItemWindows.empty()) {
		next();
		return;
	}
	fAfterClosing = std::move(next);
	for (const OpenWindow& open : fItemWindows)
		open.messenger.SendMessage(B_QUIT_REQUESTED);
}


// In the folder of the document's file, if there is one.
std::unique_ptr<BFilePanel>
FileWindow::_MakePanel(file_panel_mode mode, uint32 what, const char* verb)
{
	BMessenger target(this);
	BMessage message(what);
	auto panel = std::make_unique<BFilePanel>(mode, &target, nullptr, 0, true, &message);
	const BPath path(fDocument->Path());
	BPath folder;
	if (path.InitCheck() == B_OK && path.GetParent(&folder) == B_OK)
		panel->SetPanelDirectory(folder.Path());
	panel->SetButtonLabel(B_DEFAULT_BUTTON, verb);
	BWindow* window = panel->Window();
	window->Lock();
	window->SetTitle(verb);
	window->Unlock();
	return panel;
}


// What the user chose in a panel for saving; "" when it is gone.
std::string
FileWindow::_ChosenPath(const BMessage* message)
{
	entry_ref folder;
	if (message->FindRef("directory", &folder) != B_OK)
		return "";
	BPath path(&folder);
	return path.Append(message->GetString("name", "")) == B_OK ? path.Path() : "";
}


void
FileWindow::_Tell(const std::string& text)
{
	(new BAlert("Archway", text.c_str(), "OK", NULL, NULL, B_WIDTH_AS_USUAL, B_WARNING_ALERT))
		->Go(NULL);
}


// Whether the user wants that; a question that is closed or cancelled says no.
bool
FileWindow::_Ask(const char* title, const std::string& text, const char* verb)
{
	BAlert* alert =
		new BAlert(title, text.c_str(), "Cancel", verb, NULL, B_WIDTH_AS_USUAL, B_WARNING_ALERT);
	alert->SetShortcut(0, B_ESCAPE);
	return alert->Go() == 1;
}
