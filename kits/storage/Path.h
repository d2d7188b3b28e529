// BPath: an absolute path name.
#pragma once

#include <Flattenable.h>
#include <SupportDefs.h>

class BDirectory;
class BEntry;
struct entry_ref;


// A path is tidied when it is set: it is absolute, without "." and ".." and doubled slashes.
class BPath : public BFlattenable {
public:
	BPath();
	BPath(const BPath& path);
	BPath(const entry_ref* ref);
	BPath(const BEntry* entry);
	BPath(const char* directory, const char* leaf = NULL, bool normalize = false);
	BPath(const BDirectory* directory, const char* leaf, bool normalize = false);
	virtual ~BPath();

	status_t InitCheck() const;

	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const BEntry* entry);
	// A `leaf` must not be absolute. Normalizing follows links in the directory part, which then
	// has to exist.
	status_t SetTo(const char* path, const char* leaf = NULL, bool normalize = false);
	status_t SetTo(const BDirectory* directory, const char* path, bool normalize = false);
	void Unset();
	status_t Append(const char* path, bool normalize = false);

	// NULL when unset.
	const char* Path() const;
	const char* Leaf() const;
	status_t GetParent(BPath* _path) const;

	bool operator==(const BPath& path) const;
	bool operator==(const char* path) const;
	bool operator!=(const BPath& path) const;
	bool operator!=(const char* path) const;
	BPath& operator=(const BPath& path);
	BPath& operator=(const char* path);

	// The flattened form is an entry_ref: B_REF_TYPE.
	virtual bool IsFixedSize() const;
	virtual type_code TypeCode() const;
	virtual ssize_t FlattenedSize() const;
	virtual status_t Flatten(void* buffer, ssize_t size) const;
	virtual bool AllowsTypeCode(type_code code) const;
	virtual status_t Unflatten(type_code code, const void* buffer, ssize_t size);

private:
	status_t _SetPath(const char* path);

	char* fName; // owned, from malloc(); NULL when unset
	status_t fCStatus;
};
