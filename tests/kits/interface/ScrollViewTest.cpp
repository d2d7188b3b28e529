// Scroll views.
#include <gtest/gtest.h>

#include <vector>

#include <AppDefs.h>
#include <ListView.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <TextView.h>
#include <Window.h>

#include "support/TestWindow.h"

namespace {

struct Geometry {
	border_style border;
	BRect frame, target, horizontal, vertical;
};

} // namespace


TEST(ScrollView, LiesAroundItsTarget)
{
	const Geometry kCases[] = {
		{ B_FANCY_BORDER, BRect(-2, -2, 240, 144), BRect(2, 2, 226, 130), BRect(1, 131, 227, 145),
			BRect(227, 1, 241, 131) },
		{ B_PLAIN_BORDER, BRect(-1, -1, 239, 143), BRect(1, 1, 225, 129), BRect(0, 130, 226, 144),
			BRect(226, 0, 240, 130) },
		{ B_NO_BORDER, BRect(0, 0, 239, 143), BRect(0, 0, 224, 128), BRect(0, 129, 225, 143),
			BRect(225, 0, 239, 129) },
	};
	for (const Geometry& expected : kCases) {
		BView* target = new BView(BRect(0, 0, 224, 128), "target", B_FOLLOW_ALL, 0);
		BScrollView view("scroll", target, B_FOLLOW_ALL, 0, true, true, expected.border);
		EXPECT_EQ(expected.frame, view.Frame());
		EXPECT_EQ(expected.target, target->Frame());
		ASSERT_NE(nullptr, view.ScrollBar(B_HORIZONTAL));
		EXPECT_EQ(expected.horizontal, view.ScrollBar(B_HORIZONTAL)->Frame());
		EXPECT_EQ(expected.vertical, view.ScrollBar(B_VERTICAL)->Frame());
		EXPECT_STREQ("_HSB_", view.ScrollBar(B_HORIZONTAL)->Name());
		EXPECT_STREQ("_VSB_", view.ScrollBar(B_VERTICAL)->Name());
		EXPECT_EQ(target, view.ChildAt(0));
		EXPECT_EQ(target, view.Target());
		EXPECT_EQ(expected.border != B_NO_BORDER, (view.Flags() & B_FRAME_EVENTS) != 0);
	}
}


TEST(ScrollView, ANewTargetTakesTheOldOnesPlace)
{
	class Target : public BView {
	public:
		Target() : BView(BRect(0, 0, 50, 50), "target", B_FOLLOW_ALL, 0) {}
		void TargetedByScrollView(BScrollView* view) override { by = view; }
		BScrollView* by = nullptr;
	};
	Target* first = new Target;
	Target second;
	BScrollView view("scroll", first, B_FOLLOW_ALL, 0, true, true);
	EXPECT_EQ(&view, first->by);
	const BRect frame = first->Frame();
	view.SetTarget(&second);
	EXPECT_EQ(NULL, first->by);
	EXPECT_EQ(NULL, first->Parent());
	EXPECT_EQ(&view, second.by);
	EXPECT_EQ(&second, view.ChildAt(0));
	EXPECT_EQ(frame, second.Frame());
	EXPECT_EQ(&second, view.ScrollBar(B_VERTICAL)->Target());
	view.SetTarget(NULL);
	EXPECT_EQ(NULL, view.Target());
	EXPECT_EQ(2, view.CountChildren());
	view.SetTarget(&second);
	view.SetTarget(NULL);
	delete first;
}


TEST(ScrollView, SetBorderMovesThePartsWithinTheFrame)
{
	BView* target = new BView(BRect(0, 0, 224, 128), "target", B_FOLLOW_ALL, 0);
	BScrollView view("scroll", target, B_FOLLOW_ALL, 0, true, true, B_FANCY_BORDER);
	const BRect frame = view.Frame();
	view.SetBorder(B_NO_BORDER);
	EXPECT_EQ(frame, view.Frame());
	EXPECT_EQ(BRect(0, 0, 227, 131), target->Frame());
	view.SetBorder(B_FANCY_BORDER);
	EXPECT_EQ(BRect(2, 2, 226, 130), target->Frame());
	EXPECT_EQ(B_OK, view.SetBorderHighlighted(true));
	EXPECT_TRUE(view.IsBorderHighlighted());
	view.SetBorder(B_PLAIN_BORDER);
	EXPECT_NE(B_OK, view.SetBorderHighlighted(false));
}


TEST(ScrollView, RevivesItsTargetAndBarsByKind)
{
	BView* target = new BView(BRect(0, 0, 100, 100), "target", B_FOLLOW_ALL, 0);
	BScrollView view("scroll", target, B_FOLLOW_ALL, 0, true, true, B_PLAIN_BORDER);
	BMessage archive;
	ASSERT_EQ(B_OK, view.Archive(&archive));
	EXPECT_EQ(B_PLAIN_BORDER, archive.FindInt32("_style"));
	EXPECT_FALSE(archive.HasBool("_no_target_"));

	BScrollView* copy = dynamic_cast<BScrollView*>(BScrollView::Instantiate(&archive));
	ASSERT_NE(nullptr, copy);
	EXPECT_STREQ("target", copy->Target()->Name());
	EXPECT_EQ(copy->Target(), copy->ScrollBar(B_HORIZONTAL)->Target());
	EXPECT_EQ(copy->ScrollBar(B_VERTICAL), copy->Target()->ScrollBar(B_VERTICAL));
	BView* old = copy->Target();
	copy->SetTarget(NULL);
	delete old;
	BMessage second;
	ASSERT_EQ(B_OK, copy->Archive(&second));
	EXPECT_TRUE(second.FindBool("_no_target_"));
	delete copy;
}


namespace {

// The view's scroll view is lit while the view has the focus in an active window.
void
ExpectFocusBorder(BView* view)
{
	TestWindow window;
	BScrollView* scroller =
		window.Add(new BScrollView("scroller", view, B_FOLLOW_NONE, 0, false, true));
	window.driver.ActivateWindow(window.Window());
	const auto lit = [&] {
		bool result = false;
		window.Locked([&] { result = scroller->IsBorderHighlighted(); });
		return result;
	};
	const rgb_color plain = window.driver.PixelAt(scroller, BPoint(30, 1));
	EXPECT_FALSE(lit());
	window.Locked([&] { view->MakeFocus(); });
	EXPECT_TRUE(lit());
	EXPECT_NE(plain, window.driver.PixelAt(scroller, BPoint(30, 1)));

	BWindow* other = new BWindow(BRect(600, 50, 700, 150), "Other", B_TITLED_WINDOW, 0);
	other->Show();
	window.driver.ActivateWindow(other);
	EXPECT_EQ(plain, window.driver.PixelAt(scroller, BPoint(30, 1)));
	window.driver.ActivateWindow(window.Window());
	EXPECT_TRUE(lit());
	BMessenger(other).SendMessage(B_QUIT_REQUESTED);
	Driver::WaitUntilIdle();

	window.Locked([&] { view->MakeFocus(false); });
	EXPECT_FALSE(lit());
	window.Locked([&] { view->MakeFocus(); });
	window.Locked([&] { scroller->SetTarget(NULL); });
	EXPECT_FALSE(lit()) << "its target has gone";
	EXPECT_EQ(plain, window.driver.PixelAt(scroller, BPoint(30, 1)));

	// It may outlive its scroll view.
	window.Locked([&] {
		scroller->SetTarget(view);
		view->RemoveSelf();
		scroller->RemoveSelf();
		delete scroller;
		window.Window()->AddChild(view);
		view->MakeFocus();
		EXPECT_TRUE(view->IsFocus());
	});
}

} // namespace


TEST(ScrollView, ItsBorderShowsTheFocusOfAList)
{
	ExpectFocusBorder(new BListView(BRect(10, 10, 109, 109), "list"));
}


TEST(ScrollView, ItsBorderShowsTheFocusOfAText)
{
	ExpectFocusBorder(new BTextView(
		BRect(10, 10, 109, 109), "text", BRect(2, 2, 97, 97), B_FOLLOW_NONE, B_WILL_DRAW));
}
