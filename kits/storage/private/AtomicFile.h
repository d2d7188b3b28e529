// AtomicFile: replaces a file as a whole, so that it is always the old or the new one, complete.
#pragma once

#include <memory>
#include <string>

#include <SupportDefs.h>

#include "storage/private/Descriptor.h"

namespace BPrivate {

// Bytes go to a temporary file beside the target; Commit() syncs it, gives it the target's
// permissions, owner and extended attributes, renames it over the target and syncs the folder.
// A symbolic link keeps leading to the file; other hard links keep the old bytes. Without a
// successful Commit() the target is untouched and the temporary file goes with the object.
class AtomicFile {
public:
	AtomicFile();
	~AtomicFile();

	// Checks everything that can be checked beforehand. B_NOT_ALLOWED when owner, group or
	// permissions could not be kept, B_BAD_VALUE for what is no regular file. A target that does
	// not exist yet gets the usual permissions.
	status_t SetTo(const char* path);
	// The file of an open descriptor, which stays the caller's. When it was replaced or deleted
	// meanwhile, the file at `path` takes its place, if there is one.
	status_t SetTo(int fd, const char* path);

	status_t Write(const void* data, size_t size);
	// Zero bytes.
	status_t Fill(off_t size);
	// Bytes of another file. B_IO_ERROR when that ends too early.
	status_t CopyFrom(int fd, off_t position, off_t size);
	off_t Written() const { return fWritten; }

	// B_NOT_SUPPORTED when extended attributes could not be kept. An error after the rename means
	// that the new file is there but may not survive a power failure: see IsReplaced().
	status_t Commit();
	bool IsReplaced() const { return fReplaced; }

	// The new file, open for reading and writing; ours.
	int Fd() const { return fFile != nullptr ? fFile->Fd() : -1; }
	const std::string& Path() const { return fPath; }

private:
	AtomicFile(const AtomicFile&);
	AtomicFile& operator=(const AtomicFile&);

	status_t _Open(const char* path);
	status_t _CreateTemporary(mode_t mode);
	status_t _CheckTarget();
	status_t _CopyMetadata();
	status_t _CopyAttributes();
	void _Abandon();

	std::unique_ptr<Descriptor> fFolder;
	std::unique_ptr<Descriptor> fTarget; // what is to be replaced; NULL when nothing is there
	std::unique_ptr<Descriptor> fFile;
	std::string fPath; // of the target, links followed
	std::string fName; // its leaf
	std::string fTemporary; // a leaf; empty when there is none
	off_t fWritten;
	bool fReplaced;
};

} // namespace BPrivate
