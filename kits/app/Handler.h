// BHandler: an object that receives messages through a looper.
#pragma once

#include <atomic>

#include <Archivable.h>
#include <Message.h>
#include <OS.h>
#include <SupportDefs.h>

class BList;
class BLooper;
class BMessage;
class BMessageFilter;
class BMessenger;

namespace BPrivate {
class HandlerPrivate;
class ObserverList;
} // namespace BPrivate


// A handler belongs to at most one looper. Its looper must be locked for everything that changes
// the handler while it is attached; Looper() and the three lock functions may be called from any
// thread. Deleting a handler takes it out of its looper and drops the messages queued for it.
class _EXPORT BHandler : public BArchivable {
public:
	BHandler(const char* name = NULL);
	BHandler(BMessage* data);
	virtual ~BHandler();
	BHandler(const BHandler&) = delete;
	BHandler& operator=(const BHandler&) = delete;

	static BArchivable* Instantiate(BMessage* data);
	virtual status_t Archive(BMessage* data, bool deep = true) const;

	// Hands the message to the next handler; at the end of the chain a sender that waits, a drop
	// or a scripting message is answered B_MESSAGE_NOT_UNDERSTOOD.
	virtual void MessageReceived(BMessage* message);

	BLooper* Looper() const;
	void SetName(const char* name);
	const char* Name() const;
	// The handler must be attached to a locked looper, which the next handler shares.
	virtual void SetNextHandler(BHandler* handler);
	BHandler* NextHandler() const;

	// Filters in the list belong to the handler. SetFilterList() deletes the previous ones.
	virtual void AddFilter(BMessageFilter* filter);
	virtual bool RemoveFilter(BMessageFilter* filter);
	virtual void SetFilterList(BList* filters);
	BList* FilterList();

	// Lock whatever looper the handler has now; they fail when it has none or changes meanwhile.
	bool LockLooper();
	status_t LockLooperWithTimeout(bigtime_t timeout);
	void UnlockLooper();

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);

	status_t StartWatching(BMessenger target, uint32 what);
	status_t StartWatchingAll(BMessenger target);
	status_t StopWatching(BMessenger target, uint32 what);
	status_t StopWatchingAll(BMessenger target);
	status_t StartWatching(BHandler* observer, uint32 what);
	status_t StartWatchingAll(BHandler* observer);
	status_t StopWatching(BHandler* observer, uint32 what);
	status_t StopWatchingAll(BHandler* observer);
	// Sends B_OBSERVER_NOTICE_CHANGE to those who watch `what`, with the given message's fields.
	virtual void SendNotices(uint32 what, const BMessage* message = NULL);
	bool IsWatched() const;

private:
	friend class BPrivate::HandlerPrivate;

	friend class BLooper;

	bool _CheckLooperLocked(const char* function) const;
	status_t _AskToWatch(const BMessenger& observed, uint32 request, uint32 what);
	bool _HandleRequest(BMessage* message);
	bool _HandleWatchRequest(const BMessage& message);
	status_t _ReplyToScript(BMessage* message);

	char* fName = nullptr;
	std::atomic<BLooper*> fLooper { nullptr };
	BHandler* fNextHandler = nullptr; // borrowed
	BList* fFilters = nullptr;
	BPrivate::ObserverList* fObservers = nullptr;
	mutable std::atomic<int32> fToken { -1 }; // given when somebody first addresses the handler
	int32 fSlot = -1; // where the looper's handler list holds it
};


// Fields of B_OBSERVER_NOTICE_CHANGE, and the code that watches everything.
extern _EXPORT const char* B_OBSERVE_WHAT_CHANGE;
extern _EXPORT const char* B_OBSERVE_ORIGINAL_WHAT;
const uint32 B_OBSERVER_OBSERVE_ALL = 0xffffffff;
