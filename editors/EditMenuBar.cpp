#include "editors/EditMenuBar.h"

#include <Beep.h>
#include <Button.h>
#include <CheckBox.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <OutlineListView.h>
#include <ScrollView.h>
#include <TextControl.h>
#include <TextView.h>

#include "archive/ViewTree.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kBorderChosen = 'brdr';
constexpr uint32 kEntrySelected = 'list';
constexpr uint32 kLabelChanged = 'labl';
constexpr uint32 kEnabledChanged = 'enbl';
constexpr uint32 kMessageChanged = 'mssg';
constexpr uint32 kKindChosen = 'mode';
constexpr uint32 kAddBeforePressed = 'befr';
constexpr uint32 kAddAfterPressed = 'aftr';
constexpr uint32 kDeletePressed = 'dlte';
constexpr uint32 kAddSubmenuPressed = 'asub';

constexpr uint32 kNoMessage = 0x3f3f3f3f; // shown as four question marks
constexpr uint32 kNewItemMessage = 'menu';
constexpr uint32 kSubItemMessage = 'xxxx';

constexpr float kPanelHeight = 300;
constexpr float kListHeight = 100;
constexpr float kScrollBarSize = 14;
constexpr float kButtonWidth = 70;
constexpr float kButtonStep = 90;

// How an item of a submenu is chosen, by the index in the menu of kinds.
constexpr int32 kRadioSelection = 1;
constexpr int32 kRadioAndLabel = 2;


int32
KindOf(const BMenu* menu)
{
	if (const_cast<BMenu*>(menu)->IsLabelFromMarked())
		return kRadioAndLabel;
	return const_cast<BMenu*>(menu)->IsRadioMode() ? kRadioSelection : 0;
}


} // namespace


ZetkaStringItem::ZetkaStringItem(const char* text, uint32 level, bool expanded, BMenuItem* item) :
	BStringItem(text, level, expanded), item(item)
{
}


ZetkaStringItem::~ZetkaStringItem()
{
}


// #pragma mark - EditMenuBar


EditMenuBar::EditMenuBar() :
	PanelOf("EditMenuBar", "Properties from BMenuBar", kPanelHeight), selectedEntry(nullptr)
{
	const BRect area = RowArea();
	borderMenu = MakeChoiceMenu(
		{ "B_BORDER_FRAME", "B_BORDER_CONTENTS", "B_BORDER_EACH_ITEM" }, kBorderChosen);
	AddMenuField(
		this, FrameAt(area.right - 140, area.top - 2, 140, 20), "", borderMenu, 0, B_FOLLOW_RIGHT);
	_AddItemList(area);
	_AddItemRows(area);
	SetSelectKind(nullptr);
	_EnableButtons(false);
}


EditMenuBar::~EditMenuBar()
{
	itemList->MakeEmpty();
}


bool
EditMenuBar::UseView(BView* view)
{
	if (!TakeTarget(view)) {
		itemList->DeselectAll();
		return false;
	}

	MarkChoice(borderMenu, _Target()->Border());
	SynchToTarget();
	return true;
}


bool
EditMenuBar::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kEntrySelected:
			_EntrySelected(message);
			break;
		case kBorderChosen:
			_Target()->SetBorder(static_cast<menu_bar_border>(Choice(borderMenu)));
			target->Invalidate();
			break;
		default:
			return _ApplyItemEdit(message->what) || _ApplyTreeEdit(message->what);
	}
	return true;
}


// #pragma mark - rows


void
EditMenuBar::_AddItemList(BRect area)
{
	AddSeparator(this, FrameAt(area.left + 24, area.top + kRowStep, area.Width() - 48, 1));

	const float top = area.top + kRowStep + 8;
	const BRect frame(
		area.left + 4, top + 4, area.right - 4 - kScrollBarSize, top + 4 + kListHeight);
	itemList = new BOutlineListView(frame, "", B_SINGLE_SELECTION_LIST, B_FOLLOW_ALL_SIDES,
		B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE);
	itemList->SetSelectionMessage(new BMessage(kEntrySelected));
	BScrollView* scrollView =
		new BScrollView("", itemList, B_FOLLOW_ALL_SIDES, 0, true, true, B_FANCY_BORDER);
	AddChild(scrollView);
	SetRange(scrollView, 1000, 123);
}


void
EditMenuBar::_AddItemRows(BRect area)
{
	const float left = area.left;
	float top = area.top + 166;
	labelControl = AddTextControl(this, BRect(left, top, area.right, top + 16),
		"Label: ", kLabelChanged, 40, B_FOLLOW_LEFT_RIGHT);

	top += kRowStep;
	enabledCheckBox = AddCheckBox(this, FrameAt(left, top, 70, 16), "Enabled", kEnabledChanged);
	messageControl =
		AddTextControl(this, FrameAt(left + 110, top, 80, 16), "Message: ", kMessageChanged, 50);
	selectKindMenu =
		MakeChoiceMenu({ "Normal Selection", "Radio Selection", "Radio & Set Label" }, kKindChosen);
	AddMenuField(this, FrameAt(left + 240, top, 146, 20), "", selectKindMenu, 0, B_FOLLOW_RIGHT);

	BRect frame = FrameAt(left, top + kRowStep, kButtonWidth, 24);
	addBeforeButton = AddButton(this, frame, "Add Before", kAddBeforePressed);
	frame.OffsetBy(kButtonStep, 0);
	addAfterButton = AddButton(this, frame, "Add After", kAddAfterPressed);
	frame.OffsetBy(kButtonStep, 0);
	deleteButton = AddButton(this, frame, "Delete", kDeletePressed);
	frame.OffsetBy(kButtonStep, 0);
	addSubmenuButton = AddButton(this, frame, "Add Submenu", kAddSubmenuPressed);
}


// The menu that holds the selected item, or NULL when nothing can be edited.
BMenu*
EditMenuBar::_SelectedMenu() const
{
	if (selectedEntry == nullptr || selectedEntry->item == nullptr)
		return nullptr;
	return selectedEntry->item->Menu();
}


ZetkaStringItem*
EditMenuBar::_NewEntry(const char* text, uint32 level, bool expanded, BMenuItem* item)
{
	fEntries.push_back(std::make_unique<ZetkaStringItem>(text, level, expanded, item));
	return fEntries.back().get();
}


// #pragma mark - the mirror


void
EditMenuBar::SynchToTarget()
{
	itemList->DeselectAll();
	selectedEntry = nullptr;
	SetSelectKind(nullptr);
	_EnableButtons(false);
	itemList->MakeEmpty();
	_ForgetRemoved();
	RecursiveAddItem(_Target(), 0);
}


void
EditMenuBar::RecursiveAddItem(const BMenu* menu, int level)
{
	if (menu == nullptr)
		return;

	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		itemList->AddItem(_NewEntry(item->Label(), static_cast<uint32>(level), level == 0, item));
		RecursiveAddItem(item->Submenu(), level + 1);
	}
}


void
EditMenuBar::SetSelectKind(BMenu* submenu)
{
	selectKindMenu->SetEnabled(submenu != nullptr);
	if (submenu != nullptr)
		MarkChoice(selectKindMenu, KindOf(submenu));
}


void
EditMenuBar::_EnableButtons(bool enabled)
{
	for (BButton* button : { addBeforeButton, addAfterButton, deleteButton, addSubmenuButton })
		button->SetEnabled(enabled);
}


void
EditMenuBar::_EntrySelected(const BMessage* message)
{
	// There is no index when nothing is selected any more.
	int32 index;
	if (message->FindInt32("index", &index) != B_OK)
		index = -1;
	selectedEntry = dynamic_cast<ZetkaStringItem*>(itemList->ItemAt(index));
	if (selectedEntry == nullptr)
		return;

	BMenuItem* item = selectedEntry->item;
	labelControl->SetText(item->Label());
	labelControl->TextView()->SelectAll();
	labelControl->MakeFocus(true);
	SetOn(enabledCheckBox, item->IsEnabled());
	ShowCode(messageControl, item->Message() != NULL ? item->Message()->what : kNoMessage);
	SetSelectKind(item->Submenu());
	_EnableButtons(true);
}


void
EditMenuBar::_ForgetRemoved()
{
	fEntries.clear();
	fRemovedItems.clear();
}


// #pragma mark - edits


bool
EditMenuBar::_ApplyItemEdit(uint32 code)
{
	if (code != kLabelChanged && code != kEnabledChanged && code != kMessageChanged)
		return false;
	if (selectedEntry == nullptr) {
		beep();
		return true;
	}

	BMenuItem* item = selectedEntry->item;
	switch (code) {
		case kLabelChanged:
			selectedEntry->SetText(labelControl->Text());
			itemList->InvalidateItem(itemList->IndexOf(selectedEntry));
			item->SetLabel(labelControl->Text());
			// A revived item takes its label from there.
			if (item->Submenu() != NULL)
				item->Submenu()->SetName(labelControl->Text());
			break;
		case kEnabledChanged:
			item->SetEnabled(IsOn(enabledCheckBox));
			break;
		case kMessageChanged:
			item->SetMessage(new BMessage(TakeCode(messageControl)));
			break;
	}
	return true;
}


bool
EditMenuBar::_ApplyTreeEdit(uint32 code)
{
	switch (code) {
		case kKindChosen:
			_ApplySelectKind();
			break;
		case kAddBeforePressed:
			_AddSibling(false);
			break;
		case kAddAfterPressed:
			_AddSibling(true);
			break;
		case kAddSubmenuPressed:
			_AddSubmenu();
			break;
		case kDeletePressed:
			_DeleteItem();
			break;
		default:
			return false;
	}
	return true;
}


void
EditMenuBar::_ApplySelectKind()
{
	BMenu* submenu = selectedEntry != nullptr ? selectedEntry->item->Submenu() : nullptr;
	if (submenu == nullptr)
		return;

	submenu->SetRadioMode(false);
	switch (Choice(selectKindMenu)) {
		case kRadioSelection:
			submenu->SetRadioMode(true);
			break;
		case kRadioAndLabel:
			submenu->SetLabelFromMarked(true);
			break;
	}
}


void
EditMenuBar::_AddSibling(bool after)
{
	BMenu* menu = _SelectedMenu();
	if (menu == nullptr)
		return;

	BMenuItem* item = new BMenuItem("new item", new BMessage(kNewItemMessage));
	menu->AddItem(item, menu->IndexOf(selectedEntry->item) + (after ? 1 : 0));

	// Behind the selected entry's whole subtree.
	const uint32 level = selectedEntry->OutlineLevel();
	int32 index = itemList->FullListIndexOf(selectedEntry);
	if (after) {
		do
			index++;
		while (index < itemList->FullListCountItems()
			&& itemList->FullListItemAt(index)->OutlineLevel() > level);
	}
	ZetkaStringItem* entry = _NewEntry(item->Label(), level, true, item);
	itemList->AddItem(entry, index);
	itemList->Select(itemList->IndexOf(itemList->FullListItemAt(index)));
}


// The submenu gets an item of its own. The selected entry stays with the item that was taken out:
// this follows from the way it is done and is wanted.
void
EditMenuBar::_AddSubmenu()
{
	BMenu* menu = _SelectedMenu();
	if (menu == nullptr)
		return;
	BMenuItem* item = selectedEntry->item;
	if (item->Submenu() != nullptr) {
		beep();
		return;
	}

	const int32 index = menu->IndexOf(item);
	BMenu* submenu = new BMenu(item->Label(), B_ITEMS_IN_COLUMN);
	BMenuItem* subItem = new BMenuItem("sub item", new BMessage(kSubItemMessage));
	submenu->AddItem(subItem);
	menu->RemoveItem(index);
	fRemovedItems.emplace_back(item);
	menu->AddItem(submenu, index);

	itemList->AddUnder(
		_NewEntry(subItem->Label(), selectedEntry->OutlineLevel() + 1, true, subItem),
		selectedEntry);
	itemList->Expand(selectedEntry);
	itemList->Select(itemList->IndexOf(selectedEntry) + 1);
}


void
EditMenuBar::_DeleteItem()
{
	BMenu* menu = _SelectedMenu();
	if (menu == nullptr)
		return;
	if (menu->CountItems() == 1) {
		beep(); // a menu is never emptied
		return;
	}

	BMenuItem* item = selectedEntry->item;
	menu->RemoveItem(menu->IndexOf(item));
	fRemovedItems.emplace_back(item);

	int32 next = itemList->IndexOf(selectedEntry);
	if (next >= itemList->CountItems() - 1)
		next--;
	itemList->RemoveItem(itemList->FullListIndexOf(selectedEntry));
	itemList->Select(next, false);
}
