#include "tools/arcv/MessageJson.h"

#include <string.h>

#include <MessageForm.h>
#include <TypeConstants.h>

#include "tools/arcv/Input.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

template<typename Number>
Number
Get(const void* data, size_t index = 0)
{
	Number number;
	memcpy(&number, static_cast<const char*>(data) + index * sizeof(Number), sizeof(Number));
	return number;
}


// Signed and unsigned numbers of one size; false when the size is another.
template<typename Number>
bool
WriteInteger(JsonWriter& json, const void* data, size_t size)
{
	if (size != sizeof(Number))
		return false;
	if (std::is_signed_v<Number>)
		json.Integer(Get<Number>(data));
	else
		json.Unsigned(Get<Number>(data));
	return true;
}


bool
WriteFloats(JsonWriter& json, const void* data, size_t size, size_t count)
{
	if (size != count * sizeof(float))
		return false;
	json.OpenArray(true);
	for (size_t i = 0; i < count; i++)
		json.Float(Get<float>(data, i));
	json.CloseArray();
	return true;
}


bool
WriteColor(JsonWriter& json, const void* data, size_t size)
{
	if (size != 4)
		return false;
	json.OpenArray(true);
	for (size_t i = 0; i < size; i++)
		json.Integer(Get<uint8>(data, i));
	json.CloseArray();
	return true;
}


bool
WriteString(JsonWriter& json, const void* data, size_t size)
{
	const std::string_view text(static_cast<const char*>(data), size);
	if (text.empty() || text.back() != '\0' || !IsUtf8(text))
		return false;
	json.String(text.substr(0, size - 1));
	return true;
}


bool
WriteBool(JsonWriter& json, const void* data, size_t size)
{
	const uint8 value = size == 1 ? Get<uint8>(data) : 2;
	if (value > 1)
		return false;
	json.Boolean(value == 1);
	return true;
}


// False when the value does not fit the type, or the type has no form of its own.
bool
WriteTyped(JsonWriter& json, type_code type, const void* data, size_t size)
{
	switch (type) {
		case B_BOOL_TYPE:
			return WriteBool(json, data, size);
		case B_INT8_TYPE:
			return WriteInteger<int8>(json, data, size);
		case B_UINT8_TYPE:
			return WriteInteger<uint8>(json, data, size);
		case B_INT16_TYPE:
			return WriteInteger<int16>(json, data, size);
		case B_UINT16_TYPE:
			return WriteInteger<uint16>(json, data, size);
		case B_INT32_TYPE:
			return WriteInteger<int32>(json, data, size);
		case B_UINT32_TYPE:
			return WriteInteger<uint32>(json, data, size);
		case B_INT64_TYPE:
			return WriteInteger<int64>(json, data, size);
		case B_UINT64_TYPE:
			return WriteInteger<uint64>(json, data, size);
		// These are as wide as the system that wrote them.
		case B_SSIZE_T_TYPE:
		case B_TIME_TYPE:
			return WriteInteger<int32>(json, data, size) || WriteInteger<int64>(json, data, size);
		case B_SIZE_T_TYPE:
			return WriteInteger<uint32>(json, data, size) || WriteInteger<uint64>(json, data, size);
		case B_FLOAT_TYPE:
			if (size != sizeof(float))
				return false;
			json.Float(Get<float>(data));
			return true;
		case B_DOUBLE_TYPE:
			if (size != sizeof(double))
				return false;
			json.Double(Get<double>(data));
			return true;
		case B_POINT_TYPE:
		case 'SIZE':
			return WriteFloats(json, data, size, 2);
		case B_RECT_TYPE:
			return WriteFloats(json, data, size, 4);
		case B_RGB_COLOR_TYPE:
		case B_RGB_32_BIT_TYPE:
			return WriteColor(json, data, size);
		case B_STRING_TYPE:
			return WriteString(json, data, size);
		default:
			return false;
	}
}


void
WriteField(JsonWriter& json, const BMessage& message, int32 field)
{
	char* name;
	type_code type;
	int32 count;
	if (message.GetInfo(B_ANY_TYPE, field, &name, &type, &count) != B_OK)
		return;
	json.OpenObject();
	json.Name("name");
	json.Text(name);
	json.Name("type");
	json.String(TypeText(type));
	json.Name("values");
	json.OpenArray(type != B_MESSAGE_TYPE);
	for (int32 i = 0; i < count; i++)
		WriteFieldValue(json, message, field, type, i);
	json.CloseArray();
	json.CloseObject();
}

} // namespace


void
WriteMessage(JsonWriter& json, const BMessage& message)
{
	json.OpenObject();
	json.Name("what");
	json.Unsigned(message.what);
	if (IsPrintable(message.what)) {
		json.Name("code");
		json.String(TypeText(message.what));
	}
	json.Name("fields");
	json.OpenArray();
	for (int32 i = 0; i < message.CountNames(B_ANY_TYPE); i++)
		WriteField(json, message, i);
	json.CloseArray();
	json.CloseObject();
}


void
WriteFieldValue(JsonWriter& json, const BMessage& message, int32 field, type_code type, int32 index)
{
	BMessage nested;
	if (find_field_message(message, field, index, &nested) == B_OK) {
		WriteMessage(json, nested);
		return;
	}
	const void* data = NULL;
	ssize_t size = 0;
	if (find_field_data(message, field, index, &data, &size) != B_OK)
		size = 0;
	if (!WriteTyped(json, type, data, size))
		json.Hex(data, size);
}


void
WriteValue(JsonWriter& json, type_code type, const void* data, size_t size)
{
	BMessage nested;
	if (type == B_MESSAGE_TYPE && IsMessage(data, size, &nested))
		WriteMessage(json, nested);
	else if (!WriteTyped(json, type, data, size))
		json.Hex(data, size);
}

} // namespace Arcv
