// BTextView with letters that run from the right.
#include <TextView.h>

#include <gtest/gtest.h>
#include <string>
#include <vector>

#include <Region.h>
#include <String.h>

#include "support/TestWindow.h"

namespace {

// What each letter of these is at, in bytes: a0 b1 c2 ' '3 ש4 ל6 ם8 ' '10 d11 e12 f13.
const char* const kMixed = "abc שלם def";
// ש0 ל2 ם4 ' '6 a7 b8 c9 ' '10 ב11 end 13. The line starts at the right.
const char* const kFromRight = "שלם abc ב";

struct Editor : TestWindow {
	explicit Editor(const char* text)
	{
		view = Add(new BTextView(
			BRect(10, 10, 309, 109), "text", BRect(2, 2, 295, 95), B_FOLLOW_ALL, B_WILL_DRAW));
		Locked([&] {
			view->SetText(text);
			view->MakeFocus();
			view->Select(0, 0);
		});
	}

	int32 Caret() const
	{
		int32 from, to;
		view->GetSelection(&from, &to);
		EXPECT_EQ(from, to);
		return from;
	}

	std::vector<int32> Press(const char* key, int32 times)
	{
		std::vector<int32> places;
		for (int32 i = 0; i < times; i++) {
			driver.Key(key);
			Driver::WaitUntilIdle();
			Locked([&] { places.push_back(Caret()); });
		}
		return places;
	}

	BRect RectOf(int32 from, int32 to)
	{
		BRegion region;
		view->GetTextRegion(from, to, &region);
		EXPECT_EQ(1, region.CountRects());
		return region.Frame();
	}

	BTextView* view;
};

typedef std::vector<int32> Places;

} // namespace


TEST(TextViewDirections, ArrowsCrossOneLetterAfterTheOtherAsTheyAreSeen)
{
	Editor editor(kMixed);
	EXPECT_EQ((Places { 1, 2, 3, 4, 8, 6, 4, 11, 12, 13, 14, 14 }), editor.Press("Right", 12));
	EXPECT_EQ((Places { 13, 12, 11, 10, 6, 8, 10, 3, 2, 1, 0, 0 }), editor.Press("Left", 12));
}


TEST(TextViewDirections, ALineThatStartsAtTheRightGoesOnToTheLeft)
{
	Editor editor(kFromRight);
	EXPECT_EQ((Places { 2, 4, 6, 7, 9, 8, 7, 11, 13, 13 }), editor.Press("Left", 10));
	EXPECT_EQ((Places { 11, 10, 8, 9, 10, 6, 4, 2, 0, 0 }), editor.Press("Right", 10));
	EXPECT_EQ((Places { 13, 0 }),
		(Places { editor.Press("End", 1).front(), editor.Press("Home", 1).front() }));
	editor.driver.Key("Left", B_CONTROL_KEY);
	editor.Locked([&] { EXPECT_EQ(6, editor.Caret()) << "behind the first word"; });
	editor.driver.Key("Right", B_CONTROL_KEY);
	editor.Locked([&] { EXPECT_EQ(0, editor.Caret()); });
}


TEST(TextViewDirections, LettersStandWhereTheyAreSeen)
{
	Editor editor(kFromRight);
	editor.Locked([&] {
		const float width = editor.view->LineWidth(0);
		const float left = editor.view->TextRect().left;
		EXPECT_NEAR(left + width, editor.view->PointAt(0).x, 1) << "the start is at the right";
		EXPECT_NEAR(left, editor.view->PointAt(13).x, 0.01f) << "the end at the left";
		EXPECT_LT(editor.view->PointAt(2).x, editor.view->PointAt(0).x);
		EXPECT_LT(editor.view->PointAt(7).x, editor.view->PointAt(8).x);
		EXPECT_LT(editor.RectOf(11, 13).right, editor.RectOf(7, 10).left);
		EXPECT_LT(editor.RectOf(7, 10).right, editor.RectOf(0, 6).left);
	});
}


TEST(TextViewDirections, ClicksFindTheLetterThatIsSeen)
{
	for (const char* text : { kMixed, kFromRight }) {
		Editor editor(text);
		const int32 length = editor.view->TextLength();
		for (int32 at = 0; at < length;) {
			const int32 next = at + (static_cast<uchar>(text[at]) < 0x80 ? 1 : 2);
			const bool fromRight = next == at + 2;
			if (text[at] == ' ') {
				at = next;
				continue;
			}
			BRect rect;
			editor.Locked([&] { rect = editor.RectOf(at, next); });
			editor.driver.Click(editor.view, BPoint(rect.left + 1, rect.top + 3));
			editor.Locked([&] { EXPECT_EQ(fromRight ? next : at, editor.Caret()) << text << at; });
			editor.driver.Click(editor.view, BPoint(rect.right, rect.top + 3));
			editor.Locked([&] { EXPECT_EQ(fromRight ? at : next, editor.Caret()) << text << at; });
			at = next;
		}
	}
}


// Where the caret is seen: the only column that is dark from top to bottom.
static float
caret_column(Editor& editor)
{
	BRect line;
	editor.Locked([&] {
		line.Set(0, editor.view->PointAt(0).y, 120,
			editor.view->PointAt(0).y + editor.view->LineHeight(0) - 1);
	});
	float found = -1;
	for (float x = line.left; x <= line.right; x++) {
		bool dark = true;
		for (float y = line.top; dark && y <= line.bottom; y++)
			dark = editor.driver.PixelAt(editor.view, BPoint(x, y)).red < 128;
		if (dark) {
			EXPECT_EQ(-1, found);
			found = x;
		}
	}
	return found;
}


TEST(TextViewDirections, TheCaretIsSeenWhereItWasClicked)
{
	Editor editor("aaa ששש aaa");
	BRect blank, firstLetter;
	editor.Locked([&] {
		blank = editor.RectOf(3, 4);
		firstLetter = editor.RectOf(4, 6);
	});
	ASSERT_GT(firstLetter.left, blank.right + 4) << "the first letter is at the far side";
	editor.driver.Click(editor.view, BPoint(blank.right - 0.5f, blank.top + 3));
	EXPECT_NEAR(blank.right + 1, caret_column(editor), 1);
	editor.driver.Click(editor.view, BPoint(firstLetter.right - 1, blank.top + 3));
	EXPECT_NEAR(firstLetter.right + 1, caret_column(editor), 1);
	editor.Locked([&] { EXPECT_EQ(4, editor.Caret()) << "one place in the text, two to see"; });
}


TEST(TextViewDirections, TheCaretMovesAlwaysTheWayOfItsKey)
{
	Editor editor("ab 12 ששש 34 cd");
	float last = caret_column(editor);
	for (int32 i = 0; i < 15; i++) {
		editor.driver.Key("Right");
		const float now = caret_column(editor);
		EXPECT_GT(now, last) << i;
		last = now;
	}
	for (int32 i = 0; i < 15; i++) {
		editor.driver.Key("Left");
		const float now = caret_column(editor);
		EXPECT_LT(now, last) << i;
		last = now;
	}
}


TEST(TextViewDirections, TypedLettersStayTogetherAndKeepTheCaret)
{
	Editor editor("ab cd");
	editor.Locked([&] { editor.view->Select(3, 3); });
	editor.driver.Type("ש");
	const float first = caret_column(editor);
	editor.driver.Type("ששש");
	EXPECT_NEAR(first, caret_column(editor), 1) << "what is typed next pushes the rest away";
	editor.driver.Key("Backspace");
	editor.Locked([&] { EXPECT_STREQ("ab שששcd", editor.view->Text()); });
	editor.Locked([&] { editor.view->Undo(NULL); });
	editor.Locked([&] { EXPECT_STREQ("ab ששששcd", editor.view->Text()); });
	editor.Locked([&] { editor.view->Undo(NULL); });
	editor.Locked([&] { EXPECT_STREQ("ab cd", editor.view->Text()); });
}


TEST(TextViewDirections, ASelectionAcrossDirectionsIsSeenInParts)
{
	Editor editor(kMixed);
	editor.Locked([&] {
		BRegion region;
		editor.view->GetTextRegion(2, 6, &region); // c, a blank and the first letter
		EXPECT_EQ(2, region.CountRects());
		const BRect rest = editor.RectOf(6, 10);
		EXPECT_FALSE(region.Intersects(rest.InsetByCopy(1, 0)));
		EXPECT_TRUE(region.Contains(editor.RectOf(4, 6).LeftTop() + BPoint(2, 2)));
		editor.view->GetTextRegion(0, 14, &region);
		EXPECT_EQ(1, region.CountRects()) << "without gaps";
	});
}


TEST(TextViewDirections, DraggingSelectsWhatWasPassed)
{
	Editor editor(kMixed);
	BRect letters, all;
	editor.Locked([&] {
		letters = editor.RectOf(4, 10);
		all = editor.RectOf(0, 14);
	});
	const float y = letters.top + 3;
	editor.driver.Drag(
		editor.view, BPoint(letters.right, y), editor.view, BPoint(letters.left + 1, y));
	int32 from, to;
	editor.view->GetSelection(&from, &to);
	EXPECT_EQ(4, from);
	EXPECT_EQ(10, to);
	EXPECT_LT(editor.driver.PixelAt(editor.view, BPoint(letters.left + 2, letters.top)).red, 128);
	EXPECT_GT(editor.driver.PixelAt(editor.view, BPoint(letters.left - 3, letters.top)).red, 128);
	editor.driver.Key("Left");
	editor.Locked([&] { EXPECT_EQ(10, editor.Caret()) << "its left end is its last"; });
	editor.driver.Key("Left", B_SHIFT_KEY);
	editor.view->GetSelection(&from, &to);
	EXPECT_EQ(3, from);
	EXPECT_EQ(10, to);
}


TEST(TextViewDirections, AStyledWordFollowsTheOneBeforeItToTheLeft)
{
	Editor editor("");
	editor.Locked([&] {
		editor.view->SetStylable(true);
		editor.view->SetText("שלם עלם");
		editor.view->SetFontAndColor(7, 13, be_bold_font);
		EXPECT_LT(editor.RectOf(7, 13).right, editor.RectOf(0, 6).left);
		const float width = be_plain_font->StringWidth("שלם ") + be_bold_font->StringWidth("עלם");
		EXPECT_EQ(ceilf(width), editor.view->LineWidth(0));
	});
}


TEST(TextViewDirections, WidthIsThatOfTheDrawnText)
{
	Editor editor("");
	editor.Locked([&] {
		for (const char* text : { kMixed, kFromRight, "سلام لا, 12.5%", "(שָׁלוֹם) a", "ب 12 ١٢ ٣" }) {
			editor.view->SetText(text);
			EXPECT_EQ(ceilf(be_plain_font->StringWidth(text) - 0.001f), editor.view->LineWidth(0))
				<< text;
		}
	});
}


TEST(TextViewDirections, IsDrawnAsAStringIs)
{
	for (const char* text : { "abc (שלם) 12.5 def", "שלם [abc] 34 ב", "سلام abc لا" }) {
		Editor editor("");
		struct Line : BView {
			Line(const char* text) :
				BView(BRect(10, 120, 309, 150), "line", B_FOLLOW_NONE, B_WILL_DRAW), text(text)
			{
				SetViewColor(255, 255, 255);
			}
			void Draw(BRect) override
			{
				SetDrawingMode(B_OP_OVER);
				DrawString(text, BPoint(2, baseline));
			}
			const char* text;
			float baseline = 0;
		};
		Line* line = editor.Add(new Line(text));
		editor.Locked([&] {
			editor.view->MakeFocus(false);
			editor.view->SetText(text);
			font_height height;
			be_plain_font->GetHeight(&height);
			line->baseline = editor.view->TextRect().top + ceilf(height.ascent);
			line->Invalidate();
		});
		int32 dark = 0;
		for (float y = 0; y < 20; y++) {
			for (float x = 0; x < 140; x++) {
				const rgb_color pixel = editor.driver.PixelAt(line, BPoint(x, y));
				dark += pixel.red < 128;
				ASSERT_EQ(pixel.red, editor.driver.PixelAt(editor.view, BPoint(x, y)).red)
					<< text << ' ' << x << ' ' << y;
			}
		}
		EXPECT_GT(dark, 50);
	}
}


TEST(TextViewDirections, LinesOfAParagraphStartWhereItStarts)
{
	// The wrapped second line begins with a Latin word.
	std::string text = "שלם";
	for (int i = 0; i < 18; i++)
		text += " abcd";
	text += " שלם";
	Editor editor(text.c_str());
	editor.Locked([&] {
		ASSERT_EQ(2, editor.view->CountLines());
		const int32 last = editor.view->TextLength() - 6;
		const int32 start = editor.view->OffsetAt(1);
		EXPECT_GT(editor.RectOf(start, start + 4).left, editor.RectOf(last, last + 6).right);
	});
}


TEST(TextViewDirections, UpAndDownKeepTheColumn)
{
	Editor editor("aaaaaaaa\nשששששששש\naaaaaaaa");
	editor.Locked([&] { editor.view->Select(3, 3); });
	const std::vector<int32> down = editor.Press("Down", 2);
	editor.Locked([&] {
		EXPECT_NEAR(editor.view->PointAt(3).x, editor.view->PointAt(down[0]).x, 4);
		EXPECT_EQ(3, down[1] - 26);
	});
}


TEST(TextViewDirections, EveryCharacterHasOnePlaceOfItsOwn)
{
	const char* const pieces[] = { "a", "b", "1", "2", ",", " ", "(", ")", "-", "ש", "ל", "ب", "ل",
		"ا", "٣", "\t", "שָ" };
	Editor editor("");
	uint32 random = 7;
	for (int run = 0; run < 200; run++) {
		std::string text;
		for (int i = 0; i < 12; i++) {
			random = random * 1664525 + 1013904223;
			text += pieces[(random >> 16) % std::size(pieces)];
		}
		editor.Locked([&] {
			editor.view->SetText(text.c_str());
			BRegion whole;
			float sum = 0;
			const int32 length = editor.view->TextLength();
			for (int32 at = 0; at < length; at++) {
				BRegion region;
				editor.view->GetTextRegion(at, at + 1, &region);
				if (region.CountRects() == 0)
					continue;
				EXPECT_EQ(1, region.CountRects()) << text;
				sum += region.Frame().Width();
				whole.Include(&region);
				BPoint middle = region.Frame().LeftTop();
				middle.x = (region.Frame().left + region.Frame().right) / 2;
				const int32 hit = editor.view->OffsetAt(middle);
				// Less is lost in rounding to pixels.
				if (region.Frame().Width() > 2) {
					EXPECT_LE(abs(hit - at), 4) << text << ' ' << at;
				}
			}
			EXPECT_EQ(1, whole.CountRects()) << text;
			EXPECT_NEAR(editor.view->LineWidth(0), whole.Frame().Width() + 1, 1) << text;
		});
	}
}
