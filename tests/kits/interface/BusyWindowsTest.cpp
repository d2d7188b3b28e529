// Each window draws in a thread of its own: the others go on whatever one of them is doing.

#include <atomic>
#include <semaphore>

#include <gtest/gtest.h>

#include <Application.h>
#include <View.h>
#include <Window.h>

#include "support/Driver.h"

namespace {

constexpr int kBusyWindows = 2;

// Stays in the middle of its drawing until it may go on.
class BusyView : public BView {
public:
	BusyView() : BView(BRect(0, 0, 99, 99), "busy", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void Draw(BRect) override
	{
		FillRect(BRect(0, 0, 49, 99));
		if (hold) {
			drawing.release();
			goOn.acquire();
		}
		FillRect(BRect(50, 0, 99, 99));
	}

	std::atomic<bool> hold { false };
	std::binary_semaphore drawing { 0 }, goOn { 0 };
};


class ThirdView : public BView {
public:
	ThirdView() : BView(BRect(0, 0, 99, 99), "third", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void MouseDown(BPoint) override
	{
		SetHighColor(10, 200, 30);
		clicked = true;
		Invalidate();
	}

	void Draw(BRect updateRect) override
	{
		FillRect(updateRect);
		if (clicked)
			painted.release();
	}

	bool clicked = false;
	std::binary_semaphore painted { 0 };
};


BWindow*
Shown(BRect frame, BView* view)
{
	auto* window = new BWindow(frame, "window", B_TITLED_WINDOW, 0);
	window->AddChild(view);
	window->Show();
	return window;
}

} // namespace


TEST(BusyWindows, DoNotKeepAThirdFromAnsweringAndPainting)
{
	BApplication application("application/x-vnd.Archway-test");
	BusyView* busy[kBusyWindows];
	BWindow* windows[kBusyWindows];
	for (int i = 0; i < kBusyWindows; i++) {
		busy[i] = new BusyView;
		windows[i] =
			Shown(BRect(50, 50, 149, 149).OffsetByCopy(static_cast<float>(i) * 150, 0), busy[i]);
	}
	auto* third = new ThirdView;
	BWindow* window = Shown(BRect(350, 50, 449, 149), third);
	Driver driver;
	driver.MoveTo(third);
	driver.SetWaiting(false);

	for (int i = 0; i < kBusyWindows; i++) {
		busy[i]->hold = true;
		windows[i]->Lock();
		busy[i]->Invalidate();
		windows[i]->Unlock();
		busy[i]->drawing.acquire();
	}
	// If the third waited for them, it would wait for ever.
	driver.Press();
	driver.Release();
	third->painted.acquire();
	ASSERT_TRUE(window->Lock());
	window->Sync();
	window->Unlock();
	EXPECT_EQ(200, driver.PixelAt(BPoint(400, 100)).green);

	for (int i = 0; i < kBusyWindows; i++) {
		busy[i]->hold = false;
		busy[i]->goOn.release();
	}
	driver.WaitUntilIdle();
	for (BWindow* each : { windows[0], windows[1], window }) {
		each->Lock();
		each->Quit();
	}
}
