#include "host/application/FileWindow.h"

#include <cstring>

#include <Alert.h>
#include <AppDefs.h>
#include <Application.h>
#include <FilePanel.h>
#include <ListView.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Path.h>
#include <ScrollView.h>
#include <String.h>

#include "host/application/AddonRoster.h"
#include "host/application/Codes.h"
#include "host/application/ItemRow.h"
#include "host/application/ItemWindow.h"
#include "host/application/ListHeader.h"
#include "host/application/ResourceDocument.h"
#include "host/application/StatusText.h"

using namespace BResEditor;

namespace {


constexpr type_code kArchiveType = 'ARCV';
constexpr float kScrollBarSize = 14;
constexpr float kHeaderHeight = 18;
constexpr float kItemWindowOffset = 24;


} // namespace


FileWindow::FileWindow(BRect frame, std::unique_ptr<ResourceDocument> document) :
	BWindow(frame, document->Name(), B_DOCUMENT_WINDOW, B_ASYNCHRONOUS_CONTROLS),
	fDocument(std::move(document)), fArgs { fDocument.get() }, fAccess(fArgs, this),
	fHandlers(std::make_unique<HandlerSet>(fArgs)), fAnswersMissing(0), fClosing(false),
	fSaveBeforeClosing(false)
{
	_AddMenuBar();
	_AddList(fMenuBar->Frame().bottom + 1);
	_UpdateTitle();
}


FileWindow::~FileWindow()
{
}


void
FileWindow::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kSave:
			if (fDocument->Path()[0] == '\0')
				_AskForPath();
			else
				_ApplyItemsThen([this] { _Save(); });
			break;
		case kSaveAs:
			_AskForPath();
			break;
		case B_SAVE_REQUESTED:
			_PlaceChosen(message);
			break;
		case B_CANCEL:
			if (message->GetInt32("old_what", 0) == B_SAVE_REQUESTED)
				fSaveBeforeClosing = false;
			break;
		case kImportItem:
			_AskForImport();
			break;
		case kImportChosen:
			_Import(message);
			break;
		case kExportItem:
			_AskForExport();
			break;
		case kExportChosen:
			_Export(message);
			break;
		case kNewFile:
			be_app->PostMessage(message);
			break;
		case kOpenFile: {
			BMessage open(kOpenFile);
			open.AddString("path", fDocument->Path());
			be_app->PostMessage(&open);
			break;
		}
		case kOpenItem:
			_OpenSelection();
			break;
		case kDeleteItem:
			_DeleteSelection();
			break;
		case kGenerateItem:
			_Generate(message);
			break;
		case kUndoStep:
			fDocument->Undo();
			break;
		case kRedoStep:
			fDocument->Redo();
			break;
		case kItemApplied:
			_ItemAnswered();
			break;
		case kItemClosed:
			_ItemClosed(message);
			break;
		case B_RESOURCE_DATA_CHANGED:
			_ReadChanges();
			break;
		default:
			BWindow::MessageReceived(message);
	}
}


void
FileWindow::MenusBeginning()
{
	auto show = [](BMenuItem* item, const char* verb, const char* step) {
		BString label(verb);
		if (step != nullptr)
			label << " " << step;
		item->SetLabel(label.String());
		item->SetEnabled(step != nullptr);
	};
	show(fUndoItem, "Undo", fDocument->UndoName());
	show(fRedoItem, "Redo", fDocument->RedoName());
}


// Asks when there is unsaved work, closes the items' windows, and goes with the last of them.
bool
FileWindow::QuitRequested()
{
	if (!fClosing)
		_ApplyItemsThen([this] { _AskAndClose(); });
	return false;
}


// The rows are ours; the list goes with the window's views.
void
FileWindow::Quit()
{
	while (BListItem* row = fList->RemoveItem(static_cast<int32>(0)))
		delete row;

	BMessage closed(kFileWindowClosed);
	closed.AddPointer("window", this);
	be_app->PostMessage(&closed);
	BWindow::Quit();
}


const char*
FileWindow::Path() const
{
	return fDocument->Path();
}


bool
FileWindow::OpenItem(type_code type, int32 id)
{
	BResourceHandle handle;
	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		handle = collection->FindItem(type, id);
		fAccess.ReadUnlock(collection);
	}
	if (handle.IsValid())
		_OpenHandle(handle);
	return handle.IsValid();
}


bool
FileWindow::OpenFirstArchive()
{
	BResourceHandle handle;
	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		for (int32 i = 0; i < collection->CountItems() && !handle.IsValid(); i++) {
			if (collection->Item(collection->HandleAt(i))->Type() == kArchiveType)
				handle = collection->HandleAt(i);
		}
		fAccess.ReadUnlock(collection);
	}
	if (handle.IsValid())
		_OpenHandle(handle);
	return handle.IsValid();
}


// #pragma mark - contents


void
FileWindow::_AddMenuBar()
{
	fMenuBar = new BMenuBar(BRect(0, 0, Bounds().right, 10), "menu bar");

	BMenu* menu = new BMenu("File");
	menu->AddItem(new BMenuItem("New", new BMessage(kNewFile), 'N'));
	menu->AddItem(new BMenuItem("Open...", new BMessage(kOpenFile), 'O'));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Save", new BMessage(kSave), 'S'));
	menu->AddItem(new BMenuItem("Save As...", new BMessage(kSaveAs), 'S', B_SHIFT_KEY));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Close", new BMessage(B_QUIT_REQUESTED), 'W'));
	BMenuItem* quit = new BMenuItem("Quit", new BMessage(B_QUIT_REQUESTED), 'Q');
	menu->AddItem(quit);
	fMenuBar->AddItem(menu);

	menu = new BMenu("Edit");
	fUndoItem = new BMenuItem("Undo", new BMessage(kUndoStep), 'Z');
	fRedoItem = new BMenuItem("Redo", new BMessage(kRedoStep), 'Z', B_SHIFT_KEY);
	menu->AddItem(fUndoItem);
	menu->AddItem(fRedoItem);
	fMenuBar->AddItem(menu);

	menu = new BMenu("Resource");
	BMenu* newMenu = new BMenu("New");
	_AddNewMenu(newMenu);
	menu->AddItem(newMenu);
	menu->AddItem(new BMenuItem("Open", new BMessage(kOpenItem)));
	menu->AddItem(new BMenuItem("Delete", new BMessage(kDeleteItem)));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Import...", new BMessage(kImportItem), 'I'));
	menu->AddItem(new BMenuItem("Export...", new BMessage(kExportItem), 'E'));
	fMenuBar->AddItem(menu);

	AddChild(fMenuBar);
	quit->SetTarget(be_app);
}


void
FileWindow::_AddList(float top)
{
	BRect frame = Bounds();
	frame.top = top;
	frame.bottom = top + kHeaderHeight - 1;
	AddChild(new ListHeader(frame));

	frame.top = frame.bottom + 1;
	frame.bottom = Bounds().bottom;
	frame.InsetBy(2, 2);
	frame.right -= kScrollBarSize;
	fList = new BListView(frame, "items", B_SINGLE_SELECTION_LIST, B_FOLLOW_ALL_SIDES,
		B_WILL_DRAW | B_NAVIGABLE | B_FRAME_EVENTS | B_FULL_UPDATE_ON_RESIZE);
	fList->SetInvocationMessage(new BMessage(kOpenItem));
	AddChild(new BScrollView("scroll", fList, B_FOLLOW_ALL_SIDES, 0, false, true));

	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		for (int32 i = 0; i < collection->CountItems(); i++)
			fList->AddItem(new ItemRow(collection->Item(collection->HandleAt(i))));
		fAccess.ReadUnlock(collection);
	}
	fList->Select(0);
	fList->MakeFocus(true);
}


// One entry for each kind of item that an add-on can make.
void
FileWindow::_AddNewMenu(BMenu* menu)
{
	const auto& handlers = fHandlers->Handlers();
	for (size_t i = 0; i < handlers.size(); i++) {
		for (int32 n = 0;; n++) {
			BMessage info(kGenerateItem);
			if (handlers[i]->GetNthGenerateInfo(n, &info) != B_OK)
				break;
			info.AddInt32("handler", static_cast<int32>(i));
			const char* name = info.GetString(B_GENERATE_NAME, "Resource");
			menu->AddItem(new BMenuItem(name, new BMessage(info)));
		}
	}
}


void
FileWindow::_OpenHandle(const BResourceHandle& handle)
{
	for (const OpenWindow& open : fItemWindows) {
		if (open.handle == handle) {
			open.window->Lock();
			open.window->Activate(true);
			open.window->Unlock();
			return;
		}
	}

	const BRect frame =
		BRect(0, 0, 400, 300)
			.OffsetToCopy(Frame().LeftTop() + BPoint(kItemWindowOffset, kItemWindowOffset));
	ItemWindow* window =
		new ItemWindow(frame, BMessenger(this), fDocument.get(), fHandlers.get(), handle);
	fItemWindows.push_back({ window, BMessenger(window), handle });
	window->Show();
}


void
FileWindow::_OpenSelection()
{
	if (ItemRow* row = dynamic_cast<ItemRow*>(fList->ItemAt(fList->CurrentSelection())))
		_OpenHandle(row->Handle());
}


void
FileWindow::_DeleteSelection()
{
	ItemRow* row = dynamic_cast<ItemRow*>(fList->ItemAt(fList->CurrentSelection()));
	if (row == nullptr)
		return;

	for (const OpenWindow& open : fItemWindows) {
		if (open.handle == row->Handle())
			open.messenger.SendMessage(B_QUIT_REQUESTED);
	}
	if (BResourceCollection* collection = fAccess.WriteLock("Delete")) {
		collection->RemoveItem(row->Handle());
		fAccess.WriteUnlock(collection);
	}
}


void
FileWindow::_Generate(BMessage* request)
{
	const auto& handlers = fHandlers->Handlers();
	const size_t index = static_cast<size_t>(request->GetInt32("handler", -1));
	if (index >= handlers.size())
		return;

	BResourceHandle handle;
	const status_t status = handlers[index]->GenerateResource(
		&handle, request, 1, "", true, BResourceCollection::B_FAIL_ON_CONFLICT);
	if (status == B_OK)
		_OpenHandle(handle);
	else
		_Tell(std::string("The resource could not be made: ") + StatusText(status) + ".");
}


void
FileWindow::_ReadChanges()
{
	const BResourceCollection* collection = fAccess.ReadLock();
	if (collection == nullptr)
		return;

	uint32 changes;
	BResourceHandle handle;
	while ((handle = collection->GetNextChange(&fAccess, &changes)).IsValid())
		_TakeChange(collection, handle, changes);
	fAccess.ReadUnlock(collection);
	_UpdateTitle();
}


void
FileWindow::_TakeChange(
	const BResourceCollection* collection, const BResourceHandle& handle, uint32 changes)
{
	const BResourceItem* item = collection->Item(handle);
	ItemRow* row = _RowFor(handle);
	if (item == nullptr) {
		fList->RemoveItem(row);
		delete row;
	} else if (row == nullptr) {
		fList->AddItem(new ItemRow(item));
		fList->Select(fList->CountItems() - 1);
	} else {
		row->SetTo(item);
		fList->InvalidateItem(fList->IndexOf(row));
	}
}


ItemRow*
FileWindow::_RowFor(const BResourceHandle& handle) const
{
	for (int32 i = 0; i < fList->CountItems(); i++) {
		ItemRow* row = static_cast<ItemRow*>(fList->ItemAt(i));
		if (row->Handle() == handle)
			return row;
	}
	return nullptr;
}


void
FileWindow::_UpdateTitle()
{
	BString title(fDocument->Name());
	if (fDocument->IsModified())
		title << " *";
	if (title != Title())
		SetTitle(title.String());
}


// #pragma mark - saving and closing


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
	if (fClosing && fItemWindows.empty())
		Quit();
}


void
FileWindow::_Save()
{
	if (!_MayReplaceFile()) {
		fSaveBeforeClosing = false;
		return;
	}
	const status_t status = fDocument->Save();
	if (status != B_OK) {
		fSaveBeforeClosing = false;
		_Tell(std::string("\"") + fDocument->Path() + "\" could not be saved: " + StatusText(status)
			+ ". The file is as it was.");
	}
	_UpdateTitle();
	if (fSaveBeforeClosing)
		_CloseItems();
}


void
FileWindow::_SaveAs(const std::string& path)
{
	const status_t status = fDocument->SaveAs(path.c_str());
	if (status != B_OK) {
		fSaveBeforeClosing = false;
		_Tell("\"" + path + "\" could not be written: " + StatusText(status) + ".");
	}
	_UpdateTitle();
	if (fSaveBeforeClosing)
		_CloseItems();
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
	BAlert* alert = new BAlert(
		"Changed on disk", text.c_str(), "Cancel", "Save", NULL, B_WIDTH_AS_USUAL, B_WARNING_ALERT);
	alert->SetShortcut(0, B_ESCAPE);
	return alert->Go() == 1;
}


void
FileWindow::_AskAndClose()
{
	if (!fDocument->IsModified()) {
		_CloseItems();
		return;
	}

	const std::string text =
		std::string("Save the changes to \"") + fDocument->Name() + "\" before closing?";
	BAlert* alert = new BAlert("Unsaved changes", text.c_str(), "Cancel", "Don't Save", "Save",
		B_WIDTH_AS_USUAL, B_WARNING_ALERT);
	alert->SetShortcut(0, B_ESCAPE);
	switch (alert->Go()) {
		case 1:
			_CloseItems();
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


void
FileWindow::_CloseItems()
{
	fClosing = true;
	if (fItemWindows.empty()) {
		Quit();
		return;
	}
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
