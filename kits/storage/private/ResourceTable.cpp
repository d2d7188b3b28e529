#include "storage/private/ResourceTable.h"

#include <stdlib.h>
#include <string.h>

#include <algorithm>

namespace BPrivate {

std::unique_ptr<ResourceItem>
NewResourceItem(type_code type, int32 id, const char* name, const void* data, size_t size)
{
	auto item = std::make_unique<ResourceItem>();
	item->type = type;
	item->id = id;
	item->named = name != NULL;
	item->name = name != NULL ? name : "";
	item->size = size;
	item->data = malloc(std::max<size_t>(size, 1));
	if (item->data == NULL)
		return nullptr;
	memcpy(item->data, data, size);
	return item;
}


// #pragma mark - ResourceItemList


void
ResourceItemList::Add(ResourceItem* item)
{
	item->*fSlot = fItems.size();
	fItems.push_back(item);
}


void
ResourceItemList::Remove(ResourceItem* item)
{
	fItems[item->*fSlot] = NULL;
	fHoles++;
	// An item taken from the front costs nothing later.
	while (fFirst < fItems.size() && fItems[fFirst] == NULL) {
		fFirst++;
		fHoles--;
	}
}


ResourceItem*
ResourceItemList::At(int32 index)
{
	if (index < 0 || index >= Count())
		return NULL;
	if (fHoles > 0)
		_Close();
	return fItems[fFirst + index];
}


void
ResourceItemList::_Close()
{
	size_t to = 0;
	for (size_t from = fFirst; from < fItems.size(); from++) {
		if (fItems[from] == NULL)
			continue;
		fItems[to] = fItems[from];
		fItems[to]->*fSlot = to;
		to++;
	}
	fItems.resize(to);
	fFirst = 0;
	fHoles = 0;
}


// #pragma mark - ResourceTable


ResourceTable::ResourceTable() : fOrder(&ResourceItem::slot)
{
}


ResourceTable::~ResourceTable()
{
	for (int32 i = Count() - 1; i >= 0; i--)
		delete fOrder.At(i);
}


ResourceItem*
ResourceTable::Add(std::unique_ptr<ResourceItem> newItem)
{
	ResourceItem* item = newItem.release();
	fOrder.Add(item);
	fTypes.try_emplace(item->type, &ResourceItem::typeSlot).first->second.Add(item);
	const auto [key, added] = fKeys.try_emplace(_Key(item->type, item->id), SameKey { item, item });
	if (!added) {
		key->second.last->nextSame = item;
		key->second.last = item;
	}
	if (item->data != NULL)
		fData[item->data] = item;
	return item;
}


void
ResourceTable::Remove(ResourceItem* item)
{
	fOrder.Remove(item);
	const auto type = fTypes.find(item->type);
	type->second.Remove(item);
	if (type->second.Count() == 0)
		fTypes.erase(type);
	_RemoveKey(item);
	if (item->data != NULL)
		fData.erase(item->data);
	delete item;
}


void
ResourceTable::DataChanged(ResourceItem* item, const void* oldData)
{
	if (oldData == item->data)
		return;
	if (oldData != NULL)
		fData.erase(oldData);
	if (item->data != NULL)
		fData[item->data] = item;
}


ResourceItem*
ResourceTable::At(type_code type, int32 index)
{
	const auto found = fTypes.find(type);
	return found != fTypes.end() ? found->second.At(index) : NULL;
}


ResourceItem*
ResourceTable::Find(type_code type, int32 id) const
{
	const auto found = fKeys.find(_Key(type, id));
	return found != fKeys.end() ? found->second.first : NULL;
}


ResourceItem*
ResourceTable::Find(type_code type, const char* name)
{
	const auto found = fTypes.find(type);
	if (name == NULL || found == fTypes.end())
		return NULL;
	ResourceItemList& items = found->second;
	const int32 count = items.Count();
	for (int32 i = 0; i < count; i++) {
		ResourceItem* item = items.At(i);
		if (item->name == name)
			return item;
	}
	return NULL;
}


ResourceItem*
ResourceTable::Find(const void* data) const
{
	const auto found = fData.find(data);
	return data != NULL && found != fData.end() ? found->second : NULL;
}


// #pragma mark - private


uint64
ResourceTable::_Key(type_code type, int32 id)
{
	return static_cast<uint64>(type) << 32 | static_cast<uint32>(id);
}


void
ResourceTable::_RemoveKey(ResourceItem* item)
{
	const auto found = fKeys.find(_Key(item->type, item->id));
	SameKey& same = found->second;
	if (same.first == item) {
		same.first = item->nextSame;
		if (same.first == NULL)
			fKeys.erase(found);
		return;
	}
	ResourceItem* before = same.first;
	while (before->nextSame != item)
		before = before->nextSame;
	before->nextSame = item->nextSame;
	if (same.last == item)
		same.last = before;
}

} // namespace BPrivate
