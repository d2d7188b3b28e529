// BMessage: asking for items of each type.

#include <Message.h>

#include <cstring>

#include <String.h>


bool
BMessage::HasRect(const char* name, int32 index) const
{
	return HasData(name, B_RECT_TYPE, index);
}


bool
BMessage::HasPoint(const char* name, int32 index) const
{
	return HasData(name, B_POINT_TYPE, index);
}


bool
BMessage::HasInt8(const char* name, int32 index) const
{
	return HasData(name, B_INT8_TYPE, index);
}


bool
BMessage::HasUInt8(const char* name, int32 index) const
{
	return HasData(name, B_UINT8_TYPE, index);
}


bool
BMessage::HasInt16(const char* name, int32 index) const
{
	return HasData(name, B_INT16_TYPE, index);
}


bool
BMessage::HasUInt16(const char* name, int32 index) const
{
	return HasData(name, B_UINT16_TYPE, index);
}


bool
BMessage::HasInt32(const char* name, int32 index) const
{
	return HasData(name, B_INT32_TYPE, index);
}


bool
BMessage::HasUInt32(const char* name, int32 index) const
{
	return HasData(name, B_UINT32_TYPE, index);
}


bool
BMessage::HasInt64(const char* name, int32 index) const
{
	return HasData(name, B_INT64_TYPE, index);
}


bool
BMessage::HasUInt64(const char* name, int32 index) const
{
	return HasData(name, B_UINT64_TYPE, index);
}


bool
BMessage::HasBool(const char* name, int32 index) const
{
	return HasData(name, B_BOOL_TYPE, index);
}


bool
BMessage::HasFloat(const char* name, int32 index) const
{
	return HasData(name, B_FLOAT_TYPE, index);
}


bool
BMessage::HasDouble(const char* name, int32 index) const
{
	return HasData(name, B_DOUBLE_TYPE, index);
}


bool
BMessage::HasColor(const char* name, int32 index) const
{
	return HasData(name, B_RGB_32_BIT_TYPE, index);
}


bool
BMessage::HasString(const char* name, int32 index) const
{
	return HasData(name, B_STRING_TYPE, index);
}


bool
BMessage::HasPointer(const char* name, int32 index) const
{
	return HasData(name, B_POINTER_TYPE, index);
}


bool
BMessage::HasMessenger(const char* name, int32 index) const
{
	return HasData(name, B_MESSENGER_TYPE, index);
}


bool
BMessage::HasRef(const char* name, int32 index) const
{
	return HasData(name, B_REF_TYPE, index);
}


bool
BMessage::HasNodeRef(const char* name, int32 index) const
{
	return HasData(name, B_NODE_REF_TYPE, index);
}


bool
BMessage::HasMessage(const char* name, int32 index) const
{
	return HasData(name, B_MESSAGE_TYPE, index);
}
