// MessageReader: the R5 form, which most files have, and what all forms have in common.
#include "app/private/MessageReader.h"

#include <cstdlib>

#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

constexpr uint32 kFewItems = 8; // as many are found without a table


// Names are short, so this is quicker than a call.
bool
has_zero(const char* bytes, size_t length)
{
	constexpr uint64 kOnes = 0x0101010101010101;
	uint64 zeros = 0;
	for (; length >= 8; bytes += 8, length -= 8) {
		uint64 word;
		memcpy(&word, bytes, 8);
		zeros |= (word - kOnes) & ~word & kOnes << 7;
	}
	if (length >= 4) {
		// The two halves may overlap.
		uint32 low;
		uint32 high;
		memcpy(&low, bytes, 4);
		memcpy(&high, bytes + length - 4, 4);
		const uint64 word = uint64(high) << 32 | low;
		zeros |= (word - kOnes) & ~word & kOnes << 7;
	} else {
		for (; length > 0; bytes++, length--)
			zeros |= *bytes == 0 ? 1 : 0;
	}
	return zeros != 0;
}

} // namespace


MessageReader::MessageReader(SharedBytes* source, const uint8* bytes, size_t size, int32 level) :
	fSource(source), fBytes(bytes), fSize(size), fLevel(level)
{
}


MessageReader::~MessageReader()
{
	const MessageField* fields = fManyFields == nullptr ? fFewFields : fManyFields;
	for (uint32 i = 0; i < fFieldCount; i++)
		free(fields[i].table);
	free(fManyFields);
	if (fBuilt != nullptr)
		fBuilt->Release();
	if (fSource != nullptr)
		fSource->Release();
}


MessageData*
MessageReader::Read()
{
	if (fSize < 4) {
		_Fail(B_NOT_A_MESSAGE, size_t(0), "there are fewer bytes than a message begins with");
		return nullptr;
	}

	const uint32 magic = read_uint32(fBytes);
	fSwapped = magic == swap_if(kR5Magic, true) || magic == swap_if(kDanoMagic, true)
		|| magic == swap_if(kHaikuMagic, true);
	switch (swap_if(magic, fSwapped)) {
		case kR5Magic:
			return _ReadR5();
		case kHaikuMagic:
			return _ReadHaiku();
		case kDanoMagic:
			return _ReadDano();
		default:
			_Fail(B_NOT_A_MESSAGE, size_t(0), "no form of message begins with these bytes");
			return nullptr;
	}
}


// #pragma mark - the R5 form


// Everything is inlined here: this is where the time of opening an archive goes.
[[gnu::flatten]] MessageData*
MessageReader::_ReadR5()
{
	if (!_ReadR5Header())
		return nullptr;

	const uint8 messageFlags = fBytes[16];
	size_t position = kR5HeaderSize;
	position += (messageFlags & kR5HasTarget) != 0 ? 4 : 0;
	position += (messageFlags & kR5HasReply) != 0 ? 16 : 0;
	if (position >= fSize) {
		_Fail(B_BAD_VALUE, kR5HeaderSize, "the header passes the end of the message");
		return nullptr;
	}

	const size_t start = position;
	fIsCompact = fDamages == nullptr;
	Field field;
	while (position < fSize && (fBytes[position] & kR5Valid) != 0) {
		if (fFieldCount == kFewFields && !_ReserveFields(kFewFields + _CountR5Fields(position)))
			return nullptr;
		if (!_ReadR5Field(&position, &field)) {
			if (!_LeaveOut())
				return nullptr;
			return _Finish();
		}
		if (_KeepWholeItems(&field) && !_Take(field) && !_LeaveOut())
			return nullptr;
	}
	if (position >= fSize) {
		_Fail(B_BAD_VALUE, fSize, "the fields do not end before the message does");
		if (!_LeaveOut())
			return nullptr;
	}
	fBodySize = uint32(position - start);
	return _Finish();
}


// From here on the size is the one that the header gives.
bool
MessageReader::_ReadR5Header()
{
	if (fSize < kR5HeaderSize + 1)
		return _Fail(B_BAD_VALUE, fSize, "the header is cut short");
	size_t size = _Number32(fBytes + 8);
	if (size < kR5HeaderSize + 1)
		return _Fail(B_BAD_VALUE, size_t(8), "the size of the message is less than its header");
	if (size > fSize) {
		_Fail(B_BAD_VALUE, size_t(8), "the size of the message is more than there is");
		if (!_LeaveOut())
			return false;
		size = fSize;
	}
	fSize = size;
	fUsed = size;
	fWhat = _Number32(fBytes + 12);
	if ((fBytes[16] & kR5Valid) == 0)
		return _Fail(B_BAD_VALUE, size_t(16), "the message is not marked as valid");
	return true;
}


bool
MessageReader::_ReadR5Field(size_t* position, Field* field)
{
	const uint8* start = fBytes + *position;
	const uint8* end = fBytes + fSize;
	const uint8 flags = *start;
	const bool mini = (flags & kR5Mini) != 0;
	const bool single = (flags & kR5Single) != 0;
	const size_t header = 1 + 4 + (single ? 0 : (mini ? 1 : 4)) + (mini ? 1 : 4) + 1;
	if (size_t(end - start) < header)
		return _Fail(B_BAD_VALUE, start, "the field's header passes the end of the message");

	const uint8* at = start + 1;
	field->type = _Number32(at);
	at += 4;
	field->count = 1;
	if (!single) {
		field->count = mini ? *at : _Number32(at);
		at += mini ? 1 : 4;
	}
	field->size = mini ? *at : _Number32(at);
	at += mini ? 1 : 4;
	field->nameLength = *at++;
	if (size_t(end - at) < field->nameLength)
		return _Fail(B_BAD_VALUE, at, "the field's name passes the end of the message");
	field->name = reinterpret_cast<const char*>(at);
	at += field->nameLength;
	field->stated = field->size;
	if (size_t(end - at) < field->size) {
		_Fail(B_BAD_VALUE, at, "the field's data pass the end of the message");
		if (!_LeaveOut())
			return false;
		field->size = size_t(end - at);
	}
	field->start = start;
	field->data = at;
	field->fixed = (flags & kR5Fixed) != 0;

	_SetR5Flags(field, flags);
	*position = size_t(at - fBytes) + field->size;
	return true;
}


// Whether the head of the field is one that our writer would write in the same way.
void
MessageReader::_SetR5Flags(Field* field, uint8 flags)
{
	const bool mini = (flags & kR5Mini) != 0;
	const bool single = (flags & kR5Single) != 0;
	field->flags = 0;
	const bool whole = field->size == field->stated;
	if (whole && single == (field->count == 1) && (flags & 0xf0) == 0) {
		const bool fitsMini = field->count <= 255 && field->size <= 255;
		field->flags |= mini == fitsMini ? MessageField::kCompact : 0;
		field->flags |= mini ? 0 : MessageField::kWide;
	}
	fIsCompact = fIsCompact && (field->flags & MessageField::kCompact) != 0;
}


// Looks at nothing but where the fields end: what is wrong with them shows when they are read.
size_t
MessageReader::_CountR5Fields(size_t position) const
{
	size_t count = 0;
	while (position < fSize && (fBytes[position] & kR5Valid) != 0) {
		const bool mini = (fBytes[position] & kR5Mini) != 0;
		const bool single = (fBytes[position] & kR5Single) != 0;
		const size_t sizeAt = position + 5 + (single ? 0 : (mini ? 1 : 4));
		const size_t nameAt = sizeAt + (mini ? 1 : 4);
		if (nameAt >= fSize)
			return count + 1;
		const size_t size = mini ? fBytes[sizeAt] : _Number32(fBytes + sizeAt);
		count++;
		if (size == 0)
			break;
		position = nameAt + 1 + fBytes[nameAt] + size;
	}
	return count;
}


// #pragma mark - fields


bool
MessageReader::_Take(const Field& field)
{
	if (field.count == 0 || field.size == 0)
		return _Fail(B_BAD_VALUE, field.start, "the field has no items");
	if (has_zero(field.name, field.nameLength))
		return _Fail(B_BAD_VALUE, field.start, "the field's name has an end inside it");
	if (field.fixed && field.size % field.count != 0)
		return _Fail(B_BAD_VALUE, field.data, "the items do not divide the field's data evenly");
	if (!field.fixed && field.count > field.size / 5)
		return _Fail(B_BAD_VALUE, field.start, "there are more items than the data have room for");
	return fSwapped ? _TakeSwapped(field) : _TakeReference(field);
}


// In the host's byte order the field stays where it is.
bool
MessageReader::_TakeReference(const Field& field)
{
	MessageField* next = _NextField();
	if (next == nullptr)
		return false;
	MessageField& taken = *next;
	taken.name = uint32(reinterpret_cast<const uint8*>(field.name) - fBytes);
	taken.data = uint32(field.data - fBytes);
	taken.size = uint32(field.size);
	taken.count = field.count;
	taken.capacity = 0;
	taken.type = field.type;
	taken.key = name_key(field.name, field.nameLength);
	taken.table = nullptr;
	taken.nameLength = uint16(field.nameLength);
	taken.flags = field.flags | MessageField::kInSource | MessageField::kNameInSource
		| (field.fixed ? MessageField::kFixed : 0);
	if (!field.fixed) {
		if (field.count > kFewItems) {
			taken.table = static_cast<uint64*>(malloc(field.count * sizeof(uint64)));
			taken.capacity = field.count;
			if (taken.table == nullptr)
				return _Fail(B_NO_MEMORY, field.start, "there is not enough memory");
		}
		if (!_CheckItems(field, taken.table)) {
			free(taken.table);
			return false;
		}
	}

	fFieldCount++;
	return true;
}


// Room for one more field, which counts when it is complete.
inline MessageField*
MessageReader::_NextField()
{
	if (fManyFields == nullptr && fFieldCount < kFewFields)
		return fFewFields + fFieldCount;
	if (fFieldCount == fManyRoom && !_ReserveFields(size_t(fFieldCount) * 2))
		return nullptr;
	return fManyFields + fFieldCount;
}


// Moves all fields to where that many have room.
bool
MessageReader::_ReserveFields(size_t count)
{
	void* fields = realloc(fManyFields, count * sizeof(MessageField));
	if (fields == nullptr)
		return _Fail(B_NO_MEMORY, size_t(0), "there is not enough memory");
	if (fManyFields == nullptr)
		memcpy(fields, fFewFields, fFieldCount * sizeof(MessageField));
	fManyFields = static_cast<MessageField*>(fields);
	fManyRoom = count;
	return true;
}


// Walks over the sizes of variable items; the table, if any, gets their places.
bool
MessageReader::_CheckItems(const Field& field, uint64* table)
{
	const bool packed = (field.flags & MessageField::kPacked) != 0;
	const uint8* at = field.data;
	const uint8* end = field.data + field.size;
	for (uint32 i = 0; i < field.count; i++) {
		if (end - at < 5)
			return _Fail(B_BAD_VALUE, at, "an item lies outside the field's data");
		const size_t size = _Number32(at);
		const size_t bytes = packed ? size + 4 : padded_item_size(size);
		if (size == 0 || bytes > size_t(end - at))
			return _Fail(B_BAD_VALUE, at, "an item's size does not fit the field's data");
		if (table != nullptr)
			table[i] = ItemPlace::InSource(uint32(at - fBytes)).Word();
		at += bytes;
	}
	if (at != end) {
		// Bytes behind the last item would get lost; the form has no use for them.
		return _Fail(B_BAD_VALUE, at, "the field's data go on behind its last item");
	}
	return true;
}


MessageData*
MessageReader::_Finish()
{
	MessageData* data = fBuilt;
	fBuilt = nullptr;
	if (data == nullptr) {
		const uint32 bodySize = fIsCompact ? fBodySize : 0;
		data = fManyFields != nullptr
			? MessageData::CreateAround(fSource, fBytes, fManyFields, fFieldCount, fLevel, bodySize)
			: MessageData::CreateFrom(fSource, fBytes, fFewFields, fFieldCount, fLevel, bodySize);
		fManyFields = nullptr;
		// Whatever came of it, it has taken over the source and the tables.
		fSource = nullptr;
		fFieldCount = 0;
	}
	if (data == nullptr)
		_Fail(B_NO_MEMORY, size_t(0), "there is not enough memory");
	else
		data->SetWhat(fWhat);
	return data;
}


bool
MessageReader::_Fail(status_t status, const uint8* where, const char* reason)
{
	return _Fail(status, size_t(where - fBytes), reason);
}


bool
MessageReader::_Fail(status_t status, size_t offset, const char* reason)
{
	fStatus = status;
	fDamage = { offset, reason };
	return false;
}


} // namespace BPrivate
