#include <Volume.h>

#include <stdio.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include <fstream>
#include <string>

#include <Directory.h>
#include <Errors.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/NodeAttributes.h"

using namespace BPrivate;

namespace {

struct Mount {
	std::string point;
	std::string fileSystem;
};


// The mount table escapes blanks and the like as three octal digits.
std::string
Unescape(const std::string& text)
{
	std::string plain;
	for (size_t i = 0; i < text.size(); i++) {
		if (text[i] == '\\' && i + 3 < text.size()) {
			plain += static_cast<char>(
				(text[i + 1] - '0') * 64 + (text[i + 2] - '0') * 8 + (text[i + 3] - '0'));
			i += 3;
		} else
			plain += text[i];
	}
	return plain;
}


bool
FindMount(dev_t device, Mount* _mount)
{
	std::ifstream table("/proc/self/mountinfo");
	std::string line;
	const std::string number = std::to_string(major(device)) + ":" + std::to_string(minor(device));
	while (std::getline(table, line)) {
		char identity[64];
		char root[B_PATH_NAME_LENGTH];
		char point[B_PATH_NAME_LENGTH];
		if (sscanf(line.c_str(), "%*d %*d %63s %4095s %4095s", identity, root, point) != 3
			|| number != identity)
			continue;
		_mount->point = Unescape(point);
		const size_t separator = line.find(" - ");
		if (separator != std::string::npos)
			_mount->fileSystem =
				line.substr(separator + 3, line.find(' ', separator + 3) - separator - 3);
		return true;
	}

	// Below a changed root directory the table does not tell about the root itself.
	struct stat info;
	if (stat("/", &info) != 0 || info.st_dev != device)
		return false;
	_mount->point = "/";
	return true;
}

} // namespace


BVolume::BVolume() : fDevice(static_cast<dev_t>(-1)), fCStatus(B_NO_INIT)
{
}


BVolume::BVolume(dev_t device) : fDevice(static_cast<dev_t>(-1)), fCStatus(B_NO_INIT)
{
	SetTo(device);
}


BVolume::BVolume(const BVolume& volume) : fDevice(volume.fDevice), fCStatus(volume.fCStatus)
{
}


BVolume::~BVolume()
{
}


status_t
BVolume::InitCheck() const
{
	return fCStatus;
}


status_t
BVolume::SetTo(dev_t device)
{
	Mount mount;
	const bool found = FindMount(device, &mount);
	fDevice = found ? device : static_cast<dev_t>(-1);
	return fCStatus = found ? B_OK : B_BAD_VALUE;
}


void
BVolume::Unset()
{
	fDevice = static_cast<dev_t>(-1);
	fCStatus = B_NO_INIT;
}


dev_t
BVolume::Device() const
{
	return fDevice;
}


status_t
BVolume::GetRootDirectory(BDirectory* _directory) const
{
	char point[B_PATH_NAME_LENGTH];
	if (_directory == NULL || !_MountPoint(point, sizeof(point)))
		return B_BAD_VALUE;
	return _directory->SetTo(point);
}


off_t
BVolume::Capacity() const
{
	char point[B_PATH_NAME_LENGTH];
	struct statvfs stat;
	if (!_MountPoint(point, sizeof(point)))
		return B_BAD_VALUE;
	if (statvfs(point, &stat) < 0)
		return LastStatus();
	return static_cast<off_t>(stat.f_frsize) * stat.f_blocks;
}


off_t
BVolume::FreeBytes() const
{
	char point[B_PATH_NAME_LENGTH];
	struct statvfs stat;
	if (!_MountPoint(point, sizeof(point)))
		return B_BAD_VALUE;
	if (statvfs(point, &stat) < 0)
		return LastStatus();
	return static_cast<off_t>(stat.f_frsize) * stat.f_bavail;
}


status_t
BVolume::GetName(char* name) const
{
	char point[B_PATH_NAME_LENGTH];
	if (name == NULL || !_MountPoint(point, sizeof(point)))
		return B_BAD_VALUE;
	const char* leaf = strrchr(point, '/');
	const char* text = leaf != NULL && leaf[1] != '\0' ? leaf + 1 : point;
	strncpy(name, text, B_FILE_NAME_LENGTH);
	name[B_FILE_NAME_LENGTH] = '\0';
	return B_OK;
}


bool
BVolume::IsRemovable() const
{
	const std::string path =
		"/sys/dev/block/" + std::to_string(major(fDevice)) + ":" + std::to_string(minor(fDevice));
	// A partition's disk is the folder above it.
	for (const char* file : { "/removable", "/../removable" }) {
		std::ifstream stream(path + file);
		int removable = 0;
		if (stream >> removable)
			return removable != 0;
	}
	return false;
}


bool
BVolume::IsReadOnly() const
{
	char point[B_PATH_NAME_LENGTH];
	struct statvfs stat;
	return _MountPoint(point, sizeof(point)) && statvfs(point, &stat) == 0
		&& (stat.f_flag & ST_RDONLY) != 0;
}


bool
BVolume::IsPersistent() const
{
	Mount mount;
	return FindMount(fDevice, &mount) && mount.fileSystem != "tmpfs" && mount.fileSystem != "ramfs"
		&& mount.fileSystem != "proc" && mount.fileSystem != "sysfs"
		&& mount.fileSystem != "devtmpfs";
}


bool
BVolume::IsShared() const
{
	Mount mount;
	return FindMount(fDevice, &mount)
		&& (mount.fileSystem.compare(0, 3, "nfs") == 0 || mount.fileSystem == "cifs"
			|| mount.fileSystem == "9p" || mount.fileSystem == "fuse.sshfs");
}


bool
BVolume::KnowsMime() const
{
	return KnowsAttr();
}


bool
BVolume::KnowsAttr() const
{
	char point[B_PATH_NAME_LENGTH];
	if (!_MountPoint(point, sizeof(point)))
		return false;
	const int fd = OpenAt(AT_FDCWD, point, O_PATH);
	if (fd < 0)
		return false;
	const Descriptor descriptor(fd);
	return KeepsAttributes(fd);
}


bool
BVolume::KnowsQuery() const
{
	return false;
}


bool
BVolume::operator==(const BVolume& volume) const
{
	return fDevice == volume.fDevice && fCStatus == volume.fCStatus;
}


bool
BVolume::operator!=(const BVolume& volume) const
{
	return !(*this == volume);
}


BVolume&
BVolume::operator=(const BVolume& volume)
{
	fDevice = volume.fDevice;
	fCStatus = volume.fCStatus;
	return *this;
}


bool
BVolume::_MountPoint(char* buffer, size_t size) const
{
	Mount mount;
	if (fCStatus != B_OK || !FindMount(fDevice, &mount) || mount.point.size() >= size)
		return false;
	strcpy(buffer, mount.point.c_str());
	return true;
}
