#include "host/application/FourCharacters.h"

#include <cstdio>
#include <cstdlib>


std::string
FourCharacters(type_code code)
{
	std::string text;
	for (int shift = 24; shift >= 0; shift -= 8) {
		const uint8 byte = static_cast<uint8>(code >> shift);
		if (byte < 0x20 || byte >= 0x7f) {
			char number[16];
			snprintf(number, sizeof(number), "0x%08x", static_cast<unsigned>(code));
			return number;
		}
		text += static_cast<char>(byte);
	}
	return text;
}


bool
ParseFourCharacters(const std::string& text, type_code* _code)
{
	constexpr size_t kLongestNumber = 10; // of 32 bits
	if (text.size() > 4 && text.size() <= kLongestNumber && text.compare(0, 2, "0x") == 0) {
		char* end;
		*_code = static_cast<type_code>(strtoul(text.c_str(), &end, 16));
		return *end == '\0';
	}
	if (text.empty() || text.size() > 4)
		return false;

	std::string padded = text;
	padded.resize(4, ' ');
	*_code = 0;
	for (char character : padded)
		*_code = *_code << 8 | static_cast<uint8>(character);
	return true;
}
