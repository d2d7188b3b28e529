// ResourceTable: the resources of one object, in order, found by key in constant time.
#pragma once

#include <memory>
#include <unordered_map>
#include <vector>

#include <SupportDefs.h>

#include "storage/private/ResourceItem.h"

namespace BPrivate {

// A new item with a copy of the bytes; NULL without memory. The name may be NULL.
std::unique_ptr<ResourceItem> NewResourceItem(
	type_code type, int32 id, const char* name, const void* data, size_t size);

// Items in their order. Each knows its slot, so taking one out is constant time; the holes that
// this leaves are closed when an item is next asked for by its index.
class ResourceItemList {
public:
	explicit ResourceItemList(size_t ResourceItem::*slot) : fSlot(slot) {}

	void Add(ResourceItem* item);
	void Remove(ResourceItem* item);
	ResourceItem* At(int32 index);
	int32 Count() const { return static_cast<int32>(fItems.size() - fFirst - fHoles); }

private:
	void _Close();

	size_t ResourceItem::*fSlot;
	std::vector<ResourceItem*> fItems; // borrowed; NULL is a hole
	size_t fFirst = 0; // slots before it are empty and not counted as holes
	size_t fHoles = 0;
};


class ResourceTable {
public:
	ResourceTable();
	~ResourceTable();

	// The table owns the item from then on. Several of one key may be there; the first is found.
	ResourceItem* Add(std::unique_ptr<ResourceItem> item);
	void Remove(ResourceItem* item);
	// To be told when an item's data came into memory or moved.
	void DataChanged(ResourceItem* item, const void* oldData);

	int32 Count() const { return fOrder.Count(); }
	ResourceItem* At(int32 index) { return fOrder.At(index); }
	ResourceItem* At(type_code type, int32 index);
	ResourceItem* Find(type_code type, int32 id) const;
	// A nameless item has the name "".
	ResourceItem* Find(type_code type, const char* name);
	ResourceItem* Find(const void* data) const;

private:
	struct SameKey {
		ResourceItem* first;
		ResourceItem* last;
	};

	static uint64 _Key(type_code type, int32 id);
	void _RemoveKey(ResourceItem* item);

	ResourceItemList fOrder;
	std::unordered_map<type_code, ResourceItemList> fTypes;
	std::unordered_map<uint64, SameKey> fKeys;
	std::unordered_map<const void*, ResourceItem*> fData;
};

} // namespace BPrivate
