// When a window paints, and when it shows what it has painted.
#include <atomic>

#include <gtest/gtest.h>

#include <Message.h>
#include <View.h>

#include "interface/private/WindowInternals.h"
#include "support/PaintCounter.h"
#include "support/TestWindow.h"

namespace {


constexpr bigtime_t kMinute = 60000000;
constexpr uint32 kStep = 'step';
constexpr int kSteps = 100;


// Each step does something and posts the next one, until there are none left.
class Stepper : public BView {
public:
	Stepper() : BView(BRect(0, 0, 99, 99), "stepper", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void Draw(BRect) override { draws++; }

	void MessageReceived(BMessage* message) override
	{
		if (message->what != kStep) {
			BView::MessageReceived(message);
			return;
		}
		if (drawsDirectly)
			FillRect(BRect(10, 10, 20, 20));
		else
			Invalidate(BRect(10, 10, 20, 20));
		if (--stepsLeft != 0)
			Window()->PostMessage(kStep, this);
	}

	bool drawsDirectly = false;
	std::atomic<int> stepsLeft { 0 };
	std::atomic<int> draws { 0 };
};


class UpdateOrder : public testing::TestWithParam<bool> {
protected:
	UpdateOrder() : window(BRect(10, 10, 209, 209))
	{
		stepper = new Stepper;
		stepper->drawsDirectly = GetParam();
		window.Add(stepper);
		stepper->draws = 0;
	}

	~UpdateOrder() override { BPrivate::WindowInternals::presentDelay = delay; }

	void Start(int steps)
	{
		stepper->stepsLeft = steps;
		window.Window()->PostMessage(kStep, stepper);
	}

	const bigtime_t delay = BPrivate::WindowInternals::presentDelay;
	TestWindow window;
	Stepper* stepper;
};


} // namespace


TEST_P(UpdateOrder, MessagesThatFollowEachOtherAreShownOnce)
{
	BPrivate::WindowInternals::presentDelay = kMinute;
	PaintCounter counter(window.Window());
	Start(kSteps);
	Driver::WaitUntilIdle();
	EXPECT_EQ(0, stepper->stepsLeft);
	EXPECT_EQ(1, counter.Flushes());
	EXPECT_EQ(GetParam() ? 0 : kSteps, stepper->draws);
	EXPECT_EQ(11 * 11, counter.FlushedPixels());
}


// Would wait for ever if it were not so.
TEST_P(UpdateOrder, MessagesWithoutEndDoNotKeepTheWindowFromShowing)
{
	PaintCounter counter(window.Window());
	Start(-1);
	while (counter.Flushes() < 3) {
	}
	stepper->stepsLeft = 1;
	Driver::WaitUntilIdle();
	EXPECT_GE(counter.Flushes(), 3);
}


INSTANTIATE_TEST_SUITE_P(Drawing, UpdateOrder, testing::Bool(),
	[](const auto& info) { return info.param ? "Directly" : "InUpdates"; });
