// BMessage: objects that can be flattened, as items.

#include <Message.h>

#include <cstdlib>

#include <Flattenable.h>


status_t
BMessage::AddFlat(const char* name, BFlattenable* object, int32 count)
{
	return AddFlat(name, const_cast<const BFlattenable*>(object), count);
}


status_t
BMessage::AddFlat(const char* name, const BFlattenable* object, int32 count)
{
	if (name == nullptr || object == nullptr)
		return B_BAD_VALUE;
	const ssize_t size = object->FlattenedSize();
	if (size <= 0)
		return B_BAD_VALUE;
	void* buffer = malloc(size_t(size));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	status_t status = object->Flatten(buffer, size);
	if (status == B_OK)
		status = AddData(name, object->TypeCode(), buffer, size, false, count);
	free(buffer);
	return status;
}


status_t
BMessage::FindFlat(const char* name, BFlattenable* object) const
{
	return FindFlat(name, 0, object);
}


status_t
BMessage::FindFlat(const char* name, int32 index, BFlattenable* object) const
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const void* data;
	ssize_t size;
	const status_t status = FindData(name, object->TypeCode(), index, &data, &size);
	return status == B_OK ? object->Unflatten(object->TypeCode(), data, size) : status;
}


status_t
BMessage::ReplaceFlat(const char* name, BFlattenable* object)
{
	return ReplaceFlat(name, 0, object);
}


status_t
BMessage::ReplaceFlat(const char* name, int32 index, BFlattenable* object)
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const ssize_t size = object->FlattenedSize();
	if (size <= 0)
		return B_BAD_VALUE;
	void* buffer = malloc(size_t(size));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	status_t status = object->Flatten(buffer, size);
	if (status == B_OK)
		status = ReplaceData(name, object->TypeCode(), index, buffer, size);
	free(buffer);
	return status;
}


bool
BMessage::HasFlat(const char* name, const BFlattenable* object) const
{
	return HasFlat(name, 0, object);
}


bool
BMessage::HasFlat(const char* name, int32 index, const BFlattenable* object) const
{
	return object != nullptr && HasData(name, object->TypeCode(), index);
}
