// FilePanelWindow: what the user chooses, and what is sent for it.
#include "storage/private/FilePanelWindow.h"

#include <cstring>

#include <Alert.h>
#include <Beep.h>
#include <Directory.h>
#include <Entry.h>
#include <Invoker.h>
#include <Path.h>
#include <TextControl.h>
#include <TextView.h>

#include "storage/private/FileList.h"
#include "storage/private/FilePanelCodes.h"
#include "storage/private/NewFolderWindow.h"

namespace BPrivate {

namespace {


std::string
ParentOf(const std::string& path)
{
	const size_t slash = path.rfind('/');
	return slash == 0 || slash == std::string::npos ? "/" : path.substr(0, slash);
}


std::string
LeafOf(const std::string& path)
{
	return path.substr(path.rfind('/') + 1);
}


bool
Exists(const std::string& path)
{
	return BEntry(path.c_str()).Exists();
}


} // namespace


// A single file's name goes into the field, where it can be read whole and be changed.
void
FilePanelWindow::_RowsSelected()
{
	const int32 first = fList->CurrentSelection(0);
	const bool single = first >= 0 && fList->CurrentSelection(1) < 0;
	if (single && !fList->RowAt(first)->Item().isFolder)
		SetName(fList->RowAt(first)->Item().name);
	else if (fMode == B_OPEN_PANEL)
		SetName("");
	fNextSelected = 0;
	fPanel->SelectionChanged();
}


// Adds the rest of the name that the typed text begins, selected, so that typing goes on over it.
// A name to save is new as a rule, so only the folders of a path are completed there.
void
FilePanelWindow::_NameChanged()
{
	const std::string text = fNameField->Text();
	if (text == fShownName)
		return;

	const bool longer =
		text.size() > fTypedName.size() && text.compare(0, fTypedName.size(), fTypedName) == 0;
	fTypedName = fShownName = text;
	fNameTyped = true;
	fList->SelectName(text);

	BTextView* view = fNameField->TextView();
	int32 start, end;
	view->GetSelection(&start, &end);
	const int32 length = view->TextLength();
	if (!longer || start != length)
		return;
	std::string rest = CompletionOf(text, fFolder, fItems, fRules);
	if (fMode == B_SAVE_PANEL
		&& (rest.empty() || rest.back() != '/' || text.find('/') == text.npos))
		return;
	if (rest.empty())
		return;
	fShownName = text + rest;
	view->Insert(length, rest.data(), static_cast<int32>(rest.size()));
	view->Select(length, length + static_cast<int32>(rest.size()));
}


// A folder is gone to; with a file, its folder is, and the file is selected.
void
FilePanelWindow::_TakeDrop(const BMessage* message)
{
	entry_ref ref;
	if (message->FindRef("refs", &ref) != B_OK)
		return;
	const BPath path(&ref);
	if (path.InitCheck() != B_OK)
		return;
	if (IsFolder(path.Path())) {
		GoTo(path.Path());
		return;
	}
	GoTo(ParentOf(path.Path()));
	if (fList->SelectName(LeafOf(path.Path())))
		_RowsSelected();
}


// Double-click or key in the list: a single folder is entered even where folders can be chosen.
void
FilePanelWindow::_Invoked()
{
	const int32 index = fList->CurrentSelection();
	if (index < 0)
		return;
	const FolderItem item = fList->RowAt(index)->Item();
	if (item.isFolder && fList->CurrentSelection(1) < 0)
		GoTo(ResolveTypedPath(item.name, fFolder));
	else
		_Choose();
}


void
FilePanelWindow::_Choose()
{
	const std::string text = fNameField->Text();
	if (fMode == B_SAVE_PANEL) {
		const int32 index = fList->CurrentSelection();
		const bool inFolder =
			fList->IsFocus() && index >= 0 && fList->RowAt(index)->Item().isFolder;
		if (inFolder)
			_Invoked();
		else if (text.empty())
			beep();
		else
			_SaveTyped(text);
	} else if (fNameTyped && !text.empty()) {
		_OpenTyped(text);
	} else {
		_OpenSelection();
	}
}


void
FilePanelWindow::_OpenTyped(const std::string& text)
{
	const std::string path = ResolveTypedPath(text, fFolder);
	if (IsFolder(path))
		GoTo(path);
	else if (Exists(path))
		_OpenPaths({ path });
	else
		_Tell("There is no file \"" + path + "\".");
}


// Where folders can be chosen, nothing selected means the folder that is shown.
void
FilePanelWindow::_OpenSelection()
{
	const bool takesFolders = (fRules.flavors & B_DIRECTORY_NODE) != 0;
	if (fList->CurrentSelection() < 0) {
		if (takesFolders)
			_OpenPaths({ fFolder });
		else
			beep();
		return;
	}

	std::vector<std::string> paths;
	for (int32 i = 0, index; (index = fList->CurrentSelection(i)) >= 0; i++) {
		const FolderItem& item = fList->RowAt(index)->Item();
		if (!item.isFolder || takesFolders)
			paths.push_back(ResolveTypedPath(item.name, fFolder));
	}
	if (paths.empty())
		_Invoked();
	else
		_OpenPaths(paths);
}


void
FilePanelWindow::_OpenPaths(const std::vector<std::string>& paths)
{
	BMessage message(fMessage);
	const bool followLinks = (fRules.flavors & B_SYMLINK_NODE) == 0;
	for (const std::string& path : paths) {
		entry_ref ref;
		BEntry entry(path.c_str(), followLinks);
		if (entry.GetRef(&ref) == B_OK)
			message.AddRef("refs", &ref);
	}
	_Send(&message);
	_Done();
}


void
FilePanelWindow::_SaveTyped(const std::string& text)
{
	const std::string path = ResolveTypedPath(text, fFolder);
	if (IsFolder(path))
		GoTo(path);
	else if (!IsFolder(ParentOf(path)))
		_Tell("There is no folder \"" + ParentOf(path) + "\".");
	else if (text.back() == '/')
		_Tell("There is no folder \"" + path + "\".");
	else if (Exists(path))
		_AskToReplace(path);
	else
		_Save(path);
}


// Without waiting, so that whoever holds on to the panel is not held up by the user.
void
FilePanelWindow::_AskToReplace(const std::string& path)
{
	const std::string text =
		"The file \"" + LeafOf(path) + "\" exists already. Do you want to replace it?";
	BMessage* answer = new BMessage(kPanelReplace);
	answer->AddString("path", path.c_str());
	BAlert* alert = new BAlert(
		"Replace", text.c_str(), "Cancel", "Replace", NULL, B_WIDTH_AS_USUAL, B_WARNING_ALERT);
	alert->SetShortcut(0, B_ESCAPE);
	alert->Go(new BInvoker(answer, this));
}


void
FilePanelWindow::_Save(const std::string& path)
{
	entry_ref folder;
	BMessage message(fMessage);
	if (BEntry(ParentOf(path).c_str(), true).GetRef(&folder) != B_OK) {
		_Tell("There is no folder \"" + ParentOf(path) + "\" any more.");
		return;
	}
	message.AddRef("directory", &folder);
	message.AddString("name", LeafOf(path).c_str());
	_Send(&message);
	_Done();
}


void
FilePanelWindow::_Cancel()
{
	BMessage message(B_CANCEL);
	message.AddInt32("old_what", static_cast<int32>(fMessage.what));
	message.AddPointer("source", fPanel);
	_Send(&message);
	HidePanel();
	fPanel->WasHidden();
}


void
FilePanelWindow::_Send(BMessage* message)
{
	const BMessenger target = Target();
	fPanel->SendMessage(&target, message);
}


void
FilePanelWindow::_Done()
{
	if (fMode == B_OPEN_PANEL)
		SetName("");
	if (!fHideWhenDone)
		return;
	HidePanel();
	fPanel->WasHidden();
}


void
FilePanelWindow::_AskForFolder()
{
	(new NewFolderWindow(this))->Show();
}


void
FilePanelWindow::_MakeFolder(const std::string& name)
{
	const std::string path = ResolveTypedPath(name, fFolder);
	BDirectory folder(fFolder.c_str());
	status_t status = name.empty() ? B_BAD_VALUE : folder.CreateDirectory(path.c_str(), NULL);
	if (status == B_OK)
		GoTo(path);
	else if (status == B_FILE_EXISTS)
		_Tell("There is a \"" + name + "\" in this folder already.");
	else
		_Tell("The folder \"" + name + "\" could not be made: " + strerror(status) + ".");
}


void
FilePanelWindow::_ChangeFavorites(status_t status)
{
	if (status != B_OK)
		_Tell(std::string("The favorites could not be written: ") + strerror(status) + ".");
	_FillFavorites();
}


void
FilePanelWindow::_Tell(const std::string& text)
{
	(new BAlert(Title(), text.c_str(), "OK", NULL, NULL, B_WIDTH_AS_USUAL, B_WARNING_ALERT))
		->Go(NULL);
}

} // namespace BPrivate
