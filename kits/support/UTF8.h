// Conversion between UTF-8 and other encodings.
#pragma once

#include <SupportDefs.h>

enum {
	B_ISO1_CONVERSION,
	B_ISO2_CONVERSION,
	B_ISO3_CONVERSION,
	B_ISO4_CONVERSION,
	B_ISO5_CONVERSION,
	B_ISO6_CONVERSION,
	B_ISO7_CONVERSION,
	B_ISO8_CONVERSION,
	B_ISO9_CONVERSION,
	B_ISO10_CONVERSION,
	B_MAC_ROMAN_CONVERSION,
	B_SJIS_CONVERSION,
	B_EUC_CONVERSION,
	B_JIS_CONVERSION,
	B_MS_WINDOWS_CONVERSION,
	B_UNICODE_CONVERSION, // two bytes a character, big-endian
	B_KOI8R_CONVERSION,
	B_MS_WINDOWS_1251_CONVERSION,
	B_MS_DOS_866_CONVERSION,
	B_MS_DOS_CONVERSION,
	B_EUC_KR_CONVERSION,
};

#define B_SUBSTITUTE_CHARACTER '?'

// The lengths are in bytes: on entry the source's length and the room, on return what was used of
// each. Stops before a character that no longer fits or is cut short. The state starts at 0.
// B_ERROR for an unknown encoding.
status_t convert_to_utf8(uint32 sourceEncoding, const char* source, int32* sourceLength,
	char* destination, int32* destinationLength, int32* state,
	char substitute = B_SUBSTITUTE_CHARACTER);
status_t convert_from_utf8(uint32 destinationEncoding, const char* source, int32* sourceLength,
	char* destination, int32* destinationLength, int32* state,
	char substitute = B_SUBSTITUTE_CHARACTER);
