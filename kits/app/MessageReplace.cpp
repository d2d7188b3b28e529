// BMessage: replacing items of each type.

#include <Message.h>

#include <cstring>

#include <Entry.h>
#include <Node.h>
#include <String.h>

#include "app/private/EntryRefData.h"


status_t
BMessage::ReplaceRect(const char* name, BRect value)
{
	return ReplaceRect(name, 0, value);
}


status_t
BMessage::ReplaceRect(const char* name, int32 index, BRect value)
{
	return ReplaceData(name, B_RECT_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplacePoint(const char* name, BPoint value)
{
	return ReplacePoint(name, 0, value);
}


status_t
BMessage::ReplacePoint(const char* name, int32 index, BPoint value)
{
	return ReplaceData(name, B_POINT_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceInt8(const char* name, int8 value)
{
	return ReplaceInt8(name, 0, value);
}


status_t
BMessage::ReplaceInt8(const char* name, int32 index, int8 value)
{
	return ReplaceData(name, B_INT8_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceUInt8(const char* name, uint8 value)
{
	return ReplaceUInt8(name, 0, value);
}


status_t
BMessage::ReplaceUInt8(const char* name, int32 index, uint8 value)
{
	return ReplaceData(name, B_UINT8_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceInt16(const char* name, int16 value)
{
	return ReplaceInt16(name, 0, value);
}


status_t
BMessage::ReplaceInt16(const char* name, int32 index, int16 value)
{
	return ReplaceData(name, B_INT16_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceUInt16(const char* name, uint16 value)
{
	return ReplaceUInt16(name, 0, value);
}


status_t
BMessage::ReplaceUInt16(const char* name, int32 index, uint16 value)
{
	return ReplaceData(name, B_UINT16_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceInt32(const char* name, int32 value)
{
	return ReplaceInt32(name, 0, value);
}


status_t
BMessage::ReplaceInt32(const char* name, int32 index, int32 value)
{
	return ReplaceData(name, B_INT32_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceUInt32(const char* name, uint32 value)
{
	return ReplaceUInt32(name, 0, value);
}


status_t
BMessage::ReplaceUInt32(const char* name, int32 index, uint32 value)
{
	return ReplaceData(name, B_UINT32_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceInt64(const char* name, int64 value)
{
	return ReplaceInt64(name, 0, value);
}


status_t
BMessage::ReplaceInt64(const char* name, int32 index, int64 value)
{
	return ReplaceData(name, B_INT64_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceUInt64(const char* name, uint64 value)
{
	return ReplaceUInt64(name, 0, value);
}


status_t
BMessage::ReplaceUInt64(const char* name, int32 index, uint64 value)
{
	return ReplaceData(name, B_UINT64_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceBool(const char* name, bool value)
{
	return ReplaceBool(name, 0, value);
}


status_t
BMessage::ReplaceBool(const char* name, int32 index, bool value)
{
	const uint8 byte = value ? 1 : 0;
	return ReplaceData(name, B_BOOL_TYPE, index, &byte, sizeof(byte));
}


status_t
BMessage::ReplaceFloat(const char* name, float value)
{
	return ReplaceFloat(name, 0, value);
}


status_t
BMessage::ReplaceFloat(const char* name, int32 index, float value)
{
	return ReplaceData(name, B_FLOAT_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceDouble(const char* name, double value)
{
	return ReplaceDouble(name, 0, value);
}


status_t
BMessage::ReplaceDouble(const char* name, int32 index, double value)
{
	return ReplaceData(name, B_DOUBLE_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceColor(const char* name, rgb_color value)
{
	return ReplaceColor(name, 0, value);
}


status_t
BMessage::ReplaceColor(const char* name, int32 index, rgb_color value)
{
	return ReplaceData(name, B_RGB_32_BIT_TYPE, index, &value, sizeof(value));
}


status_t
BMessage::ReplaceString(const char* name, const char* string)
{
	return ReplaceString(name, 0, string);
}


status_t
BMessage::ReplaceString(const char* name, int32 index, const char* string)
{
	if (string == nullptr)
		return B_BAD_VALUE;
	return ReplaceData(name, B_STRING_TYPE, index, string, ssize_t(strlen(string) + 1));
}


status_t
BMessage::ReplaceString(const char* name, const BString& string)
{
	return ReplaceString(name, 0, string);
}


status_t
BMessage::ReplaceString(const char* name, int32 index, const BString& string)
{
	return ReplaceData(name, B_STRING_TYPE, index, string.String(), string.Length() + 1);
}


status_t
BMessage::ReplacePointer(const char* name, const void* pointer)
{
	return ReplacePointer(name, 0, pointer);
}


status_t
BMessage::ReplacePointer(const char* name, int32 index, const void* pointer)
{
	return ReplaceData(name, B_POINTER_TYPE, index, &pointer, sizeof(pointer));
}


status_t
BMessage::ReplaceRef(const char* name, const entry_ref* ref)
{
	return ReplaceRef(name, 0, ref);
}


status_t
BMessage::ReplaceRef(const char* name, int32 index, const entry_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const BPrivate::EntryRefData data(*ref);
	return ReplaceData(name, B_REF_TYPE, index, data.Bytes(), ssize_t(data.Size()));
}


status_t
BMessage::ReplaceNodeRef(const char* name, const node_ref* ref)
{
	return ReplaceNodeRef(name, 0, ref);
}


status_t
BMessage::ReplaceNodeRef(const char* name, int32 index, const node_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const BPrivate::EntryRefData data(*ref);
	return ReplaceData(name, B_NODE_REF_TYPE, index, data.Bytes(), ssize_t(data.Size()));
}
