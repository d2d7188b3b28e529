#include "OutlineListView.h"

#include <algorithm>
#include <cmath>

#include <List.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr float kLatchWidth = 13; // pixels

} // namespace


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


// #pragma mark - outline


BListItem*
BOutlineListView::Superitem(const BListItem* item)
{
	const int32 index = FullListIndexOf(const_cast<BListItem*>(item));
	return index >= 0 ? FullListItemAt(_SuperitemIndex(index)) : NULL;
}


void
BOutlineListView::Expand(BListItem* item)
{
	ExpandOrCollapse(item, true);
}


void
BOutlineListView::Collapse(BListItem* item)
{
	ExpandOrCollapse(item, false);
}


bool
BOutlineListView::IsExpanded(int32 fullListIndex)
{
	const BListItem* item = FullListItemAt(fullListIndex);
	return item != NULL && item->fExpanded;
}


// Subitems that disappear are no longer selected.
void
BOutlineListView::ExpandOrCollapse(BListItem* superitem, bool expand)
{
	const int32 index = FullListIndexOf(superitem);
	if (index < 0 || superitem->fExpanded == expand)
		return;
	superitem->fExpanded = expand;
	if (!superitem->fVisible)
		return;
	const int32 end = _SubtreeEnd(index);
	const int32 visibleIndex = IndexOf(superitem);
	if (expand) {
		std::vector<BListItem*> shown;
		_CollectVisible(index + 1, end, shown);
		_Insert(visibleIndex + 1, shown.data(), static_cast<int32>(shown.size()));
	} else {
		int32 count = 0;
		for (int32 i = index + 1; i < end; i++) {
			if (fFullItems[i]->fVisible)
				count++;
			fFullItems[i]->fVisible = false;
		}
		_TakeHidden(visibleIndex + 1, count);
	}
	InvalidateItem(visibleIndex);
}


// They leave the visible list, not the outline.
void
BOutlineListView::_TakeHidden(int32 index, int32 count)
{
	if (count == 0)
		return;
	const std::vector<BListItem*> hidden(fItems.begin() + index, fItems.begin() + index + count);
	_Take(index, count);
	for (BListItem* item : hidden)
		item->Deselect();
}


int32
BOutlineListView::CountItemsUnder(BListItem* superitem, bool oneLevelOnly) const
{
	int32 from, to;
	if (!_RangeUnder(superitem, &from, &to))
		return 0;
	if (!oneLevelOnly)
		return to - from;
	int32 count = 0;
	for (int32 i = from; i < to; i = _SubtreeEnd(i))
		count++;
	return count;
}


BListItem*
BOutlineListView::EachItemUnder(BListItem* superitem, bool oneLevelOnly,
	BListItem* (*eachFunc)(BListItem* item, void* arg), void* arg)
{
	int32 from, to;
	if (!_RangeUnder(superitem, &from, &to))
		return NULL;
	for (int32 i = from; i < std::min(to, FullListCountItems());
		 i = oneLevelOnly ? _SubtreeEnd(i) : i + 1) {
		if (BListItem* found = eachFunc(fFullItems[i], arg))
			return found;
	}
	return NULL;
}


BListItem*
BOutlineListView::ItemUnderAt(BListItem* superitem, bool oneLevelOnly, int32 index) const
{
	int32 from, to;
	if (index < 0 || !_RangeUnder(superitem, &from, &to))
		return NULL;
	for (int32 i = from; i < to; i = oneLevelOnly ? _SubtreeEnd(i) : i + 1) {
		if (index-- == 0)
			return fFullItems[i];
	}
	return NULL;
}


void
BOutlineListView::FullListSortItems(int (*compare)(const BListItem*, const BListItem*))
{
	SortItemsUnder(NULL, false, compare);
}


void
BOutlineListView::SortItemsUnder(
	BListItem* superitem, bool oneLevelOnly, int (*compare)(const BListItem*, const BListItem*))
{
	int32 from, to;
	if (!_RangeUnder(superitem, &from, &to))
		return;
	_SortBlock(from, to, oneLevelOnly, compare);
	fFullIndicesValid = false;
	_RebuildVisible();
}


// Each item moves together with what is under it.
void
BOutlineListView::_SortBlock(
	int32 from, int32 to, bool oneLevelOnly, int (*compare)(const BListItem*, const BListItem*))
{
	struct Block {
		std::vector<BListItem*> items;
	};
	std::vector<Block> blocks;
	for (int32 i = from; i < to;) {
		const int32 end = std::min(_SubtreeEnd(i), to);
		if (!oneLevelOnly && end > i + 1)
			_SortBlock(i + 1, end, false, compare);
		blocks.push_back({ { fFullItems.begin() + i, fFullItems.begin() + end } });
		i = end;
	}
	std::stable_sort(blocks.begin(), blocks.end(), [compare](const Block& a, const Block& b) {
		return compare(a.items.front(), b.items.front()) < 0;
	});
	auto place = fFullItems.begin() + from;
	for (const Block& block : blocks)
		place = std::copy(block.items.begin(), block.items.end(), place);
}


// The items under a superitem, or all of them for NULL.
bool
BOutlineListView::_RangeUnder(BListItem* superitem, int32* _from, int32* _to) const
{
	if (superitem == NULL) {
		*_from = 0;
		*_to = FullListCountItems();
		return true;
	}
	const int32 index = FullListIndexOf(superitem);
	if (index < 0)
		return false;
	*_from = index + 1;
	*_to = _SubtreeEnd(index);
	return true;
}


int32
BOutlineListView::_SubtreeEnd(int32 fullIndex) const
{
	const uint32 level = fFullItems[fullIndex]->fLevel;
	int32 end = fullIndex + 1;
	while (end < FullListCountItems() && fFullItems[end]->fLevel > level)
		end++;
	return end;
}


// The nearest earlier item of a lower level; -1 at the top.
int32
BOutlineListView::_SuperitemIndex(int32 fullIndex) const
{
	const uint32 level = fFullItems[fullIndex]->fLevel;
	for (int32 i = fullIndex - 1; i >= 0 && level > 0; i--) {
		if (fFullItems[i]->fLevel < level)
			return i;
	}
	return -1;
}


bool
BOutlineListView::_ShowsSubitems(int32 superIndex) const
{
	if (superIndex < 0)
		return true;
	return fFullItems[superIndex]->fVisible && fFullItems[superIndex]->fExpanded;
}


int32
BOutlineListView::_VisibleIndexFor(int32 fullIndex) const
{
	for (int32 i = fullIndex - 1; i >= 0; i--) {
		if (fFullItems[i]->fVisible)
			return IndexOf(fFullItems[i]) + 1;
	}
	return 0;
}


// All of the range that is under expanded items only.
void
BOutlineListView::_CollectVisible(int32 from, int32 to, std::vector<BListItem*>& visible)
{
	for (int32 i = from; i < to;) {
		BListItem* item = fFullItems[i];
		if (!item->fVisible && Window() != NULL)
			_UpdateItem(item);
		item->fVisible = true;
		visible.push_back(item);
		if (item->fExpanded) {
			i++;
			continue;
		}
		const int32 end = _SubtreeEnd(i);
		for (i++; i < end; i++)
			fFullItems[i]->fVisible = false;
	}
}


void
BOutlineListView::_SubitemsChanged(int32 superIndex)
{
	BListItem* item = FullListItemAt(superIndex);
	if (item == NULL)
		return;
	const bool has = _SubtreeEnd(superIndex) > superIndex + 1;
	if (item->fHasSubitems == has)
		return;
	item->fHasSubitems = has;
	if (item->fVisible)
		InvalidateItem(IndexOf(item));
}


void
BOutlineListView::_RebuildVisible()
{
	const float oldBottom = Window() != NULL ? _Bottom() : 0;
	fItems.clear();
	_CollectVisible(0, FullListCountItems(), fItems);
	for (int32 i = 0; i < FullListCountItems(); i++)
		fFullItems[i]->fHasSubitems =
			i + 1 < FullListCountItems() && fFullItems[i + 1]->fLevel > fFullItems[i]->fLevel;
	fPlaced = 0;
	_RescanSelection();
	_PlacesChanged(0, oldBottom);
}


bool
BOutlineListView::DoMiscellaneous(MiscCode code, MiscData* data)
{
	switch (code) {
		case B_SWAP_OP:
			return _SwapBlocks(
				FullListIndexOf(ItemAt(data->swap.a)), FullListIndexOf(ItemAt(data->swap.b)));

		case B_REPLACE_OP: {
			BListItem* old = ItemAt(data->replace.index);
			const int32 index = FullListIndexOf(old);
			if (index < 0 || data->replace.item == NULL)
				return false;
			BListItem* item = data->replace.item;
			item->fLevel = old->fLevel;
			item->fExpanded = old->fExpanded;
			item->fHasSubitems = old->fHasSubitems;
			item->fVisible = true;
			item->fFullIndex = index;
			fFullItems[index] = item;
			return BListView::DoMiscellaneous(code, data);
		}

		case B_MOVE_OP: {
			BListItem* item = ItemAt(data->move.from);
			BListItem* target = ItemAt(data->move.to);
			int32 from = FullListIndexOf(item);
			int32 to = FullListIndexOf(target);
			if (from < 0 || to < 0 || item->fLevel != target->fLevel
				|| _SuperitemIndex(from) != _SuperitemIndex(to))
				return false;
			const int32 end = _SubtreeEnd(from);
			if (to > from)
				std::rotate(fFullItems.begin() + from, fFullItems.begin() + end,
					fFullItems.begin() + _SubtreeEnd(to));
			else
				std::rotate(
					fFullItems.begin() + to, fFullItems.begin() + from, fFullItems.begin() + end);
			fFullIndicesValid = false;
			_RebuildVisible();
			return true;
		}

		default:
			return false;
	}
}


// With what is under them; only among the subitems of one superitem.
bool
BOutlineListView::_SwapBlocks(int32 a, int32 b)
{
	if (a < 0 || b < 0)
		return false;
	if (a == b)
		return true;
	if (a > b)
		std::swap(a, b);
	if (fFullItems[a]->fLevel != fFullItems[b]->fLevel || _SuperitemIndex(a) != _SuperitemIndex(b))
		return false;
	const int32 endA = _SubtreeEnd(a);
	const int32 endB = _SubtreeEnd(b);
	std::vector<BListItem*> items(fFullItems.begin() + b, fFullItems.begin() + endB);
	items.insert(items.end(), fFullItems.begin() + endA, fFullItems.begin() + b);
	items.insert(items.end(), fFullItems.begin() + a, fFullItems.begin() + endA);
	std::copy(items.begin(), items.end(), fFullItems.begin() + a);
	fFullIndicesValid = false;
	_RebuildVisible();
	return true;
}


// #pragma mark - drawing and input


float
BOutlineListView::_Indent(int32 level) const
{
	BFont font;
	GetFont(&font);
	return level * std::ceil(font.Size() * 0.85f);
}


BRect
BOutlineListView::LatchRect(BRect itemRect, int32 level) const
{
	const float left = itemRect.left + _Indent(level);
	return BRect(left, itemRect.top, left + kLatchWidth - 1, itemRect.bottom);
}


void
BOutlineListView::DrawLatch(BRect itemRect, int32 level, bool collapsed, bool highlighted, bool)
{
	Look::DrawLatch(this, LatchRect(itemRect, level), !collapsed, highlighted);
}


void
BOutlineListView::DrawItem(BListItem* item, BRect itemFrame, bool complete)
{
	if (item->fHasSubitems) {
		DrawLatch(itemFrame, static_cast<int32>(item->fLevel), !item->fExpanded,
			item == fLatchItem && fLatchInside, item == fLatchItem && !fLatchInside);
	}
	itemFrame.left += _Indent(static_cast<int32>(item->fLevel)) + kLatchWidth;
	BListView::DrawItem(item, itemFrame, complete);
}


bool
BOutlineListView::_HitsLatch(BPoint where, int32 index) const
{
	const BListItem* item = ItemAt(index);
	if (item == NULL || !item->fHasSubitems)
		return false;
	const BRect frame = const_cast<BOutlineListView*>(this)->ItemFrame(index);
	return LatchRect(frame, static_cast<int32>(item->fLevel)).Contains(where);
}


void
BOutlineListView::MouseDown(BPoint where)
{
	const int32 index = IndexOf(where);
	if (!_HitsLatch(where, index)) {
		BListView::MouseDown(where);
		return;
	}
	if (!IsFocus())
		MakeFocus(true);
	fLatchItem = ItemAt(index);
	fLatchInside = true;
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS);
	InvalidateItem(index);
}


void
BOutlineListView::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	if (fLatchItem == NULL) {
		BListView::MouseMoved(where, code, message);
		return;
	}
	const int32 index = IndexOf(fLatchItem);
	const bool inside = _HitsLatch(where, index);
	if (inside != fLatchInside) {
		fLatchInside = inside;
		InvalidateItem(index);
	}
}


void
BOutlineListView::MouseUp(BPoint where)
{
	if (fLatchItem == NULL) {
		BListView::MouseUp(where);
		return;
	}
	BListItem* item = fLatchItem;
	fLatchItem = NULL;
	const int32 index = IndexOf(item);
	InvalidateItem(index);
	if (_HitsLatch(where, index))
		ExpandOrCollapse(item, !item->fExpanded);
}


// Left closes an item, or goes to the one above it; right opens it.
void
BOutlineListView::KeyDown(const char* bytes, int32 numBytes)
{
	const char key = numBytes == 1 ? bytes[0] : '\0';
	const bool asOutline = (_CurrentModifiers() & (B_CONTROL_KEY | B_COMMAND_KEY)) != 0;
	const bool closes = key == B_LEFT_ARROW || (asOutline && key == B_UP_ARROW);
	const bool opens = key == B_RIGHT_ARROW || (asOutline && key == B_DOWN_ARROW);
	BListItem* item = ItemAt(CurrentSelection());
	if (item == NULL || (!closes && !opens)) {
		BListView::KeyDown(bytes, numBytes);
		return;
	}
	if (opens) {
		Expand(item);
	} else if (item->fHasSubitems && item->fExpanded) {
		Collapse(item);
	} else if (BListItem* superitem = Superitem(item)) {
		Select(IndexOf(superitem));
		ScrollToSelection();
	}
}


void
BOutlineListView::FrameMoved(BPoint newPosition)
{
	BListView::FrameMoved(newPosition);
}


void
BOutlineListView::FrameResized(float width, float height)
{
	BListView::FrameResized(width, height);
}


BHandler*
BOutlineListView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BListView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BOutlineListView::GetSupportedSuites(BMessage* data)
{
	return BListView::GetSupportedSuites(data);
}


status_t
BOutlineListView::Perform(perform_code code, void* data)
{
	return BListView::Perform(code, data);
}


void
BOutlineListView::ResizeToPreferred()
{
	BListView::ResizeToPreferred();
}


void
BOutlineListView::GetPreferredSize(float* _width, float* _height)
{
	BListView::GetPreferredSize(_width, _height);
	if (_width == NULL || IsEmpty())
		return;
	for (const BListItem* item : fItems) {
		const float left = _Indent(static_cast<int32>(item->fLevel)) + kLatchWidth;
		*_width = std::max(*_width, left + std::ceil(item->fWidth));
	}
}


void
BOutlineListView::MakeFocus(bool focus)
{
	BListView::MakeFocus(focus);
}


void
BOutlineListView::AllAttached()
{
	BListView::AllAttached();
}


void
BOutlineListView::AllDetached()
{
	BListView::AllDetached();
}


void
BOutlineListView::DetachedFromWindow()
{
	fLatchItem = NULL;
	BListView::DetachedFromWindow();
}
