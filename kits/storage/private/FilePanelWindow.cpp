// FilePanelWindow: its making and what it shows. What the user chooses: FilePanelChoice.cpp.
#include "storage/private/FilePanelWindow.h"

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Application.h>
#include <Button.h>
#include <InterfaceDefs.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Path.h>
#include <PopUpMenu.h>
#include <ScrollView.h>
#include <TextControl.h>
#include <TextView.h>

#include "interface/private/Look.h"
#include "storage/private/FavoriteFolders.h"
#include "storage/private/FileList.h"
#include "storage/private/FilePanelCodes.h"

namespace BPrivate {

namespace {


constexpr float kWidth = 480;
constexpr float kHeight = 340;
constexpr float kMinimumWidth = 380;
constexpr float kMinimumHeight = 220;
constexpr float kMaximumSize = 32767;
constexpr float kMargin = 10;
constexpr float kGap = 8;
constexpr float kHeaderHeight = 18;
constexpr float kListBorder = 2;
constexpr float kNameDivider = 40;
constexpr float kFolderDivider = 46;


BMenuItem*
FolderItemFor(const char* label, const std::string& path, char shortcut = 0)
{
	BMessage* message = new BMessage(kPanelGo);
	message->AddString("path", path.c_str());
	return new BMenuItem(label, message, shortcut);
}


} // namespace


FilePanelWindow::FilePanelWindow(BFilePanel* panel, const Setup& setup) :
	BWindow(BRect(0, 0, kWidth - 1, kHeight - 1), setup.mode == B_OPEN_PANEL ? "Open" : "Save",
		B_TITLED_WINDOW_LOOK, setup.modal ? B_MODAL_APP_WINDOW_FEEL : B_NORMAL_WINDOW_FEEL,
		B_ASYNCHRONOUS_CONTROLS | B_NOT_ZOOMABLE | B_CLOSE_ON_ESCAPE),
	fPanel(panel), fMode(setup.mode), fManyFiles(setup.manyFiles && setup.mode == B_OPEN_PANEL),
	fHideWhenDone(setup.hideWhenDone), fTarget(setup.target), fChangeTime(0), fNameTyped(false),
	fNextSelected(0)
{
	fRules.flavors = fMode == B_OPEN_PANEL ? setup.flavors : static_cast<uint32>(B_ANY_NODE);
	fRules.filter = setup.filter;
	SetMessage(NULL);
	SetSizeLimits(kMinimumWidth, kMaximumSize, kMinimumHeight, kMaximumSize);

	BView* ground = new BView(Bounds(), "ground", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	ground->SetViewColor(Look::PanelColor());
	AddChild(ground);
	_AddMenus();
	_AddFolderField(fMenuBar->Frame().bottom + 1 + kGap);
	_AddButtons();
	_AddNameField();
	_AddList();

	for (const char* path : { setup.folder.c_str(), "/" }) {
		if (_Read(path))
			break;
	}
	_FillFavorites();
	CenterOnScreen();
}


FilePanelWindow::~FilePanelWindow()
{
}


void
FilePanelWindow::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kPanelSelection:
			_RowsSelected();
			break;
		case kPanelInvoked:
			_Invoked();
			break;
		case kPanelName:
			_NameChanged();
			break;
		case kPanelChoose:
			_Choose();
			break;
		case kPanelCancel:
			_Cancel();
			break;
		case kPanelReplace:
			if (message->GetInt32("which", 0) == 1 && !IsHidden())
				_Save(message->GetString("path", ""));
			break;
		case kPanelGo:
			GoTo(message->GetString("path", "/"));
			break;
		case kPanelParent: {
			const std::string left = BPath(fFolder.c_str()).Leaf();
			GoTo(ResolveTypedPath("..", fFolder));
			fList->SelectName(left);
			break;
		}
		case kPanelHidden:
			fRules.hidden = !fRules.hidden;
			Refresh();
			break;
		case kPanelRefresh:
			Refresh();
			break;
		case kPanelAskFolder:
			_AskForFolder();
			break;
		case kPanelMakeFolder:
			_MakeFolder(message->GetString("name", ""));
			break;
		case kPanelAddFavorite:
			_ChangeFavorites(AddFavoriteFolder(fFolder));
			break;
		case kPanelRemoveFavorite:
			_ChangeFavorites(RemoveFavoriteFolder(fFolder));
			break;
		default:
			if (message->WasDropped() && message->HasRef("refs"))
				_TakeDrop(message);
			else
				BWindow::MessageReceived(message);
	}
}


void
FilePanelWindow::MenusBeginning()
{
	fHiddenItem->SetMarked(fRules.hidden);
}


void
FilePanelWindow::WindowActivated(bool active)
{
	BWindow::WindowActivated(active);
	if (active && FolderChangeTime(fFolder) != fChangeTime)
		Refresh();
}


// An application that quits waits for the answer; a user who closes the window does not.
bool
FilePanelWindow::QuitRequested()
{
	const BMessage* message = CurrentMessage();
	const bool ends = message != NULL && message->IsSourceWaiting();
	if (!IsHidden())
		_Cancel();
	return ends;
}


void
FilePanelWindow::ShowPanel()
{
	if (!IsHidden()) {
		Activate(true);
		return;
	}
	if (FolderChangeTime(fFolder) != fChangeTime)
		Refresh();
	_FillFavorites();
	_FocusFirst();
	Show();
}


void
FilePanelWindow::HidePanel()
{
	if (!IsHidden())
		Hide();
}


void
FilePanelWindow::GoTo(const std::string& folder)
{
	if (!_Read(folder)) {
		_Tell("The folder \"" + folder + "\" cannot be read.");
		return;
	}
	fList->ScrollTo(0, 0);
	if (fMode == B_OPEN_PANEL || std::string(fNameField->Text()).find('/') != std::string::npos)
		SetName("");
}


void
FilePanelWindow::Refresh()
{
	if (!_Read(fFolder))
		_Read("/");
}


void
FilePanelWindow::SetFilter(BRefFilter* filter)
{
	fRules.filter = filter;
	Refresh();
}


BMessenger
FilePanelWindow::Target() const
{
	return fTarget.IsValid() ? fTarget : be_app_messenger;
}


void
FilePanelWindow::SetMessage(const BMessage* message)
{
	if (message != NULL)
		fMessage = *message;
	else if (fMode == B_OPEN_PANEL)
		fMessage = BMessage(B_REFS_RECEIVED);
	else
		fMessage = BMessage(B_SAVE_REQUESTED);
}


// What comes before the last dot is selected, for it is what the user would replace.
void
FilePanelWindow::SetName(const std::string& name)
{
	fShownName = name;
	fTypedName = name;
	fNameTyped = false;
	fNameField->SetText(name.c_str());
	const size_t dot = name.rfind('.');
	if (dot != std::string::npos && dot > 0 && fNameField->TextView()->IsFocus())
		fNameField->TextView()->Select(0, static_cast<int32>(dot));
}


void
FilePanelWindow::SetButtonLabel(file_panel_button button, const char* label)
{
	(button == B_CANCEL_BUTTON ? fCancelButton : fDefaultButton)->SetLabel(label);
	_LayOutButtons();
}


status_t
FilePanelWindow::GetNextSelectedRef(entry_ref* _ref)
{
	const int32 index = fList->CurrentSelection(fNextSelected);
	if (index < 0)
		return B_ENTRY_NOT_FOUND;
	fNextSelected++;
	return get_ref_for_path((fFolder + "/" + fList->RowAt(index)->Item().name).c_str(), _ref);
}


// #pragma mark - contents


void
FilePanelWindow::_AddMenus()
{
	fMenuBar = new BMenuBar(BRect(0, 0, Bounds().right, 10), "menu bar");
	fMenuBar->AddItem(_MakeFileMenu());
	fFavoritesMenu = new BMenu("Favorites");
	fMenuBar->AddItem(fFavoritesMenu);
	ChildAt(0)->AddChild(fMenuBar);
}


BMenu*
FilePanelWindow::_MakeFileMenu()
{
	BMenu* menu = new BMenu("File");
	menu->AddItem(new BMenuItem("New Folder...", new BMessage(kPanelAskFolder), 'N'));
	menu->AddItem(new BMenuItem("Enclosing Folder", new BMessage(kPanelParent), B_UP_ARROW));
	menu->AddItem(new BMenuItem("Refresh", new BMessage(kPanelRefresh), 'R'));
	fHiddenItem = new BMenuItem("Show Hidden Files", new BMessage(kPanelHidden), 'I');
	menu->AddItem(fHiddenItem);
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Close", new BMessage(kPanelCancel), 'W'));
	return menu;
}


void
FilePanelWindow::_AddFolderField(float top)
{
	const BRect frame(kMargin, top, Bounds().right - kMargin, top + 22);
	BPopUpMenu* menu = new BPopUpMenu("");
	fFolderField =
		new BMenuField(frame, "folder", "Folder:", menu, false, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	fFolderField->SetDivider(kFolderDivider);
	ChildAt(0)->AddChild(fFolderField);
}


void
FilePanelWindow::_AddButtons()
{
	const BRect frame(0, 0, 74, 24);
	const uint32 follow = B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM;
	const char* label = fMode == B_OPEN_PANEL ? "Open" : "Save";
	fDefaultButton =
		new BButton(frame, "default button", label, new BMessage(kPanelChoose), follow);
	fCancelButton =
		new BButton(frame, "cancel button", "Cancel", new BMessage(kPanelCancel), follow);
	ChildAt(0)->AddChild(fCancelButton);
	ChildAt(0)->AddChild(fDefaultButton);
	fDefaultButton->MakeDefault(true);
	_LayOutButtons();
}


void
FilePanelWindow::_LayOutButtons()
{
	float right = Bounds().right - kMargin + Look::kDefaultButtonInset;
	const float middle = Bounds().bottom - kMargin - 12;
	for (BButton* button : { fDefaultButton, fCancelButton }) {
		button->ResizeToPreferred();
		const BRect size = button->Bounds();
		button->MoveTo(right - size.Width(), std::floor(middle - size.Height() / 2));
		right -= size.Width() + 1 + kGap;
	}
}


void
FilePanelWindow::_AddNameField()
{
	// Placed by its baseline: beside the buttons, as far as they leave room.
	const BRect button = fCancelButton->Frame();
	BRect frame(kMargin, button.top, button.left - kGap * 2, button.top + 20);
	fNameField = new BTextControl(
		frame, "text view", "Name:", "", NULL, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_BOTTOM);
	fNameField->SetDivider(kNameDivider);
	fNameField->SetModificationMessage(new BMessage(kPanelName));
	ChildAt(0)->AddChild(fNameField);
	const float height = fNameField->Bounds().Height();
	fNameField->MoveTo(frame.left, std::floor(button.top + (button.Height() - height) / 2));
}


void
FilePanelWindow::_AddList()
{
	BRect frame = fFolderField->Frame();
	frame.top = frame.bottom + kGap;
	frame.bottom = frame.top + kHeaderHeight - 1;
	ChildAt(0)->AddChild(new FileHeader(frame));

	frame.top = frame.bottom + 1;
	frame.bottom = std::min(fDefaultButton->Frame().top, fNameField->Frame().top) - kGap;
	frame.InsetBy(kListBorder, kListBorder);
	frame.right -= B_V_SCROLL_BAR_WIDTH;
	fList = new FileList(frame, fManyFiles ? B_MULTIPLE_SELECTION_LIST : B_SINGLE_SELECTION_LIST);
	BScrollView* scroller = new BScrollView("scroll", fList, B_FOLLOW_ALL_SIDES, 0, false, true);
	// Before the field and the buttons, so that Tab goes from the top to the bottom.
	ChildAt(0)->AddChild(scroller, fCancelButton);
	fNameField->RemoveSelf();
	ChildAt(0)->AddChild(fNameField, fCancelButton);
	fList->SetTarget(this);
}


bool
FilePanelWindow::_Read(const std::string& folder)
{
	const bigtime_t changeTime = FolderChangeTime(folder);
	std::vector<FolderItem> items;
	if (ReadFolder(folder, fRules, &items) != B_OK)
		return false;

	const bool moved = folder != fFolder;
	if (moved)
		fList->SelectNothing();
	fFolder = folder;
	fItems = std::move(items);
	fChangeTime = changeTime;
	fNextSelected = 0;
	fList->SetItems(fItems);
	if (moved)
		_ShowPlace();
	return true;
}


// The folder and those that it lies in.
void
FilePanelWindow::_ShowPlace()
{
	BMenu* menu = fFolderField->Menu();
	menu->RemoveItems(0, menu->CountItems(), true);
	BPath path(fFolder.c_str());
	bool more = path.InitCheck() == B_OK;
	while (more) {
		const std::string whole = path.Path();
		menu->AddItem(FolderItemFor(whole == "/" ? "/" : path.Leaf(), whole));
		more = whole != "/" && path.GetParent(&path) == B_OK;
	}
	menu->SetTargetForItems(this);
	if (BMenuItem* item = menu->ItemAt(0)) {
		item->SetMarked(true);
		fFolderField->MenuItem()->SetLabel(item->Label());
	}
}


void
FilePanelWindow::_FillFavorites()
{
	BMenu* menu = fFavoritesMenu;
	menu->RemoveItems(0, menu->CountItems(), true);
	for (const KnownPlace& place : KnownPlaces())
		menu->AddItem(FolderItemFor(place.label.c_str(), place.path, place.shortcut));
	menu->AddSeparatorItem();
	for (const std::string& folder : FavoriteFolders())
		menu->AddItem(FolderItemFor(BPath(folder.c_str()).Leaf(), folder));
	menu->AddItem(new BMenuItem("Add This Folder", new BMessage(kPanelAddFavorite), 'T'));
	menu->AddItem(new BMenuItem("Remove This Folder", new BMessage(kPanelRemoveFavorite)));
	menu->SetTargetForItems(this);
}


void
FilePanelWindow::_FocusFirst()
{
	if (fMode == B_OPEN_PANEL) {
		fList->MakeFocus(true);
		return;
	}
	fNameField->MakeFocus(true);
	SetName(fNameField->Text());
}

} // namespace BPrivate
