#include <atomic>
#include <cstring>

#include <gtest/gtest.h>

#include <OS.h>

namespace {

status_t
double_it(void* data)
{
	return *static_cast<int32*>(data) * 2;
}

} // namespace


TEST(Thread, SleepsUntilResumedAndGivesItsResult)
{
	static std::atomic<bool> sRan;
	sRan = false;
	const thread_id id = spawn_thread(
		[](void*) -> status_t {
			sRan = true;
			return 7;
		},
		"a thread", B_NORMAL_PRIORITY, nullptr);
	ASSERT_LT(0, id);
	thread_info info;
	ASSERT_EQ(B_OK, get_thread_info(id, &info));
	EXPECT_STREQ("a thread", info.name);
	EXPECT_EQ(B_THREAD_SUSPENDED, info.state);
	EXPECT_EQ(B_NORMAL_PRIORITY, info.priority);
	EXPECT_FALSE(sRan);

	EXPECT_EQ(B_OK, resume_thread(id));
	EXPECT_EQ(B_BAD_THREAD_STATE, resume_thread(id));
	status_t result = 0;
	EXPECT_EQ(B_OK, wait_for_thread(id, &result));
	EXPECT_EQ(7, result);
	EXPECT_TRUE(sRan);
}


TEST(Thread, IsResumedByWaitingAndRemembersItsResult)
{
	int32 number = 21;
	const thread_id id = spawn_thread(double_it, "double", B_NORMAL_PRIORITY, &number);
	status_t result = 0;
	EXPECT_EQ(B_OK, wait_for_thread(id, &result));
	EXPECT_EQ(42, result);
	result = 0;
	EXPECT_EQ(B_OK, wait_for_thread(id, &result));
	EXPECT_EQ(42, result);
	thread_info info;
	EXPECT_EQ(B_BAD_THREAD_ID, get_thread_info(id, &info));
	EXPECT_EQ(B_BAD_THREAD_ID, wait_for_thread(-5, &result));
	EXPECT_EQ(B_BAD_THREAD_ID, wait_for_thread(find_thread(nullptr), &result));
}


TEST(Thread, CanLeaveFromAnywhereAndCallsItsCallbacks)
{
	static std::atomic<int32> sCalls;
	static int32 sFive = 5;
	sCalls = 0;
	const thread_id id = spawn_thread(
		[](void*) -> status_t {
			on_exit_thread([](void* data) { sCalls += *static_cast<int32*>(data); }, &sFive);
			exit_thread(11);
			return 1;
		},
		"leaver", B_LOW_PRIORITY, nullptr);
	status_t result = 0;
	EXPECT_EQ(B_OK, wait_for_thread(id, &result));
	EXPECT_EQ(11, result);
	EXPECT_EQ(5, sCalls);
}


TEST(Thread, KnowsItselfAndCanBeFoundByName)
{
	const thread_id self = find_thread(nullptr);
	EXPECT_LT(0, self);
	EXPECT_EQ(self, find_thread(nullptr));
	EXPECT_EQ(B_OK, rename_thread(self, "main of the test"));
	EXPECT_EQ(self, find_thread("main of the test"));
	EXPECT_EQ(B_NAME_NOT_FOUND, find_thread("no such thread"));
	EXPECT_EQ(B_BAD_VALUE, rename_thread(self, nullptr));
	const int32 old = set_thread_priority(self, B_DISPLAY_PRIORITY);
	EXPECT_EQ(B_DISPLAY_PRIORITY, set_thread_priority(self, old));
}


TEST(Thread, ReceivesDataThatWasSentBeforeItRan)
{
	const thread_id self = find_thread(nullptr);
	const thread_id id = spawn_thread(
		[](void* data) -> status_t {
			char text[8] = "";
			thread_id sender = -1;
			const int32 code = receive_data(&sender, text, sizeof(text));
			const bool right = code == 99 && strcmp(text, "hello") == 0
				&& sender == *static_cast<thread_id*>(data) && !has_data(find_thread(nullptr));
			return right ? B_OK : B_ERROR;
		},
		"receiver", B_NORMAL_PRIORITY, const_cast<thread_id*>(&self));
	EXPECT_EQ(B_OK, send_data(id, 99, "hello", 6));
	EXPECT_TRUE(has_data(id));
	status_t result = B_ERROR;
	EXPECT_EQ(B_OK, wait_for_thread(id, &result));
	EXPECT_EQ(B_OK, result);
	EXPECT_EQ(B_BAD_THREAD_ID, send_data(id, 1, "late", 5));
}


TEST(Thread, HasStorageOfItsOwn)
{
	static int32 sSlot;
	sSlot = tls_allocate();
	ASSERT_LE(0, sSlot);
	int32 number = 1;
	tls_set(sSlot, &number);
	const thread_id id =
		spawn_thread([](void*) -> status_t { return tls_get(sSlot) == nullptr ? B_OK : B_ERROR; },
			"other", B_NORMAL_PRIORITY, nullptr);
	status_t result = B_ERROR;
	wait_for_thread(id, &result);
	EXPECT_EQ(B_OK, result);
	EXPECT_EQ(&number, tls_get(sSlot));
	EXPECT_EQ(&number, *tls_address(sSlot));
}


TEST(Time, RunsForwardAndSnoozeTakesAtLeastItsTime)
{
	const bigtime_t start = system_time();
	EXPECT_EQ(B_OK, snooze(2000));
	const bigtime_t end = system_time();
	EXPECT_LE(start + 2000, end);
	EXPECT_EQ(B_OK, snooze_until(end - 1000, B_SYSTEM_TIMEBASE));
	EXPECT_EQ(B_BAD_VALUE, snooze_until(end, 5));
	EXPECT_LT(1600000000u, real_time_clock());
}


TEST(Thread, CanBeKilledBeforeItRuns)
{
	int32 number = 1;
	const thread_id id = spawn_thread(double_it, "unborn", B_NORMAL_PRIORITY, &number);
	EXPECT_EQ(B_OK, kill_thread(id));
	EXPECT_EQ(B_BAD_THREAD_ID, kill_thread(id));
	EXPECT_NE(B_OK, resume_thread(id));
	EXPECT_EQ(B_NOT_ALLOWED, kill_thread(find_thread(nullptr)));
}


TEST(Thread, BelongsToItsTeam)
{
	const thread_id self = find_thread(nullptr);
	thread_info info;
	bool found = false;
	for (int32 cookie = 0; get_next_thread_info(B_CURRENT_TEAM, &cookie, &info) == B_OK;)
		found |= info.thread == self;
	EXPECT_TRUE(found);

	team_info team;
	ASSERT_EQ(B_OK, get_team_info(B_CURRENT_TEAM, &team));
	EXPECT_EQ(info.team, team.team);
	EXPECT_LE(1, team.thread_count);
	EXPECT_LE(1, team.image_count);
	EXPECT_LE(1, team.argc);
	EXPECT_NE('\0', team.args[0]);
	EXPECT_EQ(B_BAD_TEAM_ID, get_team_info(-5, &team));
	int32 cookie = 0;
	EXPECT_EQ(B_OK, get_next_team_info(&cookie, &team));
	EXPECT_EQ(B_BAD_VALUE, get_next_team_info(&cookie, &team));
}
