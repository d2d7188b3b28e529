// BMessage: comparing.

#include <Message.h>

#include <cstring>
#include <vector>

#include "app/private/MessageData.h"
#include "app/private/TwinFields.h"

using BPrivate::MessageData;
using BPrivate::MessageField;


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
