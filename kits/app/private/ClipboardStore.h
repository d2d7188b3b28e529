// ClipboardStore: the contents of one clipboard, shared by the objects of its name.
#pragma once

#include <mutex>
#include <string>
#include <vector>

#include <Locker.h>
#include <Message.h>
#include <Messenger.h>

namespace BPrivate {


// The store named "system" is the desktop's clipboard while there is a desktop. Stores are never
// deleted. Any thread; see BClipboard for what needs Lock().
class ClipboardStore {
public:
	static ClipboardStore* Named(const char* name);
	// The desktop's clipboard has got other contents. Any thread, waits for no lock of a user.
	static void SystemChanged();

	explicit ClipboardStore(const char* name);

	const char* Name() const { return fName.c_str(); }
	bool Lock() { return fLock.Lock(); }
	void Unlock() { fLock.Unlock(); }
	bool IsLocked() const { return fLock.IsLocked(); }

	BMessage* Data();
	status_t Clear();
	status_t Commit(bool failIfChanged);
	status_t Revert();
	BMessenger Source() const;

	// How often the contents were replaced, and as of when Data() is.
	uint32 Count() const;
	uint32 SeenCount() const;

	status_t AddWatcher(const BMessenger& watcher);
	status_t RemoveWatcher(const BMessenger& watcher);

private:
	bool _IsSystem() const { return fName == "system"; }
	void _Fetch();
	void _Notify();

	const std::string fName;
	mutable BLocker fLock; // the user's

	// Under the user's lock:
	BMessage fData;
	bool fIsFetched = false; // fData is what was there at fSeen, or is being changed

	mutable std::mutex fStateLock; // held for moments, never with a call to the outside
	BMessage fCommitted;
	BMessenger fSource;
	uint32 fCount = 0;
	uint32 fSeen = 0;
	uint32 fOwnSerial = 0;
	std::vector<BMessenger> fWatchers;
};


} // namespace BPrivate
