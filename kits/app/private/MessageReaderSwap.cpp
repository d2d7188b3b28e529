// MessageReader: items of the other byte order, which are copied.

#include <cstdlib>

#include <ByteOrder.h>
#include <TypeConstants.h>

#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

// Turns an item of the other byte order into the host's. Sizes and alignments are younger than the
// R5 form's swapping: its writers and readers leave their bytes alone.
void
swap_item(type_code type, uint8* item, size_t size, bool isR5)
{
	switch (type) {
		case B_SIZE_TYPE:
		case B_ALIGNMENT_TYPE:
			if (!isR5)
				swap_data(type, item, size, B_SWAP_ALWAYS);
			break;

		case B_SIZE_T_TYPE:
		case B_SSIZE_T_TYPE:
		case B_POINTER_TYPE:
		case B_TIME_TYPE:
			// As wide as a word of the machine that wrote it.
			swap_data(size >= 8 ? B_INT64_TYPE : B_INT32_TYPE, item, size, B_SWAP_ALWAYS);
			break;

		case B_MESSENGER_TYPE:
			swap_data(B_INT32_TYPE, item, min_c(size, size_t(12)), B_SWAP_ALWAYS);
			break;

		case B_REF_TYPE:
		case B_NODE_REF_TYPE:
			if (size >= 12) {
				swap_data(B_INT32_TYPE, item, 4, B_SWAP_ALWAYS);
				swap_data(B_INT64_TYPE, item + 4, 8, B_SWAP_ALWAYS);
			}
			break;

		default:
			swap_data(type, item, size, B_SWAP_ALWAYS);
			break;
	}
}

} // namespace


bool
MessageReader::_TakeSwapped(const Field& field)
{
	if (field.fixed) {
		const size_t size = field.size / field.count;
		for (uint32 i = 0; i < field.count; i++) {
			if (!_AddSwappedItem(field, i == 0, field.data + i * size, size))
				return false;
		}
		return true;
	}

	if (!_CheckItems(field, nullptr))
		return false;
	const bool packed = (field.flags & MessageField::kPacked) != 0;
	const uint8* at = field.data;
	for (uint32 i = 0; i < field.count; i++) {
		const size_t size = _Number32(at);
		if (!_AddSwappedItem(field, i == 0, at + 4, size))
			return false;
		at += packed ? size + 4 : padded_item_size(size);
	}
	return true;
}


// Adds a copy in the host's byte order.
bool
MessageReader::_AddSwappedItem(const Field& field, bool first, const uint8* item, size_t size)
{
	if (fBuilt == nullptr)
		fBuilt = MessageData::Create();
	status_t status = fBuilt != nullptr ? status_t(B_OK) : status_t(B_NO_MEMORY);

	uint8 few[64];
	uint8* swapped = size <= sizeof(few) ? few : static_cast<uint8*>(malloc(size));
	if (swapped == nullptr)
		status = B_NO_MEMORY;
	if (status == B_OK) {
		memcpy(swapped, item, size);
		if (fSwapped)
			swap_item(field.type, swapped, size, read_uint32(fBytes) == swap_if(kR5Magic, true));
		status = first ? fBuilt->AddField(
					 field.name, field.nameLength, field.type, field.fixed, { swapped, size })
					   : fBuilt->AddItem(fBuilt->CountFields() - 1, { swapped, size });
	}
	if (swapped != few)
		free(swapped);
	return status == B_OK || _Fail(status, item, "there is not enough memory");
}


} // namespace BPrivate
