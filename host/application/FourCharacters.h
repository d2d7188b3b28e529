// Type codes as text.
#pragma once

#include <string>

#include <SupportDefs.h>

// The four characters, most significant byte first, or "0x%08x" when they are not all printable.
std::string FourCharacters(type_code code);

// The reverse; also takes fewer characters, filled up with blanks. False for anything else.
bool ParseFourCharacters(const std::string& text, type_code* _code);
