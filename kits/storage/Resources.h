// BResources: the typed resources of one file, in memory.
#pragma once

#include <memory>

#include <SupportDefs.h>

#include <File.h>

struct entry_ref;


// SetTo() reads the table, not the data: an item's bytes are read when they are first asked for.
// Sync() and the destructor write everything back; the file is replaced as a whole, so it is at
// every moment either what it was or what was last saved. The destructor does not try again what
// Sync() failed to do. The key of a resource is its type and id; names need not be unique. Not
// thread-safe: one owner, one thread.
class BResources {
public:
	BResources();
	BResources(const BFile* file, bool clobber = false);
	BResources(const char* path, bool clobber = false);
	BResources(const entry_ref* ref, bool clobber = false);
	virtual ~BResources();

	// Pending changes of the previous file are written first. With `clobber` what the file holds
	// is given up for an empty set of resources, at once. The caller may close his BFile. While he
	// keeps it, it shows the new file after a save, at the same position.
	status_t SetTo(const BFile* file, bool clobber = false);
	status_t SetTo(const char* path, bool clobber = false);
	status_t SetTo(const entry_ref* ref, bool clobber = false);
	void Unset();
	status_t InitCheck() const;
	const BFile& File() const;

	// The bytes stay ours and are valid until that resource is changed or removed. When there is
	// no such resource the result is NULL and *_size is left alone.
	const void* LoadResource(type_code type, int32 id, size_t* _size);
	const void* LoadResource(type_code type, const char* name, size_t* _size);
	// 0, or the number of resources that could not be read, negated. Type 0 means all.
	status_t PreloadResourceType(type_code type = 0);

	status_t Sync();
	// Adds all resources of `from`; those with a known key replace ours and move to the end.
	status_t MergeFrom(BFile* from);
	// Writes into `file`, which must be a resource file, an executable or empty, and belongs to it
	// from then on; after an error to no file. What the file had besides resources stays.
	status_t WriteTo(BFile* file);

	status_t AddResource(
		type_code type, int32 id, const void* data, size_t length, const char* name = NULL);
	bool HasResource(type_code type, int32 id);
	bool HasResource(type_code type, const char* name);
	bool GetResourceInfo(
		int32 index, type_code* _type, int32* _id, const char** _name, size_t* _length);
	bool GetResourceInfo(
		type_code byType, int32 index, int32* _id, const char** _name, size_t* _length);
	bool GetResourceInfo(type_code byType, int32 id, const char** _name, size_t* _length);
	bool GetResourceInfo(type_code byType, const char* name, int32* _id, size_t* _length);
	bool GetResourceInfo(
		const void* pointer, type_code* _type, int32* _id, size_t* _length, const char** _name);

	status_t RemoveResource(const void* resource);
	status_t RemoveResource(type_code type, int32 id);

	// Changes bytes from `offset` on. A gap is filled with zeros; a resource never shrinks.
	status_t WriteResource(type_code type, int32 id, const void* data, off_t offset, size_t length);
	status_t ReadResource(type_code type, int32 id, void* data, off_t offset, size_t length);
	// A copy for the caller to free(); *_length is 0 when there is none.
	void* FindResource(type_code type, int32 id, size_t* _length);
	void* FindResource(type_code type, const char* name, size_t* _length);

private:
	friend const void* load_resource(BResources* resources, int32 index, size_t* _size);
	friend status_t write_resources_over(BResources* resources, BFile* file);

	BResources(const BResources&);
	BResources& operator=(const BResources&);

	struct State;

	status_t _SetTo(bool clobber);
	status_t _WriteTo(BFile* file, bool clobber);
	status_t _Save();
	status_t _CheckChange() const;
	const void* _LoadAt(int32 index, size_t* _size);

	BFile fFile; // shares its descriptor with the caller's, so that both follow a save
	std::unique_ptr<State> fState; // never NULL
};
