#include <TextView.h>

#include <gtest/gtest.h>

#include <Clipboard.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>

#include "support/TestWindow.h"

namespace {

const BRect kFrame(10, 10, 309, 209);

BTextView*
make_view(BRect frame = kFrame)
{
	BRect textRect = frame;
	textRect.OffsetTo(0, 0);
	textRect.InsetBy(2, 2);
	return new BTextView(frame, "text", textRect, B_FOLLOW_ALL, B_WILL_DRAW);
}


void
expect_selection(const BTextView* view, int32 from, int32 to)
{
	int32 start, end;
	view->GetSelection(&start, &end);
	EXPECT_EQ(from, start);
	EXPECT_EQ(to, end);
}

// A focused text view in a window.
struct Editor : TestWindow {
	Editor() : view(Add(make_view()))
	{
		Locked([this] { view->MakeFocus(); });
	}

	BTextView* view;
};

} // namespace


TEST(TextView, StartsEditableSelectableWrappedAndEmpty)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(make_view());
	EXPECT_TRUE(view->IsEditable());
	EXPECT_TRUE(view->IsSelectable());
	EXPECT_TRUE(view->DoesWordWrap());
	EXPECT_TRUE(view->DoesUndo());
	EXPECT_FALSE(view->IsStylable());
	EXPECT_FALSE(view->DoesAutoindent());
	EXPECT_FALSE(view->IsResizable());
	EXPECT_FALSE(view->IsTypingHidden());
	EXPECT_EQ(28, view->TabWidth());
	EXPECT_EQ(B_CMAP8, view->ColorSpace());
	EXPECT_EQ(B_ALIGN_LEFT, view->Alignment());
	EXPECT_EQ(INT32_MAX, view->MaxBytes());
	EXPECT_STREQ("", view->Text());
	EXPECT_EQ(1, view->CountLines());
	EXPECT_EQ(B_WILL_DRAW | B_PULSE_NEEDED | B_FRAME_EVENTS | B_INPUT_METHOD_AWARE, view->Flags());
}


TEST(TextView, TypedTextAppearsAtTheCaret)
{
	Editor editor;
	editor.driver.Type("Hello");
	EXPECT_STREQ("Hello", editor.view->Text());
	editor.driver.Key("Left", 0, 2);
	editor.driver.Type("XX");
	EXPECT_STREQ("HelXXlo", editor.view->Text());
	expect_selection(editor.view, 5, 5);
}


TEST(TextView, ArrowsStepOverWholeCharactersOfEveryScript)
{
	Editor editor;
	// Latin, Greek, Cyrillic, Hebrew, Arabic, Thai, Chinese, an emoji: 1 to 4 bytes each.
	const char* characters[] = { "a", "\xc3\xa9", "\xce\xb1", "\xd0\x96", "\xd7\x90", "\xd8\xa8",
		"\xe0\xb8\x81", "\xe4\xb8\xad", "\xf0\x9f\x98\x80" };
	std::string text;
	for (const char* character : characters)
		text += character;
	editor.driver.Type(text);
	EXPECT_EQ(text, editor.view->Text());

	// The Hebrew and the Arabic letter run from the right: the Hebrew one, the first, comes first.
	for (const int32 offset : { 17, 14, 11, 9, 11, 5, 3, 1, 0 }) {
		editor.driver.Key("Left");
		expect_selection(editor.view, offset, offset);
	}
	editor.driver.Key("Delete");
	EXPECT_EQ(text.substr(1), editor.view->Text());
	editor.driver.Key("End");
	editor.driver.Key("Backspace", 0, 2);
	EXPECT_EQ(text.substr(1, text.size() - 8), editor.view->Text());
}


TEST(TextView, CaretDoesNotStopBetweenALetterAndItsAccent)
{
	Editor editor;
	editor.driver.Type("e\xcc\x81x"); // e, combining acute, x
	editor.driver.Key("Home");
	editor.driver.Key("Right");
	expect_selection(editor.view, 3, 3);
	editor.driver.Key("Left");
	expect_selection(editor.view, 0, 0);
}


TEST(TextView, ShiftExtendsTheSelectionAndTypingReplacesIt)
{
	Editor editor;
	editor.driver.Type("one two");
	editor.driver.Key("Left", B_SHIFT_KEY, 3);
	expect_selection(editor.view, 4, 7);
	editor.driver.Type("2");
	EXPECT_STREQ("one 2", editor.view->Text());
}


TEST(TextView, ControlMovesAndErasesByWords)
{
	Editor editor;
	editor.driver.Type("one two three");
	editor.driver.Key("Left", B_CONTROL_KEY);
	expect_selection(editor.view, 8, 8);
	editor.driver.Key("Left", B_CONTROL_KEY);
	expect_selection(editor.view, 4, 4);
	editor.driver.Key("Right", B_CONTROL_KEY);
	expect_selection(editor.view, 7, 7);
	editor.driver.Key("Backspace", B_CONTROL_KEY);
	EXPECT_STREQ("one  three", editor.view->Text());
	editor.driver.Key("Home", B_CONTROL_KEY);
	expect_selection(editor.view, 0, 0);
}


TEST(TextView, UpAndDownKeepTheColumnOverShortLines)
{
	Editor editor;
	editor.driver.Type("long line\nx\nlong line");
	expect_selection(editor.view, 21, 21);
	editor.driver.Key("Up");
	expect_selection(editor.view, 11, 11);
	editor.driver.Key("Up");
	expect_selection(editor.view, 9, 9);
}


TEST(TextView, ClicksPlaceTheCaretAndSelectWordsAndLines)
{
	Editor editor;
	editor.driver.Type("one two\nthree");
	BPoint place;
	editor.Locked([&] { place = editor.view->PointAt(5) + BPoint(1, 4); });
	editor.driver.Click(editor.view, place);
	expect_selection(editor.view, 5, 5);
	editor.driver.Click(editor.view, place, 2);
	expect_selection(editor.view, 4, 7);
	editor.driver.Click(editor.view, place, 3);
	expect_selection(editor.view, 0, 8);
}


TEST(TextView, DraggingSelectsInBothDirections)
{
	Editor editor;
	editor.driver.Type("one two three");
	BPoint a, b;
	editor.Locked([&] {
		a = editor.view->PointAt(2) + BPoint(0, 4);
		b = editor.view->PointAt(9) + BPoint(0, 4);
	});
	editor.driver.Drag(editor.view, a, editor.view, b);
	expect_selection(editor.view, 2, 9);
	editor.driver.Click(editor.view, BPoint(200, 100));
	editor.driver.Drag(editor.view, b, editor.view, a);
	expect_selection(editor.view, 2, 9);
}


TEST(TextView, SelectedTextIsMovedByDragging)
{
	Editor editor;
	editor.driver.Type("one two three ");
	BPoint from, to;
	editor.Locked([&] {
		editor.view->Select(0, 4);
		from = editor.view->PointAt(2) + BPoint(0, 4);
		to = editor.view->PointAt(14) + BPoint(0, 4);
	});
	editor.driver.Drag(editor.view, from, editor.view, to);
	EXPECT_STREQ("two three one ", editor.view->Text());
	expect_selection(editor.view, 10, 14);
	editor.driver.Key("z", B_CONTROL_KEY);
	EXPECT_STREQ("one two three ", editor.view->Text());
}


TEST(TextView, TextDraggedToAnotherViewIsCopied)
{
	Editor editor;
	BTextView* other = editor.Add(make_view(BRect(10, 220, 309, 260)));
	editor.driver.Type("source");
	BPoint from;
	editor.Locked([&] {
		editor.view->SelectAll();
		from = editor.view->PointAt(2) + BPoint(0, 4);
	});
	editor.driver.Drag(editor.view, from, other, BPoint(5, 5));
	EXPECT_STREQ("source", other->Text());
	EXPECT_STREQ("source", editor.view->Text());
}


TEST(TextView, CutCopyAndPasteUseTheClipboard)
{
	Editor editor;
	editor.driver.Type("one two");
	editor.driver.Key("Left", B_SHIFT_KEY, 3);
	editor.driver.Key("x", B_CONTROL_KEY);
	EXPECT_STREQ("one ", editor.view->Text());
	editor.driver.Key("Home");
	editor.driver.Key("v", B_CONTROL_KEY);
	EXPECT_STREQ("twoone ", editor.view->Text());
	editor.driver.Key("a", B_CONTROL_KEY);
	editor.driver.Key("c", B_CONTROL_KEY);
	editor.driver.Key("End");
	editor.driver.Key("v", B_CONTROL_KEY);
	EXPECT_STREQ("twoone twoone ", editor.view->Text());
}


TEST(TextView, StyledTextKeepsItsRunsOverTheClipboard)
{
	Editor editor;
	const rgb_color red = { 200, 0, 0, 255 };
	editor.Locked([&] {
		editor.view->SetStylable(true);
		editor.view->SetText("plain red plain");
		BFont large(be_plain_font);
		large.SetSize(20);
		editor.view->SetFontAndColor(6, 9, &large, B_FONT_SIZE, &red);
		editor.view->Select(4, 11);
		editor.view->Copy(be_clipboard);
		editor.view->Select(0, 0);
		editor.view->Paste(be_clipboard);
		EXPECT_STREQ("n red pplain red plain", editor.view->Text());
		BFont font;
		rgb_color color;
		editor.view->GetFontAndColor(3, &font, &color);
		EXPECT_EQ(20, font.Size());
		EXPECT_EQ(red, color);
		editor.view->GetFontAndColor(0, &font, &color);
		EXPECT_EQ(be_plain_font->Size(), font.Size());
		EXPECT_EQ(0, color.red);
	});
}


TEST(TextView, UndoTakesTypingBackAsAWholeAndRedoBringsItAgain)
{
	Editor editor;
	editor.driver.Type("hello");
	bool isRedo = true;
	EXPECT_EQ(B_UNDO_TYPING, editor.view->UndoState(&isRedo));
	EXPECT_FALSE(isRedo);
	editor.driver.Key("z", B_CONTROL_KEY);
	EXPECT_STREQ("", editor.view->Text());
	EXPECT_EQ(B_UNDO_TYPING, editor.view->UndoState(&isRedo));
	EXPECT_TRUE(isRedo);
	editor.driver.Key("z", B_CONTROL_KEY | B_SHIFT_KEY);
	EXPECT_STREQ("hello", editor.view->Text());
	expect_selection(editor.view, 5, 5);
}


TEST(TextView, MovingTheCaretBeginsANewUndoStep)
{
	Editor editor;
	editor.driver.Type("ab");
	editor.driver.Key("Left");
	editor.driver.Type("c");
	EXPECT_STREQ("acb", editor.view->Text());
	editor.driver.Key("z", B_CONTROL_KEY);
	EXPECT_STREQ("ab", editor.view->Text());
	editor.driver.Key("z", B_CONTROL_KEY);
	EXPECT_STREQ("", editor.view->Text());
}


TEST(TextView, MaxBytesStopsTypingAndCutsPastedTextAtACharacter)
{
	Editor editor;
	editor.Locked([&] { editor.view->SetMaxBytes(4); });
	editor.driver.Type("abcdef");
	EXPECT_STREQ("abcd", editor.view->Text());
	editor.Locked([&] {
		editor.view->SetText("");
		editor.view->Insert("ab\xe4\xb8\xad");
	});
	EXPECT_STREQ("ab", editor.view->Text());
}


TEST(TextView, DisallowedCharactersAreNotTyped)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->DisallowChar('b');
		editor.view->DisallowChar(0xe9);
	});
	editor.driver.Type("abc\xc3\xa9");
	EXPECT_STREQ("ac", editor.view->Text());
	editor.Locked([&] { editor.view->AllowChar('b'); });
	editor.driver.Type("b");
	EXPECT_STREQ("acb", editor.view->Text());
}


TEST(TextView, AutoindentRepeatsTheBlanksOfTheLine)
{
	Editor editor;
	editor.Locked([&] { editor.view->SetAutoindent(true); });
	editor.driver.Type("  a\nb");
	EXPECT_STREQ("  a\n  b", editor.view->Text());
}


TEST(TextView, ReadOnlyTextIsSelectedButNotChanged)
{
	Editor editor;
	editor.Locked([&] {
		editor.view->SetText("fixed");
		editor.view->MakeEditable(false);
	});
	editor.driver.Key("Right", B_SHIFT_KEY);
	editor.driver.Type("x");
	EXPECT_STREQ("fixed", editor.view->Text());
	expect_selection(editor.view, 0, 1);
}


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


TEST(TextView, RunArraysSurviveFlattening)
{
	BApplication app("application/x-vnd.Archway-test");
	text_run_array* runs = BTextView::AllocRunArray(2);
	runs->runs[0] = { 0, *be_bold_font, { 1, 2, 3, 255 } };
	runs->runs[1] = { 7, *be_plain_font, { 4, 5, 6, 255 } };
	runs->runs[1].font.SetSize(17);
	int32 size;
	void* flat = BTextView::FlattenRunArray(runs, &size);
	EXPECT_EQ(12 + 2 * 148, size);
	EXPECT_EQ(0, memcmp(flat, "Ali!\0\0\0\0\0\0\0\2\0\0\0\0", 16));
	text_run_array* read = BTextView::UnflattenRunArray(flat);
	ASSERT_NE(nullptr, read);
	ASSERT_EQ(2, read->count);
	EXPECT_EQ(7, read->runs[1].offset);
	EXPECT_EQ(17, read->runs[1].font.Size());
	EXPECT_EQ(be_bold_font->FamilyAndStyle(), read->runs[0].font.FamilyAndStyle());
	EXPECT_EQ(6, read->runs[1].color.blue);
	free(flat);
	BTextView::FreeRunArray(read);
	BTextView::FreeRunArray(runs);
}


TEST(TextView, ArchiveRoundTripKeepsEverything)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(make_view());
	view->SetStylable(true);
	view->SetText("some bold text");
	view->SetFontAndColor(5, 9, be_bold_font, B_FONT_FAMILY_AND_STYLE);
	view->SetAlignment(B_ALIGN_CENTER);
	view->SetTabWidth(40);
	view->SetMaxBytes(500);
	view->SetWordWrap(false);
	view->MakeEditable(false);
	view->SetAutoindent(true);
	view->DisallowChar('q');
	view->Select(2, 6);
	BMessage archive;
	ASSERT_EQ(B_OK, view->Archive(&archive));

	BArchivable* object = instantiate_object(&archive);
	const std::unique_ptr<BTextView> revived(dynamic_cast<BTextView*>(object));
	ASSERT_NE(nullptr, revived);
	EXPECT_STREQ("some bold text", revived->Text());
	EXPECT_EQ(B_ALIGN_CENTER, revived->Alignment());
	EXPECT_EQ(40, revived->TabWidth());
	EXPECT_EQ(500, revived->MaxBytes());
	EXPECT_FALSE(revived->DoesWordWrap());
	EXPECT_FALSE(revived->IsEditable());
	EXPECT_TRUE(revived->DoesAutoindent());
	expect_selection(revived.get(), 2, 6);
	BFont font;
	revived->GetFontAndColor(6, &font);
	EXPECT_EQ(be_bold_font->FamilyAndStyle(), font.FamilyAndStyle());

	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


// #pragma mark - input methods


namespace {

void
send_method(Editor& editor, int32 code, const char* string, bool confirmed)
{
	BMessage event(B_INPUT_METHOD_EVENT);
	event.AddInt32("be:opcode", code);
	if (string != NULL)
		event.AddString("be:string", string);
	if (confirmed)
		event.AddBool("be:confirmed", true);
	editor.Window()->PostMessage(&event, editor.view);
	Driver::WaitUntilIdle();
}

} // namespace


TEST(TextView, ComposedTextIsShownAndReplacedUntilItIsConfirmed)
{
	Editor editor;
	editor.driver.Type("ab");
	editor.driver.Key("Left");
	send_method(editor, 0, NULL, false);
	send_method(editor, 2, "n", false);
	EXPECT_STREQ("anb", editor.view->Text());
	send_method(editor, 2, "\xe3\x81\xab", false);
	EXPECT_STREQ("a\xe3\x81\xab"
				 "b",
		editor.view->Text());
	send_method(editor, 2, "\xe4\xba\x8c", true);
	send_method(editor, 1, NULL, false);
	EXPECT_STREQ("a\xe4\xba\x8c"
				 "b",
		editor.view->Text());
	expect_selection(editor.view, 4, 4);
	editor.driver.Key("z", B_CONTROL_KEY);
	EXPECT_STREQ("ab", editor.view->Text());
}


TEST(TextView, ComposedTextThatIsNotConfirmedGoes)
{
	Editor editor;
	editor.driver.Type("x");
	send_method(editor, 0, NULL, false);
	send_method(editor, 2, "abc", false);
	send_method(editor, 1, NULL, false);
	EXPECT_STREQ("x", editor.view->Text());
}


TEST(TextView, HiddenTypingShowsBulletsAndIsNotCopied)
{
	Editor editor;
	editor.Locked([&] { editor.view->HideTyping(true); });
	editor.driver.Type("iiii");
	editor.Locked([&] {
		EXPECT_NEAR(4 * editor.view->StringWidth(B_UTF8_BULLET), editor.view->LineWidth(0), 2);
		be_clipboard->Lock();
		be_clipboard->Clear();
		be_clipboard->Commit();
		be_clipboard->Unlock();
		editor.view->SelectAll();
		editor.view->Copy(be_clipboard);
		EXPECT_FALSE(editor.view->AcceptsPaste(be_clipboard));
	});
	EXPECT_STREQ("iiii", editor.view->Text());
}
