#include <OS.h>

#include <condition_variable>
#include <cstring>
#include <list>
#include <mutex>
#include <string>

#include <unistd.h>

#include "kernel/private/Deadline.h"
#include "kernel/private/Table.h"

using BPrivate::Deadline;
using BPrivate::Table;

namespace {

// One waiting thread. Each has its own condition, so that a release wakes only those that it
// serves, in the order in which they came.
struct Waiter {
	int32 count;
	bool granted = false;
	std::condition_variable changed;
};

struct Semaphore {
	std::mutex lock;
	std::string name;
	int32 count;
	bool deleted = false;
	thread_id latestHolder = -1;
	std::list<Waiter*> waiters;

	void Grant()
	{
		while (!waiters.empty() && waiters.front()->count <= count) {
			Waiter* waiter = waiters.front();
			waiters.pop_front();
			count -= waiter->count;
			waiter->granted = true;
			waiter->changed.notify_one();
		}
	}
};


Table<Semaphore>&
semaphores()
{
	static Table<Semaphore>* sSemaphores = new Table<Semaphore>;
	return *sSemaphores;
}

} // namespace


sem_id
create_sem(int32 count, const char* name)
{
	if (count < 0)
		return B_BAD_VALUE;
	auto semaphore = std::make_shared<Semaphore>();
	semaphore->count = count;
	semaphore->name = std::string(name != nullptr ? name : "").substr(0, B_OS_NAME_LENGTH - 1);
	return semaphores().Add(std::move(semaphore));
}


status_t
delete_sem(sem_id id)
{
	std::shared_ptr<Semaphore> semaphore = semaphores().Remove(id);
	if (semaphore == nullptr)
		return B_BAD_SEM_ID;

	std::unique_lock lock(semaphore->lock);
	semaphore->deleted = true;
	for (Waiter* waiter : semaphore->waiters)
		waiter->changed.notify_one();
	return B_OK;
}


status_t
acquire_sem(sem_id id)
{
	return acquire_sem_etc(id, 1, 0, 0);
}


status_t
acquire_sem_etc(sem_id id, int32 count, uint32 flags, bigtime_t timeout)
{
	if (count < 1)
		return B_BAD_VALUE;
	std::shared_ptr<Semaphore> semaphore = semaphores().Get(id);
	if (semaphore == nullptr)
		return B_BAD_SEM_ID;

	const thread_id holder = find_thread(nullptr);
	std::unique_lock lock(semaphore->lock);
	if (semaphore->deleted)
		return B_BAD_SEM_ID;
	if (semaphore->waiters.empty() && semaphore->count >= count) {
		semaphore->count -= count;
		semaphore->latestHolder = holder;
		return B_OK;
	}

	const Deadline deadline(flags, timeout);
	Waiter waiter { count, false, {} };
	semaphore->waiters.push_back(&waiter);
	deadline.Wait(waiter.changed, lock, [&] { return waiter.granted || semaphore->deleted; });
	if (waiter.granted) {
		semaphore->latestHolder = holder;
		return B_OK;
	}

	semaphore->waiters.remove(&waiter);
	if (semaphore->deleted)
		return B_BAD_SEM_ID;
	// Those behind may want less than was missing here.
	semaphore->Grant();
	return deadline.Error();
}


status_t
release_sem(sem_id id)
{
	return release_sem_etc(id, 1, 0);
}


status_t
release_sem_etc(sem_id id, int32 count, uint32 flags)
{
	std::shared_ptr<Semaphore> semaphore = semaphores().Get(id);
	if (semaphore == nullptr)
		return B_BAD_SEM_ID;

	std::unique_lock lock(semaphore->lock);
	if (semaphore->deleted)
		return B_BAD_SEM_ID;
	if ((flags & B_RELEASE_ALL) != 0) {
		int64 wanted = 0;
		for (Waiter* waiter : semaphore->waiters)
			wanted += waiter->count;
		count = static_cast<int32>(max_c(wanted - semaphore->count, 0));
	} else if (count < 1)
		return B_BAD_VALUE;
	if (semaphore->count > INT32_MAX - count)
		return B_BAD_VALUE;
	semaphore->count += count;
	semaphore->Grant();
	return B_OK;
}


status_t
get_sem_count(sem_id id, int32* _count)
{
	if (_count == nullptr)
		return B_BAD_VALUE;
	std::shared_ptr<Semaphore> semaphore = semaphores().Get(id);
	if (semaphore == nullptr)
		return B_BAD_SEM_ID;

	// Below zero, it counts what the waiting threads lack.
	std::unique_lock lock(semaphore->lock);
	*_count = semaphore->count;
	for (Waiter* waiter : semaphore->waiters)
		*_count -= waiter->count;
	return B_OK;
}


status_t
_get_sem_info(sem_id id, sem_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(sem_info))
		return B_BAD_VALUE;
	std::shared_ptr<Semaphore> semaphore = semaphores().Get(id);
	if (semaphore == nullptr)
		return B_BAD_SEM_ID;

	memset(info, 0, sizeof(*info));
	get_sem_count(id, &info->count);
	std::unique_lock lock(semaphore->lock);
	info->sem = id;
	info->team = getpid();
	strncpy(info->name, semaphore->name.c_str(), B_OS_NAME_LENGTH - 1);
	info->latest_holder = semaphore->latestHolder;
	return B_OK;
}


status_t
_get_next_sem_info(team_id team, int32* cookie, sem_info* info, size_t size)
{
	return BPrivate::NextInfo(semaphores(), team, cookie, info, size, _get_sem_info);
}


status_t
set_sem_owner(sem_id id, team_id team)
{
	if (semaphores().Get(id) == nullptr)
		return B_BAD_SEM_ID;
	return BPrivate::IsOwnTeam(team) ? B_OK : B_BAD_TEAM_ID;
}
