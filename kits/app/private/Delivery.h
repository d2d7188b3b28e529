// Delivery: how a message reached its receiver, and whom an answer goes to.
#pragma once

#include <memory>

#include <Messenger.h>

#include "app/private/LooperPrivate.h"
#include "app/private/MessagePrivate.h"

namespace BPrivate {


// When a message goes whose sender still waits, the sender is answered B_NO_REPLY.
class Delivery final : public DeliveryState {
public:
	Delivery() = default;
	~Delivery() override;

	// A copy was not delivered; it keeps the reply address alone.
	std::unique_ptr<DeliveryState> CloneForCopy() const override;

	// The message's state; made when there is none.
	static Delivery& Of(BMessage& message);
	static const Delivery* Find(const BMessage& message); // NULL when it has none

	int32 target = kNoToken;
	BMessenger replyTo;
	bool delivered = false;
	bool replyRequired = false; // somebody waits at replyTo
	bool replyDone = false;
	bool isReply = false;
	bool dropped = false;
	std::unique_ptr<BMessage> previous; // made when it is first asked for
};


// Sends the message to a target; see Port::Receive() for the results.
status_t deliver(const BMessenger& target, std::unique_ptr<BMessage> message, bigtime_t timeout);

// Sends a copy whose answer comes back here. B_TIMED_OUT when there was none in time.
status_t deliver_and_wait(const BMessenger& target, const BMessage& message, bool isReply,
	BMessage* reply, bigtime_t deliveryTimeout, bigtime_t replyTimeout);

// Passes a message that was delivered here on to another target, which answers its sender. The
// message at hand can no longer be answered if its sender waits.
status_t forward(BMessage& message, const BMessenger& target);

// The reply address that a NULL handler stands for: the application.
BMessenger reply_address(const BHandler* replyTo);

// Makes it a message that was dropped, with answers going to the source of the drag.
void mark_as_dropped(BMessage* message, const BMessenger& replyTo);


} // namespace BPrivate
