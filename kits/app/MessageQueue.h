// BMessageQueue: messages waiting in the order of their arrival.
#pragma once

#include <deque>
#include <mutex>

#include <Locker.h>
#include <SupportDefs.h>

class BMessage;

namespace BPrivate {
class LooperCore;
}


// The queue owns its messages. Every function locks for itself; hold the lock to look at several
// messages consistently. Any thread.
class _EXPORT BMessageQueue {
public:
	BMessageQueue();
	virtual ~BMessageQueue();
	BMessageQueue(const BMessageQueue&) = delete;
	BMessageQueue& operator=(const BMessageQueue&) = delete;

	void AddMessage(BMessage* message);
	// Takes the message out without deleting it; false when it is not here.
	bool RemoveMessage(BMessage* message);
	// Takes out the oldest message, which then belongs to the caller; NULL when empty.
	BMessage* NextMessage();

	BMessage* FindMessage(int32 index) const;
	// The index-th message with that code.
	BMessage* FindMessage(uint32 what, int32 index = 0) const;
	int32 CountMessages() const;
	bool IsEmpty() const;

	bool Lock();
	void Unlock();

private:
	friend class BPrivate::LooperCore;

	mutable std::recursive_mutex fLock;
	std::deque<BMessage*> fMessages; // owned
	BPrivate::LooperCore* fCore = nullptr; // borrowed; NULL for a queue without a looper
};
