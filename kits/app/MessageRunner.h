// BMessageRunner: sends a message again and again, at an interval.
#pragma once

#include <Messenger.h>

class BMessage;


// The message is copied. Deleting the runner ends it; nothing more is sent afterwards.
class _EXPORT BMessageRunner {
public:
	// The interval is in microseconds; a count below 0 means for ever.
	BMessageRunner(
		BMessenger target, const BMessage* message, bigtime_t interval, int32 count = -1);
	BMessageRunner(BMessenger target, const BMessage* message, bigtime_t interval, int32 count,
		BMessenger replyTo);
	virtual ~BMessageRunner();
	BMessageRunner(const BMessageRunner&) = delete;
	BMessageRunner& operator=(const BMessageRunner&) = delete;

	status_t InitCheck() const;
	status_t SetInterval(bigtime_t interval);
	status_t SetCount(int32 count);
	// B_BAD_VALUE once the last message was sent.
	status_t GetInfo(bigtime_t* _interval, int32* _count) const;

	// A runner of its own: it ends with its count, or when its target is gone.
	static status_t StartSending(
		BMessenger target, const BMessage* message, bigtime_t interval, int32 count);
	static status_t StartSending(BMessenger target, const BMessage* message, bigtime_t interval,
		int32 count, BMessenger replyTo);

private:
	int32 fToken; // the runner's number in the timer, or an error
};
