// MessageReader: the Dano form.

#include <TypeConstants.h>

#include "app/private/MessageReader.h"

namespace BPrivate {

namespace {

constexpr uint32 kDanoSingle = 'SGDa';
constexpr uint32 kDanoFixedArray = 'FADa';
constexpr uint32 kDanoVariableArray = 'VADa';
constexpr uint32 kDanoEnd = 'DDEn';


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

} // namespace


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

	field.fixed = code == kDanoFixedArray;
	return _ReadDanoArray(&field, data, left, itemSize);
}


// The item size counts for items of a fixed size only; the ends of others follow them.
bool
MessageReader::_ReadDanoArray(Field* field, const uint8* data, size_t left, size_t itemSize)
{
	if (left < 8)
		return _Fail(B_BAD_DATA, data, "the section is too short for its items");
	field->count = _Number32(data);
	const size_t total = _Number32(data + 4);
	left -= 8;
	const uint8* items = data + 8;
	if (field->fixed) {
		if (field->count == 0 || itemSize == 0 || field->count > left / itemSize)
			return _Fail(B_BAD_DATA, data, "the items pass the end of their section");
		return _AddDanoItems(*field, items, field->count * itemSize, nullptr);
	}
	if (field->count == 0 || total > left || field->count > (left - total) / 4)
		return _Fail(B_BAD_DATA, data, "the items pass the end of their section");
	return _AddDanoItems(*field, items, total, items + total);
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


} // namespace BPrivate
