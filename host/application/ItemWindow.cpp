#include "host/application/ItemWindow.h"

#include <cctype>

#include <AppDefs.h>
#include <Button.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <TextView.h>

#include "host/application/AddonRoster.h"
#include "host/application/BytesEditor.h"
#include "host/application/Codes.h"
#include "host/application/FourCharacters.h"
#include "host/application/ItemCheck.h"
#include "host/application/ResourceDocument.h"
#include "host/library/ResourceAddon.h"

using namespace BResEditor;

namespace {


// Behind what the focus view posted when it lost the focus.
constexpr uint32 kApplyNow = 'ApNw';
constexpr uint32 kCloseNow = 'ClNw';


// Reads of the document for the length of a scope.
class Reader : public BResourceAddonBase {
public:
	explicit Reader(ResourceDocument* document) :
		BResourceAddonBase(BResourceAddonArgs { document }), fCollection(ReadLock())
	{
	}
	~Reader() override { ReadUnlock(fCollection); }

	const BResourceItem* Item(const BResourceHandle& handle) { return fCollection->Item(handle); }

private:
	const BResourceCollection* fCollection;
};


bool
HasItem(const BMenu* menu, const void* address)
{
	for (int32 i = 0; i < menu->CountItems(); i++) {
		const BMenuItem* item = menu->ItemAt(i);
		if (item == address || (item->Submenu() != nullptr && HasItem(item->Submenu(), address)))
			return true;
	}
	return false;
}


// The item that a key pressed with Command stands for, in the menu or its submenus; NULL if none.
BMenuItem*
ItemForKey(const BMenu* menu, int32 key, uint32 modifiers)
{
	constexpr uint32 kTellingApart = B_SHIFT_KEY | B_OPTION_KEY;
	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		if (BMenu* submenu = item->Submenu()) {
			if (BMenuItem* found = ItemForKey(submenu, key, modifiers))
				return found;
			continue;
		}
		uint32 needed;
		const uchar shortcut = static_cast<uchar>(item->Shortcut(&needed));
		if (shortcut != 0 && tolower(shortcut) == tolower(key)
			&& ((needed ^ modifiers) & kTellingApart) == 0)
			return item;
	}
	return nullptr;
}


// The same, in all menus of a view tree.
BMenuItem*
ItemForKey(const BView* view, int32 key, uint32 modifiers)
{
	if (const BMenu* menu = dynamic_cast<const BMenu*>(view)) {
		if (BMenuItem* found = ItemForKey(menu, key, modifiers))
			return found;
	}
	for (const BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		if (BMenuItem* found = ItemForKey(child, key, modifiers))
			return found;
	}
	return nullptr;
}


bool
LiesIn(const BView* view, const BView* tree)
{
	for (; view != nullptr; view = view->Parent()) {
		if (view == tree)
			return true;
	}
	return false;
}


} // namespace


ItemWindow::ItemWindow(BRect frame, const BMessenger& fileWindow, ResourceDocument* document,
	HandlerSet* handlers, const BResourceHandle& handle) :
	BWindow(frame, "", B_DOCUMENT_WINDOW, B_ASYNCHRONOUS_CONTROLS),
	fFileWindow(fileWindow), fDocument(document), fHandlers(handlers), fHandle(handle),
	fEditsObject(false)
{
	_AddMenuBar();
	_AddEditor();
	_UpdateTitle();
}


ItemWindow::~ItemWindow()
{
}


const BResourceHandle&
ItemWindow::Handle() const
{
	return fHandle;
}


// The controls of an edited design are live. Their messages, even a quit request, mean nothing
// here; their default button does not take Enter from the panels, nor their menus a shortcut.
void
ItemWindow::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (handler == this && _IsFromDesign(message))
		return;

	if (message->what == B_KEY_DOWN && fEditor != nullptr) {
		if (_TakeShortcut(message))
			return;
		if (handler == DefaultButton() && CurrentFocus() != nullptr
			&& LiesIn(DefaultButton(), fEditor->View()))
			handler = CurrentFocus();
	}

	if (message->what == B_RESOURCE_DATA_CHANGED && fEditor != nullptr && fEditsObject
		&& handler == fEditor->View() && !_WhyUnfit().empty()) {
		// The new bytes must not reach an editor that could not show them.
		_RemoveEditor(false);
		if (!_ItemIsGone())
			_AddEditor();
		else
			PostMessage(B_QUIT_REQUESTED);
		return;
	}
	if (message->what == B_RESOURCE_DATA_CHANGED)
		_UpdateTitle();
	BWindow::DispatchMessage(message, handler);
}


// The text commands go to the field that has the keyboard.
void
ItemWindow::MenusBeginning()
{
	BTextView* text = dynamic_cast<BTextView*>(CurrentFocus());
	for (const uint32 command : { B_CUT, B_COPY, B_PASTE, B_SELECT_ALL }) {
		BMenuItem* item = fEditMenu->FindItem(command);
		item->SetTarget(text);
		item->SetEnabled(text != nullptr);
	}
}


void
ItemWindow::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kSave:
		case kUndoStep:
		case kRedoStep:
			fFileWindow.SendMessage(message);
			break;

		case kApplyItem: {
			if (CurrentFocus() != nullptr)
				fFormerFocus = BMessenger(CurrentFocus());
			_ReleaseFocus();
			BMessage now(kApplyNow);
			now.AddMessenger("reply", message->ReturnAddress());
			PostMessage(&now);
			break;
		}
		case kApplyNow:
			_ApplyNow(message);
			break;

		case kCloseNow:
			_RemoveEditor(true);
			Quit();
			break;

		default:
			BWindow::MessageReceived(message);
	}
}


// What is being typed is taken over before the editor goes.
bool
ItemWindow::QuitRequested()
{
	_ReleaseFocus();
	PostMessage(kCloseNow);
	return false;
}


void
ItemWindow::Quit()
{
	_RemoveEditor(true);
	BMessage closed(kItemClosed);
	closed.AddPointer("window", this);
	fFileWindow.SendMessage(&closed);
	BWindow::Quit();
}


// #pragma mark - private


void
ItemWindow::_AddMenuBar()
{
	fMenuBar = new BMenuBar(BRect(0, 0, Bounds().right, 10), "menu bar");

	BMenu* menu = new BMenu("File");
	menu->AddItem(new BMenuItem("Save", new BMessage(kSave), 'S'));
	menu->AddItem(new BMenuItem("Close", new BMessage(B_QUIT_REQUESTED), 'W'));
	fMenuBar->AddItem(menu);

	menu = new BMenu("Edit");
	menu->AddItem(new BMenuItem("Undo", new BMessage(kUndoStep), 'Z'));
	menu->AddItem(new BMenuItem("Redo", new BMessage(kRedoStep), 'Z', B_SHIFT_KEY));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Cut", new BMessage(B_CUT), 'X'));
	menu->AddItem(new BMenuItem("Copy", new BMessage(B_COPY), 'C'));
	menu->AddItem(new BMenuItem("Paste", new BMessage(B_PASTE), 'V'));
	menu->AddItem(new BMenuItem("Select All", new BMessage(B_SELECT_ALL), 'A'));
	fMenuBar->AddItem(menu);
	fEditMenu = menu;

	AddChild(fMenuBar);
	SetKeyMenuBar(fMenuBar);
}


void
ItemWindow::_AddEditor()
{
	const BResourceAddonArgs args = { fDocument };
	std::string note;
	{
		Reader reader(fDocument);
		if (const BResourceItem* item = reader.Item(fHandle)) {
			if (BResourceAddon* handler = fHandlers->BestFor(item)) {
				note = WhyNoArchivedObject(item);
				if (note.empty())
					fEditor.reset(handler->MakeFullEditor(args, fHandle, NULL));
			}
		}
	}
	fEditsObject = fEditor != nullptr;
	if (fEditor == nullptr)
		fEditor = std::make_unique<BytesEditor>(args, fHandle, note);

	BView* view = fEditor->View();
	const float top = fMenuBar->Frame().bottom + 1;
	float width, height;
	view->GetPreferredSize(&width, &height);
	ResizeTo(std::max(width, Bounds().Width()), std::max(height + top, Bounds().Height()));
	// Only what is attached has its children follow.
	AddChild(view);
	view->MoveTo(0, top);
	view->ResizeTo(Bounds().Width(), Bounds().Height() - top);
	SetKeyMenuBar(fMenuBar);
}


// The editor writes back, if it may, while it is detached.
void
ItemWindow::_RemoveEditor(bool writeBack)
{
	if (fEditor == nullptr)
		return;

	if (!writeBack)
		fEditor->Disconnect();
	fEditor->View()->RemoveSelf();
	fEditor.reset();
}


void
ItemWindow::_UpdateTitle()
{
	Reader reader(fDocument);
	const BResourceItem* item = reader.Item(fHandle);
	if (item == nullptr)
		return;

	std::string title = std::string(fDocument->Name()) + ": " + FourCharacters(item->Type()) + " "
		+ std::to_string(item->ID());
	if (item->Name()[0] != '\0')
		title += std::string(" \"") + item->Name() + "\"";
	SetTitle(title.c_str());
}


void
ItemWindow::_ReleaseFocus()
{
	if (BView* focus = CurrentFocus())
		focus->MakeFocus(false);
}


void
ItemWindow::_ApplyNow(BMessage* request)
{
	if (fEditor != nullptr)
		fEditor->ApplyChanges();

	BLooper* looper;
	BView* focus = dynamic_cast<BView*>(fFormerFocus.Target(&looper));
	if (focus != nullptr && focus->Window() == this && CurrentFocus() == nullptr)
		focus->MakeFocus(true);
	fFormerFocus = BMessenger();

	BMessenger reply;
	if (request->FindMessenger("reply", &reply) == B_OK) {
		BMessage applied(kItemApplied);
		applied.AddPointer("window", this);
		reply.SendMessage(&applied);
	}
}


bool
ItemWindow::_ItemIsGone() const
{
	Reader reader(fDocument);
	return reader.Item(fHandle) == nullptr;
}


std::string
ItemWindow::_WhyUnfit() const
{
	Reader reader(fDocument);
	const BResourceItem* item = reader.Item(fHandle);
	return item != nullptr ? WhyNoArchivedObject(item) : "The item is gone.";
}


// Invocations name their source. Only those of this window's own menus are meant for it.
bool
ItemWindow::_IsFromDesign(const BMessage* message) const
{
	void* source;
	return message->FindPointer("source", &source) == B_OK && !HasItem(fMenuBar, source);
}


// Carries out a shortcut of this window's own menus, and drops one that only the design has. All
// other keys are left to the window.
bool
ItemWindow::_TakeShortcut(const BMessage* message)
{
	int32 key, modifiers;
	if (message->FindInt32("raw_char", &key) != B_OK
		|| message->FindInt32("modifiers", &modifiers) != B_OK || (modifiers & B_COMMAND_KEY) == 0)
		return false;

	if (BMenuItem* own = ItemForKey(fMenuBar, key, modifiers)) {
		MenusBeginning();
		static_cast<BInvoker*>(own)->Invoke();
		MenusEnded();
		return true;
	}
	return ItemForKey(fEditor->View(), key, modifiers) != nullptr;
}
