// Dragging views about in the work area, and dropping on it.

#include "work/WorkView.h"

#include <memory>
#include <string>

#include <gtest/gtest.h>

#include <Bitmap.h>
#include <Box.h>
#include <Button.h>
#include <Entry.h>
#include <File.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Path.h>
#include <Resources.h>

#include "archive/BitmapView.h"
#include "archive/ViewDrag.h"
#include "archive/ViewTree.h"
#include "support/TestWindow.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkViewFixture.h"

namespace {


// Another program's view, so to speak: what is pressed there drags a message along.
class SourceView : public BView {
public:
	SourceView() : BView(BRect(0, 360, 99, 389), "source", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void MouseDown(BPoint where) override
	{
		DragMessage(&message, BRect(where, where + BPoint(9, 9)));
	}

	BMessage message;
};


class WorkViewDropTest : public testing::Test {
protected:
	WorkViewDropTest() : window(BRect(40, 40, 539, 439))
	{
		BView* listener = new BView(BRect(0, 0, 9, 9), "listener", B_FOLLOW_NONE, 0);
		window.Add(listener);
		workView = new WorkView(BRect(20, 20, 449, 349), B_FOLLOW_ALL_SIDES, listener);
		window.Add(workView);
		source = window.Add(new SourceView);
		root = new BView(BRect(0, 0, 299, 199), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		root->AddChild(new BButton(BRect(20, 20, 99, 44), "button", "Press", NULL));
		box = new BBox(BRect(140, 20, 279, 179), "box");
		root->AddChild(box);
		window.Locked([&] { workView->SetEditView(root); });
	}

	BView* Find(const char* name) { return workView->EditView()->FindView(name); }

	// A drag that begins in the view's middle, which was selected before.
	void DragSelected(const char* name, BView* to, BPoint where, uint32 modifiers = 0)
	{
		BView* view = Find(name);
		window.driver.Click(view, BPoint(10, 10));
		Drag(Driver::PointIn(view, BPoint(10, 10)), Driver::PointIn(to, where), modifiers);
	}

	// To that very place, which may be between points.
	void Drag(BPoint from, BPoint to, uint32 modifiers = 0)
	{
		window.driver.MoveTo(from);
		window.driver.Press(1, modifiers);
		window.driver.MoveTo(from + BPoint(8, 8), modifiers);
		window.driver.MoveTo(to, modifiers);
		window.driver.Release(1, modifiers);
		window.driver.MoveTo(to); // lets go of the keys
	}

	// Held at its left top.
	void Drop(const BMessage& message, BView* target, BPoint where)
	{
		window.Locked([&] { source->message = message; });
		Drag(Driver::PointIn(source, BPoint(20, 10)), Driver::PointIn(target, where));
	}

	TestWindow window;
	WorkView* workView;
	SourceView* source;
	BView* root;
	BBox* box;
};


// On a screen of two pixels a point, where the pointer may be between points.
class SharpDropTest : private SharpScreen, public WorkViewDropTest {};


} // namespace


TEST_F(WorkViewDropTest, ADragMovesTheView)
{
	DragSelected("button", root, BPoint(40, 130));
	BView* button = Find("button");
	ASSERT_NE(nullptr, button);
	EXPECT_EQ(root, button->Parent());
	EXPECT_EQ(BPoint(30, 120), button->Frame().LeftTop());
	EXPECT_EQ(button, workView->SelectedView());
	EXPECT_EQ(2, root->CountChildren());
}


TEST_F(WorkViewDropTest, AScrolledViewStaysUnderThePointer)
{
	BView* scrolled = new BView(BRect(20, 60, 99, 99), "scrolled", B_FOLLOW_NONE, B_WILL_DRAW);
	window.Locked([&] {
		root->AddChild(scrolled);
		scrolled->ScrollTo(BPoint(5, 30));
	});
	window.driver.Click(scrolled, BPoint(15, 40));
	window.driver.Drag(
		Driver::PointIn(scrolled, BPoint(15, 40)), Driver::PointIn(root, BPoint(40, 130)));
	ASSERT_NE(nullptr, Find("scrolled"));
	EXPECT_EQ(BRect(30, 120, 109, 159), Find("scrolled")->Frame());
}


TEST_F(WorkViewDropTest, ADragIntoABoxChangesTheParent)
{
	DragSelected("button", box, BPoint(30, 60));
	BView* button = Find("button");
	ASSERT_NE(nullptr, button);
	EXPECT_EQ(box, button->Parent());
	EXPECT_EQ(BPoint(20, 50), button->Frame().LeftTop());
}


TEST_F(WorkViewDropTest, AControlDragCopies)
{
	DragSelected("button", box, BPoint(30, 60), B_CONTROL_KEY);
	EXPECT_EQ(2, root->CountChildren());
	EXPECT_EQ(1, box->CountChildren());
	EXPECT_EQ(BRect(20, 20, 99, 44), root->ChildAt(1)->Frame());
	EXPECT_STREQ("button", box->ChildAt(0)->Name());
}


TEST_F(WorkViewDropTest, ADropOnNothingLosesTheView)
{
	BView* button = Find("button");
	window.driver.Click(button, BPoint(10, 10));
	window.driver.Drag(Driver::PointIn(button, BPoint(10, 10)), BPoint(1200, 800));
	EXPECT_EQ(NULL, Find("button"));
	EXPECT_EQ(1, root->CountChildren());
	EXPECT_NE(nullptr, ViewAttached(root, workView->SelectedView()));
}


TEST_F(WorkViewDropTest, AControlDragToNothingLeavesTheViewInItsPlace)
{
	BView* button = Find("button");
	window.driver.Click(button, BPoint(10, 10));
	const int32 beeps = Driver::CountBeeps();
	window.driver.Drag(
		Driver::PointIn(button, BPoint(10, 10)), BPoint(1200, 800), 10, 1, B_CONTROL_KEY);
	EXPECT_EQ(2, root->CountChildren());
	EXPECT_EQ(button, Find("button"));
	EXPECT_EQ(BRect(20, 20, 99, 44), button->Frame());
	EXPECT_EQ(beeps, Driver::CountBeeps());
}


TEST_F(WorkViewDropTest, UnderADragTheViewThatWouldTakeItIsSelected)
{
	BView* button = Find("button");
	window.driver.Click(button, BPoint(10, 10));
	window.driver.MoveTo(button, BPoint(10, 10));
	window.driver.Press();
	EXPECT_EQ(root, workView->SelectedView());
	EXPECT_EQ(NULL, Find("button"));
	window.driver.MoveTo(box, BPoint(30, 60));
	EXPECT_EQ(box, workView->SelectedView());
	const rgb_color edge = window.driver.PixelAt(box, BPoint(0, 120));
	EXPECT_EQ(255, edge.blue);
	EXPECT_EQ(0, edge.red);
	window.driver.MoveTo(workView->Container(), BPoint(320, 240));
	EXPECT_EQ(box, workView->SelectedView()); // the ground is no view of the design
	window.driver.MoveTo(root, BPoint(40, 130));
	EXPECT_EQ(root, workView->SelectedView());
	window.driver.Release();
	EXPECT_EQ(Find("button"), workView->SelectedView());
	EXPECT_EQ(root, Find("button")->Parent());
}


// Red shows a quarter of what is below; black and white show nothing of it.
TEST_F(WorkViewDropTest, TheDragImageIsTranslucentButForBlackAndWhite)
{
	BView* striped = new BView(BRect(20, 60, 83, 83), "striped", B_FOLLOW_NONE, B_WILL_DRAW);
	for (const auto& [left, color] :
		{ std::pair(0, rgb_color { 255, 0, 0, 255 }), std::pair(20, rgb_color { 0, 0, 0, 255 }),
			std::pair(40, rgb_color { 255, 255, 255, 255 }) }) {
		BView* stripe = new BView(BRect(left, 0, left + 19, 19), "", B_FOLLOW_NONE, B_WILL_DRAW);
		stripe->SetViewColor(color);
		striped->AddChild(stripe);
	}
	window.Locked([&] {
		root->AddChild(striped);
		root->SetViewColor(0, 0, 200);
		root->Invalidate();
		workView->SetSelectedView(striped);
	});
	window.driver.MoveTo(striped, BPoint(5, 21)); // below the stripes
	window.driver.Press();
	ASSERT_EQ(NULL, Find("striped"));
	window.driver.MoveTo(root, BPoint(25, 151));
	const BPoint leftTop(20, 130);
	const rgb_color red = window.driver.PixelAt(root, leftTop + BPoint(10, 10));
	EXPECT_NEAR(192, red.red, 1);
	EXPECT_NEAR(200 * 63 / 255, red.blue, 1);
	const rgb_color black = window.driver.PixelAt(root, leftTop + BPoint(30, 10));
	EXPECT_EQ(0, black.blue);
	const rgb_color white = window.driver.PixelAt(root, leftTop + BPoint(50, 10));
	EXPECT_EQ(255, white.red);
	EXPECT_EQ(255, white.blue);
	window.driver.Release();
}


TEST_F(WorkViewDropTest, TwoQuickClicksLoseNothing)
{
	BView* button = Find("button");
	window.driver.SetWaiting(false);
	for (int i = 0; i < 2; i++)
		window.driver.Click(button, BPoint(10, 10));
	window.driver.SetWaiting(true);
	Driver::WaitUntilIdle();
	ASSERT_NE(nullptr, Find("button"));
	EXPECT_EQ(BRect(20, 20, 99, 44), Find("button")->Frame());
	EXPECT_EQ(2, root->CountChildren());
}


TEST_F(WorkViewDropTest, AMenuBarEndsAtTheLeftTop)
{
	BMenuBar bar(BRect(0, 0, 100, 18), "bar");
	BMessage drag;
	MakeDragMessage(&bar, &drag);
	Drop(drag, box, BPoint(40, 40));
	BView* dropped = Find("bar");
	ASSERT_NE(nullptr, dropped);
	EXPECT_EQ(box, dropped->Parent());
	EXPECT_EQ(BPoint(0, 0), dropped->Frame().LeftTop());
}


TEST_F(WorkViewDropTest, OnlyADroppedArchiveKeepsItsMenuBarWhereItFalls)
{
	BMenuBar bar(BRect(0, 0, 100, 18), "bar");
	for (const uint32 code : { 'drpp', 'drop' }) {
		BMessage archive(code);
		bar.Archive(&archive, true);
		Drop(archive, box, BPoint(40, 40));
		BView* dropped = box->ChildAt(box->CountChildren() - 1);
		EXPECT_STREQ("bar", dropped->Name());
		EXPECT_EQ(code == 'drop' ? BPoint(40, 40) : BPoint(0, 0), dropped->Frame().LeftTop());
	}
	EXPECT_EQ(2, box->CountChildren());
}


TEST_F(SharpDropTest, ADropBetweenPixelsFallsOnTheNearest)
{
	BView view(BRect(0, 0, 30, 30), "fresh", B_FOLLOW_NONE, B_WILL_DRAW);
	BMessage archive('drop');
	view.Archive(&archive, true);
	Drop(archive, root, BPoint(25.5, 150.5));
	EXPECT_EQ(BRect(26, 151, 56, 181), Find("fresh")->Frame());
}


TEST_F(SharpDropTest, ADragThatEndsBetweenPixelsPutsTheViewOnTheNearest)
{
	DragSelected("button", root, BPoint(40.5, 130.5));
	ASSERT_NE(nullptr, Find("button"));
	EXPECT_EQ(BRect(31, 121, 110, 145), Find("button")->Frame());
}


TEST_F(WorkViewDropTest, AnArchiveIsAddedWhereItIsDropped)
{
	BView view(BRect(0, 0, 30, 30), "fresh", B_FOLLOW_NONE, B_WILL_DRAW);
	BMessage archive('drop');
	view.Archive(&archive, true);
	Drop(archive, root, BPoint(25, 150));
	ASSERT_NE(nullptr, Find("fresh"));
	EXPECT_EQ(BPoint(25, 150), Find("fresh")->Frame().LeftTop());
	EXPECT_EQ(Find("fresh"), workView->SelectedView());
}


TEST_F(WorkViewDropTest, RubbishBeepsAndChangesNothing)
{
	const int32 beeps = Driver::CountBeeps();
	BMessage empty('DATA');
	Drop(empty, root, BPoint(25, 150));
	BMessage unknown('drop');
	unknown.AddString("class", "NoSuchClass");
	Drop(unknown, root, BPoint(25, 150));
	BMenuItem item("no view", NULL);
	BMessage noView('drop');
	item.Archive(&noView, true);
	Drop(noView, root, BPoint(25, 150));
	EXPECT_EQ(beeps + 3, Driver::CountBeeps());
	EXPECT_EQ(2, root->CountChildren());
	EXPECT_EQ(root, workView->SelectedView());
}


TEST_F(WorkViewDropTest, APictureBecomesABitmapView)
{
	const std::string path = testing::TempDir() + "dropped picture.png";
	ASSERT_TRUE(window.driver.Screenshot(path.c_str()));
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
	BMessage drop('DATA');
	drop.AddRef("refs", &ref);
	Drop(drop, root, BPoint(5, 150));

	BitmapView* view = dynamic_cast<BitmapView*>(Find("dropped picture.png"));
	ASSERT_NE(nullptr, view);
	ASSERT_NE(nullptr, view->Bitmap());
	EXPECT_EQ(view->Bitmap()->Bounds(), view->Bounds());
	EXPECT_EQ(0u, view->Flags());
}


TEST_F(WorkViewDropTest, AFileOfAViewComesBack)
{
	const std::string path = testing::TempDir() + "dragged.rsrc";
	{
		BButton button(BRect(0, 0, 50, 20), "filed", "Filed", NULL);
		BMessage archive('drop');
		button.Archive(&archive, true);
		std::vector<char> bytes(static_cast<size_t>(archive.FlattenedSize()));
		archive.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
		BFile file(path.c_str(), B_READ_WRITE | B_CREATE_FILE | B_ERASE_FILE);
		BResources resources(&file, true);
		resources.AddResource('ARCV', 1, bytes.data(), bytes.size(), "zetka");
		ASSERT_EQ(B_OK, resources.Sync());
	}
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
	BMessage drop('DATA');
	drop.AddRef("refs", &ref);
	Drop(drop, root, BPoint(5, 150));
	EXPECT_NE(nullptr, dynamic_cast<BButton*>(Find("filed")));
}


TEST_F(WorkViewDropTest, TheGroundAsksBeforeItReplaces)
{
	for (const bool yes : { false, true }) {
		BView view(BRect(0, 0, 80, 80), "fresh", B_FOLLOW_NONE, B_WILL_DRAW);
		BMessage archive('drop');
		view.Archive(&archive, true);
		Drop(archive, workView->Container(), BPoint(330, 230));
		if (yes) {
			BWindow* alert = be_app->WindowAt(be_app->CountWindows() - 1);
			EXPECT_STREQ("Warning!", alert->Title());
			alert->Lock();
			BView* button = alert->FindView("_b0_");
			alert->Unlock();
			window.driver.Click(button);
			EXPECT_STREQ("fresh", workView->EditView()->Name());
		} else {
			window.driver.Key("Escape");
			EXPECT_STREQ("root", workView->EditView()->Name());
		}
	}
}
