#include <Locker.h>

// A thread that finds the lock free never enters the semaphore: the count of requests says whether
// somebody holds or wants it. What the holder wrote is seen by the next one through that count, or
// through the semaphore.


BLocker::BLocker() : BLocker("some BLocker", true)
{
}


BLocker::BLocker(const char* name) : BLocker(name, true)
{
}


BLocker::BLocker(bool benaphoreStyle) : BLocker("some BLocker", benaphoreStyle)
{
}


BLocker::BLocker(const char* name, bool benaphoreStyle) : fSem(create_sem(0, name))
{
	// A lock in semaphore style is one that always looks wanted.
	if (!benaphoreStyle) {
		fRequests = 1;
		release_sem(fSem);
	}
}


BLocker::~BLocker()
{
	delete_sem(fSem);
}


status_t
BLocker::InitCheck() const
{
	return fSem >= 0 ? B_OK : fSem;
}


bool
BLocker::Lock()
{
	return _Acquire(B_INFINITE_TIMEOUT) == B_OK;
}


status_t
BLocker::LockWithTimeout(bigtime_t timeout)
{
	return _Acquire(timeout);
}


void
BLocker::Unlock()
{
	if (!IsLocked()) {
		debugger("BLocker::Unlock() called by a thread that does not hold the lock");
		return;
	}

	if (--fDepth > 0)
		return;
	__atomic_store_n(&fOwner, -1, __ATOMIC_RELAXED);
	if (atomic_add(&fRequests, -1) > 1)
		release_sem(fSem);
}


thread_id
BLocker::LockingThread() const
{
	return __atomic_load_n(&fOwner, __ATOMIC_RELAXED);
}


bool
BLocker::IsLocked() const
{
	return LockingThread() == find_thread(nullptr);
}


int32
BLocker::CountLocks() const
{
	return __atomic_load_n(&fDepth, __ATOMIC_RELAXED);
}


int32
BLocker::CountLockRequests() const
{
	return __atomic_load_n(&fRequests, __ATOMIC_RELAXED);
}


sem_id
BLocker::Sem() const
{
	return fSem;
}


status_t
BLocker::_Acquire(bigtime_t timeout)
{
	if (IsLocked()) {
		__atomic_store_n(&fDepth, fDepth + 1, __ATOMIC_RELAXED);
		return B_OK;
	}

	if (atomic_add(&fRequests, 1) > 0) {
		const status_t status = acquire_sem_etc(fSem, 1, B_RELATIVE_TIMEOUT, timeout);
		if (status != B_OK) {
			// The request stays counted, or the holder's release would be one too many. From then
			// on every lock goes through the semaphore, which is right, only slower.
			return status == B_WOULD_BLOCK ? B_TIMED_OUT : status;
		}
	}
	__atomic_store_n(&fOwner, find_thread(nullptr), __ATOMIC_RELAXED);
	__atomic_store_n(&fDepth, 1, __ATOMIC_RELAXED);
	return B_OK;
}
