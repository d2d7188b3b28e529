// When loopers count as idle, which the driver and play scripts wait for.
#include <atomic>
#include <gtest/gtest.h>

#include <Looper.h>
#include <Message.h>
#include <MessageQueue.h>

#include "app/private/LooperPrivate.h"
#include "kernel/private/Activity.h"
#include "tests/kits/app/RecordingLooper.h"

using BPrivate::wait_until_idle;

namespace {

// Waits inside a message, as for its user, until it is told to go on.
class ModalLooper : public RecordingLooper {
public:
	void MessageReceived(BMessage* message) override
	{
		if (message->what != 'ask ') {
			RecordingLooper::MessageReceived(message);
			return;
		}
		{
			const BPrivate::WaitingScope waiting(&BPrivate::LooperPrivate(this).Activity());
			acquire_sem(answered);
		}
		message->SendReply('answ');
	}

	const sem_id answered = create_sem(0, "answered");
};


// Asks another looper and waits for the answer.
class AskingLooper : public RecordingLooper {
public:
	explicit AskingLooper(const BMessenger& target) : fTarget(target) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == 'go  ') {
			BMessage reply;
			fTarget.SendMessage('ask ', &reply);
			result = reply.what;
		} else
			RecordingLooper::MessageReceived(message);
	}

	std::atomic<uint32> result { 0 };

private:
	const BMessenger fTarget;
};

} // namespace


TEST(Idle, ComesWhenEveryMessageWasHandled)
{
	Running<RecordingLooper> looper("l");
	for (int i = 0; i < 50; i++)
		looper->PostMessage('mess');

	EXPECT_TRUE(wait_until_idle());

	looper->Lock();
	EXPECT_EQ(50u, looper->log.size());
	looper->Unlock();
}


TEST(Idle, DoesNotComeWhileAMessageIsInWork)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	looper->PostMessage('mess');

	EXPECT_FALSE(wait_until_idle(1000));

	looper->Unlock();
	EXPECT_TRUE(wait_until_idle());
}


TEST(Idle, LeavesOutLoopersThatDoNotRun)
{
	auto* looper = new RecordingLooper("l");
	looper->PostMessage('mess');

	EXPECT_TRUE(wait_until_idle());

	looper->Run();
	EXPECT_TRUE(wait_until_idle());
	looper->Lock();
	EXPECT_EQ(1u, looper->log.size());
	looper->PostMessage('mess');
	looper->Quit();
	EXPECT_TRUE(wait_until_idle());
}


TEST(Idle, ComesWhileOneWaitsForAnotherThatWaitsForItsUser)
{
	Running<ModalLooper> modal;
	Running<AskingLooper> asking { BMessenger(modal.Get()) };

	for (int i = 0; i < 100; i++) {
		asking->result = 0;
		asking->PostMessage('go  ');
		ASSERT_TRUE(wait_until_idle());
		ASSERT_EQ(0u, asking->result);

		// Between the answer and the work that follows from it the program is not idle. The
		// answer's own thread is a looper's, as a user's would be the display's.
		BPrivate::LooperPrivate(modal.Get()).Activity().AddWork();
		release_sem(modal->answered);
		while (BPrivate::LooperPrivate(modal.Get()).Activity().IsIdle())
			;
		BPrivate::LooperPrivate(modal.Get()).Activity().WorkDone();
		ASSERT_TRUE(wait_until_idle());
		ASSERT_EQ(uint32('answ'), asking->result);
	}
	delete_sem(modal->answered);
}


TEST(Idle, CountsMessagesThatAreTakenOutOfTheQueue)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	looper->PostMessage('aaaa');
	looper->PostMessage('bbbb');
	delete looper->MessageQueue()->NextMessage();
	BMessage* second = looper->MessageQueue()->FindMessage(uint32('bbbb'));
	looper->MessageQueue()->RemoveMessage(second);
	delete second;

	EXPECT_TRUE(wait_until_idle());

	looper->Unlock();
}


// #pragma mark - what windows do with their queue


TEST(LooperQueue, AnUpdateOvertakesEverythingAndWaitsOnce)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	BPrivate::LooperPrivate access(looper.Get());
	looper->PostMessage('mess');
	access.RequestUpdate();
	access.RequestUpdate();
	EXPECT_EQ(2, looper->MessageQueue()->CountMessages());
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "l:_UPD", "l:mess" }), looper->log);
}


TEST(LooperQueue, AnUpdateCanBeTakenBackAndAskedForAgain)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	BPrivate::LooperPrivate access(looper.Get());
	EXPECT_FALSE(access.CancelUpdate());
	access.RequestUpdate();
	EXPECT_TRUE(access.CancelUpdate());
	EXPECT_TRUE(looper->MessageQueue()->IsEmpty());
	access.RequestUpdate();
	looper->Unlock();
	looper->Sync();

	looper->Lock();
	access.RequestUpdate();
	looper->Unlock();
	looper->Sync();

	EXPECT_EQ((Log { "l:_UPD", "l:_UPD" }), looper->log);
}


TEST(LooperQueue, SystemMessagesKnowNoFullPort)
{
	auto* looper = new RecordingLooper("l", 2);
	BPrivate::LooperPrivate access(looper);
	for (int i = 0; i < 10; i++)
		access.PostSystem(new BMessage('_MMV'));
	access.PostAhead(new BMessage('frst'));
	looper->Run();
	looper->Sync();

	looper->Lock();
	ASSERT_EQ(11u, looper->log.size());
	EXPECT_EQ("l:frst", looper->log[0]);
	looper->Quit();
}


TEST(LooperQueue, GivesOutTheFirstMessageThatIsWanted)
{
	auto* looper = new RecordingLooper("l");
	BPrivate::LooperPrivate access(looper);
	BMessage moved('_MMV');
	for (int32 i = 0; i < 2; i++) {
		moved.SetInt32("index", i);
		looper->PostMessage('mess');
		looper->PostMessage(&moved);
	}

	const auto isMove = [](const BMessage& message) { return message.what == '_MMV'; };
	std::unique_ptr<BMessage> first(access.TakeMessage(isMove));
	std::unique_ptr<BMessage> second(access.TakeMessage(isMove));

	ASSERT_NE(nullptr, first);
	ASSERT_NE(nullptr, second);
	EXPECT_EQ(0, first->FindInt32("index"));
	EXPECT_EQ(1, second->FindInt32("index"));
	EXPECT_EQ(nullptr, access.TakeMessage(isMove));
	EXPECT_EQ(2, looper->MessageQueue()->CountMessages());
	looper->Quit();
}
