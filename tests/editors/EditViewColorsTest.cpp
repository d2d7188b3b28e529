// The view panel's colours.

#include "editors/EditView.h"

#include <Box.h>
#include <RadioButton.h>

#include "PanelFixture.h"
#include "editors/LiveColorControl.h"

namespace {


constexpr rgb_color kDark = { 10, 20, 30, 255 };
constexpr rgb_color kPale = { 200, 210, 220, 255 };
constexpr rgb_color kRed = { 255, 0, 0, 255 };


int32
Packed(rgb_color color)
{
	return color.red << 16 | color.green << 8 | color.blue;
}


class EditViewColorsTest : public PanelFixture<EditView> {
protected:
	EditViewColorsTest()
	{
		view = new BView(BRect(10, 20, 209, 179), "plain", B_FOLLOW_NONE, B_WILL_DRAW);
		child = new BView(BRect(10, 10, 99, 99), "child", B_FOLLOW_NONE, B_WILL_DRAW);
		text = new BTextView(BRect(5, 5, 80, 80), "text", BRect(0, 0, 70, 70), B_FOLLOW_NONE);
		view->AddChild(child);
		child->AddChild(text);
		Use(view);
		window.Locked([&] {
			ground->SetViewColor(kPale);
			ground->SetHighColor(kDark);
			ground->SetLowColor(kRed);
			text->SetText("text");
			for (BView* each : { view, child, static_cast<BView*>(text) })
				each->SetViewColor(255, 255, 255);
		});
		Reload(view);
	}

	void Choose(const char* role) { window.driver.Click(Find<BRadioButton>(role)); }
	void PressDefault() { window.driver.Click(DefaultButton()); }

	BButton* DefaultButton()
	{
		for (const char* label : { "216 Gray", "Black", "Use View Color" }) {
			if (BButton* button = Find<BButton>(label))
				return button;
		}
		return nullptr;
	}

	LiveColorControl* Colors()
	{
		return dynamic_cast<LiveColorControl*>(Find<BTextControl>("Red:")->Parent());
	}

	int32 ShownColor() { return Packed(Colors()->ValueAsColor()); }

	// The swatches stand in the order of the radio buttons.
	int32 Swatch(int n)
	{
		BBox* swatch = ControlUser::Find<BBox>(Colors()->Parent(), "", n);
		return Packed(swatch->ViewColor());
	}

	int32 TextColor()
	{
		rgb_color color;
		text->GetFontAndColor(0, NULL, &color);
		return Packed(color);
	}

	BView* view;
	BView* child;
	BTextView* text;
};


} // namespace


TEST_F(EditViewColorsTest, ShowsTheThreeColors)
{
	window.Locked([&] {
		view->SetViewColor(kPale);
		view->SetHighColor(kDark);
		view->SetLowColor(kRed);
	});
	Reload(view);
	EXPECT_EQ(Packed(kPale), Swatch(0));
	EXPECT_EQ(Packed(kDark), Swatch(1));
	EXPECT_EQ(Packed(kRed), Swatch(2));
	EXPECT_EQ(Packed(kPale), ShownColor());
	Choose("High");
	EXPECT_EQ(Packed(kDark), ShownColor());
	Choose("Low");
	EXPECT_EQ(Packed(kRed), ShownColor());
}


TEST_F(EditViewColorsTest, TheChosenColorSelectsWhatIsShownOfTheNextView)
{
	Choose("High");
	window.Locked([&] { child->SetHighColor(kRed); });
	Reload(child);
	EXPECT_EQ(Packed(kRed), ShownColor());
}


TEST_F(EditViewColorsTest, ATypedComponentIsApplied)
{
	TypeOver("Green:", "40");
	EXPECT_EQ(0xff28ff, Packed(view->ViewColor()));
	EXPECT_EQ(0xff28ff, Swatch(0));

	Choose("High");
	TypeOver("Blue:", "300");
	EXPECT_EQ(44, view->HighColor().blue);
	EXPECT_EQ("44", Shown("Blue:"));

	Choose("Low");
	TypeOver("Red:", "511");
	EXPECT_EQ(255, view->LowColor().red);
}


TEST_F(EditViewColorsTest, DraggingInTheRampChangesTheColorLive)
{
	window.Locked([&] { view->SetLowColor(view->ViewColor()); });
	Reload(view);
	LiveColorControl* colors = Colors();
	// In the ramp of red, below that of grey.
	const float ramp = (colors->Bounds().Height() + 1) / 4;
	window.driver.MoveTo(colors, BPoint(30, ramp * 1.5f));
	window.driver.Press();
	const uint8 first = view->ViewColor().red;
	EXPECT_LT(first, 80);
	EXPECT_EQ(Packed(view->ViewColor()), Packed(view->LowColor()));
	window.driver.MoveTo(colors, BPoint(90, ramp * 1.5f));
	const uint8 second = view->ViewColor().red;
	EXPECT_GT(second, first);
	EXPECT_EQ(Packed(view->ViewColor()), Swatch(0));
	EXPECT_EQ(Packed(view->ViewColor()), Swatch(2));
	EXPECT_EQ(Packed(view->ViewColor()), Packed(view->LowColor()));
	window.driver.Release();
	EXPECT_EQ(second, view->ViewColor().red);
	EXPECT_EQ(255, view->ViewColor().green);
}


TEST_F(EditViewColorsTest, ALowColorOfItsOwnDoesNotFollow)
{
	window.Locked([&] { view->SetLowColor(kRed); });
	Reload(view);
	TypeOver("Green:", "40");
	EXPECT_EQ(Packed(kRed), Packed(view->LowColor()));
}


TEST_F(EditViewColorsTest, TheDefaultButtonIsNamedForTheChosenColor)
{
	EXPECT_STREQ("216 Gray", DefaultButton()->Label());
	Choose("High");
	EXPECT_STREQ("Black", DefaultButton()->Label());
	Choose("Low");
	EXPECT_STREQ("Use View Color", DefaultButton()->Label());
	Choose("View");
	EXPECT_STREQ("216 Gray", DefaultButton()->Label());
}


TEST_F(EditViewColorsTest, TheDefaultsAreGrayBlackAndTheViewColor)
{
	window.Locked([&] {
		view->SetViewColor(kPale);
		view->SetHighColor(kPale);
		view->SetLowColor(kRed);
	});
	Reload(view);
	Choose("Low");
	PressDefault();
	EXPECT_EQ(Packed(kPale), Packed(view->LowColor()));
	Choose("High");
	PressDefault();
	EXPECT_EQ(0, Packed(view->HighColor()));
	Choose("View");
	PressDefault();
	EXPECT_EQ(0xd8d8d8, Packed(view->ViewColor()));
	EXPECT_EQ(0xd8d8d8, Swatch(0));
}


TEST_F(EditViewColorsTest, TakesTheParentsColors)
{
	Press("Use Parent");
	EXPECT_EQ(Packed(kPale), Packed(view->ViewColor()));
	Choose("High");
	Press("Use Parent");
	EXPECT_EQ(Packed(kDark), Packed(view->HighColor()));
	Choose("Low");
	Press("Use Parent");
	EXPECT_EQ(Packed(kRed), Packed(view->LowColor()));
}


TEST_F(EditViewColorsTest, WithoutAParentTheShownColorIsAppliedWithABeep)
{
	window.Locked([&] { EXPECT_TRUE(panel->UseView(ground)); });
	BView* top = ground;
	window.Locked([&] { top->SetViewColor(kPale); });
	Reload(top);
	const int32 beeps = Driver::CountBeeps();
	window.Locked([&] { top->SetViewColor(kRed); });
	Press("Use Parent");
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	EXPECT_EQ(Packed(kPale), Packed(top->ViewColor()));
}


TEST_F(EditViewColorsTest, SetsTheColorsOfAllDescendants)
{
	window.Locked([&] {
		view->SetViewColor(kRed);
		view->SetHighColor(kDark);
		child->SetLowColor(child->ViewColor());
		text->SetLowColor(kPale);
	});
	Reload(view);
	Press("Set Children");
	EXPECT_EQ(Packed(kRed), Packed(child->ViewColor()));
	EXPECT_EQ(Packed(kRed), Packed(text->ViewColor()));
	// Low follows where it was alike.
	EXPECT_EQ(Packed(kRed), Packed(child->LowColor()));
	EXPECT_EQ(Packed(kPale), Packed(text->LowColor()));

	Choose("High");
	Press("Set Children");
	EXPECT_EQ(Packed(kDark), Packed(child->HighColor()));
	EXPECT_EQ(Packed(kDark), TextColor());

	Choose("Low");
	Press("Use Parent");
	Press("Set Children");
	EXPECT_EQ(Packed(kRed), Packed(text->LowColor()));
}


TEST_F(EditViewColorsTest, TheHighColorOfATextViewIsItsTexts)
{
	window.Locked([&] { EXPECT_TRUE(panel->UseView(text)); });
	Choose("High");
	TypeOver("Red:", "99");
	EXPECT_EQ(0x630000, TextColor());
}


TEST_F(EditViewColorsTest, LookingKeepsTransparencyAndAlpha)
{
	BView* clear = new BView(BRect(0, 200, 9, 209), "clear", B_FOLLOW_NONE, B_WILL_DRAW);
	clear->SetViewColor(B_TRANSPARENT_COLOR);
	clear->SetHighColor(1, 2, 3, 77);
	Use(clear);
	for (const char* role : { "High", "Low", "View" })
		Choose(role);
	EXPECT_EQ(B_TRANSPARENT_COLOR.alpha, clear->ViewColor().alpha);
	EXPECT_EQ(Packed(B_TRANSPARENT_COLOR), Packed(clear->ViewColor()));
	EXPECT_EQ(77, clear->HighColor().alpha);
}
