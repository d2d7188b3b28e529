// MessageReader: the Haiku form.
#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

enum HaikuFlag : uint32 {
	kHaikuValid = 0x01,
	kHaikuFixed = 0x02,
};

} // namespace


MessageData*
MessageReader::_ReadHaiku()
{
	size_t count;
	size_t areaSize;
	if (!_ReadHaikuHeader(&count, &areaSize))
		return nullptr;
	const size_t areaStart = kHaikuHeaderSize + count * kHaikuFieldSize;
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


// The number of fields, and the bytes behind their heads.
bool
MessageReader::_ReadHaikuHeader(size_t* _count, size_t* _areaSize)
{
	if (fSize < kHaikuHeaderSize)
		return _Fail(B_BAD_VALUE, fSize, "the header is cut short");
	fWhat = _Number32(fBytes + 4);
	if ((_Number32(fBytes + 8) & kHaikuValid) == 0)
		return _Fail(B_BAD_VALUE, size_t(8), "the message is not marked as valid");
	if (_Number32(fBytes + 44) != kHaikuHashSize)
		return _Fail(B_BAD_VALUE, size_t(44), "the hash table has not its five slots");
	*_count = _Number32(fBytes + 40);
	const size_t mostFields = (fSize - kHaikuHeaderSize) / kHaikuFieldSize;
	if (*_count > mostFields) {
		_Fail(B_BAD_VALUE, size_t(40), "there are more fields than the message has room for");
		if (!_LeaveOut())
			return false;
		*_count = mostFields;
	}
	*_areaSize = _Number32(fBytes + 36);
	const size_t room = fSize - kHaikuHeaderSize - *_count * kHaikuFieldSize;
	if (*_areaSize > room) {
		_Fail(B_BAD_VALUE, size_t(36), "the data pass the end of the message");
		if (!_LeaveOut())
			return false;
		*_areaSize = room;
	}
	return true;
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


} // namespace BPrivate
