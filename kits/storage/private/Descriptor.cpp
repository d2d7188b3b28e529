#include "storage/private/Descriptor.h"

#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <Errors.h>

#include "storage/private/Errno.h"

namespace BPrivate {

Descriptor::Descriptor(int fd) : fFd(fd)
{
}


Descriptor::~Descriptor()
{
	close(fFd);
}


status_t
Descriptor::Replace(int fd)
{
	while (dup3(fd, fFd, O_CLOEXEC) < 0) {
		if (errno != EINTR && errno != EBUSY)
			return LastStatus();
	}
	return B_OK;
}


status_t
Descriptor::Lock()
{
	// The host lets the holder of a lock take it again, so we remember.
	if (fLocked.exchange(true))
		return B_BUSY;
	if (flock(fFd, LOCK_EX | LOCK_NB) == 0)
		return B_OK;
	const status_t status = errno == EWOULDBLOCK ? B_BUSY : LastStatus();
	fLocked = false;
	return status;
}


status_t
Descriptor::Unlock()
{
	if (!fLocked)
		return B_BAD_VALUE;
	if (flock(fFd, LOCK_UN) < 0)
		return LastStatus();
	fLocked = false;
	return B_OK;
}


// #pragma mark - functions


std::string
ProcPathOf(int fd)
{
	return "/proc/self/fd/" + std::to_string(fd);
}


std::string
PathOf(int fd)
{
	char buffer[PATH_MAX];
	const ssize_t length = readlink(ProcPathOf(fd).c_str(), buffer, sizeof(buffer));
	if (length <= 0 || length == sizeof(buffer) || buffer[0] != '/')
		return std::string();

	// A deleted node's path has a note behind it; only comparing tells it from a real name.
	const std::string path(buffer, length);
	struct stat byPath;
	struct stat byFd;
	if (lstat(path.c_str(), &byPath) < 0 || fstat(fd, &byFd) < 0)
		return std::string();
	if (byPath.st_dev != byFd.st_dev || byPath.st_ino != byFd.st_ino)
		return std::string();
	return path;
}


int
OpenAt(int directoryFd, const char* path, int flags, mode_t mode)
{
	int fd;
	do {
		fd = openat(directoryFd, path, flags | O_CLOEXEC, mode);
	} while (fd < 0 && errno == EINTR);
	return fd;
}


int
OpenParent(int directoryFd, const char* path, std::string* _leaf)
{
	std::string directory(path);
	while (directory.size() > 1 && directory.back() == '/')
		directory.pop_back();

	const size_t slash = directory.rfind('/');
	const size_t start = slash == std::string::npos ? 0 : slash + 1;
	*_leaf = directory.substr(start);
	if (*_leaf == "." || *_leaf == "..")
		_leaf->clear();
	else
		directory.resize(start);

	if (directory.empty())
		directory = ".";
	return OpenAt(directoryFd, directory.c_str(), O_PATH | O_DIRECTORY);
}

} // namespace BPrivate
