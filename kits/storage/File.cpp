#include <File.h>

#include <errno.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <Directory.h>
#include <Entry.h>
#include <Errors.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"

using namespace BPrivate;


BFile::BFile() : fMode(0)
{
}


BFile::BFile(const BFile& file) : BNode(file), BPositionIO(), fMode(file.fMode)
{
}


BFile::BFile(const entry_ref* ref, uint32 openMode) : fMode(0)
{
	SetTo(ref, openMode);
}


BFile::BFile(const BEntry* entry, uint32 openMode) : fMode(0)
{
	SetTo(entry, openMode);
}


BFile::BFile(const char* path, uint32 openMode) : fMode(0)
{
	SetTo(path, openMode);
}


BFile::BFile(const BDirectory* directory, const char* path, uint32 openMode) : fMode(0)
{
	SetTo(directory, path, openMode);
}


BFile::~BFile()
{
	close_fd();
}


status_t
BFile::SetTo(const entry_ref* ref, uint32 openMode)
{
	const BEntry entry(ref);
	return SetTo(&entry, openMode);
}


status_t
BFile::SetTo(const BEntry* entry, uint32 openMode)
{
	if (entry == NULL || entry->InitCheck() != B_OK) {
		Unset();
		return fCStatus = entry == NULL ? B_BAD_VALUE : entry->InitCheck();
	}
	return _Open(entry->_DirectoryFd(), entry->fName, openMode);
}


status_t
BFile::SetTo(const char* path, uint32 openMode)
{
	return _Open(AT_FDCWD, path, openMode);
}


status_t
BFile::SetTo(const BDirectory* directory, const char* path, uint32 openMode)
{
	if (directory == NULL || directory->fDescriptor == nullptr) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	const std::shared_ptr<Descriptor> start = directory->fDescriptor;
	return _Open(start->Fd(), path, openMode);
}


bool
BFile::IsReadable() const
{
	const uint32 access = fMode & O_ACCMODE;
	return InitCheck() == B_OK && (access == B_READ_ONLY || access == B_READ_WRITE);
}


bool
BFile::IsWritable() const
{
	const uint32 access = fMode & O_ACCMODE;
	return InitCheck() == B_OK && (access == B_WRITE_ONLY || access == B_READ_WRITE);
}


// #pragma mark - transfers

namespace {

// Goes on after an interruption and after a partial transfer, until all is done, the end is
// reached, or an error comes first; what was transferred before an error counts.
template<typename Call>
ssize_t
Transfer(size_t size, Call call)
{
	size_t done = 0;
	while (done < size) {
		const ssize_t step = call(done, size - done);
		if (step < 0 && errno == EINTR)
			continue;
		if (step < 0)
			return done > 0 ? static_cast<ssize_t>(done) : LastStatus();
		if (step == 0)
			break;
		done += step;
	}
	return done;
}

} // namespace


ssize_t
BFile::Read(void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (!IsReadable())
		return B_NOT_ALLOWED;
	return Transfer(size, [&](size_t done, size_t left) {
		return read(_Fd(), static_cast<char*>(buffer) + done, left);
	});
}


ssize_t
BFile::ReadAt(off_t location, void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (!IsReadable())
		return B_NOT_ALLOWED;
	if (location < 0)
		return B_BAD_VALUE;
	return Transfer(size, [&](size_t done, size_t left) {
		return pread(_Fd(), static_cast<char*>(buffer) + done, left, location + done);
	});
}


ssize_t
BFile::Write(const void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (!IsWritable())
		return B_NOT_ALLOWED;
	return Transfer(size, [&](size_t done, size_t left) {
		return write(_Fd(), static_cast<const char*>(buffer) + done, left);
	});
}


ssize_t
BFile::WriteAt(off_t location, const void* buffer, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (!IsWritable())
		return B_NOT_ALLOWED;
	if (location < 0)
		return B_BAD_VALUE;
	return Transfer(size, [&](size_t done, size_t left) {
		return pwrite(_Fd(), static_cast<const char*>(buffer) + done, left, location + done);
	});
}


off_t
BFile::Seek(off_t offset, uint32 seekMode)
{
	if (InitCheck() != B_OK)
		return B_FILE_ERROR;
	const off_t position = lseek(_Fd(), offset, static_cast<int>(seekMode));
	return position < 0 ? LastStatus() : position;
}


off_t
BFile::Position() const
{
	if (InitCheck() != B_OK)
		return B_FILE_ERROR;
	const off_t position = lseek(_Fd(), 0, SEEK_CUR);
	return position < 0 ? LastStatus() : position;
}


status_t
BFile::SetSize(off_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (size < 0)
		return B_BAD_VALUE;
	while (ftruncate(_Fd(), size) < 0) {
		if (errno != EINTR)
			return LastStatus();
	}
	return B_OK;
}


status_t
BFile::GetSize(off_t* _size) const
{
	return BStatable::GetSize(_size);
}


BFile&
BFile::operator=(const BFile& file)
{
	if (this != &file) {
		BNode::operator=(file);
		fMode = file.fMode;
	}
	return *this;
}


// #pragma mark - private


void
BFile::close_fd()
{
	BNode::close_fd();
	fMode = 0;
}


status_t
BFile::_Open(int directoryFd, const char* path, uint32 openMode)
{
	if (path == NULL || (openMode & O_ACCMODE) == O_ACCMODE) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	if (path[0] == '\0') {
		Unset();
		return fCStatus = B_ENTRY_NOT_FOUND;
	}
	const int flags = static_cast<int>(openMode)
		& (O_ACCMODE | B_FAIL_IF_EXISTS | B_CREATE_FILE | B_ERASE_FILE | B_OPEN_AT_END);
	const int fd = OpenAt(directoryFd, path, flags, 0666);
	const status_t status = _Adopt(fd, fd < 0 ? LastStatus() : B_OK);
	if (status == B_OK)
		fMode = openMode;
	return status;
}
