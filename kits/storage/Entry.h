// BEntry and entry_ref: a place in a directory, whether or not something is there.
#pragma once

#include <memory>

#include <SupportDefs.h>

#include <Statable.h>
#include <StorageDefs.h>

class BDirectory;
class BPath;

namespace BPrivate {
class Descriptor;
}


// A directory by its number, and a name in it. A small value that owns its name.
struct entry_ref {
	entry_ref();
	entry_ref(dev_t device, ino_t directory, const char* name);
	entry_ref(const entry_ref& other);
	entry_ref(entry_ref&& other) noexcept;
	~entry_ref();

	status_t set_name(const char* name);

	bool operator==(const entry_ref& other) const;
	bool operator!=(const entry_ref& other) const;
	entry_ref& operator=(const entry_ref& other);
	entry_ref& operator=(entry_ref&& other) noexcept;

	dev_t device;
	ino_t directory;
	char* name; // owned, from malloc(); NULL when unset
};


// Holds its directory open, so an entry stays valid when that directory is moved.
class BEntry : public BStatable {
public:
	BEntry();
	BEntry(const BDirectory* directory, const char* path, bool traverse = false);
	BEntry(const entry_ref* ref, bool traverse = false);
	BEntry(const char* path, bool traverse = false);
	BEntry(const BEntry& entry);
	virtual ~BEntry();

	status_t InitCheck() const;
	bool Exists() const;

	virtual status_t GetStat(struct stat* _stat) const;

	// The directory must exist, the entry itself need not. With `traverse` a symbolic link is
	// followed to the end.
	status_t SetTo(const BDirectory* directory, const char* path, bool traverse = false);
	status_t SetTo(const entry_ref* ref, bool traverse = false);
	status_t SetTo(const char* path, bool traverse = false);
	void Unset();

	status_t GetRef(entry_ref* _ref) const;
	status_t GetPath(BPath* _path) const;
	status_t GetParent(BEntry* _entry) const;
	status_t GetParent(BDirectory* _directory) const;
	// `buffer` has room for B_FILE_NAME_LENGTH + 1 bytes.
	status_t GetName(char* buffer) const;

	// Both replace an existing entry only when `clobber` is set. A path is taken from the entry's
	// own directory, or from `directory`.
	status_t Rename(const char* path, bool clobber = false);
	status_t MoveTo(BDirectory* directory, const char* path = NULL, bool clobber = false);
	status_t Remove();

	bool operator==(const BEntry& other) const;
	bool operator!=(const BEntry& other) const;
	BEntry& operator=(const BEntry& other);

private:
	friend class BDirectory;
	friend class BFile;
	friend class BNode;
	friend class BSymLink;

	virtual status_t set_stat(struct stat& stat, uint32 what);
	status_t _SetTo(int directoryFd, const char* path, bool traverse);
	status_t _SetToDirectory(int fd);
	status_t _Rename(int targetFd, const char* path, bool clobber);
	int _DirectoryFd() const;

	// Shared by copies; NULL when unset.
	std::shared_ptr<BPrivate::Descriptor> fDirectory;
	char* fName; // owned leaf name; "." for the root directory
	status_t fStatus;
};


status_t get_ref_for_path(const char* path, entry_ref* _ref);
bool operator<(const entry_ref& a, const entry_ref& b);
