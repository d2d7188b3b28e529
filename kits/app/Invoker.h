// BInvoker: a message and the place to send it to.
#pragma once

#include <AppDefs.h>
#include <Messenger.h>

class BMessage;


class _EXPORT BInvoker {
public:
	BInvoker();
	// The message belongs to the invoker.
	BInvoker(BMessage* message, BMessenger target);
	BInvoker(BMessage* message, const BHandler* handler, const BLooper* looper = NULL);
	virtual ~BInvoker();
	BInvoker(const BInvoker&) = delete;
	BInvoker& operator=(const BInvoker&) = delete;

	// Deletes the previous message unless it is the same one.
	virtual status_t SetMessage(BMessage* message);
	BMessage* Message() const;
	uint32 Command() const;

	// The handler must be in a looper already.
	virtual status_t SetTarget(const BHandler* handler, const BLooper* looper = NULL);
	virtual status_t SetTarget(BMessenger target);
	bool IsTargetLocal() const;
	BHandler* Target(BLooper** _looper = NULL) const;
	BMessenger Messenger() const;

	virtual status_t SetHandlerForReply(BHandler* handler);
	BHandler* HandlerForReply() const;

	// Sends a copy of the given message, or of the own one: B_BAD_VALUE when there is none.
	virtual status_t Invoke(BMessage* message = NULL);
	// As Invoke(), with InvokeKind() being `kind` meanwhile. A control tells its watchers too.
	status_t InvokeNotify(BMessage* message, uint32 kind = B_CONTROL_INVOKED);
	status_t SetTimeout(bigtime_t timeout);
	bigtime_t Timeout() const;

protected:
	// *_notify tells whether Invoke() runs inside InvokeNotify().
	uint32 InvokeKind(bool* _notify = NULL);
	void BeginInvokeNotify(uint32 kind = B_CONTROL_INVOKED);
	void EndInvokeNotify();

private:
	BMessage* fMessage = nullptr; // owned
	BMessenger fTarget;
	BHandler* fReplyTo = nullptr; // borrowed
	bigtime_t fTimeout = B_INFINITE_TIMEOUT;
	uint32 fNotifyKind = 0; // 0: not inside InvokeNotify()
};
