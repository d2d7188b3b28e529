#include "app/private/MessageData.h"

#include <cstdlib>
#include <new>

#include "app/private/ManagedNote.h"

namespace BPrivate {


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

	clone->_CopyStore(*this);
	for (uint32 i = 0; i < fCount; i++) {
		if (!_CopyPlaces(fFields[i], &clone->fFields[i])) {
			clone->Release();
			return nullptr;
		}
		clone->fCount++;
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


void
MessageData::SetNote(ManagedNote* note)
{
	if (note != nullptr)
		note->Acquire();
	if (fNote != nullptr)
		fNote->Release();
	fNote = note;
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


// Everything but the fields; the store has room.
void
MessageData::_CopyStore(const MessageData& from)
{
	fSource = from.fSource;
	fSourceBase = from.fSourceBase;
	if (fSource != nullptr)
		fSource->Acquire();
	if (from.fStoreSize > 0)
		memcpy(fStore, from.fStore, from.fStoreSize);
	fStoreSize = from.fStoreSize;
	fWaste = from.fWaste;
	fWhat = from.fWhat;
	fLevel = from.fLevel;
	fHeight = from.fHeight;
	fBodySize = from.fBodySize;
	fNameBits = from.fNameBits;
	fStoreIsBody = from.fStoreIsBody;
	fCopies = from.fCopies;
	SetNote(from.fNote);
}


// Copies a field together with its table and the messages in that. False without memory.
bool
MessageData::_CopyPlaces(const MessageField& from, MessageField* copy)
{
	MessageField field = from;
	if (field.table != nullptr) {
		field.table = static_cast<uint64*>(malloc(field.capacity * sizeof(uint64)));
		if (field.table == nullptr)
			return false;
		for (uint32 i = 0; i < field.count; i++) {
			const ItemPlace place(from.table[i]);
			if (place.IsNested())
				place.Message()->Acquire();
			field.table[i] = place.Word();
		}
	}
	*copy = field;
	return true;
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


void
MessageData::_ForgetDerived()
{
	fHasDerived.store(false, std::memory_order_relaxed);
	fFlatSize.store(0, std::memory_order_relaxed);
	free(fNames.exchange(nullptr, std::memory_order_relaxed));
	if (SharedBytes* flat = fFlat.exchange(nullptr, std::memory_order_relaxed))
		flat->Release();
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
