// BAutolock: holds a lock for a scope.
#pragma once

#include <Locker.h>

class BLooper;

class BAutolock {
public:
	BAutolock(BLooper* looper);
	BAutolock(BLocker* locker);
	BAutolock(BLocker& locker);
	~BAutolock();

	BAutolock(const BAutolock&) = delete;
	BAutolock& operator=(const BAutolock&) = delete;

	bool IsLocked(); // whether the lock was taken
	bool Lock();
	void Unlock();

private:
	BLocker* fLocker = nullptr; // borrowed
	BLooper* fLooper = nullptr; // borrowed
	bool fIsLocked = false;
};
