// The part of BMessage that deals with its delivery: the sender, answers, drops.

#include <Message.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <unistd.h>

#include <AppDefs.h>
#include <Application.h>

#include "app/private/Delivery.h"
#include "app/private/LooperCore.h"
#include "app/private/MessengerPrivate.h"
#include "app/private/Port.h"

namespace BPrivate {
namespace {

constexpr const char* kPrevious = "_previous_";

// Where a synchronous sender waits for its answer: the first one counts. If the sender runs a loop,
// it counts as idle while it waits, since the receiver may be waiting for its user; it has work
// again from the moment the answer is given, which is part of the receiver's own work.
class ReplyPort final : public Port {
public:
	status_t Receive(std::unique_ptr<BMessage> message, bigtime_t) override
	{
		std::lock_guard lock(fLock);
		if (fIsOver)
			return B_BAD_PORT_ID;
		if (!fReply)
			fReply = std::move(message);
		_EndWaiting();
		fArrived.notify_all();
		return B_OK;
	}

	// After the message was delivered, so that somebody has work when the sender has none.
	std::unique_ptr<BMessage> Wait(bigtime_t timeout)
	{
		std::unique_lock lock(fLock);
		const auto arrived = [&] { return fReply != nullptr; };
		LooperCore* loop = LooperCore::OfThisThread();
		if (loop != nullptr && !arrived()) {
			fSender = &loop->Activity();
			fSender->BeginWaiting();
		}
		if (timeout > bigtime_t(1) << 51) // would overflow the clock
			fArrived.wait(lock, arrived);
		else
			fArrived.wait_for(lock, std::chrono::microseconds(timeout), arrived);
		fIsOver = true;
		_EndWaiting();
		return std::move(fReply);
	}

private:
	void _EndWaiting()
	{
		if (fSender != nullptr)
			fSender->EndWaiting();
		fSender = nullptr;
	}

	std::mutex fLock;
	std::condition_variable fArrived;
	std::unique_ptr<BMessage> fReply;
	Worker* fSender = nullptr; // borrowed while it waits
	bool fIsOver = false;
};

} // namespace


Delivery::~Delivery()
{
	if (!replyRequired || replyDone)
		return;
	auto answer = std::make_unique<BMessage>(B_NO_REPLY);
	Delivery::Of(*answer).delivered = true;
	deliver(replyTo, std::move(answer), 0);
}


std::unique_ptr<DeliveryState>
Delivery::CloneForCopy() const
{
	auto copy = std::make_unique<Delivery>();
	if (!replyRequired)
		copy->replyTo = replyTo;
	return copy;
}


Delivery&
Delivery::Of(BMessage& message)
{
	MessagePrivate access(&message);
	if (access.Delivery() == nullptr)
		access.SetDelivery(std::make_unique<Delivery>());
	return *static_cast<Delivery*>(access.Delivery());
}


const Delivery*
Delivery::Find(const BMessage& message)
{
	return static_cast<const Delivery*>(MessagePrivate(&message).Delivery());
}


status_t
deliver(const BMessenger& target, std::unique_ptr<BMessage> message, bigtime_t timeout)
{
	const std::shared_ptr<Port> port = PortTable::Find(MessengerPrivate::Port(target));
	if (!port)
		return B_BAD_PORT_ID;

	Delivery& delivery = Delivery::Of(*message);
	delivery.target = MessengerPrivate::Token(target);
	delivery.delivered = true;
	return port->Receive(std::move(message), timeout);
}


status_t
deliver_and_wait(const BMessenger& target, const BMessage& message, bool isReply, BMessage* reply,
	bigtime_t deliveryTimeout, bigtime_t replyTimeout)
{
	if (reply == nullptr)
		return B_BAD_VALUE;

	const auto looper =
		std::dynamic_pointer_cast<LooperCore>(PortTable::Find(MessengerPrivate::Port(target)));
	if (looper && looper->Thread() == find_thread(NULL))
		return B_MESSAGE_TO_SELF;

	const auto port = std::make_shared<ReplyPort>();
	const int32 id = PortTable::Add(port);

	auto copy = std::make_unique<BMessage>(message);
	Delivery& delivery = Delivery::Of(*copy);
	delivery.replyTo = MessengerPrivate::Make(id, kNoToken, getpid());
	delivery.replyRequired = true;
	delivery.isReply = isReply;

	const status_t status = deliver(target, std::move(copy), deliveryTimeout);
	std::unique_ptr<BMessage> answer = port->Wait(status == B_OK ? replyTimeout : 0);
	PortTable::Remove(id);
	if (status != B_OK)
		return status;
	if (!answer)
		return B_TIMED_OUT;

	*reply = *answer;
	// The answer may itself be waited for, so its address must not stay with the one that goes.
	Delivery& from = Delivery::Of(*answer);
	Delivery& to = Delivery::Of(*reply);
	to.replyTo = from.replyTo;
	to.replyRequired = from.replyRequired;
	to.replyDone = false;
	to.delivered = true;
	to.isReply = from.isReply;
	from.replyDone = true;
	return B_OK;
}


status_t
forward(BMessage& message, const BMessenger& target)
{
	Delivery& from = Delivery::Of(message);
	auto copy = std::make_unique<BMessage>(message);
	MessagePrivate(copy.get()).SetCurrentSpecifier(MessagePrivate(&message).CurrentSpecifier());
	Delivery& to = Delivery::Of(*copy);
	to.replyTo = from.replyTo;
	to.replyRequired = from.replyRequired;
	to.replyDone = from.replyDone;
	to.isReply = from.isReply;
	to.dropped = from.dropped;
	from.replyDone = from.replyRequired;
	return deliver(target, std::move(copy), B_INFINITE_TIMEOUT);
}


BMessenger
reply_address(const BHandler* replyTo)
{
	return replyTo != nullptr ? BMessenger(replyTo) : be_app_messenger;
}


void
mark_as_dropped(BMessage* message, const BMessenger& replyTo)
{
	Delivery& delivery = Delivery::Of(*message);
	delivery.delivered = true;
	delivery.dropped = true;
	delivery.replyTo = replyTo;
}


} // namespace BPrivate


using BPrivate::Delivery;


bool
BMessage::IsReply() const
{
	const Delivery* delivery = Delivery::Find(*this);
	return delivery != nullptr && delivery->isReply;
}


bool
BMessage::WasDelivered() const
{
	const Delivery* delivery = Delivery::Find(*this);
	return delivery != nullptr && delivery->delivered;
}


bool
BMessage::IsSourceWaiting() const
{
	const Delivery* delivery = Delivery::Find(*this);
	return delivery != nullptr && delivery->replyRequired && !delivery->replyDone;
}


bool
BMessage::IsSourceRemote() const
{
	const Delivery* delivery = Delivery::Find(*this);
	return delivery != nullptr && delivery->delivered && delivery->replyTo.Team() >= 0
		&& delivery->replyTo.Team() != getpid();
}


BMessenger
BMessage::ReturnAddress() const
{
	const Delivery* delivery = Delivery::Find(*this);
	return delivery != nullptr ? delivery->replyTo : BMessenger();
}


const BMessage*
BMessage::Previous() const
{
	if (!IsReply())
		return nullptr;

	Delivery& delivery = Delivery::Of(const_cast<BMessage&>(*this));
	if (!delivery.previous) {
		auto previous = std::make_unique<BMessage>();
		if (FindMessage(BPrivate::kPrevious, previous.get()) == B_OK)
			delivery.previous = std::move(previous);
	}
	return delivery.previous.get();
}


bool
BMessage::WasDropped() const
{
	const Delivery* delivery = Delivery::Find(*this);
	return delivery != nullptr && delivery->dropped;
}


BPoint
BMessage::DropPoint(BPoint* offset) const
{
	if (offset != nullptr)
		*offset = FindPoint("_drop_offset_");
	return FindPoint("_drop_point_");
}


// #pragma mark - replies


namespace {

// Whether the message can be answered: B_OK, or the error that SendReply() gives.
status_t
CheckReply(const BMessage& message)
{
	const Delivery* delivery = Delivery::Find(message);
	if (delivery == nullptr || !delivery->delivered)
		return B_BAD_REPLY;
	return delivery->replyRequired && delivery->replyDone ? B_DUPLICATE_REPLY : B_OK;
}

// The answer to a message whose sender went on carries that message along.
BMessage
MakeReply(const BMessage& reply, const BMessage& original)
{
	BMessage copy(reply);
	copy.RemoveName(BPrivate::kPrevious);
	copy.AddMessage(BPrivate::kPrevious, &original);
	return copy;
}

} // namespace


status_t
BMessage::SendReply(uint32 command, BHandler* replyTo)
{
	BMessage reply(command);
	return SendReply(&reply, replyTo);
}


status_t
BMessage::SendReply(BMessage* reply, BHandler* replyTo, bigtime_t timeout)
{
	return SendReply(reply, BPrivate::reply_address(replyTo), timeout);
}


status_t
BMessage::SendReply(BMessage* reply, BMessenger replyTo, bigtime_t timeout)
{
	if (reply == nullptr)
		return B_BAD_VALUE;
	if (const status_t status = CheckReply(*this); status != B_OK)
		return status;

	Delivery& own = Delivery::Of(*this);
	const bool waiting = own.replyRequired;
	auto copy = std::make_unique<BMessage>(waiting ? *reply : MakeReply(*reply, *this));
	Delivery& delivery = Delivery::Of(*copy);
	delivery.replyTo = replyTo;
	delivery.isReply = !waiting;

	own.replyDone = waiting;
	return BPrivate::deliver(own.replyTo, std::move(copy), timeout);
}


status_t
BMessage::SendReply(uint32 command, BMessage* replyToReply)
{
	BMessage reply(command);
	return SendReply(&reply, replyToReply);
}


status_t
BMessage::SendReply(
	BMessage* reply, BMessage* replyToReply, bigtime_t sendTimeout, bigtime_t replyTimeout)
{
	if (reply == nullptr)
		return B_BAD_VALUE;
	if (const status_t status = CheckReply(*this); status != B_OK)
		return status;

	Delivery& own = Delivery::Of(*this);
	const bool waiting = own.replyRequired;
	own.replyDone = waiting;
	return BPrivate::deliver_and_wait(own.replyTo, waiting ? *reply : MakeReply(*reply, *this),
		!waiting, replyToReply, sendTimeout, replyTimeout);
}
