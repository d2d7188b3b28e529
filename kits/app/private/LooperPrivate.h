// LooperPrivate: what the other kits may do to a looper beyond its public calls.
#pragma once

#include <functional>

#include <Looper.h>

class BWindow;

namespace BPrivate {

class Worker;

// A message for no handler in particular: for the preferred one, else for the looper.
constexpr int32 kNoToken = -1;
constexpr int32 kPreferredToken = -2;

class LooperPrivate {
public:
	explicit LooperPrivate(BLooper* looper) : fLooper(looper) {}

	// The looper's entry among the workers; lives as long as the looper.
	BPrivate::Worker& Activity();

	// Puts a message of the system behind those that wait, whatever the port's capacity; any
	// thread, takes the queue's lock only. Its target is the looper, or the preferred handler.
	// Takes ownership. The looper must be alive, as a window is while its ServerWindow exists.
	void PostSystem(BMessage* message, bool toPreferred = false);
	// The same for one handler, which may be gone when its turn comes.
	void PostSystemTo(BMessage* message, const BHandler* handler);
	// The same, ahead of everything that waits.
	void PostAhead(BMessage* message);
	// Queues _UPDATE_ for the looper ahead of everything, unless one is waiting already. Any thread.
	void RequestUpdate();
	// Takes the waiting _UPDATE_ out, as when the update is done at once; false when none waits.
	bool CancelUpdate();

	// Takes the first waiting message out for which the function says so; NULL when there is
	// none. The caller owns it. Walks the queue from the oldest on, with its lock.
	BMessage* TakeMessage(const std::function<bool(const BMessage&)>& wanted);
	// Waits until a message arrives that was not in the queue at the call, or so many
	// microseconds; false when the time is over.
	bool WaitForMessage(bigtime_t timeout);

	// Filters and dispatches in the looper's thread, as the loop does; see BLooper::_Deliver().
	void Deliver(BMessage* message, BHandler* target) { fLooper->_Deliver(message, target); }
	// Whether Run() or Loop() was called, and the loop has not ended.
	bool IsRunning() const;
	bool IsTerminating() const;

	// Told by the window's constructor: the application ends it, if nobody else does.
	void MarkAsWindow();
	// Makes it a window of the application, in the order of these calls, until it is deleted.
	void RegisterWindow(BWindow* window);

	// Every living looper, in the order of their making. Valid until one is deleted; use
	// BMessenger or BLooper::Lock() to reach one safely.
	static int32 CountLoopers();
	static BLooper* LooperAt(int32 index);
	static bool IsAlive(const BLooper* looper);
	static bool IsRunning(const BLooper* looper); // false when it is gone

private:
	BLooper* fLooper; // borrowed
};


} // namespace BPrivate
