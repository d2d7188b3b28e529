#include "storage/private/SetStat.h"

#include <errno.h>
#include <fcntl.h>
#include <unistd.h>

#include <Errors.h>

#include "storage/private/Errno.h"

namespace BPrivate {

namespace {

status_t
SetMode(int directoryFd, const char* path, int flags, mode_t mode)
{
	// A link has no permissions of its own, and the host may refuse to say so gracefully.
	struct stat current;
	if (fstatat(directoryFd, path, &current, flags) < 0)
		return LastStatus();
	if (S_ISLNK(current.st_mode))
		return B_UNSUPPORTED;
	return fchmodat(directoryFd, path, mode, 0) < 0 ? LastStatus() : B_OK;
}


status_t
SetTimes(int directoryFd, const char* path, int flags, const struct stat& stat, uint32 what)
{
	timespec times[2] = { { 0, UTIME_OMIT }, { 0, UTIME_OMIT } };
	if ((what & kSetAccessTime) != 0)
		times[0] = { stat.st_atime, 0 };
	if ((what & kSetModificationTime) != 0)
		times[1] = { stat.st_mtime, 0 };
	return utimensat(directoryFd, path, times, flags) < 0 ? LastStatus() : B_OK;
}

} // namespace


status_t
SetStatAt(int directoryFd, const char* path, int flags, const struct stat& stat, uint32 what)
{
	if ((what & kSetCreationTime) != 0)
		return B_UNSUPPORTED;

	if ((what & (kSetOwner | kSetGroup)) != 0) {
		const uid_t owner = (what & kSetOwner) != 0 ? stat.st_uid : static_cast<uid_t>(-1);
		const gid_t group = (what & kSetGroup) != 0 ? stat.st_gid : static_cast<gid_t>(-1);
		if (fchownat(directoryFd, path, owner, group, flags) < 0)
			return LastStatus();
	}
	if ((what & kSetMode) != 0) {
		const status_t status = SetMode(directoryFd, path, flags, stat.st_mode);
		if (status != B_OK)
			return status;
	}
	if ((what & (kSetAccessTime | kSetModificationTime)) != 0)
		return SetTimes(directoryFd, path, flags, stat, what);
	return B_OK;
}

} // namespace BPrivate
