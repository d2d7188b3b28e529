// BMessage: messengers as items.

#include <Message.h>

#include <cstring>

#include "app/private/MessengerPrivate.h"

namespace {

// An item has the size that all writers of this type agree on; what is behind the three numbers
// means nothing.
constexpr size_t kMessengerSize = 24;


void
messenger_to_bytes(const BMessenger& messenger, uint8* bytes)
{
	using BPrivate::MessengerPrivate;
	const int32 numbers[3] = { MessengerPrivate::Port(messenger),
		MessengerPrivate::Token(messenger), MessengerPrivate::Team(messenger) };
	memset(bytes, 0, kMessengerSize);
	memcpy(bytes, numbers, sizeof(numbers));
}

} // namespace


status_t
BMessage::AddMessenger(const char* name, BMessenger messenger)
{
	uint8 bytes[kMessengerSize];
	messenger_to_bytes(messenger, bytes);
	return AddData(name, B_MESSENGER_TYPE, bytes, sizeof(bytes));
}


status_t
BMessage::FindMessenger(const char* name, BMessenger* messenger) const
{
	return FindMessenger(name, 0, messenger);
}


status_t
BMessage::FindMessenger(const char* name, int32 index, BMessenger* messenger) const
{
	if (messenger == nullptr)
		return B_BAD_VALUE;
	int32 numbers[3];
	const status_t status = _FindFixed(name, B_MESSENGER_TYPE, index, numbers, sizeof(numbers));
	*messenger = status == B_OK
		? BPrivate::MessengerPrivate::Make(numbers[0], numbers[1], numbers[2])
		: BMessenger();
	return status;
}


status_t
BMessage::ReplaceMessenger(const char* name, BMessenger messenger)
{
	return ReplaceMessenger(name, 0, messenger);
}


status_t
BMessage::ReplaceMessenger(const char* name, int32 index, BMessenger messenger)
{
	uint8 bytes[kMessengerSize];
	messenger_to_bytes(messenger, bytes);
	return ReplaceData(name, B_MESSENGER_TYPE, index, bytes, sizeof(bytes));
}
