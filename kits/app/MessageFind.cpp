// BMessage: finding items of each type.

#include <Message.h>

#include <cstring>

#include <Entry.h>
#include <Node.h>
#include <String.h>

#include "app/private/EntryRefData.h"


status_t
BMessage::FindRect(const char* name, BRect* value) const
{
	return FindRect(name, 0, value);
}


status_t
BMessage::FindRect(const char* name, int32 index, BRect* value) const
{
	const status_t status = _FindFixed(name, B_RECT_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = BRect();
	return status;
}


status_t
BMessage::FindPoint(const char* name, BPoint* value) const
{
	return FindPoint(name, 0, value);
}


status_t
BMessage::FindPoint(const char* name, int32 index, BPoint* value) const
{
	const status_t status = _FindFixed(name, B_POINT_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = BPoint();
	return status;
}


status_t
BMessage::FindInt8(const char* name, int8* value) const
{
	return FindInt8(name, 0, value);
}


status_t
BMessage::FindInt8(const char* name, int32 index, int8* value) const
{
	const status_t status = _FindFixed(name, B_INT8_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindUInt8(const char* name, uint8* value) const
{
	return FindUInt8(name, 0, value);
}


status_t
BMessage::FindUInt8(const char* name, int32 index, uint8* value) const
{
	const status_t status = _FindFixed(name, B_UINT8_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindInt16(const char* name, int16* value) const
{
	return FindInt16(name, 0, value);
}


status_t
BMessage::FindInt16(const char* name, int32 index, int16* value) const
{
	const status_t status = _FindFixed(name, B_INT16_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindUInt16(const char* name, uint16* value) const
{
	return FindUInt16(name, 0, value);
}


status_t
BMessage::FindUInt16(const char* name, int32 index, uint16* value) const
{
	const status_t status = _FindFixed(name, B_UINT16_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindInt32(const char* name, int32* value) const
{
	return FindInt32(name, 0, value);
}


status_t
BMessage::FindInt32(const char* name, int32 index, int32* value) const
{
	const status_t status = _FindFixed(name, B_INT32_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindUInt32(const char* name, uint32* value) const
{
	return FindUInt32(name, 0, value);
}


status_t
BMessage::FindUInt32(const char* name, int32 index, uint32* value) const
{
	const status_t status = _FindFixed(name, B_UINT32_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindInt64(const char* name, int64* value) const
{
	return FindInt64(name, 0, value);
}


status_t
BMessage::FindInt64(const char* name, int32 index, int64* value) const
{
	const status_t status = _FindFixed(name, B_INT64_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindUInt64(const char* name, uint64* value) const
{
	return FindUInt64(name, 0, value);
}


status_t
BMessage::FindUInt64(const char* name, int32 index, uint64* value) const
{
	const status_t status = _FindFixed(name, B_UINT64_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindBool(const char* name, bool* value) const
{
	return FindBool(name, 0, value);
}


status_t
BMessage::FindBool(const char* name, int32 index, bool* value) const
{
	uint8 byte = 0;
	const status_t status = _FindFixed(name, B_BOOL_TYPE, index, &byte, sizeof(byte));
	if (value == nullptr)
		return B_BAD_VALUE;
	*value = byte != 0;
	return status;
}


status_t
BMessage::FindFloat(const char* name, float* value) const
{
	return FindFloat(name, 0, value);
}


status_t
BMessage::FindFloat(const char* name, int32 index, float* value) const
{
	const status_t status = _FindFixed(name, B_FLOAT_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindDouble(const char* name, double* value) const
{
	return FindDouble(name, 0, value);
}


status_t
BMessage::FindDouble(const char* name, int32 index, double* value) const
{
	const status_t status = _FindFixed(name, B_DOUBLE_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = 0;
	return status;
}


status_t
BMessage::FindColor(const char* name, rgb_color* value) const
{
	return FindColor(name, 0, value);
}


status_t
BMessage::FindColor(const char* name, int32 index, rgb_color* value) const
{
	const status_t status = _FindFixed(name, B_RGB_32_BIT_TYPE, index, value, sizeof(*value));
	if (status != B_OK && value != nullptr)
		*value = { 0, 0, 0, 0 };
	return status;
}


status_t
BMessage::FindString(const char* name, const char** string) const
{
	return FindString(name, 0, string);
}


// An item without an end of its own is no string that could be given out like this.
status_t
BMessage::FindString(const char* name, int32 index, const char** string) const
{
	if (string == nullptr)
		return B_BAD_VALUE;
	*string = nullptr;
	const void* data;
	ssize_t size;
	const status_t status = FindData(name, B_STRING_TYPE, index, &data, &size);
	if (status != B_OK)
		return status;
	if (memchr(data, 0, size_t(size)) == nullptr)
		return B_BAD_DATA;
	*string = static_cast<const char*>(data);
	return B_OK;
}


status_t
BMessage::FindString(const char* name, BString* string) const
{
	return FindString(name, 0, string);
}


status_t
BMessage::FindString(const char* name, int32 index, BString* string) const
{
	if (string == nullptr)
		return B_BAD_VALUE;
	const void* data;
	ssize_t size;
	const status_t status = FindData(name, B_STRING_TYPE, index, &data, &size);
	if (status == B_OK)
		string->SetTo(static_cast<const char*>(data), int32(size));
	else
		string->SetTo("");
	return status;
}


status_t
BMessage::FindPointer(const char* name, void** pointer) const
{
	return FindPointer(name, 0, pointer);
}


status_t
BMessage::FindPointer(const char* name, int32 index, void** pointer) const
{
	const status_t status = _FindFixed(name, B_POINTER_TYPE, index, pointer, sizeof(*pointer));
	if (status != B_OK && pointer != nullptr)
		*pointer = nullptr;
	return status;
}


status_t
BMessage::FindRef(const char* name, entry_ref* ref) const
{
	return FindRef(name, 0, ref);
}


status_t
BMessage::FindRef(const char* name, int32 index, entry_ref* ref) const
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const void* data;
	ssize_t size;
	status_t status = FindData(name, B_REF_TYPE, index, &data, &size);
	if (status == B_OK)
		status = BPrivate::EntryRefData::Read(data, size_t(size), ref);
	if (status != B_OK)
		*ref = entry_ref();
	return status;
}


status_t
BMessage::FindNodeRef(const char* name, node_ref* ref) const
{
	return FindNodeRef(name, 0, ref);
}


status_t
BMessage::FindNodeRef(const char* name, int32 index, node_ref* ref) const
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const void* data;
	ssize_t size;
	status_t status = FindData(name, B_NODE_REF_TYPE, index, &data, &size);
	if (status == B_OK)
		status = BPrivate::EntryRefData::Read(data, size_t(size), ref);
	if (status != B_OK)
		*ref = node_ref();
	return status;
}


// #pragma mark - old style


BRect
BMessage::FindRect(const char* name, int32 index) const
{
	BRect value;
	FindRect(name, index, &value);
	return value;
}


BPoint
BMessage::FindPoint(const char* name, int32 index) const
{
	BPoint value;
	FindPoint(name, index, &value);
	return value;
}


int8
BMessage::FindInt8(const char* name, int32 index) const
{
	int8 value;
	FindInt8(name, index, &value);
	return value;
}


int16
BMessage::FindInt16(const char* name, int32 index) const
{
	int16 value;
	FindInt16(name, index, &value);
	return value;
}


int32
BMessage::FindInt32(const char* name, int32 index) const
{
	int32 value;
	FindInt32(name, index, &value);
	return value;
}


int64
BMessage::FindInt64(const char* name, int32 index) const
{
	int64 value;
	FindInt64(name, index, &value);
	return value;
}


bool
BMessage::FindBool(const char* name, int32 index) const
{
	bool value;
	FindBool(name, index, &value);
	return value;
}


float
BMessage::FindFloat(const char* name, int32 index) const
{
	float value;
	FindFloat(name, index, &value);
	return value;
}


double
BMessage::FindDouble(const char* name, int32 index) const
{
	double value;
	FindDouble(name, index, &value);
	return value;
}


const char*
BMessage::FindString(const char* name, int32 index) const
{
	const char* string;
	FindString(name, index, &string);
	return string;
}
