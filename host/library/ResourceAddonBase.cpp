#include "host/library/ResourceAddonBase.h"

#include <Messenger.h>

namespace BResEditor {


BResourceAddonBase::BResourceAddonBase(const BResourceAddonArgs& args, BHandler* handler) :
	fCollection(args.collection), fHandler(handler)
{
	if (fCollection != nullptr)
		fCollection->_Register(this);
}


BResourceAddonBase::~BResourceAddonBase()
{
	Disconnect();
}


const BResourceCollection*
BResourceAddonBase::ReadLock()
{
	if (fCollection == nullptr || !fCollection->LockForReading())
		return nullptr;

	// Taken here, in the handler's own thread: the notice is posted from other threads, where the
	// handler itself must not be touched.
	if (fHandler != nullptr && fHandler->Looper() != nullptr)
		fCollection->_SetMessenger(this, BMessenger(fHandler));
	return fCollection;
}


void
BResourceAddonBase::ReadUnlock(const BResourceCollection* collection)
{
	if (collection != nullptr)
		collection->UnlockForReading();
}


BResourceCollection*
BResourceAddonBase::WriteLock(const char* operation)
{
	if (fCollection == nullptr || !fCollection->LockForWriting(operation))
		return nullptr;
	return fCollection;
}


void
BResourceAddonBase::WriteUnlock(BResourceCollection* collection)
{
	if (collection != nullptr)
		collection->UnlockForWriting();
}


void
BResourceAddonBase::Disconnect()
{
	if (fCollection != nullptr)
		fCollection->_Unregister(this);
	fCollection = nullptr;
}


BResourceHandle&
BResourceAddonBase::PrimaryItem()
{
	return fPrimaryItem;
}


const BResourceHandle&
BResourceAddonBase::PrimaryItem() const
{
	return fPrimaryItem;
}


void
BResourceAddonBase::SetPrimaryItem(const BResourceHandle& handle)
{
	fPrimaryItem = handle;
}


void
BResourceAddonBase::DataChanged(const BResourceCollection* collection)
{
}


} // namespace BResEditor
