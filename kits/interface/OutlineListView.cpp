#include "OutlineListView.h"

#include <algorithm>
#include <cmath>

#include <List.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/EventModifiers.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

BOutlineListView::BOutlineListView(
	BRect frame, const char* name, list_view_type type, uint32 resizingMode, uint32 flags) :
	BListView(frame, name, type, resizingMode, flags),
	fFullIndicesValid(true), fLatchItem(NULL), fLatchInside(false)
{
}


// Items of a plain list's field come first.
BOutlineListView::BOutlineListView(BMessage* archive) :
	BListView(archive), fFullIndicesValid(false), fLatchItem(NULL), fLatchInside(false)
{
	fFullItems = fItems;
	_ReadItems(archive, "_l_full_items", fFullItems);
	_RebuildVisible();
}


BOutlineListView::~BOutlineListView() = default;


BArchivable*
BOutlineListView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BOutlineListView") ? new BOutlineListView(archive)
															   : NULL;
}


// The list's own part is written here, with all items instead of the visible ones.
status_t
BOutlineListView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;
	return _ArchiveOwn(archive, deep, "_l_full_items", fFullItems);
}


// #pragma mark - items


bool
BOutlineListView::AddUnder(BListItem* item, BListItem* superitem)
{
	if (item == NULL)
		return false;
	const int32 superIndex = FullListIndexOf(superitem);
	if (superIndex < 0)
		return AddItem(item);
	item->fLevel = superitem->fLevel + 1;
	return AddItem(item, superIndex + 1);
}


bool
BOutlineListView::AddItem(BListItem* item)
{
	return AddItem(item, FullListCountItems());
}


bool
BOutlineListView::AddItem(BListItem* item, int32 fullListIndex)
{
	if (item == NULL || fullListIndex < 0 || fullListIndex > FullListCountItems())
		return false;
	fFullIndicesValid = fFullIndicesValid && fullListIndex == FullListCountItems();
	item->fFullIndex = fullListIndex;
	fFullItems.insert(fFullItems.begin() + fullListIndex, item);
	const int32 superIndex = _SuperitemIndex(fullListIndex);
	_SubitemsChanged(superIndex);
	_SubitemsChanged(fullListIndex);
	item->fVisible = _ShowsSubitems(superIndex);
	const int32 end = _SubtreeEnd(fullListIndex);
	if (end > fullListIndex + 1) {
		// What follows has come under the new item, and shows as that says.
		if (Window() != NULL)
			_UpdateItem(item);
		_RebuildVisible();
		for (int32 i = fullListIndex + 1; i < end; i++) {
			if (!fFullItems[i]->fVisible)
				fFullItems[i]->Deselect();
		}
	} else if (item->fVisible) {
		_Insert(_VisibleIndexFor(fullListIndex), &item, 1);
	}
	return true;
}


bool
BOutlineListView::AddList(BList* newItems)
{
	return AddList(newItems, FullListCountItems());
}


bool
BOutlineListView::AddList(BList* newItems, int32 fullListIndex)
{
	if (newItems == NULL || fullListIndex < 0 || fullListIndex > FullListCountItems())
		return false;
	for (int32 i = 0; i < newItems->CountItems(); i++) {
		if (!AddItem(static_cast<BListItem*>(newItems->ItemAt(i)), fullListIndex + i))
			return false;
	}
	return true;
}


bool
BOutlineListView::RemoveItem(BListItem* item)
{
	return RemoveItem(FullListIndexOf(item)) != NULL;
}


BListItem*
BOutlineListView::RemoveItem(int32 fullListIndex)
{
	BListItem* item = FullListItemAt(fullListIndex);
	if (item == NULL)
		return NULL;
	const int32 end = _SubtreeEnd(fullListIndex);
	const int32 superIndex = _SuperitemIndex(fullListIndex);
	_RemoveFull(fullListIndex, end);
	_SubitemsChanged(superIndex);
	return item;
}


bool
BOutlineListView::RemoveItems(int32 fullListIndex, int32 count)
{
	if (fullListIndex < 0 || fullListIndex >= FullListCountItems() || count < 0)
		return false;
	int32 end = std::min(fullListIndex + count, FullListCountItems());
	if (end > fullListIndex)
		end = std::max(end, _SubtreeEnd(end - 1));
	const int32 superIndex = _SuperitemIndex(fullListIndex);
	_RemoveFull(fullListIndex, end);
	_SubitemsChanged(superIndex);
	return true;
}


void
BOutlineListView::_RemoveFull(int32 from, int32 to)
{
	int32 firstVisible = -1;
	int32 visible = 0;
	for (int32 i = from; i < to; i++) {
		BListItem* item = fFullItems[i];
		if (item->fVisible) {
			if (firstVisible < 0)
				firstVisible = IndexOf(item);
			visible++;
		}
		_Leave(item);
		if (item == fLatchItem)
			fLatchItem = NULL;
	}
	fFullItems.erase(fFullItems.begin() + from, fFullItems.begin() + to);
	fFullIndicesValid = false;
	if (visible > 0)
		_Take(firstVisible, visible);
}


void
BOutlineListView::MakeEmpty()
{
	for (BListItem* item : fFullItems)
		_Leave(item);
	fFullItems.clear();
	fLatchItem = NULL;
	BListView::MakeEmpty();
}


BListItem*
BOutlineListView::FullListItemAt(int32 fullListIndex) const
{
	return fullListIndex >= 0 && fullListIndex < FullListCountItems() ? fFullItems[fullListIndex]
																	  : NULL;
}


int32
BOutlineListView::FullListIndexOf(BPoint point) const
{
	return FullListIndexOf(ItemAt(IndexOf(point)));
}


int32
BOutlineListView::FullListIndexOf(BListItem* item) const
{
	if (item == NULL)
		return -1;
	if (FullListItemAt(item->fFullIndex) == item)
		return item->fFullIndex;
	if (!fFullIndicesValid) {
		for (int32 i = 0; i < FullListCountItems(); i++)
			fFullItems[i]->fFullIndex = i;
		fFullIndicesValid = true;
	}
	return FullListItemAt(item->fFullIndex) == item ? item->fFullIndex : -1;
}


BListItem*
BOutlineListView::FullListFirstItem() const
{
	return FullListItemAt(0);
}


BListItem*
BOutlineListView::FullListLastItem() const
{
	return FullListItemAt(FullListCountItems() - 1);
}


bool
BOutlineListView::FullListHasItem(BListItem* item) const
{
	return FullListIndexOf(item) >= 0;
}


int32
BOutlineListView::FullListCountItems() const
{
	return static_cast<int32>(fFullItems.size());
}


int32
BOutlineListView::FullListCurrentSelection(int32 index) const
{
	return FullListIndexOf(ItemAt(CurrentSelection(index)));
}


bool
BOutlineListView::FullListIsEmpty() const
{
	return fFullItems.empty();
}


// Both stop at the first true.
void
BOutlineListView::FullListDoForEach(bool (*func)(BListItem* item))
{
	for (size_t i = 0; i < fFullItems.size(); i++) {
		if (func(fFullItems[i]))
			break;
	}
}


void
BOutlineListView::FullListDoForEach(bool (*func)(BListItem* item, void* arg), void* arg)
{
	for (size_t i = 0; i < fFullItems.size(); i++) {
		if (func(fFullItems[i], arg))
			break;
	}
}
