#include "support/private/Utf8.h"

namespace BPrivate {

namespace {

bool
is_continuation(char byte)
{
	return (static_cast<unsigned char>(byte) & 0xc0) == 0x80;
}


// Bytes that a character with this first byte has; 0 when no character begins with it.
int32
length_from_first(unsigned char first)
{
	if (first < 0x80)
		return 1;
	if (first >= 0xc2 && first <= 0xdf)
		return 2;
	if (first >= 0xe0 && first <= 0xef)
		return 3;
	if (first >= 0xf0 && first <= 0xf4)
		return 4;
	return 0;
}


// Decodes a whole character, or returns false for bytes that are none: too long an encoding, half
// of a surrogate pair, beyond the last code point.
bool
decode(const char* text, int32 length, uint32* _codePoint, int32* _bytes)
{
	const auto first = static_cast<unsigned char>(text[0]);
	const int32 bytes = length_from_first(first);
	if (bytes == 0 || bytes > length)
		return false;

	static constexpr unsigned char kFirstBits[] = { 0, 0x7f, 0x1f, 0x0f, 0x07 };
	static constexpr uint32 kLeast[] = { 0, 0, 0x80, 0x800, 0x10000 };
	uint32 codePoint = first & kFirstBits[bytes];
	for (int32 i = 1; i < bytes; i++) {
		if (!is_continuation(text[i]))
			return false;
		codePoint = (codePoint << 6) | (static_cast<unsigned char>(text[i]) & 0x3f);
	}
	if (codePoint < kLeast[bytes] || codePoint > 0x10ffff
		|| (codePoint >= 0xd800 && codePoint <= 0xdfff))
		return false;
	*_codePoint = codePoint;
	*_bytes = bytes;
	return true;
}

} // namespace


int32
utf8_char_length(const char* text, int32 length)
{
	if (length <= 0)
		return 0;
	uint32 codePoint;
	int32 bytes;
	return decode(text, length, &codePoint, &bytes) ? bytes : 1;
}


int32
utf8_previous_char_length(const char* text, int32 offset)
{
	for (int32 bytes = 1; bytes <= 4 && bytes <= offset; bytes++) {
		if (!is_continuation(text[offset - bytes]))
			return utf8_char_length(text + offset - bytes, bytes) == bytes ? bytes : 1;
	}
	return offset > 0 ? 1 : 0;
}


int32
utf8_count_chars(const char* text, int32 length)
{
	int32 count = 0;
	for (int32 offset = 0; offset < length; count++)
		offset += utf8_char_length(text + offset, length - offset);
	return count;
}


bool
utf8_is_valid(const char* text, int32 length)
{
	uint32 codePoint;
	int32 bytes;
	for (int32 offset = 0; offset < length; offset += bytes) {
		if (!decode(text + offset, length - offset, &codePoint, &bytes))
			return false;
	}
	return true;
}


uint32
utf8_next_code_point(const char** text, const char* end)
{
	uint32 codePoint = 0xfffd;
	int32 bytes = 1;
	const ptrdiff_t left = end - *text;
	if (left <= 0)
		return 0;
	if (!decode(*text, static_cast<int32>(min_c(left, 4)), &codePoint, &bytes)) {
		codePoint = 0xfffd;
		bytes = 1;
	}
	*text += bytes;
	return codePoint;
}


int32
utf8_encode(uint32 codePoint, char* buffer)
{
	if (codePoint > 0x10ffff || (codePoint >= 0xd800 && codePoint <= 0xdfff))
		codePoint = 0xfffd;
	if (codePoint < 0x80) {
		buffer[0] = char(codePoint);
		return 1;
	}
	if (codePoint < 0x800) {
		buffer[0] = char(0xc0 | (codePoint >> 6));
		buffer[1] = char(0x80 | (codePoint & 0x3f));
		return 2;
	}
	if (codePoint < 0x10000) {
		buffer[0] = char(0xe0 | (codePoint >> 12));
		buffer[1] = char(0x80 | ((codePoint >> 6) & 0x3f));
		buffer[2] = char(0x80 | (codePoint & 0x3f));
		return 3;
	}
	buffer[0] = char(0xf0 | (codePoint >> 18));
	buffer[1] = char(0x80 | ((codePoint >> 12) & 0x3f));
	buffer[2] = char(0x80 | ((codePoint >> 6) & 0x3f));
	buffer[3] = char(0x80 | (codePoint & 0x3f));
	return 4;
}


} // namespace BPrivate
