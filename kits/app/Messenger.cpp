#include <Messenger.h>

#include <string.h>
#include <tuple>
#include <unistd.h>

#include <Application.h>
#include <Handler.h>
#include <Looper.h>
#include <Message.h>

#include "app/private/Delivery.h"
#include "app/private/HandlerPrivate.h"
#include "app/private/HandlerTokens.h"
#include "app/private/LooperCore.h"
#include "app/private/MessengerPrivate.h"

using BPrivate::HandlerPrivate;
using BPrivate::HandlerTokens;
using BPrivate::LooperCore;
using BPrivate::LooperTable;
using BPrivate::PortTable;

namespace {

std::shared_ptr<LooperCore>
FindCore(int32 port)
{
	return std::dynamic_pointer_cast<LooperCore>(PortTable::Find(port));
}

} // namespace


BMessenger::BMessenger() = default;


BMessenger::BMessenger(const BHandler* handler, const BLooper* looper, status_t* _result)
{
	const status_t status = SetTo(handler, looper);
	if (_result != nullptr)
		*_result = status;
}


BMessenger::BMessenger(const char* signature, team_id team, status_t* _result)
{
	const status_t status = SetTo(signature, team);
	if (_result != nullptr)
		*_result = status;
}


bool
BMessenger::IsTargetLocal() const
{
	return fTeam == getpid();
}


BHandler*
BMessenger::Target(BLooper** _looper) const
{
	const std::shared_ptr<LooperCore> core = IsTargetLocal() ? FindCore(fPort) : nullptr;
	BLooper* looper = core ? core->Looper() : nullptr;
	if (_looper != nullptr)
		*_looper = looper;
	if (looper == nullptr || fToken < 0)
		return nullptr;

	return HandlerTokens::FindIn(fToken, looper);
}


bool
BMessenger::LockTarget() const
{
	return LockTargetWithTimeout(B_INFINITE_TIMEOUT) == B_OK;
}


status_t
BMessenger::LockTargetWithTimeout(bigtime_t timeout) const
{
	const std::shared_ptr<LooperCore> core = IsTargetLocal() ? FindCore(fPort) : nullptr;
	return core ? core->Lock(timeout) : B_BAD_VALUE;
}


status_t
BMessenger::SendMessage(uint32 command, BHandler* replyTo) const
{
	BMessage message(command);
	return SendMessage(&message, replyTo);
}


status_t
BMessenger::SendMessage(BMessage* message, BHandler* replyTo, bigtime_t timeout) const
{
	return SendMessage(message, BPrivate::reply_address(replyTo), timeout);
}


status_t
BMessenger::SendMessage(BMessage* message, BMessenger replyTo, bigtime_t timeout) const
{
	if (message == nullptr)
		return B_BAD_VALUE;

	auto copy = std::make_unique<BMessage>(*message);
	BPrivate::Delivery::Of(*copy).replyTo = replyTo;
	return BPrivate::deliver(*this, std::move(copy), timeout);
}


status_t
BMessenger::SendMessage(uint32 command, BMessage* reply) const
{
	BMessage message(command);
	return SendMessage(&message, reply);
}


status_t
BMessenger::SendMessage(
	BMessage* message, BMessage* reply, bigtime_t deliveryTimeout, bigtime_t replyTimeout) const
{
	if (message == nullptr)
		return B_BAD_VALUE;
	return BPrivate::deliver_and_wait(*this, *message, false, reply, deliveryTimeout, replyTimeout);
}


bool
BMessenger::IsValid() const
{
	return fPort >= 0 && PortTable::Find(fPort) != nullptr;
}


team_id
BMessenger::Team() const
{
	return fTeam;
}


// Programs on this desktop have no common registry, so the only one that can be found is our own.
status_t
BMessenger::SetTo(const char* signature, team_id team)
{
	*this = BMessenger();
	if (signature == nullptr && team < 0)
		return B_BAD_VALUE;
	if (be_app == nullptr || (team >= 0 && team != getpid()))
		return B_BAD_TEAM_ID;
	if (signature != nullptr && strcasecmp(signature, be_app->Signature()) != 0)
		return team >= 0 ? B_MISMATCHED_VALUES : B_BAD_VALUE;

	return SetTo(be_app);
}


status_t
BMessenger::SetTo(const BHandler* handler, const BLooper* looper)
{
	*this = BMessenger();
	if (handler == nullptr && looper == nullptr)
		return B_BAD_VALUE;
	if (handler != nullptr) {
		const BLooper* own = handler->Looper();
		if (own == nullptr || (looper != nullptr && looper != own))
			return B_MISMATCHED_VALUES;
		looper = own;
	}

	const std::shared_ptr<LooperCore> core = LooperTable::Find(looper);
	if (!core)
		return B_BAD_VALUE;

	fPort = core->PortId();
	fToken = handler != nullptr ? HandlerPrivate(handler).Token() : BPrivate::kPreferredToken;
	fTeam = getpid();
	return B_OK;
}


bool
BMessenger::operator==(const BMessenger& other) const
{
	return fPort == other.fPort && fToken == other.fToken && fTeam == other.fTeam;
}


bool
operator<(const BMessenger& a, const BMessenger& b)
{
	using Access = BPrivate::MessengerPrivate;
	return std::make_tuple(Access::Team(a), Access::Port(a), Access::Token(a))
		< std::make_tuple(Access::Team(b), Access::Port(b), Access::Token(b));
}
