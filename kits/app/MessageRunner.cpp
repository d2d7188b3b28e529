#include <MessageRunner.h>

#include <Handler.h>
#include <Message.h>

#include "app/private/Delivery.h"
#include "app/private/Timer.h"

using BPrivate::Timer;


BMessageRunner::BMessageRunner(
	BMessenger target, const BMessage* message, bigtime_t interval, int32 count) :
	BMessageRunner(target, message, interval, count, BPrivate::reply_address(nullptr))
{
}


BMessageRunner::BMessageRunner(BMessenger target, const BMessage* message, bigtime_t interval,
	int32 count, BMessenger replyTo) :
	fToken(Timer::Get().Add(target, message, interval, count, replyTo))
{
}


BMessageRunner::~BMessageRunner()
{
	if (fToken >= 0)
		Timer::Get().Remove(fToken);
}


status_t
BMessageRunner::InitCheck() const
{
	return fToken < 0 ? fToken : B_OK;
}


status_t
BMessageRunner::SetInterval(bigtime_t interval)
{
	return fToken < 0 ? fToken : Timer::Get().SetInterval(fToken, interval);
}


status_t
BMessageRunner::SetCount(int32 count)
{
	return fToken < 0 ? fToken : Timer::Get().SetCount(fToken, count);
}


status_t
BMessageRunner::GetInfo(bigtime_t* _interval, int32* _count) const
{
	return fToken < 0 ? fToken : Timer::Get().GetInfo(fToken, _interval, _count);
}


status_t
BMessageRunner::StartSending(
	BMessenger target, const BMessage* message, bigtime_t interval, int32 count)
{
	return StartSending(target, message, interval, count, BPrivate::reply_address(nullptr));
}


status_t
BMessageRunner::StartSending(
	BMessenger target, const BMessage* message, bigtime_t interval, int32 count, BMessenger replyTo)
{
	const int32 token = Timer::Get().Add(target, message, interval, count, replyTo);
	return token < 0 ? token : B_OK;
}
