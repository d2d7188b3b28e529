#include <Autolock.h>

#include <Looper.h>


BAutolock::BAutolock(BLooper* looper) : fLooper(looper)
{
	Lock();
}


BAutolock::BAutolock(BLocker* locker) : fLocker(locker)
{
	Lock();
}


BAutolock::BAutolock(BLocker& locker) : fLocker(&locker)
{
	Lock();
}


BAutolock::~BAutolock()
{
	Unlock();
}


bool
BAutolock::IsLocked()
{
	return fIsLocked;
}


bool
BAutolock::Lock()
{
	if (!fIsLocked) {
		if (fLooper != nullptr)
			fIsLocked = fLooper->Lock();
		else
			fIsLocked = fLocker != nullptr && fLocker->Lock();
	}
	return fIsLocked;
}


void
BAutolock::Unlock()
{
	if (!fIsLocked)
		return;
	fIsLocked = false;
	if (fLooper != nullptr)
		fLooper->Unlock();
	else
		fLocker->Unlock();
}
