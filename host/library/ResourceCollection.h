// BResourceCollection: the items of one resource file, shared by the host and its add-ons.
#pragma once

#include <memory>
#include <vector>

#include <BeBuild.h>
#include <SupportDefs.h>

#include "host/library/ResourceHandle.h"
#include "host/library/ResourceItem.h"

class BMessenger;

namespace BResEditor {

class BResourceAddonBase;

// What happened to an item, as bits of a change.
enum {
	B_ITEM_CREATED = 0x1,
	B_ITEM_REMOVED = 0x2,
	B_ITEM_ATTRIBUTES_CHANGED = 0x4, // type, id or name
	B_ITEM_DATA_CHANGED = 0x8
};

// Posted, without fields, to each registered handler when changes wait for it.
enum { B_RESOURCE_DATA_CHANGED = 'RDCG' };


// Many readers or one writer: access goes through the locks of BResourceAddonBase. The collection
// keeps items in their order in the file. It posts B_RESOURCE_DATA_CHANGED after the write lock
// has been released, holding no lock, and never sends synchronously.
class _EXPORT BResourceCollection {
public:
	// What AddItem() does when an item of the same type and id exists.
	enum conflict_resolution {
		B_FAIL_ON_CONFLICT, // B_NAME_IN_USE, nothing changes
		B_REPLACE_ON_CONFLICT, // the existing item gets the new name and data
		B_RENUMBER_ON_CONFLICT // the new item gets the next free id
	};

	BResourceCollection();
	virtual ~BResourceCollection();
	BResourceCollection(const BResourceCollection&) = delete;
	BResourceCollection& operator=(const BResourceCollection&) = delete;

	int32 CountItems() const;
	BResourceHandle HandleAt(int32 index) const; // invalid when out of range
	BResourceHandle FindItem(type_code type, int32 id) const; // invalid when there is none

	// NULL when the handle's item is gone. Read lock.
	const BResourceItem* Item(const BResourceHandle& handle) const;

	// The same item, writable. Write lock.
	BResourceItem* WriteItem(const BResourceHandle& handle);

	// Appends an item with a copy of the data and returns its handle in *_handle, which may be
	// NULL. makeUnique picks the next free id when the given one is taken, before the resolution
	// is asked. Write lock.
	status_t AddItem(BResourceHandle* _handle, type_code type, int32 id, const char* name,
		const void* data, size_t size, bool makeUnique = false,
		conflict_resolution resolution = B_FAIL_ON_CONFLICT);

	// B_ENTRY_NOT_FOUND when the item is gone. Write lock.
	status_t RemoveItem(const BResourceHandle& handle);

	// Takes the oldest change that this user of the collection has not seen, several changes of
	// one item merged into one. Invalid handle at the end. Read lock; each user from its own thread.
	BResourceHandle GetNextChange(BResourceAddonBase* user, uint32* _changes) const;

protected:
	// What a collection that keeps undo steps builds on; all are called in the thread that holds
	// the write lock. An item is reported with its present state before each change; a new item
	// after it was made.
	virtual void StepBegins(const char* operation);
	virtual void ItemChanges(const BResourceItem* item, uint32 change);
	virtual void StepEnds();

	// May rewrite data that an item is about to get, into bytes of the same meaning. The item still
	// has its former data.
	virtual void PrepareData(const BResourceItem* item, std::vector<uint8>& data) const;

	// The access behind the locks of BResourceAddonBase.
	bool LockForReading() const;
	void UnlockForReading() const;
	bool LockForWriting(const char* operation);
	void UnlockForWriting();

	// Puts an item back as it was, under its former handle and at that index; for undo.
	BResourceItem* RestoreItem(const BResourceItem& state, int32 index);
	int32 IndexOf(const BResourceHandle& handle) const; // -1 when the item is gone

private:
	friend class BResourceAddonBase;
	friend class BResourceItem;

	int32 _NextFreeID(type_code type, int32 id) const;
	void _WillChange(BResourceItem* item, uint32 change);
	void _Rekey(BResourceItem* item, type_code type, int32 id);
	void _Register(BResourceAddonBase* user);
	void _Unregister(BResourceAddonBase* user);
	void _SetMessenger(BResourceAddonBase* user, const BMessenger& messenger);

	class Private;
	std::unique_ptr<Private> fPrivate;
};


} // namespace BResEditor
