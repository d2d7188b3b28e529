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

	// For who waits for new work itself, and looks for it again and again: work beyond this count
	// makes the worker busy although it waits. The count is taken before the look.
	int32 CountWork() const { return fWork; }
	void BeginWaiting(int32 knownWork);

	bool IsIdle() const;

private:
	std::atomic<int32> fWork { 0 };
	std::atomic<int32> fWaiting { 0 };
	std::atomic<int32> fKnownWork { -1 }; // -1: whatever comes is somebody else's to look at
};


// Marks a worker as waiting for the length of a scope. A NULL worker is allowed.
class WaitingScope {
public:
	explicit WaitingScope(Worker* worker);
	WaitingScope(Worker* worker, int32 knownWork);
	~WaitingScope();
	WaitingScope(const WaitingScope&) = delete;
	WaitingScope& operator=(const WaitingScope&) = delete;

private:
	Worker* fWorker; // borrowed
};


// Blocks until no worker has work, or the time (microseconds) is over; returns whether it is quiet.
bool wait_until_idle(bigtime_t timeout = B_INFINITE_TIMEOUT);


} // namespace BPrivate
