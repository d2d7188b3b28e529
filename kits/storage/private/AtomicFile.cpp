#include "storage/private/AtomicFile.h"

#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <vector>

#include "storage/private/Errno.h"
#include "storage/private/NodeAttributes.h"

namespace BPrivate {

namespace {

constexpr size_t kBlockSize = 128 * 1024;
constexpr size_t kLargestName = 255;
constexpr int kMostAttempts = 100;

std::atomic<uint32> sCounter { 0 };


// Goes on after an interruption.
template<typename Call>
auto
Retry(Call call)
{
	auto result = call();
	while (result < 0 && errno == EINTR)
		result = call();
	return result;
}


status_t
SyncFolder(int fd)
{
	if (Retry([=] { return fsync(fd); }) == 0)
		return B_OK;
	// Some file systems sync no folders, and a folder that may not be listed is open as a path.
	return errno == EINVAL || errno == EBADF ? B_OK : LastStatus();
}


// What is not there, or cannot be there, need not be carried over.
bool
IsOwnAttribute(const char* name)
{
	return strncmp(name, "user.", 5) == 0 || strncmp(name, "system.posix_acl", 16) == 0;
}

} // namespace


AtomicFile::AtomicFile() : fWritten(0), fReplaced(false)
{
}


AtomicFile::~AtomicFile()
{
	_Abandon();
}


status_t
AtomicFile::SetTo(const char* path)
{
	if (path == NULL || path[0] == '\0')
		return B_BAD_VALUE;
	return _Open(path);
}


status_t
AtomicFile::SetTo(int fd, const char* path)
{
	const std::string now = PathOf(fd);
	if (!now.empty())
		return _Open(now.c_str());
	if (path == NULL || access(path, F_OK) < 0)
		return B_ENTRY_NOT_FOUND;
	return _Open(path);
}


status_t
AtomicFile::Write(const void* data, size_t size)
{
	if (fFile == nullptr)
		return B_NO_INIT;
	const char* from = static_cast<const char*>(data);
	while (size > 0) {
		const ssize_t step = Retry([&] { return write(Fd(), from, size); });
		if (step < 0)
			return LastStatus();
		if (step == 0)
			return B_DEVICE_FULL;
		from += step;
		size -= step;
		fWritten += step;
	}
	return B_OK;
}


status_t
AtomicFile::Fill(off_t size)
{
	const std::vector<char> zeros(std::min<off_t>(size, kBlockSize));
	while (size > 0) {
		const size_t step = std::min<off_t>(size, zeros.size());
		const status_t status = Write(zeros.data(), step);
		if (status != B_OK)
			return status;
		size -= step;
	}
	return B_OK;
}


status_t
AtomicFile::CopyFrom(int fd, off_t position, off_t size)
{
	std::vector<char> block(std::min<off_t>(size, kBlockSize));
	while (size > 0) {
		const size_t wanted = std::min<off_t>(size, block.size());
		const ssize_t step = Retry([&] { return pread(fd, block.data(), wanted, position); });
		if (step < 0)
			return LastStatus();
		if (step == 0)
			return B_IO_ERROR;
		const status_t status = Write(block.data(), step);
		if (status != B_OK)
			return status;
		position += step;
		size -= step;
	}
	return B_OK;
}


status_t
AtomicFile::Commit()
{
	if (fFile == nullptr || fTemporary.empty())
		return B_NO_INIT;
	status_t status = fTarget != nullptr ? _CopyMetadata() : static_cast<status_t>(B_OK);
	if (status == B_OK && Retry([&] { return fsync(Fd()); }) < 0)
		status = LastStatus();
	if (status == B_OK
		&& renameat(fFolder->Fd(), fTemporary.c_str(), fFolder->Fd(), fName.c_str()) < 0)
		status = LastStatus();
	if (status != B_OK) {
		_Abandon();
		return status;
	}

	fTemporary.clear();
	fReplaced = true;
	if (fTarget != nullptr)
		MoveRememberedAttributes(fTarget->Fd(), Fd());
	return SyncFolder(fFolder->Fd());
}


// #pragma mark - private


status_t
AtomicFile::_Open(const char* path)
{
	_Abandon();
	fTarget.reset();
	fWritten = 0;
	fReplaced = false;

	// Following all links first puts the new file beside the real one, not beside a link. A file
	// that is not there yet has a folder all the same.
	char* real = realpath(path, NULL);
	fPath = real != NULL ? real : path;
	free(real);
	if (real == NULL && errno != ENOENT)
		return LastStatus();

	const int folder = OpenParent(AT_FDCWD, fPath.c_str(), &fName);
	if (folder < 0)
		return LastStatus();
	fFolder = std::make_unique<Descriptor>(folder);
	if (fName.empty())
		return B_IS_A_DIRECTORY;
	const int listed = OpenAt(folder, ".", O_RDONLY | O_DIRECTORY);
	if (listed >= 0)
		fFolder = std::make_unique<Descriptor>(listed);

	const int target = OpenAt(fFolder->Fd(), fName.c_str(), O_PATH | O_NOFOLLOW);
	if (target < 0 && errno != ENOENT)
		return LastStatus();
	if (target < 0)
		return _CreateTemporary(0666);
	fTarget = std::make_unique<Descriptor>(target);
	const status_t status = _CreateTemporary(0600);
	return status == B_OK ? _CheckTarget() : status;
}


status_t
AtomicFile::_CreateTemporary(mode_t mode)
{
	// The name says whose it is, for the case that the machine stops before it is removed.
	for (int attempt = 0; attempt < kMostAttempts; attempt++) {
		char suffix[48];
		snprintf(suffix, sizeof(suffix), ".%d-%u.tmp", static_cast<int>(getpid()),
			static_cast<unsigned>(sCounter++));
		const std::string name = "." + fName.substr(0, kLargestName - 1 - strlen(suffix)) + suffix;
		const int fd =
			OpenAt(fFolder->Fd(), name.c_str(), O_RDWR | O_CREAT | O_EXCL | O_NOFOLLOW, mode);
		if (fd >= 0) {
			fFile = std::make_unique<Descriptor>(fd);
			fTemporary = name;
			return B_OK;
		}
		if (errno != EEXIST)
			return LastStatus();
	}
	return B_FILE_EXISTS;
}


// Whether the new file can stand in for the old one in every way.
status_t
AtomicFile::_CheckTarget()
{
	struct stat target;
	struct stat file;
	if (fstat(fTarget->Fd(), &target) < 0 || fstat(Fd(), &file) < 0)
		return LastStatus();
	status_t status = B_OK;
	if (S_ISDIR(target.st_mode))
		status = B_IS_A_DIRECTORY;
	else if (!S_ISREG(target.st_mode))
		status = B_BAD_VALUE;
	else if (faccessat(fFolder->Fd(), fName.c_str(), W_OK, AT_EACCESS) < 0)
		status = LastStatus();
	else if ((target.st_uid != file.st_uid || target.st_gid != file.st_gid)
		&& fchown(Fd(), target.st_uid, target.st_gid) < 0)
		status = B_NOT_ALLOWED;
	if (status != B_OK)
		_Abandon();
	return status;
}


status_t
AtomicFile::_CopyMetadata()
{
	struct stat stat;
	if (fstat(fTarget->Fd(), &stat) < 0)
		return LastStatus();
	const status_t status = _CopyAttributes();
	if (status != B_OK)
		return status;
	// Last, because writing and changing the owner take special bits away.
	return fchmod(Fd(), stat.st_mode & 07777) < 0 ? LastStatus() : B_OK;
}


status_t
AtomicFile::_CopyAttributes()
{
	// The folder may have given the new file an access list that the old one does not have.
	fremovexattr(Fd(), "system.posix_acl_access");

	const std::string path = ProcPathOf(fTarget->Fd());
	const ssize_t length = listxattr(path.c_str(), NULL, 0);
	if (length < 0)
		return errno == ENOTSUP || errno == ENOSYS ? static_cast<status_t>(B_OK) : LastStatus();
	std::string names(length, '\0');
	const ssize_t listed = listxattr(path.c_str(), names.data(), names.size());
	if (listed < 0)
		return LastStatus();
	names.resize(listed);

	std::string value;
	for (size_t start = 0; start < names.size(); start += strlen(names.c_str() + start) + 1) {
		const char* name = names.c_str() + start;
		// Labels of the system are its own business: the new file gets its own.
		if (!IsOwnAttribute(name))
			continue;
		const ssize_t size = getxattr(path.c_str(), name, NULL, 0);
		if (size < 0)
			return LastStatus();
		value.resize(size);
		const ssize_t read = getxattr(path.c_str(), name, value.data(), value.size());
		if (read < 0)
			return LastStatus();
		if (fsetxattr(Fd(), name, value.data(), read, 0) < 0)
			return errno == EPERM || errno == EACCES ? B_NOT_SUPPORTED : LastStatus();
	}
	return B_OK;
}


void
AtomicFile::_Abandon()
{
	if (!fTemporary.empty()) {
		unlinkat(fFolder->Fd(), fTemporary.c_str(), 0);
		fTemporary.clear();
	}
	fFile.reset();
}

} // namespace BPrivate
