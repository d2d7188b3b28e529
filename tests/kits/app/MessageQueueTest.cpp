#include <MessageQueue.h>

#include <gtest/gtest.h>
#include <memory>
#include <thread>

#include <Message.h>


TEST(MessageQueue, GivesMessagesInTheOrderOfTheirArrival)
{
	BMessageQueue queue;
	EXPECT_TRUE(queue.IsEmpty());
	EXPECT_EQ(nullptr, queue.NextMessage());

	auto* first = new BMessage('aaaa');
	auto* second = new BMessage('bbbb');
	queue.AddMessage(first);
	queue.AddMessage(second);
	EXPECT_EQ(2, queue.CountMessages());
	EXPECT_FALSE(queue.IsEmpty());

	EXPECT_EQ(first, queue.NextMessage());
	EXPECT_EQ(second, queue.NextMessage());
	EXPECT_EQ(nullptr, queue.NextMessage());
	delete first;
	delete second;
}


TEST(MessageQueue, FindsMessagesByPlaceAndCode)
{
	BMessageQueue queue;
	BMessage* messages[3];
	const uint32 codes[] = { 'aaaa', 'bbbb', 'aaaa' };
	for (int i = 0; i < 3; i++)
		queue.AddMessage(messages[i] = new BMessage(codes[i]));

	EXPECT_EQ(messages[1], queue.FindMessage(int32(1)));
	EXPECT_EQ(nullptr, queue.FindMessage(int32(3)));
	EXPECT_EQ(nullptr, queue.FindMessage(int32(-1)));
	EXPECT_EQ(messages[0], queue.FindMessage(uint32('aaaa')));
	EXPECT_EQ(messages[2], queue.FindMessage(uint32('aaaa'), 1));
	EXPECT_EQ(nullptr, queue.FindMessage(uint32('aaaa'), 2));
	EXPECT_EQ(nullptr, queue.FindMessage(uint32('bbbb'), -1));
	EXPECT_EQ(nullptr, queue.FindMessage(uint32('cccc')));
	EXPECT_EQ(3, queue.CountMessages());
}


TEST(MessageQueue, RemovesWithoutDeleting)
{
	BMessageQueue queue;
	std::unique_ptr<BMessage> message(new BMessage('aaaa'));
	queue.AddMessage(message.get());
	queue.AddMessage(new BMessage('bbbb'));

	EXPECT_TRUE(queue.RemoveMessage(message.get()));

	EXPECT_EQ(uint32('aaaa'), message->what);
	EXPECT_EQ(1, queue.CountMessages());
	EXPECT_FALSE(queue.RemoveMessage(message.get()));
}


TEST(MessageQueue, DeletesWhatItHoldsAtItsEnd)
{
	static int sDeleted;
	sDeleted = 0;
	class Message : public BMessage {
	public:
		~Message() override { sDeleted++; }
	};
	{
		BMessageQueue queue;
		queue.AddMessage(new Message);
		queue.AddMessage(new Message);
	}
	EXPECT_EQ(2, sDeleted);
}


TEST(MessageQueue, StaysAsItIsWhileLocked)
{
	BMessageQueue queue;
	ASSERT_TRUE(queue.Lock());
	std::thread adder([&] { queue.AddMessage(new BMessage('aaaa')); });
	for (int i = 0; i < 1000; i++)
		ASSERT_TRUE(queue.IsEmpty());
	queue.Unlock();
	adder.join();
	EXPECT_EQ(1, queue.CountMessages());
}
