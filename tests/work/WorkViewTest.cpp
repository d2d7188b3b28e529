#include "work/WorkView.h"

#include <AppDefs.h>
#include <Dragger.h>

#include "work/WorkViewFixture.h"

namespace {


class WorkViewTest : public WorkViewFixture {};


// On a screen of two pixels a point, where the pointer may be between points.
class SharpWorkViewTest : private SharpScreen, public WorkViewFixture {};


} // namespace


TEST_F(WorkViewTest, HasItsHierarchy)
{
	EXPECT_STREQ("WorkView", workView->Name());
	BView* scrollTarget = workView->Target();
	EXPECT_STREQ("scroll target", scrollTarget->Name());
	EXPECT_EQ(0xa4000000u, scrollTarget->Flags());
	ASSERT_EQ(2, scrollTarget->CountChildren());
	BView* container = scrollTarget->ChildAt(0);
	EXPECT_STREQ("container", container->Name());
	EXPECT_EQ(BRect(0, 0, 10000, 10000), container->Frame());
	EXPECT_EQ(0x1212u, container->ResizingMode());
	EXPECT_EQ(root, container->ChildAt(0));
	BView* hilite = scrollTarget->ChildAt(1);
	EXPECT_STREQ("hilite view", hilite->Name());
	EXPECT_EQ(0x20000000u, hilite->Flags());
}


TEST_F(WorkViewTest, ShowsTheRootWithAMargin)
{
	EXPECT_EQ(BPoint(22, 32), workView->ScrollOrigin());
	EXPECT_EQ(BRect(30, 40, 329, 239), root->Frame());
	window.Locked([&] {
		const BPoint shown =
			workView->Target()->ConvertFromScreen(root->ConvertToScreen(BPoint(0, 0)));
		EXPECT_EQ(BPoint(8, 8), shown);
	});
}


TEST_F(WorkViewTest, RangesFitTheRootAndItsMargins)
{
	window.Locked([&] {
		float minimum, maximum;
		workView->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(0, minimum);
		EXPECT_EQ(0, maximum); // the root fits
	});
	window.Locked([&] {
		workView->SetEditView(
			new BView(BRect(0, 0, 799, 599), "large", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		float minimum, maximum;
		workView->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(799 + 16 - workView->Target()->Bounds().Width(), maximum);
	});
}


TEST_F(WorkViewTest, RangesFollowTheSizeOfTheWorkArea)
{
	float minimum, maximum;
	window.driver.ResizeWindow(window.Window(), 300, 250);
	window.Locked([&] {
		const BRect shown = workView->Target()->Bounds();
		workView->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(299 + 16 - shown.Width(), maximum);
		EXPECT_FLOAT_EQ(
			shown.Width() / (299 + 16), workView->ScrollBar(B_HORIZONTAL)->Proportion());
		workView->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
		EXPECT_EQ(199 + 16 - shown.Height(), maximum);
	});
	window.driver.ResizeWindow(window.Window(), 499, 399);
	workView->ScrollBar(B_VERTICAL)->GetRange(&minimum, &maximum);
	EXPECT_EQ(0, maximum);
}


TEST_F(WorkViewTest, TheFirstClickOnlySelects)
{
	window.driver.Click(plain);
	EXPECT_EQ(plain, workView->SelectedView());
	EXPECT_THAT(listener->selections, testing::ElementsAre(plain));
	EXPECT_EQ(0, plain->presses);
	EXPECT_EQ(BRect(20, 20, 119, 79), plain->Frame());
}


TEST_F(WorkViewTest, ASecondClickOnWhatStaysInItsPlaceBeeps)
{
	window.driver.Click(target);
	int32 beeps = Driver::CountBeeps();
	const BRect frame = target->Frame();
	window.driver.Drag(target, BPoint(30, 30), root, BPoint(30, 150));
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	EXPECT_EQ(target, scroll->Target());
	EXPECT_EQ(frame, target->Frame());

	window.driver.Click(root, BPoint(10, 150));
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	window.driver.Drag(root, BPoint(10, 150), root, BPoint(40, 170));
	EXPECT_EQ(beeps + 2, Driver::CountBeeps());
	EXPECT_EQ(BRect(30, 40, 329, 239), root->Frame());
}


TEST_F(WorkViewTest, AClickOnAButtonDoesNotPressIt)
{
	window.driver.Click(button);
	EXPECT_EQ(button, workView->SelectedView());
	EXPECT_EQ(0, button->Value());
}


// Nor does a dragger of the design drag anything away.
TEST_F(WorkViewTest, APressOnADraggerDragsNoReplicant)
{
	struct Noting : BDragger {
		using BDragger::BDragger;

		BBitmap* DragBitmap(BPoint*, drawing_mode*) override
		{
			drags++;
			return NULL;
		}

		int drags = 0;
	};
	Noting* dragger = new Noting(BRect(120, 100, 149, 129), button);
	window.Locked([&] { root->AddChild(dragger); });
	ASSERT_EQ(button, dragger->Target());

	for (const uint32 mouseButton : { B_PRIMARY_MOUSE_BUTTON, B_SECONDARY_MOUSE_BUTTON }) {
		window.driver.MoveTo(dragger, BPoint(15, 15));
		window.driver.Press(mouseButton);
		window.driver.MoveTo(dragger, BPoint(5, 5));
		window.driver.MoveTo(plain, BPoint(5, 5));
		window.driver.Release(mouseButton);
		EXPECT_EQ(0, dragger->drags) << mouseButton;
		EXPECT_EQ(root, dragger->Parent());
	}
	EXPECT_THAT(listener->selections, testing::Contains(dragger));
}


TEST_F(WorkViewTest, SelectingTheSelectedViewTellsNobody)
{
	window.driver.Click(plain);
	listener->selections.clear();
	window.Locked([&] { workView->SetSelectedView(plain); });
	EXPECT_TRUE(listener->selections.empty());
}


TEST_F(WorkViewTest, ASecondaryClickReachesTheView)
{
	window.driver.Click(plain, 1, B_SECONDARY_MOUSE_BUTTON);
	EXPECT_EQ(1, plain->presses);
	EXPECT_EQ(root, workView->SelectedView());
}


TEST_F(WorkViewTest, AClickOnTheGroundChangesNothing)
{
	window.driver.Click(workView->Container(), BPoint(30 + 310, 100));
	EXPECT_EQ(root, workView->SelectedView());
	EXPECT_TRUE(listener->selections.empty());
}


TEST_F(WorkViewTest, TheCornerResizes)
{
	window.driver.Click(plain);
	window.driver.Drag(plain, FromCorner(plain, 3, 3), plain, FromCorner(plain, -17, -7));
	EXPECT_EQ(BRect(20, 20, 139, 89), plain->Frame());
	EXPECT_GT(listener->moves, 0);

	// The button is up again: further moves do nothing.
	window.driver.MoveTo(plain, BPoint(5, 5));
	EXPECT_EQ(BRect(20, 20, 139, 89), plain->Frame());
}


TEST_F(SharpWorkViewTest, TheCornerStaysUnderThePointerInHalfSteps)
{
	window.driver.Click(plain);
	window.driver.MoveTo(plain, FromCorner(plain, 3, 3));
	const BPoint start = Driver::PointIn(plain, FromCorner(plain, 3, 3));
	window.driver.Press();
	for (int i = 1; i <= 40; i++)
		window.driver.MoveTo(start + BPoint(0.5f * i, 0.5f * (i / 2)));
	window.driver.Release();
	EXPECT_EQ(BRect(20, 20, 139, 89), plain->Frame());
}


TEST_F(WorkViewTest, AViewIsResizedToNothingAndBack)
{
	window.driver.Click(plain);
	const BPoint start = Driver::PointIn(plain, FromCorner(plain, 3, 3));
	window.driver.MoveTo(start);
	window.driver.Press();
	window.driver.MoveTo(start - BPoint(99, 59));
	EXPECT_EQ(BRect(20, 20, 20, 20), plain->Frame());
	window.driver.MoveTo(start - BPoint(80, 50));
	window.driver.Release();
	EXPECT_EQ(BRect(20, 20, 39, 29), plain->Frame());
	EXPECT_EQ(2, listener->moves);
}


TEST_F(WorkViewTest, TheResizeZoneEndsAtTwelve)
{
	window.driver.Click(plain);
	window.driver.Drag(plain, FromCorner(plain, 6, 5), plain, FromCorner(plain, 5, 5));
	EXPECT_EQ(BRect(20, 20, 120, 79), plain->Frame());

	// One pixel further away the press takes the view along instead.
	window.driver.Click(button);
	window.driver.Drag(button, FromCorner(button, 6, 6), root, BPoint(200, 180));
	BView* moved = root->FindView("button");
	ASSERT_NE(nullptr, moved);
	EXPECT_EQ(99, moved->Bounds().Width());
	EXPECT_EQ(206, moved->Frame().right);
	EXPECT_EQ(186, moved->Frame().bottom);
}


TEST_F(SharpWorkViewTest, AHalfPixelInsideTheZoneResizes)
{
	window.driver.Click(plain);
	window.driver.MoveTo(plain, FromCorner(plain, 6, 5.5));
	window.driver.Press();
	EXPECT_EQ(5u, workView->EventMask());
	window.driver.Release();
	EXPECT_EQ(0u, workView->EventMask());
	EXPECT_EQ(BRect(20, 20, 119, 79), plain->Frame());
}


TEST_F(WorkViewTest, APressWithoutAPlaceIsIgnored)
{
	BMessage press(B_MOUSE_DOWN);
	press.AddInt32("buttons", B_PRIMARY_MOUSE_BUTTON);
	window.Window()->PostMessage(&press, plain);
	Driver::WaitUntilIdle();
	EXPECT_EQ(root, workView->SelectedView());
}


// A design may ask for all presses and keys.
TEST_F(WorkViewTest, AViewThatOverhearsEverythingActsOnNothing)
{
	window.Locked([&] { plain->SetEventMask(B_POINTER_EVENTS | B_KEYBOARD_EVENTS); });
	window.driver.Click(plain);
	window.driver.Drag(workView->Container(), BPoint(340, 230), workView->Container(),
		BPoint(360, 250)); // right of the view and below it
	EXPECT_EQ(BRect(20, 20, 119, 79), plain->Frame());
	window.driver.Click(button);
	EXPECT_EQ(button, workView->SelectedView());
	window.driver.Key("Right");
	EXPECT_EQ(21, button->Frame().left);
	EXPECT_EQ(0, plain->keys);
	EXPECT_EQ(0, plain->presses);

	// It can still be used itself.
	window.driver.Click(plain);
	EXPECT_EQ(plain, workView->SelectedView());
	window.driver.Drag(plain, FromCorner(plain, 3, 3), plain, FromCorner(plain, -17, -7));
	EXPECT_EQ(BRect(20, 20, 139, 89), plain->Frame());
}


TEST_F(WorkViewTest, TheFirstOfTwoWorkViewsTakesTheMouse)
{
	Listener* otherListener = new Listener;
	window.Add(otherListener);
	WorkView* other = new WorkView(BRect(20, 360, 200, 390), B_FOLLOW_NONE, otherListener);
	BView* otherRoot = new BView(BRect(0, 0, 99, 99), "other", B_FOLLOW_NONE, B_WILL_DRAW);
	window.Add(other);
	window.Locked([&] { other->SetEditView(otherRoot); });
	otherListener->selections.clear();

	window.driver.Click(plain);
	EXPECT_EQ(plain, workView->SelectedView());
	// The other one's views are not in the first one's tree, so their clicks pass.
	window.driver.Click(otherRoot, BPoint(20, 5));
	EXPECT_EQ(plain, workView->SelectedView());
	EXPECT_TRUE(otherListener->selections.empty());
}


TEST_F(WorkViewTest, AFrameControledViewIsNotResized)
{
	window.driver.Click(target);
	ASSERT_EQ(target, workView->SelectedView());
	const BRect frame = target->Frame();
	window.driver.Drag(target, FromCorner(target, 2, 2), target, FromCorner(target, -20, -20));
	EXPECT_EQ(frame, target->Frame());
}


TEST_F(WorkViewTest, TheRootIsResizedByItsCorner)
{
	window.driver.Drag(root, FromCorner(root, 2, 2), root, FromCorner(root, 12, 22));
	EXPECT_EQ(BRect(30, 40, 319, 219), root->Frame());
}


TEST_F(WorkViewTest, ArrowKeysMoveTheSelectedView)
{
	window.driver.Click(plain);
	window.driver.Key("Right", 0, 3);
	window.driver.Key("Down");
	EXPECT_EQ(BRect(23, 21, 122, 80), plain->Frame());
	EXPECT_EQ(4, listener->moves);
}


TEST_F(WorkViewTest, EachByteOfAKeyActs)
{
	window.driver.Click(plain);
	const char bytes[] = { B_LEFT_ARROW, B_UP_ARROW, B_LEFT_ARROW, '\0' };
	window.driver.KeyThatTypes(bytes);
	EXPECT_EQ(BRect(18, 19, 117, 78), plain->Frame());
	EXPECT_EQ(3, listener->moves);
}


TEST_F(WorkViewTest, KeysAreTraced)
{
	window.driver.Click(plain);
	testing::internal::CaptureStdout();
	window.driver.Key("Left");
	window.driver.Key("a");
	window.driver.Type("\u00e9");
	fflush(stdout);
	EXPECT_EQ("1c\n61\nc3\na9\n", testing::internal::GetCapturedStdout());
}


// Steps are points, however many pixels that are.
TEST_F(SharpWorkViewTest, ArrowKeysMoveByPoints)
{
	window.driver.Click(plain);
	window.driver.Key("Right", 0, 3);
	window.driver.Key("Up");
	EXPECT_EQ(BRect(23, 19, 122, 78), plain->Frame());
}


TEST_F(WorkViewTest, ArrowKeysLeaveTheRootAndFrameControledViewsAlone)
{
	const int32 beeps = Driver::CountBeeps();
	window.driver.Click(plain);
	window.driver.Click(root, BPoint(290, 190));
	window.driver.Key("Right");
	EXPECT_EQ(BRect(30, 40, 329, 239), root->Frame());
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());

	window.driver.Click(target);
	const BRect frame = target->Frame();
	window.driver.Key("Right");
	EXPECT_EQ(frame, target->Frame());
	EXPECT_EQ(beeps + 2, Driver::CountBeeps());
	EXPECT_EQ(0, listener->moves);
}


TEST_F(WorkViewTest, OtherKeysDoNothing)
{
	window.driver.Click(plain);
	const int32 beeps = Driver::CountBeeps();
	for (const char* key : { "a", "Home", "Return", "Escape" })
		window.driver.Key(key);
	EXPECT_EQ(BRect(20, 20, 119, 79), plain->Frame());
	EXPECT_EQ(plain, workView->SelectedView());
	EXPECT_EQ(beeps, Driver::CountBeeps());
	EXPECT_EQ(0, listener->moves);
}


TEST_F(WorkViewTest, DeleteSelectsTheParentFirst)
{
	window.driver.Click(plain);
	listener->selections.clear();
	window.driver.Key("Delete");
	EXPECT_EQ(root, workView->SelectedView());
	EXPECT_THAT(listener->selections, testing::ElementsAre(root));
	EXPECT_EQ(2, root->CountChildren());
	EXPECT_EQ(button, root->ChildAt(0));

	window.driver.Click(button);
	window.driver.Key("Backspace");
	EXPECT_EQ(1, root->CountChildren());
}


TEST_F(WorkViewTest, TheRootAndFrameControledViewsAreNotDeleted)
{
	window.driver.Click(plain);
	window.driver.Click(root, BPoint(290, 190));
	const int32 beeps = Driver::CountBeeps();
	window.driver.Key("Delete");
	EXPECT_EQ(root, workView->EditView());
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	window.driver.Click(target);
	window.driver.Key("Backspace");
	EXPECT_EQ(target, scroll->Target());
	EXPECT_EQ(target, workView->SelectedView());
	EXPECT_EQ(beeps + 2, Driver::CountBeeps());
}


TEST_F(WorkViewTest, ReplacingTheTreeDeletesTheOldOne)
{
	window.driver.Click(plain);
	BView* other = new BView(BRect(0, 0, 50, 50), "other", B_FOLLOW_NONE, B_WILL_DRAW);
	window.Locked([&] { workView->SetEditView(other); });
	EXPECT_EQ(other, workView->SelectedView());
	EXPECT_EQ(1, workView->Container()->CountChildren());

	window.Locked([&] { workView->SetEditView(NULL); });
	EXPECT_EQ(NULL, workView->EditView());
	EXPECT_EQ(NULL, workView->SelectedView());
	EXPECT_EQ(0, workView->Container()->CountChildren());
}


TEST_F(WorkViewTest, ColorsOfTheTreeSurvive)
{
	BView* other = new BView(BRect(0, 0, 50, 50), "other", B_FOLLOW_NONE, B_WILL_DRAW);
	BButton* inner = new BButton(BRect(5, 5, 40, 30), "inner", "x", NULL);
	inner->SetViewColor(1, 2, 3);
	other->AddChild(inner);
	window.Locked([&] { workView->SetEditView(other); });
	EXPECT_EQ(1, inner->ViewColor().red);
}


TEST_F(WorkViewTest, KeysWithNothingSelectedBeep)
{
	window.driver.Click(plain);
	window.Locked([&] { workView->SetEditView(NULL); });
	const int32 beeps = Driver::CountBeeps();
	window.driver.Key("Delete");
	window.driver.Key("Left");
	window.driver.Key("a");
	EXPECT_EQ(beeps + 3, Driver::CountBeeps());
	EXPECT_EQ(NULL, workView->SelectedView());
	EXPECT_EQ(0, listener->moves);
}
