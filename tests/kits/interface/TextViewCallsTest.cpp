// Calls and hooks of a text view beside its editing.
#include <TextView.h>

#include <memory>
#include <string>

#include <Bitmap.h>
#include <Clipboard.h>
#include <Region.h>
#include <ScrollBar.h>
#include <ScrollView.h>

#include "ControlFixture.h"

namespace {

constexpr const char* kText = "one two\nthree-four\nfive";


BTextView*
NewView(const char* text = kText)
{
	const BRect frame(10, 10, 209, 109);
	BTextView* view = new BTextView(
		frame, "text", frame.OffsetToCopy(0, 0).InsetByCopy(2, 2), B_FOLLOW_NONE, B_WILL_DRAW);
	view->SetText(text);
	return view;
}


std::string
WordAt(BTextView& view, int32 offset)
{
	int32 from, to;
	view.FindWord(offset, &from, &to);
	return std::string(view.Text() + from, static_cast<size_t>(to - from));
}


std::string
Selection(BTextView& view)
{
	int32 from, to;
	view.GetSelection(&from, &to);
	return std::string(view.Text() + from, static_cast<size_t>(to - from));
}

} // namespace


TEST(TextViewCalls, LinesAreFoundByOffsetAndPlace)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(NewView());
	EXPECT_EQ(3, view->CountLines());
	EXPECT_EQ(0, view->LineAt(int32(0)));
	EXPECT_EQ(0, view->LineAt(int32(7)));
	EXPECT_EQ(1, view->LineAt(int32(8)));
	EXPECT_EQ(2, view->LineAt(int32(1000)));
	EXPECT_EQ(1, view->LineAt(BPoint(5, 2 + view->LineHeight(0) + 1)));

	EXPECT_EQ(0, view->CurrentLine());
	view->GoToLine(2);
	EXPECT_EQ(2, view->CurrentLine());
	int32 from, to;
	view->GetSelection(&from, &to);
	EXPECT_EQ(19, from);
	EXPECT_EQ(19, to);
}


TEST(TextViewCalls, GetTextCopiesAPartAndEndsIt)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(NewView());
	char buffer[16];
	std::fill_n(buffer, sizeof(buffer), 'x');
	view->GetText(4, 3, buffer);
	EXPECT_STREQ("two", buffer);
	EXPECT_EQ('x', buffer[4]);
	view->GetText(19, 12, buffer);
	EXPECT_STREQ("five", buffer);
}


TEST(TextViewCalls, FindWordTakesWordsBlanksAndSigns)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(NewView());
	EXPECT_EQ("one", WordAt(*view, 1));
	EXPECT_EQ(" ", WordAt(*view, 3));
	EXPECT_EQ("three", WordAt(*view, 8));
	EXPECT_EQ("-", WordAt(*view, 13));
	EXPECT_EQ("four", WordAt(*view, 17));
}


TEST(TextViewCalls, FindWordOfAClassDecidesWhatADoubleClickSelects)
{
	class WholeLines : public BTextView {
	public:
		using BTextView::BTextView;
		void FindWord(int32, int32* from, int32* to) override
		{
			*from = 8;
			*to = 18;
		}
	};
	ControlFixture fixture;
	BTextView* view = fixture.Add(new WholeLines(
		BRect(10, 10, 209, 109), "text", BRect(2, 2, 197, 97), B_FOLLOW_NONE, B_WILL_DRAW));
	fixture.Locked([&] { view->SetText(kText); });
	const BPoint where = fixture.Locked([&] { return view->PointAt(10) + BPoint(1, 4); });
	fixture.driver.Click(view, where, 2);
	EXPECT_EQ("three-four", fixture.Locked([&] { return Selection(*view); }));
}


TEST(TextViewCalls, LinesEndWhereCanEndLineAllows)
{
	class AnyWhere : public BTextView {
	public:
		using BTextView::BTextView;
		bool CanEndLine(int32 offset) override { return free || BTextView::CanEndLine(offset); }
		bool free = false;
	};
	BApplication app("application/x-vnd.Archway-test");
	AnyWhere view(BRect(0, 0, 99, 99), "text", BRect(0, 0, 60, 99), B_FOLLOW_NONE, B_WILL_DRAW);
	view.SetText("aaa bbbbbbbbbb cc");
	EXPECT_TRUE(view.CanEndLine(3));
	EXPECT_FALSE(view.CanEndLine(1));
	EXPECT_EQ(4, view.OffsetAt(int32(1))) << "behind the blank";
	view.free = true;
	view.SetText("aaa bbbbbbbbbb cc");
	EXPECT_GT(view.OffsetAt(int32(1)), 4) << "within the long word";
}


TEST(TextViewCalls, GetTextRegionHoldsTheCharacters)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(NewView());
	BRegion region;
	view->GetTextRegion(4, 7, &region);
	const BPoint start = view->PointAt(4), end = view->PointAt(7);
	EXPECT_EQ(1, region.CountRects());
	EXPECT_NEAR(start.x, region.Frame().left, 1);
	EXPECT_NEAR(end.x, region.Frame().right + 1, 1);
	EXPECT_EQ(start.y, region.Frame().top);
	EXPECT_EQ(start.y + view->LineHeight(0) - 1, region.Frame().bottom);

	view->GetTextRegion(4, 20, &region);
	EXPECT_FALSE(region.Contains(BPoint(start.x - 4, start.y + 4)));
	EXPECT_TRUE(region.Contains(BPoint(start.x + 4, start.y + 4)));
	EXPECT_TRUE(region.Contains(BPoint(4, start.y + view->LineHeight(0) + 4)));
	view->GetTextRegion(7, 7, &region);
	EXPECT_EQ(0, region.CountRects());
}


TEST(TextViewCalls, HighlightInvertsUntilItIsTakenBack)
{
	ControlFixture fixture;
	BTextView* view = fixture.Add(NewView("WWWW"));
	const BPoint gap(2 + view->StringWidth("WWWW") + 20, 6);
	const rgb_color white = { 255, 255, 255, 255 };
	const BPoint corner(3, 3);
	ASSERT_EQ(white, fixture.driver.PixelAt(view, corner));
	fixture.Locked([&] { view->Highlight(0, 4); });
	EXPECT_NE(white, fixture.driver.PixelAt(view, corner));
	EXPECT_EQ(white, fixture.driver.PixelAt(view, gap));
	fixture.Locked([&] { view->Highlight(0, 4); });
	EXPECT_EQ(white, fixture.driver.PixelAt(view, corner));
}


TEST(TextViewCalls, ScrollToOffsetShowsTheCharacter)
{
	ControlFixture fixture;
	std::string text;
	for (int i = 0; i < 100; i++)
		text += "line\n";
	BTextView* view = NewView(text.c_str());
	fixture.Add(new BScrollView("scroller", view, B_FOLLOW_NONE, 0, false, true));
	fixture.Locked([&] {
		EXPECT_EQ(0, view->Bounds().top);
		view->ScrollToOffset(5 * 60);
		const BPoint place = view->PointAt(5 * 60);
		EXPECT_TRUE(view->Bounds().Contains(place));
		EXPECT_TRUE(view->Bounds().Contains(place + BPoint(0, view->LineHeight() - 1)));
		view->ScrollToOffset(0);
		EXPECT_EQ(0, view->Bounds().top);
	});
}


TEST(TextViewCalls, CutTakesTheSelectionToTheClipboard)
{
	ControlFixture fixture;
	BTextView* view = fixture.Add(NewView());
	BClipboard clipboard("test of cutting");
	fixture.Locked([&] {
		view->Select(0, 4);
		view->Cut(&clipboard);
		EXPECT_STREQ("two\nthree-four\nfive", view->Text());
		EXPECT_TRUE(view->AcceptsPaste(&clipboard));
		view->GoToLine(2);
		view->Paste(&clipboard);
		EXPECT_STREQ("two\nthree-four\none five", view->Text());
	});
}


TEST(TextViewCalls, AcceptsDropOfTextWhileItMayBeEdited)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(NewView());
	BMessage text(B_MIME_DATA), file(B_SIMPLE_DATA), wrongType(B_MIME_DATA);
	text.AddData("text/plain", B_MIME_TYPE, "abc", 3);
	wrongType.AddString("text/plain", "abc");
	EXPECT_TRUE(view->AcceptsDrop(&text));
	EXPECT_FALSE(view->AcceptsDrop(&file));
	EXPECT_FALSE(view->AcceptsDrop(&wrongType));
	EXPECT_FALSE(view->AcceptsDrop(NULL));
	view->MakeEditable(false);
	EXPECT_FALSE(view->AcceptsDrop(&text));
}


TEST(TextViewCalls, RunsAreSetCopiedAndRead)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BTextView> view(NewView());
	view->SetStylable(true);
	const rgb_color red = { 255, 0, 0, 255 };
	text_run_array* runs = BTextView::AllocRunArray(2);
	runs->runs[0] = { 0, *be_plain_font, { 0, 0, 0, 255 } };
	runs->runs[1] = { 4, *be_bold_font, red };
	view->SetRunArray(0, 7, runs);
	BFont font;
	rgb_color color;
	view->GetFontAndColor(2, &font, &color);
	EXPECT_EQ(*be_plain_font, font);
	view->GetFontAndColor(5, &font, &color);
	EXPECT_EQ(*be_bold_font, font);
	EXPECT_EQ(red, color);

	text_run_array* copy = BTextView::CopyRunArray(runs, 1);
	ASSERT_NE(nullptr, copy);
	EXPECT_EQ(3, copy->count);
	EXPECT_EQ(4, copy->runs[1].offset);
	EXPECT_EQ(red, copy->runs[1].color);
	EXPECT_EQ(nullptr, BTextView::CopyRunArray(NULL));
	BTextView::FreeRunArray(copy);
	BTextView::FreeRunArray(runs);
}


TEST(TextViewCalls, WithoutUndoNothingIsTakenBack)
{
	ControlFixture fixture;
	BTextView* view = fixture.Add(NewView(""));
	fixture.Focus(view);
	fixture.driver.Type("abc");
	fixture.Locked([&] {
		bool isRedo;
		EXPECT_EQ(B_UNDO_TYPING, view->UndoState(&isRedo));
		view->SetDoesUndo(false);
		EXPECT_FALSE(view->DoesUndo());
		EXPECT_EQ(B_UNDO_UNAVAILABLE, view->UndoState(&isRedo));
		view->Undo(be_clipboard);
		EXPECT_STREQ("abc", view->Text());
	});
}


TEST(TextViewCalls, EveryChangeGoesThroughInsertTextAndDeleteText)
{
	class Noting : public BTextView {
	public:
		using BTextView::BTextView;
		void InsertText(
			const char* text, int32 length, int32 offset, const text_run_array* runs) override
		{
			changes += "+" + std::string(text, static_cast<size_t>(length)) + "@"
				+ std::to_string(offset) + " ";
			BTextView::InsertText(text, length, offset, runs);
		}
		void DeleteText(int32 from, int32 to) override
		{
			changes += "-" + std::to_string(from) + ".." + std::to_string(to) + " ";
			BTextView::DeleteText(from, to);
		}
		std::string changes;
	};
	ControlFixture fixture;
	Noting* view = fixture.Add(new Noting(
		BRect(10, 10, 209, 109), "text", BRect(2, 2, 197, 97), B_FOLLOW_NONE, B_WILL_DRAW));
	fixture.Focus(view);
	fixture.driver.Type("ab");
	fixture.driver.Key("Backspace");
	EXPECT_EQ("+a@0 +b@1 -1..2 ", view->changes);
	fixture.Locked([&] {
		view->changes.clear();
		view->Insert("xyz");
		view->Delete(0, 2);
	});
	EXPECT_EQ("+xyz@1 -0..2 ", view->changes);
}


TEST(TextViewCalls, GetDragParametersOfAClassDecidesWhatIsDragged)
{
	class Dragged : public BTextView {
	public:
		using BTextView::BTextView;
		void GetDragParameters(
			BMessage* drag, BBitmap** bitmap, BPoint* point, BHandler** handler) override
		{
			BTextView::GetDragParameters(drag, bitmap, point, handler);
			drag->AddString("extra", "more");
			drag->AddPointer("source", this); // the window notes such messages
		}
	};
	ControlFixture fixture;
	BTextView* view = fixture.Add(new Dragged(
		BRect(10, 10, 209, 109), "text", BRect(2, 2, 197, 97), B_FOLLOW_NONE, B_WILL_DRAW));
	fixture.Locked([&] {
		view->SetText("WWWWWWWW");
		view->SelectAll();
	});
	fixture.Focus(view);
	fixture.driver.Drag(
		Driver::PointIn(view, BPoint(20, 8)), fixture.window->Frame().LeftTop() + BPoint(300, 250));
	const std::vector<BMessage> dropped = fixture.Received(B_MIME_DATA);
	// The ground passes what it does not understand on to its window.
	ASSERT_EQ(1u, dropped.size());
	EXPECT_STREQ("more", dropped[0].GetString("extra", ""));
	const void* data;
	ssize_t size;
	ASSERT_EQ(B_OK, dropped[0].FindData("text/plain", B_MIME_TYPE, &data, &size));
	EXPECT_EQ("WWWWWWWW", std::string(static_cast<const char*>(data), size_t(size)));
}


TEST(TextViewCalls, ItsPreferredSizeHoldsItsText)
{
	ControlFixture fixture;
	BTextView* view = fixture.Add(NewView());
	fixture.Locked([&] {
		view->SetWordWrap(false);
		float width, height;
		view->GetPreferredSize(&width, &height);
		EXPECT_GE(width, view->LineWidth(1));
		EXPECT_GE(height, view->TextHeight(0, 2));
		view->ResizeToPreferred();
		EXPECT_EQ(width, view->Frame().Width());
		EXPECT_EQ(height, view->Frame().Height());
	});
}
