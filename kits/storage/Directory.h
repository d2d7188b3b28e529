// BDirectory: a directory's contents.
#pragma once

#include <EntryList.h>
#include <Node.h>
#include <StorageDefs.h>

class BFile;
class BSymLink;


class BDirectory : public BNode, public BEntryList {
public:
	BDirectory();
	BDirectory(const BDirectory& directory);
	BDirectory(const entry_ref* ref);
	BDirectory(const node_ref* ref);
	BDirectory(const BEntry* entry);
	BDirectory(const char* path);
	BDirectory(const BDirectory* directory, const char* path);
	virtual ~BDirectory();

	// A symbolic link to a directory is followed.
	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const node_ref* ref);
	status_t SetTo(const BEntry* entry);
	status_t SetTo(const char* path);
	status_t SetTo(const BDirectory* directory, const char* path);

	status_t GetEntry(BEntry* _entry) const;
	bool IsRootDirectory() const;

	status_t FindEntry(const char* path, BEntry* _entry, bool traverse = false) const;
	// NULL asks whether the directory itself exists.
	bool Contains(const char* path, int32 nodeFlags = B_ANY_NODE) const;
	bool Contains(const BEntry* entry, int32 nodeFlags = B_ANY_NODE) const;
	status_t GetStatFor(const char* path, struct stat* _stat) const;

	// "." and ".." are left out, except by GetNextDirents().
	virtual status_t GetNextEntry(BEntry* entry, bool traverse = false);
	virtual status_t GetNextRef(entry_ref* ref);
	virtual int32 GetNextDirents(struct dirent* buffer, size_t length, int32 count = INT32_MAX);
	virtual status_t Rewind();
	virtual int32 CountEntries();

	status_t CreateDirectory(const char* path, BDirectory* _directory);
	// An existing file is erased, unless failIfExists is set.
	status_t CreateFile(const char* path, BFile* _file, bool failIfExists = false);
	status_t CreateSymLink(const char* path, const char* linkToPath, BSymLink* _link);

	BDirectory& operator=(const BDirectory& directory);

private:
	friend class BEntry;
	friend class BFile;
	friend class BNode;
	friend class BSymLink;

	virtual void close_fd();
	status_t _Open(int directoryFd, const char* path);
	// The next name that is neither "." nor "..".
	status_t _NextName(const char** _name);

	DIR* fIterator = NULL; // an own stream on the directory; NULL before the first step
	bool fNamed = false; // refs into it were given out
};


status_t create_directory(const char* path, mode_t mode);
