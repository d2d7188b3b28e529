#include <Directory.h>

#include <errno.h>
#include <fcntl.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>

#include <Entry.h>
#include <Errors.h>
#include <File.h>
#include <SymLink.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/KnownDirectories.h"

using namespace BPrivate;

namespace {

bool
IsDotEntry(const char* name)
{
	return strcmp(name, ".") == 0 || strcmp(name, "..") == 0;
}


bool
HasFlavor(const struct stat& stat, int32 nodeFlags)
{
	if (S_ISLNK(stat.st_mode))
		return (nodeFlags & B_SYMLINK_NODE) != 0;
	if (S_ISDIR(stat.st_mode))
		return (nodeFlags & B_DIRECTORY_NODE) != 0;
	return (nodeFlags & B_FILE_NODE) != 0;
}

} // namespace


BDirectory::BDirectory()
{
}


BDirectory::BDirectory(const BDirectory& directory) : BNode(directory), BEntryList()
{
}


BDirectory::BDirectory(const entry_ref* ref)
{
	SetTo(ref);
}


BDirectory::BDirectory(const node_ref* ref)
{
	SetTo(ref);
}


BDirectory::BDirectory(const BEntry* entry)
{
	SetTo(entry);
}


BDirectory::BDirectory(const char* path)
{
	SetTo(path);
}


BDirectory::BDirectory(const BDirectory* directory, const char* path)
{
	SetTo(directory, path);
}


BDirectory::~BDirectory()
{
	close_fd();
}


status_t
BDirectory::SetTo(const entry_ref* ref)
{
	const BEntry entry(ref);
	return SetTo(&entry);
}


status_t
BDirectory::SetTo(const node_ref* ref)
{
	if (ref == NULL) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	const int fd = OpenKnownDirectory(ref->device, ref->node);
	if (fd < 0) {
		Unset();
		return fCStatus = B_ENTRY_NOT_FOUND;
	}
	const Descriptor directory(fd);
	return _Open(directory.Fd(), ".");
}


status_t
BDirectory::SetTo(const BEntry* entry)
{
	if (entry == NULL || entry->InitCheck() != B_OK) {
		Unset();
		return fCStatus = entry == NULL ? B_BAD_VALUE : entry->InitCheck();
	}
	return _Open(entry->_DirectoryFd(), entry->fName);
}


status_t
BDirectory::SetTo(const char* path)
{
	return _Open(AT_FDCWD, path);
}


status_t
BDirectory::SetTo(const BDirectory* directory, const char* path)
{
	if (directory == NULL || directory->fDescriptor == nullptr || path == NULL || path[0] == '/') {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	const std::shared_ptr<Descriptor> start = directory->fDescriptor;
	return _Open(start->Fd(), path);
}


status_t
BDirectory::GetEntry(BEntry* _entry) const
{
	if (_entry == NULL)
		return B_BAD_VALUE;
	if (InitCheck() != B_OK)
		return InitCheck();
	return _entry->_SetTo(_Fd(), ".", false);
}


bool
BDirectory::IsRootDirectory() const
{
	// The root of a volume lies on another device than its parent, or is its own parent.
	struct stat own;
	struct stat parent;
	if (GetStat(&own) != B_OK || fstatat(_Fd(), "..", &parent, 0) < 0)
		return false;
	return own.st_dev != parent.st_dev || own.st_ino == parent.st_ino;
}


status_t
BDirectory::FindEntry(const char* path, BEntry* _entry, bool traverse) const
{
	if (path == NULL || _entry == NULL)
		return B_BAD_VALUE;
	_entry->Unset();
	if (InitCheck() != B_OK)
		return InitCheck();
	status_t status = _entry->SetTo(this, path, traverse);
	if (status == B_OK && !_entry->Exists()) {
		_entry->Unset();
		status = B_ENTRY_NOT_FOUND;
	}
	return status;
}


bool
BDirectory::Contains(const char* path, int32 nodeFlags) const
{
	if (InitCheck() != B_OK)
		return false;
	if (path == NULL)
		return (nodeFlags & B_DIRECTORY_NODE) != 0;
	const BEntry entry(this, path);
	return Contains(&entry, nodeFlags);
}


// An entry is also contained when it lies deeper, in one of the directory's own directories.
bool
BDirectory::Contains(const BEntry* entry, int32 nodeFlags) const
{
	struct stat stat;
	if (entry == NULL || InitCheck() != B_OK || entry->GetStat(&stat) != B_OK
		|| !HasFlavor(stat, nodeFlags))
		return false;

	const std::string own = PathOf(_Fd());
	std::string place = PathOf(entry->_DirectoryFd());
	if (own.empty() || place.empty())
		return false;
	if (own == "/")
		return true;
	return place == own || place.compare(0, own.size() + 1, own + "/") == 0;
}


status_t
BDirectory::GetStatFor(const char* path, struct stat* _stat) const
{
	if (_stat == NULL)
		return B_BAD_VALUE;
	if (InitCheck() != B_OK)
		return InitCheck();
	if (path == NULL)
		return GetStat(_stat);
	if (path[0] == '\0')
		return B_ENTRY_NOT_FOUND;
	return fstatat(_Fd(), path, _stat, AT_SYMLINK_NOFOLLOW) < 0 ? LastStatus() : B_OK;
}


// #pragma mark - iteration


status_t
BDirectory::GetNextEntry(BEntry* entry, bool traverse)
{
	if (entry == NULL)
		return B_BAD_VALUE;
	const char* name;
	const status_t status = _NextName(&name);
	return status == B_OK ? entry->_SetTo(_Fd(), name, traverse) : status;
}


status_t
BDirectory::GetNextRef(entry_ref* ref)
{
	if (ref == NULL)
		return B_BAD_VALUE;
	const char* name;
	status_t status = _NextName(&name);
	if (status != B_OK)
		return status;
	if (!fNamed)
		RememberDirectory(_Fd());
	fNamed = true;
	struct stat stat;
	status = GetStat(&stat);
	if (status != B_OK)
		return status;
	ref->device = stat.st_dev;
	ref->directory = stat.st_ino;
	return ref->set_name(name);
}


int32
BDirectory::GetNextDirents(struct dirent* buffer, size_t length, int32 count)
{
	if (buffer == NULL)
		return B_BAD_VALUE;
	if (InitCheck() != B_OK)
		return B_FILE_ERROR;
	if (fIterator == NULL && Rewind() != B_OK)
		return B_FILE_ERROR;

	int32 done = 0;
	char* place = reinterpret_cast<char*>(buffer);
	while (done < count) {
		const long position = telldir(fIterator);
		errno = 0;
		const struct dirent* entry = readdir(fIterator);
		if (entry == NULL)
			return errno != 0 && done == 0 ? LastStatus() : done;
		if (entry->d_reclen > length) {
			seekdir(fIterator, position); // comes next time
			return done > 0 ? done : B_BAD_VALUE;
		}
		memcpy(place, entry, entry->d_reclen);
		place += entry->d_reclen;
		length -= entry->d_reclen;
		done++;
	}
	return done;
}


status_t
BDirectory::Rewind()
{
	if (InitCheck() != B_OK)
		return B_FILE_ERROR;
	if (fIterator != NULL) {
		rewinddir(fIterator);
		return B_OK;
	}
	// An own descriptor, so that copies iterate by themselves.
	const int fd = OpenAt(_Fd(), ".", O_RDONLY | O_DIRECTORY);
	if (fd < 0)
		return LastStatus();
	fIterator = fdopendir(fd);
	if (fIterator != NULL)
		return B_OK;
	const status_t status = LastStatus();
	close(fd);
	return status;
}


int32
BDirectory::CountEntries()
{
	status_t status = Rewind();
	if (status != B_OK)
		return status;
	int32 count = 0;
	const char* name;
	while ((status = _NextName(&name)) == B_OK)
		count++;
	Rewind();
	return status == B_ENTRY_NOT_FOUND ? count : status;
}


// #pragma mark - creation


status_t
BDirectory::CreateDirectory(const char* path, BDirectory* _directory)
{
	if (path == NULL)
		return B_BAD_VALUE;
	const int start = InitCheck() == B_OK ? _Fd() : AT_FDCWD;
	if (mkdirat(start, path, 0777) < 0)
		return LastStatus();
	return _directory != NULL ? _directory->_Open(start, path) : B_OK;
}


status_t
BDirectory::CreateFile(const char* path, BFile* _file, bool failIfExists)
{
	if (path == NULL)
		return B_BAD_VALUE;
	const uint32 mode =
		B_READ_WRITE | B_CREATE_FILE | (failIfExists ? B_FAIL_IF_EXISTS : B_ERASE_FILE);
	BFile file;
	const status_t status = file._Open(InitCheck() == B_OK ? _Fd() : AT_FDCWD, path, mode);
	if (status == B_OK && _file != NULL)
		*_file = file;
	return status;
}


status_t
BDirectory::CreateSymLink(const char* path, const char* linkToPath, BSymLink* _link)
{
	if (path == NULL || linkToPath == NULL)
		return B_BAD_VALUE;
	const int start = InitCheck() == B_OK ? _Fd() : AT_FDCWD;
	if (symlinkat(linkToPath, start, path) < 0)
		return LastStatus();
	return _link != NULL ? _link->_SetTo(start, path) : B_OK;
}


BDirectory&
BDirectory::operator=(const BDirectory& directory)
{
	if (this != &directory)
		BNode::operator=(directory);
	return *this;
}


// #pragma mark - private


void
BDirectory::close_fd()
{
	if (fIterator != NULL) {
		closedir(fIterator);
		fIterator = NULL;
	}
	fNamed = false;
	BNode::close_fd();
}


status_t
BDirectory::_Open(int directoryFd, const char* path)
{
	if (path == NULL || path[0] == '\0') {
		Unset();
		fCStatus = B_ENTRY_NOT_FOUND;
		if (path == NULL)
			fCStatus = B_BAD_VALUE;
		return fCStatus;
	}
	// A directory that may be passed but not listed still is one.
	int fd = OpenAt(directoryFd, path, O_RDONLY | O_DIRECTORY);
	if (fd < 0 && errno == EACCES)
		fd = OpenAt(directoryFd, path, O_PATH | O_DIRECTORY);
	return _Adopt(fd, fd < 0 ? LastStatus() : B_OK);
}


status_t
BDirectory::_NextName(const char** _name)
{
	if (fIterator == NULL) {
		const status_t status = Rewind();
		if (status != B_OK)
			return status;
	}
	const struct dirent* entry;
	do {
		errno = 0;
		entry = readdir(fIterator);
		if (entry == NULL)
			return errno != 0 ? LastStatus() : B_ENTRY_NOT_FOUND;
	} while (IsDotEntry(entry->d_name));
	*_name = entry->d_name;
	return B_OK;
}


// Makes the directories that are missing along the path too.
status_t
create_directory(const char* path, mode_t mode)
{
	if (path == NULL || path[0] == '\0')
		return B_BAD_VALUE;
	const std::string whole(path);
	for (size_t end = 0; end != std::string::npos;) {
		end = whole.find('/', end + 1);
		const std::string part = whole.substr(0, end);
		if (mkdir(part.c_str(), mode) < 0 && errno != EEXIST && errno != EISDIR)
			return LastStatus();
	}
	struct stat stat;
	if (::stat(path, &stat) < 0)
		return LastStatus();
	if (!S_ISDIR(stat.st_mode))
		return B_NOT_A_DIRECTORY;
	return B_OK;
}
