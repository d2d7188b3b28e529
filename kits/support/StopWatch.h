// BStopWatch: measures a stretch of time and prints it.
#pragma once

#include <OS.h>

// The destructor prints the time and the laps on standard output, unless it is silent.
class BStopWatch {
public:
	BStopWatch(const char* name, bool silent = false);
	virtual ~BStopWatch();

	void Suspend();
	void Resume();
	bigtime_t Lap(); // microseconds so far, 0 when suspended; ten laps are kept
	bigtime_t ElapsedTime() const; // without the time it was suspended
	void Reset();
	const char* Name() const;

private:
	enum { kMaxLaps = 10 };

	bigtime_t fStart;
	bigtime_t fSuspended = 0; // when it was suspended, 0 while it runs
	bigtime_t fLaps[kMaxLaps];
	int32 fLapCount = 0;
	const char* fName; // borrowed
	bool fSilent;
};
