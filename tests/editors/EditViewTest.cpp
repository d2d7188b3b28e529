#include "editors/EditView.h"

#include <string>

#include <gtest/gtest.h>

#include <Button.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <TextControl.h>
#include <TextView.h>

#include "PanelFixture.h"

namespace {


class EditViewTest : public PanelFixture<EditView> {
protected:
	BView* UsePlain(uint32 mode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = B_WILL_DRAW)
	{
		return Use(new BView(BRect(10, 20, 109, 79), "plain", mode, flags));
	}

	BTextControl* Text(const char* label) { return Find<BTextControl>(label); }
	std::string ShownFlags() { return Find<BMenuField>("Flags:")->MenuItem()->Label(); }
};


} // namespace


TEST_F(EditViewTest, DeclinesNull)
{
	UsePlain();
	window.Locked([&] { EXPECT_FALSE(panel->UseView(NULL)); });
}


TEST_F(EditViewTest, HasThePlatformClassInItsLabel)
{
	EXPECT_STREQ("EditView", panel->Name());
	EXPECT_STREQ("Properties from BView", panel->Label());
	EXPECT_EQ(330, panel->Bounds().Height());
}


TEST_F(EditViewTest, ShowsAndSetsTheName)
{
	BView* view = UsePlain();
	EXPECT_STREQ("plain", Text("Name: ")->Text());
	TypeOver("Name: ", "fancy");
	EXPECT_STREQ("fancy", view->Name());
}


TEST_F(EditViewTest, ShowsAMissingName)
{
	BView* view = Use(new BView(BRect(0, 0, 9, 9), NULL, B_FOLLOW_NONE, B_WILL_DRAW));
	EXPECT_STREQ("<unnamed>", Text("Name: ")->Text());
	// Looking changes nothing.
	EXPECT_EQ(NULL, view->Name());
	TypeOver("Name: ", "now");
	EXPECT_STREQ("now", view->Name());
}


TEST_F(EditViewTest, ShowsTheFrameAndFollowsIt)
{
	BView* view = UsePlain();
	EXPECT_STREQ("10", Text("L:")->Text());
	EXPECT_STREQ("20", Text("T:")->Text());
	EXPECT_STREQ("109", Text("R:")->Text());
	EXPECT_STREQ("79", Text("B:")->Text());
	window.Locked([&] {
		view->MoveBy(5, -3);
		panel->FrameChanged();
	});
	EXPECT_STREQ("15", Text("L:")->Text());
	EXPECT_STREQ("17", Text("T:")->Text());
}


TEST_F(EditViewTest, ANewRightEdgeResizes)
{
	BView* view = UsePlain();
	TypeOver("R:", "159");
	EXPECT_EQ(BRect(10, 20, 159, 79), view->Frame());
}


TEST_F(EditViewTest, ANewLeftEdgeKeepsTheRightOne)
{
	BView* view = UsePlain();
	TypeOver("L:", "30");
	EXPECT_EQ(BRect(30, 20, 109, 79), view->Frame());
}


TEST_F(EditViewTest, MarksTheResizingMode)
{
	UsePlain(B_FOLLOW_ALL_SIDES);
	EXPECT_EQ("Left & Right", Chosen("Resizing:", 0));
	EXPECT_EQ("Top & Bottom", Chosen("Resizing:", 1));
}


TEST_F(EditViewTest, MarksNothingForAnOddResizingMode)
{
	UsePlain(B_FOLLOW_NONE);
	EXPECT_EQ("", Chosen("Resizing:", 0));
	EXPECT_EQ("", Chosen("Resizing:", 1));
}


TEST_F(EditViewTest, SetsTheResizingMode)
{
	BView* view = UsePlain();
	Choose("Resizing:", "Right", 0);
	EXPECT_EQ(uint32(B_FOLLOW_RIGHT | B_FOLLOW_TOP), view->ResizingMode());
	Choose("Resizing:", "V. Center", 1);
	EXPECT_EQ(uint32(B_FOLLOW_RIGHT | B_FOLLOW_V_CENTER), view->ResizingMode());
}


TEST_F(EditViewTest, ShowsAndTogglesFlags)
{
	BView* view = UsePlain(B_FOLLOW_NONE, B_WILL_DRAW | B_FRAME_EVENTS);
	EXPECT_EQ("Draw, FrEvts", ShownFlags());
	Choose("Flags:", "B_PULSE_NEEDED");
	EXPECT_EQ("Draw, Pulse, FrEvts", ShownFlags());
	EXPECT_EQ(uint32(B_WILL_DRAW | B_PULSE_NEEDED | B_FRAME_EVENTS), view->Flags());
	Choose("Flags:", "B_WILL_DRAW");
	EXPECT_EQ("Pulse, FrEvts", ShownFlags());
}


TEST_F(EditViewTest, FlagsThatTheMenuDoesNotShowSurvive)
{
	BView* view = UsePlain(B_FOLLOW_NONE, B_WILL_DRAW | 0x00010000);
	Choose("Flags:", "B_NAVIGABLE");
	EXPECT_EQ(uint32(B_WILL_DRAW | B_NAVIGABLE | 0x00010000), view->Flags());
}


TEST_F(EditViewTest, NoFlagsShowNoText)
{
	UsePlain(B_FOLLOW_NONE, 0);
	EXPECT_EQ("", ShownFlags());
}


TEST_F(EditViewTest, PreferredKeepsTheBoundEdge)
{
	BView* left = Use(new BButton(BRect(100, 50, 250, 90), "b", "x", NULL));
	window.driver.Click(Find<BButton>("preferred"));
	EXPECT_EQ(100, left->Frame().left);
	EXPECT_NE(250, left->Frame().right);

	BView* right = Use(
		new BButton(BRect(100, 150, 250, 190), "b", "x", NULL, B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM));
	window.driver.Click(Find<BButton>("preferred"));
	EXPECT_EQ(250, right->Frame().right);
	EXPECT_EQ(190, right->Frame().bottom);
	EXPECT_NE(100, right->Frame().left);
	EXPECT_EQ(std::to_string(static_cast<int>(right->Frame().left)), Text("L:")->Text());
}


TEST_F(EditViewTest, ZoomFillsTheParent)
{
	BView* view = UsePlain();
	window.driver.Click(Find<BButton>("zoom"));
	EXPECT_EQ(ground->Bounds(), view->Frame());
	EXPECT_STREQ("379", Text("R:")->Text());
}


TEST_F(EditViewTest, LoadingFiresNothing)
{
	BView* first = UsePlain();
	BView* second = Use(new BView(BRect(1, 2, 3.5, 4.25), "second", B_FOLLOW_NONE, 0));
	window.Locked([&] { panel->UseView(first); });
	EXPECT_STREQ("plain", first->Name());
	EXPECT_STREQ("second", second->Name());
	EXPECT_EQ(BRect(10, 20, 109, 79), first->Frame());
}


TEST_F(EditViewTest, ADeletedTargetIsNotTouched)
{
	BView* view = UsePlain();
	window.Locked([&] {
		view->RemoveSelf();
		delete view;
		panel->FrameChanged();
	});
	TypeOver("Name: ", "nobody");
}


TEST_F(EditViewTest, ANewTopOrBottomEdgeKeepsTheOtherOne)
{
	BView* view = UsePlain();
	TypeOver("T:", "30");
	EXPECT_EQ(BRect(10, 30, 109, 79), view->Frame());
	TypeOver("B:", "99.6");
	EXPECT_EQ(BRect(10, 30, 109, 100), view->Frame());
	EXPECT_EQ("100", Shown("B:"));
}


TEST_F(EditViewTest, PreferredKeepsTheCentre)
{
	BView* view = Use(new BButton(
		BRect(100, 150, 250, 190), "b", "x", NULL, B_FOLLOW_H_CENTER | B_FOLLOW_V_CENTER));
	window.driver.Click(Find<BButton>("preferred"));
	EXPECT_NE(150, view->Bounds().Width());
	EXPECT_NEAR(175, (view->Frame().left + view->Frame().right) / 2, 1);
	EXPECT_NEAR(170, (view->Frame().top + view->Frame().bottom) / 2, 1);
}


// Half of the growth goes to each of the two edges.
TEST_F(EditViewTest, PreferredMovesAViewThatFollowsBothEdgesByHalf)
{
	BView* view = Use(new BButton(BRect(100, 150, 250, 190), "b", "x", NULL, B_FOLLOW_ALL_SIDES));
	window.driver.Click(Find<BButton>("preferred"));
	EXPECT_NE(150, view->Bounds().Width());
	EXPECT_NEAR(175, (view->Frame().left + view->Frame().right) / 2, 1);
	EXPECT_NEAR(170, (view->Frame().top + view->Frame().bottom) / 2, 1);
}


TEST_F(EditViewTest, ZoomFillsWhatTheParentCanScrollTo)
{
	BView* target = new BView(BRect(0, 0, 99, 99), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	BScrollView* scroll = new BScrollView("scroll", target, B_FOLLOW_NONE, 0, true, true);
	BView* inner = new BView(BRect(5, 5, 9, 9), "inner", B_FOLLOW_NONE, B_WILL_DRAW);
	target->AddChild(inner);
	window.Locked([&] {
		ground->AddChild(scroll);
		scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 70);
		scroll->ScrollBar(B_VERTICAL)->SetRange(0, 50);
		EXPECT_TRUE(panel->UseView(inner));
	});
	window.driver.Click(Find<BButton>("zoom"));
	EXPECT_EQ(BRect(0, 0, 169, 149), inner->Frame());
	window.Locked([&] { target->ScrollTo(BPoint(30, 20)); });
	window.driver.Click(Find<BButton>("zoom"));
	EXPECT_EQ(BPoint(-30, -20), inner->Frame().LeftTop());
}


TEST_F(EditViewTest, TheFirstRowsDoNotDrawTheView)
{
	auto view = Use(new Counting<BView>(
		BRect(10, 20, 109, 79), "plain", uint32(B_FOLLOW_NONE), uint32(B_WILL_DRAW)));
	const int draws = view->draws;
	TypeOver("Name: ", "other");
	Choose("Resizing:", "Right");
	EXPECT_EQ(draws, view->draws);
}
