#include "server/paint/FontEngine.h"

#include <math.h>
#include <string.h>
#include <string>
#include <thread>
#include <vector>

#include "PaintFixture.h"

using namespace BPrivate;

namespace {

const char* const kTexts[] = { "Hello", "The quick brown fox", "WWWW", "iiii", "jpqgy",
	"\xc3\x84\xc3\x96\xc3\x9c", "\xd0\x9f\xd1\x80\xd0\xb8\xd0\xb2\xd0\xb5\xd1\x82", "a b  c", "" };

} // namespace


TEST(Text, InkStaysWithinTheMeasuredWidthAndHeight)
{
	for (float size : { 9.0f, 10.0f, 12.0f, 18.0f, 40.0f }) {
		for (uint32 code = 0; code < 3; code++) {
			for (const char* text : kTexts) {
				PaintFixture fixture(600, 80);
				fixture.state.font.size = size;
				fixture.state.font.familyAndStyle = code;
				font_height height;
				FontEngine::Get().GetHeight(fixture.state.font, &height);
				const float width = FontEngine::Get().StringWidth(fixture.state.font, text);

				const BPoint end = fixture.painter.DrawString(text, BPoint(20, 50));

				EXPECT_FLOAT_EQ(20 + width, end.x);
				EXPECT_EQ(50, end.y);
				// Letters such as j may reach a little out of their own place.
				const int32 slack = 1 + (int32)ceilf(size / 10);
				fixture.ExpectInk([&](int32 x, int32 y) {
					if (fixture.At(x, y) == 0xffffffff)
						return false;
					return x >= 20 - slack && x < 20 + width + slack
						&& y >= 50 - ceilf(height.ascent) - 1 && y < 50 + ceilf(height.descent) + 1;
				});
			}
		}
	}
}


TEST(Text, LettersStandOnTheBaseline)
{
	PaintFixture fixture;
	fixture.painter.DrawString("HIL", BPoint(5, 30));
	bool inkAbove = false;
	for (int32 x = 0; x < 64; x++) {
		inkAbove |= (fixture.At(x, 29) & 0xff) < 64;
		EXPECT_EQ(0xffffffff, fixture.At(x, 30));
	}
	EXPECT_TRUE(inkAbove);
}


TEST(Text, WidthIsTheSumOfItsParts)
{
	FontEngine& engine = FontEngine::Get();
	FontSpec spec;
	EXPECT_FLOAT_EQ(engine.StringWidth(spec, "Archway"),
		engine.StringWidth(spec, "Arch") + engine.StringWidth(spec, "way"));
	EXPECT_EQ(0, engine.StringWidth(spec, ""));
}


TEST(Text, WidthGrowsWithTheSize)
{
	FontEngine& engine = FontEngine::Get();
	FontSpec small, large;
	large.size = 20;
	EXPECT_NEAR(
		2 * engine.StringWidth(small, "Archway"), engine.StringWidth(large, "Archway"), 0.001);
}


TEST(Text, LongAndShortTextsAreMeasuredAlike)
{
	FontSpec spec;
	const std::string once = "A fairly ordinary text, ";
	std::string often;
	for (int i = 0; i < 100; i++)
		often += once;
	EXPECT_NEAR(100 * FontEngine::Get().StringWidth(spec, once),
		FontEngine::Get().StringWidth(spec, often), 0.5);
}


TEST(Text, FixedFontHasOneWidth)
{
	FontSpec spec;
	spec.familyAndStyle = FontEngine::kFixedCode;
	EXPECT_TRUE(FontEngine::Get().IsFixed(FontEngine::kFixedCode));
	EXPECT_FLOAT_EQ(
		FontEngine::Get().StringWidth(spec, "iiii"), FontEngine::Get().StringWidth(spec, "WWWW"));
}


TEST(Text, DefaultFontsHaveTheWidthsOfTheirDesign)
{
	EXPECT_STREQ("Liberation Sans", FontEngine::Get().FamilyOf(FontEngine::kPlainCode));
	EXPECT_STREQ("Regular", FontEngine::Get().StyleOf(FontEngine::kPlainCode));
	EXPECT_STREQ("Bold", FontEngine::Get().StyleOf(FontEngine::kBoldCode));
	EXPECT_STREQ("Liberation Mono", FontEngine::Get().FamilyOf(FontEngine::kFixedCode));
	FontSpec spec;
	EXPECT_NEAR(5.56, FontEngine::Get().StringWidth(spec, "0"), 0.01);
}


TEST(Text, RepeatedMeasuringTakesTheRememberedRun)
{
	FontSpec spec;
	const std::shared_ptr<const GlyphRun> first = FontEngine::Get().Run(spec, "remembered");
	EXPECT_EQ(first, FontEngine::Get().Run(spec, "remembered"));
	spec.size = 11;
	EXPECT_NE(first, FontEngine::Get().Run(spec, "remembered"));
}


TEST(Text, RememberedRunsAreBounded)
{
	FontSpec spec;
	std::weak_ptr<const GlyphRun> first = FontEngine::Get().Run(spec, "first of many");
	for (int i = 0; i < 40000; i++)
		FontEngine::Get().StringWidth(spec, "number " + std::to_string(i));
	EXPECT_TRUE(first.expired());
}


TEST(Text, FamiliesAndStylesAreSorted)
{
	FontEngine& engine = FontEngine::Get();
	ASSERT_GT(engine.CountFamilies(), 0);
	for (int32 i = 0; i < engine.CountFamilies(); i++) {
		const char* family = engine.FamilyAt(i);
		if (i > 0) {
			EXPECT_LT(strcmp(engine.FamilyAt(i - 1), family), 0);
		}
		ASSERT_GT(engine.CountStyles(family), 0);
		for (int32 k = 0; k < engine.CountStyles(family); k++) {
			uint32 code = 0;
			const char* style = engine.StyleAt(family, k);
			if (k > 0) {
				EXPECT_LT(strcmp(engine.StyleAt(family, k - 1), style), 0);
			}
			ASSERT_EQ(B_OK, engine.FindCode(family, style, &code));
			EXPECT_STREQ(family, engine.FamilyOf(code));
			EXPECT_STREQ(style, engine.StyleOf(code));
		}
	}
	EXPECT_EQ(nullptr, engine.FamilyAt(-1));
	EXPECT_EQ(nullptr, engine.FamilyAt(engine.CountFamilies()));
}


TEST(Text, RotatedTextEndsWhereItPoints)
{
	PaintFixture fixture;
	fixture.state.font.rotation = 90;
	const float width = FontEngine::Get().StringWidth(fixture.state.font, "up");
	const BPoint end = fixture.painter.DrawString("up", BPoint(30, 50));
	EXPECT_NEAR(30, end.x, 0.01);
	EXPECT_NEAR(50 - width, end.y, 0.01);
	EXPECT_TRUE(fixture.painter.HasDamage());
}


TEST(Text, DeltaMovesTheFollowingGlyphs)
{
	PaintFixture fixture;
	const float width = FontEngine::Get().StringWidth(fixture.state.font, "a b");
	EXPECT_FLOAT_EQ(width + 2 * 3 + 7, fixture.painter.DrawString("a b", BPoint(0, 20), 3, 7).x);
}


TEST(Text, IsDrawnAsWideAsItIsMeasuredInEverySpacing)
{
	for (uint8 spacing = B_CHAR_SPACING; spacing <= B_FIXED_SPACING; spacing++) {
		for (const char* text : { "AVATAR To", "Γειά, שלום", "سلام لا" }) {
			PaintFixture fixture(200, 30);
			fixture.state.font.spacing = spacing;
			const auto run = FontEngine::Get().Run(fixture.state.font, text);
			float sum = 0;
			for (const PlacedGlyph& glyph : run->glyphs)
				sum += glyph.advance;
			EXPECT_NEAR(run->width, sum, 0.001f);
			EXPECT_EQ(run->width, FontEngine::Get().StringWidth(fixture.state.font, text));
			EXPECT_FLOAT_EQ(5 + run->width, fixture.painter.DrawString(text, BPoint(5, 20)).x);
		}
	}
}


TEST(Text, GlyphsKnowTheirCharacters)
{
	const auto run = FontEngine::Get().Run(FontSpec(), "a שב");
	ASSERT_EQ(4u, run->glyphs.size());
	const uint32 indexes[] = { 0, 1, 3, 2 };
	for (size_t i = 0; i < 4; i++)
		EXPECT_EQ(indexes[i], run->glyphs[i].index);
}


TEST(Text, WithoutSmoothingPixelsAreAllOrNothing)
{
	PaintFixture fixture(200, 30);
	fixture.state.font.flags = B_DISABLE_ANTIALIASING;
	fixture.painter.DrawString("Oval shapes", BPoint(3, 20));
	int32 ink = 0;
	for (int32 y = 0; y < 30; y++) {
		for (int32 x = 0; x < 200; x++) {
			ASSERT_TRUE(fixture.At(x, y) == 0xffffffff || fixture.At(x, y) == 0xff000000);
			ink += fixture.At(x, y) == 0xff000000;
		}
	}
	EXPECT_GT(ink, 50);
}


TEST(Text, CharactersThatTheFontLacksComeFromAnother)
{
	FontSpec spec;
	// A check mark, which text faces do not have.
	const std::shared_ptr<const GlyphRun> run = FontEngine::Get().Run(spec, "a\xe2\x9c\x93");
	ASSERT_EQ(2u, run->glyphs.size());
	if (FontEngine::Get().Covers(0, 0x2713))
		GTEST_SKIP() << "the plain font has one";
	EXPECT_NE(run->glyphs[0].face, run->glyphs[1].face);
	EXPECT_NE(0u, run->glyphs[1].glyph);
}


TEST(Text, ThreadsPaintTheSamePicture)
{
	auto paint = [](PaintFixture& fixture, int32 seed) {
		for (int32 i = 0; i < 60; i++) {
			fixture.state.font.size = 9 + (i + seed) % 7;
			fixture.state.font.familyAndStyle = i % 3;
			fixture.painter.DrawString(
				"Thread " + std::to_string(i), BPoint(i % 7 * 0.3f, 5 + i % 60));
		}
	};
	std::vector<std::unique_ptr<PaintFixture>> fixtures;
	for (int i = 0; i < 8; i++)
		fixtures.push_back(std::make_unique<PaintFixture>());
	std::vector<std::thread> threads;
	for (int i = 0; i < 8; i++)
		threads.emplace_back([&, i] { paint(*fixtures[i], i % 2); });
	for (std::thread& thread : threads)
		thread.join();
	for (int i = 2; i < 8; i++) {
		for (int32 y = 0; y < 64; y++) {
			for (int32 x = 0; x < 64; x++)
				ASSERT_EQ(fixtures[i % 2]->At(x, y), fixtures[i]->At(x, y));
		}
	}
}


TEST(Utf8, CharactersAreDecoded)
{
	const std::string_view text = "a\xc3\xa4\xe2\x82\xac\xf0\x9f\x98\x80";
	size_t at = 0;
	EXPECT_EQ('a', (int)NextCharacter(text, &at));
	EXPECT_EQ(0xe4u, NextCharacter(text, &at));
	EXPECT_EQ(0x20acu, NextCharacter(text, &at));
	EXPECT_EQ(0x1f600u, NextCharacter(text, &at));
	EXPECT_EQ(text.size(), at);
}


TEST(Utf8, BadBytesAreReplacedAndAlwaysEnd)
{
	std::mt19937 random(1);
	for (int i = 0; i < 5000; i++) {
		std::string bytes;
		for (int k = random() % 12; k >= 0; k--)
			bytes += (char)random();
		size_t at = 0;
		size_t last = 0;
		while (at < bytes.size()) {
			const uint32 character = NextCharacter(bytes, &at);
			ASSERT_GT(at, last);
			ASSERT_LE(at, bytes.size());
			ASSERT_TRUE(character <= 0x10ffff && (character < 0xd800 || character > 0xdfff));
			last = at;
		}
	}
	size_t at = 0;
	EXPECT_EQ(0xfffdu, NextCharacter("\xc0\x80", &at));
	at = 0;
	EXPECT_EQ(0xfffdu, NextCharacter("\xed\xa0\x80", &at));
}


TEST(Text, LettersFromTheRightAreDrawnInTheirOrder)
{
	const char* const kShin = "\xd7\xa9";
	const char* const kLamed = "\xd7\x9c";
	PaintFixture whole, parts;
	const BPoint end = whole.painter.DrawString(std::string(kShin) + kLamed, BPoint(5, 30));
	const BPoint middle = parts.painter.DrawString(kLamed, BPoint(5, 30));
	EXPECT_EQ(end, parts.painter.DrawString(kShin, middle));
	bool hasInk = false;
	for (int32 y = 0; y < 48; y++) {
		for (int32 x = 0; x < 64; x++) {
			hasInk |= whole.At(x, y) != 0xffffffff;
			ASSERT_EQ(parts.At(x, y), whole.At(x, y)) << x << ' ' << y;
		}
	}
	EXPECT_TRUE(hasInk);
}


TEST(Text, StringSpacingPutsEachCharacterOnAWholePixel)
{
	FontSpec spec;
	spec.spacing = B_STRING_SPACING;
	const auto run = FontEngine::Get().Run(spec, "Archway");
	spec.spacing = B_CHAR_SPACING;
	const auto exact = FontEngine::Get().Run(spec, "Archway");
	ASSERT_EQ(exact->glyphs.size(), run->glyphs.size());
	EXPECT_EQ(exact->width, run->width);
	bool differs = false;
	for (size_t i = 0; i < run->glyphs.size(); i++) {
		EXPECT_EQ(floorf(exact->glyphs[i].x + 0.5f), run->glyphs[i].x);
		differs |= exact->glyphs[i].x != run->glyphs[i].x;
	}
	EXPECT_TRUE(differs);
}


TEST(Text, MarksStandInTheMiddleOfTheirLetter)
{
	FontSpec spec;
	spec.size = 40;
	const char* const kLetter = "\xd7\xa9"; // shin
	const std::string marked = std::string(kLetter) + "\xd6\xb8"; // and qamats
	const auto alone = FontEngine::Get().Run(spec, kLetter);
	const auto run = FontEngine::Get().Run(spec, marked);
	ASSERT_EQ(2u, run->glyphs.size());
	EXPECT_EQ(alone->width, run->width) << "a mark takes no room";
	EXPECT_EQ(alone->width, FontEngine::Get().StringWidth(spec, marked));
	EXPECT_EQ(alone->glyphs[0].glyph, run->glyphs[0].glyph);
	const PathData outline = FontEngine::Get().Outline(run->glyphs[1]);
	ASSERT_FALSE(outline.points.empty());
	float left = 1000, right = -1000;
	for (const BPoint& point : outline.points) {
		left = std::min(left, run->glyphs[1].x + point.x * spec.size);
		right = std::max(right, run->glyphs[1].x + point.x * spec.size);
	}
	EXPECT_NEAR(run->width / 2, (left + right) / 2, 0.01f);
}
