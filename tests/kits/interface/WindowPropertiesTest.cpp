// What a window can be told and asked.
#include <gtest/gtest.h>

#include <MenuBar.h>
#include <Screen.h>

#include "support/TestWindow.h"

namespace {

class OtherWindow : public BWindow {
public:
	OtherWindow() : BWindow(BRect(500, 100, 699, 299), "other", B_TITLED_WINDOW, 0) {}

	void Zoom(BPoint leftTop, float width, float height) override
	{
		zooms++;
		BWindow::Zoom(leftTop, width, height);
	}

	int32 zooms = 0;
};

} // namespace


TEST(WindowProperties, TitlesFramesAndPlaces)
{
	TestWindow test(BRect(100, 100, 299, 199));
	test.Locked([&] {
		BWindow* window = test.Window();
		window->SetTitle("renamed");
		EXPECT_STREQ("renamed", window->Title());
		window->MoveTo(50, 60);
		EXPECT_EQ(BRect(50, 60, 249, 159), window->Frame());
		window->MoveBy(5, 5);
		window->ResizeBy(10, 20);
		EXPECT_EQ(BRect(55, 65, 264, 184), window->Frame());
		window->CenterOnScreen();
		const BRect screen = BScreen(window).Frame();
		EXPECT_NEAR(screen.Width() - window->Frame().right, window->Frame().left, 1);
		window->CenterIn(BRect(0, 0, 409, 319));
		EXPECT_EQ(100, window->Frame().left);
		EXPECT_EQ(0, window->CountChildren());
		BView* view = new BView(BRect(0, 0, 9, 9), "view", B_FOLLOW_NONE, 0);
		window->AddChild(view);
		EXPECT_EQ(1, window->CountChildren());
		EXPECT_EQ(view, window->ChildAt(0));
	});
}


TEST(WindowProperties, ZoomingFillsTheLimitsAndComesBack)
{
	BApplication app("application/x-vnd.Archway-test");
	OtherWindow* window = new OtherWindow;
	window->Show();
	Driver::WaitUntilIdle();
	window->Lock();
	const BRect before = window->Frame();
	window->SetZoomLimits(400, 300);
	static_cast<BWindow*>(window)->Zoom();
	window->Unlock();
	Driver::WaitUntilIdle();
	window->Lock();
	EXPECT_EQ(1, window->zooms);
	EXPECT_EQ(400, window->Bounds().Width());
	EXPECT_EQ(300, window->Bounds().Height());
	static_cast<BWindow*>(window)->Zoom();
	window->Unlock();
	Driver::WaitUntilIdle();
	window->Lock();
	EXPECT_EQ(before, window->Frame());
	window->Quit();
}


TEST(WindowProperties, AMinimizedWindowIsRemembered)
{
	TestWindow test;
	test.Locked([&] { test.Window()->Minimize(true); });
	test.Locked([&] {
		EXPECT_TRUE(test.Window()->IsMinimized());
		test.Window()->Minimize(false);
	});
	test.Locked([&] { EXPECT_FALSE(test.Window()->IsMinimized()); });
}


TEST(WindowProperties, WindowsAreSentBehindEachOther)
{
	TestWindow test;
	OtherWindow* other = new OtherWindow;
	other->Show();
	Driver::WaitUntilIdle();
	test.driver.ActivateWindow(other);
	other->Lock();
	EXPECT_TRUE(other->IsFront());
	EXPECT_TRUE(other->IsActive());
	EXPECT_EQ(B_OK, other->SendBehind(test.Window()));
	other->Unlock();
	Driver::WaitUntilIdle();
	test.Locked([&] { EXPECT_TRUE(test.Window()->IsFront()); });
	other->Lock();
	EXPECT_FALSE(other->IsFront());
	other->Close();
}


TEST(WindowProperties, TheKeyMenuBarIsTheLastThatWasAttached)
{
	TestWindow test;
	BMenuBar* first = new BMenuBar(BRect(0, 0, 9, 9), "first");
	BMenuBar* second = new BMenuBar(BRect(0, 30, 9, 39), "second");
	test.Add(first);
	test.Add(second);
	test.Locked([&] {
		EXPECT_EQ(second, test.Window()->KeyMenuBar());
		test.Window()->SetKeyMenuBar(first);
		EXPECT_EQ(first, test.Window()->KeyMenuBar());
		first->RemoveSelf();
		EXPECT_EQ(nullptr, test.Window()->KeyMenuBar());
	});
	delete first;
}


TEST(WindowProperties, SubsetsAreOfWindowsThatNeedOne)
{
	TestWindow test;
	OtherWindow* floating = new OtherWindow;
	EXPECT_EQ(B_OK, floating->SetFeel(B_FLOATING_SUBSET_WINDOW_FEEL));
	EXPECT_TRUE(floating->IsFloating());
	EXPECT_EQ(B_OK, floating->AddToSubset(test.Window()));
	EXPECT_EQ(B_OK, floating->RemoveFromSubset(test.Window()));
	floating->Quit();
}


TEST(WindowProperties, NumbersAreKept)
{
	TestWindow test;
	test.Locked([&] {
		BWindow* window = test.Window();
		window->SetPulseRate(70000);
		EXPECT_EQ(70000, window->PulseRate());
		window->SetWorkspaces(5);
		EXPECT_EQ(5u, window->Workspaces());
		EXPECT_FALSE(window->NeedsUpdate());
		EXPECT_FALSE(window->InViewTransaction());
		window->BeginViewTransaction();
		EXPECT_TRUE(window->InViewTransaction());
		window->EndViewTransaction();
		EXPECT_FALSE(window->InViewTransaction());
	});
}


TEST(WindowProperties, TheTypeNamesTheLookAndFeel)
{
	TestWindow test;
	OtherWindow* window = new OtherWindow;
	EXPECT_EQ(B_OK, window->SetLook(B_DOCUMENT_WINDOW_LOOK));
	EXPECT_EQ(B_DOCUMENT_WINDOW, window->Type());
	EXPECT_EQ(B_OK, window->SetType(B_FLOATING_WINDOW));
	EXPECT_EQ(B_FLOATING_WINDOW_LOOK, window->Look());
	EXPECT_EQ(B_FLOATING_APP_WINDOW_FEEL, window->Feel());
	EXPECT_EQ(B_OK, window->SetFeel(B_NORMAL_WINDOW_FEEL));
	EXPECT_EQ(B_UNTYPED_WINDOW, window->Type()) << "no type looks like a palette and is none";
	EXPECT_EQ(B_OK, window->SetLook(B_BORDERED_WINDOW_LOOK));
	EXPECT_EQ(B_BORDERED_WINDOW, window->Type());
	EXPECT_EQ(B_BAD_VALUE, window->SetType(static_cast<window_type>(7)));
	EXPECT_EQ(B_BORDERED_WINDOW, window->Type());
	window->Quit();
}
