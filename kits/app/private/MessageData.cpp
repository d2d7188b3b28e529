#include "app/private/MessageData.h"

#include <cstdlib>
#include <new>
#include <sys/random.h>

#include <TypeConstants.h>

#include "app/private/ManagedNote.h"
#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

// Up to here a walk over the fields, or over the items of one, is as good as a table.
constexpr uint32 kFewFields = 8;
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


void
put_item(uint8* to, const void* data, size_t size)
{
	write_uint32(to, uint32(size));
	memcpy(to + 4, data, size);
	memset(to + 4 + size, 0, padded_item_size(size) - 4 - size);
}

} // namespace


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
	if (length >= 4) {
		uint32 low;
		uint32 high;
		memcpy(&low, name, 4);
		memcpy(&high, name + length - 4, 4);
		word = uint64(high) << 32 | low;
	} else if (length > 0) {
		word = uint64(uint8(name[0])) | uint64(uint8(name[length / 2])) << 8
			| uint64(uint8(name[length - 1])) << 16;
	}
	hash = mix(hash ^ word, sSeed ^ 0xe7037ed1a0b428dbull);
	return uint32(hash ^ hash >> 32);
}


MessageData*
MessageData::Create()
{
	return new (std::nothrow) MessageData;
}


MessageData*
MessageData::CreateFrom(
	SharedBytes* source, const uint8* base, const MessageField* fields, uint32 count, int32 level)
{
	MessageData* data = Create();
	if (data == nullptr || !data->_ReserveFields(count)) {
		for (uint32 i = 0; i < count; i++)
			free(fields[i].table);
		if (source != nullptr)
			source->Release();
		delete data;
		return nullptr;
	}
	if (count > 0)
		memcpy(data->fFields, fields, count * sizeof(MessageField));
	data->fCount = count;
	data->fSource = source;
	data->fSourceBase = base;
	data->fLevel = int16(level);
	if (count > kFewFields && !data->_BuildIndex()) {
		data->Release();
		return nullptr;
	}
	return data;
}


MessageData*
MessageData::Clone() const
{
	MessageData* clone = Create();
	if (clone == nullptr)
		return nullptr;
	if (!clone->_ReserveFields(fCount) || (fStoreSize > 0 && !clone->_ReserveStore(fStoreSize))) {
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
	clone->fFlatSize.store(fFlatSize.load(std::memory_order_relaxed), std::memory_order_relaxed);
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
	free(fFields);
	free(fIndex);
	free(fStore);
	free(fNames.load(std::memory_order_relaxed));
	if (SharedBytes* flat = fFlat.load(std::memory_order_relaxed))
		flat->Release();
	if (fSource != nullptr)
		fSource->Release();
	SetNote(nullptr);
}


int32
MessageData::Find(const char* name) const
{
	const size_t length = strlen(name);
	return Find(name, length, hash_name(name, length));
}


int32
MessageData::Find(const char* name, size_t length, uint32 hash) const
{
	if (fIndex == nullptr) {
		for (uint32 i = 0; i < fCount; i++) {
			const MessageField& field = fFields[i];
			if (field.hash == hash && field.nameLength == length
				&& memcmp(NameBytes(field), name, length) == 0)
				return int32(i);
		}
		return -1;
	}

	for (uint32 slot = hash & fIndexMask; fIndex[slot] != 0; slot = (slot + 1) & fIndexMask) {
		const uint32 i = fIndex[slot] - 1;
		const MessageField& field = fFields[i];
		if (field.hash == hash && field.nameLength == length
			&& memcmp(NameBytes(field), name, length) == 0)
			return int32(i);
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
			memcpy(made + offset, NameBytes(fFields[i]), fFields[i].nameLength);
			made[offset + fFields[i].nameLength] = '\0';
			offset += fFields[i].nameLength + size_t(1);
		}
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
	const char* name, size_t length, type_code type, bool fixed, const void* data, size_t size)
{
	if (size > kLargestStore)
		return B_NO_MEMORY;
	const size_t bytes = fixed ? size : padded_item_size(size);
	MessageField field = {};
	field.nameLength = uint16(length);
	const uint32 header = _HeaderLength(field, 1, bytes);
	if (!_ReserveStore(header + length + bytes) || !_ReserveFields(1))
		return B_NO_MEMORY;
	_Changed();

	field.start = fStoreSize;
	field.name = fStoreSize + header;
	field.data = field.name + uint32(length);
	field.size = uint32(bytes);
	field.count = 1;
	field.type = type;
	field.hash = hash_name(name, length);
	field.flags = MessageField::kCompact | (bytes > 255 ? MessageField::kWide : 0);
	if (fixed) {
		field.flags |= MessageField::kFixed;
		field.capacity = uint32(bytes);
	}
	_WriteHeader(field);
	memcpy(fStore + field.name, name, length);
	if (fixed)
		memcpy(fStore + field.data, data, size);
	else
		put_item(fStore + field.data, data, size);
	fStoreSize = field.data + uint32(bytes);

	fFields[fCount++] = field;
	_Index(fCount - 1);
	return B_OK;
}


status_t
MessageData::AddItem(uint32 number, const void* data, size_t size)
{
	if (size > kLargestStore || fFields[number].count == INT32_MAX)
		return B_NO_MEMORY;
	_Changed();
	MessageField& field = fFields[number];
	return field.Has(MessageField::kFixed) ? _AppendFixed(field, data, size)
										   : _AppendVariable(field, data, size);
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

	MessageField field = {};
	field.name = fStoreSize;
	field.nameLength = uint16(length);
	field.size = uint32(padded_item_size(data->FlatSize()));
	field.count = 1;
	field.capacity = 1;
	field.type = type;
	field.hash = hash_name(name, length);
	field.flags = MessageField::kScattered;
	field.table = table;
	data->Acquire();
	table[0] = ItemPlace::Nested(data).Word();
	memcpy(fStore + fStoreSize, name, length);
	fStoreSize += uint32(length);
	_AddHeight(*data);

	fFields[fCount++] = field;
	_Index(fCount - 1);
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
	_AddHeight(*data);
	return B_OK;
}


status_t
MessageData::ReplaceItem(uint32 number, uint32 index, const void* data, size_t size)
{
	if (size > kLargestStore)
		return B_NO_MEMORY;
	_Changed();
	MessageField& field = fFields[number];
	if (field.Has(MessageField::kFixed)) {
		if (!_OwnFixed(field, field.size))
			return B_NO_MEMORY;
		memcpy(fStore + field.data + size_t(index) * size, data, size);
		return B_OK;
	}

	const ItemPlace old = PlaceAt(field, index);
	const size_t oldSize = ItemSizeAt(number, index);
	if (!old.IsNested() && !old.IsInSource()
		&& padded_item_size(oldSize) == padded_item_size(size)) {
		put_item(fStore + old.Offset(), data, size);
		return B_OK;
	}

	uint32 offset;
	if (!_Scatter(field, field.count) || !_PutItem(data, size, &offset))
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
	_AddHeight(*data);
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
	memcpy(fStore + fStoreSize, name, length);
	field.name = fStoreSize;
	field.nameLength = uint16(length);
	field.hash = hash_name(name, length);
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
		fFields[fCount++] = field;
		_Index(fCount - 1);
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
				original.Has(MessageField::kFixed), data, size);
		} else
			status = AddItem(last, data, size);
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


void
MessageData::MoveField(uint32 from, uint32 to)
{
	if (from <= to)
		return;
	const MessageField moved = fFields[from];
	memmove(fFields + to + 1, fFields + to, (from - to) * sizeof(MessageField));
	fFields[to] = moved;
	_Changed();
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
	for (uint32 i = 0; i < fCount; i++) {
		const MessageField& field = fFields[i];
		if (field.Has(MessageField::kCompact)) {
			size += field.data + field.size - field.start;
			continue;
		}
		const size_t bytes = padded_field_size(*this, field);
		size += _HeaderLength(field, field.count, bytes) + min_c(field.nameLength, 255) + bytes;
	}
	if (size <= UINT32_MAX)
		fFlatSize.store(uint32(size), std::memory_order_relaxed);
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


// Neighbouring fields that lie as the form wants them are copied together.
uint8*
MessageData::WritePlain(uint32 what, uint8* to) const
{
	to = write_r5_header(to, FlatSize(), what);
	const uint8* run = nullptr;
	const uint8* runEnd = nullptr;
	for (uint32 i = 0; i < fCount; i++) {
		const MessageField& field = fFields[i];
		if (field.Has(MessageField::kCompact)) {
			const uint8* start = Base(field) + field.start;
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


// What was derived from the fields no longer holds.
void
MessageData::_Changed()
{
	fFlatSize.store(0, std::memory_order_relaxed);
	fPlain.store(-1, std::memory_order_relaxed);
	if (fNames.load(std::memory_order_relaxed) != nullptr)
		free(fNames.exchange(nullptr, std::memory_order_relaxed));
	if (fFlat.load(std::memory_order_relaxed) != nullptr)
		fFlat.exchange(nullptr, std::memory_order_relaxed)->Release();
}


bool
MessageData::_ReserveFields(uint32 count)
{
	const uint32 needed = fCount + count;
	if (needed <= fFieldRoom)
		return true;
	const uint32 room = fFieldRoom == 0 && count > 1 ? needed : max_c(needed, fFieldRoom * 2);
	const uint32 least = fFieldRoom == 0 && count == 1 ? 8 : room;
	void* fields = realloc(fFields, max_c(room, least) * sizeof(MessageField));
	if (fields == nullptr)
		return false;
	fFields = static_cast<MessageField*>(fields);
	fFieldRoom = max_c(room, least);
	return true;
}


bool
MessageData::_ReserveStore(size_t size)
{
	if (size <= fStoreRoom - fStoreSize)
		return true;
	const size_t needed = fStoreSize + size;
	if (needed > kLargestStore)
		return false;
	const size_t doubled = min_c(size_t(fStoreRoom) * 2, kLargestStore);
	const size_t room = max_c(max_c(needed, doubled), size_t(256));
	void* store = realloc(fStore, room);
	if (store == nullptr)
		return false;
	fStore = static_cast<uint8*>(store);
	fStoreRoom = uint32(room);
	return true;
}


// Enters a new last field into the index, which is made when there are many.
void
MessageData::_Index(uint32 number)
{
	if (fIndex == nullptr) {
		// Without memory for an index the look-up stays a walk.
		if (fCount > kFewFields)
			_BuildIndex();
		return;
	}
	if ((fCount + 1) * 2 > fIndexMask) {
		_BuildIndex();
		return;
	}

	const MessageField& field = fFields[number];
	uint32 slot = field.hash & fIndexMask;
	while (fIndex[slot] != 0) {
		const MessageField& other = fFields[fIndex[slot] - 1];
		// Of two fields of one name the first is found; the other needs no entry.
		if (other.hash == field.hash && other.nameLength == field.nameLength
			&& memcmp(NameBytes(other), NameBytes(field), field.nameLength) == 0)
			return;
		slot = (slot + 1) & fIndexMask;
	}
	fIndex[slot] = number + 1;
}


bool
MessageData::_BuildIndex()
{
	uint32 slots = 32;
	while (slots < fCount * 4)
		slots *= 2;
	free(fIndex);
	fIndex = static_cast<uint32*>(calloc(slots, sizeof(uint32)));
	if (fIndex == nullptr)
		return false;
	fIndexMask = slots - 1;
	for (uint32 i = 0; i < fCount; i++)
		_Index(i);
	return true;
}


// Of the compact form, without the name.
uint32
MessageData::_HeaderLength(const MessageField&, uint32 count, size_t size) const
{
	return r5_field_header_length(count, size, B_R5_FORM);
}


void
MessageData::_WriteHeader(const MessageField& field)
{
	write_r5_field_head(fStore + field.start, field, field.size, B_R5_FORM);
}


bool
MessageData::_IsAtEnd(const MessageField& field) const
{
	return !field.Has(MessageField::kInSource | MessageField::kScattered)
		&& field.data + field.size == fStoreSize;
}


status_t
MessageData::_AppendFixed(MessageField& field, const void* data, size_t size)
{
	if (_IsAtEnd(field)) {
		const status_t status = _Lengthen(field, uint32(size));
		if (status != B_OK)
			return status;
		memcpy(fStore + fStoreSize, data, size);
		fStoreSize += uint32(size);
		field.capacity = field.size;
		return B_OK;
	}
	if (field.Has(MessageField::kInSource) || field.size + size > field.capacity) {
		if (!_OwnFixed(field, (field.size + size) * 2))
			return B_NO_MEMORY;
	}
	memcpy(fStore + field.data + field.size, data, size);
	field.size += uint32(size);
	field.count++;
	field.flags &= uint16(~(MessageField::kCompact | MessageField::kWide));
	return B_OK;
}


status_t
MessageData::_AppendVariable(MessageField& field, const void* data, size_t size)
{
	const size_t bytes = padded_item_size(size);
	if (field.size + bytes > kLargestStore)
		return B_NO_MEMORY;
	if (!_IsAtEnd(field)) {
		uint32 offset;
		if (!_Scatter(field, field.count + 1) || !_PutItem(data, size, &offset))
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
	put_item(fStore + fStoreSize, data, size);
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
	if (field.Has(MessageField::kCompact)) {
		shift = _HeaderLength(field, field.count + 1, newSize)
			- _HeaderLength(field, field.count, field.size);
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
		_WriteHeader(field);
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
	field.size = uint32(padded_field_size(*this, field));
	field.flags &= uint16(~(MessageField::kCompact | MessageField::kWide | MessageField::kPacked));
	field.flags |= MessageField::kScattered;
	return true;
}


bool
MessageData::_PutItem(const void* data, size_t size, uint32* _offset)
{
	if (!_ReserveStore(padded_item_size(size)))
		return false;
	put_item(fStore + fStoreSize, data, size);
	*_offset = fStoreSize;
	fStoreSize += uint32(padded_item_size(size));
	return true;
}


void
MessageData::_AddHeight(const MessageData& nested)
{
	fHeight = int16(max_c(int32(fHeight), nested.Height() + 1));
}


// Packs the store when most of it is no longer used.
void
MessageData::_CompactStore()
{
	if (fWaste < 4096 || fWaste < fStoreSize / 2)
		return;

	MessageData packed;
	for (uint32 i = 0; i < fCount; i++) {
		// Without memory everything stays as it was, only larger than it need be.
		if (packed.CopyField(*this, i) != B_OK)
			return;
	}
	std::swap(fFields, packed.fFields);
	std::swap(fCount, packed.fCount);
	std::swap(fFieldRoom, packed.fFieldRoom);
	std::swap(fIndex, packed.fIndex);
	std::swap(fIndexMask, packed.fIndexMask);
	std::swap(fSource, packed.fSource);
	std::swap(fSourceBase, packed.fSourceBase);
	std::swap(fStore, packed.fStore);
	std::swap(fStoreSize, packed.fStoreSize);
	std::swap(fStoreRoom, packed.fStoreRoom);
	fWaste = 0;
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
