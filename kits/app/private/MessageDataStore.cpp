// MessageData: where items lie in the store.

#include <cstdlib>
#include <utility>

#include "app/private/MessageStore.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {


bool
MessageData::_GrowStore(size_t size)
{
	const size_t needed = fStoreSize + size;
	if (needed > kLargestStore)
		return false;
	const size_t doubled = min_c(size_t(fStoreRoom) * 2, kLargestStore);
	const size_t room = max_c(max_c(needed, doubled), size_t(256));
	void* store = realloc(fStoreIsInside ? nullptr : fStore, room);
	if (store == nullptr)
		return false;
	if (fStoreIsInside)
		memcpy(store, fStore, fStoreSize);
	fStoreIsInside = false;
	fStore = static_cast<uint8*>(store);
	fStoreRoom = uint32(room);
	return true;
}


// Brings the items of a fixed field into the store, with room for more.
bool
MessageData::_OwnFixed(MessageField& field, size_t capacity)
{
	if (!field.Has(MessageField::kInSource) && capacity <= field.capacity)
		return true;
	if (!_ReserveStore(capacity))
		return false;
	fStoreIsBody = false;
	fBodySize = 0;
	memcpy(fStore + fStoreSize, Base(field) + field.data, field.size);
	if (!field.Has(MessageField::kInSource))
		fWaste += field.capacity;
	field.data = fStoreSize;
	field.capacity = uint32(capacity);
	field.flags &=
		uint16(~(MessageField::kInSource | MessageField::kCompact | MessageField::kWide));
	fStoreSize += uint32(capacity);
	return true;
}


// Gives a variable field a table with room for that many items.
bool
MessageData::_MakeTable(MessageField& field, uint32 room)
{
	if (field.table != nullptr) {
		if (room <= field.capacity)
			return true;
		const uint32 wanted = max_c(room, field.capacity * 2);
		void* table = realloc(field.table, wanted * sizeof(uint64));
		if (table == nullptr)
			return false;
		field.table = static_cast<uint64*>(table);
		field.capacity = wanted;
		return true;
	}

	const uint32 wanted = max_c(room, uint32(4));
	uint64* table = static_cast<uint64*>(malloc(wanted * sizeof(uint64)));
	if (table == nullptr)
		return false;
	for (uint32 i = 0; i < field.count; i++)
		table[i] = PlaceAt(field, i).Word();
	field.table = table;
	field.capacity = wanted;
	return true;
}


// From now on the items of a variable field may be anywhere.
bool
MessageData::_Scatter(MessageField& field, uint32 room)
{
	if (!_MakeTable(field, room))
		return false;
	if (field.Has(MessageField::kScattered))
		return true;
	fStoreIsBody = false;
	fBodySize = 0;
	field.size = uint32(padded_field_size(*this, field));
	field.flags &= uint16(~(MessageField::kCompact | MessageField::kWide | MessageField::kPacked));
	field.flags |= MessageField::kScattered;
	return true;
}


bool
MessageData::_PutItem(const ItemContents& item, uint32* _offset)
{
	if (!_ReserveStore(padded_item_size(item.size)))
		return false;
	fStoreIsBody = false;
	put_item(fStore + fStoreSize, item);
	*_offset = fStoreSize;
	fStoreSize += uint32(padded_item_size(item.size));
	return true;
}


// Packs the store when most of it is no longer used.
void
MessageData::_CompactStore()
{
	if (fWaste < 4096 || fWaste < fStoreSize / 2 || fStoreIsInside)
		return;

	MessageData* packed = _CreateWithRoom(fCount);
	if (packed == nullptr)
		return;
	for (uint32 i = 0; i < fCount; i++) {
		// Without memory everything stays as it was, only larger than it need be.
		if (packed->CopyField(*this, i) != B_OK) {
			packed->Release();
			return;
		}
	}
	for (uint32 i = 0; i < fCount; i++)
		std::swap(fFields[i], packed->fFields[i]);
	std::swap(fIndex, packed->fIndex);
	std::swap(fIndexMask, packed->fIndexMask);
	std::swap(fSource, packed->fSource);
	std::swap(fSourceBase, packed->fSourceBase);
	std::swap(fStore, packed->fStore);
	std::swap(fStoreSize, packed->fStoreSize);
	std::swap(fStoreRoom, packed->fStoreRoom);
	fStoreIsBody = packed->fStoreIsBody;
	fWaste = 0;
	packed->Release();
}


} // namespace BPrivate
