// Timer: the one thread that sends what message runners ask for.
#pragma once

#include <condition_variable>
#include <memory>
#include <mutex>
#include <set>
#include <unordered_map>

#include <Messenger.h>

class BMessage;

namespace BPrivate {


// Sleeps until the next message is due, and for good while there is none. Any thread.
class Timer {
public:
	static Timer& Get();

	// A number of 0 or more, or an error. The message is copied.
	int32 Add(const BMessenger& target, const BMessage* message, bigtime_t interval, int32 count,
		const BMessenger& replyTo);
	void Remove(int32 id);
	status_t SetInterval(int32 id, bigtime_t interval);
	status_t SetCount(int32 id, int32 count);
	status_t GetInfo(int32 id, bigtime_t* _interval, int32* _count);

private:
	struct Entry {
		BMessenger target;
		BMessenger replyTo;
		std::unique_ptr<BMessage> message;
		bigtime_t interval;
		int32 count; // what is left; below 0 for ever
		bigtime_t due;
	};

	void _Run();
	// Sends what is due now; the lock is held.
	void _SendDue(bigtime_t now);
	bool _Send(Entry& entry);
	void _Forget(int32 id);

	std::mutex fLock;
	std::condition_variable fChanged;
	std::unordered_map<int32, Entry> fEntries;
	std::set<std::pair<bigtime_t, int32>> fSchedule; // when, who
	int32 fNextId = 0;
	bool fRunning = false;
};


} // namespace BPrivate
