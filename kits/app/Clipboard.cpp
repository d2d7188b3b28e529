#include <Clipboard.h>

#include <string.h>

#include <Message.h>

#include "app/private/ClipboardStore.h"

BClipboard* be_clipboard = nullptr;


BClipboard::BClipboard(const char* name, bool transient) :
	fStore(BPrivate::ClipboardStore::Named(name != nullptr ? name : "system"))
{
}


BClipboard::~BClipboard() = default;


const char*
BClipboard::Name() const
{
	return fStore->Name();
}


uint32
BClipboard::LocalCount() const
{
	return fStore->SeenCount();
}


uint32
BClipboard::SystemCount() const
{
	return fStore->Count();
}


status_t
BClipboard::StartWatching(BMessenger target)
{
	return fStore->AddWatcher(target);
}


status_t
BClipboard::StopWatching(BMessenger target)
{
	return fStore->RemoveWatcher(target);
}


bool
BClipboard::Lock()
{
	return fStore->Lock();
}


void
BClipboard::Unlock()
{
	fStore->Unlock();
}


bool
BClipboard::IsLocked() const
{
	return fStore->IsLocked();
}


status_t
BClipboard::Clear()
{
	return IsLocked() ? fStore->Clear() : B_NOT_ALLOWED;
}


status_t
BClipboard::Commit()
{
	return Commit(false);
}


status_t
BClipboard::Commit(bool failIfChanged)
{
	return IsLocked() ? fStore->Commit(failIfChanged) : B_NOT_ALLOWED;
}


status_t
BClipboard::Revert()
{
	return IsLocked() ? fStore->Revert() : B_NOT_ALLOWED;
}


BMessenger
BClipboard::DataSource() const
{
	return fStore->Source();
}


BMessage*
BClipboard::Data() const
{
	return IsLocked() ? fStore->Data() : nullptr;
}
