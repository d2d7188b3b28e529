// MessageData: the items of its fields, for those who read.
#include "app/private/MessageData.h"
#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {


ItemPlace
MessageData::PlaceAt(const MessageField& field, uint32 index) const
{
	if (field.table != nullptr)
		return ItemPlace(field.table[index]);

	const bool packed = field.Has(MessageField::kPacked);
	uint32 offset = field.data;
	for (uint32 i = 0; i < index; i++) {
		const uint32 size = read_uint32(Base(field) + offset);
		offset += packed ? size + 4 : uint32(padded_item_size(size));
	}
	return field.Has(MessageField::kInSource) ? ItemPlace::InSource(offset)
											  : ItemPlace::InStore(offset);
}


status_t
MessageData::GetItem(uint32 number, uint32 index, const void** _data, size_t* _size) const
{
	const MessageField& field = fFields[number];
	if (field.Has(MessageField::kFixed)) {
		*_size = field.ItemSize();
		*_data = Base(field) + field.data + size_t(index) * field.ItemSize();
		return B_OK;
	}

	const ItemPlace place = PlaceAt(field, index);
	if (!place.IsNested()) {
		const uint8* bytes = BytesAt(place);
		*_size = read_uint32(bytes);
		*_data = bytes + 4;
		return B_OK;
	}

	const SharedBytes* flat = place.Message()->_Flat();
	if (flat == nullptr)
		return B_NO_MEMORY;
	*_data = flat->Bytes();
	*_size = flat->Size();
	return B_OK;
}


// The bytes of a message that was added as one, for those who want them; NULL without memory.
const SharedBytes*
MessageData::_Flat() const
{
	SharedBytes* flat = fFlat.load(std::memory_order_acquire);
	if (flat != nullptr)
		return flat;
	SharedBytes* made = flatten_to_bytes(*this, What());
	if (made == nullptr)
		return nullptr;
	fHasDerived.store(true, std::memory_order_relaxed);
	if (fFlat.compare_exchange_strong(flat, made, std::memory_order_acq_rel))
		return made;
	made->Release(); // another thread was first
	return flat;
}


size_t
MessageData::ItemSizeAt(uint32 number, uint32 index) const
{
	const MessageField& field = fFields[number];
	if (field.Has(MessageField::kFixed))
		return field.ItemSize();
	const ItemPlace place = PlaceAt(field, index);
	return place.IsNested() ? place.Message()->FlatSize() : read_uint32(BytesAt(place));
}


MessageData*
MessageData::MessageAt(uint32 number, uint32 index) const
{
	const MessageField& field = fFields[number];
	if (field.Has(MessageField::kFixed) || field.table == nullptr)
		return nullptr;
	const ItemPlace place(field.table[index]);
	return place.IsNested() ? place.Message() : nullptr;
}


MessageData*
MessageData::GetMessage(uint32 number, uint32 index, status_t* _status) const
{
	status_t ignored;
	status_t& status = _status != nullptr ? *_status : ignored;
	status = B_OK;
	if (MessageData* nested = MessageAt(number, index)) {
		nested->Acquire();
		return nested;
	}
	status = B_BAD_DATA;
	if (fLevel >= B_MAX_MESSAGE_NESTING)
		return nullptr;

	const void* bytes;
	size_t size;
	GetItem(number, index, &bytes, &size);
	SharedBytes* source = _SourceOf(number, index, &bytes, size);
	status = B_NO_MEMORY;
	if (source == nullptr)
		return nullptr;
	MessageReader reader(source, static_cast<const uint8*>(bytes), size, fLevel + 1);
	MessageData* nested = reader.Read();
	status = reader.Status();
	return nested;
}


// What an item's bytes lie in, as a reference, for a message that will refer to them. The store
// moves when it grows, so what lies there is copied.
SharedBytes*
MessageData::_SourceOf(uint32 number, uint32 index, const void** _bytes, size_t size) const
{
	const MessageField& field = fFields[number];
	const bool inSource = field.Has(MessageField::kFixed) ? field.Has(MessageField::kInSource)
														  : PlaceAt(field, index).IsInSource();
	if (inSource) {
		fSource->Acquire();
		return fSource;
	}
	SharedBytes* copy = SharedBytes::Create(size);
	if (copy != nullptr) {
		memcpy(copy->Bytes(), *_bytes, size);
		*_bytes = copy->Bytes();
	}
	return copy;
}


bool
MessageData::HasSameField(uint32 number, const MessageData& other) const
{
	const MessageField& a = fFields[number];
	const MessageField& b = other.fFields[number];
	if (a.type != b.type || a.count != b.count || a.nameLength != b.nameLength
		|| (a.nameLength > 0 && memcmp(NameBytes(a), other.NameBytes(b), a.nameLength) != 0))
		return false;
	const bool inPlace = !a.Has(MessageField::kScattered) && !b.Has(MessageField::kScattered);
	if (inPlace && Base(a) + a.data == other.Base(b) + b.data && a.size == b.size)
		return true;
	for (uint32 i = 0; i < a.count; i++) {
		const MessageData* nested = MessageAt(number, i);
		if (nested != nullptr && nested == other.MessageAt(number, i))
			continue;
		const void* data;
		const void* otherData;
		size_t size, otherSize;
		if (GetItem(number, i, &data, &size) != B_OK
			|| other.GetItem(number, i, &otherData, &otherSize) != B_OK || size != otherSize
			|| (data != otherData && memcmp(data, otherData, size) != 0))
			return false;
	}
	return true;
}


} // namespace BPrivate
