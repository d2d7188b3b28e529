#include <Message.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <utility>
#include <vector>

#include <DataIO.h>
#include <Flattenable.h>

#include "app/private/LookUps.h"
#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"
#include "app/private/TwinFields.h"
#include "app/private/WriteBack.h"

using BPrivate::MessageData;
using BPrivate::MessageField;
using BPrivate::MessageReader;
using BPrivate::MessageWriter;


BMessage::BMessage()
{
}


BMessage::BMessage(uint32 what) : what(what)
{
}


BMessage::BMessage(const BMessage& message) : what(message.what), fData(message.fData)
{
	if (fData != nullptr)
		fData->Acquire();
	if (message.fDelivery != nullptr)
		fDelivery = message.fDelivery->CloneForCopy().release();
	fCurrentSpecifier = message.fCurrentSpecifier;
}


BMessage::BMessage(BMessage&& message) :
	what(message.what), fData(std::exchange(message.fData, nullptr)),
	fDelivery(std::exchange(message.fDelivery, nullptr)),
	fLookUps(std::exchange(message.fLookUps, nullptr)),
	fWriteBack(std::exchange(message.fWriteBack, nullptr)),
	fCurrentSpecifier(std::exchange(message.fCurrentSpecifier, -1))
{
}


BMessage::~BMessage()
{
	_Release();
}


BMessage&
BMessage::operator=(const BMessage& message)
{
	if (this != &message)
		*this = BMessage(message);
	return *this;
}


BMessage&
BMessage::operator=(BMessage&& message)
{
	if (this == &message)
		return *this;
	_Release();
	what = message.what;
	fData = std::exchange(message.fData, nullptr);
	fDelivery = std::exchange(message.fDelivery, nullptr);
	fLookUps = std::exchange(message.fLookUps, nullptr);
	fWriteBack = std::exchange(message.fWriteBack, nullptr);
	fCurrentSpecifier = std::exchange(message.fCurrentSpecifier, -1);
	return *this;
}


// #pragma mark - fields


status_t
BMessage::GetInfo(type_code typeRequested, int32 index, char** nameFound, type_code* typeFound,
	int32* countFound) const
{
	const int32 count = fData != nullptr ? int32(fData->CountFields()) : 0;
	if (index < 0 || index >= count)
		return B_BAD_INDEX;

	int32 number = index;
	if (typeRequested != B_ANY_TYPE) {
		int32 ofType = 0;
		for (number = 0; number < count; number++) {
			if (fData->FieldAt(uint32(number)).type == typeRequested && ofType++ == index)
				break;
		}
		if (number == count)
			return ofType == 0 ? status_t(B_BAD_TYPE) : status_t(B_BAD_INDEX);
	}

	const MessageField& field = fData->FieldAt(uint32(number));
	if (nameFound != nullptr) {
		const char* name = fData->NameAt(uint32(number));
		if (name == nullptr)
			return B_NO_MEMORY;
		*nameFound = const_cast<char*>(name);
	}
	if (typeFound != nullptr)
		*typeFound = field.type;
	if (countFound != nullptr)
		*countFound = int32(field.count);
	return B_OK;
}


status_t
BMessage::GetInfo(const char* name, type_code* typeFound, int32* countFound) const
{
	return GetInfo(name, typeFound, countFound, nullptr);
}


status_t
BMessage::GetInfo(const char* name, type_code* typeFound, bool* fixedSize) const
{
	return GetInfo(name, typeFound, nullptr, fixedSize);
}


status_t
BMessage::GetInfo(const char* name, type_code* typeFound, int32* countFound, bool* fixedSize) const
{
	if (countFound != nullptr)
		*countFound = 0;
	if (name == nullptr)
		return B_BAD_VALUE;
	const int32 number = _Find(name);
	if (number < 0)
		return B_NAME_NOT_FOUND;

	const MessageField& field = fData->FieldAt(uint32(number));
	if (typeFound != nullptr)
		*typeFound = field.type;
	if (countFound != nullptr)
		*countFound = int32(field.count);
	if (fixedSize != nullptr)
		*fixedSize = field.Has(MessageField::kFixed);
	return B_OK;
}


int32
BMessage::CountNames(type_code type) const
{
	const uint32 count = fData != nullptr ? fData->CountFields() : 0;
	if (type == B_ANY_TYPE)
		return int32(count);
	int32 ofType = 0;
	for (uint32 i = 0; i < count; i++)
		ofType += fData->FieldAt(i).type == type ? 1 : 0;
	return ofType;
}


bool
BMessage::IsEmpty() const
{
	return fData == nullptr || fData->CountFields() == 0;
}


bool
BMessage::IsSystem() const
{
	return what >> 24 == '_';
}


void
BMessage::PrintToStream() const
{
	printf("BMessage: what = 0x%08x, %d fields\n", unsigned(what), int(CountNames(B_ANY_TYPE)));
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		const char code[] = { char(type >> 24), char(type >> 16), char(type >> 8), char(type), 0 };
		printf("    %s, type = '%s', count = %d\n", name, code, int(count));
	}
}


status_t
BMessage::Rename(const char* oldEntry, const char* newEntry)
{
	if (oldEntry == nullptr || newEntry == nullptr)
		return B_BAD_VALUE;
	const size_t length = strlen(newEntry);
	if (length > B_FIELD_NAME_LENGTH)
		return B_BAD_VALUE;
	const int32 number = _Find(oldEntry);
	if (number < 0)
		return B_NAME_NOT_FOUND;
	MessageData* data = _Own();
	return data != nullptr ? data->RenameField(uint32(number), newEntry, length)
						   : status_t(B_NO_MEMORY);
}


// #pragma mark - bytes


ssize_t
BMessage::FlattenedSize() const
{
	return flattened_message_size(*this, B_R5_FORM);
}


status_t
BMessage::Flatten(char* buffer, ssize_t size) const
{
	return flatten_message(*this, B_R5_FORM, buffer, size);
}


status_t
BMessage::Flatten(BDataIO* stream, ssize_t* size) const
{
	if (stream == nullptr)
		return B_BAD_VALUE;
	MessageWriter writer(fData, what, B_R5_FORM);
	if (writer.Size() < 0)
		return status_t(writer.Size());
	uint8* buffer = static_cast<uint8*>(malloc(size_t(writer.Size())));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	writer.Write(buffer);
	const ssize_t written = stream->Write(buffer, size_t(writer.Size()));
	free(buffer);

	if (written < 0)
		return status_t(written);
	if (written != writer.Size())
		return B_ERROR;
	if (size != nullptr)
		*size = written;
	return B_OK;
}


status_t
BMessage::Unflatten(const char* flatBuffer)
{
	if (flatBuffer == nullptr)
		return B_BAD_VALUE;
	// The caller vouches for a whole message, so its header may be read, but only if it is one.
	uint32 magic;
	memcpy(&magic, flatBuffer, sizeof(magic));
	const auto* bytes = reinterpret_cast<const uint8*>(flatBuffer);
	const bool haiku =
		magic == BPrivate::kHaikuMagic || magic == __builtin_bswap32(BPrivate::kHaikuMagic);
	const bool known = haiku || magic == BPrivate::kR5Magic || magic == BPrivate::kDanoMagic
		|| magic == __builtin_bswap32(BPrivate::kR5Magic)
		|| magic == __builtin_bswap32(BPrivate::kDanoMagic);
	if (!known) {
		_Clear();
		return B_NOT_A_MESSAGE;
	}
	const size_t size = BPrivate::read_message_size(bytes, haiku ? BPrivate::kHaikuHeaderSize : 16);
	return unflatten_message(this, flatBuffer, size);
}


status_t
BMessage::Unflatten(BDataIO* stream)
{
	if (stream == nullptr)
		return B_BAD_VALUE;
	_Clear();

	uint8 header[BPrivate::kFormHeaderSize];
	size_t have = 0;
	status_t status = stream->ReadExactly(header, 16, &have);
	if (status != B_OK)
		return status == B_PARTIAL_READ ? status_t(B_NOT_A_MESSAGE) : status;
	size_t size = BPrivate::read_message_size(header, have);
	uint32 magic = BPrivate::read_uint32(header);
	if (magic == BPrivate::kHaikuMagic || magic == __builtin_bswap32(BPrivate::kHaikuMagic)) {
		size_t more = 0;
		status = stream->ReadExactly(header + have, sizeof(header) - have, &more);
		if (status != B_OK)
			return status == B_PARTIAL_READ ? status_t(B_BAD_VALUE) : status;
		have += more;
		size = BPrivate::read_message_size(header, have);
	} else if (size == 0)
		return B_NOT_A_MESSAGE;
	if (size < have)
		return B_BAD_VALUE;
	return _ReadRest(stream, header, have, size);
}


// #pragma mark - adding and removing


status_t
BMessage::AddData(
	const char* name, type_code type, const void* data, ssize_t numBytes, bool isFixedSize, int32)
{
	if (name == nullptr || data == nullptr || numBytes <= 0)
		return B_BAD_VALUE;
	MessageData* owned = _Own();
	if (owned == nullptr)
		return B_NO_MEMORY;
	const size_t length = strlen(name);
	int32 number = owned->Find(name, length);
	if (number >= 0 && fWriteBack != nullptr)
		number = fWriteBack->MakeRoom(*owned, name, length);
	if (number < 0) {
		if (length > B_FIELD_NAME_LENGTH)
			return B_BAD_VALUE;
		const status_t status =
			owned->AddField(name, length, type, isFixedSize, { data, size_t(numBytes) });
		if (status == B_OK && fWriteBack != nullptr)
			fWriteBack->PlaceLast(*owned);
		return status;
	}

	const MessageField& field = owned->FieldAt(uint32(number));
	if (type != B_ANY_TYPE && type != field.type)
		return B_BAD_TYPE;
	if (field.Has(MessageField::kFixed) && field.ItemSize() != size_t(numBytes))
		return B_BAD_VALUE;
	return owned->AddItem(uint32(number), { data, size_t(numBytes) });
}


status_t
BMessage::AddMessage(const char* name, const BMessage* message)
{
	if (name == nullptr || message == nullptr)
		return B_BAD_VALUE;
	// First, so that a message can be put into itself.
	MessageData* nested = _Nested(*message);
	if (nested == nullptr)
		return B_NO_MEMORY;
	const status_t status = _Own() != nullptr ? _AddNested(name, nested) : status_t(B_NO_MEMORY);
	nested->Release();
	return status;
}


status_t
BMessage::AddFlat(const char* name, BFlattenable* object, int32 count)
{
	return AddFlat(name, const_cast<const BFlattenable*>(object), count);
}


status_t
BMessage::AddFlat(const char* name, const BFlattenable* object, int32 count)
{
	if (name == nullptr || object == nullptr)
		return B_BAD_VALUE;
	const ssize_t size = object->FlattenedSize();
	if (size <= 0)
		return B_BAD_VALUE;
	void* buffer = malloc(size_t(size));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	status_t status = object->Flatten(buffer, size);
	if (status == B_OK)
		status = AddData(name, object->TypeCode(), buffer, size, false, count);
	free(buffer);
	return status;
}


status_t
BMessage::Append(const BMessage& message)
{
	// The other message may be this one.
	const BMessage other(message);
	const uint32 fields = other.fData != nullptr ? other.fData->CountFields() : 0;
	for (uint32 i = 0; i < fields; i++) {
		const MessageField& field = other.fData->FieldAt(i);
		const char* name = other.fData->NameAt(i);
		for (uint32 k = 0; k < field.count; k++) {
			const status_t status = _AppendItem(*other.fData, i, k, name);
			if (status != B_OK)
				return status;
		}
	}
	return B_OK;
}


status_t
BMessage::RemoveData(const char* name, int32 index)
{
	if (index < 0)
		return B_BAD_INDEX;
	if (name == nullptr)
		return B_BAD_VALUE;
	const int32 number = _Find(name);
	if (number < 0)
		return B_NAME_NOT_FOUND;
	if (uint32(index) >= fData->FieldAt(uint32(number)).count)
		return B_BAD_INDEX;
	MessageData* data = _Own();
	return data != nullptr ? data->RemoveItem(uint32(number), uint32(index))
						   : status_t(B_NO_MEMORY);
}


status_t
BMessage::RemoveName(const char* name)
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const int32 number = _Find(name);
	if (number < 0)
		return B_NAME_NOT_FOUND;
	MessageData* data = _Own();
	if (data == nullptr)
		return B_NO_MEMORY;
	data->RemoveField(uint32(number));
	return B_OK;
}


status_t
BMessage::MakeEmpty()
{
	_Release();
	fData = nullptr;
	fDelivery = nullptr;
	fLookUps = nullptr;
	fWriteBack = nullptr;
	fCurrentSpecifier = -1;
	return B_OK;
}


// #pragma mark - finding and replacing


status_t
BMessage::FindData(const char* name, type_code type, const void** data, ssize_t* numBytes) const
{
	return FindData(name, type, 0, data, numBytes);
}


status_t
BMessage::FindData(
	const char* name, type_code type, int32 index, const void** data, ssize_t* numBytes) const
{
	if (data == nullptr)
		return B_BAD_VALUE;
	*data = nullptr;
	uint32 number;
	status_t status = _FindItem(name, type, index, &number);
	size_t size = 0;
	if (status == B_OK)
		status = fData->GetItem(number, uint32(index), data, &size);
	if (status == B_OK && numBytes != nullptr)
		*numBytes = ssize_t(size);
	return status;
}


status_t
BMessage::FindMessage(const char* name, BMessage* message) const
{
	return FindMessage(name, 0, message);
}


// The target may be this message itself, so its old contents go last.
status_t
BMessage::FindMessage(const char* name, int32 index, BMessage* message) const
{
	if (message == nullptr)
		return B_BAD_VALUE;
	uint32 number;
	status_t status = _FindItem(name, B_MESSAGE_TYPE, index, &number);
	MessageData* nested = nullptr;
	if (status == B_OK)
		nested = fData->GetMessage(number, uint32(index), &status);

	BMessage found(nested != nullptr ? nested->What() : 0);
	found.fData = nested;
	*message = std::move(found);
	return status;
}


status_t
BMessage::FindFlat(const char* name, BFlattenable* object) const
{
	return FindFlat(name, 0, object);
}


status_t
BMessage::FindFlat(const char* name, int32 index, BFlattenable* object) const
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const void* data;
	ssize_t size;
	const status_t status = FindData(name, object->TypeCode(), index, &data, &size);
	return status == B_OK ? object->Unflatten(object->TypeCode(), data, size) : status;
}


status_t
BMessage::ReplaceData(const char* name, type_code type, const void* data, ssize_t numBytes)
{
	return ReplaceData(name, type, 0, data, numBytes);
}


status_t
BMessage::ReplaceData(
	const char* name, type_code type, int32 index, const void* data, ssize_t numBytes)
{
	if (data == nullptr || numBytes <= 0)
		return B_BAD_VALUE;
	uint32 number;
	const status_t status = _FindItem(name, type, index, &number);
	if (status != B_OK)
		return status;
	const MessageField& field = fData->FieldAt(number);
	if (field.Has(MessageField::kFixed) && field.ItemSize() != size_t(numBytes))
		return B_BAD_VALUE;
	MessageData* owned = _Own();
	return owned != nullptr ? owned->ReplaceItem(number, uint32(index), { data, size_t(numBytes) })
							: status_t(B_NO_MEMORY);
}


status_t
BMessage::ReplaceMessage(const char* name, const BMessage* message)
{
	return ReplaceMessage(name, 0, message);
}


status_t
BMessage::ReplaceMessage(const char* name, int32 index, const BMessage* message)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	uint32 number;
	status_t status = _FindItem(name, B_MESSAGE_TYPE, index, &number);
	if (status != B_OK)
		return status;

	MessageData* nested = _Nested(*message);
	MessageData* owned = _Own();
	if (nested == nullptr || owned == nullptr)
		status = B_NO_MEMORY;
	else if (owned->FieldAt(number).Has(MessageField::kFixed)) {
		// Such a field takes bytes of its size only.
		BPrivate::SharedBytes* bytes = BPrivate::flatten_to_bytes(*nested, nested->What());
		status = bytes != nullptr
			? ReplaceData(name, B_MESSAGE_TYPE, index, bytes->Bytes(), ssize_t(bytes->Size()))
			: status_t(B_NO_MEMORY);
		if (bytes != nullptr)
			bytes->Release();
	} else
		status = owned->ReplaceMessage(number, uint32(index), nested);
	if (nested != nullptr)
		nested->Release();
	return status;
}


status_t
BMessage::ReplaceFlat(const char* name, BFlattenable* object)
{
	return ReplaceFlat(name, 0, object);
}


status_t
BMessage::ReplaceFlat(const char* name, int32 index, BFlattenable* object)
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const ssize_t size = object->FlattenedSize();
	if (size <= 0)
		return B_BAD_VALUE;
	void* buffer = malloc(size_t(size));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	status_t status = object->Flatten(buffer, size);
	if (status == B_OK)
		status = ReplaceData(name, object->TypeCode(), index, buffer, size);
	free(buffer);
	return status;
}


// #pragma mark - asking


bool
BMessage::HasFlat(const char* name, const BFlattenable* object) const
{
	return HasFlat(name, 0, object);
}


bool
BMessage::HasFlat(const char* name, int32 index, const BFlattenable* object) const
{
	return object != nullptr && HasData(name, object->TypeCode(), index);
}


bool
BMessage::HasData(const char* name, type_code type, int32 index) const
{
	uint32 number;
	return _FindItem(name, type, index, &number) == B_OK;
}


bool
BMessage::HasSameData(const BMessage& other, bool ignoreFieldOrder, bool deep) const
{
	const uint32 count = fData != nullptr ? fData->CountFields() : 0;
	const uint32 otherCount = other.fData != nullptr ? other.fData->CountFields() : 0;
	if (count != otherCount)
		return false;
	if (fData == other.fData)
		return true;
	std::vector<uint32> pairs;
	if (ignoreFieldOrder && !BPrivate::pair_fields(*fData, *other.fData, &pairs))
		return false;
	for (uint32 i = 0; i < count; i++) {
		const uint32 otherField = pairs.empty() ? i : pairs[i];
		if (!_SameField(i, *other.fData, otherField, ignoreFieldOrder, deep))
			return false;
	}
	return true;
}


// #pragma mark - private


int32
BMessage::_Find(const char* name) const
{
	if (fData == nullptr)
		return -1;
	const int32 number = fWriteBack == nullptr
		? fData->Find(name)
		: BPrivate::WriteBack::Find(*fData, name, strlen(name));
	if (fLookUps != nullptr)
		fLookUps->Mark(fData, number, name);
	return number;
}


status_t
BMessage::_FindItem(const char* name, type_code type, int32 index, uint32* _number) const
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const int32 number = _Find(name);
	if (number < 0)
		return B_NAME_NOT_FOUND;
	const MessageField& field = fData->FieldAt(uint32(number));
	if (type != B_ANY_TYPE && type != field.type)
		return B_BAD_TYPE;
	if (index < 0 || uint32(index) >= field.count)
		return B_BAD_INDEX;
	*_number = uint32(number);
	return B_OK;
}


// A shorter item than the value is refused, a longer one is cut, as in sources that were written
// for a smaller type.
status_t
BMessage::_FindFixed(const char* name, type_code type, int32 index, void* value, size_t size) const
{
	if (value == nullptr)
		return B_BAD_VALUE;
	const void* data;
	size_t found = 0;
	uint32 number;
	status_t status = _FindItem(name, type, index, &number);
	if (status == B_OK)
		status = fData->GetItem(number, uint32(index), &data, &found);
	if (status == B_OK && found < size)
		status = B_BAD_VALUE;
	if (status == B_OK)
		memcpy(value, data, size);
	return status;
}


MessageData*
BMessage::_Own()
{
	if (fData == nullptr)
		fData = MessageData::Create();
	else if (fData->IsShared()) {
		MessageData* clone = fData->Clone();
		if (clone == nullptr)
			return nullptr;
		fData->Release();
		fData = clone;
	}
	return fData;
}


// A message's contents for keeping inside another one: a reference, or NULL without memory. They
// are shared when they can carry the message's code.
MessageData*
BMessage::_Nested(const BMessage& message)
{
	if (message.fData == nullptr) {
		MessageData* empty = MessageData::Create();
		if (empty != nullptr)
			empty->SetWhat(message.what);
		return empty;
	}
	if (message.fData->What() == message.what) {
		message.fData->Acquire();
		return message.fData;
	}
	if (!message.fData->IsShared()) {
		message.fData->SetWhat(message.what);
		message.fData->Acquire();
		return message.fData;
	}
	MessageData* clone = message.fData->Clone();
	if (clone != nullptr)
		clone->SetWhat(message.what);
	return clone;
}


status_t
BMessage::_AddNested(const char* name, MessageData* nested)
{
	const size_t length = strlen(name);
	int32 number = fData->Find(name, length);
	if (number >= 0 && fWriteBack != nullptr)
		number = fWriteBack->MakeRoom(*fData, name, length);
	const bool fixed = number >= 0 && fData->FieldAt(uint32(number)).Has(MessageField::kFixed);
	// Messages that lie deep in each other are kept as bytes from some depth on, so that no walk
	// over them has to go deeper than that.
	if (fixed || nested->Height() >= B_MAX_MESSAGE_NESTING - 1) {
		BPrivate::SharedBytes* bytes = BPrivate::flatten_to_bytes(*nested, nested->What());
		if (bytes == nullptr)
			return B_NO_MEMORY;
		const status_t status =
			AddData(name, B_MESSAGE_TYPE, bytes->Bytes(), ssize_t(bytes->Size()), false);
		bytes->Release();
		return status;
	}
	const BPrivate::ItemContents item { nullptr, nested->FlatSize(), nested };
	const bool copied = nested->IsBetterCopied();
	if (number >= 0) {
		if (fData->FieldAt(uint32(number)).type != B_MESSAGE_TYPE)
			return B_BAD_TYPE;
		return copied ? fData->AddItem(uint32(number), item)
					  : fData->AddMessageItem(uint32(number), nested);
	}
	if (length > B_FIELD_NAME_LENGTH)
		return B_BAD_VALUE;
	const status_t status = copied ? fData->AddField(name, length, B_MESSAGE_TYPE, false, item)
								   : fData->AddMessageField(name, length, B_MESSAGE_TYPE, nested);
	if (status == B_OK && fWriteBack != nullptr)
		fWriteBack->PlaceLast(*fData);
	return status;
}


status_t
BMessage::_AppendItem(const MessageData& from, uint32 number, uint32 index, const char* name)
{
	const MessageField& field = from.FieldAt(number);
	if (_Own() == nullptr)
		return B_NO_MEMORY;
	if (MessageData* nested = from.MessageAt(number, index))
		return _AddNested(name, nested);
	const void* data;
	size_t size;
	const status_t status = from.GetItem(number, index, &data, &size);
	if (status != B_OK)
		return status;
	return AddData(name, field.type, data, ssize_t(size), field.Has(MessageField::kFixed));
}


bool
BMessage::_SameField(uint32 number, const MessageData& other, uint32 otherNumber,
	bool ignoreFieldOrder, bool deep) const
{
	const MessageField& a = fData->FieldAt(number);
	const MessageField& b = other.FieldAt(otherNumber);
	if (a.type != b.type || a.count != b.count || a.nameLength != b.nameLength
		|| memcmp(fData->NameBytes(a), other.NameBytes(b), a.nameLength) != 0)
		return false;
	for (uint32 i = 0; i < a.count; i++) {
		if (deep && a.type == B_MESSAGE_TYPE) {
			const int8 same = _SameMessages(number, other, otherNumber, i, ignoreFieldOrder);
			if (same >= 0) {
				if (same == 0)
					return false;
				continue;
			}
		}
		const void* dataA;
		const void* dataB;
		size_t sizeA;
		size_t sizeB;
		if (fData->GetItem(number, i, &dataA, &sizeA) != B_OK
			|| other.GetItem(otherNumber, i, &dataB, &sizeB) != B_OK)
			return false;
		if (sizeA != sizeB || memcmp(dataA, dataB, sizeA) != 0)
			return false;
	}
	return true;
}


// 1 or 0, or -1 when one of the items is no message that can be read.
int8
BMessage::_SameMessages(uint32 number, const MessageData& other, uint32 otherNumber, uint32 index,
	bool ignoreFieldOrder) const
{
	BMessage a;
	BMessage b;
	a.fData = fData->GetMessage(number, index);
	b.fData = other.GetMessage(otherNumber, index);
	if (a.fData == nullptr || b.fData == nullptr)
		return -1;
	if (a.fData->What() != b.fData->What())
		return 0;
	return a.HasSameData(b, ignoreFieldOrder, true) ? 1 : 0;
}


// Reads the rest of a message whose size its header gives. The memory grows with what comes, since
// the size may be a lie.
status_t
BMessage::_ReadRest(BDataIO* stream, const uint8* header, size_t have, size_t size)
{
	constexpr size_t kFirstRoom = 64 * 1024;
	size_t room = min_c(size, max_c(kFirstRoom, have));
	uint8* buffer = static_cast<uint8*>(malloc(room));
	if (buffer == nullptr)
		return B_NO_MEMORY;
	memcpy(buffer, header, have);
	status_t status = B_OK;
	while (have < size && status == B_OK) {
		if (have == room) {
			room = min_c(size, room * 2);
			uint8* larger = static_cast<uint8*>(realloc(buffer, room));
			if (larger == nullptr) {
				status = B_NO_MEMORY;
				break;
			}
			buffer = larger;
		}
		size_t more = 0;
		status = stream->ReadExactly(buffer + have, room - have, &more);
		have += more;
	}
	if (status != B_OK) {
		free(buffer);
		return status == B_PARTIAL_READ ? status_t(B_BAD_VALUE) : status;
	}
	return unflatten_message_shared(this, buffer, size, free, buffer);
}


// Empties the message for new contents.
void
BMessage::_Clear()
{
	MakeEmpty();
	what = 0;
}


void
BMessage::_Release()
{
	if (fData != nullptr)
		fData->Release();
	delete fDelivery;
	delete fWriteBack;
	if (fLookUps != nullptr)
		fLookUps->Release();
}


// #pragma mark - MessagePrivate


namespace BPrivate {


DeliveryState::~DeliveryState()
{
}


void
MessagePrivate::SetDelivery(std::unique_ptr<DeliveryState> state)
{
	delete fMessage->fDelivery;
	fMessage->fDelivery = state.release();
}


void
MessagePrivate::SetData(MessageData* data)
{
	if (data != nullptr)
		data->Acquire();
	if (fMessage->fData != nullptr)
		fMessage->fData->Release();
	fMessage->fData = data;
}


void
MessagePrivate::SetWriteBack(std::unique_ptr<WriteBack> writeBack)
{
	delete fMessage->fWriteBack;
	fMessage->fWriteBack = writeBack.release();
}


void
MessagePrivate::SetLookUps(LookUps* lookUps)
{
	if (lookUps != nullptr)
		lookUps->Acquire();
	if (fMessage->fLookUps != nullptr)
		fMessage->fLookUps->Release();
	fMessage->fLookUps = lookUps;
}


} // namespace BPrivate
