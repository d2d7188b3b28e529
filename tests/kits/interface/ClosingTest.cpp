// Windows that go in the middle of something: a drag, a question, an open menu.
#include <gtest/gtest.h>

#include <Alert.h>
#include <Invoker.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>

#include "ControlFixture.h"
#include "support/TestWindow.h"

namespace {

// Drags a text away as soon as the pointer moves with the button held, and takes what is dropped.
class DragView : public BView {
public:
	explicit DragView(BRect frame) : BView(frame, "drag", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void MouseDown(BPoint where) override { fPressed = true; }
	void MouseUp(BPoint where) override { fPressed = false; }
	void MouseMoved(BPoint where, uint32 code, const BMessage* message) override
	{
		if (!fPressed)
			return;
		fPressed = false;
		BMessage drag('drag');
		drag.AddString("text", "dragged");
		DragMessage(&drag, BRect(where.x - 5, where.y - 5, where.x + 5, where.y + 5));
	}
	void MessageReceived(BMessage* message) override
	{
		if (message->WasDropped())
			drops++;
		else
			BView::MessageReceived(message);
	}

	int32 drops = 0;

private:
	bool fPressed = false;
};


// A window beside the fixture's own.
class OtherWindow : public BWindow {
public:
	OtherWindow() : BWindow(BRect(500, 50, 699, 249), "other", B_TITLED_WINDOW, 0)
	{
		view = new DragView(Bounds());
		AddChild(view);
	}

	DragView* view; // child
};


class Closing : public testing::Test {
protected:
	Closing() : other(new OtherWindow), otherTarget(other)
	{
		source = fixture.Add(new DragView(BRect(0, 0, 199, 199)));
		other->Show();
		// The first click would only activate the window.
		fixture.driver.ActivateWindow(fixture.window);
	}

	~Closing() override { Close(other); }

	// Does nothing if it is closed.
	void Close(BWindow* window)
	{
		const BMessenger& target = window == other ? otherTarget : fixture.target;
		if (target.LockTarget())
			window->Quit();
		Driver::WaitUntilIdle();
	}

	// Leaves the button held over the other window.
	void DragOver()
	{
		fixture.driver.MoveTo(source, BPoint(50, 50));
		fixture.driver.Press();
		fixture.driver.MoveTo(source, BPoint(60, 60));
		fixture.driver.MoveTo(source, BPoint(70, 70));
		fixture.driver.MoveTo(BPoint(600, 150));
	}

	ControlFixture fixture;
	DragView* source; // child
	OtherWindow* other; // ends with the test, unless that closes it
	const BMessenger otherTarget; // tells whether it is still there
};

} // namespace


TEST_F(Closing, TheTargetOfADragMayGo)
{
	DragOver();
	Close(other);
	fixture.driver.MoveTo(BPoint(610, 150));
	fixture.driver.MoveTo(source, BPoint(100, 100));
	fixture.driver.Release();
	EXPECT_EQ(1, fixture.Locked([&] { return source->drops; }));
}


TEST_F(Closing, TheSourceOfADragMayGo)
{
	DragOver();
	fixture.Locked([&] { fixture.window->PostMessage(B_QUIT_REQUESTED); });
	EXPECT_FALSE(fixture.target.IsValid());
	fixture.driver.MoveTo(BPoint(610, 150));
	fixture.driver.Release();
	other->Lock();
	EXPECT_EQ(1, other->view->drops);
	other->Unlock();
}


TEST_F(Closing, TheSourceViewOfADragMayGo)
{
	DragOver();
	fixture.Locked([&] {
		source->RemoveSelf();
		delete source;
	});
	fixture.driver.Release();
	other->Lock();
	EXPECT_EQ(1, other->view->drops);
	other->Unlock();
}


TEST_F(Closing, BothWindowsOfADragMayGo)
{
	DragOver();
	Close(other);
	Close(fixture.window);
	fixture.driver.MoveTo(BPoint(610, 150));
	fixture.driver.Release();
	EXPECT_EQ(0, fixture.app.CountWindows());
}


TEST_F(Closing, AWindowWithAnOpenMenuMayGo)
{
	BMenuBar* bar = new BMenuBar(BRect(0, 220, 10, 230), "bar");
	BMenu* menu = new BMenu("Menu");
	menu->AddItem(new BMenuItem("Item", new BMessage('item')));
	BMenu* submenu = new BMenu("Submenu");
	submenu->AddItem(new BMenuItem("Deep", new BMessage('deep')));
	menu->AddItem(submenu);
	bar->AddItem(menu);
	fixture.Add(bar);
	const BPoint title = Driver::PointIn(bar, BPoint(15, 8));
	fixture.driver.Click(title);
	fixture.driver.Key("Down");
	fixture.driver.Key("Down");
	fixture.driver.Key("Right");
	EXPECT_TRUE(fixture.Locked([&] { return submenu->Window() != NULL; }));

	fixture.driver.CloseWindow(fixture.window);
	EXPECT_FALSE(fixture.target.IsValid());
	EXPECT_EQ(1, fixture.app.CountWindows());
	fixture.driver.Key("Return");
	fixture.driver.Click(title);
}


TEST_F(Closing, AWindowThatWaitsForAnAlertIsClosedAfterIt)
{
	class Asking : public BWindow {
	public:
		Asking() : BWindow(BRect(50, 400, 249, 499), "asking", B_TITLED_WINDOW, 0) {}
		void MessageReceived(BMessage* message) override
		{
			if (message->what != 'ask ')
				BWindow::MessageReceived(message);
			else
				(new BAlert("question", "Go on?", "No", "Yes"))->Go();
		}
	};
	Asking* asking = new Asking;
	asking->Show();
	BMessenger messenger(asking);
	messenger.SendMessage('ask ');
	Driver::WaitUntilIdle();
	messenger.SendMessage(B_QUIT_REQUESTED);
	Driver::WaitUntilIdle();
	EXPECT_TRUE(messenger.IsValid());
	fixture.driver.Key("Return");
	EXPECT_FALSE(messenger.IsValid());
}


TEST_F(Closing, TheReceiverOfAnAlertsAnswerMayGo)
{
	BAlert* alert = new BAlert("question", "Go on?", "No", "Yes");
	alert->Go(new BInvoker(new BMessage('answ'), fixture.window));
	Driver::WaitUntilIdle();
	Close(fixture.window);
	fixture.driver.Key("Return");
	EXPECT_EQ(1, fixture.app.CountWindows());
}


TEST_F(Closing, TheApplicationQuitsThroughAnOpenMenu)
{
	BMenuBar* bar = new BMenuBar(BRect(0, 220, 10, 230), "bar");
	BMenu* menu = new BMenu("Menu");
	menu->AddItem(new BMenuItem("Item", new BMessage('item')));
	bar->AddItem(menu);
	fixture.Add(bar);
	fixture.driver.Click(Driver::PointIn(bar, BPoint(15, 8)));
	EXPECT_TRUE(fixture.Locked([&] { return menu->Window() != NULL; }));
	EXPECT_TRUE(fixture.app.QuitRequested());
	EXPECT_EQ(0, fixture.app.CountWindows());
	fixture.driver.Key("Return");
}
