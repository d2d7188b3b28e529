#include <Screen.h>

#include "kits/interface/ControlFixture.h"

namespace {

const rgb_color kTipColor = ui_color(B_TOOL_TIP_BACKGROUND_COLOR);


// A view with a text, and a place on the screen where its tip would be.
class ToolTip : public testing::Test {
protected:
	void SetUp() override
	{
		view = fixture.Add(new BView(BRect(10, 10, 209, 109), "tipped", 0, B_WILL_DRAW));
		fixture.Locked([this] { view->SetToolTip("What this is for"); });
		place = Driver::PointIn(view, BPoint(50, 50));
	}

	bool IsShown() { return fixture.driver.PixelAt(place + BPoint(2, 22)) == kTipColor; }

	ControlFixture fixture;
	Driver& driver = fixture.driver;
	BView* view;
	BPoint place;
};

} // namespace


TEST_F(ToolTip, IsShownWhereThePointerRests)
{
	EXPECT_STREQ("What this is for", view->ToolTip());
	EXPECT_FALSE(IsShown());
	driver.MoveTo(place);
	EXPECT_TRUE(IsShown());
	EXPECT_EQ(make_color(0, 0, 0), driver.PixelAt(place + BPoint(0, 20))) << "its frame";
}


TEST_F(ToolTip, LeavesWithThePointerAndComesAgain)
{
	driver.MoveTo(place);
	driver.MoveTo(fixture.ground, BPoint(300, 250));
	EXPECT_FALSE(IsShown());
	driver.MoveTo(place);
	EXPECT_TRUE(IsShown());
}


TEST_F(ToolTip, LeavesAtAPressAndAKey)
{
	driver.MoveTo(place);
	ASSERT_TRUE(IsShown());
	driver.Press();
	EXPECT_FALSE(IsShown());
	driver.Release();
	EXPECT_FALSE(IsShown()) << "until the pointer moves";

	driver.MoveTo(place + BPoint(1, 0));
	driver.MoveTo(place);
	ASSERT_TRUE(IsShown());
	driver.Key("a");
	EXPECT_FALSE(IsShown());
}


TEST_F(ToolTip, LeavesWithItsView)
{
	driver.MoveTo(place);
	ASSERT_TRUE(IsShown());
	fixture.Locked([this] { view->RemoveSelf(); });
	EXPECT_FALSE(IsShown());
	delete view;
}


TEST_F(ToolTip, IsNotShownWithoutAText)
{
	fixture.Locked([this] { view->SetToolTip(""); });
	EXPECT_EQ(nullptr, view->ToolTip());
	driver.MoveTo(place);
	EXPECT_FALSE(IsShown());
}


TEST_F(ToolTip, OfAViewHoldsForItsChildren)
{
	fixture.Locked(
		[this] { view->AddChild(new BView(BRect(40, 40, 80, 60), "child", 0, B_WILL_DRAW)); });
	driver.MoveTo(place);
	EXPECT_TRUE(IsShown());
}


TEST_F(ToolTip, StaysOnTheScreen)
{
	const BRect screen = BScreen().Frame();
	driver.MoveWindow(fixture.window, screen.RightBottom() - BPoint(100, 60));
	place = Driver::PointIn(view, BPoint(80, 45));
	driver.MoveTo(place);
	EXPECT_EQ(kTipColor, driver.PixelAt(BPoint(screen.right - 2, place.y - 6)));
}


TEST_F(ToolTip, ClosesWithItsWindow)
{
	driver.MoveTo(place);
	ASSERT_TRUE(IsShown());
	driver.CloseWindow(fixture.window);
	EXPECT_FALSE(IsShown());
}
