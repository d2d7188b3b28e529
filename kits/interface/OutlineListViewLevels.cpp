// BOutlineListView: what lies under what.
#include "OutlineListView.h"

#include <algorithm>

#include <Window.h>


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
