#include <atomic>
#include <vector>

#include <gtest/gtest.h>

#include <OS.h>

namespace {

struct Waiter {
	sem_id sem;
	int32 count;
	status_t result = 1;

	static status_t Run(void* data)
	{
		auto* waiter = static_cast<Waiter*>(data);
		return acquire_sem_etc(waiter->sem, waiter->count, 0, 0);
	}
};


// Returns when so many are lacking, that is, when the waiters have queued up.
void
wait_for_count(sem_id sem, int32 wanted)
{
	int32 count;
	while (get_sem_count(sem, &count) == B_OK && count != wanted)
		snooze(100);
}

} // namespace


TEST(Semaphore, CountsWhatIsTakenAndGiven)
{
	const sem_id sem = create_sem(2, "two");
	ASSERT_LT(0, sem);
	EXPECT_EQ(B_OK, acquire_sem(sem));
	EXPECT_EQ(B_OK, acquire_sem(sem));
	EXPECT_EQ(B_WOULD_BLOCK, acquire_sem_etc(sem, 1, B_RELATIVE_TIMEOUT, 0));
	EXPECT_EQ(B_TIMED_OUT, acquire_sem_etc(sem, 1, B_RELATIVE_TIMEOUT, 1000));
	EXPECT_EQ(B_TIMED_OUT, acquire_sem_etc(sem, 1, B_ABSOLUTE_TIMEOUT, system_time() + 1000));
	EXPECT_EQ(B_OK, release_sem_etc(sem, 3, 0));
	int32 count = 0;
	EXPECT_EQ(B_OK, get_sem_count(sem, &count));
	EXPECT_EQ(3, count);
	sem_info info;
	EXPECT_EQ(B_OK, get_sem_info(sem, &info));
	EXPECT_STREQ("two", info.name);
	EXPECT_EQ(find_thread(nullptr), info.latest_holder);
	EXPECT_EQ(B_OK, delete_sem(sem));
	EXPECT_EQ(B_BAD_SEM_ID, delete_sem(sem));
	EXPECT_EQ(B_BAD_SEM_ID, acquire_sem(sem));
	EXPECT_EQ(B_BAD_SEM_ID, release_sem(sem));
	EXPECT_EQ(B_BAD_VALUE, create_sem(-1, "bad"));
}


TEST(Semaphore, ServesWaitersInTheirOrder)
{
	const sem_id sem = create_sem(0, "order");
	Waiter first { sem, 2 };
	Waiter second { sem, 1 };
	const thread_id firstThread = spawn_thread(Waiter::Run, "first", 10, &first);
	resume_thread(firstThread);
	wait_for_count(sem, -2);
	const thread_id secondThread = spawn_thread(Waiter::Run, "second", 10, &second);
	resume_thread(secondThread);
	wait_for_count(sem, -3);

	// One is not enough for the first, and the second has to wait behind it.
	release_sem(sem);
	int32 count;
	get_sem_count(sem, &count);
	EXPECT_EQ(-2, count);
	release_sem_etc(sem, 2, 0);
	status_t result = 1;
	EXPECT_EQ(B_OK, wait_for_thread(firstThread, &result));
	EXPECT_EQ(B_OK, result);
	EXPECT_EQ(B_OK, wait_for_thread(secondThread, &result));
	EXPECT_EQ(B_OK, result);
	delete_sem(sem);
}


TEST(Semaphore, ItsEndWakesTheWaiters)
{
	const sem_id sem = create_sem(0, "doomed");
	Waiter waiter { sem, 1 };
	const thread_id thread = spawn_thread(Waiter::Run, "waiter", 10, &waiter);
	resume_thread(thread);
	wait_for_count(sem, -1);
	EXPECT_EQ(B_OK, delete_sem(sem));
	status_t result = B_OK;
	EXPECT_EQ(B_OK, wait_for_thread(thread, &result));
	EXPECT_EQ(B_BAD_SEM_ID, result);
}


TEST(Semaphore, ReleasesAllWhoWait)
{
	const sem_id sem = create_sem(0, "gate");
	std::vector<Waiter> waiters(3, Waiter { sem, 1 });
	std::vector<thread_id> threads;
	for (Waiter& waiter : waiters) {
		threads.push_back(spawn_thread(Waiter::Run, "waiter", 10, &waiter));
		resume_thread(threads.back());
	}
	wait_for_count(sem, -3);
	EXPECT_EQ(B_OK, release_sem_etc(sem, 0, B_RELEASE_ALL));
	for (thread_id thread : threads) {
		status_t result = 1;
		wait_for_thread(thread, &result);
		EXPECT_EQ(B_OK, result);
	}
	int32 count = 1;
	get_sem_count(sem, &count);
	EXPECT_EQ(0, count);
	delete_sem(sem);
}


TEST(Semaphore, IsAmongThoseOfTheTeam)
{
	const sem_id id = create_sem(3, "listed");
	sem_info info;
	bool found = false;
	for (int32 cookie = 0; get_next_sem_info(B_CURRENT_TEAM, &cookie, &info) == B_OK;)
		found |= info.sem == id && info.count == 3;
	EXPECT_TRUE(found);
	int32 cookie = 0;
	EXPECT_EQ(B_BAD_TEAM_ID, get_next_sem_info(-5, &cookie, &info));
	EXPECT_EQ(B_OK, set_sem_owner(id, B_CURRENT_TEAM));
	delete_sem(id);
	EXPECT_EQ(B_BAD_SEM_ID, set_sem_owner(id, B_CURRENT_TEAM));
}
