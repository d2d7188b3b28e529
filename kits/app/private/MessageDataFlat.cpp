// MessageData: written in the compact R5 form.

#include <TypeConstants.h>

#include "app/private/MessageData.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {


size_t
MessageData::FlatSize() const
{
	const uint32 known = fFlatSize.load(std::memory_order_relaxed);
	if (known != 0)
		return known;

	size_t size = kR5HeaderSize + 1;
	size_t bodySize;
	if (_Body(&bodySize) != nullptr)
		return size + bodySize;
	for (uint32 i = 0; i < fCount; i++) {
		const MessageField& field = fFields[i];
		if (field.Has(MessageField::kCompact)) {
			size += field.data + field.size - field.Start();
			continue;
		}
		const size_t bytes = padded_field_size(*this, field);
		size += r5_field_header_length(field.count, bytes, B_R5_FORM) + min_c(field.nameLength, 255)
			+ bytes;
	}
	if (size <= UINT32_MAX) {
		fHasDerived.store(true, std::memory_order_relaxed);
		fFlatSize.store(uint32(size), std::memory_order_relaxed);
	}
	return size;
}


bool
MessageData::IsPlain() const
{
	const int8 known = fPlain.load(std::memory_order_relaxed);
	if (known >= 0)
		return known != 0;

	bool plain = true;
	for (uint32 i = 0; i < fCount && plain; i++) {
		const MessageField& field = fFields[i];
		if (field.type != B_MESSAGE_TYPE || field.Has(MessageField::kFixed))
			continue;
		for (uint32 k = 0; k < field.count && plain; k++) {
			const ItemPlace place = PlaceAt(field, k);
			plain = place.IsNested()
				? place.Message()->IsPlain()
				: stays_as_it_is(BytesAt(place) + 4, read_uint32(BytesAt(place)), fLevel + 1);
		}
	}
	fPlain.store(plain ? 1 : 0, std::memory_order_relaxed);
	return plain;
}


bool
MessageData::IsBetterCopied() const
{
	constexpr size_t kLargestCopied = 65536;
	constexpr uint8 kMostCopies = 2;
	size_t size;
	return fNote == nullptr && fCopies < kMostCopies && _Body(&size) != nullptr
		&& size <= kLargestCopied && IsPlain();
}


// Neighbouring fields that lie as the form wants them are copied together.
uint8*
MessageData::WritePlain(uint32 what, uint8* to) const
{
	to = write_r5_header(to, FlatSize(), what);
	size_t bodySize;
	if (const uint8* body = _Body(&bodySize)) {
		to = append_bytes(to, body, body + bodySize);
		*to++ = 0;
		return to;
	}
	const uint8* run = nullptr;
	const uint8* runEnd = nullptr;
	for (uint32 i = 0; i < fCount; i++) {
		const MessageField& field = fFields[i];
		if (field.Has(MessageField::kCompact)) {
			const uint8* start = Base(field) + field.Start();
			if (start != runEnd) {
				to = append_bytes(to, run, runEnd);
				run = start;
			}
			runEnd = Base(field) + field.data + field.size;
			continue;
		}
		to = append_bytes(to, run, runEnd);
		run = runEnd = nullptr;
		to = _WriteField(field, to);
	}
	to = append_bytes(to, run, runEnd);
	*to++ = 0;
	return to;
}


// #pragma mark - private


// A field that does not lie as the form wants it.
uint8*
MessageData::_WriteField(const MessageField& field, uint8* to) const
{
	to = write_r5_field_header(to, *this, field, padded_field_size(*this, field), B_R5_FORM);
	if (field.Has(MessageField::kFixed)
		|| !field.Has(MessageField::kScattered | MessageField::kPacked)) {
		const uint8* data = Base(field) + field.data;
		return append_bytes(to, data, data + field.size);
	}
	for (uint32 i = 0; i < field.count; i++) {
		const ItemPlace place = PlaceAt(field, i);
		to = place.IsNested() ? write_plain_item(to, *place.Message())
							  : write_padded_item(to, BytesAt(place));
	}
	return to;
}


// All fields as the compact form has them, or NULL when they are not in one piece.
const uint8*
MessageData::_Body(size_t* _size) const
{
	if (fStoreIsBody) {
		*_size = fStoreSize;
		// An empty store has no place, but its emptiness is in one piece.
		return fStore != nullptr ? fStore : reinterpret_cast<const uint8*>("");
	}
	*_size = fBodySize;
	return fBodySize > 0 ? fSourceBase + fFields[0].Start() : nullptr;
}


} // namespace BPrivate
