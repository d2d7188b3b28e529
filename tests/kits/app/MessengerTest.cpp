#include <Messenger.h>

#include <atomic>
#include <gtest/gtest.h>
#include <thread>
#include <unistd.h>

#include <AppDefs.h>

#include "tests/kits/app/RecordingLooper.h"


TEST(Messenger, IsInvalidAtFirst)
{
	BMessenger messenger;

	EXPECT_FALSE(messenger.IsValid());
	EXPECT_FALSE(messenger.IsTargetLocal());
	BLooper* looper = reinterpret_cast<BLooper*>(&messenger);
	EXPECT_EQ(nullptr, messenger.Target(&looper));
	EXPECT_EQ(nullptr, looper);
	EXPECT_FALSE(messenger.LockTarget());
	EXPECT_EQ(B_BAD_VALUE, messenger.LockTargetWithTimeout(0));
	EXPECT_EQ(B_BAD_PORT_ID, messenger.SendMessage('what'));
}


TEST(Messenger, TellsWhyATargetIsNoGood)
{
	auto* looper = new BLooper;
	auto* other = new BLooper;
	BHandler handler;
	BHandler stranger;
	looper->AddHandler(&handler);
	status_t status = B_ERROR;

	EXPECT_TRUE(BMessenger(&handler, NULL, &status).IsValid());
	EXPECT_EQ(B_OK, status);
	EXPECT_TRUE(BMessenger(&handler, looper, &status).IsValid());
	EXPECT_EQ(B_OK, status);
	EXPECT_TRUE(BMessenger((BHandler*)NULL, looper, &status).IsValid());
	EXPECT_EQ(B_OK, status);
	EXPECT_FALSE(BMessenger(&handler, other, &status).IsValid());
	EXPECT_EQ(B_MISMATCHED_VALUES, status);
	EXPECT_FALSE(BMessenger(&stranger, NULL, &status).IsValid());
	EXPECT_EQ(B_MISMATCHED_VALUES, status);
	EXPECT_FALSE(BMessenger((BHandler*)NULL, NULL, &status).IsValid());
	EXPECT_EQ(B_BAD_VALUE, status);
	looper->Quit();
	other->Quit();
}


TEST(Messenger, KnowsItsTarget)
{
	auto* looper = new BLooper;
	BHandler handler;
	looper->AddHandler(&handler);
	BLooper* found = NULL;

	const BMessenger toHandler(&handler);
	EXPECT_EQ(&handler, toHandler.Target(&found));
	EXPECT_EQ(looper, found);
	EXPECT_TRUE(toHandler.IsTargetLocal());
	EXPECT_EQ(getpid(), toHandler.Team());

	found = NULL;
	const BMessenger toPreferred((BHandler*)NULL, looper);
	EXPECT_EQ(nullptr, toPreferred.Target(&found));
	EXPECT_EQ(looper, found);

	looper->Quit();
	EXPECT_EQ(nullptr, toHandler.Target(&found));
	EXPECT_EQ(nullptr, found);
}


TEST(Messenger, IsValidAsLongAsTheLooperLives)
{
	auto* looper = new BLooper;
	auto* handler = new BHandler;
	looper->AddHandler(handler);
	const BMessenger messenger(handler);

	delete handler;
	EXPECT_TRUE(messenger.IsValid());
	BLooper* found = NULL;
	EXPECT_EQ(nullptr, messenger.Target(&found));

	looper->Quit();
	EXPECT_FALSE(messenger.IsValid());
	EXPECT_EQ(B_BAD_PORT_ID, messenger.SendMessage('what'));
}


TEST(Messenger, EqualsAnotherOneToTheSameHandler)
{
	auto* looper = new BLooper;
	BHandler first;
	BHandler second;
	looper->AddHandler(&first);
	looper->AddHandler(&second);

	EXPECT_TRUE(BMessenger(&first) == BMessenger(&first, looper));
	EXPECT_TRUE(BMessenger(&first) != BMessenger(&second));
	EXPECT_TRUE(BMessenger(looper) != BMessenger((BHandler*)NULL, looper));
	EXPECT_TRUE(BMessenger() == BMessenger());
	EXPECT_NE(BMessenger(&first) < BMessenger(&second), BMessenger(&second) < BMessenger(&first));
	looper->Quit();
}


TEST(Messenger, LocksTheTargetsLooper)
{
	Running<RecordingLooper> looper;
	const BMessenger messenger(looper.Get());

	ASSERT_TRUE(messenger.LockTarget());
	EXPECT_TRUE(looper->IsLocked());
	std::thread([&] { EXPECT_EQ(B_TIMED_OUT, messenger.LockTargetWithTimeout(1000)); }).join();
	looper->Unlock();
}


TEST(Messenger, SendsToThePreferredHandler)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	RecordingHandler preferred("preferred", &looper->log);
	looper->AddHandler(&preferred);
	looper->SetPreferredHandler(&preferred);
	looper->Unlock();

	EXPECT_EQ(B_OK, BMessenger((BHandler*)NULL, looper.Get()).SendMessage('aaaa'));
	EXPECT_EQ(B_OK, BMessenger(looper.Get()).SendMessage('bbbb'));
	looper->Sync();

	EXPECT_EQ((Log { "preferred:aaaa", "l:bbbb" }), looper->log);
	looper->Lock();
	looper->RemoveHandler(&preferred);
	looper->Unlock();
}


TEST(Messenger, WaitsForRoomAsLongAsItIsTold)
{
	auto* looper = new RecordingLooper("l", 1);
	ASSERT_EQ(B_OK, looper->PostMessage('full'));
	const BMessenger messenger(looper);
	BMessage message('what');

	// The one who holds the lock keeps the looper from making room, so another thread asks.
	std::thread([&] {
		EXPECT_EQ(B_WOULD_BLOCK, messenger.SendMessage(&message, (BHandler*)NULL, 0));
		EXPECT_EQ(B_TIMED_OUT, messenger.SendMessage(&message, (BHandler*)NULL, 1000));
	}).join();

	std::thread waiting([&] { EXPECT_EQ(B_OK, messenger.SendMessage(&message, (BHandler*)NULL)); });
	looper->Run();
	waiting.join();
	looper->Sync();
	EXPECT_EQ((Log { "l:full", "l:what" }), looper->log);
	looper->Lock();
	looper->Quit();
}


TEST(Messenger, NeverWaitsForTheLooperThatItsCallerHolds)
{
	auto* looper = new RecordingLooper("l", 1);
	const BMessenger messenger(looper);

	for (int i = 0; i < 10; i++)
		EXPECT_EQ(B_OK, messenger.SendMessage('what'));

	looper->Run();
	looper->Sync();
	EXPECT_EQ(10u, looper->log.size());
	looper->Lock();
	looper->Quit();
}


// #pragma mark - synchronous


TEST(Messenger, WaitsForTheAnswer)
{
	class Answering : public BLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			EXPECT_TRUE(message->IsSourceWaiting());
			BMessage answer('answ');
			answer.AddInt32("twice", message->FindInt32("value") * 2);
			EXPECT_EQ(B_OK, message->SendReply(&answer));
			EXPECT_FALSE(message->IsSourceWaiting());
			EXPECT_EQ(B_DUPLICATE_REPLY, message->SendReply(&answer));
		}
	};
	Running<Answering> looper;
	BMessage message('ques');
	message.AddInt32("value", 21);
	BMessage reply;

	ASSERT_EQ(B_OK, BMessenger(looper.Get()).SendMessage(&message, &reply));

	EXPECT_EQ(uint32('answ'), reply.what);
	EXPECT_EQ(42, reply.FindInt32("twice"));
	EXPECT_FALSE(reply.IsReply());
	EXPECT_TRUE(reply.WasDelivered());
}


TEST(Messenger, GetsNoReplyWhenTheMessageIsDeletedUnanswered)
{
	Running<RecordingLooper> looper;
	BMessage reply;

	ASSERT_EQ(B_OK, BMessenger(looper.Get()).SendMessage('what', &reply));

	EXPECT_EQ(uint32(B_NO_REPLY), reply.what);
}


TEST(Messenger, GetsNoReplyWhenTheTargetsHandlerIsGone)
{
	Running<RecordingLooper> looper;
	looper->Lock();
	auto* handler = new BHandler;
	looper->AddHandler(handler);
	const BMessenger messenger(handler);
	delete handler;
	looper->Unlock();
	BMessage reply;

	ASSERT_EQ(B_OK, messenger.SendMessage('what', &reply));

	EXPECT_EQ(uint32(B_NO_REPLY), reply.what);
}


TEST(Messenger, GivesUpWaitingForAnAnswer)
{
	auto* looper = new RecordingLooper("l");
	looper->Unlock();
	BMessage message('what');
	BMessage reply;

	EXPECT_EQ(
		B_TIMED_OUT, BMessenger(looper).SendMessage(&message, &reply, B_INFINITE_TIMEOUT, 1000));

	looper->Lock();
	looper->Quit();
}


TEST(Messenger, ALooperCannotWaitForItself)
{
	class Asker : public RecordingLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			if (message->what == 'ask ') {
				BMessage reply;
				result = BMessenger(this).SendMessage('self', &reply);
			} else
				RecordingLooper::MessageReceived(message);
		}
		status_t result = B_OK;
	};
	Running<Asker> looper;

	looper->PostMessage('ask ');
	looper->Sync();

	looper->Lock();
	EXPECT_EQ(B_MESSAGE_TO_SELF, looper->result);
	looper->Unlock();
}


TEST(Messenger, NeedsAMessageAndAPlaceForTheAnswer)
{
	Running<RecordingLooper> looper;
	const BMessenger messenger(looper.Get());
	BMessage message;

	EXPECT_EQ(B_BAD_VALUE, messenger.SendMessage((BMessage*)NULL));
	EXPECT_EQ(B_BAD_VALUE, messenger.SendMessage(&message, (BMessage*)NULL));
}


TEST(Messenger, TravelsInAMessage)
{
	auto* looper = new BLooper;
	BMessage message;
	ASSERT_EQ(B_OK, message.AddMessenger("target", BMessenger(looper)));

	BMessenger found;
	ASSERT_EQ(B_OK, message.FindMessenger("target", &found));

	EXPECT_TRUE(found == BMessenger(looper));
	type_code type = 0;
	message.GetInfo("target", &type);
	EXPECT_EQ(uint32('MSNG'), type);
	looper->Quit();
}


TEST(Messenger, SendsFromManyThreadsLoseNothing)
{
	class Counter : public RecordingLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			if (message->what == 'mess')
				count++;
			else
				RecordingLooper::MessageReceived(message);
		}
		int count = 0;
	};
	Running<Counter> looper;
	const BMessenger messenger(looper.Get());
	std::vector<std::thread> threads;
	for (int i = 0; i < 4; i++) {
		threads.emplace_back([&] {
			for (int n = 0; n < 500; n++)
				messenger.SendMessage('mess');
		});
	}
	for (std::thread& thread : threads)
		thread.join();
	looper->Sync();

	looper->Lock();
	EXPECT_EQ(2000, looper->count);
	looper->Unlock();
}
