#include "app/private/MessageData.h"

#include <cstdlib>
#include <new>
#include <utility>

#include <sys/random.h>

#include <TypeConstants.h>

#include "app/private/ManagedNote.h"
#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

// Up to here a walk over the fields, or over the items of one, is as good as a table.
constexpr uint32 kFewFields = 16;
constexpr uint32 kFewItems = 8;

// Offsets and the sizes in flattened messages are signed 32-bit numbers.
constexpr size_t kLargestStore = 0x7fffff00;


// Differs from run to run, so that nobody can prepare a file of names that all collide.
uint64
make_seed()
{
	uint64 seed;
	if (getrandom(&seed, sizeof(seed), GRND_NONBLOCK) != sizeof(seed))
		seed = reinterpret_cast<uint64>(&seed);
	return seed | 1;
}


const uint64 sSeed = make_seed();


uint64
mix(uint64 a, uint64 b)
{
	const auto product = static_cast<unsigned __int128>(a) * b;
	return uint64(product) ^ uint64(product >> 64);
}


uint32
hash_name(const char* name, size_t length)
{
	uint64 hash = sSeed ^ length;
	while (length > 8) {
		uint64 word;
		memcpy(&word, name, 8);
		hash = mix(hash ^ word, 0x9e3779b97f4a7c15ull);
		name += 8;
		length -= 8;
	}
	uint64 word = 0;
	if (length > 0)
		memcpy(&word, name, length);
	hash = mix(hash ^ word, sSeed ^ 0xe7037ed1a0b428dbull);
	return uint32(hash ^ hash >> 32);
}


// Whether that many fields find their places in the index quickly. A message of thousands of tiny
// fields should take no more memory than they are worth.
bool
is_roomy(uint32 slots, uint32 fields)
{
	return uint64(slots) * 2 >= uint64(fields) * 3;
}


void
put_item(uint8* to, const ItemContents& item)
{
	const size_t end = 4 + item.size;
	write_uint32(to, uint32(item.size));
	if (item.message != nullptr)
		item.message->WritePlain(item.message->What(), to + 4);
	else
		memcpy(to + 4, item.data, item.size);
	// The padding is at most seven bytes.
	for (size_t at = end; at < ((end + 7) & ~size_t(7)); at++)
		to[at] = 0;
}

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


MessageData*
MessageData::Create()
{
	// Enough for most views and messages, so that they take one block of memory and no copying.
	constexpr uint32 kFirstRoom = 14;
	constexpr uint32 kFirstStore = 384;
	return _CreateWithRoom(kFirstRoom, kFirstStore);
}


MessageData*
MessageData::CreateFrom(SharedBytes* source, const uint8* base, const MessageField* fields,
	uint32 count, int32 level, uint32 bodySize)
{
	MessageData* data = _CreateWithRoom(count);
	if (data == nullptr) {
		for (uint32 i = 0; i < count; i++)
			free(fields[i].table);
		source->Release();
		return nullptr;
	}
	if (count > 0)
		memcpy(data->fFields, fields, count * sizeof(MessageField));
	data->fCount = count;
	if (data->_InitFrom(source, base, level, bodySize))
		return data;
	data->Release();
	return nullptr;
}


MessageData*
MessageData::CreateAround(SharedBytes* source, const uint8* base, MessageField* fields,
	uint32 count, int32 level, uint32 bodySize)
{
	MessageData* data = _CreateWithRoom(0);
	if (data == nullptr) {
		for (uint32 i = 0; i < count; i++)
			free(fields[i].table);
		free(fields);
		source->Release();
		return nullptr;
	}
	data->fFields = fields;
	data->fCount = count;
	data->fFieldRoom = count;
	if (data->_InitFrom(source, base, level, bodySize))
		return data;
	data->Release();
	return nullptr;
}


MessageData*
MessageData::Clone() const
{
	// It is about to be changed, most likely by adding something.
	MessageData* clone = _CreateWithRoom(fCount + 1);
	if (clone == nullptr)
		return nullptr;
	if (fStoreSize > 0 && !clone->_ReserveStore(fStoreSize)) {
		clone->Release();
		return nullptr;
	}

	clone->fSource = fSource;
	clone->fSourceBase = fSourceBase;
	if (fSource != nullptr)
		fSource->Acquire();
	if (fStoreSize > 0)
		memcpy(clone->fStore, fStore, fStoreSize);
	clone->fStoreSize = fStoreSize;
	clone->fWaste = fWaste;
	clone->fWhat = fWhat;
	clone->fLevel = fLevel;
	clone->fHeight = fHeight;
	clone->fBodySize = fBodySize;
	clone->fNameBits = fNameBits;
	clone->fStoreIsBody = fStoreIsBody;
	clone->fCopies = fCopies;
	clone->SetNote(fNote);

	for (uint32 i = 0; i < fCount; i++) {
		MessageField field = fFields[i];
		if (field.table != nullptr) {
			field.table = static_cast<uint64*>(malloc(field.capacity * sizeof(uint64)));
			if (field.table == nullptr) {
				clone->Release();
				return nullptr;
			}
			for (uint32 k = 0; k < field.count; k++) {
				const ItemPlace place(fFields[i].table[k]);
				if (place.IsNested())
					place.Message()->Acquire();
				field.table[k] = place.Word();
			}
		}
		clone->fFields[clone->fCount++] = field;
	}
	if (fCount > kFewFields && !clone->_BuildIndex()) {
		clone->Release();
		return nullptr;
	}
	clone->fPlain.store(fPlain.load(std::memory_order_relaxed), std::memory_order_relaxed);
	return clone;
}


void
MessageData::Release()
{
	if (fReferences.fetch_sub(1, std::memory_order_acq_rel) == 1)
		delete this;
}


MessageData::~MessageData()
{
	for (uint32 i = 0; i < fCount; i++)
		_ReleaseTable(fFields[i]);
	if (fFields != reinterpret_cast<MessageField*>(this + 1))
		free(fFields);
	free(fIndex);
	if (!fStoreIsInside)
		free(fStore);
	_Changed();
	if (fSource != nullptr)
		fSource->Release();
	SetNote(nullptr);
}


int32
MessageData::Find(const char* name) const
{
	return Find(name, strlen(name));
}


int32
MessageData::Find(const char* name, size_t length) const
{
	const uint32 key = name_key(name, length);
	if ((fNameBits & name_bit(key)) == 0)
		return -1;
	if (fIndex == nullptr) {
		for (uint32 i = 0; i < fCount; i++) {
			if (_IsNamed(fFields[i], name, length, key))
				return int32(i);
		}
		return -1;
	}

	uint32 slot = hash_name(name, length) & fIndexMask;
	for (; fIndex[slot] != 0; slot = (slot + 1) & fIndexMask) {
		if (_IsNamed(fFields[fIndex[slot] - 1], name, length, key))
			return int32(fIndex[slot] - 1);
	}
	return -1;
}


const char*
MessageData::NameBytes(const MessageField& field) const
{
	const uint8* base = field.Has(MessageField::kNameInSource) ? fSourceBase : fStore;
	return reinterpret_cast<const char*>(base + field.name);
}


// All names are copied at the first question, since in the bytes they have no NUL.
const char*
MessageData::NameAt(uint32 index) const
{
	char* names = fNames.load(std::memory_order_acquire);
	if (names == nullptr) {
		size_t size = fCount * sizeof(uint32);
		for (uint32 i = 0; i < fCount; i++)
			size += fFields[i].nameLength + size_t(1);
		char* made = static_cast<char*>(malloc(size));
		if (made == nullptr)
			return nullptr;
		size_t offset = fCount * sizeof(uint32);
		for (uint32 i = 0; i < fCount; i++) {
			write_uint32(made + i * sizeof(uint32), uint32(offset));
			if (fFields[i].nameLength > 0)
				memcpy(made + offset, NameBytes(fFields[i]), fFields[i].nameLength);
			made[offset + fFields[i].nameLength] = '\0';
			offset += fFields[i].nameLength + size_t(1);
		}
		fHasDerived.store(true, std::memory_order_relaxed);
		if (fNames.compare_exchange_strong(names, made, std::memory_order_acq_rel))
			names = made;
		else
			free(made); // another thread was first
	}
	return names + read_uint32(names + index * sizeof(uint32));
}


// #pragma mark - items


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

	MessageData* nested = place.Message();
	SharedBytes* flat = nested->fFlat.load(std::memory_order_acquire);
	if (flat == nullptr) {
		SharedBytes* made = flatten_to_bytes(*nested, nested->What());
		if (made == nullptr)
			return B_NO_MEMORY;
		nested->fHasDerived.store(true, std::memory_order_relaxed);
		if (nested->fFlat.compare_exchange_strong(flat, made, std::memory_order_acq_rel))
			flat = made;
		else
			made->Release();
	}
	*_data = flat->Bytes();
	*_size = flat->Size();
	return B_OK;
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
	const MessageField& field = fFields[number];
	const bool inSource = field.Has(MessageField::kFixed) ? field.Has(MessageField::kInSource)
														  : PlaceAt(field, index).IsInSource();
	SharedBytes* source = fSource;
	if (inSource)
		source->Acquire();
	else {
		// The store moves when it grows, so the message gets bytes of its own.
		source = SharedBytes::Create(size);
		status = B_NO_MEMORY;
		if (source == nullptr)
			return nullptr;
		memcpy(source->Bytes(), bytes, size);
		bytes = source->Bytes();
	}
	MessageReader reader(source, static_cast<const uint8*>(bytes), size, fLevel + 1);
	MessageData* nested = reader.Read();
	status = reader.Status();
	return nested;
}


// #pragma mark - changes


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


// Shares the bytes that both were read from, if they are the same or there are none here yet.
status_t
MessageData::CopyField(const MessageData& from, uint32 number)
{
	const MessageField& original = from.fFields[number];
	const char* name = from.NameBytes(original);
	const bool whole = original.Has(MessageField::kInSource)
		&& original.Has(MessageField::kNameInSource) && !original.Has(MessageField::kScattered);
	if (whole && fSource == nullptr && from.fSource != nullptr) {
		from.fSource->Acquire();
		fSource = from.fSource;
		fSourceBase = from.fSourceBase;
	}
	if (whole && fSourceBase == from.fSourceBase) {
		if (!_ReserveFields(1))
			return B_NO_MEMORY;
		MessageField field = original;
		if (field.table != nullptr) {
			field.table = static_cast<uint64*>(malloc(field.capacity * sizeof(uint64)));
			if (field.table == nullptr)
				return B_NO_MEMORY;
			memcpy(field.table, original.table, field.count * sizeof(uint64));
		}
		_Changed();
		fStoreIsBody = false;
		fBodySize = 0;
		fPlain.store(-1, std::memory_order_relaxed);
		fFields[fCount] = field;
		_AddToIndex(fCount++);
		return B_OK;
	}

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
		if (i == 0) {
			status = AddField(name, original.nameLength, original.type,
				original.Has(MessageField::kFixed), { data, size });
		} else
			status = AddItem(last, { data, size });
	}
	if (status == B_OK) {
		MessageField& copy = fFields[fCount - 1];
		copy.flags |= original.flags & uint16(MessageField::kCarried | MessageField::kTwin);
		copy.place = original.place;
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


void
MessageData::SetNote(ManagedNote* note)
{
	if (note != nullptr)
		note->Acquire();
	if (fNote != nullptr)
		fNote->Release();
	fNote = note;
}


// #pragma mark - the compact R5 form


size_t
MessageData::FlatSize() const
{
	const uint32 known = fFlatSize.load(std::memory_order_relaxed);
	if (known != 0)
		return known;

	size_t size = kR5HeaderSize + 1;
	size_t bodySize;
	if (_Body(&bodySize) != nullptr)
		return size + bodySize;
	for (uint32 i = 0; i < fCount; i++) {
		const MessageField& field = fFields[i];
		if (field.Has(MessageField::kCompact)) {
			size += field.data + field.size - field.Start();
			continue;
		}
		const size_t bytes = padded_field_size(*this, field);
		size += r5_field_header_length(field.count, bytes, B_R5_FORM) + min_c(field.nameLength, 255)
			+ bytes;
	}
	if (size <= UINT32_MAX) {
		fHasDerived.store(true, std::memory_order_relaxed);
		fFlatSize.store(uint32(size), std::memory_order_relaxed);
	}
	return size;
}


bool
MessageData::IsPlain() const
{
	const int8 known = fPlain.load(std::memory_order_relaxed);
	if (known >= 0)
		return known != 0;

	bool plain = true;
	for (uint32 i = 0; i < fCount && plain; i++) {
		const MessageField& field = fFields[i];
		if (field.type != B_MESSAGE_TYPE || field.Has(MessageField::kFixed))
			continue;
		for (uint32 k = 0; k < field.count && plain; k++) {
			const ItemPlace place = PlaceAt(field, k);
			plain = place.IsNested()
				? place.Message()->IsPlain()
				: stays_as_it_is(BytesAt(place) + 4, read_uint32(BytesAt(place)), fLevel + 1);
		}
	}
	fPlain.store(plain ? 1 : 0, std::memory_order_relaxed);
	return plain;
}


bool
MessageData::IsBetterCopied() const
{
	constexpr size_t kLargestCopied = 65536;
	constexpr uint8 kMostCopies = 2;
	size_t size;
	return fNote == nullptr && fCopies < kMostCopies && _Body(&size) != nullptr
		&& size <= kLargestCopied && IsPlain();
}


// Neighbouring fields that lie as the form wants them are copied together.
uint8*
MessageData::WritePlain(uint32 what, uint8* to) const
{
	to = write_r5_header(to, FlatSize(), what);
	size_t bodySize;
	if (const uint8* body = _Body(&bodySize)) {
		to = append_bytes(to, body, body + bodySize);
		*to++ = 0;
		return to;
	}
	const uint8* run = nullptr;
	const uint8* runEnd = nullptr;
	for (uint32 i = 0; i < fCount; i++) {
		const MessageField& field = fFields[i];
		if (field.Has(MessageField::kCompact)) {
			const uint8* start = Base(field) + field.Start();
			if (start != runEnd) {
				to = append_bytes(to, run, runEnd);
				run = start;
			}
			runEnd = Base(field) + field.data + field.size;
			continue;
		}
		to = append_bytes(to, run, runEnd);
		run = runEnd = nullptr;
		to = write_r5_field_header(to, *this, field, padded_field_size(*this, field), B_R5_FORM);
		if (field.Has(MessageField::kFixed)
			|| !field.Has(MessageField::kScattered | MessageField::kPacked)) {
			const uint8* data = Base(field) + field.data;
			to = append_bytes(to, data, data + field.size);
			continue;
		}
		for (uint32 k = 0; k < field.count; k++) {
			const ItemPlace place = PlaceAt(field, k);
			to = place.IsNested() ? write_plain_item(to, *place.Message())
								  : write_padded_item(to, BytesAt(place));
		}
	}
	to = append_bytes(to, run, runEnd);
	*to++ = 0;
	return to;
}


// #pragma mark - private


MessageData*
MessageData::_CreateWithRoom(uint32 fields, uint32 store)
{
	void* block = malloc(sizeof(MessageData) + fields * sizeof(MessageField) + store);
	if (block == nullptr)
		return nullptr;
	MessageData* data = new (block) MessageData;
	data->fFields = reinterpret_cast<MessageField*>(data + 1);
	data->fFieldRoom = fields;
	if (store > 0) {
		data->fStore = reinterpret_cast<uint8*>(data->fFields + fields);
		data->fStoreRoom = store;
		data->fStoreIsInside = true;
	}
	return data;
}


// What is the same for all messages that were read, once their fields are there.
bool
MessageData::_InitFrom(SharedBytes* source, const uint8* base, int32 level, uint32 bodySize)
{
	for (uint32 i = 0; i < fCount; i++)
		fNameBits |= name_bit(fFields[i].key);
	fSource = source;
	fSourceBase = base;
	fBodySize = bodySize;
	fStoreIsBody = false;
	fLevel = int16(level);
	fPlain.store(-1, std::memory_order_relaxed);
	return fCount <= kFewFields || _BuildIndex();
}


// What was derived from the fields no longer holds.
inline void
MessageData::_Changed()
{
	if (fHasDerived.load(std::memory_order_relaxed))
		_ForgetDerived();
}


void
MessageData::_ForgetDerived()
{
	fHasDerived.store(false, std::memory_order_relaxed);
	fFlatSize.store(0, std::memory_order_relaxed);
	free(fNames.exchange(nullptr, std::memory_order_relaxed));
	if (SharedBytes* flat = fFlat.exchange(nullptr, std::memory_order_relaxed))
		flat->Release();
}


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


// Enters a field, which is already counted, into the index; that is made when there are many.
void
MessageData::_AddToIndex(uint32 number)
{
	fNameBits |= name_bit(fFields[number].key);
	if (fIndex == nullptr && number < kFewFields)
		return;
	if (fIndex == nullptr || !is_roomy(fIndexMask + 1, number + 1)) {
		// Without memory for an index the look-up becomes a walk.
		_BuildIndex();
		return;
	}

	const MessageField& field = fFields[number];
	const char* name = NameBytes(field);
	uint32 slot = hash_name(name, field.nameLength) & fIndexMask;
	while (fIndex[slot] != 0) {
		// Of two fields of one name the first is found; the other needs no entry.
		if (_IsNamed(fFields[fIndex[slot] - 1], name, field.nameLength, field.key))
			return;
		slot = (slot + 1) & fIndexMask;
	}
	fIndex[slot] = number + 1;
}


bool
MessageData::_BuildIndex()
{
	uint32 slots = 64;
	while (!is_roomy(slots, fCount))
		slots *= 2;
	free(fIndex);
	fIndex = static_cast<uint32*>(calloc(slots, sizeof(uint32)));
	if (fIndex == nullptr)
		return false;
	fIndexMask = slots - 1;
	for (uint32 i = 0; i < fCount; i++)
		_AddToIndex(i);
	return true;
}


inline bool
MessageData::_IsNamed(const MessageField& field, const char* name, size_t length, uint32 key) const
{
	return field.key == key && field.nameLength == length
		&& (length == 0 || memcmp(NameBytes(field), name, length) == 0);
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


// All fields as the compact form has them, or NULL when they are not in one piece.
const uint8*
MessageData::_Body(size_t* _size) const
{
	if (fStoreIsBody) {
		*_size = fStoreSize;
		// An empty store has no place, but its emptiness is in one piece.
		return fStore != nullptr ? fStore : reinterpret_cast<const uint8*>("");
	}
	*_size = fBodySize;
	return fBodySize > 0 ? fSourceBase + fFields[0].Start() : nullptr;
}


void
MessageData::_ReleaseTable(MessageField& field)
{
	if (field.table == nullptr)
		return;
	for (uint32 i = 0; i < field.count; i++) {
		const ItemPlace place(field.table[i]);
		if (place.IsNested())
			place.Message()->Release();
	}
	free(field.table);
	field.table = nullptr;
}


} // namespace BPrivate
