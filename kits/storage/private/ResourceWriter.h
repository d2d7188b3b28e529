// Writes resource files.
#pragma once

#include <SupportDefs.h>

#include "storage/private/AtomicFile.h"
#include "storage/private/ResourceReader.h"
#include "storage/private/ResourceTable.h"

namespace BPrivate {

// What a file has besides its resources.
struct ResourceFrame {
	resource_file_info info = { B_EMPTY_FILE, false, false, 4 };
	ResourceExtras extras;
	off_t size = 0;
};

// Where the bytes of items lie that are not in memory.
struct ResourceSource {
	int fd = -1;
	bool bigEndian = false;
};

// Writes the whole file: what precedes the section is copied from `oldFd`, or is a new x86 header
// when the frame is that of an empty file. *_offsets gets each item's new place.
status_t WriteResourceFile(AtomicFile& file, const ResourceFrame& frame, int oldFd,
	ResourceTable& table, const ResourceSource& source, std::vector<off_t>* _offsets);

// The bytes of an item in the host's order, from malloc(); NULL when they cannot be read.
void* ReadResourceData(const ResourceItem& item, const ResourceSource& source);

} // namespace BPrivate
