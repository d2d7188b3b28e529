// The panels of sliders, status bars and scroll views.

#include "editors/EditScrollView.h"
#include "editors/EditSlider.h"
#include "editors/EditStatusBar.h"

#include <ScrollBar.h>
#include <ScrollView.h>
#include <Slider.h>
#include <StatusBar.h>

#include "PanelFixture.h"

namespace {


const BRect kFrame(20, 20, 220, 120);


bool
IsColor(rgb_color color, uint8 red, uint8 green, uint8 blue)
{
	return color.red == red && color.green == green && color.blue == blue;
}


} // namespace


class EditSliderTest : public PanelFixture<EditSlider> {
protected:
	// The box beside the colour control.
	rgb_color Swatch()
	{
		BView* group = Find<BTextControl>("Red:")->Parent()->Parent();
		return ControlUser::Find<BBox>(group, "")->ViewColor();
	}
};


TEST_F(EditSliderTest, ShowsAndChangesWhatASliderCanChange)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", new BMessage('sldr'), -5, 50));
	EXPECT_EQ("-5", Shown("Min Value:"));
	EXPECT_EQ("50", Shown("Max Value:"));
	EXPECT_EQ("20000", Shown("Snooze:"));
	EXPECT_EQ("none", Chosen("Hash marks:"));
	EXPECT_EQ("block", Chosen("Thumb:"));

	TypeOver("Snooze:", "30000");
	EXPECT_EQ(30000, slider->SnoozeAmount());
	TypeOver("Key Increment:", "4");
	EXPECT_EQ(4, slider->KeyIncrementValue());
	TypeOver("Num Hash Marks:", "7");
	EXPECT_EQ(7, slider->HashMarkCount());
	Choose("Hash marks:", "top & bottom");
	EXPECT_EQ(B_HASH_MARKS_BOTH, slider->HashMarks());
	Choose("Thumb:", "triangle");
	EXPECT_EQ(B_TRIANGLE_THUMB, slider->Style());
	ExpectDeclined();
}


TEST_F(EditSliderTest, OneEmptyLimitLabelStaysALabel)
{
	BSlider* slider = new BSlider(kFrame, "s", "Toast:", NULL, 0, 99);
	slider->SetLimitLabels("light", "dark");
	Use(slider);
	EXPECT_EQ("light", Shown("Min Label:"));
	TypeOver("Min Label:", "");
	EXPECT_STREQ("", slider->MinLimitLabel());
	EXPECT_STREQ("dark", slider->MaxLimitLabel());
}


TEST_F(EditSliderTest, ARebuildNeedsAnEditor)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", NULL, 0, 99));
	TypeOver("Min Value:", "10");
	EXPECT_EQ(slider, ground->ChildAt(0));
	int32 minimum, maximum;
	slider->GetLimits(&minimum, &maximum);
	EXPECT_EQ(0, minimum);
}


TEST_F(EditSliderTest, UsesTheDefaultColor)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", NULL, 0, 99));
	Press("Use Default");
	EXPECT_TRUE(IsColor(slider->BarColor(), 80, 80, 80));
	EXPECT_TRUE(IsColor(Swatch(), 80, 80, 80));
	EXPECT_EQ("80", Shown("Green:"));
}


TEST_F(EditSliderTest, LoadingDoesNotTouchTheColor)
{
	BSlider* slider = new BSlider(kFrame, "s", "Toast:", NULL, 0, 99);
	slider->SetBarColor(rgb_color { 1, 2, 3, 77 });
	Use(slider);
	EXPECT_EQ(77, slider->BarColor().alpha);
}


TEST_F(EditSliderTest, ShowsWhatTheSliderHas)
{
	BSlider* slider = new BSlider(kFrame, "s", "Toast:", NULL, 3, 70, B_TRIANGLE_THUMB);
	slider->SetSnoozeAmount(15000);
	slider->SetKeyIncrementValue(6);
	slider->SetHashMarkCount(11);
	slider->SetHashMarks(B_HASH_MARKS_TOP);
	slider->SetLimitLabels("light", "dark");
	slider->SetBarColor(rgb_color { 11, 22, 33, 255 });
	Use(slider);
	EXPECT_EQ("15000", Shown("Snooze:"));
	TypeOver("Snooze:", "5");
	EXPECT_EQ(std::to_string(slider->SnoozeAmount()), Shown("Snooze:"));
	EXPECT_EQ("light", Shown("Min Label:"));
	EXPECT_EQ("dark", Shown("Max Label:"));
	EXPECT_EQ("3", Shown("Min Value:"));
	EXPECT_EQ("70", Shown("Max Value:"));
	EXPECT_EQ("6", Shown("Key Increment:"));
	EXPECT_EQ("11", Shown("Num Hash Marks:"));
	EXPECT_EQ("top", Chosen("Hash marks:"));
	EXPECT_EQ("triangle", Chosen("Thumb:"));
	EXPECT_EQ("11", Shown("Red:"));
	EXPECT_EQ("33", Shown("Blue:"));
	EXPECT_TRUE(IsColor(Swatch(), 11, 22, 33));
}


TEST_F(EditSliderTest, SetsBothLimitLabels)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", NULL, 0, 99));
	TypeOver("Max Label:", "dark");
	EXPECT_STREQ("", slider->MinLimitLabel());
	EXPECT_STREQ("dark", slider->MaxLimitLabel());
	TypeOver("Min Label:", "light");
	EXPECT_STREQ("light", slider->MinLimitLabel());
	EXPECT_STREQ("dark", slider->MaxLimitLabel());
}


TEST_F(EditSliderTest, AColorIsTypedOrDragged)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", NULL, 0, 99));
	TypeOver("Red:", "200");
	EXPECT_EQ(200, slider->BarColor().red);
	EXPECT_EQ(200, Swatch().red);
	BView* colors = Find<BTextControl>("Red:")->Parent();
	window.driver.MoveTo(colors, BPoint(30, 20));
	window.driver.Press();
	const rgb_color first = slider->BarColor();
	window.driver.MoveTo(colors, BPoint(120, 20));
	const rgb_color second = slider->BarColor();
	window.driver.Release();
	EXPECT_FALSE(IsColor(second, first.red, first.green, first.blue));
	EXPECT_TRUE(IsColor(Swatch(), second.red, second.green, second.blue));
}


TEST_F(EditSliderTest, SnoozeAndKeyIncrementDoNotDrawTheSlider)
{
	auto slider = Use(new Counting<BSlider>(kFrame, "s", "Toast:", nullptr, 0, 99));
	const int draws = slider->draws;
	TypeOver("Snooze:", "30000");
	TypeOver("Key Increment:", "4");
	EXPECT_EQ(30000, slider->SnoozeAmount());
	EXPECT_EQ(draws, slider->draws);
	TypeOver("Num Hash Marks:", "7");
	EXPECT_GT(slider->draws, draws);
}


class EditStatusBarTest : public PanelFixture<EditStatusBar> {
protected:
	rgb_color Swatch()
	{
		BView* group = Find<BTextControl>("Red:")->Parent()->Parent();
		return ControlUser::Find<BBox>(group, "")->ViewColor();
	}
};


TEST_F(EditStatusBarTest, OneTextKeepsTheOthersAndTheValue)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s", "Copying:", "left");
	Use(bar);
	window.Locked([&] { bar->Update(40, "file", "12"); });
	Reload(bar);
	EXPECT_EQ("40", Shown("Value:"));
	TypeOver("Trailing label:", "remaining");
	EXPECT_STREQ("Copying:", bar->Label());
	EXPECT_STREQ("remaining", bar->TrailingLabel());
	EXPECT_STREQ("file", bar->Text());
	EXPECT_STREQ("12", bar->TrailingText());
	EXPECT_EQ(40, bar->CurrentValue());
	ExpectDeclined();
}


TEST_F(EditStatusBarTest, ALowerMaximumLimitsTheValue)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s");
	Use(bar);
	TypeOver("Value:", "80");
	EXPECT_EQ(80, bar->CurrentValue());
	TypeOver("Max:", "50");
	EXPECT_EQ(50, bar->MaxValue());
	EXPECT_EQ("50", Shown("Value:"));
	EXPECT_EQ(50, bar->CurrentValue());
}


TEST_F(EditStatusBarTest, ChangesHeightAndColor)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s");
	bar->SetBarColor(rgb_color { 9, 9, 9, 255 });
	Use(bar);
	TypeOver("Bar height:", "20");
	EXPECT_EQ(20, bar->BarHeight());
	Press("Use Default");
	EXPECT_TRUE(IsColor(bar->BarColor(), 50, 150, 255));
	EXPECT_TRUE(IsColor(Swatch(), 50, 150, 255));
	EXPECT_EQ("150", Shown("Green:"));
}


TEST_F(EditStatusBarTest, ShowsWhatTheBarHas)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s", "Copying:", "left");
	bar->SetMaxValue(250);
	bar->SetBarHeight(17);
	bar->SetBarColor(rgb_color { 11, 22, 33, 255 });
	Use(bar);
	window.Locked([&] { bar->Update(120, "file", "12"); });
	Reload(bar);
	EXPECT_EQ("Copying:", Shown("Label:"));
	EXPECT_EQ("left", Shown("Trailing label:"));
	EXPECT_EQ("file", Shown("Text:"));
	EXPECT_EQ("12", Shown("Trailing text: "));
	EXPECT_EQ("120", Shown("Value:"));
	EXPECT_EQ("250", Shown("Max:"));
	EXPECT_EQ("17", Shown("Bar height:"));
	EXPECT_EQ("22", Shown("Green:"));
	EXPECT_TRUE(IsColor(Swatch(), 11, 22, 33));
}


TEST_F(EditStatusBarTest, SetsEachText)
{
	BStatusBar* bar = Use(new BStatusBar(kFrame, "s"));
	TypeOver("Label:", "Copying:");
	EXPECT_STREQ("Copying:", bar->Label());
	TypeOver("Text:", "file");
	EXPECT_STREQ("file", bar->Text());
	TypeOver("Trailing text: ", "12");
	EXPECT_STREQ("12", bar->TrailingText());
	EXPECT_STREQ("Copying:", bar->Label());
}


TEST_F(EditStatusBarTest, ATextKeepsTheMaximum)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s");
	bar->SetMaxValue(250);
	Use(bar);
	TypeOver("Value:", "180");
	TypeOver("Label:", "Copying:");
	EXPECT_EQ(250, bar->MaxValue());
	EXPECT_EQ(180, bar->CurrentValue());
}


TEST_F(EditStatusBarTest, AColorIsTypedOrDragged)
{
	BStatusBar* bar = Use(new BStatusBar(kFrame, "s"));
	TypeOver("Green:", "7");
	EXPECT_EQ(7, bar->BarColor().green);
	EXPECT_EQ(7, Swatch().green);
	BView* colors = Find<BTextControl>("Red:")->Parent();
	window.driver.Click(colors, BPoint(60, 4));
	EXPECT_EQ(bar->BarColor().red, bar->BarColor().green);
	EXPECT_EQ(bar->BarColor().red, Swatch().red);
}


class EditScrollViewTest : public PanelFixture<EditScrollView> {
protected:
	BScrollView* MakeScrollView(bool horizontal, bool vertical)
	{
		target = new BView(BRect(20, 20, 120, 100), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
		return new BScrollView("scroll", target, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, horizontal,
			vertical, B_FANCY_BORDER);
	}

	BView* target;
};


TEST_F(EditScrollViewTest, DisablesTheControlsOfAMissingBar)
{
	Use(MakeScrollView(false, true));
	EXPECT_FALSE(IsTicked("Horizontal"));
	EXPECT_TRUE(IsTicked("Vertical"));
	EXPECT_EQ("0", Shown("Total width:"));
	EXPECT_EQ("1", Shown("Small step:", 0));
	EXPECT_EQ("10", Shown("Big step:", 0));
	EXPECT_FALSE(Find<BTextControl>("Total width:")->IsEnabled());
	EXPECT_TRUE(Find<BTextControl>("Total height:")->IsEnabled());
	ExpectDeclined();
}


TEST_F(EditScrollViewTest, TheTotalIsNotLessThanTheTarget)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	TypeOver("Total width:", "300");
	float minimum, maximum;
	scroll->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
	EXPECT_EQ(200, maximum);
	TypeOver("Total width:", "5");
	EXPECT_EQ("100", Shown("Total width:"));
	TypeOver("Small step:", "3", 1);
	float small, big;
	scroll->ScrollBar(B_VERTICAL)->GetSteps(&small, &big);
	EXPECT_EQ(3, small);
}


TEST_F(EditScrollViewTest, ChangesTheBorder)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	EXPECT_EQ("B_FANCY_BORDER", Chosen("Border style:"));
	Choose("Border style:", "B_PLAIN_BORDER");
	EXPECT_EQ(B_PLAIN_BORDER, scroll->Border());
}


TEST_F(EditScrollViewTest, TogglingABarKeepsTheOther)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	window.Locked([&] {
		scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 70);
		scroll->ScrollBar(B_HORIZONTAL)->SetSteps(4, 40);
		scroll->ScrollBar(B_HORIZONTAL)->SetValue(25);
	});
	Tick("Vertical");
	ASSERT_EQ(1, ground->CountChildren());
	BScrollView* rebuilt = dynamic_cast<BScrollView*>(ground->ChildAt(0));
	ASSERT_NE(nullptr, rebuilt);
	EXPECT_EQ(target, rebuilt->Target());
	EXPECT_EQ(NULL, rebuilt->ScrollBar(B_VERTICAL));
	ASSERT_NE(nullptr, rebuilt->ScrollBar(B_HORIZONTAL));
	float minimum, maximum, small, big;
	rebuilt->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
	rebuilt->ScrollBar(B_HORIZONTAL)->GetSteps(&small, &big);
	EXPECT_EQ(70, maximum);
	EXPECT_EQ(25, rebuilt->ScrollBar(B_HORIZONTAL)->Value());
	EXPECT_EQ(4, small);
	EXPECT_EQ(40, big);

	Tick("Vertical");
	rebuilt = dynamic_cast<BScrollView*>(ground->ChildAt(0));
	ASSERT_NE(nullptr, rebuilt);
	EXPECT_NE(nullptr, rebuilt->ScrollBar(B_VERTICAL));
}


TEST_F(EditScrollViewTest, ShowsTotalsAndSteps)
{
	BScrollView* scroll = MakeScrollView(true, true);
	scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 170);
	scroll->ScrollBar(B_HORIZONTAL)->SetSteps(3, 30);
	scroll->ScrollBar(B_VERTICAL)->SetRange(0, 55);
	scroll->ScrollBar(B_VERTICAL)->SetSteps(4, 40);
	scroll->SetBorder(B_NO_BORDER);
	Use(scroll);
	EXPECT_EQ("B_NO_BORDER", Chosen("Border style:"));
	EXPECT_TRUE(IsTicked("Horizontal"));
	EXPECT_TRUE(IsTicked("Vertical"));
	EXPECT_EQ(target->Bounds().Width() + 170, std::stof(Shown("Total width:")));
	EXPECT_EQ(target->Bounds().Height() + 55, std::stof(Shown("Total height:")));
	EXPECT_EQ("3", Shown("Small step:", 0));
	EXPECT_EQ("30", Shown("Big step:", 0));
	EXPECT_EQ("4", Shown("Small step:", 1));
	EXPECT_EQ("40", Shown("Big step:", 1));
}


TEST_F(EditScrollViewTest, SetsEachStepAndTheTotalHeight)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	TypeOver("Small step:", "5", 0);
	TypeOver("Big step:", "50", 0);
	TypeOver("Small step:", "6", 1);
	TypeOver("Big step:", "60", 1);
	float small, big;
	scroll->ScrollBar(B_HORIZONTAL)->GetSteps(&small, &big);
	EXPECT_EQ(5, small);
	EXPECT_EQ(50, big);
	scroll->ScrollBar(B_VERTICAL)->GetSteps(&small, &big);
	EXPECT_EQ(6, small);
	EXPECT_EQ(60, big);
	TypeOver("Total height:", "480");
	float minimum, maximum;
	scroll->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
	EXPECT_EQ(480 - target->Bounds().Height(), maximum);
	EXPECT_FLOAT_EQ(target->Bounds().Height() / 480, scroll->ScrollBar(B_VERTICAL)->Proportion());
}


TEST_F(EditScrollViewTest, TotalsFollowTheFrame)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	window.Locked([&] {
		scroll->ResizeBy(40, 30);
		panel->FrameChanged();
	});
	float minimum, maximum;
	scroll->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
	EXPECT_EQ(target->Bounds().Width() + maximum, std::stof(Shown("Total width:")));
}


TEST_F(EditScrollViewTest, TogglingKeepsTheValueAndTheLook)
{
	BScrollView* scroll = MakeScrollView(true, true);
	scroll->SetHighColor(1, 2, 3);
	scroll->SetDrawingMode(B_OP_OVER);
	Use(scroll);
	window.Locked([&] {
		scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 70);
		scroll->ScrollBar(B_HORIZONTAL)->SetValue(0);
		scroll->ScrollBar(B_VERTICAL)->SetRange(0, 90);
		scroll->ScrollBar(B_VERTICAL)->SetValue(45);
	});
	const int32 beeps = Driver::CountBeeps();
	Tick("Horizontal");
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	BScrollView* rebuilt = dynamic_cast<BScrollView*>(ground->ChildAt(0));
	ASSERT_NE(nullptr, rebuilt);
	EXPECT_EQ(nullptr, rebuilt->ScrollBar(B_HORIZONTAL));
	EXPECT_EQ(45, rebuilt->ScrollBar(B_VERTICAL)->Value());
	EXPECT_STREQ("scroll", rebuilt->Name());
	EXPECT_EQ(B_FANCY_BORDER, rebuilt->Border());
	EXPECT_TRUE(IsColor(rebuilt->HighColor(), 1, 2, 3));
	EXPECT_EQ(B_OP_OVER, rebuilt->DrawingMode());
	// The event mask is what the rebuilt view follows by.
	EXPECT_EQ(0u, rebuilt->ResizingMode());
}


TEST_F(EditScrollViewTest, AToggleThatCannotBeDoneBeepsAndChangesNothing)
{
	BScrollView* scroll = new BScrollView(
		"scroll", NULL, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true, B_FANCY_BORDER);
	Use(scroll);
	const int32 beeps = Driver::CountBeeps();
	Tick("Vertical");
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	EXPECT_EQ(scroll, ground->ChildAt(0));
	EXPECT_NE(nullptr, scroll->ScrollBar(B_VERTICAL));
}
