#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Autolock.h>
#include <Locker.h>

#include "kernel/private/Debugger.h"

namespace {

struct Shared {
	BLocker lock { "counter" };
	int32 counter = 0;

	static status_t Count(void* data)
	{
		auto* shared = static_cast<Shared*>(data);
		for (int i = 0; i < 5000; i++) {
			BAutolock outer(shared->lock);
			BAutolock inner(shared->lock);
			shared->counter++;
		}
		return B_OK;
	}
};

} // namespace


TEST(Locker, CanBeTakenAgainByItsHolder)
{
	BLocker lock("a lock");
	EXPECT_EQ(B_OK, lock.InitCheck());
	EXPECT_FALSE(lock.IsLocked());
	EXPECT_TRUE(lock.Lock());
	EXPECT_EQ(B_OK, lock.LockWithTimeout(0));
	EXPECT_EQ(2, lock.CountLocks());
	EXPECT_EQ(find_thread(nullptr), lock.LockingThread());
	lock.Unlock();
	EXPECT_TRUE(lock.IsLocked());
	lock.Unlock();
	EXPECT_FALSE(lock.IsLocked());
	EXPECT_EQ(-1, lock.LockingThread());
}


TEST(Locker, LetsOneThreadInAtATime)
{
	Shared shared;
	std::vector<thread_id> threads;
	for (int i = 0; i < 4; i++) {
		threads.push_back(spawn_thread(Shared::Count, "counter", 10, &shared));
		resume_thread(threads.back());
	}
	for (thread_id thread : threads) {
		status_t result;
		wait_for_thread(thread, &result);
	}
	EXPECT_EQ(20000, shared.counter);
}


TEST(Locker, GivesUpAfterItsTimeAndStaysRight)
{
	BLocker lock("busy");
	ASSERT_TRUE(lock.Lock());
	const auto try_it = [](void* data) -> status_t {
		auto* busy = static_cast<BLocker*>(data);
		const status_t status = busy->LockWithTimeout(1000);
		if (status == B_OK)
			busy->Unlock();
		return status;
	};
	status_t result = B_OK;
	wait_for_thread(spawn_thread(try_it, "impatient", 10, &lock), &result);
	EXPECT_EQ(B_TIMED_OUT, result);
	lock.Unlock();
	wait_for_thread(spawn_thread(try_it, "impatient", 10, &lock), &result);
	EXPECT_EQ(B_OK, result);
	ASSERT_TRUE(lock.Lock());
	wait_for_thread(spawn_thread(try_it, "impatient", 10, &lock), &result);
	EXPECT_EQ(B_TIMED_OUT, result);
	lock.Unlock();
}


TEST(Locker, IsUnlockedByItsHolderOnly)
{
	static std::string sText;
	sText.clear();
	const auto old = BPrivate::set_debugger_hook([](const char* text) { sText = text; });
	BLocker lock("mine");
	lock.Unlock();
	BPrivate::set_debugger_hook(old);
	EXPECT_NE(std::string::npos, sText.find("does not hold the lock"));
}


TEST(Autolock, HoldsTheLockForItsScope)
{
	BLocker lock;
	{
		BAutolock locked(lock);
		EXPECT_TRUE(locked.IsLocked());
		EXPECT_TRUE(lock.IsLocked());
		locked.Unlock();
		EXPECT_FALSE(lock.IsLocked());
		EXPECT_TRUE(locked.Lock());
	}
	EXPECT_FALSE(lock.IsLocked());
	BAutolock none(static_cast<BLocker*>(nullptr));
	EXPECT_FALSE(none.IsLocked());
}
