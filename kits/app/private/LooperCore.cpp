#include "app/private/LooperCore.h"

#include <algorithm>
#include <chrono>
#include <unistd.h>
#include <unordered_map>
#include <vector>

#include <AppDefs.h>
#include <Message.h>

#include "app/private/Delivery.h"
#include "app/private/MessengerPrivate.h"

namespace BPrivate {
namespace {

thread_id
ThisThread()
{
	static thread_local const thread_id sThread = find_thread(NULL);
	return sThread;
}

// Of the looper whose loop this thread runs.
thread_local LooperCore* sLoop = nullptr;

// Waits on a condition with the platform's relative timeout; false when the time is over.
template<typename Condition, typename Lock, typename Predicate>
bool
WaitFor(Condition& condition, Lock& lock, bigtime_t timeout, Predicate done)
{
	// Longer than a century is for ever, and would overflow the clock.
	if (timeout > bigtime_t(1) << 51) {
		condition.wait(lock, done);
		return true;
	}
	return condition.wait_for(
		lock, std::chrono::microseconds(std::max<bigtime_t>(timeout, 0)), done);
}

} // namespace


struct LooperCore::Waiter {
	explicit Waiter(thread_id who) : thread(who) {}

	const thread_id thread;
	bool granted = false;
	std::condition_variable wake;
};


LooperCore::LooperCore(BLooper* looper, int32 capacity) :
	fLooper(looper), fCapacity(std::max<int32>(capacity, 1))
{
	fQueue.fCore = this;
}


LooperCore::~LooperCore()
{
	fQueue.fCore = nullptr;
}


void
LooperCore::SetAddress(int32 portId, int32 ownToken)
{
	fPortId = portId;
	fOwnToken = ownToken;
}


BMessenger
LooperCore::OwnMessenger() const
{
	return MessengerPrivate::Make(fPortId, fOwnToken, getpid());
}


// #pragma mark - lock


status_t
LooperCore::Lock(bigtime_t timeout)
{
	const thread_id self = ThisThread();
	if (fOwner.load(std::memory_order_relaxed) == self) {
		fLockCount.fetch_add(1, std::memory_order_relaxed);
		return B_OK;
	}

	std::unique_lock lock(fMutex);
	if (fGone)
		return B_BAD_PORT_ID;
	if (fOwner < 0) {
		fOwner = self;
		fLockCount = 1;
		return B_OK;
	}

	Waiter waiter(self);
	const auto place = fWaiters.insert(fWaiters.end(), &waiter);
	WaitFor(waiter.wake, lock, timeout, [&] { return waiter.granted || fGone; });
	if (waiter.granted)
		return B_OK;

	fWaiters.erase(place);
	return fGone ? B_BAD_PORT_ID : B_TIMED_OUT;
}


void
LooperCore::Unlock()
{
	if (fLockCount.fetch_sub(1, std::memory_order_relaxed) > 1)
		return;

	std::lock_guard lock(fMutex);
	if (fGone || fWaiters.empty()) {
		fOwner = -1;
		return;
	}

	// The lock goes straight to the next one, or a busy loop would never let anybody in.
	Waiter* next = fWaiters.front();
	fWaiters.pop_front();
	fOwner = next->thread;
	fLockCount = 1;
	next->granted = true;
	next->wake.notify_one();
}


void
LooperCore::UnlockAll()
{
	fLockCount = 1;
	Unlock();
}


bool
LooperCore::IsLockedByCaller() const
{
	return fOwner.load(std::memory_order_relaxed) == ThisThread();
}


int32
LooperCore::CountRequests() const
{
	std::lock_guard lock(fMutex);
	return int32(fWaiters.size()) + (fOwner >= 0 ? 1 : 0);
}


// #pragma mark - queue


void
LooperCore::_Added()
{
	fArrivals++;
	if (fCounting)
		fWorker.AddWork();
	fArrived.notify_all();
}


void
LooperCore::_Removed(uint32 what)
{
	if (what == _UPDATE_)
		fUpdateWaits = false;
	if (fCounting)
		fWorker.WorkDone();
}


status_t
LooperCore::Receive(std::unique_ptr<BMessage> message, bigtime_t timeout)
{
	std::unique_lock lock(fQueue.fLock);
	if (fClosed)
		return B_BAD_PORT_ID;

	// Who keeps the loop from emptying its port, or runs a loop that others may wait for, must not
	// wait here for ever: the two would never go on.
	const bool mayWait = timeout != B_INFINITE_TIMEOUT || (!IsLockedByCaller() && sLoop == nullptr);
	if (fInPort >= fCapacity && mayWait) {
		if (timeout <= 0)
			return B_WOULD_BLOCK;
		if (!WaitFor(fRoom, lock, timeout, [&] { return fInPort < fCapacity || fClosed; }))
			return B_TIMED_OUT;
		if (fClosed)
			return B_BAD_PORT_ID;
	}

	fInPort++;
	fQueue.fMessages.push_back(message.release());
	_Added();
	return B_OK;
}


bool
LooperCore::Put(std::unique_ptr<BMessage> message, bool ahead)
{
	std::unique_lock lock(fQueue.fLock);
	if (fClosed) {
		// Deleting it may answer its sender, which takes other locks.
		lock.unlock();
		return false;
	}
	if (ahead)
		fQueue.fMessages.push_front(message.release());
	else
		fQueue.fMessages.push_back(message.release());
	_Added();
	return true;
}


void
LooperCore::RequestUpdate()
{
	std::unique_lock lock(fQueue.fLock);
	if (fUpdateWaits || fClosed)
		return;

	fUpdateWaits = true;
	auto* message = new BMessage(_UPDATE_);
	Delivery::Of(*message).target = fOwnToken;
	fQueue.fMessages.push_front(message);
	_Added();
}


bool
LooperCore::CancelUpdate()
{
	std::unique_lock lock(fQueue.fLock);
	if (!fUpdateWaits)
		return false;
	delete TakeMatching([](const BMessage& message) { return message.what == _UPDATE_; });
	return true;
}


BMessage*
LooperCore::TakeMatching(const std::function<bool(const BMessage&)>& wanted)
{
	std::unique_lock lock(fQueue.fLock);
	auto& messages = fQueue.fMessages;
	for (auto i = messages.begin(); i != messages.end(); ++i) {
		if (!wanted(**i))
			continue;

		BMessage* message = *i;
		messages.erase(i);
		_Removed(message->what);
		return message;
	}
	return nullptr;
}


bool
LooperCore::WaitForArrival(bigtime_t timeout)
{
	std::unique_lock lock(fQueue.fLock);
	const uint64 before = fArrivals;
	return WaitFor(fArrived, lock, timeout, [&] { return fArrivals != before; });
}


// #pragma mark - loop


void
LooperCore::WaitForMessage()
{
	std::unique_lock lock(fQueue.fLock);
	fArrived.wait(lock, [&] { return !fQueue.fMessages.empty(); });
}


BMessage*
LooperCore::Take()
{
	std::unique_lock lock(fQueue.fLock);
	if (fQueue.fMessages.empty())
		return nullptr;

	BMessage* message = fQueue.fMessages.front();
	fQueue.fMessages.pop_front();
	if (message->what == _UPDATE_)
		fUpdateWaits = false;

	// The loop has moved everything from the port into the queue.
	fInPort = 0;
	fRoom.notify_all();
	fInWork++;
	return message;
}


void
LooperCore::WorkDone()
{
	std::unique_lock lock(fQueue.fLock);
	if (fInWork == 0)
		return;
	fInWork--;
	fWorker.WorkDone();
}


void
LooperCore::BeginLoop(thread_id thread)
{
	std::unique_lock lock(fQueue.fLock);
	fThread = thread;
	fCounting = true;
	fWorker.AddWork(int32(fQueue.fMessages.size()));
	if (thread == ThisThread())
		sLoop = this;
}


void
LooperCore::EnterLoop()
{
	sLoop = this;
}


void
LooperCore::EndLoop()
{
	std::unique_lock lock(fQueue.fLock);
	sLoop = nullptr;
	if (fCounting)
		fWorker.WorkDone(int32(fQueue.fMessages.size()) + fInWork);
	fCounting = false;
	fInWork = 0;
	fThread = -1;
}


void
LooperCore::Die()
{
	if (sLoop == this)
		sLoop = nullptr;
	_EndMourning();

	std::deque<BMessage*> left;
	{
		std::unique_lock lock(fQueue.fLock);
		fClosed = true;
		left.swap(fQueue.fMessages);
		fRoom.notify_all();
		fArrived.notify_all();
	}
	// Deleted without the lock: a sender that waits is answered now. It is work until then.
	for (BMessage* message : left)
		delete message;
	{
		std::unique_lock lock(fQueue.fLock);
		if (fCounting)
			fWorker.WorkDone(int32(left.size()) + fInWork);
		fCounting = false;
		fInWork = 0;
	}

	std::unique_lock lock(fMutex);
	fGone = true;
	fLooper = nullptr;
	fOwner = -1;
	fLockCount = 0;
	for (Waiter* waiter : fWaiters)
		waiter->wake.notify_one();
	fDead.notify_all();
}


void
LooperCore::WaitUntilDead()
{
	std::unique_lock lock(fMutex);
	if (fGone)
		return;

	Worker* self = sLoop != nullptr ? &sLoop->fWorker : nullptr;
	if (self != nullptr && !fDying) {
		self->BeginWaiting();
		fMourners.push_back(self);
	}
	fDead.wait(lock, [&] { return fGone; });
	if (self != nullptr && std::erase(fMourners, self) > 0)
		self->EndWaiting();
}


// Those who wait have work again before the last of ours is done, so the program is not taken for
// idle in between.
void
LooperCore::_EndMourning()
{
	std::unique_lock lock(fMutex);
	fDying = true;
	for (Worker* worker : fMourners)
		worker->EndWaiting();
	fMourners.clear();
}


LooperCore*
LooperCore::OfThisThread()
{
	return sLoop;
}


} // namespace BPrivate
