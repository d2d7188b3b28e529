// BMessage: adding items of each type.

#include <Message.h>

#include <cstring>

#include <Entry.h>
#include <Node.h>
#include <String.h>

#include "app/private/EntryRefData.h"


status_t
BMessage::AddRect(const char* name, BRect value)
{
	return AddData(name, B_RECT_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddPoint(const char* name, BPoint value)
{
	return AddData(name, B_POINT_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddInt8(const char* name, int8 value)
{
	return AddData(name, B_INT8_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddUInt8(const char* name, uint8 value)
{
	return AddData(name, B_UINT8_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddInt16(const char* name, int16 value)
{
	return AddData(name, B_INT16_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddUInt16(const char* name, uint16 value)
{
	return AddData(name, B_UINT16_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddInt32(const char* name, int32 value)
{
	return AddData(name, B_INT32_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddUInt32(const char* name, uint32 value)
{
	return AddData(name, B_UINT32_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddInt64(const char* name, int64 value)
{
	return AddData(name, B_INT64_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddUInt64(const char* name, uint64 value)
{
	return AddData(name, B_UINT64_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddBool(const char* name, bool value)
{
	const uint8 byte = value ? 1 : 0;
	return AddData(name, B_BOOL_TYPE, &byte, sizeof(byte));
}


status_t
BMessage::AddFloat(const char* name, float value)
{
	return AddData(name, B_FLOAT_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddDouble(const char* name, double value)
{
	return AddData(name, B_DOUBLE_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddColor(const char* name, rgb_color value)
{
	return AddData(name, B_RGB_32_BIT_TYPE, &value, sizeof(value));
}


status_t
BMessage::AddString(const char* name, const char* string)
{
	if (string == nullptr)
		return B_BAD_VALUE;
	return AddData(name, B_STRING_TYPE, string, ssize_t(strlen(string) + 1), false);
}


status_t
BMessage::AddString(const char* name, const BString& string)
{
	return AddData(name, B_STRING_TYPE, string.String(), string.Length() + 1, false);
}


status_t
BMessage::AddPointer(const char* name, const void* pointer)
{
	return AddData(name, B_POINTER_TYPE, &pointer, sizeof(pointer));
}


status_t
BMessage::AddRef(const char* name, const entry_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const BPrivate::EntryRefData data(*ref);
	return AddData(name, B_REF_TYPE, data.Bytes(), ssize_t(data.Size()), false);
}


status_t
BMessage::AddNodeRef(const char* name, const node_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const BPrivate::EntryRefData data(*ref);
	return AddData(name, B_NODE_REF_TYPE, data.Bytes(), ssize_t(data.Size()), false);
}
