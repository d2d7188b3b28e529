// MessageData: adding fields and items, and the store that they are put into.

#include <cstdlib>

#include <TypeConstants.h>

#include "app/private/MessageStore.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

// The head of most fields: one small item.
void
write_mini_head(uint8* to, const MessageField& field)
{
	*to = kR5Valid | kR5Mini | kR5Single | (field.Has(MessageField::kFixed) ? kR5Fixed : 0);
	write_uint32(to + 1, field.type);
	to[5] = uint8(field.size);
	to[6] = uint8(field.nameLength);
}

} // namespace


status_t
MessageData::AddField(
	const char* name, size_t length, type_code type, bool fixed, const ItemContents& item)
{
	if (item.size > kLargestStore)
		return B_NO_MEMORY;
	const size_t bytes = fixed ? item.size : padded_item_size(item.size);
	// The R5 form has a byte for the length of a name; longer ones come from the other form.
	const bool compact = length <= UINT8_MAX;
	const uint32 header = compact ? r5_field_header_length(1, bytes, B_R5_FORM) : 0;
	if (!_ReserveStore(header + length + bytes) || !_ReserveFields(1))
		return B_NO_MEMORY;
	_Changed();
	fStoreIsBody = fStoreIsBody && fBodySize == 0 && compact;
	fBodySize = 0;
	_NoteNested(type, item);

	MessageField& field = fFields[fCount];
	const uint32 start = fStoreSize;
	field.name = start + header;
	field.data = field.name + uint32(length);
	field.size = uint32(bytes);
	field.count = 1;
	field.capacity = fixed ? uint32(bytes) : 0;
	field.type = type;
	field.key = name_key(name, length);
	field.table = nullptr;
	field.nameLength = uint16(length);
	field.flags = fixed ? MessageField::kFixed : 0;
	if (compact && bytes <= UINT8_MAX) {
		field.flags |= MessageField::kCompact;
		write_mini_head(fStore + start, field);
	} else if (compact) {
		field.flags |= MessageField::kCompact | MessageField::kWide;
		write_r5_field_head(fStore + start, field, bytes, B_R5_FORM);
	}
	memcpy(fStore + field.name, name, length);
	if (fixed)
		memcpy(fStore + field.data, item.data, item.size);
	else
		put_item(fStore + field.data, item);
	fStoreSize = field.data + uint32(bytes);
	fNameBits |= name_bit(field.key);
	fCount++;
	if (fIndex != nullptr || fCount > kFewFields)
		_AddToIndex(fCount - 1);
	return B_OK;
}


status_t
MessageData::AddItem(uint32 number, const ItemContents& item)
{
	if (item.size > kLargestStore || fFields[number].count == INT32_MAX)
		return B_NO_MEMORY;
	_Changed();
	fBodySize = 0;
	MessageField& field = fFields[number];
	_NoteNested(field.type, item);
	return field.Has(MessageField::kFixed) ? _AppendFixed(field, item)
										   : _AppendVariable(field, item);
}


status_t
MessageData::AddMessageField(const char* name, size_t length, type_code type, MessageData* data)
{
	uint64* table = static_cast<uint64*>(malloc(sizeof(uint64)));
	if (table == nullptr || !_ReserveStore(length) || !_ReserveFields(1)) {
		free(table);
		return B_NO_MEMORY;
	}
	_Changed();
	fStoreIsBody = false;
	fBodySize = 0;

	MessageField& field = fFields[fCount];
	field = {};
	field.name = fStoreSize;
	field.nameLength = uint16(length);
	field.size = uint32(padded_item_size(data->FlatSize()));
	field.count = 1;
	field.capacity = 1;
	field.type = type;
	field.key = name_key(name, length);
	field.flags = MessageField::kScattered;
	field.table = table;
	data->Acquire();
	table[0] = ItemPlace::Nested(data).Word();
	if (length > 0)
		memcpy(fStore + fStoreSize, name, length);
	fStoreSize += uint32(length);
	_NoteNested(type, { nullptr, 0, data });
	_AddToIndex(fCount++);
	return B_OK;
}


status_t
MessageData::AddMessageItem(uint32 number, MessageData* data)
{
	MessageField& field = fFields[number];
	const size_t bytes = padded_item_size(data->FlatSize());
	if (field.size + bytes > kLargestStore || !_Scatter(field, field.count + 1))
		return B_NO_MEMORY;
	_Changed();
	data->Acquire();
	field.table[field.count++] = ItemPlace::Nested(data).Word();
	field.size += uint32(bytes);
	_NoteNested(field.type, { nullptr, 0, data });
	return B_OK;
}


// #pragma mark - private


bool
MessageData::_GrowFields(uint32 count)
{
	const uint32 needed = fCount + count;
	const uint32 room = max_c(needed, fFieldRoom * 2);
	const bool isBehind = fFields == reinterpret_cast<MessageField*>(this + 1);
	void* fields = realloc(isBehind ? nullptr : fFields, room * sizeof(MessageField));
	if (fields == nullptr)
		return false;
	if (isBehind)
		memcpy(fields, fFields, fCount * sizeof(MessageField));
	fFields = static_cast<MessageField*>(fields);
	fFieldRoom = room;
	return true;
}


bool
MessageData::_IsAtEnd(const MessageField& field) const
{
	return !field.Has(MessageField::kInSource | MessageField::kScattered)
		&& field.data + field.size == fStoreSize;
}


status_t
MessageData::_AppendFixed(MessageField& field, const ItemContents& item)
{
	const size_t size = item.size;
	if (_IsAtEnd(field)) {
		const status_t status = _Lengthen(field, uint32(size));
		if (status != B_OK)
			return status;
		memcpy(fStore + fStoreSize, item.data, size);
		fStoreSize += uint32(size);
		field.capacity = field.size;
		return B_OK;
	}
	if (field.Has(MessageField::kInSource) || field.size + size > field.capacity) {
		if (!_OwnFixed(field, (field.size + size) * 2))
			return B_NO_MEMORY;
	}
	memcpy(fStore + field.data + field.size, item.data, size);
	field.size += uint32(size);
	field.count++;
	fStoreIsBody = false;
	field.flags &= uint16(~(MessageField::kCompact | MessageField::kWide));
	return B_OK;
}


status_t
MessageData::_AppendVariable(MessageField& field, const ItemContents& item)
{
	const size_t bytes = padded_item_size(item.size);
	if (field.size + bytes > kLargestStore)
		return B_NO_MEMORY;
	if (!_IsAtEnd(field)) {
		uint32 offset;
		if (!_Scatter(field, field.count + 1) || !_PutItem(item, &offset))
			return B_NO_MEMORY;
		field.table[field.count++] = ItemPlace::InStore(offset).Word();
		field.size += uint32(bytes);
		return B_OK;
	}

	if ((field.table != nullptr || field.count >= kFewItems) && !_MakeTable(field, field.count + 1))
		return B_NO_MEMORY;
	const status_t status = _Lengthen(field, uint32(bytes));
	if (status != B_OK)
		return status;
	if (field.table != nullptr)
		field.table[field.count - 1] = ItemPlace::InStore(fStoreSize).Word();
	put_item(fStore + fStoreSize, item);
	fStoreSize += uint32(bytes);
	return B_OK;
}


// Makes room behind a field at the end of the store for one more item and counts it. The header in
// front of the name may need more bytes than before.
status_t
MessageData::_Lengthen(MessageField& field, uint32 bytes)
{
	const size_t newSize = size_t(field.size) + bytes;
	uint32 shift = 0;
	const uint32 start = field.Has(MessageField::kCompact) ? field.Start() : 0;
	if (field.Has(MessageField::kCompact)) {
		shift = r5_field_header_length(field.count + 1, newSize, B_R5_FORM)
			- r5_field_header_length(field.count, field.size, B_R5_FORM);
	}
	if (!_ReserveStore(size_t(bytes) + shift))
		return B_NO_MEMORY;

	if (shift > 0) {
		memmove(fStore + field.name + shift, fStore + field.name, fStoreSize - field.name);
		field.name += shift;
		field.data += shift;
		fStoreSize += shift;
		for (uint32 i = 0; field.table != nullptr && i < field.count; i++)
			field.table[i] = ItemPlace::InStore(ItemPlace(field.table[i]).Offset() + shift).Word();
	}
	field.size = uint32(newSize);
	field.count++;
	if (field.Has(MessageField::kCompact)) {
		write_r5_field_head(fStore + start, field, field.size, B_R5_FORM);
		const bool mini = field.size <= 255 && field.count <= 255;
		field.flags &= uint16(~MessageField::kWide);
		field.flags |= mini ? 0 : MessageField::kWide;
	}
	return B_OK;
}


// A message that is added is plain or not; bytes that are added for one can be anything.
void
MessageData::_NoteNested(type_code type, const ItemContents& item)
{
	if (type != B_MESSAGE_TYPE)
		return;
	if (item.message == nullptr) {
		fPlain.store(-1, std::memory_order_relaxed);
		return;
	}
	if (!item.message->IsPlain())
		fPlain.store(-1, std::memory_order_relaxed);
	fHeight = int16(max_c(int32(fHeight), item.message->Height() + 1));
	fCopies = uint8(max_c(int32(fCopies), item.message->fCopies + 1));
}


} // namespace BPrivate
