// How mouse, keys, drags and focus reach the views of a window.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Button.h>
#include <Message.h>
#include <MessageFilter.h>
#include <TextControl.h>
#include <View.h>
#include <Window.h>

#include "support/TestWindow.h"

namespace {

using Log = std::vector<std::string>;


std::string
text(BPoint point)
{
	return std::to_string(int(point.x)) + "," + std::to_string(int(point.y));
}


class InputView : public BView {
public:
	InputView(const char* name, BRect frame, Log& log, uint32 flags = 0) :
		BView(frame, name, B_FOLLOW_NONE, B_WILL_DRAW | flags), fLog(log)
	{
	}

	void MouseDown(BPoint where) override
	{
		_Note("down " + text(where));
		if (mouseMask != 0)
			SetMouseEventMask(mouseMask);
		if (onDown)
			onDown();
	}
	void MouseUp(BPoint where) override { _Note("up " + text(where)); }
	void MouseMoved(BPoint where, uint32 transit, const BMessage* dragged) override
	{
		const char* const kNames[] = { "entered", "inside", "exited", "outside" };
		_Note(std::string(kNames[transit]) + (dragged != nullptr ? " with drag" : ""));
	}
	void KeyDown(const char* bytes, int32 numBytes) override
	{
		_Note("key " + std::string(bytes, numBytes));
		BView::KeyDown(bytes, numBytes);
	}
	void MakeFocus(bool focused = true) override
	{
		_Note(focused ? "focus" : "no focus");
		BView::MakeFocus(focused);
	}
	void MessageReceived(BMessage* message) override
	{
		if (message->what == B_MOUSE_WHEEL_CHANGED || message->what == 'drop'
			|| message->what == B_COPY || message->what == 'cmnd') {
			_Note("message " + std::to_string(message->WasDropped()));
			last = *message;
		} else
			BView::MessageReceived(message);
	}

	uint32 mouseMask = 0;
	std::function<void()> onDown;
	BMessage last;

private:
	void _Note(const std::string& what) { fLog.push_back(std::string(Name()) + " " + what); }

	Log& fLog;
};


// The log outlives the window, whose views write into it.
struct LogHolder {
	Log log;
};


struct Two : LogHolder, TestWindow {
	Two()
	{
		a = Add(new InputView("a", BRect(0, 0, 99, 99), log, B_NAVIGABLE));
		b = Add(new InputView("b", BRect(100, 0, 199, 99), log, B_NAVIGABLE));
		driver.MoveTo(BPoint(350, 300));
		log.clear();
	}

	InputView* a;
	InputView* b;
};

} // namespace


TEST(WindowInput, PressAndReleaseReachTheViewInItsOwnCoordinates)
{
	Two window;
	window.Locked([&] { window.b->ScrollTo(5, 0); });
	window.driver.MoveTo(window.b, BPoint(15, 10));
	window.log.clear();
	window.driver.Press();
	window.driver.Release();
	EXPECT_EQ((Log { "b down 15,10", "b up 15,10" }), window.log);
}


TEST(WindowInput, OfOverlappingSiblingsTheFirstIsHit)
{
	Two window;
	BView* over = window.Add(new InputView("over", BRect(50, 0, 149, 99), window.log));
	BView* inner = new InputView("inner", BRect(90, 90, 120, 120), window.log);
	window.Locked([&] {
		window.a->AddChild(inner);
		BWindow* w = window.Window();
		EXPECT_EQ(window.a, w->FindView(BPoint(60, 10)));
		EXPECT_EQ(window.b, w->FindView(BPoint(110, 10)));
		EXPECT_EQ(inner, w->FindView(BPoint(95, 95)));
		EXPECT_EQ(NULL, w->FindView(BPoint(250, 10)));
		window.a->Hide();
		EXPECT_EQ(over, w->FindView(BPoint(60, 10)));
	});
}


TEST(WindowInput, MovesSayWhetherTheViewIsEnteredOrLeft)
{
	Two window;
	window.driver.MoveTo(window.a, BPoint(50, 50));
	window.driver.MoveTo(window.a, BPoint(51, 50));
	window.driver.MoveTo(window.b, BPoint(50, 50));
	window.driver.MoveTo(BPoint(300, 300));
	EXPECT_EQ((Log { "a entered", "a inside", "a exited", "b entered", "b exited" }), window.log);
}


TEST(WindowInput, EventMasksHearOfEverythingFirst)
{
	Two window;
	window.Locked([&] { window.b->SetEventMask(B_POINTER_EVENTS); });
	EXPECT_EQ(uint32(B_POINTER_EVENTS), window.b->EventMask());
	window.driver.MoveTo(window.a, BPoint(50, 50));
	window.driver.MoveTo(window.b, BPoint(50, 50));
	window.driver.MoveTo(window.b, BPoint(51, 50));
	window.driver.MoveTo(BPoint(700, 700));
	EXPECT_EQ((Log { "b outside", "a entered", "b entered", "a exited", "b inside", "b exited" }),
		window.log);
	window.log.clear();
	window.Locked([&] { window.b->SetEventMask(0); });
	window.driver.MoveTo(window.a, BPoint(50, 50));
	EXPECT_EQ((Log { "a entered" }), window.log);
}


TEST(WindowInput, AMouseEventMaskLastsUntilTheRelease)
{
	Two window;
	window.a->mouseMask = B_POINTER_EVENTS;
	window.driver.MoveTo(window.a, BPoint(50, 50));
	window.log.clear();
	window.driver.Press();
	window.driver.MoveTo(window.b, BPoint(50, 50));
	window.driver.MoveTo(BPoint(700, 700));
	window.driver.Release();
	EXPECT_EQ(
		(Log { "a down 50,50", "a exited", "b entered", "a outside", "b exited", "a up 650,650" }),
		window.log);
	window.log.clear();
	window.driver.MoveTo(window.b, BPoint(50, 50));
	EXPECT_EQ((Log { "b entered" }), window.log);
}


TEST(WindowInput, AFilterSeesViewCoordinatesOfPressesAndTransits)
{
	class Spy : public BMessageFilter {
	public:
		Spy() : BMessageFilter(B_ANY_DELIVERY, B_ANY_SOURCE) {}
		filter_result Filter(BMessage* message, BHandler** target) override
		{
			if (message->what == B_MOUSE_DOWN) {
				down = *message;
				downTarget = *target;
			} else if (message->what == B_MOUSE_MOVED)
				moved = *message;
			return B_DISPATCH_MESSAGE;
		}
		BMessage down, moved;
		BHandler* downTarget = nullptr;
	};
	Two window;
	Spy* filter = new Spy;
	window.Locked([&] { window.Window()->AddCommonFilter(filter); });
	window.driver.MoveTo(window.b, BPoint(50, 50));
	EXPECT_EQ(BPoint(150, 50), filter->moved.FindPoint("where"));
	EXPECT_EQ(BPoint(50, 50), filter->moved.FindPoint("be:view_where"));
	EXPECT_EQ(B_ENTERED_VIEW, filter->moved.FindInt32("be:transit"));
	window.driver.Click(window.b, BPoint(20, 30), 2);
	EXPECT_EQ(window.b, filter->downTarget);
	EXPECT_EQ(BPoint(20, 30), filter->down.FindPoint("where"));
	EXPECT_EQ(2, filter->down.FindInt32("clicks"));
	EXPECT_EQ(1, filter->down.FindInt32("buttons"));
}


TEST(WindowInput, TheWheelGoesToTheViewUnderThePointer)
{
	Two window;
	window.driver.Wheel(window.b, 0, 1);
	EXPECT_EQ("b message 0", window.log.back());
	EXPECT_EQ(1, window.b->last.FindFloat("be:wheel_delta_y"));
}


TEST(WindowInput, AViewThatIsTakenOutUnderThePointerIsForgotten)
{
	Two window;
	window.driver.MoveTo(window.a, BPoint(50, 50));
	window.Locked([&] {
		EXPECT_EQ(window.a, window.Window()->LastMouseMovedView());
		window.a->RemoveSelf();
		EXPECT_EQ(NULL, window.Window()->LastMouseMovedView());
		delete window.a;
	});
	window.log.clear();
	window.driver.MoveTo(window.b, BPoint(50, 50));
	EXPECT_EQ((Log { "b entered" }), window.log);
}


// #pragma mark - keys


TEST(WindowInput, KeysGoToTheFocusView)
{
	Two window;
	window.driver.Type("x");
	EXPECT_EQ((Log {}), window.log);
	window.Locked([&] {
		window.a->MakeFocus();
		EXPECT_EQ(window.a, window.Window()->CurrentFocus());
		EXPECT_EQ(window.a, window.Window()->PreferredHandler());
		window.b->MakeFocus();
		EXPECT_TRUE(window.b->IsFocus());
	});
	EXPECT_EQ((Log { "a focus", "b focus", "a no focus" }), window.log);
	window.log.clear();
	window.driver.Type("x");
	EXPECT_EQ((Log { "b key x" }), window.log);
	window.Locked([&] {
		window.b->RemoveSelf();
		EXPECT_EQ(NULL, window.Window()->CurrentFocus());
		EXPECT_EQ(NULL, window.Window()->PreferredHandler());
	});
	delete window.b;
}


TEST(WindowInput, TabGoesRoundTheNavigableViews)
{
	Two window;
	window.Add(new InputView("skipped", BRect(0, 200, 9, 209), window.log));
	BView* hidden =
		window.Add(new InputView("hidden", BRect(0, 210, 9, 219), window.log, B_NAVIGABLE));
	InputView* inner = new InputView("inner", BRect(0, 0, 9, 9), window.log, B_NAVIGABLE);
	window.Locked([&] {
		hidden->Hide();
		window.a->AddChild(inner);
		window.a->MakeFocus();
	});
	BWindow* w = window.Window();
	window.driver.Key("Tab");
	EXPECT_EQ(inner, w->CurrentFocus());
	window.driver.Key("Tab");
	EXPECT_EQ(window.b, w->CurrentFocus());
	window.driver.Key("Tab");
	EXPECT_EQ(window.a, w->CurrentFocus());
	window.driver.Key("Tab", B_SHIFT_KEY);
	EXPECT_EQ(window.b, w->CurrentFocus());
	window.driver.Key("Tab", B_OPTION_KEY);
	EXPECT_EQ(window.a, w->CurrentFocus());
}


TEST(WindowInput, ShortcutsAreSentAndOtherCommandKeysEaten)
{
	Two window;
	window.Locked([&] {
		window.a->MakeFocus();
		window.Window()->AddShortcut('j', 0, new BMessage('cmnd'), window.b);
		window.Window()->AddShortcut('J', B_SHIFT_KEY, new BMessage('cmnd'), NULL);
	});
	window.log.clear();
	window.driver.Key("j", B_COMMAND_KEY);
	EXPECT_EQ((Log { "b message 0" }), window.log);
	EXPECT_TRUE(window.b->last.HasInt64("when"));
	window.driver.Key("j", B_COMMAND_KEY | B_SHIFT_KEY);
	EXPECT_EQ("a message 0", window.log.back());
	window.log.clear();
	window.driver.Key("k", B_COMMAND_KEY);
	EXPECT_EQ((Log {}), window.log);
	window.driver.Key("c", B_COMMAND_KEY);
	EXPECT_EQ((Log { "a message 0" }), window.log);
	window.log.clear();
	window.Locked([&] { window.Window()->RemoveShortcut('j', 0); });
	window.driver.Key("j", B_COMMAND_KEY);
	EXPECT_EQ((Log {}), window.log);
}


TEST(WindowInput, EnterGoesToTheDefaultButton)
{
	Two window;
	BButton* button =
		window.Add(new BButton(BRect(0, 200, 80, 224), "button", "OK", new BMessage('cmnd')));
	window.Locked([&] {
		window.a->MakeFocus();
		window.Window()->SetDefaultButton(button);
		button->SetTarget(window.b);
	});
	window.log.clear();
	window.driver.Type("\n");
	EXPECT_EQ((Log { "b message 0" }), window.log);
	window.driver.Key("Return", B_SHIFT_KEY);
	EXPECT_EQ("a key \n", window.log.back());
	window.Locked([&] {
		EXPECT_TRUE(button->IsDefault());
		window.Window()->SetDefaultButton(NULL);
		EXPECT_FALSE(button->IsDefault());
	});
}


TEST(WindowInput, CommandWAsksTheWindowToQuit)
{
	class Asked : public BWindow {
	public:
		Asked() : BWindow(BRect(500, 50, 599, 149), "asked", B_TITLED_WINDOW, 0) {}
		bool QuitRequested() override
		{
			asked++;
			return false;
		}
		int asked = 0;
	};
	TestWindow window;
	Asked* asked = new Asked;
	asked->Show();
	Driver::WaitUntilIdle();
	window.driver.ActivateWindow(asked);
	window.driver.Key("w", B_COMMAND_KEY);
	EXPECT_EQ(1, asked->asked);
	window.driver.CloseWindow(asked);
	EXPECT_EQ(2, asked->asked);
	asked->Lock();
	asked->Quit();
}


// #pragma mark - drags


TEST(WindowInput, ADragIsDroppedUnderItsOwnCode)
{
	Two window;
	window.a->onDown = [&] {
		BMessage message('drop');
		message.AddString("text", "hello");
		window.a->DragMessage(&message, BRect(40, 40, 60, 60));
	};
	window.driver.Drag(window.a, BPoint(50, 50), window.b, BPoint(30, 20), 3);
	ASSERT_FALSE(window.log.empty());
	EXPECT_EQ("b message 1", window.log.back());
	const BMessage& drop = window.b->last;
	EXPECT_EQ(uint32('drop'), drop.what);
	EXPECT_STREQ("hello", drop.FindString("text"));
	EXPECT_EQ(1, drop.FindInt32("buttons"));
	EXPECT_FALSE(drop.HasInt32("_original_what"));
	BPoint offset;
	BPoint point = drop.DropPoint(&offset);
	EXPECT_EQ(BPoint(10, 10), offset);
	window.Locked([&] { window.b->ConvertFromScreen(&point); });
	EXPECT_EQ(BPoint(30, 20), point);
	EXPECT_NE(
		window.log.end(), std::find(window.log.begin(), window.log.end(), "b entered with drag"));
}


TEST(WindowInput, WithoutAButtonThereIsNoDrag)
{
	Two window;
	window.driver.MoveTo(window.b, BPoint(50, 50));
	window.log.clear();
	window.Locked([&] {
		BMessage message('drop');
		window.a->DragMessage(&message, new BBitmap(BRect(0, 0, 9, 9), B_RGBA32), BPoint(1, 1));
	});
	window.driver.MoveTo(window.b, BPoint(60, 50));
	EXPECT_EQ((Log { "b inside" }), window.log);
}


TEST(WindowInput, ThePollingLoopEndsWithTheRelease)
{
	Two window;
	std::vector<BPoint> places;
	window.a->onDown = [&] {
		BPoint where;
		uint32 buttons = 1;
		while (buttons != 0) {
			window.a->GetMouse(&where, &buttons);
			places.push_back(where);
		}
	};
	window.driver.MoveTo(window.a, BPoint(50, 50));
	window.log.clear();
	// The loop holds the window's lock, so places are the screen's.
	window.driver.Press();
	window.driver.MoveTo(BPoint(110, 100));
	window.driver.MoveTo(BPoint(120, 100));
	window.driver.Release();
	ASSERT_FALSE(places.empty());
	EXPECT_EQ(BPoint(70, 50), places.back());
	EXPECT_NE(places.end(), std::find(places.begin(), places.end(), BPoint(60, 50)));
	EXPECT_EQ((Log { "a down 50,50" }), window.log);
}


// #pragma mark - pulse and activation


TEST(WindowInput, PulseComesToViewsThatAskForIt)
{
	class Beat : public BView {
	public:
		Beat(uint32 flags, std::atomic<int>& count) :
			BView(BRect(0, 0, 9, 9), "beat", B_FOLLOW_NONE, flags), fCount(count)
		{
		}
		void Pulse() override { fCount++; }
		std::atomic<int>& fCount;
	};
	std::atomic<int> beats { 0 };
	std::atomic<int> others { 0 };
	TestWindow window;
	window.Locked([&] { window.Window()->SetPulseRate(5000); });
	window.Add(new Beat(0, others));
	window.Add(new Beat(B_PULSE_NEEDED, beats));
	const bigtime_t end = system_time() + 10000000;
	while (beats < 3 && system_time() < end)
		snooze(1000);
	EXPECT_GE(beats, 3);
	EXPECT_EQ(0, others);
}


TEST(WindowInput, ActivationReachesTheWindowThenEveryView)
{
	class Note : public BView {
	public:
		Note(const char* name, Log& log) :
			BView(BRect(0, 0, 9, 9), name, B_FOLLOW_NONE, 0), fLog(log)
		{
		}
		void WindowActivated(bool active) override
		{
			fLog.push_back(std::string(Name()) + (active ? " on" : " off"));
		}
		Log& fLog;
	};
	Log log;
	TestWindow window;
	BView* parent = new Note("p", log);
	parent->AddChild(new Note("c", log));
	window.Add(parent);
	window.Add(new Note("q", log));
	BWindow* other = new BWindow(BRect(500, 50, 599, 149), "other", B_TITLED_WINDOW, 0);
	other->Show();
	Driver::WaitUntilIdle();
	window.driver.ActivateWindow(other);
	EXPECT_EQ((Log { "p off", "c off", "q off" }), log);
	EXPECT_FALSE(window.Window()->IsActive());
	log.clear();
	window.driver.ActivateWindow(window.Window());
	EXPECT_EQ((Log { "p on", "c on", "q on" }), log);
	EXPECT_TRUE(window.Window()->IsActive());
	other->Lock();
	other->Quit();
}
