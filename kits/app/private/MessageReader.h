// MessageReader: reads flattened messages of every form; the one place that touches their bytes.
#pragma once

#include <vector>

#include <MessageForm.h>

#include "app/private/MessageData.h"

namespace BPrivate {


enum R5MessageFlag : uint8 {
	kR5HasTarget = 0x02,
	kR5HasReply = 0x04,
};


inline uint32
swap_if(uint32 value, bool swapped)
{
	return swapped ? __builtin_bswap32(value) : value;
}


// Every count and size is checked against the bytes before use. Messages in the host's byte order
// are not copied: their fields refer to the bytes.
class MessageReader {
public:
	// Takes over one reference to the source, within which the bytes lie.
	MessageReader(SharedBytes* source, const uint8* bytes, size_t size, int32 level);
	~MessageReader();
	MessageReader(const MessageReader&) = delete;
	MessageReader& operator=(const MessageReader&) = delete;

	// An item of which only the first bytes are there.
	struct CutItem {
		const char* name;
		size_t nameLength;
		type_code type;
		const uint8* data;
		size_t size;
	};

	// From now on damaged fields and items are noted and left out, and do not end the reading.
	void Tolerate(std::vector<message_damage>* damages) { fDamages = damages; }
	const std::vector<CutItem>& CutItems() const { return fCutItems; }

	// A new reference, or NULL; then the status says why.
	MessageData* Read();

	status_t Status() const { return fStatus; }
	const message_damage& Damage() const { return fDamage; }
	size_t Used() const { return fUsed; } // bytes that the message takes up

private:
	struct Field {
		const char* name;
		size_t nameLength;
		type_code type;
		uint32 count;
		bool fixed;
		const uint8* data;
		size_t size;
		size_t stated; // the size that the field claims
		uint16 flags; // of MessageField
		const uint8* start; // of the encoded field
	};

	MessageData* _ReadR5();
	bool _ReadR5Header();
	bool _ReadR5Field(size_t* position, Field* field);
	void _SetR5Flags(Field* field, uint8 flags);
	MessageData* _ReadHaiku();
	bool _ReadHaikuHeader(size_t* _count, size_t* _areaSize);
	bool _ReadHaikuField(size_t position, size_t areaStart, size_t areaSize, Field* field);
	MessageData* _ReadDano();
	bool _ReadDanoSection(uint32 code, size_t position, size_t end);
	bool _ReadDanoArray(Field* field, const uint8* data, size_t left, size_t itemSize);
	bool _AddDanoItems(const Field& field, const uint8* items, size_t size, const uint8* ends);

	bool _LeaveOut();
	void _Shorten(Field* field, uint32 count);
	// Leaves the items of a damaged field that are wholly there. False when nothing of it is left.
	bool _KeepWholeItems(Field* field)
	{
		return fDamages == nullptr || field->count == 0 || _ShortenToWholeItems(field);
	}
	bool _ShortenToWholeItems(Field* field);
	bool _KeepWholeVariableItems(Field* field, bool noted);
	bool _Take(const Field& field);
	bool _TakeReference(const Field& field);
	bool _TakeSwapped(const Field& field);
	bool _CheckItems(const Field& field, uint64* table);
	bool _AddSwappedItem(const Field& field, bool first, const uint8* item, size_t size);
	MessageField* _NextField();
	bool _ReserveFields(size_t count);
	size_t _CountR5Fields(size_t position) const;
	MessageData* _Finish();
	bool _Fail(status_t status, const uint8* where, const char* reason);
	bool _Fail(status_t status, size_t offset, const char* reason);

	uint16 _Number16(const uint8* from) const
	{
		uint16 value;
		memcpy(&value, from, sizeof(value));
		return fSwapped ? __builtin_bswap16(value) : value;
	}
	uint32 _Number32(const uint8* from) const { return swap_if(read_uint32(from), fSwapped); }

	SharedBytes* fSource; // a reference
	const uint8* fBytes;
	size_t fSize;
	int32 fLevel;
	bool fSwapped = false;
	uint32 fWhat = 0;
	size_t fUsed = 0;
	status_t fStatus = B_OK;
	message_damage fDamage { 0, "" };
	std::vector<message_damage>* fDamages = nullptr; // borrowed; NULL: the first ends the reading
	std::vector<CutItem> fCutItems;
	static constexpr uint32 kFewFields = 32; // as many have room in the reader itself
	MessageField fFewFields[kFewFields];
	MessageField* fManyFields = nullptr; // all of them, when there are more; from malloc()
	size_t fManyRoom = 0;
	uint32 fFieldCount = 0;
	MessageData* fBuilt = nullptr; // fields that had to be copied
	bool fIsCompact = false; // so far all fields are as the compact form has them
	uint32 fBodySize = 0; // of the fields of the R5 form
};


// Looks no deeper than the first bytes, see get_message_form().
status_t read_message_form(const uint8* bytes, size_t size, message_form_info* _info);
// The size that the header gives, for readers that do not know it. At most the given bytes are
// looked at; the result can be larger than what is there. 0: no message.
constexpr size_t kFormHeaderSize = 68;
size_t read_message_size(const uint8* bytes, size_t size);


} // namespace BPrivate
