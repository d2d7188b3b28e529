// Writes fields of a stat record through a path.
#pragma once

#include <sys/stat.h>

#include <SupportDefs.h>

namespace BPrivate {

enum stat_mask : uint32 {
	kSetOwner = 0x01,
	kSetGroup = 0x02,
	kSetMode = 0x04,
	kSetModificationTime = 0x08,
	kSetAccessTime = 0x10,
	kSetCreationTime = 0x20
};

// `flags` is 0 or AT_SYMLINK_NOFOLLOW. The first field that cannot be set ends the call.
status_t SetStatAt(
	int directoryFd, const char* path, int flags, const struct stat& stat, uint32 what);

} // namespace BPrivate
