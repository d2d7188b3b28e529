#include <MessageFilter.h>

#include <gtest/gtest.h>

#include <AppDefs.h>
#include <List.h>

#include "tests/kits/app/RecordingLooper.h"
#include "tests/support/DebuggerCatcher.h"

namespace {

// Notes what it sees in the looper's log and does what it is told.
class RecordingFilter : public BMessageFilter {
public:
	RecordingFilter(const char* name, Log* log, filter_result result = B_DISPATCH_MESSAGE) :
		BMessageFilter(B_ANY_DELIVERY, B_ANY_SOURCE), fName(name), fLog(log), fResult(result)
	{
	}

	filter_result Filter(BMessage* message, BHandler** target) override
	{
		if (message->what == 'sync')
			return B_DISPATCH_MESSAGE;
		fLog->push_back(Note(fName, message->what));
		if (newTarget != nullptr)
			*target = *newTarget;
		return fResult;
	}

	BHandler* const* newTarget = nullptr; // borrowed; NULL: leave it

private:
	const char* fName;
	Log* fLog; // borrowed
	filter_result fResult;
};


// A looper with two handlers of its own.
class FilteredLooper : public RecordingLooper {
public:
	FilteredLooper() : RecordingLooper("l"), first("first", &log), second("second", &log)
	{
		AddHandler(&first);
		AddHandler(&second);
	}

	RecordingHandler first;
	RecordingHandler second;
};

} // namespace


TEST(MessageFilter, KeepsItsCriteria)
{
	const BMessageFilter code('code');
	EXPECT_EQ(uint32('code'), code.Command());
	EXPECT_FALSE(code.FiltersAnyCommand());
	EXPECT_EQ(B_ANY_DELIVERY, code.MessageDelivery());
	EXPECT_EQ(B_ANY_SOURCE, code.MessageSource());
	EXPECT_EQ(nullptr, code.Looper());

	const BMessageFilter any(B_DROPPED_DELIVERY, B_LOCAL_SOURCE);
	EXPECT_TRUE(any.FiltersAnyCommand());
	EXPECT_EQ(0u, any.Command());
	EXPECT_EQ(B_DROPPED_DELIVERY, any.MessageDelivery());
	EXPECT_EQ(B_LOCAL_SOURCE, any.MessageSource());

	const BMessageFilter all(B_PROGRAMMED_DELIVERY, B_REMOTE_SOURCE, 'code');
	EXPECT_FALSE(all.FiltersAnyCommand());
	EXPECT_EQ(B_PROGRAMMED_DELIVERY, all.MessageDelivery());
	EXPECT_EQ(B_REMOTE_SOURCE, all.MessageSource());
}


TEST(MessageFilter, ACopyIsInstalledNowhere)
{
	auto* looper = new BLooper;
	auto* filter = new BMessageFilter(B_DROPPED_DELIVERY, B_LOCAL_SOURCE, 'code');
	looper->AddCommonFilter(filter);

	const BMessageFilter copy(*filter);

	EXPECT_EQ(looper, filter->Looper());
	EXPECT_EQ(nullptr, copy.Looper());
	EXPECT_EQ(uint32('code'), copy.Command());
	EXPECT_EQ(B_DROPPED_DELIVERY, copy.MessageDelivery());
	looper->Quit();
}


TEST(MessageFilter, RunsCommonFiltersBeforeTheHandlersInListOrder)
{
	Running<FilteredLooper> looper;
	looper->Lock();
	looper->first.AddFilter(new RecordingFilter("h1", &looper->log));
	looper->first.AddFilter(new RecordingFilter("h2", &looper->log));
	looper->AddCommonFilter(new RecordingFilter("c1", &looper->log));
	looper->AddCommonFilter(new RecordingFilter("c2", &looper->log));
	looper->PostMessage('aaaa', &looper->first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "c1:aaaa", "c2:aaaa", "h1:aaaa", "h2:aaaa", "first:aaaa" }), looper->log);
}


TEST(MessageFilter, ASkipStopsEverything)
{
	Running<FilteredLooper> looper;
	looper->Lock();
	looper->AddCommonFilter(new RecordingFilter("c1", &looper->log, B_SKIP_MESSAGE));
	looper->AddCommonFilter(new RecordingFilter("c2", &looper->log));
	looper->first.AddFilter(new RecordingFilter("h1", &looper->log));
	looper->PostMessage('aaaa', &looper->first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "c1:aaaa" }), looper->log);
}


TEST(MessageFilter, ACommonFilterSeesAllMessagesOfAllHandlers)
{
	Running<FilteredLooper> looper;
	looper->Lock();
	looper->AddCommonFilter(new RecordingFilter("c", &looper->log));
	looper->PostMessage('aaaa', &looper->first);
	looper->PostMessage('bbbb', &looper->second);
	looper->PostMessage('cccc');
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ(
		(Log { "c:aaaa", "first:aaaa", "c:bbbb", "second:bbbb", "c:cccc", "l:cccc" }), looper->log);
}


TEST(MessageFilter, ACommonFilterMayNameAnotherTarget)
{
	Running<FilteredLooper> looper;
	looper->Lock();
	BHandler* second = &looper->second;
	auto* filter = new RecordingFilter("c", &looper->log);
	filter->newTarget = &second;
	looper->AddCommonFilter(filter);
	looper->first.AddFilter(new RecordingFilter("h1", &looper->log));
	looper->second.AddFilter(new RecordingFilter("h2", &looper->log));
	looper->PostMessage('aaaa', &looper->first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "c:aaaa", "h2:aaaa", "second:aaaa" }), looper->log);
}


TEST(MessageFilter, TheFiltersOfANewTargetRunToo)
{
	Running<FilteredLooper> looper;
	looper->Lock();
	BHandler* second = &looper->second;
	auto* filter = new RecordingFilter("h1", &looper->log);
	filter->newTarget = &second;
	looper->first.AddFilter(filter);
	looper->second.AddFilter(new RecordingFilter("h2", &looper->log));
	looper->PostMessage('aaaa', &looper->first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "h1:aaaa", "h2:aaaa", "second:aaaa" }), looper->log);
}


TEST(MessageFilter, ATargetMustBeInTheLooper)
{
	DebuggerCatcher catcher;
	Running<FilteredLooper> looper;
	looper->Lock();
	BHandler stranger;
	BHandler* targets[] = { &stranger, NULL };
	auto* filter = new RecordingFilter("c", &looper->log);
	looper->AddCommonFilter(filter);

	for (BHandler* const& target : targets) {
		filter->newTarget = &target;
		looper->log.clear();
		looper->PostMessage('aaaa', &looper->first);
		looper->Unlock();
		looper->Sync();
		looper->Lock();
		EXPECT_EQ((Log { "c:aaaa" }), looper->log);
		EXPECT_TRUE(catcher.TakeOne());
	}
	looper->Unlock();
}


TEST(MessageFilter, MayEditTheMessage)
{
	Running<FilteredLooper> looper;
	looper->Lock();
	looper->AddCommonFilter(
		new BMessageFilter('aaaa', [](BMessage* message, BHandler**, BMessageFilter*) {
			message->what = 'bbbb';
			return B_DISPATCH_MESSAGE;
		}));
	looper->PostMessage('aaaa', &looper->first);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "first:bbbb" }), looper->log);
}


TEST(MessageFilter, AHookIsCalledInsteadOfFilter)
{
	class WithHook : public BMessageFilter {
	public:
		WithHook(filter_hook hook) : BMessageFilter('aaaa', hook) {}
		filter_result Filter(BMessage*, BHandler**) override
		{
			ADD_FAILURE() << "Filter() called";
			return B_DISPATCH_MESSAGE;
		}
	};
	static BMessageFilter* sCalled;
	sCalled = nullptr;
	Running<FilteredLooper> looper;
	looper->Lock();
	auto* filter = new WithHook([](BMessage*, BHandler**, BMessageFilter* filter) {
		sCalled = filter;
		return B_SKIP_MESSAGE;
	});
	looper->AddCommonFilter(filter);
	looper->PostMessage('aaaa', &looper->first);
	looper->Unlock();

	looper->Sync();

	EXPECT_TRUE(looper->log.empty());
	EXPECT_EQ(filter, sCalled);
}


TEST(MessageFilter, PassesWhatItsCriteriaDoNotMatch)
{
	const filter_hook skip = [](BMessage*, BHandler**, BMessageFilter*) { return B_SKIP_MESSAGE; };
	Running<FilteredLooper> looper;
	looper->Lock();
	looper->first.AddFilter(new BMessageFilter('bbbb', skip));
	looper->first.AddFilter(new BMessageFilter(B_DROPPED_DELIVERY, B_ANY_SOURCE, skip));
	looper->first.AddFilter(new BMessageFilter(B_ANY_DELIVERY, B_REMOTE_SOURCE, skip));
	looper->second.AddFilter(new BMessageFilter(B_PROGRAMMED_DELIVERY, B_LOCAL_SOURCE, skip));
	looper->PostMessage('aaaa', &looper->first);
	looper->PostMessage('bbbb', &looper->first);
	looper->PostMessage('cccc', &looper->second);
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "first:aaaa" }), looper->log);
}


TEST(MessageFilter, IsInOneListOnly)
{
	DebuggerCatcher catcher;
	auto* looper = new BLooper;
	BHandler handler;
	auto* filter = new BMessageFilter('aaaa');
	looper->AddCommonFilter(filter);

	handler.AddFilter(filter);
	EXPECT_TRUE(catcher.TakeOne());
	looper->AddCommonFilter(filter);
	EXPECT_TRUE(catcher.TakeOne());
	EXPECT_EQ(1, looper->CommonFilterList()->CountItems());

	EXPECT_TRUE(looper->RemoveCommonFilter(filter));
	EXPECT_FALSE(looper->RemoveCommonFilter(filter));
	handler.AddFilter(filter);
	EXPECT_EQ(nullptr, filter->Looper());
	looper->Quit();
}


TEST(MessageFilter, CommonFiltersAreDeletedWithTheListOrTheLooper)
{
	static int sDeleted;
	sDeleted = 0;
	class Filter : public BMessageFilter {
	public:
		Filter() : BMessageFilter('what') {}
		~Filter() override { sDeleted++; }
	};
	auto* looper = new BLooper;
	EXPECT_EQ(nullptr, looper->CommonFilterList());
	looper->AddCommonFilter(new Filter);
	auto* list = new BList;
	list->AddItem(new Filter);

	looper->SetCommonFilterList(list);
	EXPECT_EQ(1, sDeleted);
	EXPECT_EQ(list, looper->CommonFilterList());

	looper->Quit();
	EXPECT_EQ(2, sDeleted);
}


TEST(MessageFilter, MayRemoveItselfWhileItFilters)
{
	class OneShot : public RecordingFilter {
	public:
		using RecordingFilter::RecordingFilter;
		filter_result Filter(BMessage* message, BHandler** target) override
		{
			const filter_result result = RecordingFilter::Filter(message, target);
			if (message->what == 'aaaa')
				Looper()->RemoveCommonFilter(this);
			return result;
		}
	};
	Running<FilteredLooper> looper;
	looper->Lock();
	const auto filter = std::make_unique<OneShot>("c", &looper->log);
	looper->AddCommonFilter(filter.get());
	looper->PostMessage('aaaa');
	looper->PostMessage('aaaa');
	looper->Unlock();

	looper->Sync();

	EXPECT_EQ((Log { "c:aaaa", "l:aaaa", "l:aaaa" }), looper->log);
}
