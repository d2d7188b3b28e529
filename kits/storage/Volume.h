// BVolume: the file system that a node lies in.
#pragma once

#include <sys/types.h>

#include <SupportDefs.h>

#include <StorageDefs.h>

class BDirectory;


class BVolume {
public:
	BVolume();
	BVolume(dev_t device);
	BVolume(const BVolume& volume);
	virtual ~BVolume();

	status_t InitCheck() const;
	status_t SetTo(dev_t device);
	void Unset();
	dev_t Device() const;

	status_t GetRootDirectory(BDirectory* _directory) const;
	// In bytes, or an error.
	off_t Capacity() const;
	off_t FreeBytes() const;
	// `name` has room for B_FILE_NAME_LENGTH + 1 bytes.
	status_t GetName(char* name) const;

	bool IsRemovable() const;
	bool IsReadOnly() const;
	bool IsPersistent() const;
	bool IsShared() const;
	bool KnowsMime() const;
	bool KnowsAttr() const;
	bool KnowsQuery() const;

	bool operator==(const BVolume& volume) const;
	bool operator!=(const BVolume& volume) const;
	BVolume& operator=(const BVolume& volume);

private:
	bool _MountPoint(char* buffer, size_t size) const;

	dev_t fDevice;
	status_t fCStatus;
};
