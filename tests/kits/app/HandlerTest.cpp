#include <Handler.h>

#include <gtest/gtest.h>
#include <thread>

#include <AppDefs.h>
#include <List.h>
#include <MessageFilter.h>

#include "tests/kits/app/RecordingLooper.h"
#include "tests/support/DebuggerCatcher.h"


TEST(Handler, StartsOutsideOfAnyChain)
{
	BHandler handler("name");

	EXPECT_STREQ("name", handler.Name());
	EXPECT_EQ(nullptr, handler.Looper());
	EXPECT_EQ(nullptr, handler.NextHandler());
	EXPECT_EQ(nullptr, BHandler().Name());
}


TEST(Handler, LeavesItsLooperWhenDeleted)
{
	auto* looper = new BLooper;
	auto* handler = new BHandler;
	looper->AddHandler(handler);

	delete handler;

	EXPECT_EQ(1, looper->CountHandlers());
	looper->Quit();
}


TEST(Handler, LosesItsLinksWhenRemoved)
{
	auto* looper = new BLooper;
	BHandler first;
	BHandler second;
	looper->AddHandler(&first);
	looper->AddHandler(&second);
	first.SetNextHandler(&second);
	EXPECT_EQ(&second, first.NextHandler());

	looper->RemoveHandler(&first);

	EXPECT_EQ(nullptr, first.Looper());
	EXPECT_EQ(nullptr, first.NextHandler());
	looper->Quit();
}


TEST(Handler, NextHandlerNeedsALooperThatBothShare)
{
	DebuggerCatcher catcher;
	auto* looper = new BLooper;
	BHandler handler;
	BHandler stranger;

	handler.SetNextHandler(NULL);
	EXPECT_TRUE(catcher.TakeOne());

	looper->AddHandler(&handler);
	handler.SetNextHandler(&stranger);
	EXPECT_TRUE(catcher.TakeOne());
	EXPECT_EQ(looper, handler.NextHandler());

	handler.SetNextHandler(NULL);
	EXPECT_EQ(nullptr, handler.NextHandler());

	looper->Unlock();
	handler.SetNextHandler(NULL);
	EXPECT_TRUE(catcher.TakeOne());
	looper->Lock();
	looper->Quit();
}


TEST(Handler, PassesMessagesAlongTheChain)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	RecordingHandler first("first", &looper->log);
	RecordingHandler second("second", &looper->log);
	looper->AddHandler(&first);
	looper->AddHandler(&second);
	first.SetNextHandler(&second);
	first.passOn = true;
	second.passOn = true;
	looper->PostMessage('aaaa', &first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "first:aaaa", "second:aaaa", "l:aaaa" }), looper->log);
	looper->Lock();
	looper->RemoveHandler(&first);
	looper->RemoveHandler(&second);
	looper->Unlock();
}


TEST(Handler, TheNextHandlersFiltersSeeWhatIsPassedOn)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	RecordingHandler first("first", &looper->log);
	RecordingHandler second("second", &looper->log);
	RecordingHandler third("third", &looper->log);
	first.passOn = true;
	for (BHandler* handler : { &first, &second, &third })
		looper->AddHandler(handler);
	first.SetNextHandler(&second);

	// The second one's filter stops one code and redirects another.
	static RecordingHandler* sThird;
	sThird = &third;
	second.AddFilter(new BMessageFilter(
		'stop', [](BMessage*, BHandler**, BMessageFilter*) { return B_SKIP_MESSAGE; }));
	second.AddFilter(new BMessageFilter('turn', [](BMessage*, BHandler** target, BMessageFilter*) {
		*target = sThird;
		return B_DISPATCH_MESSAGE;
	}));
	looper->PostMessage('stop', &first);
	looper->PostMessage('turn', &first);
	looper->PostMessage('pass', &first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "first:stop", "first:turn", "third:turn", "first:pass", "second:pass" }),
		looper->log);
	looper->Lock();
	for (BHandler* handler : { &first, &second, &third })
		looper->RemoveHandler(handler);
	looper->Unlock();
}


TEST(Handler, AnswersNotUnderstoodAtTheEndOfTheChain)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	looper->passOn = true;
	looper->Unlock();
	BMessage reply;

	ASSERT_EQ(B_OK, BMessenger(looper.Get()).SendMessage('what', &reply));

	EXPECT_EQ(uint32(B_MESSAGE_NOT_UNDERSTOOD), reply.what);
}


TEST(Handler, LetsAMessageVanishThatNobodyWaitsFor)
{
	// The answer would come back to the looper itself.
	Running<RecordingLooper> looper("l");
	looper->Lock();
	looper->passOn = true;
	looper->Unlock();

	BMessage message('what');
	BMessenger(looper.Get()).SendMessage(&message, looper.Get());
	looper->Sync();
	looper->Sync();

	EXPECT_EQ((Log { "l:what" }), looper->log);
}


TEST(Handler, AnswersNotUnderstoodToAScriptingMessage)
{
	Running<RecordingLooper> looper("l");
	BMessage message(B_SET_PROPERTY);
	message.AddSpecifier("Nothing");
	BMessage reply;

	ASSERT_EQ(B_OK, BMessenger(looper.Get()).SendMessage(&message, &reply));

	EXPECT_EQ(uint32(B_MESSAGE_NOT_UNDERSTOOD), reply.what);
	EXPECT_EQ(B_BAD_SCRIPT_SYNTAX, reply.FindInt32("error"));
	EXPECT_TRUE(reply.HasString("message"));
}


TEST(Handler, TellsItsNameByScripting)
{
	Running<RecordingLooper> looper("a name");
	looper->Lock();
	looper->passOn = true;
	looper->Unlock();
	BMessage message(B_GET_PROPERTY);
	message.AddSpecifier("InternalName");
	BMessage reply;

	ASSERT_EQ(B_OK, BMessenger(looper.Get()).SendMessage(&message, &reply));

	EXPECT_EQ(uint32(B_REPLY), reply.what);
	EXPECT_STREQ("a name", reply.FindString("result"));
}


// #pragma mark - lock


TEST(Handler, LocksTheLooperThatItHasNow)
{
	auto* looper = new BLooper;
	BHandler handler;
	EXPECT_FALSE(handler.LockLooper());
	EXPECT_EQ(B_BAD_VALUE, handler.LockLooperWithTimeout(0));

	looper->AddHandler(&handler);
	EXPECT_TRUE(handler.LockLooper());
	EXPECT_EQ(2, looper->CountLocks());
	handler.UnlockLooper();
	EXPECT_EQ(1, looper->CountLocks());

	std::thread([&] { EXPECT_EQ(B_TIMED_OUT, handler.LockLooperWithTimeout(1000)); }).join();
	looper->Quit();
	EXPECT_FALSE(handler.LockLooper());
}


TEST(Handler, LockLooperFailsWhenTheLooperChangesMeanwhile)
{
	auto* first = new BLooper;
	auto* second = new BLooper;
	BHandler handler;
	first->AddHandler(&handler);
	second->Unlock();

	bool locked = true;
	std::thread waiting([&] { locked = handler.LockLooper(); });
	while (first->CountLockRequests() < 2)
		std::this_thread::yield();
	first->RemoveHandler(&handler);
	second->Lock();
	second->AddHandler(&handler);
	second->Unlock();
	first->Unlock();
	waiting.join();

	EXPECT_FALSE(locked);
	first->Lock();
	EXPECT_EQ(1, first->CountLocks());
	first->Quit();
	second->Lock();
	second->Quit();
}


// #pragma mark - filters


TEST(Handler, OwnsItsFilters)
{
	static int sDeleted;
	sDeleted = 0;
	class Filter : public BMessageFilter {
	public:
		Filter() : BMessageFilter('what') {}
		~Filter() override { sDeleted++; }
	};
	{
		BHandler handler;
		EXPECT_EQ(nullptr, handler.FilterList());
		handler.AddFilter(new Filter);
		handler.AddFilter(new Filter);
		auto* removed = new Filter;
		handler.AddFilter(removed);
		EXPECT_EQ(3, handler.FilterList()->CountItems());

		EXPECT_TRUE(handler.RemoveFilter(removed));
		EXPECT_FALSE(handler.RemoveFilter(removed));
		EXPECT_EQ(0, sDeleted);
		delete removed;

		auto* list = new BList;
		list->AddItem(new Filter);
		handler.SetFilterList(list);
		EXPECT_EQ(3, sDeleted);
		EXPECT_EQ(list, handler.FilterList());
	}
	EXPECT_EQ(4, sDeleted);
}


TEST(Handler, FiltersOfAnAttachedOneNeedTheLock)
{
	DebuggerCatcher catcher;
	auto* looper = new BLooper;
	BHandler handler;
	looper->AddHandler(&handler);
	looper->Unlock();
	BMessageFilter filter('what');

	handler.AddFilter(&filter);
	EXPECT_TRUE(catcher.TakeOne());
	EXPECT_FALSE(handler.RemoveFilter(&filter));
	EXPECT_TRUE(catcher.TakeOne());
	handler.SetFilterList(NULL);
	EXPECT_TRUE(catcher.TakeOne());

	looper->Lock();
	looper->Quit();
}


// #pragma mark - archive


TEST(Handler, ArchivesItsNameOnlyIfItHasOne)
{
	BMessage named;
	BMessage unnamed;
	ASSERT_EQ(B_OK, BHandler("name").Archive(&named));
	ASSERT_EQ(B_OK, BHandler().Archive(&unnamed));

	EXPECT_STREQ("name", named.FindString("_name"));
	EXPECT_FALSE(unnamed.HasString("_name"));

	const std::unique_ptr<BArchivable> revived(BHandler::Instantiate(&named));
	auto* handler = dynamic_cast<BHandler*>(revived.get());
	ASSERT_NE(nullptr, handler);
	EXPECT_STREQ("name", handler->Name());

	BMessage other;
	other.AddString("class", "BOther");
	EXPECT_EQ(nullptr, BHandler::Instantiate(&other));
}


// #pragma mark - observers


TEST(Handler, TellsThoseWhoWatchIt)
{
	Running<RecordingLooper> looper("l");
	looper->Lock();
	BHandler watched;
	RecordingHandler watcher("watcher", &looper->log);
	looper->AddHandler(&watched);
	looper->AddHandler(&watcher);
	EXPECT_FALSE(watched.IsWatched());

	EXPECT_EQ(B_OK, watched.StartWatching(&watcher, 'this'));
	EXPECT_TRUE(watched.IsWatched());
	watched.SendNotices('this');
	watched.SendNotices('that');
	EXPECT_EQ(B_OK, watched.StartWatchingAll(&watcher));
	watched.SendNotices('that');
	EXPECT_EQ(B_OK, watched.StopWatchingAll(&watcher));
	watched.SendNotices('this');
	EXPECT_FALSE(watched.IsWatched());
	EXPECT_EQ(B_BAD_VALUE, watched.StopWatching(&watcher, 'this'));
	looper->Unlock();
	looper->Sync();

	EXPECT_EQ((Log { "watcher:NTCH", "watcher:NTCH" }), looper->log);
	looper->Lock();
	looper->RemoveHandler(&watched);
	looper->RemoveHandler(&watcher);
	looper->Unlock();
}


TEST(Handler, CanBeWatchedFromAnotherLooper)
{
	class Watcher : public RecordingLooper {
	public:
		using RecordingLooper::RecordingLooper;
		void MessageReceived(BMessage* message) override
		{
			if (message->what == B_OBSERVER_NOTICE_CHANGE)
				notice = *message;
			else
				RecordingLooper::MessageReceived(message);
		}
		BMessage notice;
	};
	Running<RecordingLooper> watched("watched");
	Running<Watcher> watcher("watcher");
	watched->Lock();
	watched->passOn = true;
	watched->Unlock();
	watcher->Lock();
	EXPECT_EQ(B_OK, watcher->StartWatching(BMessenger(watched.Get()), 'this'));
	watcher->Unlock();
	watched->Sync();

	watched->Lock();
	BMessage news('news');
	news.AddInt32("value", 5);
	watched->SendNotices('this', &news);
	watched->Unlock();
	watcher->Sync();

	watcher->Lock();
	EXPECT_EQ(int32('this'), watcher->notice.FindInt32(B_OBSERVE_WHAT_CHANGE));
	EXPECT_EQ(int32('news'), watcher->notice.FindInt32(B_OBSERVE_ORIGINAL_WHAT));
	EXPECT_EQ(5, watcher->notice.FindInt32("value"));
	watcher->Unlock();
}
