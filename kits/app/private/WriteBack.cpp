#include "app/private/WriteBack.h"

#include "app/private/TwinFields.h"

namespace BPrivate {


// The field's number in the source, or -1 for a field that is new.
int32
WriteBack::_PlaceOf(const MessageData& target, uint32 number) const
{
	const MessageField& field = target.FieldAt(number);
	if (field.Has(MessageField::kTwin))
		return int32(field.place);
	return fSource->Find(target.NameBytes(field), field.nameLength);
}


int32
WriteBack::Find(const MessageData& target, const char* name, size_t length)
{
	int32 found = target.Find(name, length);
	while (found >= 0 && target.FieldAt(uint32(found)).Has(MessageField::kTwin))
		found = next_of_name(target, uint32(found));
	return found;
}


int32
WriteBack::MakeRoom(MessageData& target, const char* name, size_t length)
{
	const int32 field = Find(target, name, length);
	const uint32 number = uint32(field);
	if (field < 0 || !target.FieldAt(number).Has(MessageField::kCarried))
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
	const int32 present = Find(target, fSource->NameBytes(field), field.nameLength);
	if (present >= 0) {
		const status_t status = target.CopyFieldOver(uint32(present), *fSource, sourceField);
		if (status == B_OK) {
			target.SetCarried(uint32(present), carried);
			target.SetTwin(uint32(present), -1);
		}
		return status;
	}
	const status_t status = target.CopyField(*fSource, sourceField);
	if (status == B_OK) {
		target.SetCarried(target.CountFields() - 1, carried);
		target.SetTwin(target.CountFields() - 1, -1);
		PlaceLast(target);
	}
	return status;
}


// The first of the name may be missing in the target, its twins are always there.
void
WriteBack::MarkTwins(MessageData& target, const char* name) const
{
	std::vector<int32> places;
	for (int32 i = fSource->Find(name); i >= 0; i = next_of_name(*fSource, uint32(i)))
		places.push_back(i);
	std::vector<int32> present;
	for (int32 i = target.Find(name); i >= 0; i = next_of_name(target, uint32(i)))
		present.push_back(i);
	while (places.size() > 1 && !present.empty()) {
		target.SetTwin(uint32(present.back()), places.back());
		places.pop_back();
		present.pop_back();
	}
}


status_t
WriteBack::RestoreTwin(MessageData& target, uint32 sourceField) const
{
	const status_t status = target.CopyField(*fSource, sourceField);
	if (status == B_OK) {
		target.SetTwin(target.CountFields() - 1, int32(sourceField));
		PlaceLast(target);
	}
	return status;
}


} // namespace BPrivate
