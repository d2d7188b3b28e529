// BLocker: a lock that its holder may take again.
#pragma once

#include <OS.h>

// Any thread may use it. Each successful Lock() needs an Unlock() by the same thread. Deleting a
// locker makes the waiting Lock() calls return false.
class BLocker {
public:
	BLocker();
	BLocker(const char* name);
	BLocker(bool benaphoreStyle);
	BLocker(const char* name, bool benaphoreStyle);
	virtual ~BLocker();

	BLocker(const BLocker&) = delete;
	BLocker& operator=(const BLocker&) = delete;

	status_t InitCheck() const;

	bool Lock();
	status_t LockWithTimeout(bigtime_t timeout); // microseconds; B_TIMED_OUT, B_BAD_SEM_ID
	void Unlock(); // by the holder only, else debugger()

	thread_id LockingThread() const; // -1 when nobody holds it
	bool IsLocked() const; // by the calling thread
	int32 CountLocks() const;
	int32 CountLockRequests() const; // holders and waiters, also those that gave up
	sem_id Sem() const;

private:
	status_t _Acquire(bigtime_t timeout);

	sem_id fSem;
	int32 fRequests = 0;
	thread_id fOwner = -1;
	int32 fDepth = 0;
};
