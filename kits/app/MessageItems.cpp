// BMessage: adding, removing, finding and replacing items of any type.

#include <Message.h>

#include <cstring>
#include <utility>

#include "app/private/LookUps.h"
#include "app/private/MessageData.h"
#include "app/private/MessageWriter.h"
#include "app/private/WriteBack.h"

using BPrivate::MessageData;
using BPrivate::MessageField;


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


bool
BMessage::HasData(const char* name, type_code type, int32 index) const
{
	uint32 number;
	return _FindItem(name, type, index, &number) == B_OK;
}


// #pragma mark - private


static int32
number_of(const MessageData* data, bool isWrittenBack, const char* name)
{
	if (data == nullptr)
		return -1;
	return isWrittenBack ? BPrivate::WriteBack::Find(*data, name, strlen(name)) : data->Find(name);
}


int32
BMessage::_Find(const char* name) const
{
	const int32 number = number_of(fData, fWriteBack != nullptr, name);
	if (fLookUps != nullptr)
		fLookUps->Mark(fData, number, name);
	return number;
}


status_t
BMessage::_FindItem(const char* name, type_code type, int32 index, uint32* _number) const
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const int32 number = number_of(fData, fWriteBack != nullptr, name);
	// Who asks for another type does not know this field, and it is carried along.
	if (number >= 0 && type != B_ANY_TYPE && type != fData->FieldAt(uint32(number)).type)
		return B_BAD_TYPE;
	if (fLookUps != nullptr)
		fLookUps->Mark(fData, number, name);
	if (number < 0)
		return B_NAME_NOT_FOUND;
	const MessageField& field = fData->FieldAt(uint32(number));
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
