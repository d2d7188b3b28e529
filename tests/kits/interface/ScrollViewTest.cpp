// Scroll bars and scroll views.
#include <gtest/gtest.h>

#include <vector>

#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <Window.h>

#include "support/TestWindow.h"

namespace {

class Bar : public BScrollBar {
public:
	Bar(BRect frame, BView* target, orientation direction = B_VERTICAL) :
		BScrollBar(frame, "bar", target, 0, 100, direction)
	{
	}
	void ValueChanged(float value) override { values.push_back(value); }

	std::vector<float> values;
};


struct BarWindow : TestWindow {
	BarWindow()
	{
		target = Add(new BView(BRect(0, 0, 99, 199), "target", B_FOLLOW_NONE, B_WILL_DRAW));
		bar = Add(new Bar(BRect(100, 0, 114, 199), target));
		driver.ActivateWindow(Window());
	}
	BView* target;
	Bar* bar;
};


struct Geometry {
	border_style border;
	BRect frame, target, horizontal, vertical;
};

} // namespace


TEST(ScrollBar, HasTheDocumentedDefaults)
{
	BScrollBar bar(BRect(0, 0, 14, 99), "bar", NULL, 5, 50, B_VERTICAL);
	float small, large, min, max;
	bar.GetSteps(&small, &large);
	bar.GetRange(&min, &max);
	EXPECT_EQ(1, small);
	EXPECT_EQ(10, large);
	EXPECT_EQ(5, min);
	EXPECT_EQ(50, max);
	EXPECT_EQ(5, bar.Value());
	EXPECT_EQ(0, bar.Proportion());
	EXPECT_EQ(uint32(B_FOLLOW_TOP_BOTTOM | B_FOLLOW_RIGHT), bar.ResizingMode());
	EXPECT_EQ(B_TRANSPARENT_COLOR, bar.ViewColor());
	bar.SetRange(10, 3);
	bar.GetRange(&min, &max);
	EXPECT_EQ(0, min);
	EXPECT_EQ(0, max);
	EXPECT_EQ(0, bar.Value());
}


TEST(ScrollBar, ScrollsItsTargetAndFollowsIt)
{
	BarWindow window;
	window.Locked([&] {
		EXPECT_EQ(window.bar, window.target->ScrollBar(B_VERTICAL));
		EXPECT_EQ(NULL, window.target->ScrollBar(B_HORIZONTAL));
		window.bar->SetValue(30.4);
		EXPECT_EQ(30, window.bar->Value());
		EXPECT_EQ(30, window.target->Bounds().top);
		window.target->ScrollTo(0, 70);
		EXPECT_EQ(70, window.bar->Value());
		window.target->ScrollBy(0, 200);
		EXPECT_EQ(100, window.bar->Value());
		EXPECT_EQ(100, window.target->Bounds().top);
		window.bar->SetValue(-5);
		EXPECT_EQ(0, window.target->Bounds().top);
		window.bar->SetValue(0);
	});
	EXPECT_EQ((std::vector<float> { 30, 70, 100, 0 }), window.bar->values);
}


TEST(ScrollBar, ATargetMayDieBeforeItsBarAndTheReverse)
{
	BarWindow window;
	window.Locked([&] {
		window.target->RemoveSelf();
		delete window.target;
		EXPECT_EQ(NULL, window.bar->Target());
		window.bar->SetValue(10);
	});
	BView target(BRect(0, 0, 9, 9), "t", B_FOLLOW_NONE, 0);
	{
		BScrollBar bar(BRect(0, 0, 14, 99), "bar", &target, 0, 10, B_VERTICAL);
		EXPECT_EQ(&bar, target.ScrollBar(B_VERTICAL));
	}
	EXPECT_EQ(NULL, target.ScrollBar(B_VERTICAL));
}


TEST(ScrollBar, ArrowsStepAndTheFreeAreaPages)
{
	BarWindow window;
	window.driver.Click(window.bar, BPoint(7, 192));
	EXPECT_EQ(1, window.bar->Value());
	window.driver.Click(window.bar, BPoint(7, 192), 1, 1, B_SHIFT_KEY);
	EXPECT_EQ(11, window.bar->Value());
	window.driver.Click(window.bar, BPoint(7, 7));
	EXPECT_EQ(10, window.bar->Value());
	window.driver.Click(window.bar, BPoint(7, 170));
	EXPECT_EQ(20, window.bar->Value());
	window.driver.Click(window.bar, BPoint(7, 17));
	EXPECT_EQ(10, window.bar->Value());
}


TEST(ScrollBar, AHeldArrowRepeats)
{
	BarWindow window;
	window.driver.MoveTo(window.bar, BPoint(7, 192));
	window.driver.Press();
	const bigtime_t end = system_time() + 10000000;
	float value = 0;
	while (value < 4 && system_time() < end) {
		snooze(1000);
		window.Locked([&] { value = window.bar->Value(); });
	}
	window.driver.Release();
	EXPECT_GE(value, 4);
}


TEST(ScrollBar, TheThumbScrollsLive)
{
	BarWindow window;
	window.driver.MoveTo(window.bar, BPoint(7, 20));
	window.driver.Press();
	window.driver.MoveTo(window.bar, BPoint(7, 98));
	const float middle = window.bar->Value();
	EXPECT_GT(middle, 40);
	EXPECT_LT(middle, 60);
	EXPECT_EQ(middle, window.target->Bounds().top);
	window.driver.MoveTo(window.bar, BPoint(7, 500));
	EXPECT_EQ(100, window.bar->Value());
	window.driver.Release();
	window.driver.MoveTo(window.bar, BPoint(7, 20));
	EXPECT_EQ(100, window.bar->Value());

	// The other button brings the thumb to the pointer.
	window.driver.Click(window.bar, BPoint(7, 100), 1, B_SECONDARY_MOUSE_BUTTON);
	EXPECT_NEAR(50, window.bar->Value(), 5);
}


TEST(ScrollBar, WithoutARangeItReactsToNothing)
{
	BarWindow window;
	window.Locked([&] { window.bar->SetProportion(1); });
	window.driver.Click(window.bar, BPoint(7, 192));
	EXPECT_EQ(0, window.bar->Value());
	window.Locked([&] {
		window.bar->SetProportion(0.5);
		window.bar->SetRange(0, 0);
	});
	window.driver.Click(window.bar, BPoint(7, 192));
	EXPECT_EQ(0, window.bar->Value());
}


TEST(ScrollBar, TheWheelScrollsTheViewsBar)
{
	BarWindow window;
	window.driver.Wheel(window.target, 0, 2);
	EXPECT_EQ(6, window.bar->Value());
	window.driver.Wheel(window.bar, 0, -1);
	EXPECT_EQ(3, window.bar->Value());
}


TEST(ScrollBar, IsArchivedFieldForField)
{
	BScrollBar bar(BRect(0, 0, 99, 14), "bar", NULL, -5, 50, B_HORIZONTAL);
	bar.SetValue(7);
	bar.SetSteps(2, 20);
	bar.SetProportion(0.25);
	BMessage archive;
	ASSERT_EQ(B_OK, bar.Archive(&archive));
	EXPECT_EQ(-5, archive.FindFloat("_range", 0));
	EXPECT_EQ(50, archive.FindFloat("_range", 1));
	EXPECT_EQ(2, archive.FindFloat("_steps", 0));
	EXPECT_EQ(20, archive.FindFloat("_steps", 1));
	EXPECT_EQ(7, archive.FindFloat("_val"));
	EXPECT_EQ(B_HORIZONTAL, archive.FindInt32("_orient"));
	EXPECT_EQ(0.25, archive.FindFloat("_prop"));
	BScrollBar* copy = dynamic_cast<BScrollBar*>(BScrollBar::Instantiate(&archive));
	ASSERT_NE(nullptr, copy);
	EXPECT_EQ(7, copy->Value());
	EXPECT_EQ(B_HORIZONTAL, copy->Orientation());
	delete copy;
}


// #pragma mark - BScrollView


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
