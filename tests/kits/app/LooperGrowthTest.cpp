// Loopers with many handlers, filters and messages: a step that looked through all of them would
// take minutes at these sizes.
#include <Looper.h>

#include <atomic>
#include <memory>
#include <vector>

#include <Application.h>
#include <Handler.h>
#include <Message.h>
#include <MessageFilter.h>
#include <MessageQueue.h>
#include <OS.h>
#include <gtest/gtest.h>

namespace {

constexpr int32 kCount = 100000;
constexpr uint32 kCounted = 'cntd', kOther = 'othr', kLast = 'last';


class CountingHandler : public BHandler {
public:
	void MessageReceived(BMessage*) override { received++; }
	int32 received = 0;
};


class CountingLooper : public BLooper {
public:
	CountingLooper() : BLooper("counting", B_NORMAL_PRIORITY, kCount + 10) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == kLast)
			release_sem(done);
		else
			received++;
	}

	sem_id done = create_sem(0, "done");
	int32 received = 0;
};


class CountingFilter : public BMessageFilter {
public:
	CountingFilter(uint32 what, std::atomic<int32>& calls) : BMessageFilter(what), fCalls(calls) {}
	filter_result Filter(BMessage*, BHandler**) override
	{
		fCalls++;
		return B_DISPATCH_MESSAGE;
	}

private:
	std::atomic<int32>& fCalls;
};

} // namespace


TEST(LooperGrowth, ManyHandlersGetTheirMessages)
{
	BApplication app("application/x-vnd.Archway-test");
	CountingLooper* looper = new CountingLooper;
	std::vector<CountingHandler> handlers(kCount);
	for (CountingHandler& handler : handlers)
		looper->AddHandler(&handler);
	EXPECT_EQ(kCount + 1, looper->CountHandlers());
	for (int32 i = 0; i < kCount; i++) {
		ASSERT_EQ(&handlers[size_t(i)], looper->HandlerAt(i + 1));
		ASSERT_EQ(i + 1, looper->IndexOf(&handlers[size_t(i)]));
	}
	for (CountingHandler& handler : handlers)
		ASSERT_EQ(B_OK, looper->PostMessage(kCounted, &handler));
	ASSERT_EQ(B_OK, looper->PostMessage(kLast));
	looper->Run();
	ASSERT_EQ(B_OK, acquire_sem(looper->done));

	looper->Lock();
	for (CountingHandler& handler : handlers) {
		ASSERT_EQ(1, handler.received);
		ASSERT_TRUE(looper->RemoveHandler(&handler));
	}
	EXPECT_EQ(1, looper->CountHandlers());
	delete_sem(looper->done);
	looper->Quit();
}


TEST(LooperGrowth, AFullQueueIsFilledAndEmptied)
{
	BApplication app("application/x-vnd.Archway-test");
	CountingLooper* looper = new CountingLooper;
	std::atomic<int32> matching = 0, others = 0;
	looper->AddCommonFilter(new CountingFilter(kCounted, matching));
	for (int i = 0; i < 20; i++)
		looper->AddCommonFilter(new CountingFilter(kOther, others));
	for (int32 i = 0; i < kCount; i++)
		ASSERT_EQ(B_OK, looper->PostMessage(kCounted));
	ASSERT_EQ(B_OK, looper->PostMessage(kLast));
	looper->Run();
	ASSERT_EQ(B_OK, acquire_sem(looper->done));

	looper->Lock();
	EXPECT_EQ(kCount, looper->received);
	EXPECT_EQ(kCount, matching) << "each filter is called once for each message of its code";
	EXPECT_EQ(0, others);
	delete_sem(looper->done);
	looper->Quit();
}


TEST(LooperGrowth, AQueueIsTakenFromBothEnds)
{
	BMessageQueue queue;
	for (int32 i = 0; i < kCount; i++)
		queue.AddMessage(new BMessage(static_cast<uint32>(i)));
	EXPECT_EQ(kCount, queue.CountMessages());
	for (int32 i = 0; i < kCount; i++) {
		const std::unique_ptr<BMessage> message(queue.NextMessage());
		ASSERT_EQ(static_cast<uint32>(i), message->what);
	}
	EXPECT_TRUE(queue.IsEmpty());
}
