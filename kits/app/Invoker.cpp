#include <Invoker.h>

#include <Handler.h>
#include <Message.h>


BInvoker::BInvoker() = default;


BInvoker::BInvoker(BMessage* message, BMessenger target) : fMessage(message), fTarget(target)
{
}


BInvoker::BInvoker(BMessage* message, const BHandler* handler, const BLooper* looper) :
	fMessage(message), fTarget(handler, looper)
{
}


BInvoker::~BInvoker()
{
	delete fMessage;
}


status_t
BInvoker::SetMessage(BMessage* message)
{
	if (message != fMessage) {
		delete fMessage;
		fMessage = message;
	}
	return B_OK;
}


BMessage*
BInvoker::Message() const
{
	return fMessage;
}


uint32
BInvoker::Command() const
{
	return fMessage != nullptr ? fMessage->what : 0;
}


status_t
BInvoker::SetTarget(const BHandler* handler, const BLooper* looper)
{
	return fTarget.SetTo(handler, looper);
}


status_t
BInvoker::SetTarget(BMessenger target)
{
	fTarget = target;
	return B_OK;
}


bool
BInvoker::IsTargetLocal() const
{
	return fTarget.IsTargetLocal();
}


BHandler*
BInvoker::Target(BLooper** _looper) const
{
	return fTarget.Target(_looper);
}


BMessenger
BInvoker::Messenger() const
{
	return fTarget;
}


status_t
BInvoker::SetHandlerForReply(BHandler* handler)
{
	fReplyTo = handler;
	return B_OK;
}


BHandler*
BInvoker::HandlerForReply() const
{
	return fReplyTo;
}


status_t
BInvoker::Invoke(BMessage* message)
{
	if (message == nullptr)
		message = fMessage;
	if (message == nullptr)
		return B_BAD_VALUE;
	return fTarget.SendMessage(message, fReplyTo, fTimeout);
}


status_t
BInvoker::InvokeNotify(BMessage* message, uint32 kind)
{
	BeginInvokeNotify(kind);
	const status_t status = Invoke(message);
	EndInvokeNotify();
	return status;
}


status_t
BInvoker::SetTimeout(bigtime_t timeout)
{
	fTimeout = timeout;
	return B_OK;
}


bigtime_t
BInvoker::Timeout() const
{
	return fTimeout;
}


uint32
BInvoker::InvokeKind(bool* _notify)
{
	if (_notify != nullptr)
		*_notify = fNotifyKind != 0;
	return fNotifyKind != 0 ? fNotifyKind : uint32(B_CONTROL_INVOKED);
}


void
BInvoker::BeginInvokeNotify(uint32 kind)
{
	fNotifyKind = kind;
}


void
BInvoker::EndInvokeNotify()
{
	fNotifyKind = 0;
}
