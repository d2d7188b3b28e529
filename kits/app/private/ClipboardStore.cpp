#include "app/private/ClipboardStore.h"

#include <algorithm>
#include <map>
#include <memory>

#include <AppDefs.h>
#include <Application.h>

#include "server/Desktop.h"

namespace BPrivate {


ClipboardStore*
ClipboardStore::Named(const char* name)
{
	static auto* lock = new std::mutex;
	static auto* stores = new std::map<std::string, std::unique_ptr<ClipboardStore>>;

	std::lock_guard guard(*lock);
	std::unique_ptr<ClipboardStore>& store = (*stores)[name];
	if (!store)
		store = std::make_unique<ClipboardStore>(name);
	return store.get();
}


void
ClipboardStore::SystemChanged()
{
	Named("system")->_Notify();
}


ClipboardStore::ClipboardStore(const char* name) : fName(name), fLock(name)
{
}


BMessage*
ClipboardStore::Data()
{
	_Fetch();
	return &fData;
}


status_t
ClipboardStore::Clear()
{
	fData.MakeEmpty();
	fIsFetched = true;
	std::lock_guard lock(fStateLock);
	fSeen = fCount;
	return B_OK;
}


status_t
ClipboardStore::Commit(bool failIfChanged)
{
	if (failIfChanged && Count() != SeenCount())
		return B_ERROR;

	Desktop* desktop = _IsSystem() ? Desktop::Get() : nullptr;
	if (desktop != nullptr)
		desktop->SetClipboard(fData);

	{
		std::lock_guard lock(fStateLock);
		fCommitted = fData;
		fSource = be_app_messenger;
		fCount++;
		if (desktop != nullptr)
			fOwnSerial = desktop->ClipboardSerial();
		fSeen = desktop != nullptr ? fOwnSerial : fCount;
	}
	// The desktop tells us of a change of its clipboard, also of our own.
	if (desktop == nullptr)
		_Notify();
	return B_OK;
}


status_t
ClipboardStore::Revert()
{
	fIsFetched = false;
	return B_OK;
}


BMessenger
ClipboardStore::Source() const
{
	const uint32 count = Count();
	std::lock_guard lock(fStateLock);
	if (_IsSystem() && Desktop::Get() != nullptr && count != fOwnSerial)
		return BMessenger();
	return fSource;
}


uint32
ClipboardStore::Count() const
{
	if (_IsSystem()) {
		if (Desktop* desktop = Desktop::Get())
			return desktop->ClipboardSerial();
	}
	std::lock_guard lock(fStateLock);
	return fCount;
}


uint32
ClipboardStore::SeenCount() const
{
	std::lock_guard lock(fStateLock);
	return fSeen;
}


status_t
ClipboardStore::AddWatcher(const BMessenger& watcher)
{
	if (!watcher.IsValid())
		return B_BAD_VALUE;
	std::lock_guard lock(fStateLock);
	if (std::find(fWatchers.begin(), fWatchers.end(), watcher) == fWatchers.end())
		fWatchers.push_back(watcher);
	return B_OK;
}


status_t
ClipboardStore::RemoveWatcher(const BMessenger& watcher)
{
	std::lock_guard lock(fStateLock);
	return std::erase(fWatchers, watcher) > 0 ? B_OK : B_BAD_VALUE;
}


// Reads what is there now, unless the user has it already. Holds no state lock while it waits for
// the desktop.
void
ClipboardStore::_Fetch()
{
	const uint32 count = Count();
	bool isOwn = true;
	{
		std::lock_guard lock(fStateLock);
		if (fIsFetched && fSeen == count)
			return;
		isOwn = !_IsSystem() || Desktop::Get() == nullptr || count == fOwnSerial;
		if (isOwn)
			fData = fCommitted;
		fSeen = count;
	}
	if (!isOwn && Desktop::Get()->GetClipboard(&fData) != B_OK)
		fData.MakeEmpty();
	fIsFetched = true;
}


void
ClipboardStore::_Notify()
{
	std::vector<BMessenger> watchers;
	{
		std::lock_guard lock(fStateLock);
		std::erase_if(fWatchers, [](const BMessenger& watcher) { return !watcher.IsValid(); });
		watchers = fWatchers;
	}
	BMessage change(B_CLIPBOARD_CHANGED);
	for (const BMessenger& watcher : watchers)
		watcher.SendMessage(&change, BMessenger(), 0);
}


} // namespace BPrivate
