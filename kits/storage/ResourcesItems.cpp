// BResources: its items, one by one.

#include <Resources.h>

#include <stdlib.h>
#include <string.h>

#include <algorithm>
#include <string>

#include "storage/private/ResourcesState.h"

using namespace BPrivate;

namespace {

constexpr size_t kLargestName = 65534; // its size, with the terminator, is written as 16 bits
constexpr size_t kLargestResource = 0xffff0000;

} // namespace


status_t
BResources::AddResource(type_code type, int32 id, const void* data, size_t length, const char* name)
{
	if (data == NULL || length > kLargestResource)
		return B_BAD_VALUE;
	if (name != NULL && strlen(name) > kLargestName)
		return B_NAME_TOO_LONG;
	const status_t status = _CheckChange();
	if (status != B_OK)
		return status;
	ResourceItem* old = fState->table.Find(type, id);
	if (old == NULL && fState->table.Count() >= static_cast<int32>(kMostResources))
		return B_NOT_ALLOWED; // the file could not be read any more

	// The bytes may be the old resource's own.
	auto item = NewResourceItem(type, id, name, data, length);
	if (item == nullptr)
		return B_NO_MEMORY;
	if (old != NULL)
		fState->table.Remove(old);
	fState->table.Add(std::move(item));
	fState->changed = true;
	return B_OK;
}


bool
BResources::HasResource(type_code type, int32 id)
{
	return fState->table.Find(type, id) != NULL;
}


bool
BResources::HasResource(type_code type, const char* name)
{
	return fState->table.Find(type, name) != NULL;
}


namespace {

template<typename Type, typename Value>
void
Answer(Type* _answer, Value value)
{
	if (_answer != NULL)
		*_answer = value;
}

} // namespace


bool
BResources::GetResourceInfo(
	int32 index, type_code* _type, int32* _id, const char** _name, size_t* _length)
{
	const ResourceItem* item = fState->table.At(index);
	if (item == NULL)
		return false;
	Answer(_type, item->type);
	Answer(_id, item->id);
	Answer(_name, item->name.c_str());
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(
	type_code byType, int32 index, int32* _id, const char** _name, size_t* _length)
{
	const ResourceItem* item = fState->table.At(byType, index);
	if (item == NULL)
		return false;
	Answer(_id, item->id);
	Answer(_name, item->name.c_str());
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(type_code byType, int32 id, const char** _name, size_t* _length)
{
	const ResourceItem* item = fState->table.Find(byType, id);
	if (item == NULL)
		return false;
	Answer(_name, item->name.c_str());
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(type_code byType, const char* name, int32* _id, size_t* _length)
{
	const ResourceItem* item = fState->table.Find(byType, name);
	if (item == NULL)
		return false;
	Answer(_id, item->id);
	Answer(_length, item->size);
	return true;
}


bool
BResources::GetResourceInfo(
	const void* pointer, type_code* _type, int32* _id, size_t* _length, const char** _name)
{
	const ResourceItem* item = fState->table.Find(pointer);
	if (item == NULL)
		return false;
	Answer(_type, item->type);
	Answer(_id, item->id);
	Answer(_length, item->size);
	Answer(_name, item->name.c_str());
	return true;
}


status_t
BResources::RemoveResource(const void* resource)
{
	const status_t status = _CheckChange();
	if (resource != NULL && status != B_OK)
		return status;
	ResourceItem* item = fState->table.Find(resource);
	if (item == NULL)
		return B_BAD_VALUE;
	fState->table.Remove(item);
	fState->changed = true;
	return B_OK;
}


status_t
BResources::RemoveResource(type_code type, int32 id)
{
	const status_t status = _CheckChange();
	if (status != B_OK)
		return status;
	ResourceItem* item = fState->table.Find(type, id);
	if (item == NULL)
		return B_BAD_VALUE;
	fState->table.Remove(item);
	fState->changed = true;
	return B_OK;
}


status_t
BResources::WriteResource(type_code type, int32 id, const void* data, off_t offset, size_t length)
{
	if (data == NULL || offset < 0 || static_cast<uint64>(offset) > kLargestResource
		|| length > kLargestResource - static_cast<size_t>(offset))
		return B_BAD_VALUE;
	const status_t status = _CheckChange();
	if (status != B_OK)
		return status;
	ResourceItem* item = fState->table.Find(type, id);
	if (item == NULL)
		return B_BAD_VALUE;
	if (fState->Load(item, fFile._Fd()) == NULL)
		return B_IO_ERROR;

	// A new block, because the bytes may come from the old one.
	const void* oldData = item->data;
	const size_t size = std::max(item->size, static_cast<size_t>(offset) + length);
	char* bytes = static_cast<char*>(malloc(std::max<size_t>(size, 1)));
	if (bytes == NULL)
		return B_NO_MEMORY;
	memcpy(bytes, oldData, item->size);
	memset(bytes + item->size, 0, size - item->size);
	memcpy(bytes + offset, data, length);
	void* old = item->data;
	item->data = bytes;
	item->size = size;
	item->offset = -1;
	fState->table.DataChanged(item, old);
	free(old);
	fState->changed = true;
	return B_OK;
}


status_t
BResources::ReadResource(type_code type, int32 id, void* data, off_t offset, size_t length)
{
	if (data == NULL || offset < 0)
		return B_BAD_VALUE;
	ResourceItem* item = fState->table.Find(type, id);
	if (item == NULL)
		return B_BAD_VALUE;
	if (fState->Load(item, fFile._Fd()) == NULL)
		return B_IO_ERROR;
	if (static_cast<uint64>(offset) < item->size)
		memcpy(data, static_cast<const char*>(item->data) + offset,
			std::min(length, item->size - static_cast<size_t>(offset)));
	return B_OK;
}


namespace {

void*
CopyOf(const void* data, size_t size, size_t* _length)
{
	void* copy = data != NULL ? malloc(std::max<size_t>(size, 1)) : NULL;
	if (copy != NULL)
		memcpy(copy, data, size);
	Answer(_length, copy != NULL ? size : 0);
	return copy;
}

} // namespace


void*
BResources::FindResource(type_code type, int32 id, size_t* _length)
{
	size_t size = 0;
	const void* data = LoadResource(type, id, &size);
	return CopyOf(data, size, _length);
}


void*
BResources::FindResource(type_code type, const char* name, size_t* _length)
{
	size_t size = 0;
	const void* data = LoadResource(type, name, &size);
	return CopyOf(data, size, _length);
}


// #pragma mark - private


status_t
BResources::_CheckChange() const
{
	if (fFile.InitCheck() == B_OK && fState->readOnly)
		return B_NOT_ALLOWED;
	return B_OK;
}
