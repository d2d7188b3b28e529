// BMessage: objects that can be flattened, as items.

#include <Message.h>

#include <cstdlib>

#include <Flattenable.h>

namespace {

// What the object flattens to, as the function's data and size.
template<typename Function>
status_t
WithFlatData(const BFlattenable* object, Function function)
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const ssize_t size = object->FlattenedSize();
	if (size <= 0)
		return B_BAD_VALUE;
	void* data = malloc(size_t(size));
	if (data == nullptr)
		return B_NO_MEMORY;
	status_t status = object->Flatten(data, size);
	if (status == B_OK)
		status = function(data, size);
	free(data);
	return status;
}

} // namespace


status_t
BMessage::AddFlat(const char* name, BFlattenable* object, int32 count)
{
	return AddFlat(name, const_cast<const BFlattenable*>(object), count);
}


status_t
BMessage::AddFlat(const char* name, const BFlattenable* object, int32 count)
{
	return WithFlatData(object, [&](const void* data, ssize_t size) {
		return AddData(name, object->TypeCode(), data, size, false, count);
	});
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
	return WithFlatData(object, [&](const void* data, ssize_t size) {
		return ReplaceData(name, object->TypeCode(), index, data, size);
	});
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
