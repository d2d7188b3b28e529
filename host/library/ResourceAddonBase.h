// BResourceAddonBase: what everything that works on a collection has: its locks and a primary item.
#pragma once

#include <BeBuild.h>
#include <Handler.h>
#include <SupportDefs.h>

#include "host/library/ResourceCollection.h"
#include "host/library/ResourceHandle.h"

namespace BResEditor {


// What the host gives to an add-on; passed on unchanged to the base constructors.
struct _EXPORT BResourceAddonArgs {
	BResourceCollection* collection; // borrowed: outlives all users
};


class _EXPORT BResourceAddonBase {
public:
	// When a handler is given, it is told of changes by B_RESOURCE_DATA_CHANGED while it has a
	// looper. The handler is borrowed and outlives this object's use of it.
	BResourceAddonBase(const BResourceAddonArgs& args, BHandler* handler = NULL);
	virtual ~BResourceAddonBase();

	// NULL when there is no collection (any more). A reader may lock again for reading; nobody
	// takes the write lock while reading. Lock a window before the collection, never the reverse.
	const BResourceCollection* ReadLock();
	void ReadUnlock(const BResourceCollection* collection);

	// The operation is the text of the undo step that collects all changes until WriteUnlock();
	// NULL gives a general one.
	BResourceCollection* WriteLock(const char* operation);
	void WriteUnlock(BResourceCollection* collection);

	// Parts this object from the collection: from now on its locks give NULL. For the host, which
	// takes an editor away from an item that it must not write any more.
	void Disconnect();

	BResourceHandle& PrimaryItem();
	const BResourceHandle& PrimaryItem() const;
	void SetPrimaryItem(const BResourceHandle& handle);

	// Called when the host has no better way to tell of changes; does nothing by default.
	virtual void DataChanged(const BResourceCollection* collection);

private:
	BResourceAddonBase(const BResourceAddonBase&) = delete;
	BResourceAddonBase& operator=(const BResourceAddonBase&) = delete;

	BResourceCollection* fCollection; // borrowed
	BHandler* fHandler; // borrowed, may be NULL
	BResourceHandle fPrimaryItem;
};


} // namespace BResEditor
