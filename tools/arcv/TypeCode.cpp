#include "tools/arcv/TypeCode.h"

#include <stdint.h>
#include <stdio.h>

#include <charconv>

namespace Arcv {

namespace {

template<typename Number>
bool
ParseNumber(std::string_view text, Number* _number)
{
	int base = 10;
	if (text.size() > 2 && text[0] == '0' && (text[1] == 'x' || text[1] == 'X')) {
		base = 16;
		text.remove_prefix(2);
	}
	const char* end = text.data() + text.size();
	const auto [last, error] = std::from_chars(text.data(), end, *_number, base);
	return error == std::errc() && last == end && !text.empty();
}


// The length of the character that starts here; 0 when it is none.
size_t
Utf8Length(std::string_view text)
{
	const auto at = [&](size_t i) { return static_cast<uint8_t>(text[i]); };
	const uint8_t first = at(0);
	if (first < 0x80)
		return 1;
	size_t length = 0;
	uint32_t character = 0;
	if (first >= 0xc2 && first < 0xe0) {
		length = 2;
		character = first & 0x1f;
	} else if (first >= 0xe0 && first < 0xf0) {
		length = 3;
		character = first & 0x0f;
	} else if (first >= 0xf0 && first < 0xf5) {
		length = 4;
		character = first & 0x07;
	}
	if (length == 0 || text.size() < length)
		return 0;
	for (size_t i = 1; i < length; i++) {
		if ((at(i) & 0xc0) != 0x80)
			return 0;
		character = character << 6 | (at(i) & 0x3f);
	}
	const bool tooLong = (length == 3 && character < 0x800) || (length == 4 && character < 0x10000);
	const bool surrogate = character >= 0xd800 && character < 0xe000;
	return tooLong || surrogate || character > 0x10ffff ? 0 : length;
}

} // namespace


bool
IsPrintable(type_code code)
{
	for (int shift = 0; shift < 32; shift += 8) {
		const uint8_t byte = code >> shift;
		if (byte < 0x20 || byte > 0x7e)
			return false;
	}
	return true;
}


std::string
TypeText(type_code code)
{
	char text[16];
	if (IsPrintable(code))
		snprintf(text, sizeof(text), "%c%c%c%c", code >> 24, (code >> 16) & 0xff,
			(code >> 8) & 0xff, code & 0xff);
	else
		snprintf(text, sizeof(text), "0x%08x", code);
	return text;
}


bool
ParseType(std::string_view text, type_code* _type)
{
	if (text.size() == 4) {
		type_code type = 0;
		for (const char character : text)
			type = type << 8 | static_cast<uint8_t>(character);
		*_type = type;
		return true;
	}
	return ParseNumber(text, _type);
}


bool
ParseItemKey(std::string_view text, ItemKey* _key)
{
	const size_t colon = text.rfind(':');
	return colon != std::string_view::npos && ParseType(text.substr(0, colon), &_key->type)
		&& ParseNumber(text.substr(colon + 1), &_key->id);
}


std::string
ItemText(type_code type, int32 id)
{
	return TypeText(type) + ":" + std::to_string(id);
}


std::string
HexText(const void* data, size_t size)
{
	static const char kDigits[] = "0123456789abcdef";
	std::string text;
	text.reserve(2 * size);
	const uint8_t* bytes = static_cast<const uint8_t*>(data);
	for (size_t i = 0; i < size; i++) {
		text += kDigits[bytes[i] >> 4];
		text += kDigits[bytes[i] & 15];
	}
	return text;
}


bool
IsUtf8(std::string_view text)
{
	while (!text.empty()) {
		const size_t length = Utf8Length(text);
		if (length == 0)
			return false;
		text.remove_prefix(length);
	}
	return true;
}

} // namespace Arcv
