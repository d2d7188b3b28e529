// BList: an ordered list of pointers.
#pragma once

#include <SupportDefs.h>

// Owns only its array, never what the pointers point to. Not thread-safe.
class BList {
public:
	BList(int32 itemsPerBlock = 20);
	BList(const BList& other);
	virtual ~BList();

	BList& operator=(const BList& other);
	bool operator==(const BList& other) const; // the same pointers in the same order
	bool operator!=(const BList& other) const;

	// An index out of range makes each of these return false or NULL and change nothing.
	bool AddItem(void* item);
	bool AddItem(void* item, int32 index);
	bool AddList(const BList* list);
	bool AddList(const BList* list, int32 index);
	bool RemoveItem(void* item);
	void* RemoveItem(int32 index);
	bool RemoveItems(int32 index, int32 count); // clamps the count to the end
	bool ReplaceItem(int32 index, void* newItem);
	void MakeEmpty();

	void SortItems(int (*compare)(const void*, const void*)); // gets pointers to two items
	bool SwapItems(int32 indexA, int32 indexB);
	bool MoveItem(int32 fromIndex, int32 toIndex);

	void* ItemAt(int32 index) const;
	void* ItemAtFast(int32 index) const; // the index must be in range
	void* FirstItem() const;
	void* LastItem() const;
	void* Items() const; // the array; valid until the list changes

	bool HasItem(void* item) const;
	bool HasItem(const void* item) const;
	int32 IndexOf(void* item) const; // -1 when it is not there
	int32 IndexOf(const void* item) const;
	int32 CountItems() const;
	bool IsEmpty() const;

	// Calls the function for each item until it returns true.
	void DoForEach(bool (*function)(void* item));
	void DoForEach(bool (*function)(void* item, void* argument), void* argument);

private:
	bool _Reserve(int32 count);

	void** fItems = nullptr;
	int32 fCount = 0;
	int32 fCapacity = 0;
	int32 fBlockSize;
};
