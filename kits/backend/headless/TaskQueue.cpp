#include "backend/headless/TaskQueue.h"

#include <chrono>

namespace BPrivate {


void
TaskQueue::Post(Task task)
{
	{
		std::lock_guard lock(fLock);
		fTasks.push_back(std::move(task));
	}
	fChanged.notify_one();
}


void
TaskQueue::PostLater(bigtime_t delay, Task task)
{
	{
		std::lock_guard lock(fLock);
		fTimed.emplace(system_time() + delay, std::move(task));
	}
	fChanged.notify_one();
}


bool
TaskQueue::RunNext(bigtime_t timeout)
{
	const bool forever = timeout == B_INFINITE_TIMEOUT;
	const bigtime_t end = forever ? B_INFINITE_TIMEOUT : system_time() + timeout;

	Task task;
	std::unique_lock lock(fLock);
	while (!task) {
		const bigtime_t now = system_time();
		const bool due = !fTimed.empty() && fTimed.begin()->first <= now;
		if (due) {
			task = std::move(fTimed.begin()->second);
			fTimed.erase(fTimed.begin());
		} else if (!fTasks.empty()) {
			task = std::move(fTasks.front());
			fTasks.pop_front();
		} else if (now >= end) {
			return false;
		} else if (forever && fTimed.empty()) {
			fChanged.wait(lock);
		} else {
			const bigtime_t next = fTimed.empty() ? end : std::min(end, fTimed.begin()->first);
			fChanged.wait_for(lock, std::chrono::microseconds(next - now));
		}
	}
	lock.unlock();
	task();
	return true;
}


} // namespace BPrivate
