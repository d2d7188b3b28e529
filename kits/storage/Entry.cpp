#include <Entry.h>

#include <errno.h>
#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <string>
#include <tuple>
#include <utility>

#include <Directory.h>
#include <Errors.h>
#include <Path.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/KnownDirectories.h"
#include "storage/private/SetStat.h"

using namespace BPrivate;


BEntry::BEntry() : fName(NULL), fStatus(B_NO_INIT)
{
}


BEntry::BEntry(const BDirectory* directory, const char* path, bool traverse) :
	fName(NULL), fStatus(B_NO_INIT)
{
	SetTo(directory, path, traverse);
}


BEntry::BEntry(const entry_ref* ref, bool traverse) : fName(NULL), fStatus(B_NO_INIT)
{
	SetTo(ref, traverse);
}


BEntry::BEntry(const char* path, bool traverse) : fName(NULL), fStatus(B_NO_INIT)
{
	SetTo(path, traverse);
}


BEntry::BEntry(const BEntry& entry) : BStatable(entry), fName(NULL), fStatus(B_NO_INIT)
{
	*this = entry;
}


BEntry::~BEntry()
{
	Unset();
}


status_t
BEntry::InitCheck() const
{
	return fStatus;
}


bool
BEntry::Exists() const
{
	struct stat stat;
	return GetStat(&stat) == B_OK;
}


status_t
BEntry::GetStat(struct stat* _stat) const
{
	if (_stat == NULL)
		return B_BAD_VALUE;
	if (fStatus != B_OK)
		return fStatus;
	return fstatat(_DirectoryFd(), fName, _stat, AT_SYMLINK_NOFOLLOW) < 0 ? LastStatus() : B_OK;
}


status_t
BEntry::SetTo(const BDirectory* directory, const char* path, bool traverse)
{
	if (directory == NULL) {
		Unset();
		return fStatus = B_BAD_VALUE;
	}
	// The directory may be a part of what is unset.
	const std::shared_ptr<Descriptor> start = directory->fDescriptor;
	if (start == nullptr) {
		Unset();
		return fStatus = B_BAD_VALUE;
	}
	return _SetTo(start->Fd(), path != NULL ? path : ".", traverse);
}


status_t
BEntry::SetTo(const entry_ref* ref, bool traverse)
{
	if (ref == NULL || ref->name == NULL || strchr(ref->name, '/') != NULL) {
		// The root directory's entry is the one with a name of its own.
		if (ref != NULL && ref->name != NULL && strcmp(ref->name, "/") == 0)
			return _SetTo(AT_FDCWD, "/", false);
		Unset();
		return fStatus = B_BAD_VALUE;
	}
	const std::string name(ref->name);
	const int fd = OpenKnownDirectory(ref->device, ref->directory);
	if (fd < 0) {
		Unset();
		return fStatus = B_ENTRY_NOT_FOUND;
	}
	const Descriptor directory(fd);
	return _SetTo(directory.Fd(), name.c_str(), traverse);
}


status_t
BEntry::SetTo(const char* path, bool traverse)
{
	return _SetTo(AT_FDCWD, path, traverse);
}


void
BEntry::Unset()
{
	fDirectory.reset();
	free(fName);
	fName = NULL;
	fStatus = B_NO_INIT;
}


status_t
BEntry::GetRef(entry_ref* _ref) const
{
	if (_ref == NULL)
		return B_BAD_VALUE;
	if (fStatus != B_OK)
		return fStatus;
	struct stat stat;
	if (fstat(_DirectoryFd(), &stat) < 0)
		return LastStatus();
	RememberDirectory(_DirectoryFd());
	_ref->device = stat.st_dev;
	_ref->directory = stat.st_ino;
	return _ref->set_name(fName);
}


status_t
BEntry::GetPath(BPath* _path) const
{
	if (_path == NULL)
		return B_BAD_VALUE;
	_path->Unset();
	if (fStatus != B_OK)
		return fStatus;
	const std::string directory = PathOf(_DirectoryFd());
	if (directory.empty())
		return B_ENTRY_NOT_FOUND;
	return strcmp(fName, ".") == 0 ? _path->SetTo(directory.c_str())
								   : _path->SetTo(directory.c_str(), fName);
}


status_t
BEntry::GetParent(BEntry* _entry) const
{
	if (_entry == NULL)
		return B_BAD_VALUE;
	if (fStatus != B_OK)
		return fStatus;
	if (strcmp(fName, ".") == 0) {
		_entry->Unset();
		return B_ENTRY_NOT_FOUND; // the root directory
	}
	const std::shared_ptr<Descriptor> directory = fDirectory;
	return _entry->_SetTo(directory->Fd(), ".", false);
}


status_t
BEntry::GetParent(BDirectory* _directory) const
{
	if (_directory == NULL)
		return B_BAD_VALUE;
	if (fStatus != B_OK)
		return fStatus;
	if (strcmp(fName, ".") == 0) {
		_directory->Unset();
		return B_ENTRY_NOT_FOUND;
	}
	return _directory->_Open(_DirectoryFd(), ".");
}


status_t
BEntry::GetName(char* buffer) const
{
	if (buffer == NULL)
		return B_BAD_VALUE;
	if (fStatus != B_OK)
		return fStatus;
	strcpy(buffer, strcmp(fName, ".") == 0 ? "/" : fName);
	return B_OK;
}


status_t
BEntry::Rename(const char* path, bool clobber)
{
	if (path == NULL)
		return B_BAD_VALUE;
	if (fStatus != B_OK)
		return fStatus;
	return _Rename(_DirectoryFd(), path, clobber);
}


status_t
BEntry::MoveTo(BDirectory* directory, const char* path, bool clobber)
{
	if (fStatus != B_OK)
		return fStatus;
	if (directory == NULL || directory->InitCheck() != B_OK)
		return B_BAD_VALUE;
	return _Rename(directory->_Fd(), path != NULL ? path : fName, clobber);
}


status_t
BEntry::Remove()
{
	if (fStatus != B_OK)
		return fStatus;
	struct stat stat;
	const status_t status = GetStat(&stat);
	if (status != B_OK)
		return status;
	const int flags = S_ISDIR(stat.st_mode) ? AT_REMOVEDIR : 0;
	return unlinkat(_DirectoryFd(), fName, flags) < 0 ? LastStatus() : B_OK;
}


// Two entries are the same when their directories and names are, whether they exist or not.
bool
BEntry::operator==(const BEntry& other) const
{
	if (fStatus != B_OK || other.fStatus != B_OK)
		return fStatus != B_OK && other.fStatus != B_OK;
	struct stat mine;
	struct stat theirs;
	return strcmp(fName, other.fName) == 0 && fstat(_DirectoryFd(), &mine) == 0
		&& fstat(other._DirectoryFd(), &theirs) == 0 && mine.st_dev == theirs.st_dev
		&& mine.st_ino == theirs.st_ino;
}


bool
BEntry::operator!=(const BEntry& other) const
{
	return !(*this == other);
}


BEntry&
BEntry::operator=(const BEntry& other)
{
	if (this == &other)
		return *this;
	Unset();
	if (other.fStatus != B_OK) {
		fStatus = other.fStatus;
		return *this;
	}
	fName = strdup(other.fName);
	if (fName == NULL) {
		fStatus = B_NO_MEMORY;
		return *this;
	}
	fDirectory = other.fDirectory;
	fStatus = B_OK;
	return *this;
}


// #pragma mark - private


status_t
BEntry::set_stat(struct stat& stat, uint32 what)
{
	if (fStatus != B_OK)
		return fStatus;
	return SetStatAt(_DirectoryFd(), fName, AT_SYMLINK_NOFOLLOW, stat, what);
}


status_t
BEntry::_SetTo(int directoryFd, const char* path, bool traverse)
{
	if (path == NULL || path[0] == '\0') {
		Unset();
		fStatus = B_ENTRY_NOT_FOUND;
		if (path == NULL)
			fStatus = B_BAD_VALUE;
		return fStatus;
	}

	std::string rest(path);
	std::shared_ptr<Descriptor> start; // keeps what directoryFd is while links are followed
	for (int32 links = 0; links <= B_MAX_SYMLINKS; links++) {
		std::string leaf;
		const int fd = OpenParent(directoryFd, rest.c_str(), &leaf);
		if (fd < 0) {
			const status_t status = LastStatus();
			Unset();
			return fStatus = status;
		}
		start = std::make_shared<Descriptor>(fd);
		if (leaf.empty())
			return _SetToDirectory(fd);

		char target[B_PATH_NAME_LENGTH];
		const ssize_t length = traverse ? readlinkat(fd, leaf.c_str(), target, sizeof(target)) : -1;
		if (length < 0) {
			Unset();
			if (leaf.size() > B_FILE_NAME_LENGTH)
				return fStatus = B_NAME_TOO_LONG;
			fName = strdup(leaf.c_str());
			if (fName == NULL)
				return fStatus = B_NO_MEMORY;
			fDirectory = start;
			return fStatus = B_OK;
		}
		rest.assign(target, length);
		directoryFd = fd;
	}

	Unset();
	return fStatus = B_LINK_LIMIT;
}


// The entry of a directory that was given by itself, as by ".." or "/".
status_t
BEntry::_SetToDirectory(int fd)
{
	const std::string path = PathOf(fd);
	Unset();
	if (path.empty())
		return fStatus = B_ENTRY_NOT_FOUND;
	if (path != "/")
		return _SetTo(AT_FDCWD, path.c_str(), false);

	const int root = OpenAt(AT_FDCWD, "/", O_PATH | O_DIRECTORY);
	if (root < 0)
		return fStatus = LastStatus();
	fDirectory = std::make_shared<Descriptor>(root);
	fName = strdup(".");
	return fStatus = fName != NULL ? B_OK : B_NO_MEMORY;
}


status_t
BEntry::_Rename(int targetFd, const char* path, bool clobber)
{
	BEntry target;
	status_t status = target._SetTo(targetFd, path, false);
	if (status != B_OK)
		return status;
	if (!Exists())
		return B_ENTRY_NOT_FOUND;
	if (target == *this)
		return B_OK;

	const uint32 flags = clobber ? 0 : RENAME_NOREPLACE;
	int result = renameat2(_DirectoryFd(), fName, target._DirectoryFd(), target.fName, flags);
	if (result < 0 && !clobber && (errno == EINVAL || errno == ENOSYS)) {
		// Some file systems cannot promise it; asking first is the next best.
		if (target.Exists())
			return B_FILE_EXISTS;
		result = renameat(_DirectoryFd(), fName, target._DirectoryFd(), target.fName);
	}
	if (result < 0)
		return LastStatus();
	*this = target;
	return fStatus;
}


int
BEntry::_DirectoryFd() const
{
	return fDirectory != nullptr ? fDirectory->Fd() : -1;
}
