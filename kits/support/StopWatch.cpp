#include <StopWatch.h>

#include <cstdio>


BStopWatch::BStopWatch(const char* name, bool silent) :
	fStart(system_time()), fName(name != nullptr ? name : ""), fSilent(silent)
{
}


BStopWatch::~BStopWatch()
{
	if (fSilent)
		return;
	printf("StopWatch \"%s\": %lld usecs.\n", fName, static_cast<long long>(ElapsedTime()));
	bigtime_t last = fStart;
	for (int32 i = 0; i < fLapCount; i++) {
		printf("   [%d: %lld#%lld]\n", int(i + 1), static_cast<long long>(fLaps[i] - fStart),
			static_cast<long long>(fLaps[i] - last));
		last = fLaps[i];
	}
}


void
BStopWatch::Suspend()
{
	if (fSuspended == 0)
		fSuspended = system_time();
}


void
BStopWatch::Resume()
{
	if (fSuspended == 0)
		return;
	fStart += system_time() - fSuspended;
	fSuspended = 0;
}


bigtime_t
BStopWatch::Lap()
{
	if (fSuspended != 0)
		return 0;
	const bigtime_t now = system_time();
	if (fLapCount < kMaxLaps)
		fLaps[fLapCount++] = now;
	else
		fLaps[kMaxLaps - 1] = now;
	return now - fStart;
}


bigtime_t
BStopWatch::ElapsedTime() const
{
	return (fSuspended != 0 ? fSuspended : system_time()) - fStart;
}


void
BStopWatch::Reset()
{
	fStart = system_time();
	fSuspended = 0;
	fLapCount = 0;
}


const char*
BStopWatch::Name() const
{
	return fName;
}
