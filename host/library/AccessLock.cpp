#include "host/library/AccessLock.h"

namespace BResEditor {


void
AccessLock::LockForReading()
{
	const thread_id self = find_thread(NULL);
	std::unique_lock<std::mutex> guard(fMutex);

	// Whoever is inside already comes in again; others let a waiting writer go first.
	if (fWriter != self && fReaders.find(self) == fReaders.end())
		fFreed.wait(guard, [this] { return fWriter < 0 && fWaitingWriters == 0; });
	fReaders[self]++;
}


void
AccessLock::UnlockForReading()
{
	std::lock_guard<std::mutex> guard(fMutex);
	auto reader = fReaders.find(find_thread(NULL));
	if (reader == fReaders.end()) {
		debugger("a collection is unlocked that was not locked for reading");
		return;
	}
	if (--reader->second == 0) {
		fReaders.erase(reader);
		fFreed.notify_all();
	}
}


bool
AccessLock::LockForWriting()
{
	const thread_id self = find_thread(NULL);
	std::unique_lock<std::mutex> guard(fMutex);
	if (fWriter != self) {
		if (fReaders.find(self) != fReaders.end()) {
			debugger("a collection is locked for writing while it is being read");
			return false;
		}
		fWaitingWriters++;
		fFreed.wait(guard, [this] { return fWriter < 0 && fReaders.empty(); });
		fWaitingWriters--;
		fWriter = self;
	}
	fWriteDepth++;
	return true;
}


bool
AccessLock::UnlockForWriting()
{
	std::lock_guard<std::mutex> guard(fMutex);
	if (fWriter != find_thread(NULL)) {
		debugger("a collection is unlocked that was not locked for writing");
		return false;
	}
	if (--fWriteDepth > 0)
		return false;

	fWriter = -1;
	fFreed.notify_all();
	return true;
}


int32
AccessLock::WriteDepth() const
{
	return fWriteDepth;
}


} // namespace BResEditor
