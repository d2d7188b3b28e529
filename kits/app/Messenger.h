// BMessenger: the address of a handler, and the way to send it messages.
#pragma once

#include <OS.h>
#include <SupportDefs.h>

class BHandler;
class BLooper;
class BMessage;

namespace BPrivate {
class MessengerPrivate;
}


// A small value. It stays safe to use after its target is gone: sending then fails or the message
// vanishes. Any thread.
class _EXPORT BMessenger {
public:
	BMessenger();
	// A handler must be in a looper; without a handler the looper's preferred one is meant.
	BMessenger(const BHandler* handler, const BLooper* looper = NULL, status_t* _result = NULL);
	// The application of that signature, or of that team.
	BMessenger(const char* signature, team_id team = -1, status_t* _result = NULL);
	BMessenger(const BMessenger& other) = default;
	BMessenger& operator=(const BMessenger& other) = default;
	~BMessenger() = default;

	bool IsTargetLocal() const;
	// NULL for the preferred handler of *_looper, and when the target is gone.
	BHandler* Target(BLooper** _looper) const;
	bool LockTarget() const;
	status_t LockTargetWithTimeout(bigtime_t timeout) const;

	// Send a copy. The timeouts are in microseconds and count while the target's port is full.
	status_t SendMessage(uint32 command, BHandler* replyTo = NULL) const;
	status_t SendMessage(
		BMessage* message, BHandler* replyTo = NULL, bigtime_t timeout = B_INFINITE_TIMEOUT) const;
	status_t SendMessage(
		BMessage* message, BMessenger replyTo, bigtime_t timeout = B_INFINITE_TIMEOUT) const;
	// Wait for the answer, which is B_NO_REPLY when the receiver deletes the message unanswered.
	status_t SendMessage(uint32 command, BMessage* reply) const;
	status_t SendMessage(BMessage* message, BMessage* reply,
		bigtime_t deliveryTimeout = B_INFINITE_TIMEOUT,
		bigtime_t replyTimeout = B_INFINITE_TIMEOUT) const;

	// Whether the target's looper exists; says nothing about the handler.
	bool IsValid() const;
	team_id Team() const;
	status_t SetTo(const char* signature, team_id team = -1);
	status_t SetTo(const BHandler* handler, const BLooper* looper = NULL);

	bool operator==(const BMessenger& other) const;
	bool operator!=(const BMessenger& other) const { return !(*this == other); }

private:
	friend class BPrivate::MessengerPrivate;

	int32 fPort = -1;
	int32 fToken = -1;
	team_id fTeam = -1;
};

_EXPORT bool operator<(const BMessenger& a, const BMessenger& b);

// Programs name messages wherever they send them.
#include <Message.h>
