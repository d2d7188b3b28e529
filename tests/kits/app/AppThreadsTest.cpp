// Many threads at once, mostly for the thread sanitizer.

#include <atomic>
#include <cstring>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include <Clipboard.h>
#include <Handler.h>
#include <Looper.h>
#include <Message.h>
#include <MessageRunner.h>
#include <Messenger.h>

namespace {

constexpr uint32 kAsk = 'ask ';
constexpr uint32 kAnswer = 'answ';
constexpr uint32 kKeep = 'keep';
constexpr uint32 kData = 'data';

// Answers, or keeps a message unanswered until its end.
class AnsweringLooper : public BLooper {
public:
	~AnsweringLooper() override
	{
		for (BMessage* message : fKept)
			delete message;
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == kAsk)
			message->SendReply(kAnswer);
		else if (message->what == kKeep)
			fKept.push_back(DetachCurrentMessage());
		else if (message->what != kData)
			BLooper::MessageReceived(message);
		count++;
	}

	std::atomic<int32> count { 0 };

private:
	std::vector<BMessage*> fKept; // owned
};


AnsweringLooper*
StartLooper()
{
	auto* looper = new AnsweringLooper;
	looper->Run();
	return looper;
}


void
End(BLooper* looper)
{
	ASSERT_TRUE(looper->Lock());
	looper->Quit();
}


template<typename Function>
std::vector<std::thread>
StartThreads(int count, Function function)
{
	std::vector<std::thread> threads;
	for (int i = 0; i < count; i++)
		threads.emplace_back(function, i);
	return threads;
}


void
Join(std::vector<std::thread>& threads)
{
	for (std::thread& thread : threads)
		thread.join();
}

} // namespace


TEST(Looper, QuitLetsAllGoWhoSendToIt)
{
	for (int round = 0; round < 20; round++) {
		AnsweringLooper* looper = StartLooper();
		const BMessenger messenger(looper);
		auto threads = StartThreads(4, [&](int i) {
			BMessage message(kData);
			message.AddString("text", "bytes");
			BMessage reply;
			while (
				(i % 2 == 0 ? messenger.SendMessage(&message) : messenger.SendMessage(kAsk, &reply))
				== B_OK) {
			}
		});
		while (looper->count < 50)
			std::this_thread::yield();
		End(looper);
		Join(threads);
		EXPECT_FALSE(messenger.IsValid());
	}
}


TEST(Looper, ItsEndAnswersAllWhoWait)
{
	for (int round = 0; round < 20; round++) {
		AnsweringLooper* looper = StartLooper();
		const BMessenger messenger(looper);
		std::atomic<int32> unanswered { 0 };
		auto threads = StartThreads(5, [&](int) {
			BMessage message(kKeep);
			BMessage reply;
			if (messenger.SendMessage(&message, &reply) == B_OK && reply.what == uint32(B_NO_REPLY))
				unanswered++;
		});
		while (looper->count < 5)
			std::this_thread::yield();
		End(looper);
		Join(threads);
		EXPECT_EQ(5, unanswered);
	}
}


TEST(Looper, EightThreadsShareItsLock)
{
	AnsweringLooper* looper = StartLooper();
	int32 shared = 0;
	auto threads = StartThreads(8, [&](int i) {
		for (int k = 0; k < 200; k++) {
			if (i % 4 == 0)
				looper->PostMessage(kData);
			ASSERT_TRUE(looper->Lock());
			ASSERT_TRUE(looper->Lock());
			shared++;
			looper->Unlock();
			looper->Unlock();
		}
	});
	Join(threads);
	EXPECT_EQ(1600, shared);
	End(looper);
}


TEST(Messenger, IsUsedWhileItsHandlerComesAndGoes)
{
	AnsweringLooper* looper = StartLooper();
	for (int round = 0; round < 50; round++) {
		auto* handler = new BHandler;
		looper->Lock();
		looper->AddHandler(handler);
		looper->Unlock();
		const BMessenger messenger(handler);
		std::atomic<int32> sent { 0 };
		auto threads = StartThreads(3, [&](int i) {
			BMessage reply;
			for (int k = 0; k < 20; k++, sent++) {
				if (i == 0)
					messenger.SendMessage(kData);
				else if (i == 1)
					messenger.SendMessage(kData, &reply);
				else if (messenger.LockTarget()) {
					messenger.Target(NULL);
					looper->Unlock();
				}
			}
		});
		while (sent < 5)
			std::this_thread::yield();
		looper->Lock();
		looper->RemoveHandler(handler);
		delete handler;
		looper->Unlock();
		Join(threads);
		EXPECT_EQ(nullptr, messenger.Target(NULL));
	}
	End(looper);
}


TEST(Clipboard, IsWholeForEachOfManyThreads)
{
	BClipboard first("threads");
	BClipboard second("threads");
	auto threads = StartThreads(5, [&](int i) {
		BClipboard& clipboard = i % 2 == 0 ? first : second;
		for (int k = 0; k < 60; k++) {
			const char text[] = { char('a' + i), char('a' + i), char('a' + i), char('a' + i) };
			const void* data = nullptr;
			ssize_t size = 0;
			ASSERT_TRUE(clipboard.Lock());
			if (clipboard.Data()->FindData("text/plain", B_MIME_TYPE, &data, &size) == B_OK) {
				ASSERT_EQ(4, size);
				EXPECT_EQ(0, memcmp(data, static_cast<const char*>(data) + 1, 3));
			}
			clipboard.Clear();
			clipboard.Data()->AddData("text/plain", B_MIME_TYPE, text, sizeof(text));
			EXPECT_EQ(B_OK, k % 3 == 0 ? clipboard.Revert() : clipboard.Commit());
			clipboard.Unlock();
		}
	});
	Join(threads);
	EXPECT_EQ(5u * 40, first.SystemCount());
}


TEST(MessageRunner, ManyComeAndGoWhileTheirTargetEnds)
{
	for (int round = 0; round < 10; round++) {
		AnsweringLooper* looper = StartLooper();
		const BMessenger messenger(looper);
		const BMessage message(kData);
		auto threads = StartThreads(4, [&](int) {
			do {
				BMessageRunner runner(messenger, &message, 500);
				runner.SetInterval(300);
				runner.SetCount(3);
				bigtime_t interval;
				int32 count;
				runner.GetInfo(&interval, &count);
				BMessageRunner::StartSending(messenger, &message, 200, 2);
				std::this_thread::yield();
			} while (messenger.IsValid());
		});
		while (looper->count < 20)
			std::this_thread::yield();
		End(looper);
		Join(threads);
	}
}
