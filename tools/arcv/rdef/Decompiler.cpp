#include "tools/arcv/rdef/Decompiler.h"

#include <math.h>
#include <stdio.h>
#include <string.h>

#include <algorithm>
#include <set>

#include <MessageForm.h>
#include <TypeConstants.h>

#include "tools/arcv/Json.h"
#include "tools/arcv/TypeCode.h"
#include "tools/arcv/rdef/Types.h"

namespace Arcv {

namespace {

constexpr size_t kRawLine = 32; // bytes
constexpr size_t kStringLine = 64;


// The text has one field for each name. A message with several of one name, which no program makes,
// is written as the bytes that it is.
bool
HasTwinFields(const BMessage& message)
{
	for (int32 i = 0; i < message.CountNames(B_ANY_TYPE); i++) {
		if (!is_first_of_its_name(message, i))
			return true;
	}
	return false;
}


std::string
Tabs(int32 depth)
{
	return std::string(depth, '\t');
}


std::string
Quoted(std::string_view text)
{
	const bool utf8 = IsUtf8(text);
	std::string quoted = "\"";
	for (const char character : text) {
		static const char kEscaped[] = "\b\f\n\r\t\v\"\\";
		static const char kLetters[] = "bfnrtv\"\\";
		const uint8 byte = character;
		const char* escape = byte != 0 ? strchr(kEscaped, character) : NULL;
		if (escape != NULL) {
			quoted += '\\';
			quoted += kLetters[escape - kEscaped];
		} else if (byte < 0x20 || byte == 0x7f || (byte >= 0x80 && !utf8)) {
			char hex[8];
			snprintf(hex, sizeof(hex), "\\0x%02X", byte);
			quoted += hex;
		} else
			quoted += character;
	}
	return quoted + '"';
}


std::string
CodeText(type_code code)
{
	const std::string text = TypeText(code);
	if (IsPrintable(code) && text.find_first_of("'\\") == std::string::npos)
		return "'" + text + "'";
	return std::to_string(code);
}


std::string
RawText(const char* bytes, size_t size, int32 depth)
{
	if (size <= kRawLine)
		return "$\"" + HexText(bytes, size) + "\"";
	std::string text = "array {\n";
	for (size_t start = 0; start < size; start += kRawLine)
		text += Tabs(depth + 1) + "$\"" + HexText(bytes + start, std::min(kRawLine, size - start))
			+ "\"\n";
	return text + Tabs(depth) + "}";
}


// Long strings go on in the next line, best behind the end of one of their own lines.
std::string
StringText(std::string_view text, int32 depth)
{
	if (text.size() <= kStringLine)
		return Quoted(text);
	std::string lines;
	while (!text.empty()) {
		size_t length = std::min(text.size(), kStringLine);
		const size_t newline = text.substr(0, length).rfind('\n');
		if (newline != std::string_view::npos && length < text.size())
			length = newline + 1;
		// A character's bytes stay together, so that the text stays text.
		while (length > 1 && length < text.size() && (text[length] & 0xc0) == 0x80)
			length--;
		lines += "\n" + Tabs(depth + 1) + Quoted(text.substr(0, length));
		text.remove_prefix(length);
	}
	return lines;
}


// A class that can stand behind "archive".
bool
IsClassName(std::string_view name)
{
	static const std::set<std::string_view> kKeywords = { "resource", "array", "message", "archive",
		"enum", "type", "import", "true", "false" };
	if (name.empty() || isdigit(static_cast<uint8>(name[0])) || kKeywords.count(name) != 0)
		return false;
	return std::all_of(name.begin(), name.end(), [](char character) {
		const uint8 byte = character;
		return byte < 0x80 && (isalnum(byte) || character == '_');
	});
}


class MessageWriter {
public:
	explicit MessageWriter(const BMessage& message, int32 depth) : fMessage(message), fDepth(depth)
	{
	}

	std::string Text()
	{
		_FindClass();
		std::string text = _Head();
		char* name;
		type_code type;
		int32 count;
		std::string fields;
		for (int32 i = 0; fMessage.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++)
			_AddField(i, name, type, count);
		if (!fText.empty())
			return text + " {\n" + fText + "\n" + Tabs(fDepth) + "}";
		// An archive needs a field; this one is dropped.
		return fClass.empty() ? text : text + " { \"\" = $\"\" }";
	}

private:
	// The class goes into the head when the compiler can put it back where it is.
	void _FindClass()
	{
		type_code type;
		int32 count;
		const void* data;
		ssize_t size;
		if (fMessage.GetInfo("class", &type, &count) != B_OK || type != B_STRING_TYPE
			|| fMessage.FindData("class", type, count - 1, &data, &size) != B_OK || size < 2
			|| static_cast<const char*>(data)[size - 1] != '\0')
			return;
		const std::string name(static_cast<const char*>(data), size - 1);
		if (!IsClassName(name))
			return;
		// Of several, the first ones stay fields and the head adds the last.
		fClass = name;
		fClassCount = count;
	}

	std::string _Head() const
	{
		const std::string what = fMessage.what == 0 ? ""
			: IsPrintable(fMessage.what)            ? CodeText(fMessage.what)
													: std::to_string(fMessage.what);
		if (fClass.empty())
			return what.empty() ? "message" : "message(" + what + ")";
		return (what.empty() ? "archive " : "archive(, " + what + ") ") + fClass;
	}

	void _AddField(int32 index, const char* name, type_code type, int32 count)
	{
		const bool isClass = !fClass.empty() && strcmp(name, "class") == 0;
		const int32 fieldCount = fMessage.CountNames(B_ANY_TYPE);
		if (isClass && count == 1) {
			// At the end it comes by itself.
			if (index < fieldCount - 1)
				fPending = "/*class*/ ";
			return;
		}
		for (int32 i = 0; i < (isClass ? count - 1 : count); i++) {
			const void* data;
			ssize_t size;
			if (fMessage.FindData(name, type, i, &data, &size) == B_OK)
				_AddItem(name, type, i, static_cast<const char*>(data), size);
		}
	}

	void _AddItem(const char* name, type_code type, int32 index, const char* data, size_t size)
	{
		if (!fText.empty())
			fText += ",\n";
		fText += Tabs(fDepth + 1) + fPending;
		fPending.clear();

		std::string code;
		std::string value;
		BMessage nested;
		if (type == B_MESSAGE_TYPE && fMessage.FindMessage(name, index, &nested) == B_OK
			&& !HasTwinFields(nested))
			value = MessageWriter(nested, fDepth + 1).Text();
		else
			value = ValueText(type, data, size, fDepth + 1, &code);
		fText += (code.empty() ? "" : "#" + code + " ") + Quoted(name) + " = " + value;
	}

public:
	// The text of a value, and the code that has to stand in front of it, if any.
	static std::string ValueText(
		type_code type, const char* data, size_t size, int32 depth, std::string* _code)
	{
		std::string text;
		if (_Number(type, data, size, &text) || _Floats(type, data, size, &text)
			|| _Color(type, data, size, &text))
			*_code = type == B_RGB_32_BIT_TYPE ? CodeText(type) : "";
		else if (_IsString(type, data, size)) {
			text = StringText(std::string_view(data, size - 1), depth);
			*_code = type == B_STRING_TYPE ? "" : CodeText(type);
		} else {
			text = RawText(data, size, depth);
			*_code = type == B_RAW_TYPE ? "" : CodeText(type);
		}
		return text;
	}

private:
	template<typename Number> static Number _Get(const char* data)
	{
		Number number;
		memcpy(&number, data, sizeof(Number));
		return number;
	}

	static bool _Number(type_code type, const char* data, size_t size, std::string* _text)
	{
		if (type == B_BOOL_TYPE && size == 1 && static_cast<uint8>(data[0]) <= 1) {
			*_text = data[0] != 0 ? "true" : "false";
			return true;
		}
		const RdefType* number = FindNumberType(type);
		if (number == nullptr || number->size != size)
			return false;
		if (type == B_FLOAT_TYPE) {
			const float value = _Get<float>(data);
			*_text = FloatText(value);
			return isfinite(value);
		}
		if (type == B_DOUBLE_TYPE) {
			const double value = _Get<double>(data);
			*_text = "(double)" + DoubleText(value);
			return isfinite(value);
		}
		const bool isSigned = type == B_INT8_TYPE || type == B_INT16_TYPE || type == B_INT32_TYPE
			|| type == B_INT64_TYPE || type == B_SSIZE_T_TYPE || type == B_TIME_TYPE
			|| type == B_OFF_T_TYPE;
		*_text = type == B_INT32_TYPE ? "" : "(" + number->name + ")";
		*_text += _Integer(data, size, isSigned);
		return true;
	}

	static std::string _Integer(const char* data, size_t size, bool isSigned)
	{
		switch (size) {
			case 1:
				return isSigned ? std::to_string(_Get<int8>(data))
								: std::to_string(_Get<uint8>(data));
			case 2:
				return isSigned ? std::to_string(_Get<int16>(data))
								: std::to_string(_Get<uint16>(data));
			case 4:
				return isSigned ? std::to_string(_Get<int32>(data))
								: std::to_string(_Get<uint32>(data));
			default:
				return isSigned ? std::to_string(_Get<int64>(data))
								: std::to_string(_Get<uint64>(data));
		}
	}

	static bool _Floats(type_code type, const char* data, size_t size, std::string* _text)
	{
		const size_t count = type == B_POINT_TYPE ? 2 : type == B_RECT_TYPE ? 4 : 0;
		if (count == 0 || size != count * sizeof(float))
			return false;
		*_text = type == B_POINT_TYPE ? "point {" : "rect {";
		for (size_t i = 0; i < count; i++) {
			const float value = _Get<float>(data + i * sizeof(float));
			if (!isfinite(value))
				return false;
			*_text += (i > 0 ? ", " : " ") + FloatText(value);
		}
		*_text += " }";
		return true;
	}

	static bool _Color(type_code type, const char* data, size_t size, std::string* _text)
	{
		if ((type != B_RGB_COLOR_TYPE && type != B_RGB_32_BIT_TYPE) || size != 4)
			return false;
		char text[64];
		const auto byte = [&](size_t i) { return static_cast<uint8>(data[i]); };
		snprintf(text, sizeof(text), "rgb_color { 0x%02X, 0x%02X, 0x%02X, 0x%02X }", byte(0),
			byte(1), byte(2), byte(3));
		*_text = text;
		return true;
	}

	// Of other types only what is certainly text.
	static bool _IsString(type_code type, const char* data, size_t size)
	{
		if (size == 0 || data[size - 1] != '\0')
			return false;
		if (type == B_STRING_TYPE)
			return true;
		if (type == B_RAW_TYPE || type == B_POINTER_TYPE || type == B_MESSAGE_TYPE || size < 2
			|| FindNumberType(type) != nullptr)
			return false;
		return std::all_of(data, data + size - 1,
			[](char character) { return character >= 0x20 && character < 0x7f; });
	}

	const BMessage& fMessage;
	const int32 fDepth;
	std::string fClass; // empty for a message
	int32 fClassCount = 0;
	std::string fText; // of the fields
	std::string fPending; // a mark in front of the next field
};


bool
ReadWholeMessage(const void* data, size_t size, BMessage* _message)
{
	message_form_info info;
	size_t used = 0;
	return get_message_form(data, size, &info) == B_OK
		&& unflatten_message(_message, data, size, NULL, &used) == B_OK && used == size
		&& !HasTwinFields(*_message);
}

} // namespace


std::string
ResourceText(type_code type, int32 id, const std::string& name, const void* data, size_t size)
{
	std::string code;
	std::string value;
	BMessage message;
	if (ReadWholeMessage(data, size, &message)) {
		value = MessageWriter(message, 0).Text();
		code = type == B_MESSAGE_TYPE ? "" : CodeText(type);
	} else
		value = MessageWriter::ValueText(type, static_cast<const char*>(data), size, 0, &code);
	const std::string head = name.empty() ? "" : ", " + Quoted(name);
	return "\nresource(" + std::to_string(id) + head + ") " + (code.empty() ? "" : "#" + code + " ")
		+ value + ";\n";
}

} // namespace Arcv
