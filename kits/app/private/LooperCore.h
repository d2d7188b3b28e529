// LooperCore: the lock and the queue of a looper, which outlive it for those who still use them.
#pragma once

#include <atomic>
#include <condition_variable>
#include <functional>
#include <list>
#include <memory>
#include <mutex>
#include <vector>

#include <MessageQueue.h>
#include <Messenger.h>
#include <OS.h>

#include "app/private/Port.h"
#include "kernel/private/Activity.h"

class BLooper;
class BWindow;

namespace BPrivate {


// Shared by the looper, the port table and everyone who is just locking or posting. Any thread.
class LooperCore final : public Port {
public:
	LooperCore(BLooper* looper, int32 capacity);
	~LooperCore() override;

	// The lock: recursive, granted in the order of the requests. B_BAD_PORT_ID when the looper
	// is gone, B_TIMED_OUT.
	status_t Lock(bigtime_t timeout);
	void Unlock();
	void UnlockAll();
	bool IsLockedByCaller() const;
	thread_id Owner() const { return fOwner.load(std::memory_order_relaxed); }
	int32 CountLocks() const { return fLockCount.load(std::memory_order_relaxed); }
	int32 CountRequests() const;

	status_t Receive(std::unique_ptr<BMessage> message, bigtime_t timeout) override;
	// Without regard to the capacity; false when the looper is gone.
	bool Put(std::unique_ptr<BMessage> message, bool ahead);
	void RequestUpdate();
	bool CancelUpdate();
	BMessage* TakeMatching(const std::function<bool(const BMessage&)>& wanted);
	bool WaitForArrival(bigtime_t timeout);

	// For the loop: waits, takes the first one, and tells that its work is done.
	void WaitForMessage();
	BMessage* Take();
	void WorkDone();
	// From the start of the loop on, waiting messages count as work of the program.
	void BeginLoop(thread_id thread);
	// The same thread, before its first message.
	void EnterLoop();
	void EndLoop();

	// Nothing arrives and nobody gets the lock any more; the waiting messages are deleted.
	void Die();
	// A looper that waits here counts as idle: this one may be waiting for its user.
	void WaitUntilDead();

	// Whose loop the calling thread runs; NULL for none.
	static LooperCore* OfThisThread();

	BMessageQueue& Queue() { return fQueue; }
	Worker& Activity() { return fWorker; }
	bool IsLooping() const { return fThread.load() >= 0; }
	thread_id Thread() const { return fThread.load(); }
	BLooper* Looper() const { return fLooper.load(); } // NULL when it is gone
	int32 Capacity() const { return fCapacity; }
	int32 PortId() const { return fPortId; }
	int32 OwnToken() const { return fOwnToken; }
	BMessenger OwnMessenger() const; // to the looper itself
	void SetAddress(int32 portId, int32 ownToken);
	void MarkAsWindow() { fIsWindow = true; }
	bool IsWindow() const { return fIsWindow; }

private:
	friend class ::BMessageQueue;

	struct Waiter;

	void _EndMourning();
	// The queue's lock is held.
	void _Added();
	void _Removed(uint32 what);

	// The lock.
	mutable std::mutex fMutex;
	std::condition_variable fDead;
	std::list<Waiter*> fWaiters; // on their threads' stacks
	std::vector<Worker*> fMourners; // loopers that wait for the death of this one
	std::atomic<thread_id> fOwner { -1 };
	std::atomic<int32> fLockCount { 0 };
	bool fDying = false;
	bool fGone = false;

	// The queue; its own lock protects the rest.
	BMessageQueue fQueue;
	std::condition_variable_any fArrived;
	std::condition_variable_any fRoom;
	uint64 fArrivals = 0;
	int32 fInPort = 0; // arrived since the loop last took a message
	bool fUpdateWaits = false;
	bool fClosed = false;
	bool fCounting = false;
	int32 fInWork = 0; // taken by the loop, not done yet

	std::atomic<BLooper*> fLooper;
	const int32 fCapacity;
	int32 fPortId = -1;
	int32 fOwnToken = -1;
	std::atomic<bool> fIsWindow { false };
	std::atomic<thread_id> fThread { -1 };
	Worker fWorker;
};


// Every living looper, found by its address even if that is stale. Any thread.
class LooperTable {
public:
	static void Add(BLooper* looper, std::shared_ptr<LooperCore> core);
	static void Remove(BLooper* looper);
	static std::shared_ptr<LooperCore> Find(const BLooper* looper); // NULL when it is gone
	static BLooper* FindByThread(thread_id thread);

	static int32 CountLoopers();
	static BLooper* LooperAt(int32 index);

	// The windows of the application, in the order of their first showing.
	static void AddWindow(BLooper* looper, BWindow* window);
	static int32 CountWindows();
	static BWindow* WindowAt(int32 index);
	static BMessenger WindowMessenger(int32 index); // invalid when there is none
	// The first window that is not among those; NULL when there is none.
	static std::shared_ptr<LooperCore> NextWindow(
		const std::vector<std::shared_ptr<LooperCore>>& known);
	// Those that were never shown, too.
	static std::vector<std::shared_ptr<LooperCore>> AllWindows();
};


} // namespace BPrivate
