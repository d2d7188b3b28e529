// The part of BMessage that deals with its delivery.
#include <Message.h>

#include <functional>
#include <gtest/gtest.h>

#include <AppDefs.h>
#include <MessageFilter.h>

#include "tests/kits/app/RecordingLooper.h"

namespace {

// Runs a function of the test in its thread, for each message but 'sync'.
class ScriptedLooper : public RecordingLooper {
public:
	explicit ScriptedLooper(std::function<void(BMessage*)> script) : fScript(std::move(script)) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == 'sync')
			RecordingLooper::MessageReceived(message);
		else
			fScript(message);
	}

private:
	std::function<void(BMessage*)> fScript;
};

} // namespace


TEST(MessageDelivery, ALocalMessageWasNotDeliveredAndTakesNoAnswer)
{
	BMessage message('mess');

	EXPECT_FALSE(message.WasDelivered());
	EXPECT_FALSE(message.IsSourceWaiting());
	EXPECT_FALSE(message.IsSourceRemote());
	EXPECT_FALSE(message.IsReply());
	EXPECT_FALSE(message.WasDropped());
	EXPECT_EQ(nullptr, message.Previous());
	EXPECT_FALSE(message.ReturnAddress().IsValid());
	EXPECT_EQ(B_BAD_REPLY, message.SendReply('answ'));
	EXPECT_EQ(uint32('mess'), message.what);
}


TEST(MessageDelivery, ADeliveredMessageKnowsItsSender)
{
	Running<RecordingLooper> sender("sender");
	bool delivered = false;
	BMessenger address;
	Running<ScriptedLooper> receiver([&](BMessage* message) {
		delivered = message->WasDelivered() && !message->IsSourceWaiting()
			&& !message->IsSourceRemote() && !message->IsReply();
		address = message->ReturnAddress();
	});

	receiver->PostMessage('mess', receiver.Get(), sender.Get());
	receiver->Sync();

	EXPECT_TRUE(delivered);
	EXPECT_TRUE(BMessenger(sender.Get()) == address);
}


TEST(MessageDelivery, AnAnswerCarriesTheOriginal)
{
	BMessage answer;
	bool isReply = false;
	int32 value = 0;
	const BMessage* first = nullptr;
	const BMessage* second = nullptr;
	Running<ScriptedLooper> sender([&](BMessage* message) {
		answer = *message;
		isReply = message->IsReply();
		first = message->Previous();
		second = message->Previous();
		if (first != nullptr)
			value = first->what == 'mess' ? first->FindInt32("value") : -1;
	});
	Running<ScriptedLooper> receiver([&](BMessage* message) {
		BMessage reply('answ');
		reply.AddBool("own", true);
		EXPECT_EQ(B_OK, message->SendReply(&reply));
		// A sender who went on may get several answers.
		EXPECT_EQ(B_OK, message->SendReply(&reply));
	});
	BMessage message('mess');
	message.AddInt32("value", 5);

	BMessenger(receiver.Get()).SendMessage(&message, sender.Get());
	receiver->Sync();
	sender->Sync();

	EXPECT_TRUE(isReply);
	EXPECT_EQ(5, value);
	EXPECT_NE(nullptr, first);
	EXPECT_EQ(first, second);
	EXPECT_EQ(uint32('answ'), answer.what);
	EXPECT_TRUE(answer.FindBool("own"));
	EXPECT_TRUE(answer.HasMessage("_previous_"));
}


TEST(MessageDelivery, AnswersGoBackAndForth)
{
	std::vector<std::string> log;
	Running<ScriptedLooper> asker([&](BMessage* message) {
		log.push_back(Note("asker", message->what));
		message->SendReply('thrd');
	});
	Running<ScriptedLooper> other([&](BMessage* message) {
		log.push_back(Note("other", message->what));
		EXPECT_EQ(message->what == 'thrd', message->IsReply());
		if (message->what == 'frst') {
			BMessage reply('scnd');
			message->SendReply(&reply, static_cast<BHandler*>(other.Get()));
		}
	});

	BMessenger(other.Get()).SendMessage('frst', asker.Get());
	other->Sync();
	asker->Sync();
	other->Sync();

	EXPECT_EQ((std::vector<std::string> { "other:frst", "asker:scnd", "other:thrd" }), log);
}


TEST(MessageDelivery, AnAnswerToOneWhoWaitsCanBeWaitedForToo)
{
	BMessage answerToAnswer;
	status_t status = B_ERROR;
	Running<ScriptedLooper> receiver([&](BMessage* message) {
		BMessage reply('answ');
		status = message->SendReply(&reply, &answerToAnswer);
	});
	BMessage reply;
	ASSERT_EQ(B_OK, BMessenger(receiver.Get()).SendMessage('mess', &reply));
	ASSERT_EQ(uint32('answ'), reply.what);
	EXPECT_TRUE(reply.IsSourceWaiting());

	EXPECT_EQ(B_OK, reply.SendReply('more'));
	receiver->Sync();

	EXPECT_EQ(B_OK, status);
	EXPECT_EQ(uint32('more'), answerToAnswer.what);
}


TEST(MessageDelivery, ACopyOfAMessageDoesNotAnswerItsSender)
{
	Running<ScriptedLooper> receiver([&](BMessage* message) {
		{
			const BMessage copy(*message);
			EXPECT_FALSE(copy.IsSourceWaiting());
			EXPECT_FALSE(copy.WasDelivered());
		}
		message->SendReply('answ');
	});
	BMessage reply;

	ASSERT_EQ(B_OK, BMessenger(receiver.Get()).SendMessage('mess', &reply));

	EXPECT_EQ(uint32('answ'), reply.what);
}


TEST(MessageDelivery, PointersTravelAsNumbers)
{
	int object = 0;
	void* found = nullptr;
	Running<ScriptedLooper> receiver(
		[&](BMessage* message) { message->FindPointer("pointer", &found); });
	BMessage message('mess');
	message.AddPointer("pointer", &object);

	receiver->PostMessage(&message);
	receiver->Sync();

	EXPECT_EQ(&object, found);
}


TEST(MessageDelivery, DropFieldsAreReadAsTheyAre)
{
	BMessage message('DATA');
	message.AddPoint("_drop_point_", BPoint(10, 20));
	message.AddPoint("_drop_offset_", BPoint(3, 4));

	BPoint offset;
	EXPECT_EQ(BPoint(10, 20), message.DropPoint(&offset));
	EXPECT_EQ(BPoint(3, 4), offset);
}
