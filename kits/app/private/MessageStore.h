// How the items of a message lie in its store.
#pragma once

#include <cstring>

#include "app/private/MessageData.h"

namespace BPrivate {

// Up to here a walk over the items of a field is as good as a table.
constexpr uint32 kFewItems = 8;

// Offsets and the sizes in flattened messages are signed 32-bit numbers.
constexpr size_t kLargestStore = 0x7fffff00;


// Writes a variable item with its size and padding.
inline void
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


} // namespace BPrivate
