// The highlight of the selected view, and the ground below the design.

#include "work/HiliteView.h"

#include "work/WorkViewFixture.h"

namespace {


constexpr rgb_color kBlue = { 0, 0, 255, 255 };


bool
IsBlue(rgb_color color)
{
	return color.red == kBlue.red && color.green == kBlue.green && color.blue == kBlue.blue;
}


class HiliteViewTest : public WorkViewFixture {};


} // namespace


TEST_F(HiliteViewTest, TheHighlightFramesTheSelectedView)
{
	window.driver.Click(plain);
	for (const BPoint& point : { BPoint(0, 0), BPoint(1, 1), BPoint(50, 0), BPoint(99, 59),
			 BPoint(98, 30), BPoint(0, 59), BPoint(95, 56) })
		EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, point))) << point.x << "," << point.y;
	for (const BPoint& point : { BPoint(2, 2), BPoint(50, 30), BPoint(88, 48) })
		EXPECT_FALSE(IsBlue(window.driver.PixelAt(plain, point))) << point.x << "," << point.y;
}


TEST_F(HiliteViewTest, TheOldHighlightIsErased)
{
	window.driver.Click(plain);
	window.driver.Click(button);
	for (const BPoint& point : { BPoint(0, 0), BPoint(1, 30), BPoint(99, 59), BPoint(94, 56) })
		EXPECT_FALSE(IsBlue(window.driver.PixelAt(plain, point))) << point.x << "," << point.y;
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(button, BPoint(0, 0))));
}


TEST_F(HiliteViewTest, TheHighlightFollowsAMove)
{
	window.driver.Click(plain);
	window.driver.Key("Right", 0, 5);
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(0, 0))));
	EXPECT_FALSE(IsBlue(window.driver.PixelAt(root, BPoint(20, 40))));
}


TEST_F(HiliteViewTest, AFrameControledViewHasNoTriangle)
{
	window.driver.Click(target);
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(target, BPoint(0, 0))));
	const BRect bounds = target->Bounds();
	EXPECT_FALSE(
		IsBlue(window.driver.PixelAt(target, BPoint(bounds.right - 4, bounds.bottom - 4))));
}


TEST_F(HiliteViewTest, TheHighlightHidesBehindASibling)
{
	BView* cover = new BView(BRect(60, 10, 110, 90), "cover", B_FOLLOW_NONE, B_WILL_DRAW);
	window.Locked([&] { root->AddChild(cover); });
	window.driver.Click(plain, BPoint(10, 10));
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(10, 0))));
	EXPECT_FALSE(IsBlue(window.driver.PixelAt(cover, BPoint(20, 10))));
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(97, 0))));
}


TEST_F(HiliteViewTest, ADeletedViewLeavesNoHighlight)
{
	window.driver.Click(plain);
	window.driver.Key("Delete");
	EXPECT_FALSE(IsBlue(window.driver.PixelAt(root, BPoint(20, 20))));
}


TEST_F(HiliteViewTest, TheGroundIsAlignedToTheContainer)
{
	// Scrolled by the origin, the pattern slides along.
	BView* container = workView->Container();
	for (const BPoint& cell : { BPoint(340, 48), BPoint(344, 52), BPoint(352, 56) }) {
		const bool light = (static_cast<int>(cell.x) / 4 + static_cast<int>(cell.y) / 4) % 2 == 0;
		EXPECT_EQ(light ? 204 : 153, window.driver.PixelAt(container, cell).red);
	}
}


// What is drawn again in part fits to what stands there.
TEST_F(HiliteViewTest, TheGroundIsAlignedHoweverLittleOfItIsDrawnAgain)
{
	BView* container = workView->Container();
	std::vector<uint8> before;
	for (float x = 332; x < 380; x++)
		before.push_back(window.driver.PixelAt(container, BPoint(x, 61)).red);
	window.Locked([&] { container->Invalidate(BRect(337, 59, 361, 66)); });
	for (float x = 332; x < 380; x++) {
		EXPECT_EQ(before[static_cast<size_t>(x - 332)],
			window.driver.PixelAt(container, BPoint(x, 61)).red)
			<< x;
	}
}


// Not only what was drawn again shows it.
TEST_F(HiliteViewTest, TheHighlightStaysWhenWhatItMarksIsDrawnAgain)
{
	window.driver.Click(plain);
	window.Locked([&] { plain->Invalidate(); });
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(0, 30))));
	window.Locked([&] { root->Invalidate(BRect(15, 15, 60, 60)); });
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(0, 30))));
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(99, 30))));

	BWindow* cover = new BWindow(BRect(60, 60, 300, 300), "cover", B_TITLED_WINDOW, 0);
	cover->Show();
	Driver::WaitUntilIdle();
	EXPECT_FALSE(IsBlue(window.driver.PixelAt(plain, BPoint(0, 30))));
	cover->Lock();
	cover->Quit();
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(0, 30))));
}


TEST_F(HiliteViewTest, TheHighlightFollowsAResize)
{
	window.driver.Click(plain);
	window.driver.Drag(plain, FromCorner(plain, 3, 3), plain, FromCorner(plain, -17, -7));
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(119, 30))));
	EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, BPoint(115, 66))));
	for (const BPoint& former : { BPoint(99, 30), BPoint(50, 59), BPoint(95, 56) })
		EXPECT_FALSE(IsBlue(window.driver.PixelAt(plain, former))) << former.x;
}


TEST_F(HiliteViewTest, TheHighlightFollowsTheScrolling)
{
	window.driver.ResizeWindow(window.Window(), 300, 250);
	window.driver.Click(plain, BPoint(10, 30));
	for (int i = 0; i < 3; i++) {
		window.driver.Wheel(root, 1, 1);
		const BPoint left = BPoint(0, 55);
		EXPECT_TRUE(IsBlue(window.driver.PixelAt(plain, left)));
		EXPECT_FALSE(IsBlue(window.driver.PixelAt(plain, left + BPoint(4, -4))));
		EXPECT_FALSE(IsBlue(window.driver.PixelAt(plain, left - BPoint(2, 0))));
	}
}
