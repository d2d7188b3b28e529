#include "server/paint/TextOrder.h"

#include <string>

#include <gtest/gtest.h>

#include "server/paint/FontEngine.h"

namespace BPrivate {

namespace {

std::vector<uint32>
CharactersOf(std::string_view text)
{
	std::vector<uint32> characters;
	for (size_t at = 0; at < text.size();)
		characters.push_back(NextCharacter(text, &at));
	return characters;
}


bool
HasAll(uint32)
{
	return true;
}


bool
HasNone(uint32)
{
	return false;
}


std::vector<uint32>
Ordered(const std::vector<uint32>& text, bool (*hasForm)(uint32))
{
	std::vector<uint32> drawn;
	for (const OrderedCharacter& ordered : InDrawingOrder(text, hasForm))
		drawn.push_back(ordered.character);
	return drawn;
}


std::vector<uint32>
Ordered(std::string_view text)
{
	return Ordered(CharactersOf(text), HasNone);
}

} // namespace


TEST(TextOrder, OnlyScriptsFromTheRightNeedIt)
{
	EXPECT_FALSE(RunsFromTheRight(""));
	EXPECT_FALSE(RunsFromTheRight("plain (text) 12"));
	EXPECT_FALSE(RunsFromTheRight("Grüße, Привет, Γειά, 日本語, 한국어, 😀"));
	EXPECT_TRUE(RunsFromTheRight("a שלום"));
	EXPECT_TRUE(RunsFromTheRight("سلام"));
	EXPECT_FALSE(RunsFromTheRight("\xd7")) << "half a character";
}


TEST(TextOrder, LettersFromTheRightAreTurnedRound)
{
	EXPECT_EQ(CharactersOf("םולש"), Ordered("שלום"));
	EXPECT_EQ(CharactersOf("םולש ילב"), Ordered("בלי שלום"));
}


TEST(TextOrder, TheFirstLetterDecidesTheDirectionOfTheLine)
{
	EXPECT_EQ(CharactersOf("abc םולש def"), Ordered("abc שלום def"));
	EXPECT_EQ(CharactersOf("ילב abc םולש"), Ordered("שלום abc בלי"));
}


TEST(TextOrder, NumbersKeepTheirOrder)
{
	EXPECT_EQ(CharactersOf("123 םולש"), Ordered("שלום 123"));
	EXPECT_EQ(CharactersOf("ילב 1,234.5 םולש"), Ordered("שלום 1,234.5 בלי"));
	EXPECT_EQ(CharactersOf("$10 םולש"), Ordered("שלום $10"));
	EXPECT_EQ(CharactersOf("abc 10-20"), Ordered("abc 10-20"));
}


TEST(TextOrder, BracketsAreMirrored)
{
	EXPECT_EQ(CharactersOf("(םולש) ילב"), Ordered("בלי (שלום)"));
	EXPECT_EQ(CharactersOf("a (םולש)"), Ordered("a (שלום)"));
	EXPECT_EQ(CharactersOf("12.5 (abc) םולש"), Ordered("שלום (abc) 12.5"));
	EXPECT_EQ(CharactersOf("[a (b) {c}] םולש"), Ordered("שלום [a (b) {c}]"));
	EXPECT_EQ(CharactersOf("x (a) y"), Ordered("x (a) y"));
}


TEST(TextOrder, SpaceAtTheEndStaysAtTheEndOfTheLine)
{
	EXPECT_EQ(CharactersOf(" םולש"), Ordered("שלום "));
	EXPECT_EQ(CharactersOf("a םולש "), Ordered("a שלום "));
}


TEST(TextOrder, MarksFollowTheirLetter)
{
	const std::vector<uint32> text = { 0x5d0, 0x5b8, 0x5d1 };
	EXPECT_EQ((std::vector<uint32> { 0x5d1, 0x5d0, 0x5b8 }), Ordered(text, HasNone));
}


TEST(TextOrder, ArabicLettersJoin)
{
	// Beh joins on both sides, reh to what is before it alone.
	const std::vector<uint32> text = { 0x628, 0x628, 0x631, 0x628 };
	EXPECT_EQ((std::vector<uint32> { 0xfe8f, 0xfeae, 0xfe92, 0xfe91 }), Ordered(text, HasAll));
	EXPECT_EQ((std::vector<uint32> { 0x628, 0x631, 0x628, 0x628 }), Ordered(text, HasNone));
	const std::vector<uint32> apart = { 0x628, ' ', 0x628 };
	EXPECT_EQ((std::vector<uint32> { 0xfe8f, ' ', 0xfe8f }), Ordered(apart, HasAll));
}


TEST(TextOrder, MarksDoNotPartArabicLetters)
{
	const std::vector<uint32> text = { 0x628, 0x64e, 0x628 };
	EXPECT_EQ((std::vector<uint32> { 0xfe90, 0xfe91, 0x64e }), Ordered(text, HasAll));
}


TEST(TextOrder, LamAndAlefAreOneSign)
{
	const std::vector<uint32> text = { 0x644, 0x627 };
	EXPECT_EQ((std::vector<uint32> { 0x200b, 0xfefb }), Ordered(text, HasAll));
	EXPECT_EQ((std::vector<uint32> { 0x627, 0x644 }), Ordered(text, HasNone))
		<< "both stay where the font has no such sign";
}


TEST(TextOrder, SaysWhereEachCharacterComesFrom)
{
	const std::vector<OrderedCharacter> drawn = InDrawingOrder(CharactersOf("a שלם 12"), HasNone);
	const uint32 indexes[] = { 0, 1, 6, 7, 5, 4, 3, 2 };
	ASSERT_EQ(std::size(indexes), drawn.size());
	for (size_t i = 0; i < drawn.size(); i++) {
		EXPECT_EQ(indexes[i], drawn[i].index) << i;
		EXPECT_EQ(i >= 4, drawn[i].fromRight) << i;
	}
}


TEST(TextOrder, TheStartOfTheLineCanBeGiven)
{
	const auto drawn = [](std::string_view text, LineStart start) {
		std::vector<uint32> characters;
		for (const OrderedCharacter& ordered : InDrawingOrder(CharactersOf(text), HasNone, start))
			characters.push_back(ordered.character);
		return characters;
	};
	EXPECT_EQ(CharactersOf("def abc"), drawn("def abc", LineStart::Right));
	EXPECT_EQ(CharactersOf(". def"), drawn("def .", LineStart::Right));
	EXPECT_EQ(CharactersOf("םולש ."), drawn("שלום .", LineStart::Left));
	EXPECT_EQ(LineStart::OfItself, StartOf(CharactersOf(" 12 .")));
	EXPECT_EQ(LineStart::Right, StartOf(CharactersOf("12 ש a")));
	EXPECT_EQ(LineStart::Left, StartOf(CharactersOf("12 a ש")));
}


TEST(TextOrder, AnOverrideTurnsAllOrNothing)
{
	EXPECT_EQ(CharactersOf("(cba 21"
						   "\u202e"),
		Ordered("\u202e"
				"12 abc)"));
	EXPECT_EQ(CharactersOf("\u202d"
						   "שלום (1"),
		Ordered("\u202d"
				"שלום (1"));
	EXPECT_TRUE(RunsFromTheRight("\u202e"
								 "12"));
}


TEST(TextOrder, KeepsAsManyCharacters)
{
	const std::string pieces[] = { "a", "1", ",", " ", "(", "$", "+", "ש", "ب", "ل", "ا", "٣", "َ" };
	uint32 random = 1;
	for (int run = 0; run < 2000; run++) {
		std::string text;
		for (uint32 length = run % 12; length > 0; length--) {
			random = random * 1664525 + 1013904223;
			text += pieces[(random >> 16) % std::size(pieces)];
		}
		EXPECT_EQ(CharactersOf(text).size(), Ordered(CharactersOf(text), HasAll).size()) << text;
	}
}


} // namespace BPrivate
