#include "kits/server/DesktopFixture.h"

#include <InterfaceDefs.h>
#include <TypeConstants.h>

namespace BPrivate {

using KeyboardInput = DesktopTest;

namespace {

KeyStroke
Stroke(const char* name)
{
	KeyStroke stroke;
	EXPECT_TRUE(stroke_of_name(name, &stroke)) << name;
	return stroke;
}

} // namespace


TEST_F(KeyboardInput, KeyGoesToTheActiveWindowWithAllItsFields)
{
	TestWindow other(BRect(0, 0, 99, 99)), window(BRect(200, 0, 299, 99));
	Settle();
	window.Take();
	input.KeyDown(Stroke("A"));
	Settle();

	EXPECT_TRUE(other.Take(B_KEY_DOWN).empty());
	const Messages keys = window.Take(B_KEY_DOWN);
	ASSERT_EQ(1u, keys.size());
	const BMessage& key = *keys[0];
	EXPECT_STREQ("A", key.FindString("bytes"));
	EXPECT_EQ('A', key.FindInt8("byte"));
	EXPECT_EQ('a', key.FindInt32("raw_char"));
	EXPECT_EQ(0x3c, key.FindInt32("key"));
	EXPECT_EQ(B_SHIFT_KEY | B_LEFT_SHIFT_KEY, key.FindInt32("modifiers"));
	EXPECT_FALSE(key.HasInt32("be:key_repeat"));
	EXPECT_GT(key.FindInt64("when"), 0);
	int32 count = 0;
	type_code type;
	ASSERT_EQ(B_OK, key.GetInfo("states", &type, &count));
	EXPECT_EQ(16, count);
	EXPECT_EQ(0x80 >> (0x3c % 8), key.GetUInt8("states", 0x3c / 8, 0));
}


TEST_F(KeyboardInput, LongCharacterHasThreeBytesAndItsText)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.KeyDown(stroke_of_character("\xf0\x9f\x98\x80"));
	Settle();
	const Messages keys = window.Take(B_KEY_DOWN);
	ASSERT_EQ(1u, keys.size());
	EXPECT_STREQ("\xf0\x9f\x98\x80", keys[0]->FindString("bytes"));
	int32 count = 0;
	type_code type;
	EXPECT_EQ(B_OK, keys[0]->GetInfo("byte", &type, &count));
	EXPECT_EQ(3, count);
}


TEST_F(KeyboardInput, RepeatsAreNumbered)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.KeyDown(Stroke("Left"), 0);
	input.KeyDown(Stroke("Left"), 1);
	Settle();
	const Messages keys = window.Take(B_KEY_DOWN);
	ASSERT_EQ(2u, keys.size());
	EXPECT_FALSE(keys[0]->HasInt32("be:key_repeat"));
	EXPECT_EQ(1, keys[1]->FindInt32("be:key_repeat"));
	EXPECT_EQ(B_LEFT_ARROW, keys[0]->FindInt8("byte"));
}


TEST_F(KeyboardInput, KeyWithoutCharacterIsUnmapped)
{
	TestWindow window(BRect(0, 0, 99, 99));
	Settle();
	window.Take();
	input.KeyDown(Stroke("Menu"));
	input.KeyUp(Stroke("Menu"));
	Settle();
	const Messages keys = window.Take();
	ASSERT_EQ(2u, keys.size());
	EXPECT_EQ(uint32(B_UNMAPPED_KEY_DOWN), keys[0]->what);
	EXPECT_EQ(uint32(B_UNMAPPED_KEY_UP), keys[1]->what);
	EXPECT_FALSE(keys[0]->HasString("bytes"));
}


TEST_F(KeyboardInput, ControlIsCommandAsWell)
{
	TestWindow window(BRect(0, 0, 99, 99));
	Settle();
	window.Take();
	input.SetModifiers(B_CONTROL_KEY);
	Settle();
	const int32 both = B_CONTROL_KEY | B_COMMAND_KEY | B_LEFT_CONTROL_KEY | B_LEFT_COMMAND_KEY;
	EXPECT_EQ(uint32(both), Desktop::Get()->Modifiers());
	Messages changes = window.Take(B_MODIFIERS_CHANGED);
	ASSERT_EQ(1u, changes.size());
	EXPECT_EQ(both, changes[0]->FindInt32("modifiers"));
	EXPECT_EQ(0, changes[0]->FindInt32("be:old_modifiers"));

	input.SetModifiers(0);
	Settle();
	changes = window.Take(B_MODIFIERS_CHANGED);
	ASSERT_EQ(1u, changes.size());
	EXPECT_EQ(both, changes[0]->FindInt32("be:old_modifiers"));
	EXPECT_EQ(0u, Desktop::Get()->Modifiers());
}


TEST_F(KeyboardInput, HeldKeysAreReadable)
{
	TestWindow window(BRect(0, 0, 99, 99));
	input.KeyDown(Stroke("Space"));
	Settle();
	uint8 states[16];
	Desktop::Get()->GetKeyStates(states);
	EXPECT_EQ(0x80 >> (0x5e % 8), states[0x5e / 8]);
	input.KeyUp(Stroke("Space"));
	Settle();
	Desktop::Get()->GetKeyStates(states);
	EXPECT_EQ(0, states[0x5e / 8]);
}


TEST_F(KeyboardInput, TextOfAnInputMethodComesCharacterByCharacter)
{
	TestWindow window(BRect(0, 0, 99, 99));
	BackendEvent event;
	event.type = BackendEvent::Type::TextEntered;
	event.text = "\xe6\x97\xa5\xe6\x9c\xac";
	Desktop::Get()->Inject(event);
	Settle();
	const Messages keys = window.Take(B_KEY_DOWN);
	ASSERT_EQ(2u, keys.size());
	EXPECT_STREQ("\xe6\x97\xa5", keys[0]->FindString("bytes"));
	EXPECT_STREQ("\xe6\x9c\xac", keys[1]->FindString("bytes"));
}


TEST_F(KeyboardInput, CompositionIsToldFromStartToEnd)
{
	TestWindow window(BRect(0, 0, 99, 99));
	for (const char* text : { "k", "ka", "" }) {
		BackendEvent event;
		event.type = BackendEvent::Type::TextComposed;
		event.text = text;
		Desktop::Get()->Inject(event);
	}
	Settle();
	std::vector<int32> opcodes;
	for (const std::unique_ptr<BMessage>& message : window.Take(B_INPUT_METHOD_EVENT))
		opcodes.push_back(message->FindInt32("be:opcode"));
	EXPECT_EQ((std::vector<int32> { 0, 2, 2, 2, 1 }), opcodes);
}


TEST(KeyTable, EveryPrintableCharacterHasAKey)
{
	for (char character = ' '; character <= '~'; character++) {
		const KeyStroke stroke = stroke_of_character(std::string(1, character));
		EXPECT_NE(0, stroke.key) << character;
		EXPECT_EQ(std::string(1, character), stroke.text);
	}
	EXPECT_EQ(0, stroke_of_character("\xc3\xa9").key);
}


TEST(KeyTable, KeysOfAKeyboardHaveTheirCodes)
{
	EXPECT_EQ(0x01, key_of_scan_code(9)); // Escape
	EXPECT_EQ(0x3c, key_of_scan_code(38)); // A
	EXPECT_EQ(0x5e, key_of_scan_code(65)); // Space
	EXPECT_EQ(0x0d, key_of_scan_code(96)); // F12
	EXPECT_EQ(0x34, key_of_scan_code(119)); // Delete
	EXPECT_EQ(0x68, key_of_scan_code(135)); // Menu
	EXPECT_EQ(0, key_of_scan_code(0));
	EXPECT_EQ(0, key_of_scan_code(1000));
}


TEST(KeyTable, ThereIsNoKeyOfAnUnknownName)
{
	KeyStroke stroke;
	EXPECT_FALSE(stroke_of_name("Retrun", &stroke));
	EXPECT_FALSE(stroke_of_name("", &stroke));
}


} // namespace BPrivate
