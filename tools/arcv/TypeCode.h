// Type codes as text, and the names of items on the command line.
#pragma once

#include <string>
#include <string_view>

#include <SupportDefs.h>

namespace Arcv {

// Whether all four bytes are printable ASCII.
bool IsPrintable(type_code code);

// The four characters, or "0x%08x".
std::string TypeText(type_code code);

// Four characters, or a number. False for anything else.
bool ParseType(std::string_view text, type_code* _type);

struct ItemKey {
	type_code type;
	int32 id;
};

// "TYPE:ID"; in the type, which may hold a colon itself, the last colon counts.
bool ParseItemKey(std::string_view text, ItemKey* _key);
std::string ItemText(type_code type, int32 id);

// The bytes as hexadecimal digits.
std::string HexText(const void* data, size_t size);

bool IsUtf8(std::string_view text);

} // namespace Arcv
