// ResourceItem: one resource, its bytes in memory or still in its file.
#pragma once

#include <stdlib.h>

#include <string>

#include <SupportDefs.h>

namespace BPrivate {

struct ResourceItem {
	ResourceItem() = default;
	~ResourceItem() { free(data); }
	ResourceItem(const ResourceItem&) = delete;
	ResourceItem& operator=(const ResourceItem&) = delete;

	type_code type = 0;
	int32 id = 0;
	std::string name;
	bool named = false; // an empty name is not the same as none, in the file
	size_t size = 0;

	off_t offset = -1; // in the file; -1 when the bytes are only in memory
	void* data = NULL; // from malloc(), in the host's byte order; NULL until it is asked for

	// The table's own
	size_t slot = 0;
	size_t typeSlot = 0;
	ResourceItem* nextSame = NULL; // the next of the same type and id
};

} // namespace BPrivate
