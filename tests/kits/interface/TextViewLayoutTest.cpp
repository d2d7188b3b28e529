// BTextView: where text is shown.
#include <TextView.h>

#include <cmath>

#include <ScrollBar.h>
#include <ScrollView.h>

#include "TextEditor.h"


TEST(TextView, WordsWrapAtTheTextRectangle)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->SetTextRect(BRect(2, 2, 60, 100));
		editor.view->SetText("some words that need several lines");
		EXPECT_GT(editor.view->CountLines(), 2);
		for (int32 line = 0; line < editor.view->CountLines() - 1; line++) {
			const int32 end = editor.view->OffsetAt(line + 1);
			EXPECT_EQ(' ', editor.view->ByteAt(end - 1)) << line;
		}
		editor.view->SetWordWrap(false);
		EXPECT_EQ(1, editor.view->CountLines());
	});
}


TEST(TextView, ALineIsAsHighAsItsLargestFont)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->SetStylable(true);
		editor.view->SetText("small\nlarge\nsmall");
		const float small = editor.view->LineHeight(0);
		BFont large(be_plain_font);
		large.SetSize(40);
		editor.view->SetFontAndColor(6, 8, &large);
		EXPECT_EQ(small, editor.view->LineHeight(0));
		EXPECT_GT(editor.view->LineHeight(1), 3 * small);
		EXPECT_EQ(small, editor.view->LineHeight(2));
		EXPECT_EQ(2 * small + editor.view->LineHeight(1), editor.view->TextHeight(0, 2));
		EXPECT_EQ(editor.view->TextRect().Height(), editor.view->TextHeight(0, 2));
	});
}


TEST(TextView, PlaceAndOffsetAreInverse)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->SetText("The quick brown fox\njumps over\n\nthe lazy dog.");
		for (int32 i = 0; i <= editor.view->TextLength(); i++)
			EXPECT_EQ(i, editor.view->OffsetAt(editor.view->PointAt(i) + BPoint(0, 3))) << i;
	});
}


TEST(TextView, AlignmentMovesLinesWithinTheTextRectangle)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->SetText("text");
		const float width = editor.view->LineWidth(0);
		EXPECT_EQ(2, editor.view->PointAt(0).x);
		editor.view->SetAlignment(B_ALIGN_RIGHT);
		EXPECT_NEAR(297, editor.view->PointAt(4).x, 2);
		editor.view->SetAlignment(B_ALIGN_CENTER);
		EXPECT_NEAR(2 + (295 - width) / 2, editor.view->PointAt(0).x, 2);
	});
}


TEST(TextView, ResizableViewFollowsItsText)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->MakeResizable(true);
		EXPECT_FALSE(editor.view->DoesWordWrap());
		editor.view->SetText("short");
		const float narrow = editor.view->Bounds().Width();
		editor.view->SetText("a rather longer text than before");
		EXPECT_GT(editor.view->Bounds().Width(), narrow + 50);
		editor.view->SetText("short");
		EXPECT_EQ(narrow, editor.view->Bounds().Width());
	});
}


TEST(TextView, TypingScrollsTheCaretIntoView)
{
	TestWindow window;
	BTextView* view = make_view(BRect(10, 10, 200, 60));
	window.Add(new BScrollView("scroll", view, B_FOLLOW_LEFT_TOP, 0, false, true));
	window.Locked([&] { view->MakeFocus(); });
	for (int i = 0; i < 20; i++)
		window.driver.Type("line\n");
	window.Locked([&] {
		EXPECT_TRUE(view->Bounds().Contains(view->PointAt(view->TextLength()) + BPoint(0, 8)));
		float minimum, maximum;
		view->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
		EXPECT_GT(maximum, 100);
		EXPECT_EQ(maximum, view->ScrollBar(B_VERTICAL)->Value());
	});
	window.driver.Key("Home", B_CONTROL_KEY);
	window.Locked([&] { EXPECT_EQ(0, view->Bounds().top); });
}


TEST(TextView, DrawnTextAppearsAndSelectionIsInverted)
{
	Editor editor;
	editor.driver.Type("MMMM");
	BRect first;
	editor.Locked([&] {
		const BPoint place = editor.view->PointAt(0);
		first.Set(place.x, place.y, editor.view->PointAt(1).x - 1,
			place.y + editor.view->LineHeight(0) - 1);
	});
	const auto count_dark = [&] {
		int32 dark = 0;
		for (float y = first.top; y <= first.bottom; y++) {
			for (float x = first.left; x <= first.right; x++)
				dark += editor.driver.PixelAt(editor.view, BPoint(x, y)).red < 128 ? 1 : 0;
		}
		return dark;
	};
	const int32 plain = count_dark();
	const int32 all = static_cast<int32>((first.Width() + 1) * (first.Height() + 1));
	EXPECT_GT(plain, 5);
	EXPECT_LT(plain, all / 2);
	editor.Locked([&] { editor.view->Select(0, 4); });
	EXPECT_NEAR(all - plain, count_dark(), all / 8);
}


// How many dark pixels the view shows: the caret, where there is no text.
static int32
dark_pixels(Editor& editor)
{
	int32 dark = 0;
	for (int32 y = 0; y < 30; y++) {
		for (int32 x = 0; x < 10; x++)
			dark += editor.driver.PixelAt(editor.view, BPoint(x, y)).red < 128 ? 1 : 0;
	}
	return dark;
}


TEST(TextView, TheCaretBlinksByThePulse)
{
	Editor editor;
	editor.Locked([&] { editor.Window()->SetPulseRate(50000); });
	// Both ends of the change come by themselves; a caret that stays is a hang.
	while (dark_pixels(editor) == 0)
		Driver::WaitUntilIdle();
	while (dark_pixels(editor) != 0)
		Driver::WaitUntilIdle();
	editor.driver.Key("Left");
	EXPECT_NE(0, dark_pixels(editor)); // every key shows it anew
	editor.Locked([&] { editor.view->MakeFocus(false); });
	EXPECT_EQ(0, dark_pixels(editor));
}


TEST(TextView, APointerHeldBelowTheViewScrollsAndSelects)
{
	Editor editor;
	std::string text;
	for (int32 line = 0; line < 100; line++)
		text += "line " + std::to_string(line) + "\n";
	editor.Locked([&] { editor.view->SetText(text.c_str()); });
	int32 pressed = 0;
	editor.Locked([&] { pressed = editor.view->OffsetAt(BPoint(20, 20)); });
	editor.driver.MoveTo(editor.view, BPoint(20, 20));
	editor.driver.Press();
	editor.driver.MoveTo(editor.view, BPoint(20, 220));

	const auto bottom = [&] {
		float result = 0;
		editor.Locked([&] { result = editor.view->Bounds().bottom; });
		return result;
	};
	float end = 0;
	editor.Locked([&] { end = editor.view->PointAt(editor.view->TextLength()).y; });
	while (bottom() < end)
		Driver::WaitUntilIdle();
	editor.driver.Release();
	int32 from, to;
	editor.view->GetSelection(&from, &to);
	EXPECT_EQ(pressed, from);
	EXPECT_EQ(static_cast<int32>(text.size()), to);
	const float rested = bottom();
	Driver::WaitUntilIdle();
	EXPECT_EQ(rested, bottom());
}
