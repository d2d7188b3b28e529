// BResourceItem: one typed resource of a collection: its type, id, name and bytes.
#pragma once

#include <memory>
#include <vector>

#include <BeBuild.h>
#include <String.h>
#include <SupportDefs.h>

#include "host/library/ResourceHandle.h"

namespace BResEditor {

class BResourceCollection;


// Items belong to their collection and are read under its read lock, changed under its write lock.
// Pointers to an item or its data are good until the lock is released.
class _EXPORT BResourceItem {
public:
	BResourceHandle Handle() const;
	type_code Type() const;
	int32 ID() const;
	const char* Name() const; // never NULL; "" for an item without a name
	const void* Data() const; // NULL when Size() is 0
	size_t Size() const; // in bytes

	// A copy keeps the state of the moment and shares the bytes; it is for reading only.
	BResourceItem(const BResourceItem& other);

	// For items got by BResourceCollection::WriteItem(). A type and id that another item has give
	// B_NAME_IN_USE and change nothing. Data is copied. Setting what is already there is no change.
	status_t SetType(type_code type);
	status_t SetID(int32 id);
	status_t SetKey(type_code type, int32 id); // both in one step
	status_t SetName(const char* name);
	status_t SetData(const void* data, size_t size);

private:
	friend class BResourceCollection;

	BResourceItem(BResourceCollection* collection, const BResourceHandle& handle);
	BResourceItem& operator=(const BResourceItem&) = delete;

	BResourceCollection* fCollection; // borrowed: the collection owns the item
	BResourceHandle fHandle;
	type_code fType;
	int32 fID;
	BString fName;
	std::shared_ptr<const std::vector<uint8>> fData; // shared with the undo steps; never NULL
};


} // namespace BResEditor
