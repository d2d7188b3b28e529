// AccessLock: many readers or one writer, each able to lock again.
#pragma once

#include <condition_variable>
#include <mutex>
#include <unordered_map>

#include <OS.h>

namespace BResEditor {


// A writer may also read. A reader that asks for writing would wait for itself: that is a mistake
// of the program and stops in the debugger.
class AccessLock {
public:
	void LockForReading();
	void UnlockForReading();

	// False when this thread is reading.
	bool LockForWriting();

	// True when this was the outermost level.
	bool UnlockForWriting();

	// For the thread that writes: how often it has locked.
	int32 WriteDepth() const;

private:
	std::mutex fMutex;
	std::condition_variable fFreed;
	std::unordered_map<thread_id, int32> fReaders; // how often each has locked
	thread_id fWriter = -1;
	int32 fWriteDepth = 0;
	int32 fWaitingWriters = 0;
};


} // namespace BResEditor
