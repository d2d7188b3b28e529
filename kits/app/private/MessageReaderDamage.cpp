// MessageReader: what is left of damaged fields.
#include "app/private/MessageReader.h"

namespace BPrivate {


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
bool
MessageReader::_ShortenToWholeItems(Field* field)
{
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


} // namespace BPrivate
