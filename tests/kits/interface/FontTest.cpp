#include <Font.h>

#include <gtest/gtest.h>
#include <string.h>
#include <string>
#include <vector>

#include <Shape.h>
#include <String.h>


TEST(Font, DefaultIsThePlainFont)
{
	const BFont font;
	EXPECT_EQ(*be_plain_font, font);
	EXPECT_EQ(10, font.Size());
	EXPECT_EQ(90, font.Shear());
	EXPECT_EQ(0, font.Rotation());
	EXPECT_EQ(B_BITMAP_SPACING, font.Spacing());
	EXPECT_EQ(B_UNICODE_UTF8, font.Encoding());
	EXPECT_EQ(0, font.Face());
	EXPECT_EQ(0u, font.Flags());
}


TEST(Font, ThreeStandardFontsDiffer)
{
	EXPECT_NE(*be_plain_font, *be_bold_font);
	EXPECT_NE(*be_plain_font, *be_fixed_font);
	EXPECT_TRUE(be_fixed_font->IsFixed());
	EXPECT_FALSE(be_plain_font->IsFixed());
	EXPECT_GT(be_bold_font->StringWidth("Bold text"), be_plain_font->StringWidth("Bold text"));
}


TEST(Font, FamilyAndStyleComeBack)
{
	BFont font;
	font_family family;
	font_style style;
	be_bold_font->GetFamilyAndStyle(&family, &style);
	ASSERT_EQ(B_OK, font.SetFamilyAndStyle(family, style));
	EXPECT_EQ(*be_bold_font, font);

	font_family sameFamily;
	font_style sameStyle;
	font.GetFamilyAndStyle(&sameFamily, &sameStyle);
	EXPECT_STREQ(family, sameFamily);
	EXPECT_STREQ(style, sameStyle);
}


TEST(Font, UnknownNamesChangeNothing)
{
	BFont font(be_fixed_font);
	EXPECT_NE(B_OK, font.SetFamilyAndStyle("No Such Family", "Roman"));
	EXPECT_NE(B_OK, font.SetFamilyAndStyle(NULL, "No Such Style"));
	EXPECT_EQ(*be_fixed_font, font);
}


TEST(Font, NoStyleMeansTheRegularOne)
{
	BFont font(be_bold_font);
	font_family family;
	font.GetFamilyAndStyle(&family, NULL);
	ASSERT_EQ(B_OK, font.SetFamilyAndStyle(family, NULL));
	EXPECT_EQ(*be_plain_font, font);
}


TEST(Font, FaceChoosesTheStyle)
{
	BFont font;
	font.SetFace(B_BOLD_FACE);
	font_style style;
	font.GetFamilyAndStyle(NULL, &style);
	EXPECT_STREQ("Bold", style);
	EXPECT_EQ(B_BOLD_FACE, font.Face());
	font.SetFace(B_BOLD_FACE | B_ITALIC_FACE);
	font.GetFamilyAndStyle(NULL, &style);
	EXPECT_STREQ("Bold Italic", style);
}


TEST(Font, EveryFieldCountsInComparing)
{
	BFont fonts[8];
	fonts[1].SetSize(11);
	fonts[2].SetShear(100);
	fonts[3].SetRotation(45);
	fonts[4].SetSpacing(B_FIXED_SPACING);
	fonts[5].SetEncoding(B_ISO_8859_1);
	fonts[6].SetFlags(B_DISABLE_ANTIALIASING);
	fonts[7].SetFace(B_UNDERSCORE_FACE);
	for (int i = 0; i < 8; i++) {
		for (int k = 0; k < 8; k++)
			EXPECT_EQ(i == k, fonts[i] == fonts[k]) << i << ", " << k;
	}
}


TEST(Font, HeightsArePositive)
{
	font_height height;
	be_plain_font->GetHeight(&height);
	EXPECT_NEAR(9.05, height.ascent, 0.1);
	EXPECT_NEAR(2.12, height.descent, 0.1);
	EXPECT_GE(height.leading, 0);
}


TEST(Font, EscapementsAddUpToTheWidth)
{
	const char* text = "Gr\xc3\xb6\xc3\x9f"
					   "e 12";
	float escapements[8];
	be_plain_font->GetEscapements(text, 8, escapements);
	float sum = 0;
	for (float escapement : escapements)
		sum += escapement * be_plain_font->Size();
	EXPECT_NEAR(be_plain_font->StringWidth(text), sum, 0.001);
}


TEST(Font, WhatIsMeasuredAgreesInEverySpacing)
{
	// Latin, Greek, Hebrew with a vowel sign, Arabic with a ligature, mixed.
	const char* const texts[] = { "AVATAR To 12", "Γειά", "שָׁלוֹם", "سلام", "لا", "a (שלום) 3.5, ب" };
	for (const uint8 spacing :
		{ B_CHAR_SPACING, B_STRING_SPACING, B_BITMAP_SPACING, B_FIXED_SPACING }) {
		BFont font(be_plain_font);
		font.SetSpacing(spacing);
		font.SetSize(13);
		for (const char* text : texts) {
			const int32 count = BString(text).CountChars();
			std::vector<float> escapements(count);
			font.GetEscapements(text, count, escapements.data());
			std::vector<BPoint> points(count);
			font.GetEscapements(text, count, NULL, points.data());
			float sum = 0;
			for (int32 i = 0; i < count; i++) {
				EXPECT_GE(escapements[i], 0);
				EXPECT_FLOAT_EQ(escapements[i], points[i].x);
				sum += escapements[i] * font.Size();
			}
			const float width = font.StringWidth(text);
			EXPECT_NEAR(width, sum, 0.001f) << text << ' ' << int(spacing);
			const char* strings[] = { text };
			const int32 lengths[] = { int32(strlen(text)) };
			float widths[1];
			font.GetStringWidths(strings, lengths, 1, widths);
			EXPECT_EQ(width, widths[0]);
			BString cut(text);
			font.TruncateString(&cut, B_TRUNCATE_END, width + 0.01f);
			EXPECT_STREQ(text, cut.String());
		}
	}
}


TEST(Font, EdgesAreWithinTheEscapement)
{
	const char* text = "Hiש";
	float escapements[3];
	edge_info edges[3];
	BRect boxes[3];
	BFont font;
	font.SetSize(100);
	font.GetEscapements(text, 3, escapements);
	font.GetEdges(text, 3, edges);
	font.GetBoundingBoxesAsGlyphs(text, 3, B_PRINTING_METRIC, boxes);
	for (int i = 0; i < 3; i++) {
		EXPECT_NEAR(edges[i].left * 100, boxes[i].left, 0.01f) << i;
		EXPECT_NEAR((escapements[i] - edges[i].right) * 100, boxes[i].right, 0.01f) << i;
	}
}


TEST(Font, DeltasAreAddedToEachEscapement)
{
	const char* text = "a b";
	escapement_delta delta = { 3, 7 };
	float plain[3], wide[3];
	be_plain_font->GetEscapements(text, 3, plain);
	be_plain_font->GetEscapements(text, 3, &delta, wide);
	const float size = be_plain_font->Size();
	EXPECT_FLOAT_EQ(plain[0] * size + 3, wide[0] * size);
	EXPECT_FLOAT_EQ(plain[1] * size + 7, wide[1] * size);
	EXPECT_FLOAT_EQ(plain[2] * size + 3, wide[2] * size);
	BRect boxes[3];
	be_plain_font->GetBoundingBoxesAsString(text, 3, B_PRINTING_METRIC, &delta, boxes);
	BRect alone;
	be_plain_font->GetBoundingBoxesAsGlyphs("b", 1, B_PRINTING_METRIC, &alone);
	EXPECT_NEAR((wide[0] + wide[1]) * size, boxes[2].left - alone.left, 0.001f);
}


TEST(Font, BoxesOfTextFromTheRightAreWhereItIsDrawn)
{
	BRect boxes[3];
	be_plain_font->GetBoundingBoxesAsString("שלם", 3, B_PRINTING_METRIC, NULL, boxes);
	EXPECT_GT(boxes[0].left, boxes[1].right);
	EXPECT_GT(boxes[1].left, boxes[2].right);
}


TEST(Font, LengthIsInBytesAndEndsAtTheZero)
{
	EXPECT_EQ(be_plain_font->StringWidth("abc"), be_plain_font->StringWidth("abcdef", 3));
	EXPECT_EQ(be_plain_font->StringWidth("abc"), be_plain_font->StringWidth("abc", 50));
	EXPECT_EQ(0, be_plain_font->StringWidth(NULL));
	EXPECT_EQ(0, be_plain_font->StringWidth("abc", -1));
}


TEST(Font, ReadingEndsAtTheZero)
{
	float escapements[3] = { -1, -1, -1 };
	be_plain_font->GetEscapements("a", 3, escapements);
	EXPECT_GT(escapements[0], 0);
	EXPECT_EQ(-1, escapements[1]);
}


TEST(Font, TextThatFitsIsNotCut)
{
	BString text("short");
	be_plain_font->TruncateString(&text, B_TRUNCATE_END, 200);
	EXPECT_STREQ("short", text.String());
}


TEST(Font, CutTextFitsAndKeepsTheRightEnd)
{
	const char* original = "A rather long text that will not fit";
	for (uint32 mode :
		{ B_TRUNCATE_END, B_TRUNCATE_BEGINNING, B_TRUNCATE_MIDDLE, B_TRUNCATE_SMART }) {
		for (float width = 20; width < 130; width += 7) {
			BString text(original);
			be_plain_font->TruncateString(&text, mode, width);
			EXPECT_LE(be_plain_font->StringWidth(text.String()), width);
			EXPECT_NE(nullptr, strstr(text.String(), B_UTF8_ELLIPSIS));
			if (mode == B_TRUNCATE_END) {
				EXPECT_EQ('A', text[0]);
			} else if (mode == B_TRUNCATE_BEGINNING) {
				EXPECT_EQ('t', text[text.Length() - 1]);
			}
		}
	}
	BString text(original);
	be_plain_font->TruncateString(&text, B_TRUNCATE_END, 1);
	EXPECT_STREQ("", text.String());
}


TEST(Font, ShapesHaveTheInk)
{
	BShape shape;
	BShape* shapes[] = { &shape };
	BFont font;
	font.SetSize(100);
	font.GetGlyphShapes("H", 1, shapes);
	EXPECT_LT(shape.Bounds().top, -60);
	EXPECT_NEAR(0, shape.Bounds().bottom, 1);

	BRect box;
	font.GetBoundingBoxesAsGlyphs("H", 1, B_PRINTING_METRIC, &box);
	EXPECT_EQ(shape.Bounds(), box);
}


TEST(Font, GlyphsAreKnown)
{
	bool has[2];
	be_plain_font->GetHasGlyphs("a\xf3\xbf\xbf\xbd", 2, has);
	EXPECT_TRUE(has[0]);
	EXPECT_FALSE(has[1]);
}


TEST(FontLists, AreSortedAndBounded)
{
	const int32 count = count_font_families();
	ASSERT_GT(count, 0);
	font_family last = "";
	for (int32 i = 0; i < count; i++) {
		font_family family;
		ASSERT_EQ(B_OK, get_font_family(i, &family));
		EXPECT_LT(strcmp(last, family), 0);
		strcpy(last, family);
		font_style style;
		uint16 face = 0;
		ASSERT_EQ(B_OK, get_font_style(family, 0, &style, &face));
		EXPECT_NE(0, face);
		EXPECT_NE(B_OK, get_font_style(family, count_font_styles(family), &style));
	}
	font_family family;
	EXPECT_NE(B_OK, get_font_family(count, &family));
	EXPECT_NE(B_OK, get_font_family(-1, &family));
}


TEST(Font, FixedSpacingGivesAllCharactersOneWidth)
{
	BFont font(be_plain_font);
	font.SetSpacing(B_FIXED_SPACING);
	const float wide = font.StringWidth("W");
	EXPECT_EQ(be_plain_font->StringWidth("W"), wide);
	EXPECT_EQ(wide, font.StringWidth("i"));
	EXPECT_NEAR(5 * wide, font.StringWidth("iWi.m"), 0.001f);
	float escapements[2];
	font.GetEscapements("iW", 2, escapements);
	EXPECT_EQ(escapements[0], escapements[1]);
}


TEST(Font, OtherSpacingsHaveTheSameWidth)
{
	BFont font(be_plain_font);
	const float width = font.StringWidth("Some words");
	for (const uint8 spacing : { B_CHAR_SPACING, B_STRING_SPACING, B_BITMAP_SPACING }) {
		font.SetSpacing(spacing);
		EXPECT_EQ(width, font.StringWidth("Some words")) << int(spacing);
	}
}


TEST(Font, WidthOfTextFromTheRightIsThatOfItsLetters)
{
	const float letters = be_plain_font->StringWidth("ש") + be_plain_font->StringWidth("ל");
	EXPECT_NEAR(letters, be_plain_font->StringWidth("של"), 0.001f);
	const std::string longText = [] {
		std::string text;
		for (int i = 0; i < 300; i++)
			text += "ש";
		return text;
	}();
	EXPECT_NEAR(
		300 * be_plain_font->StringWidth("ש"), be_plain_font->StringWidth(longText.c_str()), 0.1f);
}
