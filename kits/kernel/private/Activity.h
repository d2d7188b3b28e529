// Activity: who still has work to do, so that tests and play scripts can wait for a quiet program.
#pragma once

#include <atomic>

#include <OS.h>

namespace BPrivate {


// One worker of the program: a looper, or the display thread. Work is counted from the moment it
// is queued until it has been carried out. A worker that waits for its user inside a task (a modal
// alert, a menu being tracked) marks itself as waiting and counts as idle meanwhile. Any thread
// may call every function.
class Worker {
public:
	Worker();
	~Worker();
	Worker(const Worker&) = delete;
	Worker& operator=(const Worker&) = delete;

	void AddWork(int32 count = 1);
	void WorkDone(int32 count = 1);

	// Nested calls add up.
	void BeginWaiting();
	void EndWaiting();

	bool IsIdle() const;

private:
	std::atomic<int32> fWork { 0 };
	std::atomic<int32> fWaiting { 0 };
};


// Marks a worker as waiting for the length of a scope. A NULL worker is allowed.
class WaitingScope {
public:
	explicit WaitingScope(Worker* worker);
	~WaitingScope();
	WaitingScope(const WaitingScope&) = delete;
	WaitingScope& operator=(const WaitingScope&) = delete;

private:
	Worker* fWorker; // borrowed
};


// Blocks until no worker has work, or the time (microseconds) is over; returns whether it is quiet.
bool wait_until_idle(bigtime_t timeout = B_INFINITE_TIMEOUT);


} // namespace BPrivate
