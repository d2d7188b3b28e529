#include <List.h>

#include <cstdlib>
#include <cstring>


BList::BList(int32 itemsPerBlock) : fBlockSize(max_c(itemsPerBlock, 1))
{
}


BList::BList(const BList& other) : fBlockSize(other.fBlockSize)
{
	AddList(&other);
}


BList::~BList()
{
	free(fItems);
}


BList&
BList::operator=(const BList& other)
{
	if (this != &other) {
		fBlockSize = other.fBlockSize;
		MakeEmpty();
		AddList(&other);
	}
	return *this;
}


bool
BList::operator==(const BList& other) const
{
	return fCount == other.fCount
		&& (fCount == 0 || memcmp(fItems, other.fItems, size_t(fCount) * sizeof(void*)) == 0);
}


bool
BList::operator!=(const BList& other) const
{
	return !(*this == other);
}


bool
BList::AddItem(void* item)
{
	return AddItem(item, fCount);
}


bool
BList::AddItem(void* item, int32 index)
{
	if (index < 0 || index > fCount || !_Reserve(1))
		return false;
	memmove(fItems + index + 1, fItems + index, size_t(fCount - index) * sizeof(void*));
	fItems[index] = item;
	fCount++;
	return true;
}


bool
BList::AddList(const BList* list)
{
	return AddList(list, fCount);
}


bool
BList::AddList(const BList* list, int32 index)
{
	if (list == nullptr || index < 0 || index > fCount)
		return false;
	const int32 count = list->fCount;
	if (count == 0)
		return true;
	if (!_Reserve(count))
		return false;
	memmove(fItems + index + count, fItems + index, size_t(fCount - index) * sizeof(void*));
	if (list == this) {
		// The first part has stayed, the rest has moved behind the gap.
		memmove(fItems + index, fItems, size_t(index) * sizeof(void*));
		memmove(fItems + 2 * index, fItems + index + count, size_t(count - index) * sizeof(void*));
	} else
		memcpy(fItems + index, list->fItems, size_t(count) * sizeof(void*));
	fCount += count;
	return true;
}


bool
BList::RemoveItem(void* item)
{
	const int32 index = IndexOf(item);
	return RemoveItems(index, 1);
}


void*
BList::RemoveItem(int32 index)
{
	void* item = ItemAt(index);
	RemoveItems(index, 1);
	return item;
}


bool
BList::RemoveItems(int32 index, int32 count)
{
	if (index < 0 || index >= fCount || count < 1)
		return false;
	count = min_c(count, fCount - index);
	const int32 behind = fCount - index - count;
	memmove(fItems + index, fItems + index + count, size_t(behind) * sizeof(void*));
	fCount -= count;
	return true;
}


bool
BList::ReplaceItem(int32 index, void* newItem)
{
	if (index < 0 || index >= fCount)
		return false;
	fItems[index] = newItem;
	return true;
}


void
BList::MakeEmpty()
{
	free(fItems);
	fItems = nullptr;
	fCount = 0;
	fCapacity = 0;
}


void
BList::SortItems(int (*compare)(const void*, const void*))
{
	if (compare != nullptr && fCount > 1)
		qsort(fItems, size_t(fCount), sizeof(void*), compare);
}


bool
BList::SwapItems(int32 indexA, int32 indexB)
{
	if (indexA < 0 || indexA >= fCount || indexB < 0 || indexB >= fCount)
		return false;
	void* item = fItems[indexA];
	fItems[indexA] = fItems[indexB];
	fItems[indexB] = item;
	return true;
}


bool
BList::MoveItem(int32 fromIndex, int32 toIndex)
{
	if (fromIndex < 0 || fromIndex >= fCount || toIndex < 0 || toIndex >= fCount)
		return false;
	void* item = fItems[fromIndex];
	if (fromIndex < toIndex) {
		memmove(fItems + fromIndex, fItems + fromIndex + 1,
			size_t(toIndex - fromIndex) * sizeof(void*));
	} else {
		memmove(
			fItems + toIndex + 1, fItems + toIndex, size_t(fromIndex - toIndex) * sizeof(void*));
	}
	fItems[toIndex] = item;
	return true;
}


void*
BList::ItemAt(int32 index) const
{
	return index >= 0 && index < fCount ? fItems[index] : nullptr;
}


void*
BList::ItemAtFast(int32 index) const
{
	return fItems[index];
}


void*
BList::FirstItem() const
{
	return ItemAt(0);
}


void*
BList::LastItem() const
{
	return ItemAt(fCount - 1);
}


void*
BList::Items() const
{
	return fItems;
}


bool
BList::HasItem(void* item) const
{
	return IndexOf(item) >= 0;
}


bool
BList::HasItem(const void* item) const
{
	return IndexOf(item) >= 0;
}


int32
BList::IndexOf(void* item) const
{
	return IndexOf(static_cast<const void*>(item));
}


int32
BList::IndexOf(const void* item) const
{
	for (int32 i = 0; i < fCount; i++) {
		if (fItems[i] == item)
			return i;
	}
	return -1;
}


int32
BList::CountItems() const
{
	return fCount;
}


bool
BList::IsEmpty() const
{
	return fCount == 0;
}


void
BList::DoForEach(bool (*function)(void* item))
{
	if (function == nullptr)
		return;
	for (int32 i = 0; i < fCount; i++) {
		if (function(fItems[i]))
			return;
	}
}


void
BList::DoForEach(bool (*function)(void* item, void* argument), void* argument)
{
	if (function == nullptr)
		return;
	for (int32 i = 0; i < fCount; i++) {
		if (function(fItems[i], argument))
			return;
	}
}


// Makes room for more items. The room doubles, so that adding one by one stays cheap.
bool
BList::_Reserve(int32 count)
{
	if (count > INT32_MAX / 2 - fCount)
		return false;
	const int32 needed = fCount + count;
	if (needed <= fCapacity)
		return true;

	const int32 blocks = (needed + fBlockSize - 1) / fBlockSize;
	const int32 capacity = max_c(blocks * fBlockSize, fCapacity * 2);
	void** items = static_cast<void**>(realloc(fItems, size_t(capacity) * sizeof(void*)));
	if (items == nullptr)
		return false;
	fItems = items;
	fCapacity = capacity;
	return true;
}
