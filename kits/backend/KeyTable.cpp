#include "backend/KeyTable.h"

#include <cstring>
#include <strings.h>

#include <InterfaceDefs.h>

namespace BPrivate {

namespace {

struct SpecialKey {
	const char* name;
	int32 key;
	char character;
};

constexpr SpecialKey kSpecialKeys[] = {
	{ "Return", 0x47, B_RETURN },
	{ "Enter", 0x5b, B_ENTER },
	{ "Tab", 0x26, B_TAB },
	{ "Escape", 0x01, B_ESCAPE },
	{ "Space", 0x5e, B_SPACE },
	{ "Backspace", 0x1e, B_BACKSPACE },
	{ "Delete", 0x34, B_DELETE },
	{ "Insert", 0x1f, B_INSERT },
	{ "Left", 0x61, B_LEFT_ARROW },
	{ "Right", 0x63, B_RIGHT_ARROW },
	{ "Up", 0x57, B_UP_ARROW },
	{ "Down", 0x62, B_DOWN_ARROW },
	{ "Home", 0x20, B_HOME },
	{ "End", 0x35, B_END },
	{ "PageUp", 0x21, B_PAGE_UP },
	{ "PageDown", 0x36, B_PAGE_DOWN },
	{ "F1", 0x02, B_FUNCTION_KEY },
	{ "F2", 0x03, B_FUNCTION_KEY },
	{ "F3", 0x04, B_FUNCTION_KEY },
	{ "F4", 0x05, B_FUNCTION_KEY },
	{ "F5", 0x06, B_FUNCTION_KEY },
	{ "F6", 0x07, B_FUNCTION_KEY },
	{ "F7", 0x08, B_FUNCTION_KEY },
	{ "F8", 0x09, B_FUNCTION_KEY },
	{ "F9", 0x0a, B_FUNCTION_KEY },
	{ "F10", 0x0b, B_FUNCTION_KEY },
	{ "F11", 0x0c, B_FUNCTION_KEY },
	{ "F12", 0x0d, B_FUNCTION_KEY },
	{ "Print", B_PRINT_KEY, B_FUNCTION_KEY },
	{ "Scroll", B_SCROLL_KEY, B_FUNCTION_KEY },
	{ "Pause", B_PAUSE_KEY, B_FUNCTION_KEY },
	{ "Menu", 0x68, 0 },
};

// A row of keys from left to right: the code of the first, and what they type.
struct KeyRow {
	int32 first;
	const char* plain;
	const char* shifted;
};

constexpr KeyRow kRows[] = {
	{ 0x11, "`1234567890-=", "~!@#$%^&*()_+" },
	{ 0x27, "qwertyuiop[]\\", "QWERTYUIOP{}|" },
	{ 0x3c, "asdfghjkl;'", "ASDFGHJKL:\"" },
	{ 0x4c, "zxcvbnm,./", "ZXCVBNM<>?" },
};

// By X key code, which is the kernel's plus 8.
constexpr uint8 kScanCodes[] = {
	0x01, // 9: Escape
	0x12, 0x13, 0x14, 0x15, 0x16, 0x17, 0x18, 0x19, 0x1a, 0x1b, 0x1c, 0x1d,
	0x1e, // 10: 1 to Backspace
	0x26, // 23: Tab
	0x27, 0x28, 0x29, 0x2a, 0x2b, 0x2c, 0x2d, 0x2e, 0x2f, 0x30, 0x31, 0x32, // 24: Q to ]
	0x47, // 36: Return
	0x5c, // 37: left Control
	0x3c, 0x3d, 0x3e, 0x3f, 0x40, 0x41, 0x42, 0x43, 0x44, 0x45, 0x46, // 38: A to '
	0x11, // 49: `
	0x4b, // 50: left Shift
	0x33, // 51: backslash
	0x4c, 0x4d, 0x4e, 0x4f, 0x50, 0x51, 0x52, 0x53, 0x54, 0x55, // 52: Z to /
	0x56, // 62: right Shift
	0x24, // 63: keypad *
	0x5d, // 64: left Alt
	0x5e, // 65: Space
	0x3b, // 66: Caps Lock
	0x02, 0x03, 0x04, 0x05, 0x06, 0x07, 0x08, 0x09, 0x0a, 0x0b, // 67: F1 to F10
	0x22, // 77: Num Lock
	0x0f, // 78: Scroll Lock
	0x37, 0x38, 0x39, 0x25, // 79: keypad 7 8 9 -
	0x48, 0x49, 0x4a, 0x3a, // 83: keypad 4 5 6 +
	0x58, 0x59, 0x5a, 0x64, 0x65, // 87: keypad 1 2 3 0 .
	0, 0, // 92
	0x69, // 94: the key between left Shift and Z
	0x0c, 0x0d, // 95: F11, F12
	0, 0, 0, 0, 0, 0, 0, // 97
	0x5b, // 104: keypad Enter
	0x60, // 105: right Control
	0x23, // 106: keypad /
	0x0e, // 107: Print
	0x5f, // 108: right Alt
	0, // 109
	0x20, 0x57, 0x21, 0x61, 0x63, 0x35, 0x62, 0x36, 0x1f, 0x34, // 110: Home to Delete
	0, 0, 0, 0, 0, 0, 0, // 120
	0x10, // 127: Pause
	0, 0, 0, 0, 0, // 128
	0x66, 0x67, 0x68, // 133: left and right system key, Menu
};
constexpr uint32 kFirstScanCode = 9;

struct ModifierName {
	const char* name;
	uint32 bit;
};

constexpr ModifierName kModifierNames[] = {
	{ "Shift", B_SHIFT_KEY },
	{ "Control", B_CONTROL_KEY },
	{ "Command", B_COMMAND_KEY },
	{ "Option", B_OPTION_KEY },
};

} // namespace


bool
stroke_of_name(std::string_view name, KeyStroke* _stroke)
{
	for (const SpecialKey& special : kSpecialKeys) {
		if (name != special.name)
			continue;
		*_stroke = KeyStroke();
		_stroke->key = special.key;
		if (special.character != 0)
			_stroke->text = special.character;
		_stroke->rawCharacter = special.character;
		return true;
	}
	if (name.empty() || character_length(name) != name.size())
		return false;
	*_stroke = stroke_of_character(name);
	return true;
}


KeyStroke
stroke_of_character(std::string_view character)
{
	KeyStroke stroke;
	if (character == "\n" || character == "\t" || character == " ") {
		stroke_of_name(character == "\n" ? "Return" : character == "\t" ? "Tab" : "Space", &stroke);
		return stroke;
	}

	stroke.text = character;
	if (character.size() != 1)
		return stroke;
	stroke.rawCharacter = static_cast<unsigned char>(character[0]);
	for (const KeyRow& row : kRows) {
		const char* plain = std::strchr(row.plain, character[0]);
		const char* shifted = std::strchr(row.shifted, character[0]);
		if (plain == nullptr && shifted == nullptr)
			continue;
		stroke.shift = plain == nullptr;
		const int32 index =
			static_cast<int32>(stroke.shift ? shifted - row.shifted : plain - row.plain);
		stroke.key = row.first + index;
		stroke.rawCharacter = static_cast<unsigned char>(row.plain[index]);
	}
	return stroke;
}


int32
key_of_scan_code(uint32 scanCode)
{
	if (scanCode < kFirstScanCode || scanCode - kFirstScanCode >= sizeof(kScanCodes))
		return 0;
	return kScanCodes[scanCode - kFirstScanCode];
}


char
special_character(int32 key)
{
	for (const SpecialKey& special : kSpecialKeys) {
		if (special.key == key)
			return special.character;
	}
	return 0;
}


size_t
character_length(std::string_view utf8)
{
	if (utf8.empty())
		return 0;
	const auto first = static_cast<unsigned char>(utf8[0]);
	const size_t length = first < 0xc0 ? 1 : first < 0xe0 ? 2 : first < 0xf0 ? 3 : 4;
	return length < utf8.size() ? length : utf8.size();
}


uint32
modifier_of_name(std::string_view name)
{
	for (const ModifierName& modifier : kModifierNames) {
		if (name == modifier.name)
			return modifier.bit;
	}
	return 0;
}


uint32
complete_modifiers(uint32 modifiers)
{
	if ((modifiers & (B_CONTROL_KEY | B_COMMAND_KEY)) != 0) {
		modifiers |= B_CONTROL_KEY | B_COMMAND_KEY;
		if ((modifiers & (B_RIGHT_CONTROL_KEY | B_RIGHT_COMMAND_KEY)) != 0)
			modifiers |= B_RIGHT_CONTROL_KEY | B_RIGHT_COMMAND_KEY;
		else
			modifiers |= B_LEFT_CONTROL_KEY | B_LEFT_COMMAND_KEY;
	}
	if ((modifiers & B_SHIFT_KEY) != 0 && (modifiers & B_RIGHT_SHIFT_KEY) == 0)
		modifiers |= B_LEFT_SHIFT_KEY;
	if ((modifiers & B_OPTION_KEY) != 0 && (modifiers & B_RIGHT_OPTION_KEY) == 0)
		modifiers |= B_LEFT_OPTION_KEY;
	return modifiers;
}


} // namespace BPrivate
