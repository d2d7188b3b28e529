#include <Message.h>

#include <cstdio>
#include <cstring>
#include <utility>

#include "app/private/LookUps.h"
#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/WriteBack.h"

using BPrivate::MessageData;
using BPrivate::MessageField;


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


// #pragma mark - private


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
