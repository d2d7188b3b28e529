// MessagePrivate: what the kits alone may do with a message.
#pragma once

#include <memory>

#include <Message.h>

namespace BPrivate {


class WriteBack;


// How a message was delivered and whom it answers. Made by the looper; a message that was never
// delivered has none. The message owns it and deletes it with itself or in MakeEmpty().
class DeliveryState {
public:
	virtual ~DeliveryState();

	// What a copy of the message gets: a state of its own, or NULL for none.
	virtual std::unique_ptr<DeliveryState> CloneForCopy() const = 0;
};


// A loan of a message's private parts, for the length of a statement.
class MessagePrivate {
public:
	explicit MessagePrivate(BMessage* message) : fMessage(message) {}

	explicit MessagePrivate(const BMessage* message) : fMessage(const_cast<BMessage*>(message)) {}

	DeliveryState* Delivery() const { return fMessage->fDelivery; }
	void SetDelivery(std::unique_ptr<DeliveryState> state);

	int32 CurrentSpecifier() const { return fMessage->fCurrentSpecifier; }
	void SetCurrentSpecifier(int32 index) { fMessage->fCurrentSpecifier = index; }

	// The shared contents; NULL for a message without fields.
	MessageData* Data() const { return fMessage->fData; }
	void SetData(MessageData* data); // takes a reference of its own
	// The contents for changing, shared with nobody; NULL without memory.
	MessageData* OwnData() const { return fMessage->_Own(); }

	// Present while the archive of an object that was read is written again.
	WriteBack* GetWriteBack() const { return fMessage->fWriteBack; }
	void SetWriteBack(std::unique_ptr<WriteBack> writeBack);

	LookUps* GetLookUps() const { return fMessage->fLookUps; }
	void SetLookUps(LookUps* lookUps); // takes a reference of its own

	// Whether both share the same contents, which makes them equal without a look.
	bool SharesDataWith(const BMessage& other) const { return fMessage->fData == other.fData; }

private:
	BMessage* fMessage; // borrowed
};


} // namespace BPrivate
