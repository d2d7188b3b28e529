// TaskQueue: what a display thread has to do, in the order of its posting or at a time.
#pragma once

#include <condition_variable>
#include <deque>
#include <functional>
#include <map>
#include <mutex>

#include <OS.h>

namespace BPrivate {


class TaskQueue {
public:
	using Task = std::function<void()>;

	void Post(Task task); // any thread
	void PostLater(bigtime_t delay, Task task); // any thread

	// Waits for the next task that is due and runs it; false when none was due within the time.
	bool RunNext(bigtime_t timeout);

private:
	std::mutex fLock;
	std::condition_variable fChanged;
	std::deque<Task> fTasks;
	std::multimap<bigtime_t, Task> fTimed; // by system_time()
};


} // namespace BPrivate
