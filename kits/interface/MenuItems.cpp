// BMenu: its items and its settings.
#include "Menu.h"

#include <algorithm>
#include <cstring>

#include <List.h>
#include <Messenger.h>

#include "interface/private/MenuTracker.h"

using namespace BPrivate;


bool
BMenu::AddItem(BMenuItem* item)
{
	return AddItem(item, CountItems());
}


bool
BMenu::AddItem(BMenuItem* item, int32 index)
{
	return _Insert(item, index);
}


bool
BMenu::AddItem(BMenuItem* item, BRect frame)
{
	if (!_Insert(item, CountItems()))
		return false;
	item->fBounds = frame;
	InvalidateLayout();
	return true;
}


bool
BMenu::AddItem(BMenu* submenu)
{
	return AddItem(submenu, CountItems());
}


bool
BMenu::AddItem(BMenu* submenu, int32 index)
{
	if (submenu == NULL || submenu->fSuperitem != NULL)
		return false;
	BMenuItem* item = new BMenuItem(submenu);
	if (AddItem(item, index))
		return true;
	item->fSubmenu = NULL;
	submenu->fSuperitem = NULL;
	delete item;
	return false;
}


bool
BMenu::AddItem(BMenu* submenu, BRect frame)
{
	if (!AddItem(submenu))
		return false;
	fItems.back()->fBounds = frame;
	InvalidateLayout();
	return true;
}


bool
BMenu::AddList(BList* list, int32 index)
{
	if (list == NULL)
		return false;
	for (int32 i = 0; i < list->CountItems(); i++) {
		if (!AddItem(static_cast<BMenuItem*>(list->ItemAt(i)), index + i))
			return false;
	}
	return true;
}


bool
BMenu::AddSeparatorItem()
{
	BMenuItem* item = new BSeparatorItem();
	if (AddItem(item))
		return true;
	delete item;
	return false;
}


bool
BMenu::RemoveItem(BMenuItem* item)
{
	return RemoveItem(IndexOf(item)) != NULL;
}


BMenuItem*
BMenu::RemoveItem(int32 index)
{
	BMenuItem* item = _Take(index);
	if (item != NULL)
		InvalidateLayout();
	return item;
}


bool
BMenu::RemoveItems(int32 index, int32 count, bool deleteItems)
{
	if (index < 0 || index >= CountItems() || count < 0)
		return false;
	count = std::min(count, CountItems() - index);
	for (int32 i = index + count - 1; i >= index; i--) {
		BMenuItem* item = _Take(i);
		if (deleteItems)
			delete item;
	}
	InvalidateLayout();
	return true;
}


bool
BMenu::RemoveItem(BMenu* submenu)
{
	const int32 index = IndexOf(submenu);
	return index >= 0 && RemoveItem(index) != NULL;
}


BMenuItem*
BMenu::ItemAt(int32 index) const
{
	return index >= 0 && index < CountItems() ? fItems[index] : NULL;
}


BMenu*
BMenu::SubmenuAt(int32 index) const
{
	BMenuItem* item = ItemAt(index);
	return item != NULL ? item->Submenu() : NULL;
}


int32
BMenu::CountItems() const
{
	return static_cast<int32>(fItems.size());
}


int32
BMenu::IndexOf(BMenuItem* item) const
{
	if (item == NULL || item->fSuper != this)
		return -1;
	if (ItemAt(item->fIndex) != item) {
		for (int32 i = 0; i < CountItems(); i++)
			fItems[i]->fIndex = i;
	}
	return item->fIndex;
}


int32
BMenu::IndexOf(BMenu* submenu) const
{
	if (submenu == NULL || submenu->fSuperitem == NULL)
		return -1;
	return IndexOf(submenu->fSuperitem);
}


BMenuItem*
BMenu::FindItem(uint32 command) const
{
	for (BMenuItem* item : fItems) {
		if (item->Message() != NULL && item->Command() == command)
			return item;
		if (item->fSubmenu != NULL) {
			if (BMenuItem* found = item->fSubmenu->FindItem(command))
				return found;
		}
	}
	return NULL;
}


BMenuItem*
BMenu::FindItem(const char* name) const
{
	if (name == NULL)
		return NULL;
	for (BMenuItem* item : fItems) {
		if (item->fLabel != NULL && strcmp(item->fLabel, name) == 0)
			return item;
		if (item->fSubmenu != NULL) {
			if (BMenuItem* found = item->fSubmenu->FindItem(name))
				return found;
		}
	}
	return NULL;
}


bool
BMenu::_Insert(BMenuItem* item, int32 index)
{
	if (item == NULL || item->fSuper != NULL || index < 0 || index > CountItems())
		return false;
	fItems.insert(fItems.begin() + index, item);
	item->fSuper = this;
	item->fIndex = index;
	item->fLabelWidth = -1;
	if (fInstalledWindow != NULL)
		item->_Install(fInstalledWindow);
	if (item->fMarked)
		_ItemMarked(item);
	InvalidateLayout();
	return true;
}


BMenuItem*
BMenu::_Take(int32 index)
{
	BMenuItem* item = ItemAt(index);
	if (item == NULL)
		return NULL;
	if (fSelected == item)
		fSelected = NULL;
	item->fSelected = false;
	item->_Uninstall();
	fItems.erase(fItems.begin() + index);
	item->fSuper = NULL;
	return item;
}


// #pragma mark - settings


status_t
BMenu::SetTargetForItems(BHandler* target)
{
	status_t result = B_OK;
	for (BMenuItem* item : fItems) {
		const status_t status = item->SetTarget(target);
		if (status != B_OK && result == B_OK)
			result = status;
	}
	return result;
}


status_t
BMenu::SetTargetForItems(BMessenger messenger)
{
	status_t result = B_OK;
	for (BMenuItem* item : fItems) {
		const status_t status = item->SetTarget(messenger);
		if (status != B_OK && result == B_OK)
			result = status;
	}
	return result;
}


void
BMenu::SetEnabled(bool enabled)
{
	if (fEnabled == enabled)
		return;
	fEnabled = enabled;
	if (fSuperitem != NULL)
		fSuperitem->SetEnabled(enabled);
	_ItemChanged(NULL, false);
}


void
BMenu::SetRadioMode(bool on)
{
	fRadioMode = on;
	if (!on)
		SetLabelFromMarked(false);
}


void
BMenu::SetTriggersEnabled(bool on)
{
	fTriggersEnabled = on;
	_ItemChanged(NULL, false);
}


void
BMenu::SetMaxContentWidth(float width)
{
	fMaxContentWidth = width;
	InvalidateLayout();
}


void
BMenu::SetLabelFromMarked(bool on)
{
	fLabelFromMarked = on;
	if (on)
		SetRadioMode(true);
}


bool
BMenu::IsLabelFromMarked()
{
	return fLabelFromMarked;
}


bool
BMenu::IsEnabled() const
{
	if (!fEnabled)
		return false;
	const BMenu* super = Supermenu();
	return super == NULL || super->IsEnabled();
}


bool
BMenu::IsRadioMode() const
{
	return fRadioMode;
}


bool
BMenu::AreTriggersEnabled() const
{
	return fTriggersEnabled;
}


bool
BMenu::IsRedrawAfterSticky() const
{
	return false;
}


float
BMenu::MaxContentWidth() const
{
	return fMaxContentWidth;
}


BMenuItem*
BMenu::FindMarked()
{
	return ItemAt(FindMarkedIndex());
}


int32
BMenu::FindMarkedIndex()
{
	for (int32 i = 0; i < CountItems(); i++) {
		if (fItems[i]->fMarked)
			return i;
	}
	return -1;
}


BMenu*
BMenu::Supermenu() const
{
	return fSuperitem != NULL ? fSuperitem->fSuper : NULL;
}


BMenuItem*
BMenu::Superitem() const
{
	return fSuperitem;
}
