#include "kernel/private/Activity.h"

#include <condition_variable>
#include <mutex>

#include "kernel/private/Deadline.h"

namespace BPrivate {

namespace {

struct Board {
	std::mutex lock;
	std::condition_variable quiet;
	int32 busy = 0; // workers that are not idle
};

// Never destroyed: workers may outlive the program's static objects.
Board&
board()
{
	static Board* sBoard = new Board;
	return *sBoard;
}


// Makes a change to one worker's counts and keeps the number of busy workers right.
template<typename Change>
void
change(const Worker& worker, Change makeChange)
{
	std::unique_lock lock(board().lock);
	const bool wasIdle = worker.IsIdle();
	makeChange();
	const bool isIdle = worker.IsIdle();
	if (wasIdle == isIdle)
		return;
	board().busy += isIdle ? -1 : 1;
	if (board().busy == 0)
		board().quiet.notify_all();
}

} // namespace


Worker::Worker()
{
}


Worker::~Worker()
{
	change(*this, [this] { fWork = 0; });
}


void
Worker::AddWork(int32 count)
{
	change(*this, [this, count] { fWork += count; });
}


void
Worker::WorkDone(int32 count)
{
	change(*this, [this, count] { fWork -= count; });
}


void
Worker::BeginWaiting()
{
	change(*this, [this] { fWaiting += 1; });
}


void
Worker::BeginWaiting(int32 knownWork)
{
	change(*this, [this, knownWork] {
		fWaiting += 1;
		fKnownWork = knownWork;
	});
}


void
Worker::EndWaiting()
{
	change(*this, [this] {
		fWaiting -= 1;
		fKnownWork = -1;
	});
}


bool
Worker::IsIdle() const
{
	return fWork <= 0 || (fWaiting > 0 && (fKnownWork < 0 || fWork <= fKnownWork));
}


// #pragma mark -


WaitingScope::WaitingScope(Worker* worker) : fWorker(worker)
{
	if (fWorker != nullptr)
		fWorker->BeginWaiting();
}


WaitingScope::WaitingScope(Worker* worker, int32 knownWork) : fWorker(worker)
{
	if (fWorker != nullptr)
		fWorker->BeginWaiting(knownWork);
}


WaitingScope::~WaitingScope()
{
	if (fWorker != nullptr)
		fWorker->EndWaiting();
}


bool
wait_until_idle(bigtime_t timeout)
{
	const Deadline deadline(B_RELATIVE_TIMEOUT, timeout);
	std::unique_lock lock(board().lock);
	return deadline.Wait(board().quiet, lock, [] { return board().busy == 0; });
}


} // namespace BPrivate
