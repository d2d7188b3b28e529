// Walking over UTF-8 text of which no byte can be trusted.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

// Bytes of the character at the start of the text, between 1 and length; a byte that begins no
// whole character counts as one character of its own. 0 when the length is 0.
int32 utf8_char_length(const char* text, int32 length);
// Bytes of the character that ends before the offset, by the same reckoning.
int32 utf8_previous_char_length(const char* text, int32 offset);
int32 utf8_count_chars(const char* text, int32 length);
bool utf8_is_valid(const char* text, int32 length);
// The code point of the character at the start, 0xfffd when it is not valid; moves *text behind it.
uint32 utf8_next_code_point(const char** text, const char* end);
// Writes at most four bytes without a NUL and returns how many.
int32 utf8_encode(uint32 codePoint, char* buffer);

} // namespace BPrivate
