// BListView: its items and where they lie.
#include "ListView.h"

#include <algorithm>
#include <cmath>

#include <List.h>
#include <ScrollBar.h>
#include <Window.h>

#include "interface/private/ListViewPrivate.h"


bool
BListView::AddItem(BListItem* item)
{
	return _Insert(CountItems(), &item, 1);
}


bool
BListView::AddItem(BListItem* item, int32 atIndex)
{
	return _Insert(atIndex, &item, 1);
}


bool
BListView::AddList(BList* newItems)
{
	return AddList(newItems, CountItems());
}


bool
BListView::AddList(BList* newItems, int32 atIndex)
{
	if (newItems == NULL)
		return false;
	return _Insert(
		atIndex, static_cast<BListItem* const*>(newItems->Items()), newItems->CountItems());
}


bool
BListView::RemoveItem(BListItem* item)
{
	return BListView::RemoveItem(IndexOf(item)) != NULL;
}


BListItem*
BListView::RemoveItem(int32 index)
{
	BListItem* item = ItemAt(index);
	if (item == NULL)
		return NULL;
	_Leave(item);
	_Take(index, 1);
	return item;
}


bool
BListView::RemoveItems(int32 index, int32 count)
{
	if (index < 0 || index >= CountItems() || count < 0)
		return false;
	count = std::min(count, CountItems() - index);
	std::for_each_n(fItems.begin() + index, count, [this](BListItem* item) { _Leave(item); });
	_Take(index, count);
	return true;
}


void
BListView::MakeEmpty()
{
	if (!IsEmpty())
		BListView::RemoveItems(0, CountItems());
}


bool
BListView::_Insert(int32 index, BListItem* const* items, int32 count)
{
	if (index < 0 || index > CountItems() || count < 0
		|| std::find(items, items + count, nullptr) != items + count)
		return false;
	if (count == 0)
		return true;
	const float oldBottom = Window() != NULL ? _Bottom() : 0;
	fItems.insert(fItems.begin() + index, items, items + count);
	const auto shift = [index, count](int32& position) {
		if (position >= index)
			position += count;
	};
	shift(fFirstSelected);
	shift(fLastSelected);
	shift(fAnchor);
	shift(fFocusItem);
	bool selected = false;
	for (int32 i = index; i < index + count; i++) {
		selected = selected || fItems[i]->fSelected;
		if (Window() != NULL)
			_UpdateItem(fItems[i]);
	}
	_PlacesChanged(index, oldBottom);
	if (selected)
		_RescanSelection();
	return true;
}


// The items stay as they are; that fewer are selected is told.
void
BListView::_Take(int32 index, int32 count)
{
	const float oldBottom = Window() != NULL ? _Bottom() : 0;
	bool selected = false;
	for (int32 i = index; i < index + count; i++) {
		selected = selected || fItems[i]->fSelected;
	}
	fItems.erase(fItems.begin() + index, fItems.begin() + index + count);
	const auto shift = [index, count](int32& position) {
		if (position >= index + count)
			position -= count;
		else if (position >= index)
			position = -1;
	};
	shift(fAnchor);
	shift(fFocusItem);
	if (fTracking != nullptr)
		fTracking.reset();
	_RescanSelection();
	_PlacesChanged(index, oldBottom);
	_SelectionDone(selected);
}


void
BListView::_Leave(BListItem* item)
{
	if (item->fReviver != this)
		return;
	item->fReviver = NULL;
	fRevived.erase(item);
}


BListItem*
BListView::ItemAt(int32 index) const
{
	return index >= 0 && index < CountItems() ? fItems[index] : NULL;
}


int32
BListView::IndexOf(BListItem* item) const
{
	if (item == NULL)
		return -1;
	if (ItemAt(item->fIndex) == item)
		return item->fIndex;
	_EnsurePlaces();
	return ItemAt(item->fIndex) == item ? item->fIndex : -1;
}


int32
BListView::IndexOf(BPoint point) const
{
	const int32 index = _IndexAt(point.y);
	return index >= 0 && point.y < fItems[index]->fTop + std::ceil(fItems[index]->fHeight) ? index
																						   : -1;
}


BListItem*
BListView::FirstItem() const
{
	return ItemAt(0);
}


BListItem*
BListView::LastItem() const
{
	return ItemAt(CountItems() - 1);
}


bool
BListView::HasItem(BListItem* item) const
{
	return IndexOf(item) >= 0;
}


int32
BListView::CountItems() const
{
	return static_cast<int32>(fItems.size());
}


bool
BListView::IsEmpty() const
{
	return fItems.empty();
}


// Both stop at the first true.
void
BListView::DoForEach(bool (*func)(BListItem* item))
{
	for (size_t i = 0; i < fItems.size(); i++) {
		if (func(fItems[i]))
			break;
	}
}


void
BListView::DoForEach(bool (*func)(BListItem* item, void* arg), void* arg)
{
	for (size_t i = 0; i < fItems.size(); i++) {
		if (func(fItems[i], arg))
			break;
	}
}


const BListItem**
BListView::Items() const
{
	return const_cast<const BListItem**>(fItems.data());
}


void
BListView::SortItems(int (*compare)(const void*, const void*))
{
	std::stable_sort(fItems.begin(), fItems.end(),
		[compare](const BListItem* a, const BListItem* b) { return compare(&a, &b) < 0; });
	_RescanSelection();
	_PlacesChanged(0, _Bottom());
}


bool
BListView::SwapItems(int32 a, int32 b)
{
	MiscData data;
	data.swap.a = a;
	data.swap.b = b;
	return DoMiscellaneous(B_SWAP_OP, &data);
}


bool
BListView::MoveItem(int32 from, int32 to)
{
	MiscData data;
	data.move.from = from;
	data.move.to = to;
	return DoMiscellaneous(B_MOVE_OP, &data);
}


bool
BListView::ReplaceItem(int32 index, BListItem* item)
{
	MiscData data;
	data.replace.index = index;
	data.replace.item = item;
	return DoMiscellaneous(B_REPLACE_OP, &data);
}


bool
BListView::DoMiscellaneous(MiscCode code, MiscData* data)
{
	const auto valid = [this](int32 index) { return index >= 0 && index < CountItems(); };
	const float oldBottom = _Bottom();
	switch (code) {
		case B_SWAP_OP:
			if (!valid(data->swap.a) || !valid(data->swap.b))
				return false;
			std::swap(fItems[data->swap.a], fItems[data->swap.b]);
			break;

		case B_MOVE_OP: {
			if (!valid(data->move.from) || !valid(data->move.to))
				return false;
			BListItem* item = fItems[data->move.from];
			fItems.erase(fItems.begin() + data->move.from);
			fItems.insert(fItems.begin() + data->move.to, item);
			break;
		}

		case B_REPLACE_OP:
			if (!valid(data->replace.index) || data->replace.item == NULL)
				return false;
			_Leave(fItems[data->replace.index]);
			fItems[data->replace.index] = data->replace.item;
			if (Window() != NULL)
				_UpdateItem(data->replace.item);
			break;

		default:
			return false;
	}
	_RescanSelection();
	_PlacesChanged(0, oldBottom);
	return true;
}


// #pragma mark - places


void
BListView::_UpdateItem(BListItem* item)
{
	BFont font;
	GetFont(&font);
	item->Update(this, &font);
}


void
BListView::_UpdateItems()
{
	BFont font;
	GetFont(&font);
	for (BListItem* item : fItems)
		item->Update(this, &font);
	fPlaced = 0;
}


void
BListView::_EnsurePlaces() const
{
	const int32 count = CountItems();
	float top = 0;
	if (fPlaced > 0)
		top = fItems[fPlaced - 1]->fTop + std::ceil(fItems[fPlaced - 1]->fHeight);
	for (; fPlaced < count; fPlaced++) {
		BListItem* item = fItems[fPlaced];
		item->fTop = top;
		item->fIndex = fPlaced;
		top += std::ceil(item->fHeight);
	}
}


void
BListView::_PlacesChanged(int32 fromIndex, float oldBottom)
{
	fPlaced = std::min(fPlaced, fromIndex);
	if (Window() == NULL)
		return;
	const BRect bounds = Bounds();
	const float top = fromIndex < CountItems() ? ItemFrame(fromIndex).top : _Bottom();
	BRect dirty(bounds.left, std::max(bounds.top, top), bounds.right,
		std::min(bounds.bottom, std::max(oldBottom, _Bottom()) + 1));
	if (dirty.IsValid())
		Invalidate(dirty);
	_UpdateScrollBars();
}


// The last row of pixels; -1 when empty.
float
BListView::_Bottom() const
{
	_EnsurePlaces();
	return fItems.empty() ? -1 : fItems.back()->fTop + std::ceil(fItems.back()->fHeight) - 1;
}


float
BListView::_WidestItem() const
{
	float widest = 0;
	for (const BListItem* item : fItems)
		widest = std::max(widest, item->fWidth);
	return std::ceil(widest);
}


// The item at that height, or the last one above; -1 above the first.
int32
BListView::_IndexAt(float y) const
{
	_EnsurePlaces();
	const auto after = std::upper_bound(fItems.begin(), fItems.end(), y,
		[](float value, const BListItem* item) { return value < item->fTop; });
	return static_cast<int32>(after - fItems.begin()) - 1;
}


BRect
BListView::ItemFrame(int32 index)
{
	if (index < 0 || index >= CountItems())
		return BRect(0, 0, -1, -1);
	_EnsurePlaces();
	const BListItem* item = fItems[index];
	return BRect(0, item->fTop, Bounds().right, item->fTop + std::ceil(item->fHeight) - 1);
}


void
BListView::InvalidateItem(int32 index)
{
	const BRect frame = ItemFrame(index);
	if (frame.IsValid())
		Invalidate(frame);
}


void
BListView::_UpdateScrollBars()
{
	if (Window() == NULL)
		return;
	const BRect bounds = Bounds();
	if (BScrollBar* bar = ScrollBar(B_VERTICAL)) {
		const float height = _Bottom() + 1;
		const float visible = bounds.Height() + 1;
		const float step = fItems.empty() ? 10 : std::max(1.0f, std::ceil(fItems[0]->fHeight));
		bar->SetRange(0, std::max(0.0f, height - visible));
		bar->SetProportion(height > 0 ? std::min(1.0f, visible / height) : 1);
		bar->SetSteps(step, std::max(step, visible - step));
	}
	if (BScrollBar* bar = ScrollBar(B_HORIZONTAL)) {
		const float width = _WidestItem();
		bar->SetRange(0, std::max(0.0f, width - bounds.Width()));
		bar->SetProportion(width > 0 ? std::min(1.0f, bounds.Width() / width) : 1);
		bar->SetSteps(10, std::max(10.0f, bounds.Width() - 10));
	}
}


void
BListView::ScrollToSelection()
{
	if (fFirstSelected >= 0)
		_ScrollToItem(fFirstSelected);
}


void
BListView::_ScrollToItem(int32 index)
{
	const BRect frame = ItemFrame(index);
	if (!frame.IsValid() || Window() == NULL)
		return;
	const BRect bounds = Bounds();
	float y = bounds.top;
	if (frame.top < bounds.top || frame.Height() > bounds.Height())
		y = frame.top;
	else if (frame.bottom > bounds.bottom)
		y = frame.bottom - bounds.Height();
	if (y != bounds.top)
		ScrollTo(BPoint(bounds.left, std::max(0.0f, y)));
}
