#include "app/private/WriteBack.h"

namespace BPrivate {


// The field's number in the source, or -1 for a field that is new.
int32
WriteBack::_PlaceOf(const MessageData& target, uint32 number) const
{
	const MessageField& field = target.FieldAt(number);
	return fSource->Find(target.NameBytes(field), field.nameLength);
}


int32
WriteBack::MakeRoom(MessageData& target, int32 field)
{
	const uint32 number = uint32(field);
	if (!target.FieldAt(number).Has(MessageField::kCarried))
		return field;
	if (fFirstItemOwn < 0 || _PlaceOf(target, number) != fFirstItemOwn) {
		target.RemoveField(number);
		return -1;
	}
	while (target.FieldAt(number).count > 1) {
		if (target.RemoveItem(number, target.FieldAt(number).count - 1) != B_OK)
			break;
	}
	target.SetCarried(number, false);
	return field;
}


void
WriteBack::PlaceLast(MessageData& target) const
{
	const uint32 last = target.CountFields() - 1;
	const int32 place = _PlaceOf(target, last);
	if (place < 0)
		return;
	// Before the first of those at the end that came later in the source; new fields among them
	// were added behind it by then and stay behind.
	uint32 to = last;
	for (uint32 i = last; i-- > 0;) {
		const int32 other = _PlaceOf(target, i);
		if (other > place)
			to = i;
		else if (other >= 0)
			break;
	}
	target.MoveField(last, to);
}


bool
WriteBack::IsUnchanged(const MessageData& target) const
{
	if (target.CountFields() != fSource->CountFields())
		return false;
	for (uint32 i = 0; i < target.CountFields(); i++) {
		if (!target.HasSameField(i, *fSource))
			return false;
	}
	return true;
}


status_t
WriteBack::Restore(MessageData& target, uint32 sourceField, bool carried) const
{
	const MessageField& field = fSource->FieldAt(sourceField);
	const int32 present = target.Find(fSource->NameBytes(field), field.nameLength);
	if (present >= 0) {
		const status_t status = target.CopyFieldOver(uint32(present), *fSource, sourceField);
		if (status == B_OK)
			target.SetCarried(uint32(present), carried);
		return status;
	}
	const status_t status = target.CopyField(*fSource, sourceField);
	if (status == B_OK) {
		target.SetCarried(target.CountFields() - 1, carried);
		PlaceLast(target);
	}
	return status;
}


} // namespace BPrivate
