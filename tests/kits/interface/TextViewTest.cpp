#include <TextView.h>

#include <gtest/gtest.h>

#include <Clipboard.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>

#include "TextEditor.h"


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
