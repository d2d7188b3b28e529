// BMessage: to bytes and from bytes.

#include <Message.h>

#include <cstdlib>
#include <cstring>

#include <DataIO.h>
#include <MessageForm.h>

#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

using BPrivate::MessageWriter;


ssize_t
BMessage::FlattenedSize() const
{
	return flattened_message_size(*this, B_R5_FORM);
}


status_t
BMessage::Flatten(char* buffer, ssize_t size) const
{
	return flatten_message(*this, B_R5_FORM, buffer, size);
}


status_t
BMessage::Flatten(BDataIO* stream, ssize_t* size) const
{
	if (stream == nullptr)
		return B_BAD_VALUE;
	MessageWriter writer(fData, what, B_R5_FORM);
	if (writer.Size() < 0)
		return status_t(writer.Size());
	uint8* buffer = static_cast<uint8*>(malloc(size_t(writer.Size())));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	writer.Write(buffer);
	const ssize_t written = stream->Write(buffer, size_t(writer.Size()));
	free(buffer);

	if (written < 0)
		return status_t(written);
	if (written != writer.Size())
		return B_ERROR;
	if (size != nullptr)
		*size = written;
	return B_OK;
}


status_t
BMessage::Unflatten(const char* flatBuffer)
{
	if (flatBuffer == nullptr)
		return B_BAD_VALUE;
	// The caller vouches for a whole message, so its header may be read, but only if it is one.
	uint32 magic;
	memcpy(&magic, flatBuffer, sizeof(magic));
	const auto* bytes = reinterpret_cast<const uint8*>(flatBuffer);
	const bool haiku =
		magic == BPrivate::kHaikuMagic || magic == __builtin_bswap32(BPrivate::kHaikuMagic);
	const bool known = haiku || magic == BPrivate::kR5Magic || magic == BPrivate::kDanoMagic
		|| magic == __builtin_bswap32(BPrivate::kR5Magic)
		|| magic == __builtin_bswap32(BPrivate::kDanoMagic);
	if (!known) {
		_Clear();
		return B_NOT_A_MESSAGE;
	}
	const size_t size = BPrivate::read_message_size(bytes, haiku ? BPrivate::kHaikuHeaderSize : 16);
	return unflatten_message(this, flatBuffer, size);
}


status_t
BMessage::Unflatten(BDataIO* stream)
{
	if (stream == nullptr)
		return B_BAD_VALUE;
	_Clear();

	uint8 header[BPrivate::kFormHeaderSize];
	size_t have = 0;
	status_t status = stream->ReadExactly(header, 16, &have);
	if (status != B_OK)
		return status == B_PARTIAL_READ ? status_t(B_NOT_A_MESSAGE) : status;
	size_t size = BPrivate::read_message_size(header, have);
	uint32 magic = BPrivate::read_uint32(header);
	if (magic == BPrivate::kHaikuMagic || magic == __builtin_bswap32(BPrivate::kHaikuMagic)) {
		size_t more = 0;
		status = stream->ReadExactly(header + have, sizeof(header) - have, &more);
		if (status != B_OK)
			return status == B_PARTIAL_READ ? status_t(B_BAD_VALUE) : status;
		have += more;
		size = BPrivate::read_message_size(header, have);
	} else if (size == 0)
		return B_NOT_A_MESSAGE;
	if (size < have)
		return B_BAD_VALUE;
	return _ReadRest(stream, header, have, size);
}


// #pragma mark - private


// Reads the rest of a message whose size its header gives. The memory grows with what comes, since
// the size may be a lie.
status_t
BMessage::_ReadRest(BDataIO* stream, const uint8* header, size_t have, size_t size)
{
	constexpr size_t kFirstRoom = 64 * 1024;
	size_t room = min_c(size, max_c(kFirstRoom, have));
	uint8* buffer = static_cast<uint8*>(malloc(room));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	memcpy(buffer, header, have);
	status_t status = B_OK;
	while (have < size && status == B_OK) {
		if (have == room) {
			room = min_c(size, room * 2);
			uint8* larger = static_cast<uint8*>(realloc(buffer, room));
			if (larger == nullptr) {
				status = B_NO_MEMORY;
				break;
			}
			buffer = larger;
		}
		size_t more = 0;
		status = stream->ReadExactly(buffer + have, room - have, &more);
		have += more;
	}
	if (status != B_OK) {
		free(buffer);
		return status == B_PARTIAL_READ ? status_t(B_BAD_VALUE) : status;
	}
	return unflatten_message_shared(this, buffer, size, free, buffer);
}
