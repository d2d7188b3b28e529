// Writing messages in their forms.
#pragma once

#include <vector>

#include <MessageForm.h>

#include "app/private/MessageData.h"

namespace BPrivate {

constexpr size_t kR5HeaderSize = 17;
constexpr uint32 kR5Magic = 'FOB1';
constexpr uint32 kDanoMagic = 'FOB2';
constexpr uint32 kHaikuMagic = '1FMH';
constexpr size_t kHaikuHeaderSize = 68;
constexpr size_t kHaikuFieldSize = 24;
constexpr uint32 kHaikuHashSize = 5;

enum R5FieldFlag : uint8 {
	kR5Valid = 0x01,
	kR5Mini = 0x02,
	kR5Fixed = 0x04,
	kR5Single = 0x08,
};


// Each returns where the next byte goes.
uint8* write_r5_header(uint8* to, size_t size, uint32 what);
uint8* write_r5_field_head(uint8* to, const MessageField& field, size_t size, message_form form);
uint8* write_r5_field_header(uint8* to, const MessageData& data, const MessageField& field,
	size_t size, message_form form); // the name too
uint8* write_padded_item(uint8* to, const uint8* item); // from the item's size word on
uint8* write_plain_item(uint8* to, const MessageData& nested);

inline uint8*
append_bytes(uint8* to, const uint8* from, const uint8* end)
{
	if (from != end)
		memcpy(to, from, size_t(end - from));
	return to + (end - from);
}


// Bytes of the field's items as the R5 form pads them; messages among them as they are.
size_t padded_field_size(const MessageData& data, const MessageField& field);

// Whether a nested message's bytes may go into a compact R5 message unchanged: because they are one
// all through, or are no message that could be read.
bool stays_as_it_is(const uint8* bytes, size_t size, int32 level);

// In the compact R5 form; NULL when it is too large or there is no memory.
SharedBytes* flatten_to_bytes(const MessageData& data, uint32 what);

uint32 haiku_name_hash(const char* name, size_t length);


// Writes a message in any form, turning the messages in it into that form too. Measure() notes the
// size of each of them in the order in which Write() comes by, so that no size is found out twice.
class MessageWriter {
public:
	MessageWriter(const MessageData* data, uint32 what, message_form form); // data may be NULL
	~MessageWriter();
	MessageWriter(const MessageWriter&) = delete;
	MessageWriter& operator=(const MessageWriter&) = delete;

	ssize_t Size() const { return fSize; } // negative: why it cannot be written
	void Write(uint8* to);

private:
	struct Nested {
		MessageData* data; // a reference; NULL when the item's bytes are taken as they are
		size_t size;
	};

	size_t _Measure(const MessageData& data, int32 depth);
	size_t _MeasureR5(const MessageData& data, int32 depth);
	size_t _MeasureHaiku(const MessageData& data, int32 depth);
	size_t _MeasureItem(const MessageData& data, uint32 field, uint32 index, int32 depth);
	size_t _MeasureItems(const MessageData& data, uint32 field, int32 depth);
	MessageData* _NestedToConvert(
		const MessageData& data, uint32 field, uint32 index, int32 depth) const;

	uint8* _Write(const MessageData& data, uint32 what, size_t size, uint8* to);
	uint8* _WriteR5(const MessageData& data, uint32 what, size_t size, uint8* to);
	uint8* _WriteHaiku(const MessageData& data, uint32 what, size_t size, uint8* to);
	uint8* _WriteHaikuHeader(const MessageData& data, uint32 what, size_t size, uint8* to) const;
	uint8* _WriteItems(const MessageData& data, uint32 field, uint8* to);

	const MessageData* fData; // borrowed
	uint32 fWhat;
	message_form fForm;
	std::vector<Nested> fNested;
	std::vector<size_t> fFieldSizes; // of every field, in order of visit
	size_t fNextNested = 0;
	size_t fNextField = 0;
	ssize_t fSize;
};


} // namespace BPrivate
