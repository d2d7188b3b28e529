#include <MessageRunner.h>

#include <condition_variable>
#include <gtest/gtest.h>
#include <mutex>

#include <AppDefs.h>
#include <Looper.h>
#include <Message.h>

#include "tests/kits/app/RecordingLooper.h"

namespace {

// Lets the test wait for a number of messages.
class CountingLooper : public BLooper {
public:
	void MessageReceived(BMessage* message) override
	{
		std::lock_guard lock(fLock);
		if (message->what == 'tick' && message->FindInt32("value") == 7)
			fCount++;
		fChanged.notify_all();
	}

	void WaitFor(int count)
	{
		std::unique_lock lock(fLock);
		fChanged.wait(lock, [&] { return fCount >= count; });
	}

	int Count()
	{
		std::lock_guard lock(fLock);
		return fCount;
	}

private:
	std::mutex fLock;
	std::condition_variable fChanged;
	int fCount = 0;
};

BMessage
Tick()
{
	BMessage message('tick');
	message.AddInt32("value", 7);
	return message;
}

} // namespace


TEST(MessageRunner, SendsItsMessageAtItsInterval)
{
	Running<CountingLooper> looper;
	const BMessage tick = Tick();
	const bigtime_t start = system_time();
	BMessageRunner runner(BMessenger(looper.Get()), &tick, 2000);
	ASSERT_EQ(B_OK, runner.InitCheck());

	looper->WaitFor(5);

	EXPECT_GE(system_time() - start, 10000);
	bigtime_t interval = 0;
	int32 count = 0;
	EXPECT_EQ(B_OK, runner.GetInfo(&interval, &count));
	EXPECT_EQ(2000, interval);
	EXPECT_EQ(-1, count);
}


TEST(MessageRunner, EndsWithItsCount)
{
	Running<CountingLooper> looper;
	const BMessage tick = Tick();
	BMessageRunner counted(BMessenger(looper.Get()), &tick, 1000, 3);
	looper->WaitFor(3);
	while (counted.GetInfo(NULL, NULL) == B_OK)
		;

	// A second runner shows that time goes on without another beat of the first.
	BMessageRunner other(BMessenger(looper.Get()), &tick, 1000, 5);
	looper->WaitFor(8);
	EXPECT_EQ(8, looper->Count());
	EXPECT_EQ(B_BAD_VALUE, counted.SetInterval(1000));
}


TEST(MessageRunner, IsSilentAfterItsEnd)
{
	Running<CountingLooper> looper;
	const BMessage tick = Tick();
	{
		BMessageRunner runner(BMessenger(looper.Get()), &tick, 1000);
		looper->WaitFor(1);
	}
	BMessage reply;
	BMessenger(looper.Get()).SendMessage('sync', &reply);
	const int count = looper->Count();

	const BMessage other('othr');
	BMessageRunner witness(BMessenger(looper.Get()), &other, 1000, 5);
	while (witness.GetInfo(NULL, NULL) == B_OK)
		;
	BMessenger(looper.Get()).SendMessage('sync', &reply);

	EXPECT_EQ(count, looper->Count());
}


TEST(MessageRunner, RefusesWhatMakesNoSense)
{
	Running<CountingLooper> looper;
	const BMessage tick = Tick();
	const BMessenger target(looper.Get());

	EXPECT_EQ(B_BAD_VALUE, BMessageRunner(BMessenger(), &tick, 1000).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BMessageRunner(target, NULL, 1000).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BMessageRunner(target, &tick, 0).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BMessageRunner(target, &tick, 1000, 0).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BMessageRunner::StartSending(target, &tick, -1, 1));
}


TEST(MessageRunner, StartSendingGoesOnByItself)
{
	Running<CountingLooper> looper;
	const BMessage tick = Tick();

	ASSERT_EQ(B_OK, BMessageRunner::StartSending(BMessenger(looper.Get()), &tick, 1000, 2));

	looper->WaitFor(2);
}


TEST(MessageRunner, EndsWhenItsTargetIsGone)
{
	auto* looper = new CountingLooper;
	looper->Run();
	const BMessage tick = Tick();
	BMessageRunner runner(BMessenger(looper), &tick, 1000);
	looper->WaitFor(1);
	looper->Lock();
	looper->Quit();

	while (runner.GetInfo(NULL, NULL) == B_OK)
		;
}
