// BFile: a file opened for reading or writing.
#pragma once

#include <DataIO.h>
#include <Node.h>
#include <StorageDefs.h>


// The position belongs to the object, except that a copy shares it with its source.
class BFile : public BNode, public BPositionIO {
public:
	BFile();
	BFile(const BFile& file);
	BFile(const entry_ref* ref, uint32 openMode);
	BFile(const BEntry* entry, uint32 openMode);
	BFile(const char* path, uint32 openMode);
	BFile(const BDirectory* directory, const char* path, uint32 openMode);
	virtual ~BFile();

	// A symbolic link is followed. Directories answer B_IS_A_DIRECTORY when opened for writing.
	status_t SetTo(const entry_ref* ref, uint32 openMode);
	status_t SetTo(const BEntry* entry, uint32 openMode);
	status_t SetTo(const char* path, uint32 openMode);
	status_t SetTo(const BDirectory* directory, const char* path, uint32 openMode);

	bool IsReadable() const;
	bool IsWritable() const;

	// The number of bytes, or an error: B_NOT_ALLOWED when it was not opened for that. An
	// interrupted call is continued.
	virtual ssize_t Read(void* buffer, size_t size);
	virtual ssize_t ReadAt(off_t location, void* buffer, size_t size);
	virtual ssize_t Write(const void* buffer, size_t size);
	virtual ssize_t WriteAt(off_t location, const void* buffer, size_t size);

	virtual off_t Seek(off_t offset, uint32 seekMode);
	virtual off_t Position() const;
	virtual status_t SetSize(off_t size);
	virtual status_t GetSize(off_t* _size) const;

	BFile& operator=(const BFile& file);

private:
	friend class BDirectory;
	friend class BResources;

	virtual void close_fd();
	status_t _Open(int directoryFd, const char* path, uint32 openMode);

	uint32 fMode; // as given to SetTo()
};
