// BClipboard: the place where cut and copied data wait to be pasted.
#pragma once

#include <AppDefs.h>
#include <Messenger.h>

class BMessage;

namespace BPrivate {
class ClipboardStore;
}


// Lock, change or read Data(), Commit() what was changed, unlock. The clipboard named "system" is
// shared with the desktop; others are the program's own. Any thread.
class _EXPORT BClipboard {
public:
	BClipboard(const char* name, bool transient = false);
	virtual ~BClipboard();
	BClipboard(const BClipboard&) = delete;
	BClipboard& operator=(const BClipboard&) = delete;

	const char* Name() const;
	uint32 LocalCount() const;
	uint32 SystemCount() const;

	// Watchers get B_CLIPBOARD_CHANGED when somebody commits.
	status_t StartWatching(BMessenger target);
	status_t StopWatching(BMessenger target);

	bool Lock();
	void Unlock();
	bool IsLocked() const;

	// Need the lock. Clear() makes the caller the owner of the coming data.
	status_t Clear();
	status_t Commit();
	status_t Commit(bool failIfChanged);
	// Drops changes that were not committed, and reads afresh.
	status_t Revert();

	// Who committed last; invalid when that was another program.
	BMessenger DataSource() const;
	// One B_MIME_TYPE field for each kind of data. Ours, valid while locked; NULL without the lock.
	BMessage* Data() const;

private:
	BPrivate::ClipboardStore* fStore; // shared by the clipboards of one name
};

extern _EXPORT BClipboard* be_clipboard;
