// MessageData: replacing, removing, moving and copying what is there.

#include <cstdlib>
#include <utility>

#include "app/private/MessageStore.h"

namespace BPrivate {


status_t
MessageData::ReplaceItem(uint32 number, uint32 index, const ItemContents& item)
{
	const size_t size = item.size;
	if (size > kLargestStore)
		return B_NO_MEMORY;
	_Changed();
	fBodySize = 0;
	MessageField& field = fFields[number];
	_NoteNested(field.type, item);
	if (field.Has(MessageField::kFixed)) {
		if (!_OwnFixed(field, field.size))
			return B_NO_MEMORY;
		memcpy(fStore + field.data + size_t(index) * size, item.data, size);
		return B_OK;
	}

	const ItemPlace old = PlaceAt(field, index);
	const size_t oldSize = ItemSizeAt(number, index);
	if (!old.IsNested() && !old.IsInSource()
		&& padded_item_size(oldSize) == padded_item_size(size)) {
		put_item(fStore + old.Offset(), item);
		return B_OK;
	}

	uint32 offset;
	if (!_Scatter(field, field.count) || !_PutItem(item, &offset))
		return B_NO_MEMORY;
	if (old.IsNested())
		old.Message()->Release();
	else if (!old.IsInSource())
		fWaste += uint32(padded_item_size(oldSize));
	field.table[index] = ItemPlace::InStore(offset).Word();
	field.size += uint32(padded_item_size(size)) - uint32(padded_item_size(oldSize));
	_CompactStore();
	return B_OK;
}


status_t
MessageData::ReplaceMessage(uint32 number, uint32 index, MessageData* data)
{
	MessageField& field = fFields[number];
	const size_t oldBytes = padded_item_size(ItemSizeAt(number, index));
	const size_t bytes = padded_item_size(data->FlatSize());
	if (field.size - oldBytes + bytes > kLargestStore || !_Scatter(field, field.count))
		return B_NO_MEMORY;
	_Changed();
	data->Acquire();
	const ItemPlace old(field.table[index]);
	if (old.IsNested())
		old.Message()->Release();
	else if (!old.IsInSource())
		fWaste += uint32(oldBytes);
	field.table[index] = ItemPlace::Nested(data).Word();
	field.size += uint32(bytes) - uint32(oldBytes);
	_NoteNested(field.type, { nullptr, 0, data });
	_CompactStore();
	return B_OK;
}


status_t
MessageData::RemoveItem(uint32 number, uint32 index)
{
	MessageField& field = fFields[number];
	if (field.count == 1) {
		RemoveField(number);
		return B_OK;
	}

	if (field.Has(MessageField::kFixed)) {
		if (!_OwnFixed(field, field.size))
			return B_NO_MEMORY;
		_Changed();
		fStoreIsBody = false;
		const uint32 size = field.ItemSize();
		uint8* item = fStore + field.data + size_t(index) * size;
		memmove(item, item + size, size_t(field.count - index - 1) * size);
		field.size -= size;
		field.flags &= uint16(~(MessageField::kCompact | MessageField::kWide));
	} else {
		const size_t bytes = padded_item_size(ItemSizeAt(number, index));
		if (!_Scatter(field, field.count))
			return B_NO_MEMORY;
		_Changed();
		const ItemPlace place(field.table[index]);
		if (place.IsNested())
			place.Message()->Release();
		else if (!place.IsInSource())
			fWaste += uint32(bytes);
		memmove(field.table + index, field.table + index + 1,
			(field.count - index - 1) * sizeof(uint64));
		field.size -= uint32(bytes);
	}
	field.count--;
	_CompactStore();
	return B_OK;
}


void
MessageData::RemoveField(uint32 number)
{
	_Changed();
	fStoreIsBody = false;
	fBodySize = 0;
	MessageField& field = fFields[number];
	if (!field.Has(MessageField::kInSource | MessageField::kScattered))
		fWaste += field.size + field.nameLength;
	_ReleaseTable(field);
	memmove(fFields + number, fFields + number + 1, (fCount - number - 1) * sizeof(MessageField));
	fCount--;
	if (fIndex != nullptr)
		_BuildIndex();
	_CompactStore();
}


status_t
MessageData::RenameField(uint32 number, const char* name, size_t length)
{
	MessageField& field = fFields[number];
	if (!field.Has(MessageField::kFixed) && !field.Has(MessageField::kScattered)
		&& field.Has(MessageField::kCompact) && !_Scatter(field, field.count))
		return B_NO_MEMORY;
	if (field.Has(MessageField::kFixed) && !_OwnFixed(field, field.size))
		return B_NO_MEMORY;
	if (!_ReserveStore(length))
		return B_NO_MEMORY;
	_Changed();
	fStoreIsBody = false;
	fBodySize = 0;
	if (length > 0)
		memcpy(fStore + fStoreSize, name, length);
	field.name = fStoreSize;
	field.nameLength = uint16(length);
	field.key = name_key(name, length);
	fNameBits |= name_bit(field.key);
	field.flags &=
		uint16(~(MessageField::kCompact | MessageField::kWide | MessageField::kNameInSource));
	fStoreSize += uint32(length);
	if (fIndex != nullptr)
		_BuildIndex();
	return B_OK;
}


void
MessageData::MoveField(uint32 from, uint32 to)
{
	if (from <= to)
		return;
	const MessageField moved = fFields[from];
	memmove(fFields + to + 1, fFields + to, (from - to) * sizeof(MessageField));
	fFields[to] = moved;
	_Changed();
	fStoreIsBody = false;
	fBodySize = 0;
	if (fIndex != nullptr)
		_BuildIndex();
}


void
MessageData::SetCarried(uint32 number, bool carried)
{
	if (carried)
		fFields[number].flags |= MessageField::kCarried;
	else
		fFields[number].flags &= uint16(~MessageField::kCarried);
}


void
MessageData::SetTwin(uint32 number, int32 place)
{
	if (place >= 0)
		fFields[number].flags |= MessageField::kTwin;
	else
		fFields[number].flags &= uint16(~MessageField::kTwin);
	fFields[number].place = uint32(place);
}


// #pragma mark - copying


// Shares the bytes that both were read from, if they are the same or there are none here yet.
status_t
MessageData::CopyField(const MessageData& from, uint32 number)
{
	const MessageField& original = from.fFields[number];
	const bool whole = original.Has(MessageField::kInSource)
		&& original.Has(MessageField::kNameInSource) && !original.Has(MessageField::kScattered);
	if (whole && fSource == nullptr && from.fSource != nullptr) {
		from.fSource->Acquire();
		fSource = from.fSource;
		fSourceBase = from.fSourceBase;
	}
	if (whole && fSourceBase == from.fSourceBase)
		return _ShareField(original);

	const status_t status = _CopyItems(from, number);
	if (status == B_OK) {
		MessageField& copy = fFields[fCount - 1];
		copy.flags |= original.flags & uint16(MessageField::kCarried | MessageField::kTwin);
		copy.place = original.place;
	}
	return status;
}


// For a field whose bytes lie in what both messages were read from.
status_t
MessageData::_ShareField(const MessageField& original)
{
	if (!_ReserveFields(1) || !_CopyPlaces(original, &fFields[fCount]))
		return B_NO_MEMORY;
	_Changed();
	fStoreIsBody = false;
	fBodySize = 0;
	fPlain.store(-1, std::memory_order_relaxed);
	_AddToIndex(fCount++);
	return B_OK;
}


status_t
MessageData::_CopyItems(const MessageData& from, uint32 number)
{
	const MessageField& original = from.fFields[number];
	const char* name = from.NameBytes(original);
	const bool fixed = original.Has(MessageField::kFixed);
	status_t status = B_OK;
	for (uint32 i = 0; i < original.count && status == B_OK; i++) {
		const uint32 last = fCount - 1;
		if (MessageData* nested = from.MessageAt(number, i)) {
			status = i == 0 ? AddMessageField(name, original.nameLength, original.type, nested)
							: AddMessageItem(last, nested);
			continue;
		}
		const void* data;
		size_t size;
		status = from.GetItem(number, i, &data, &size);
		if (status != B_OK)
			break;
		const ItemContents item { data, size };
		status = i == 0 ? AddField(name, original.nameLength, original.type, fixed, item)
						: AddItem(last, item);
	}
	return status;
}


status_t
MessageData::CopyFieldOver(uint32 target, const MessageData& from, uint32 number)
{
	const uint32 oldCount = fCount;
	const status_t status = CopyField(from, number);
	if (status != B_OK) {
		if (fCount > oldCount)
			RemoveField(oldCount);
		return status;
	}
	const MessageField made = fFields[oldCount];
	fFields[oldCount] = fFields[target];
	fFields[target] = made;
	RemoveField(oldCount);
	return B_OK;
}


} // namespace BPrivate
