#include <Invoker.h>

#include <gtest/gtest.h>

#include <AppDefs.h>

#include "tests/kits/app/RecordingLooper.h"

namespace {

// Makes the protected helpers public.
class OpenInvoker : public BInvoker {
public:
	using BInvoker::BeginInvokeNotify;
	using BInvoker::BInvoker;
	using BInvoker::EndInvokeNotify;
	using BInvoker::InvokeKind;

	status_t Invoke(BMessage* message) override
	{
		kind = InvokeKind(&notify);
		return BInvoker::Invoke(message);
	}

	uint32 kind = 0;
	bool notify = false;
};

} // namespace


TEST(Invoker, StartsWithoutMessageAndTarget)
{
	BInvoker invoker;

	EXPECT_EQ(nullptr, invoker.Message());
	EXPECT_EQ(0u, invoker.Command());
	EXPECT_FALSE(invoker.Messenger().IsValid());
	EXPECT_EQ(nullptr, invoker.Target());
	EXPECT_FALSE(invoker.IsTargetLocal());
	EXPECT_EQ(B_INFINITE_TIMEOUT, invoker.Timeout());
	EXPECT_EQ(nullptr, invoker.HandlerForReply());
	EXPECT_EQ(B_BAD_VALUE, invoker.Invoke());
}


TEST(Invoker, OwnsItsMessage)
{
	static int sDeleted;
	sDeleted = 0;
	class Message : public BMessage {
	public:
		Message() : BMessage('mess') {}
		~Message() override { sDeleted++; }
	};
	{
		auto* message = new Message;
		BInvoker invoker(message, BMessenger());
		EXPECT_EQ(message, invoker.Message());
		EXPECT_EQ(uint32('mess'), invoker.Command());

		invoker.SetMessage(message);
		EXPECT_EQ(0, sDeleted);
		invoker.SetMessage(new Message);
		EXPECT_EQ(1, sDeleted);
		invoker.SetMessage(NULL);
		EXPECT_EQ(2, sDeleted);
		EXPECT_EQ(nullptr, invoker.Message());
		invoker.SetMessage(new Message);
	}
	EXPECT_EQ(3, sDeleted);
}


TEST(Invoker, ATargetMustBeInALooper)
{
	auto* looper = new BLooper;
	BHandler handler;
	BInvoker invoker(new BMessage('mess'), looper);
	EXPECT_TRUE(invoker.Messenger().IsValid());

	EXPECT_EQ(B_MISMATCHED_VALUES, invoker.SetTarget(&handler));
	EXPECT_FALSE(invoker.Messenger().IsValid());
	EXPECT_NE(B_OK, invoker.Invoke());

	looper->AddHandler(&handler);
	EXPECT_EQ(B_OK, invoker.SetTarget(&handler));
	BLooper* found = NULL;
	EXPECT_EQ(&handler, invoker.Target(&found));
	EXPECT_EQ(looper, found);
	EXPECT_TRUE(invoker.IsTargetLocal());

	EXPECT_EQ(B_OK, invoker.SetTarget(BMessenger(looper)));
	EXPECT_TRUE(BMessenger(looper) == invoker.Messenger());
	looper->Quit();
}


TEST(Invoker, SendsACopyOfItsOwnOrTheGivenMessage)
{
	Running<RecordingLooper> looper("l");
	BInvoker invoker(new BMessage('own '), looper.Get());
	BMessage given('give');

	EXPECT_EQ(B_OK, invoker.Invoke());
	EXPECT_EQ(B_OK, invoker.Invoke(&given));
	looper->Sync();

	EXPECT_EQ((Log { "l:own ", "l:give" }), looper->log);
	EXPECT_TRUE(invoker.Message()->IsEmpty());
	EXPECT_EQ(uint32('own '), invoker.Command());
}


TEST(Invoker, AnswersGoToTheHandlerForReplies)
{
	class Answering : public RecordingLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			if (message->what == 'mess')
				message->SendReply('answ');
			else
				RecordingLooper::MessageReceived(message);
		}
	};
	Running<Answering> answering;
	Running<RecordingLooper> receiver("receiver");
	BInvoker invoker(new BMessage('mess'), answering.Get());
	EXPECT_EQ(B_OK, invoker.SetHandlerForReply(receiver.Get()));
	EXPECT_EQ(receiver.Get(), invoker.HandlerForReply());

	invoker.Invoke();
	answering->Sync();
	receiver->Sync();

	EXPECT_EQ((Log { "receiver:answ" }), receiver->log);
}


TEST(Invoker, KnowsItsKindDuringANotification)
{
	Running<RecordingLooper> looper("l");
	OpenInvoker invoker(new BMessage('mess'), looper.Get());

	invoker.Invoke(NULL);
	EXPECT_EQ(uint32(B_CONTROL_INVOKED), invoker.kind);
	EXPECT_FALSE(invoker.notify);

	BMessage changed('chng');
	EXPECT_EQ(B_OK, invoker.InvokeNotify(&changed, B_CONTROL_MODIFIED));
	EXPECT_EQ(uint32(B_CONTROL_MODIFIED), invoker.kind);
	EXPECT_TRUE(invoker.notify);
	EXPECT_EQ(uint32(B_CONTROL_INVOKED), invoker.InvokeKind());

	invoker.BeginInvokeNotify(B_CONTROL_MODIFIED);
	EXPECT_EQ(uint32(B_CONTROL_MODIFIED), invoker.InvokeKind());
	invoker.EndInvokeNotify();
	EXPECT_EQ(uint32(B_CONTROL_INVOKED), invoker.InvokeKind());
	looper->Sync();
	EXPECT_EQ((Log { "l:mess", "l:chng" }), looper->log);
}


TEST(Invoker, WaitsNoLongerThanItsTimeout)
{
	auto* looper = new RecordingLooper("l", 1);
	looper->PostMessage('full');
	looper->Unlock();
	BInvoker invoker(new BMessage('mess'), looper);

	EXPECT_EQ(B_OK, invoker.SetTimeout(0));
	EXPECT_EQ(0, invoker.Timeout());
	EXPECT_EQ(B_WOULD_BLOCK, invoker.Invoke());

	looper->Lock();
	looper->Quit();
}
