// What the first bytes of a flattened message tell.

#include <bit>

#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"

namespace BPrivate {

namespace {

uint32
r5_checksum(const uint8* bytes, size_t size)
{
	uint32 sum = 0;
	for (size_t i = 0; i < size; i += 4) {
		uint32 group = 0;
		for (size_t k = i; k < i + 4 && k < size; k++)
			group = group << 8 | bytes[k];
		sum += group;
	}
	return sum;
}


// Whether some field is written the wide way though the compact one would do.
bool
is_wide_r5(const uint8* bytes, size_t size, bool swapped)
{
	size_t position = kR5HeaderSize;
	position += (bytes[16] & kR5HasTarget) != 0 ? 4 : 0;
	position += (bytes[16] & kR5HasReply) != 0 ? 16 : 0;
	while (position < size && (bytes[position] & kR5Valid) != 0) {
		const uint8 flags = bytes[position];
		if ((flags & kR5Mini) != 0)
			return false;
		const bool single = (flags & kR5Single) != 0;
		const size_t sizeAt = position + (single ? 5 : 9);
		if (sizeAt + 5 > size)
			return false;
		const uint32 count = single ? 1 : swap_if(read_uint32(bytes + position + 5), swapped);
		const uint32 dataSize = swap_if(read_uint32(bytes + sizeAt), swapped);
		if (count <= 255 && dataSize <= 255)
			return true;
		position = sizeAt + 5 + bytes[sizeAt + 4] + dataSize;
	}
	return false;
}

} // namespace


status_t
read_message_form(const uint8* bytes, size_t size, message_form_info* _info)
{
	*_info = { B_NO_MESSAGE_FORM, false, 0, true };
	if (size < 4)
		return B_NOT_A_MESSAGE;
	uint32 magic = read_uint32(bytes);
	const bool swapped = magic == swap_if(kR5Magic, true) || magic == swap_if(kDanoMagic, true)
		|| magic == swap_if(kHaikuMagic, true);
	magic = swap_if(magic, swapped);

	const auto number = [&](size_t at) { return swap_if(read_uint32(bytes + at), swapped); };
	_info->big_endian = swapped != (std::endian::native == std::endian::big);
	if (magic == kR5Magic && size >= kR5HeaderSize) {
		_info->size = number(8);
		size_t header = kR5HeaderSize;
		header += (bytes[16] & kR5HasTarget) != 0 ? 4 : 0;
		header += (bytes[16] & kR5HasReply) != 0 ? 16 : 0;
		_info->checksum_matches = size >= header && number(4) == r5_checksum(bytes + 8, header - 8);
		const bool wide = is_wide_r5(bytes, min_c(size, _info->size), swapped);
		_info->form = wide ? B_R5_WIDE_FORM : B_R5_FORM;
	} else if (magic == kHaikuMagic && size >= kHaikuHeaderSize) {
		_info->form = B_HAIKU_FORM;
		_info->size = kHaikuHeaderSize + size_t(number(40)) * kHaikuFieldSize + number(36);
	} else if (magic == kDanoMagic && size >= 16) {
		_info->form = B_DANO_FORM;
		_info->size = number(4);
	} else
		return B_NOT_A_MESSAGE;
	return B_OK;
}


size_t
read_message_size(const uint8* bytes, size_t size)
{
	if (size < 16)
		return 0;
	uint32 magic = read_uint32(bytes);
	const bool swapped = magic == swap_if(kR5Magic, true) || magic == swap_if(kDanoMagic, true)
		|| magic == swap_if(kHaikuMagic, true);
	magic = swap_if(magic, swapped);
	const auto number = [&](size_t at) { return swap_if(read_uint32(bytes + at), swapped); };
	if (magic == kR5Magic)
		return number(8);
	if (magic == kDanoMagic)
		return number(4);
	if (magic == kHaikuMagic && size >= kHaikuHeaderSize)
		return kHaikuHeaderSize + size_t(number(40)) * kHaikuFieldSize + number(36);
	return 0;
}


} // namespace BPrivate
