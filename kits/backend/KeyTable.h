// KeyTable: the keys of the keyboard by name, character and code.
#pragma once

#include <string>
#include <string_view>

#include <SupportDefs.h>

namespace BPrivate {


// What pressing a key does on the American layout.
struct KeyStroke {
	int32 key = 0; // the platform's code; 0 when the keyboard has no such key
	std::string text; // what it types; empty for a key that types nothing
	int32 rawCharacter = 0; // without modifiers
	bool shift = false; // whether it takes Shift to type this
};

// A name of the play language ("Return", "Left", "F1", ...); false when there is no such key.
bool stroke_of_name(std::string_view name, KeyStroke* _stroke);
// One character, UTF-8; '\n' is Return, '\t' Tab. Any character can be typed.
KeyStroke stroke_of_character(std::string_view character);
// The platform's code for a key of an X keyboard, by its key code; 0 when unknown.
int32 key_of_scan_code(uint32 scanCode);
// What a special key types, by the platform's key code; 0 when it types what the layout says.
char special_character(int32 key);

// The bytes of the first character, 0 at the end.
size_t character_length(std::string_view utf8);
// Bits of one of the modifier names Shift, Control, Command, Option; 0 when it is none.
uint32 modifier_of_name(std::string_view name);
// Adds what comes with a bit: its left-hand bit, and Command with Control.
uint32 complete_modifiers(uint32 modifiers);


} // namespace BPrivate
