#include "app/private/LooperPrivate.h"

#include <Message.h>

#include "app/private/Delivery.h"
#include "app/private/HandlerPrivate.h"
#include "app/private/LooperCore.h"

namespace BPrivate {
namespace {

std::unique_ptr<BMessage>
Addressed(BMessage* message, int32 token)
{
	Delivery& delivery = Delivery::Of(*message);
	delivery.target = token;
	delivery.delivered = true;
	return std::unique_ptr<BMessage>(message);
}

} // namespace


Worker&
LooperPrivate::Activity()
{
	return fLooper->fCore->Activity();
}


void
LooperPrivate::PostSystem(BMessage* message, bool toPreferred)
{
	const int32 token = toPreferred ? kPreferredToken : fLooper->fCore->OwnToken();
	fLooper->fCore->Put(Addressed(message, token), false);
}


void
LooperPrivate::PostSystemTo(BMessage* message, const BHandler* handler)
{
	fLooper->fCore->Put(Addressed(message, HandlerPrivate(handler).Token()), false);
}


void
LooperPrivate::PostAhead(BMessage* message)
{
	fLooper->fCore->Put(Addressed(message, fLooper->fCore->OwnToken()), true);
}


void
LooperPrivate::RequestUpdate()
{
	fLooper->fCore->RequestUpdate();
}


bool
LooperPrivate::CancelUpdate()
{
	return fLooper->fCore->CancelUpdate();
}


BMessage*
LooperPrivate::TakeMessage(const std::function<bool(const BMessage&)>& wanted)
{
	return fLooper->fCore->TakeMatching(wanted);
}


bool
LooperPrivate::WaitForMessage(bigtime_t timeout)
{
	return fLooper->fCore->WaitForArrival(timeout);
}


bool
LooperPrivate::IsRunning() const
{
	return fLooper->fCore->IsLooping();
}


bool
LooperPrivate::IsTerminating() const
{
	return fLooper->fTerminating;
}


void
LooperPrivate::MarkAsWindow()
{
	fLooper->fCore->MarkAsWindow();
}


void
LooperPrivate::RegisterWindow(BWindow* window)
{
	LooperTable::AddWindow(fLooper, window);
}


int32
LooperPrivate::CountLoopers()
{
	return LooperTable::CountLoopers();
}


BLooper*
LooperPrivate::LooperAt(int32 index)
{
	return LooperTable::LooperAt(index);
}


bool
LooperPrivate::IsAlive(const BLooper* looper)
{
	return LooperTable::Find(looper) != nullptr;
}


bool
LooperPrivate::IsRunning(const BLooper* looper)
{
	const std::shared_ptr<LooperCore> core = LooperTable::Find(looper);
	return core && core->IsLooping();
}


} // namespace BPrivate
