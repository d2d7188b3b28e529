// The life, the frame and the kind of windows.
#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Message.h>
#include <Screen.h>
#include <View.h>
#include <Window.h>

#include "support/DebuggerCatcher.h"
#include "support/TestWindow.h"

namespace {

class DeathView : public BView {
public:
	DeathView(int* detached, int* deleted) :
		BView(BRect(0, 0, 9, 9), "death", B_FOLLOW_NONE, 0), fDetached(detached), fDeleted(deleted)
	{
	}
	~DeathView() { (*fDeleted)++; }
	void DetachedFromWindow() override
	{
		EXPECT_NE(nullptr, Window());
		EXPECT_TRUE(Window()->IsLocked());
		(*fDetached)++;
	}

private:
	int* fDetached;
	int* fDeleted;
};

} // namespace


TEST(Window, IsHiddenAndLockedUntilItIsShown)
{
	BApplication app("application/x-vnd.Archway-test");
	BWindow* window = new BWindow(BRect(10.4, 20, 109.6, 119), "title", B_TITLED_WINDOW, 0);
	EXPECT_TRUE(window->IsLocked());
	EXPECT_TRUE(window->IsHidden());
	EXPECT_EQ(BRect(10, 20, 110, 119), window->Frame());
	EXPECT_EQ(BRect(0, 0, 100, 99), window->Bounds());
	EXPECT_STREQ("title", window->Title());
	window->Show();
	EXPECT_FALSE(window->IsLocked());
	EXPECT_FALSE(window->IsHidden());
	window->Lock();
	window->Hide();
	window->Hide();
	window->Show();
	EXPECT_TRUE(window->IsHidden());
	window->Show();
	EXPECT_FALSE(window->IsHidden());
	window->Quit();
}


TEST(Window, QuitDeletesItsViewsAfterTheirHooks)
{
	BApplication app("application/x-vnd.Archway-test");
	int detached = 0;
	int deleted = 0;
	BWindow* window = new BWindow(BRect(10, 20, 109, 119), "title", B_TITLED_WINDOW, 0);
	BView* parent = new DeathView(&detached, &deleted);
	parent->AddChild(new DeathView(&detached, &deleted));
	window->AddChild(parent);
	window->Show();
	window->Lock();
	window->Quit();
	EXPECT_EQ(2, detached);
	EXPECT_EQ(2, deleted);

	// One that was never shown goes as well.
	window = new BWindow(BRect(10, 20, 109, 119), "title", B_TITLED_WINDOW, 0);
	window->AddChild(new DeathView(&detached, &deleted));
	window->Quit();
	EXPECT_EQ(3, deleted);
}


TEST(Window, AQuitRequestEndsIt)
{
	BApplication app("application/x-vnd.Archway-test");
	BWindow* window = new BWindow(BRect(10, 20, 109, 119), "title", B_TITLED_WINDOW, 0);
	BMessenger messenger(window);
	window->Show();
	Driver driver;
	driver.CloseWindow(window);
	EXPECT_FALSE(messenger.IsValid());
}


// Desktops show a close button all the same.
TEST(Window, OneThatIsNotClosableIsNotClosedByTheUser)
{
	TestWindow test;
	test.Locked([&] { test.Window()->SetFlags(B_NOT_CLOSABLE); });
	test.driver.CloseWindow(test.Window());
	EXPECT_TRUE(BMessenger(test.Window()).IsValid());
	test.driver.Key("w", B_COMMAND_KEY);
	EXPECT_TRUE(BMessenger(test.Window()).IsValid());
}


TEST(Window, TypesAreLooksAndFeels)
{
	TestWindow test;
	BWindow* window = test.Window();
	EXPECT_EQ(B_TITLED_WINDOW_LOOK, window->Look());
	EXPECT_EQ(B_NORMAL_WINDOW_FEEL, window->Feel());
	test.Locked([&] {
		window->SetType(B_FLOATING_WINDOW);
		EXPECT_EQ(B_FLOATING_WINDOW_LOOK, window->Look());
		EXPECT_EQ(B_FLOATING_APP_WINDOW_FEEL, window->Feel());
		EXPECT_TRUE(window->IsFloating());
		window->SetType(B_MODAL_WINDOW);
		EXPECT_TRUE(window->IsModal());
		window->SetLook(B_BORDERED_WINDOW_LOOK);
		window->SetFeel(B_NORMAL_WINDOW_FEEL);
		window->SetFlags(B_NOT_CLOSABLE | 0x40000000);
		EXPECT_EQ(uint32(B_NOT_CLOSABLE | 0x40000000), window->Flags());
	});
}


TEST(Window, LimitsBindTheUserAlone)
{
	TestWindow test(BRect(50, 50, 249, 149));
	test.Locked([&] { test.Window()->SetSizeLimits(100, 300, 80, 200); });
	float minWidth, maxWidth, minHeight, maxHeight;
	test.Window()->GetSizeLimits(&minWidth, &maxWidth, &minHeight, &maxHeight);
	EXPECT_EQ(100, minWidth);
	EXPECT_EQ(200, maxHeight);
	test.Locked([&] { test.Window()->ResizeTo(49, 49); });
	EXPECT_EQ(BRect(0, 0, 49, 49), test.Window()->Bounds());
	test.driver.ResizeWindow(test.Window(), 400, 400);
	EXPECT_EQ(BRect(0, 0, 300, 200), test.Window()->Bounds());
}


TEST(Window, TellsOfMovesAndSizesByHooks)
{
	class Noting : public BWindow {
	public:
		Noting() : BWindow(BRect(50, 50, 149, 149), "noting", B_TITLED_WINDOW, 0) {}
		void FrameMoved(BPoint where) override { moved = where; }
		void FrameResized(float width, float height) override { size = BPoint(width, height); }
		BPoint moved, size;
	};
	BApplication app("application/x-vnd.Archway-test");
	Noting* window = new Noting;
	window->Show();
	Driver driver;
	driver.MoveWindow(window, BPoint(70, 80));
	EXPECT_EQ(BPoint(70, 80), window->moved);
	EXPECT_EQ(BPoint(70, 80), window->Frame().LeftTop());
	window->Lock();
	window->ResizeTo(120, 130);
	window->MoveBy(1, 1);
	window->Unlock();
	Driver::WaitUntilIdle();
	EXPECT_EQ(BPoint(120, 130), window->size);
	EXPECT_EQ(BPoint(71, 81), window->moved);
	EXPECT_EQ(BPoint(72, 83), window->ConvertToScreen(BPoint(1, 2)));
	EXPECT_EQ(BPoint(1, 2), window->ConvertFromScreen(BPoint(72, 83)));
	window->Lock();
	window->Quit();
}


TEST(Window, IsArchivedWithItsViews)
{
	TestWindow test(BRect(50, 60, 249, 149));
	test.Add(new BView(BRect(1, 2, 3, 4), "child", B_FOLLOW_NONE, 0));
	BMessage archive;
	test.Locked([&] { EXPECT_EQ(B_OK, test.Window()->Archive(&archive)); });
	EXPECT_EQ(BRect(50, 60, 249, 149), archive.FindRect("_frame"));
	EXPECT_STREQ("test", archive.FindString("_title"));

	BWindow* copy = dynamic_cast<BWindow*>(BWindow::Instantiate(&archive));
	ASSERT_NE(nullptr, copy);
	EXPECT_STREQ("test", copy->Title());
	EXPECT_EQ(B_TITLED_WINDOW_LOOK, copy->Look());
	EXPECT_TRUE(copy->IsHidden());
	ASSERT_NE(nullptr, copy->FindView("child"));
	EXPECT_EQ(BRect(1, 2, 3, 4), copy->FindView("child")->Frame());
	copy->Quit();
}


TEST(Window, AnOffscreenBitmapTakesDrawing)
{
	BApplication app("application/x-vnd.Archway-test");
	BBitmap bitmap(BRect(0, 0, 9, 9), B_RGBA32, true);
	BView* view = new BView(bitmap.Bounds(), "view", B_FOLLOW_NONE, B_WILL_DRAW);
	ASSERT_TRUE(bitmap.Lock());
	bitmap.AddChild(view);
	EXPECT_NE(nullptr, view->Window());
	EXPECT_EQ(NULL, view->Parent());
	view->SetHighColor(255, 0, 0);
	view->FillRect(BRect(2, 2, 4, 4));
	view->Sync();
	EXPECT_TRUE(bitmap.RemoveChild(view));
	bitmap.Unlock();
	EXPECT_EQ(NULL, view->Window());
	delete view;
	const uint32* bits = static_cast<const uint32*>(bitmap.Bits());
	const int32 row = bitmap.BytesPerRow() / 4;
	EXPECT_EQ(0xffff0000, bits[2 * row + 2]);
	EXPECT_EQ(0xffff0000, bits[4 * row + 4]);
	EXPECT_NE(0xffff0000, bits[5 * row + 4]);
}


TEST(Window, ManyWindowsComeAndGo)
{
	BApplication app("application/x-vnd.Archway-test");
	for (int round = 0; round < 20; round++) {
		BWindow* windows[5];
		for (BWindow*& window : windows) {
			window = new BWindow(BRect(10, 10, 109, 109), "w", B_TITLED_WINDOW, 0);
			window->AddChild(new BView(BRect(0, 0, 99, 99), "v", B_FOLLOW_ALL, B_WILL_DRAW));
			window->Show();
		}
		for (BWindow* window : windows) {
			window->Lock();
			window->Quit();
		}
	}
	EXPECT_EQ(0, app.CountWindows());
}
