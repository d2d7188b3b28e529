#include <Looper.h>

#include <atomic>
#include <gtest/gtest.h>
#include <new>
#include <thread>

#include <AppDefs.h>
#include <MessageQueue.h>

#include "tests/kits/app/RecordingLooper.h"
#include "tests/support/DebuggerCatcher.h"

namespace {

// Locks a looper on another thread and tells when it got the lock.
class Locker {
public:
	explicit Locker(BLooper* looper) :
		fThread([this, looper] {
			result = looper->Lock();
			if (result)
				looper->Unlock();
			done = true;
		})
	{
	}
	~Locker() { Join(); }

	void Join()
	{
		if (fThread.joinable())
			fThread.join();
	}

	std::atomic<bool> result { false };
	std::atomic<bool> done { false };

private:
	std::thread fThread;
};


// Runs a function in another thread and waits for it.
template<typename Function>
void
Elsewhere(Function function)
{
	std::thread(function).join();
}

} // namespace


TEST(Looper, IsLockedByItsMakerAndItsOwnFirstHandler)
{
	auto* looper = new BLooper("name");

	EXPECT_TRUE(looper->IsLocked());
	EXPECT_EQ(1, looper->CountLocks());
	EXPECT_EQ(find_thread(NULL), looper->LockingThread());
	EXPECT_EQ(looper, looper->Looper());
	EXPECT_EQ(nullptr, looper->NextHandler());
	EXPECT_EQ(1, looper->CountHandlers());
	EXPECT_EQ(looper, looper->HandlerAt(0));
	EXPECT_EQ(0, looper->IndexOf(looper));

	looper->Quit();
}


TEST(Looper, RunUnlocksOnceAndStartsAThreadOfItsName)
{
	auto* looper = new BLooper("a looper");
	looper->Lock();

	const thread_id thread = looper->Run();

	EXPECT_GE(thread, 0);
	EXPECT_EQ(thread, looper->Thread());
	EXPECT_EQ(looper, BLooper::LooperForThread(thread));
	EXPECT_EQ(1, looper->CountLocks());
	thread_info info;
	ASSERT_EQ(B_OK, get_thread_info(thread, &info));
	EXPECT_STREQ("a looper", info.name);
	looper->Quit();
}


TEST(Looper, RunningTwiceStops)
{
	DebuggerCatcher catcher;
	Running<RecordingLooper> looper;
	looper->Lock();

	EXPECT_EQ(looper->Thread(), looper->Run());
	EXPECT_TRUE(catcher.TakeOne());

	looper->Unlock();
}


TEST(Looper, LockIsRecursiveAndCounted)
{
	auto* looper = new BLooper;

	EXPECT_TRUE(looper->Lock());
	EXPECT_TRUE(looper->Lock());
	EXPECT_EQ(3, looper->CountLocks());
	looper->Unlock();
	EXPECT_EQ(2, looper->CountLocks());
	EXPECT_TRUE(looper->IsLocked());

	looper->Quit();
}


TEST(Looper, IsLockedIsTrueForTheHolderOnly)
{
	auto* looper = new BLooper;

	Elsewhere([looper] { EXPECT_FALSE(looper->IsLocked()); });

	looper->Unlock();
	EXPECT_FALSE(looper->IsLocked());
	EXPECT_EQ(-1, looper->LockingThread());
	looper->Lock();
	looper->Quit();
}


TEST(Looper, LockWithTimeoutGivesUp)
{
	auto* looper = new BLooper;

	Elsewhere([looper] { EXPECT_EQ(B_TIMED_OUT, looper->LockWithTimeout(1000)); });

	EXPECT_EQ(1, looper->CountLockRequests());
	looper->Quit();
}


TEST(Looper, UnlockWithoutTheLockStops)
{
	DebuggerCatcher catcher;
	auto* looper = new BLooper;
	looper->Unlock();

	looper->Unlock();
	EXPECT_TRUE(catcher.TakeOne());

	looper->Lock();
	looper->Quit();
}


TEST(Looper, LockFailsForThoseWhoWaitedWhenTheLooperGoes)
{
	auto* looper = new BLooper;
	Locker locker(looper);
	while (looper->CountLockRequests() < 2)
		std::this_thread::yield();

	looper->Quit();

	locker.Join();
	EXPECT_FALSE(locker.result);
}


// The check of the object's type would look into the looper that is gone, which Lock() does not.
__attribute__((no_sanitize("undefined"))) static status_t
LockAtAddress(void* address)
{
	return static_cast<BLooper*>(address)->LockWithTimeout(B_INFINITE_TIMEOUT);
}


TEST(Looper, LockOfADeletedLooperFails)
{
	alignas(BLooper) static char place[sizeof(BLooper)];
	auto* looper = new (place) BLooper;
	looper->~BLooper();

	EXPECT_EQ(B_BAD_PORT_ID, LockAtAddress(place));
}


TEST(Looper, LockIsGrantedThoughTheLoopIsBusy)
{
	// Each message posts the next one, so the loop never pauses.
	class BusyLooper : public BLooper {
	public:
		void MessageReceived(BMessage* message) override { PostMessage(message); }
	};
	Running<BusyLooper> looper;
	looper->PostMessage('next');

	for (int i = 0; i < 100; i++) {
		ASSERT_TRUE(looper->Lock());
		looper->Unlock();
	}
}


TEST(Looper, CallsThatNeedTheLockStopWithoutIt)
{
	DebuggerCatcher catcher;
	auto* looper = new BLooper;
	BHandler handler;
	looper->AddHandler(&handler);
	looper->Unlock();

	looper->CountHandlers();
	EXPECT_TRUE(catcher.TakeOne());
	looper->HandlerAt(0);
	EXPECT_TRUE(catcher.TakeOne());
	looper->IndexOf(&handler);
	EXPECT_TRUE(catcher.TakeOne());
	BHandler other;
	looper->AddHandler(&other);
	EXPECT_TRUE(catcher.TakeOne());
	EXPECT_FALSE(looper->RemoveHandler(&handler));
	EXPECT_TRUE(catcher.TakeOne());
	looper->SetPreferredHandler(&handler);
	EXPECT_TRUE(catcher.TakeOne());
	looper->Quit();
	EXPECT_TRUE(catcher.TakeOne());
	looper->Run();
	EXPECT_TRUE(catcher.TakeOne());
	looper->AddCommonFilter(NULL);
	EXPECT_TRUE(catcher.TakeOne());
	looper->RemoveCommonFilter(NULL);
	EXPECT_TRUE(catcher.TakeOne());
	looper->SetCommonFilterList(NULL);
	EXPECT_TRUE(catcher.TakeOne());

	looper->Lock();
	looper->Quit();
}


TEST(Looper, DeletingARunningOneStops)
{
	// The stop itself would leave a thread without a looper, so only the report is looked at.
	EXPECT_DEATH(
		{
			auto* looper = new BLooper;
			looper->Run();
			looper->Lock();
			delete looper;
		},
		"running");
}


// #pragma mark - handlers


TEST(Looper, HandlersKeepTheirOrderThroughRemovals)
{
	auto* looper = new BLooper;
	std::vector<std::unique_ptr<BHandler>> handlers;
	for (int i = 0; i < 100; i++) {
		handlers.push_back(std::make_unique<BHandler>());
		looper->AddHandler(handlers.back().get());
	}
	for (int i = 0; i < 100; i += 3)
		EXPECT_TRUE(looper->RemoveHandler(handlers[i].get()));

	EXPECT_EQ(67, looper->CountHandlers());
	EXPECT_EQ(handlers[1].get(), looper->HandlerAt(1));
	EXPECT_EQ(handlers[2].get(), looper->HandlerAt(2));
	EXPECT_EQ(handlers[4].get(), looper->HandlerAt(3));
	EXPECT_EQ(66, looper->IndexOf(handlers[98].get()));
	EXPECT_EQ(-1, looper->IndexOf(handlers[0].get()));
	EXPECT_EQ(nullptr, looper->HandlerAt(67));
	EXPECT_FALSE(looper->RemoveHandler(handlers[0].get()));
	looper->Quit();
}


TEST(Looper, RefusesAHandlerOfAnotherLooper)
{
	DebuggerCatcher catcher;
	auto* first = new BLooper;
	auto* second = new BLooper;
	BHandler handler;
	first->AddHandler(&handler);

	second->AddHandler(&handler);

	EXPECT_TRUE(catcher.TakeOne());
	EXPECT_EQ(first, handler.Looper());
	EXPECT_EQ(1, second->CountHandlers());
	first->Quit();
	second->Quit();
}


TEST(Looper, UnlinksItsHandlersWhenItGoes)
{
	auto* looper = new BLooper;
	BHandler handler;
	looper->AddHandler(&handler);
	EXPECT_EQ(looper, handler.Looper());
	EXPECT_EQ(looper, handler.NextHandler());

	looper->Quit();

	EXPECT_EQ(nullptr, handler.Looper());
	EXPECT_EQ(nullptr, handler.NextHandler());
}


TEST(Looper, ForgetsAPreferredHandlerThatIsRemoved)
{
	auto* looper = new BLooper;
	BHandler handler;
	EXPECT_EQ(nullptr, looper->PreferredHandler());
	looper->AddHandler(&handler);
	looper->SetPreferredHandler(&handler);
	EXPECT_EQ(&handler, looper->PreferredHandler());

	looper->RemoveHandler(&handler);

	EXPECT_EQ(nullptr, looper->PreferredHandler());
	looper->Quit();
}


// #pragma mark - posting


TEST(Looper, HandlesMessagesInTheOrderOfPosting)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	for (uint32 code : { 'aaaa', 'bbbb', 'cccc' })
		looper->PostMessage(code);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "l:aaaa", "l:bbbb", "l:cccc" }), looper->log);
}


TEST(Looper, PostsToItselfUnlessAHandlerIsNamed)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	RecordingHandler named("named", &looper->log);
	RecordingHandler preferred("preferred", &looper->log);
	looper->AddHandler(&named);
	looper->AddHandler(&preferred);
	looper->SetPreferredHandler(&preferred);
	EXPECT_EQ(B_OK, looper->PostMessage('aaaa'));
	EXPECT_EQ(B_OK, looper->PostMessage('bbbb', &named));
	EXPECT_EQ(B_OK, looper->PostMessage('cccc', (BHandler*)NULL));
	EXPECT_EQ(B_OK, looper->PostMessage('dddd', looper.Get()));
	looper->SetPreferredHandler(NULL);
	looper->Unlock();
	looper->Sync();
	EXPECT_EQ(B_OK, looper->PostMessage('eeee', (BHandler*)NULL));
	looper->Sync();

	// The preferred handler is asked for when the message's turn comes.
	EXPECT_EQ((Log { "l:aaaa", "named:bbbb", "l:cccc", "l:dddd", "l:eeee" }), looper->log);
	looper->Lock();
	looper->RemoveHandler(&named);
	looper->RemoveHandler(&preferred);
	looper->Unlock();
}


TEST(Looper, PostsToThePreferredHandler)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	RecordingHandler preferred("preferred", &looper->log);
	looper->AddHandler(&preferred);
	looper->SetPreferredHandler(&preferred);
	looper->Unlock();

	EXPECT_EQ(B_OK, looper->PostMessage('aaaa', (BHandler*)NULL));
	looper->Sync();

	EXPECT_EQ((Log { "preferred:aaaa" }), looper->log);
	looper->Lock();
	looper->RemoveHandler(&preferred);
	looper->Unlock();
}


TEST(Looper, RefusesToPostToAHandlerOfAnotherLooper)
{
	Running<RecordingLooper> looper;
	BHandler handler;

	EXPECT_EQ(B_MISMATCHED_VALUES, looper->PostMessage('aaaa', &handler));

	looper->Sync();
	EXPECT_TRUE(looper->log.empty());
}


TEST(Looper, PostsACopy)
{
	class Reader : public BLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			if (message->what == 'copy')
				value = message->FindInt32("value");
		}
		int32 value = 0;
	};
	auto* looper = new Reader;
	BMessage message('copy');
	message.AddInt32("value", 1);

	looper->PostMessage(&message);
	message.ReplaceInt32("value", 2);
	EXPECT_FALSE(message.WasDelivered());
	looper->Run();

	BMessage reply;
	BMessenger(looper).SendMessage('last', &reply);
	looper->Lock();
	EXPECT_EQ(1, looper->value);
	looper->Quit();
}


TEST(Looper, AFullPortRefusesMessages)
{
	auto* looper = new RecordingLooper("l", 3);
	for (int i = 0; i < 3; i++)
		EXPECT_EQ(B_OK, looper->PostMessage('aaaa'));

	EXPECT_EQ(B_WOULD_BLOCK, looper->PostMessage('bbbb'));

	looper->Run();
	looper->Sync();
	EXPECT_EQ((Log { "l:aaaa", "l:aaaa", "l:aaaa" }), looper->log);
	looper->Lock();
	looper->Quit();
}


TEST(Looper, HandlesWhatIsPostedFromAHookAfterTheCurrentMessage)
{
	class Poster : public RecordingLooper {
	public:
		using RecordingLooper::RecordingLooper;
		void MessageReceived(BMessage* message) override
		{
			if (message->what == 'frst')
				PostMessage('thrd');
			RecordingLooper::MessageReceived(message);
		}
	};
	Running<Poster> looper("l");
	looper->Lock();
	looper->PostMessage('frst');
	looper->PostMessage('scnd');
	looper->Unlock();

	looper->Sync();
	looper->Sync();

	EXPECT_EQ((Log { "l:frst", "l:scnd", "l:thrd" }), looper->log);
}


TEST(Looper, DropsMessagesForDeletedHandlers)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	auto* handler = new RecordingHandler("handler", &looper->log);
	looper->AddHandler(handler);
	looper->PostMessage('aaaa', handler);
	looper->PostMessage('bbbb');
	delete handler;
	EXPECT_EQ(1, looper->CountHandlers());
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "l:bbbb" }), looper->log);
}


TEST(Looper, DropsMessagesForHandlersThatMovedToAnotherLooper)
{
	Running<RecordingLooper> first("first");
	Running<RecordingLooper> second("second");
	first->Lock();
	RecordingHandler handler("handler", &first->log);
	first->AddHandler(&handler);
	first->PostMessage('aaaa', &handler);
	first->RemoveHandler(&handler);
	second->Lock();
	second->AddHandler(&handler);
	second->Unlock();
	first->Unlock();

	first->Sync();

	EXPECT_TRUE(first->log.empty());
	second->Lock();
	second->RemoveHandler(&handler);
	second->Unlock();
}


// #pragma mark - current message


TEST(Looper, KnowsItsCurrentMessageInItsOwnThreadOnly)
{
	class Looker : public BLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			isCurrent = CurrentMessage() == message;
			Elsewhere([this] { isHidden = CurrentMessage() == NULL; });
			message->SendReply(B_REPLY);
		}
		bool isCurrent = false;
		bool isHidden = false;
	};
	Running<Looker> looper;
	BMessage reply;

	BMessenger(looper.Get()).SendMessage('look', &reply);

	looper->Lock();
	EXPECT_TRUE(looper->isCurrent);
	EXPECT_TRUE(looper->isHidden);
	EXPECT_EQ(nullptr, looper->CurrentMessage());
	looper->Unlock();
}


TEST(Looper, ADetachedMessageCanBeAnsweredLater)
{
	class Detacher : public BLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			if (message->what == 'keep') {
				kept.reset(DetachCurrentMessage());
				EXPECT_EQ(message, kept.get());
				EXPECT_EQ(nullptr, CurrentMessage());
			} else if (message->what == 'now ')
				kept->SendReply('late');
		}
		std::unique_ptr<BMessage> kept;
	};
	Running<Detacher> looper;
	BMessage reply;
	std::thread asker([&] { BMessenger(looper.Get()).SendMessage('keep', &reply); });
	while (true) {
		looper->Lock();
		const bool isKept = looper->kept != nullptr;
		looper->Unlock();
		if (isKept)
			break;
		std::this_thread::yield();
	}

	looper->PostMessage('now ');

	asker.join();
	EXPECT_EQ(uint32('late'), reply.what);
}


// #pragma mark - quitting


namespace {

// Tells of its end, and may refuse a request to end.
class MortalLooper : public RecordingLooper {
public:
	explicit MortalLooper(std::atomic<bool>* gone) : RecordingLooper("l"), fGone(gone) {}
	~MortalLooper() override { *fGone = true; }

	bool QuitRequested() override
	{
		requests++;
		return agrees;
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == 'quit') {
			Quit();
			ADD_FAILURE() << "Quit() returned";
		}
		RecordingLooper::MessageReceived(message);
	}

	bool agrees = true;
	int requests = 0;

private:
	std::atomic<bool>* fGone;
};

} // namespace


TEST(Looper, QuitOfOneThatNeverRanDeletesIt)
{
	std::atomic<bool> gone = false;
	(new MortalLooper(&gone))->Quit();
	EXPECT_TRUE(gone);
}


TEST(Looper, QuitFromAnotherThreadHandlesWhatIsQueuedFirst)
{
	class Counter : public BLooper {
	public:
		explicit Counter(int* count) : fCount(count) {}
		void MessageReceived(BMessage*) override { (*fCount)++; }

	private:
		int* fCount;
	};
	int count = 0;
	auto* looper = new Counter(&count);
	for (int i = 0; i < 50; i++)
		looper->PostMessage('mess');
	looper->Run();
	looper->Lock();
	looper->Lock();

	looper->Quit();

	EXPECT_EQ(50, count);
}


TEST(Looper, QuitInItsOwnThreadDoesNotReturn)
{
	std::atomic<bool> gone = false;
	auto* looper = new MortalLooper(&gone);
	const thread_id thread = looper->Run();

	looper->PostMessage('quit');
	wait_for_thread(thread, NULL);

	EXPECT_TRUE(gone);
}


TEST(Looper, QuitInItsOwnThreadThrowsAwayWhatIsQueued)
{
	std::atomic<bool> gone = false;
	auto* looper = new MortalLooper(&gone);
	looper->PostMessage('quit');
	const BMessenger target(looper);
	BMessage reply;
	std::thread asker([&] { target.SendMessage('ask ', &reply); });
	while (looper->MessageQueue()->CountMessages() < 2)
		std::this_thread::yield();

	wait_for_thread(looper->Run(), NULL);

	asker.join();
	EXPECT_EQ(uint32(B_NO_REPLY), reply.what);
	EXPECT_FALSE(target.IsValid());
}


TEST(Looper, QuitDoesNotAsk)
{
	class Asked : public BLooper {
	public:
		explicit Asked(bool* asked) : fAsked(asked) {}
		bool QuitRequested() override
		{
			*fAsked = true;
			return true;
		}

	private:
		bool* fAsked;
	};
	bool asked = false;
	auto* looper = new Asked(&asked);
	looper->Run();
	looper->Lock();

	looper->Quit();

	EXPECT_FALSE(asked);
}


TEST(Looper, ARequestToQuitIsAnsweredAndFollowed)
{
	std::atomic<bool> gone = false;
	auto* looper = new MortalLooper(&gone);
	const thread_id thread = looper->Run();
	const BMessenger target(looper);
	BMessage reply;

	looper->Lock();
	looper->agrees = false;
	looper->Unlock();
	ASSERT_EQ(B_OK, target.SendMessage(B_QUIT_REQUESTED, &reply));
	EXPECT_EQ(uint32(B_REPLY), reply.what);
	EXPECT_TRUE(reply.HasBool("result"));
	EXPECT_FALSE(reply.FindBool("result"));
	EXPECT_EQ(thread, reply.FindInt32("thread"));

	looper->Lock();
	looper->agrees = true;
	looper->Unlock();
	ASSERT_EQ(B_OK, target.SendMessage(B_QUIT_REQUESTED, &reply));
	EXPECT_TRUE(reply.FindBool("result"));

	wait_for_thread(thread, NULL);
	EXPECT_TRUE(gone);
}


TEST(Looper, ARequestToQuitForAHandlerIsAnOrdinaryMessage)
{
	std::atomic<bool> gone = false;
	auto* looper = new MortalLooper(&gone);
	Log log;
	RecordingHandler handler("handler", &log);
	looper->AddHandler(&handler);
	looper->Run();

	looper->PostMessage(B_QUIT_REQUESTED, &handler);
	looper->Sync();

	EXPECT_EQ((Log { "handler:_QRQ" }), log);
	looper->Lock();
	EXPECT_EQ(0, looper->requests);
	looper->RemoveHandler(&handler);
	looper->Quit();
}


TEST(Looper, TwoThreadsMayQuitItAtOnce)
{
	for (int i = 0; i < 50; i++) {
		std::atomic<bool> gone = false;
		auto* looper = new MortalLooper(&gone);
		const BMessenger target(looper);
		looper->Run();
		const auto quit = [&] {
			if (target.LockTarget())
				looper->Quit();
		};
		std::thread other(quit);
		quit();
		other.join();
		EXPECT_TRUE(gone);
	}
}


TEST(Looper, LoopRunsInTheCallersThreadUntilItIsQuit)
{
	std::atomic<bool> gone = false;
	auto* looper = new MortalLooper(&gone);
	looper->PostMessage('aaaa');
	looper->PostMessage(B_QUIT_REQUESTED);

	looper->Loop();

	EXPECT_TRUE(gone);
}


// #pragma mark - archive


TEST(Looper, ArchivesItsNamePriorityAndCapacity)
{
	auto* looper = new BLooper("name", B_DISPLAY_PRIORITY, 7);
	BMessage archive;
	ASSERT_EQ(B_OK, looper->Archive(&archive));
	looper->Quit();

	EXPECT_STREQ("name", archive.FindString("_name"));
	EXPECT_EQ(7, archive.FindInt32("_port_cap"));
	EXPECT_EQ(B_DISPLAY_PRIORITY, archive.FindInt32("_prio"));

	auto* revived = static_cast<BLooper*>(BLooper::Instantiate(&archive));
	ASSERT_NE(nullptr, revived);
	EXPECT_STREQ("name", revived->Name());
	// One that was made of an archive and never run may simply be deleted.
	delete revived;
}
