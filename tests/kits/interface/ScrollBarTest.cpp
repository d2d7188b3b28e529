#include <ScrollBar.h>

#include <gtest/gtest.h>

#include <vector>

#include <AppDefs.h>
#include <Message.h>
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


// As the palettes of programs.
TEST(ScrollBar, ShowsItsThumbWhereTheWindowIsActiveOrNeverBecomesSo)
{
	TestWindow active(BRect(400, 400, 500, 500));
	for (const uint32 flags : { uint32(0), uint32(B_AVOID_FOCUS) }) {
		BWindow* window = new BWindow(BRect(50, 50, 149, 249), "bar", B_TITLED_WINDOW, flags);
		Bar* bar = new Bar(BRect(0, 0, 14, 199), NULL);
		window->AddChild(bar);
		window->Show();
		Driver::WaitUntilIdle();
		active.driver.ActivateWindow(active.Window());
		ASSERT_FALSE(window->IsActive());
		const rgb_color thumb = active.driver.PixelAt(bar, BPoint(7, 20));
		const rgb_color track = active.driver.PixelAt(bar, BPoint(7, 150));
		EXPECT_EQ(flags == B_AVOID_FOCUS, thumb != track);
		window->Lock();
		window->Quit();
	}
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


TEST(ScrollBar, ItsTargetIsFoundByItsName)
{
	BarWindow window;
	BView* other = window.Add(new BView(BRect(200, 0, 299, 99), "other", 0, B_WILL_DRAW));
	window.Locked([&] {
		window.bar->SetTarget("other");
		EXPECT_EQ(other, window.bar->Target());
		EXPECT_EQ(NULL, window.target->ScrollBar(B_VERTICAL));
		EXPECT_EQ(window.bar, other->ScrollBar(B_VERTICAL));
		window.bar->SetValue(20);
		EXPECT_EQ(20, other->Bounds().top);
		window.bar->SetTarget("nobody");
		EXPECT_EQ(NULL, window.bar->Target());
		window.bar->SetTarget(other);
		window.bar->SetTarget(static_cast<const char*>(NULL));
		EXPECT_EQ(NULL, window.bar->Target());
	});
}


TEST(ScrollBar, SetOrientationTurnsItAndItsTarget)
{
	BarWindow window;
	window.Locked([&] {
		window.bar->SetOrientation(B_HORIZONTAL);
		EXPECT_EQ(B_HORIZONTAL, window.bar->Orientation());
		EXPECT_EQ(window.target, window.bar->Target());
		EXPECT_EQ(NULL, window.target->ScrollBar(B_VERTICAL));
		EXPECT_EQ(window.bar, window.target->ScrollBar(B_HORIZONTAL));
		window.bar->SetValue(15);
		EXPECT_EQ(15, window.target->Bounds().left);
		EXPECT_EQ(0, window.target->Bounds().top);
	});
}


TEST(ScrollBar, IsAsThickAsItPrefersAndNeverHasTheFocus)
{
	BarWindow window;
	window.Locked([&] {
		float width, height;
		window.bar->ResizeTo(30, 150);
		window.bar->GetPreferredSize(&width, &height);
		EXPECT_EQ(B_V_SCROLL_BAR_WIDTH, width);
		EXPECT_EQ(150, height);
		window.bar->ResizeToPreferred();
		EXPECT_EQ(BRect(100, 0, 100 + width, 150), window.bar->Frame());
	});
	window.driver.Click(window.bar, BPoint(7, 100));
	window.Locked([&] { EXPECT_FALSE(window.bar->IsFocus()); });
}


TEST(ScrollBar, AMessageWithAValueCallsTheHook)
{
	BarWindow window;
	BMessage message(B_VALUE_CHANGED);
	message.AddInt32("value", 42);
	BMessenger(window.bar).SendMessage(&message);
	Driver::WaitUntilIdle();
	window.Locked([&] { EXPECT_EQ((std::vector<float> { 42 }), window.bar->values); });
}


TEST(ScrollBar, FollowsTheRightEdgeOfItsWindow)
{
	BarWindow window;
	const BRect before = window.bar->Frame();
	window.driver.ResizeWindow(window.Window(), window.Window()->Bounds().Width() + 20,
		window.Window()->Bounds().Height() + 30);
	window.Locked([&] {
		EXPECT_EQ(BRect(before.left + 20, before.top, before.right + 20, before.bottom + 30),
			window.bar->Frame());
		window.bar->MoveBy(-5, 0);
		EXPECT_EQ(before.left + 15, window.bar->Frame().left);
	});
}
