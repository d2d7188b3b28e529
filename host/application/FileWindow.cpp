#include "host/application/FileWindow.h"

#include <AppDefs.h>
#include <Application.h>
#include <Entry.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <ScrollView.h>
#include <String.h>

#include "host/application/AddonRoster.h"
#include "host/application/Codes.h"
#include "host/application/ItemList.h"
#include "host/application/ListHeader.h"
#include "host/application/RecentFiles.h"
#include "host/application/ResourceDocument.h"

using namespace BResEditor;

namespace {


constexpr type_code kArchiveType = 'ARCV';
constexpr float kScrollBarSize = 14;
constexpr float kHeaderHeight = 18;
constexpr uint32 kFileChanged = 'Fchg';
constexpr uint32 kSelectionCommands[] = { B_CUT, B_COPY, kDuplicateItem, kDeleteItem, kOpenItem,
	kItemAttributes, kExportItem };


} // namespace


FileWindow::FileWindow(BRect frame, std::unique_ptr<ResourceDocument> document) :
	BWindow(frame, document->Name(), B_DOCUMENT_WINDOW, B_ASYNCHRONOUS_CONTROLS),
	fDocument(std::move(document)), fArgs { fDocument.get() }, fAccess(fArgs, this),
	fHandlers(std::make_unique<HandlerSet>(fArgs)), fAnswersMissing(0), fSaveBeforeClosing(false),
	fAskedAboutDisk(false)
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
		case kRevert:
			_AskAndRevert();
			break;
		case kFileChanged:
			_AskAboutChangeOnDisk();
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
		case B_SIMPLE_DATA: // files dropped onto the window
			message->what = B_REFS_RECEIVED;
			be_app->PostMessage(message);
			break;
		case kAttributesChosen:
			_SetAttributes(message);
			break;
		case kGenerateItem:
			_Generate(message);
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
			if (!_TakeItemCommand(message->what))
				BWindow::MessageReceived(message);
	}
}


void
FileWindow::MenusBeginning()
{
	auto show = [this](uint32 what, const char* verb, const char* step) {
		BString label(verb);
		if (step != nullptr)
			label << " " << step;
		BMenuItem* item = fMenuBar->FindItem(what);
		item->SetLabel(label.String());
		item->SetEnabled(step != nullptr);
	};
	show(kUndoStep, "Undo", fDocument->UndoName());
	show(kRedoStep, "Redo", fDocument->RedoName());

	const bool isSelected = fList->FirstSelected().IsValid();
	for (const uint32 what : kSelectionCommands)
		fMenuBar->FindItem(what)->SetEnabled(isSelected);
	fMenuBar->FindItem(kRevert)->SetEnabled(fDocument->Path()[0] != '\0');
	_ShowRecentFiles();
}


// Another program may have been at the file while its window was active.
void
FileWindow::WindowActivated(bool active)
{
	if (active)
		PostMessage(kFileChanged);
}


// Asks when there is unsaved work, closes the items' windows, and goes with the last of them.
bool
FileWindow::QuitRequested()
{
	if (!fAfterClosing)
		_ApplyItemsThen([this] { _AskAndClose(); });
	return false;
}


void
FileWindow::Quit()
{
	_CloseAttributes();
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
	fMenuBar->AddItem(_FileMenu());
	fMenuBar->AddItem(_EditMenu());
	fMenuBar->AddItem(_ResourceMenu());
	AddChild(fMenuBar);
	fMenuBar->FindItem("Quit")->SetTarget(be_app);
}


BMenu*
FileWindow::_FileMenu()
{
	BMenu* menu = new BMenu("File");
	menu->AddItem(new BMenuItem("New", new BMessage(kNewFile), 'N'));
	menu->AddItem(new BMenuItem("Open...", new BMessage(kOpenFile), 'O'));
	fRecentMenu = new BMenu("Open Recent");
	menu->AddItem(fRecentMenu);
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Save", new BMessage(kSave), 'S'));
	menu->AddItem(new BMenuItem("Save As...", new BMessage(kSaveAs), 'S', B_SHIFT_KEY));
	menu->AddItem(new BMenuItem("Revert...", new BMessage(kRevert)));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Close", new BMessage(B_QUIT_REQUESTED), 'W'));
	menu->AddItem(new BMenuItem("Quit", new BMessage(B_QUIT_REQUESTED), 'Q'));
	return menu;
}


BMenu*
FileWindow::_EditMenu()
{
	BMenu* menu = new BMenu("Edit");
	menu->AddItem(new BMenuItem("Undo", new BMessage(kUndoStep), 'Z'));
	menu->AddItem(new BMenuItem("Redo", new BMessage(kRedoStep), 'Z', B_SHIFT_KEY));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Cut", new BMessage(B_CUT), 'X'));
	menu->AddItem(new BMenuItem("Copy", new BMessage(B_COPY), 'C'));
	menu->AddItem(new BMenuItem("Paste", new BMessage(B_PASTE), 'V'));
	menu->AddItem(new BMenuItem("Select All", new BMessage(B_SELECT_ALL), 'A'));
	return menu;
}


BMenu*
FileWindow::_ResourceMenu()
{
	BMenu* menu = new BMenu("Resource");
	BMenu* newMenu = new BMenu("New");
	_AddNewMenu(newMenu);
	menu->AddItem(newMenu);
	menu->AddItem(new BMenuItem("Open", new BMessage(kOpenItem)));
	menu->AddItem(new BMenuItem("Attributes...", new BMessage(kItemAttributes), 'R'));
	menu->AddItem(new BMenuItem("Duplicate", new BMessage(kDuplicateItem), 'D'));
	menu->AddItem(new BMenuItem("Delete", new BMessage(kDeleteItem)));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Import...", new BMessage(kImportItem), 'I'));
	menu->AddItem(new BMenuItem("Export...", new BMessage(kExportItem), 'E'));
	return menu;
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
	fList = new ItemList(frame);
	AddChild(new BScrollView("scroll", fList, B_FOLLOW_ALL_SIDES, 0, false, true));

	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		for (int32 i = 0; i < collection->CountItems(); i++)
			fList->Update(collection, collection->HandleAt(i));
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


// The files that were used last, those of this window left out.
void
FileWindow::_ShowRecentFiles()
{
	while (BMenuItem* item = fRecentMenu->RemoveItem(static_cast<int32>(0)))
		delete item;

	for (const std::string& path : RecentFiles::Paths()) {
		entry_ref ref;
		if (path == fDocument->Path() || get_ref_for_path(path.c_str(), &ref) != B_OK)
			continue;
		BMessage open(B_REFS_RECEIVED);
		open.AddRef("refs", &ref);
		BMenuItem* item = new BMenuItem(path.c_str(), new BMessage(open));
		item->SetTarget(be_app);
		fRecentMenu->AddItem(item);
	}
	fRecentMenu->Superitem()->SetEnabled(fRecentMenu->CountItems() > 0);
}


// What is being typed in an item's window belongs to the item that is copied.
bool
FileWindow::_TakeItemCommand(uint32 what)
{
	switch (what) {
		case kOpenItem:
			_OpenSelection();
			return true;
		case kItemAttributes:
			_AskForAttributes();
			return true;
		case kDeleteItem:
			_DeleteSelection("Delete");
			return true;
		case kDuplicateItem:
			_ApplyItemsThen([this] { _DuplicateSelection(); });
			return true;
		case B_COPY:
			_ApplyItemsThen([this] { _CopySelection(); });
			return true;
		case B_CUT:
			_ApplyItemsThen([this] {
				if (_CopySelection())
					_DeleteSelection("Cut");
			});
			return true;
		case B_PASTE:
			_Paste();
			return true;
		case B_SELECT_ALL:
			fList->Select(0, fList->CountItems() - 1);
			return true;
		case kUndoStep:
			fDocument->Undo();
			return true;
		case kRedoStep:
			fDocument->Redo();
			return true;
		default:
			return false;
	}
}


// What is new gets selected, unless all is.
void
FileWindow::_ReadChanges()
{
	const BResourceCollection* collection = fAccess.ReadLock();
	if (collection == nullptr)
		return;

	uint32 changes;
	BResourceHandle handle;
	std::vector<BResourceHandle> added;
	while ((handle = collection->GetNextChange(&fAccess, &changes)).IsValid()) {
		if (fList->Update(collection, handle))
			added.push_back(handle);
	}
	fAccess.ReadUnlock(collection);
	if (static_cast<int32>(added.size()) < fList->CountItems())
		fList->SelectItems(added);
	else
		fList->Select(0);
	_UpdateTitle();
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
