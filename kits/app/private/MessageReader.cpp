#include "app/private/MessageReader.h"

#include <bit>
#include <cstdlib>

#include <ByteOrder.h>

#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

constexpr uint32 kFewItems = 8; // as many are found without a table
constexpr uint32 kFewFields = 32; // as many have room in the reader itself

enum R5MessageFlag : uint8 {
	kR5HasTarget = 0x02,
	kR5HasReply = 0x04,
};

enum HaikuFlag : uint32 {
	kHaikuValid = 0x01,
	kHaikuFixed = 0x02,
};

constexpr uint32 kDanoSingle = 'SGDa';
constexpr uint32 kDanoFixedArray = 'FADa';
constexpr uint32 kDanoVariableArray = 'VADa';
constexpr uint32 kDanoEnd = 'DDEn';


uint32
swap_if(uint32 value, bool swapped)
{
	return swapped ? __builtin_bswap32(value) : value;
}


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


// Types that the Dano form stores alone without saying whether their size is fixed.
bool
is_fixed_in_dano(type_code type)
{
	switch (type) {
		case B_RECT_TYPE:
		case B_POINT_TYPE:
		case B_INT8_TYPE:
		case B_INT16_TYPE:
		case B_INT32_TYPE:
		case B_INT64_TYPE:
		case B_BOOL_TYPE:
		case B_FLOAT_TYPE:
		case B_DOUBLE_TYPE:
		case B_POINTER_TYPE:
		case B_MESSENGER_TYPE:
			return true;
		default:
			return false;
	}
}


// Turns an item of the other byte order into the host's. Sizes and alignments are younger than the
// R5 form's swapping: its writers and readers leave their bytes alone.
void
swap_item(type_code type, uint8* item, size_t size, bool isR5)
{
	switch (type) {
		case B_SIZE_TYPE:
		case B_ALIGNMENT_TYPE:
			if (!isR5)
				swap_data(type, item, size, B_SWAP_ALWAYS);
			break;

		case B_SIZE_T_TYPE:
		case B_SSIZE_T_TYPE:
		case B_POINTER_TYPE:
		case B_TIME_TYPE:
			// As wide as a word of the machine that wrote it.
			swap_data(size >= 8 ? B_INT64_TYPE : B_INT32_TYPE, item, size, B_SWAP_ALWAYS);
			break;

		case B_MESSENGER_TYPE:
			swap_data(B_INT32_TYPE, item, min_c(size, size_t(12)), B_SWAP_ALWAYS);
			break;

		case B_REF_TYPE:
		case B_NODE_REF_TYPE:
			if (size >= 12) {
				swap_data(B_INT32_TYPE, item, 4, B_SWAP_ALWAYS);
				swap_data(B_INT64_TYPE, item + 4, 8, B_SWAP_ALWAYS);
			}
			break;

		default:
			swap_data(type, item, size, B_SWAP_ALWAYS);
			break;
	}
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


inline uint16
MessageReader::_Number16(const uint8* from) const
{
	uint16 value;
	memcpy(&value, from, sizeof(value));
	return fSwapped ? __builtin_bswap16(value) : value;
}


inline uint32
MessageReader::_Number32(const uint8* from) const
{
	return swap_if(read_uint32(from), fSwapped);
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

	field->flags = 0;
	const bool whole = field->size == field->stated;
	if (whole && single == (field->count == 1) && (flags & 0xf0) == 0) {
		const bool fitsMini = field->count <= 255 && field->size <= 255;
		field->flags |= mini == fitsMini ? MessageField::kCompact : 0;
		field->flags |= mini ? 0 : MessageField::kWide;
	}
	fIsCompact = fIsCompact && (field->flags & MessageField::kCompact) != 0;
	*position = size_t(at - fBytes) + field->size;
	return true;
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


// #pragma mark - the Haiku form


MessageData*
MessageReader::_ReadHaiku()
{
	if (fSize < kHaikuHeaderSize) {
		_Fail(B_BAD_VALUE, fSize, "the header is cut short");
		return nullptr;
	}
	fWhat = _Number32(fBytes + 4);
	if ((_Number32(fBytes + 8) & kHaikuValid) == 0) {
		_Fail(B_BAD_VALUE, size_t(8), "the message is not marked as valid");
		return nullptr;
	}
	size_t areaSize = _Number32(fBytes + 36);
	size_t count = _Number32(fBytes + 40);
	if (_Number32(fBytes + 44) != kHaikuHashSize) {
		_Fail(B_BAD_VALUE, size_t(44), "the hash table has not its five slots");
		return nullptr;
	}
	const size_t mostFields = (fSize - kHaikuHeaderSize) / kHaikuFieldSize;
	if (count > mostFields) {
		_Fail(B_BAD_VALUE, size_t(40), "there are more fields than the message has room for");
		if (!_LeaveOut())
			return nullptr;
		count = mostFields;
	}
	const size_t areaStart = kHaikuHeaderSize + count * kHaikuFieldSize;
	if (areaSize > fSize - areaStart) {
		_Fail(B_BAD_VALUE, size_t(36), "the data pass the end of the message");
		if (!_LeaveOut())
			return nullptr;
		areaSize = fSize - areaStart;
	}
	fUsed = areaStart + areaSize;
	if (count > kFewFields && !fSwapped && !_ReserveFields(count))
		return nullptr;

	Field field;
	for (size_t i = 0; i < count; i++) {
		const size_t position = kHaikuHeaderSize + i * kHaikuFieldSize;
		const bool read = _ReadHaikuField(position, areaStart, areaSize, &field);
		if (read && !_KeepWholeItems(&field))
			continue;
		if ((!read || !_Take(field)) && !_LeaveOut())
			return nullptr;
	}
	return _Finish();
}


bool
MessageReader::_ReadHaikuField(size_t position, size_t areaStart, size_t areaSize, Field* field)
{
	const uint8* header = fBytes + position;
	const uint16 flags = _Number16(header);
	if ((flags & kHaikuValid) == 0)
		return _Fail(B_BAD_VALUE, header, "the field is not marked as valid");
	const size_t nameLength = _Number16(header + 2);
	const size_t offset = _Number32(header + 16);
	field->type = _Number32(header + 4);
	field->count = _Number32(header + 8);
	field->size = _Number32(header + 12);
	field->stated = field->size;
	if (offset > areaSize || nameLength > areaSize - offset)
		return _Fail(B_BAD_VALUE, header + 16, "the field lies outside the message's data");
	if (field->size > areaSize - offset - nameLength) {
		_Fail(B_BAD_VALUE, header + 16, "the field lies outside the message's data");
		if (!_LeaveOut())
			return false;
		field->size = areaSize - offset - nameLength;
	}

	const uint8* name = fBytes + areaStart + offset;
	if (nameLength == 0 || name[nameLength - 1] != 0)
		return _Fail(B_BAD_VALUE, header + 2, "the field's name has no end");
	field->name = reinterpret_cast<const char*>(name);
	field->nameLength = nameLength - 1;
	field->fixed = (flags & kHaikuFixed) != 0;
	field->data = name + nameLength;
	field->flags = field->fixed ? 0 : MessageField::kPacked;
	field->start = field->data;
	return true;
}


// #pragma mark - the Dano form


// A chain of sections, each padded to eight bytes. It is only read, so its fields are copied.
MessageData*
MessageReader::_ReadDano()
{
	if (fSize < 16) {
		_Fail(B_BAD_VALUE, fSize, "the header is cut short");
		return nullptr;
	}
	const size_t size = _Number32(fBytes + 4);
	if (size < 16 || size > fSize) {
		_Fail(B_BAD_VALUE, size_t(4), "the size of the message does not fit what there is");
		return nullptr;
	}
	fSize = size;
	fUsed = size;
	fWhat = _Number32(fBytes + 8);

	size_t position = 16;
	while (fSize - position >= 8) {
		const uint32 code = _Number32(fBytes + position);
		const size_t sectionSize = _Number32(fBytes + position + 4);
		if (code == kDanoEnd)
			break;
		if (sectionSize < 8 || sectionSize > fSize - position) {
			_Fail(B_BAD_DATA, position + 4, "the section's size does not fit the message");
			return nullptr;
		}
		if (sectionSize > 8 && !_ReadDanoSection(code, position + 8, position + sectionSize))
			return nullptr;
		position += min_c((sectionSize + 7) & ~size_t(7), fSize - position);
	}
	return _Finish();
}


bool
MessageReader::_ReadDanoSection(uint32 code, size_t position, size_t end)
{
	if (code != kDanoSingle && code != kDanoFixedArray && code != kDanoVariableArray)
		return true;

	const uint8* body = fBytes + position;
	const size_t size = end - position;
	if (size < 10)
		return _Fail(B_BAD_DATA, body, "the section is too short for a field");
	Field field = {};
	field.type = _Number32(body);
	field.nameLength = body[8];
	field.name = reinterpret_cast<const char*>(body + 9);
	const size_t dataStart = (9 + field.nameLength + 1 + 7) & ~size_t(7);
	if (dataStart >= size || body[9 + field.nameLength] != 0)
		return _Fail(B_BAD_DATA, body + 8, "the field's name has no end");

	const uint8* data = body + dataStart;
	const size_t left = size - dataStart;
	const size_t itemSize = _Number32(body + 4);
	if (code == kDanoSingle) {
		field.fixed = is_fixed_in_dano(field.type);
		field.count = 1;
		if (itemSize == 0 || itemSize > left)
			return _Fail(B_BAD_DATA, body + 4, "the item passes the end of its section");
		return _AddDanoItems(field, data, itemSize, nullptr);
	}

	if (left < 8)
		return _Fail(B_BAD_DATA, data, "the section is too short for its items");
	field.fixed = code == kDanoFixedArray;
	field.count = _Number32(data);
	const size_t total = _Number32(data + 4);
	data += 8;
	if (field.fixed) {
		if (field.count == 0 || itemSize == 0 || field.count > (left - 8) / itemSize)
			return _Fail(B_BAD_DATA, data - 8, "the items pass the end of their section");
		return _AddDanoItems(field, data, field.count * itemSize, nullptr);
	}
	if (field.count == 0 || total > left - 8 || field.count > (left - 8 - total) / 4)
		return _Fail(B_BAD_DATA, data - 8, "the items pass the end of their section");
	return _AddDanoItems(field, data, total, data + total);
}


bool
MessageReader::_AddDanoItems(const Field& field, const uint8* items, size_t size, const uint8* ends)
{
	if (memchr(field.name, 0, field.nameLength) != nullptr)
		return _Fail(B_BAD_DATA, items, "the field's name has an end inside it");
	size_t start = 0;
	const size_t itemSize = size / field.count;
	for (uint32 i = 0; i < field.count; i++) {
		const size_t end = ends != nullptr ? _Number32(ends + i * size_t(4)) : start + itemSize;
		if (end <= start || end > size)
			return _Fail(B_BAD_DATA, items, "an item's end does not fit the items");
		if (!_AddSwappedItem(field, i == 0, items + start, end - start))
			return false;
		start = ends != nullptr ? (end + 7) & ~size_t(7) : end;
	}
	return true;
}


// #pragma mark - damage


// Notes the last failure, if damages may be left out.
bool
MessageReader::_LeaveOut()
{
	if (fDamages == nullptr || fStatus == B_NO_MEMORY)
		return false;
	fDamages->push_back(fDamage);
	fStatus = B_OK;
	return true;
}


// The head in front of the name tells another count and size than what is left.
void
MessageReader::_Shorten(Field* field, uint32 count)
{
	field->flags &= uint16(~(MessageField::kCompact | MessageField::kWide));
	field->count = count;
}


// Leaves the items of a damaged field that are wholly there. False when nothing of it is left.
inline bool
MessageReader::_KeepWholeItems(Field* field)
{
	if (fDamages == nullptr || field->count == 0)
		return true;
	const bool noted = field->size < field->stated;
	if (!field->fixed)
		return _KeepWholeVariableItems(field, noted);

	const size_t itemSize = field->stated / field->count;
	if (itemSize == 0)
		return true;
	if (!noted && field->stated % field->count != 0) {
		_Fail(B_BAD_VALUE, field->data, "the items do not divide the field's data evenly");
		_LeaveOut();
	}
	_Shorten(field, uint32(min_c(size_t(field->count), field->size / itemSize)));
	field->size = field->count * itemSize;
	return field->count > 0;
}


bool
MessageReader::_KeepWholeVariableItems(Field* field, bool noted)
{
	const bool packed = (field->flags & MessageField::kPacked) != 0;
	const uint8* at = field->data;
	const uint8* end = at + field->size;
	uint32 whole = 0;
	for (; whole < field->count && end - at >= 5; whole++) {
		const size_t size = _Number32(at);
		const size_t bytes = packed ? size + 4 : padded_item_size(size);
		if (size == 0 || bytes > size_t(end - at)) {
			const size_t there = min_c(size, size_t(end - at) - 4);
			if (there > 0)
				fCutItems.push_back({ field->name, field->nameLength, field->type, at + 4, there });
			break;
		}
		at += bytes;
	}
	if (whole == field->count && at == end)
		return true;
	if (!noted) {
		_Fail(B_BAD_VALUE, at, "an item's size does not fit the field's data");
		_LeaveOut();
	}
	_Shorten(field, whole);
	field->size = size_t(at - field->data);
	return whole > 0;
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


bool
MessageReader::_TakeSwapped(const Field& field)
{
	if (field.fixed) {
		const size_t size = field.size / field.count;
		for (uint32 i = 0; i < field.count; i++) {
			if (!_AddSwappedItem(field, i == 0, field.data + i * size, size))
				return false;
		}
		return true;
	}

	if (!_CheckItems(field, nullptr))
		return false;
	const bool packed = (field.flags & MessageField::kPacked) != 0;
	const uint8* at = field.data;
	for (uint32 i = 0; i < field.count; i++) {
		const size_t size = _Number32(at);
		if (!_AddSwappedItem(field, i == 0, at + 4, size))
			return false;
		at += packed ? size + 4 : padded_item_size(size);
	}
	return true;
}


// Adds a copy in the host's byte order.
bool
MessageReader::_AddSwappedItem(const Field& field, bool first, const uint8* item, size_t size)
{
	if (fBuilt == nullptr)
		fBuilt = MessageData::Create();
	status_t status = fBuilt != nullptr ? status_t(B_OK) : status_t(B_NO_MEMORY);

	uint8 few[64];
	uint8* swapped = size <= sizeof(few) ? few : static_cast<uint8*>(malloc(size));
	if (swapped == nullptr)
		status = B_NO_MEMORY;
	if (status == B_OK) {
		memcpy(swapped, item, size);
		if (fSwapped)
			swap_item(field.type, swapped, size, read_uint32(fBytes) == swap_if(kR5Magic, true));
		status = first ? fBuilt->AddField(
					 field.name, field.nameLength, field.type, field.fixed, { swapped, size })
					   : fBuilt->AddItem(fBuilt->CountFields() - 1, { swapped, size });
	}
	if (swapped != few)
		free(swapped);
	return status == B_OK || _Fail(status, item, "there is not enough memory");
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


// #pragma mark - forms


static uint32
r5_checksum(const uint8* bytes, size_t size)
{
	uint32 sum = 0;
	for (size_t i = 0; i < size; i += 4) {
		uint32 group = 0;
		for (size_t k = i; k < i + 4 && k < size; k++)
			group = group << 8 | bytes[k];
		sum += group;
	}
	return sum;
}


// Whether some field is written the wide way though the compact one would do.
static bool
is_wide_r5(const uint8* bytes, size_t size, bool swapped)
{
	size_t position = kR5HeaderSize;
	position += (bytes[16] & kR5HasTarget) != 0 ? 4 : 0;
	position += (bytes[16] & kR5HasReply) != 0 ? 16 : 0;
	while (position < size && (bytes[position] & kR5Valid) != 0) {
		const uint8 flags = bytes[position];
		if ((flags & kR5Mini) != 0)
			return false;
		const bool single = (flags & kR5Single) != 0;
		const size_t sizeAt = position + (single ? 5 : 9);
		if (sizeAt + 5 > size)
			return false;
		const uint32 count = single ? 1 : swap_if(read_uint32(bytes + position + 5), swapped);
		const uint32 dataSize = swap_if(read_uint32(bytes + sizeAt), swapped);
		if (count <= 255 && dataSize <= 255)
			return true;
		position = sizeAt + 5 + bytes[sizeAt + 4] + dataSize;
	}
	return false;
}


status_t
read_message_form(const uint8* bytes, size_t size, message_form_info* _info)
{
	*_info = { B_NO_MESSAGE_FORM, false, 0, true };
	if (size < 4)
		return B_NOT_A_MESSAGE;
	uint32 magic = read_uint32(bytes);
	const bool swapped = magic == swap_if(kR5Magic, true) || magic == swap_if(kDanoMagic, true)
		|| magic == swap_if(kHaikuMagic, true);
	magic = swap_if(magic, swapped);

	const auto number = [&](size_t at) { return swap_if(read_uint32(bytes + at), swapped); };
	_info->big_endian = swapped != (std::endian::native == std::endian::big);
	if (magic == kR5Magic && size >= kR5HeaderSize) {
		_info->size = number(8);
		size_t header = kR5HeaderSize;
		header += (bytes[16] & kR5HasTarget) != 0 ? 4 : 0;
		header += (bytes[16] & kR5HasReply) != 0 ? 16 : 0;
		_info->checksum_matches = size >= header && number(4) == r5_checksum(bytes + 8, header - 8);
		const bool wide = is_wide_r5(bytes, min_c(size, _info->size), swapped);
		_info->form = wide ? B_R5_WIDE_FORM : B_R5_FORM;
	} else if (magic == kHaikuMagic && size >= kHaikuHeaderSize) {
		_info->form = B_HAIKU_FORM;
		_info->size = kHaikuHeaderSize + size_t(number(40)) * kHaikuFieldSize + number(36);
	} else if (magic == kDanoMagic && size >= 16) {
		_info->form = B_DANO_FORM;
		_info->size = number(4);
	} else
		return B_NOT_A_MESSAGE;
	return B_OK;
}


size_t
read_message_size(const uint8* bytes, size_t size)
{
	if (size < 16)
		return 0;
	uint32 magic = read_uint32(bytes);
	const bool swapped = magic == swap_if(kR5Magic, true) || magic == swap_if(kDanoMagic, true)
		|| magic == swap_if(kHaikuMagic, true);
	magic = swap_if(magic, swapped);
	const auto number = [&](size_t at) { return swap_if(read_uint32(bytes + at), swapped); };
	if (magic == kR5Magic)
		return number(8);
	if (magic == kDanoMagic)
		return number(4);
	if (magic == kHaikuMagic && size >= kHaikuHeaderSize)
		return kHaikuHeaderSize + size_t(number(40)) * kHaikuFieldSize + number(36);
	return 0;
}


} // namespace BPrivate
