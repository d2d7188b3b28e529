// BLooper: a thread with a queue of messages for its handlers.
#pragma once

#include <memory>

#include <Handler.h>
#include <List.h>

class BMessageQueue;

namespace BPrivate {
class LooperCore;
class LooperPrivate;
} // namespace BPrivate

#define B_LOOPER_PORT_DEFAULT_CAPACITY 100


// A new looper is locked by its creator; Run() starts the thread and unlocks it once. A running
// looper is never deleted but ended with Quit(), or by a B_QUIT_REQUESTED that it agrees to.
class _EXPORT BLooper : public BHandler {
public:
	BLooper(const char* name = NULL, int32 priority = B_NORMAL_PRIORITY,
		int32 portCapacity = B_LOOPER_PORT_DEFAULT_CAPACITY);
	BLooper(BMessage* data);
	virtual ~BLooper();

	static BArchivable* Instantiate(BMessage* data);
	virtual status_t Archive(BMessage* data, bool deep = true) const;

	// Post a copy and never wait: B_WOULD_BLOCK when the port is full. Any thread, no lock. A
	// handler of another looper gives B_MISMATCHED_VALUES; a NULL handler is the preferred one.
	status_t PostMessage(uint32 command);
	status_t PostMessage(BMessage* message);
	status_t PostMessage(uint32 command, BHandler* handler, BHandler* replyTo = NULL);
	status_t PostMessage(BMessage* message, BHandler* handler, BHandler* replyTo = NULL);

	virtual void DispatchMessage(BMessage* message, BHandler* handler);
	virtual void MessageReceived(BMessage* message);
	// The message in work, in the looper's own thread only.
	BMessage* CurrentMessage() const;
	BMessage* DetachCurrentMessage();
	BMessageQueue* MessageQueue() const;
	bool IsMessageWaiting() const;

	void AddHandler(BHandler* handler);
	bool RemoveHandler(BHandler* handler);
	int32 CountHandlers() const;
	BHandler* HandlerAt(int32 index) const;
	int32 IndexOf(BHandler* handler) const;
	BHandler* PreferredHandler() const;
	void SetPreferredHandler(BHandler* handler);

	virtual thread_id Run();
	// Runs the loop in the calling thread, which holds the lock; returns when the looper is gone.
	void Loop();
	// Needs the lock. In the looper's own thread it does not return; from another one it waits
	// until everything queued before was handled. The object is gone afterwards.
	virtual void Quit();
	virtual bool QuitRequested();

	// Lock() returns false when the looper is gone, also for the address of a deleted one.
	bool Lock();
	void Unlock();
	bool IsLocked() const;
	status_t LockWithTimeout(bigtime_t timeout);
	thread_id Thread() const;
	team_id Team() const;
	static BLooper* LooperForThread(thread_id thread);
	thread_id LockingThread() const;
	int32 CountLocks() const;
	int32 CountLockRequests() const;
	// The lock is not a kernel semaphore here, so the answer is always -1.
	sem_id Sem() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);

	// Filters in the list belong to the looper. SetCommonFilterList() deletes the previous ones.
	virtual void AddCommonFilter(BMessageFilter* filter);
	virtual bool RemoveCommonFilter(BMessageFilter* filter);
	virtual void SetCommonFilterList(BList* filters);
	BList* CommonFilterList() const;

private:
	friend class BApplication;
	friend class BHandler;
	friend class BWindow;
	friend class BPrivate::LooperPrivate;

	// The step between the choice of the target and the filters. Takes ownership of the message
	// and hands it, or several copies of it, to _Deliver(). No target: it is gone.
	virtual void _RouteMessage(BMessage* message, BHandler* target);
	// Filters, dispatches and deletes one message, which is the current one meanwhile. May be
	// nested. Needs the lock.
	void _Deliver(BMessage* message, BHandler* target);

	void _Init(int32 priority, int32 portCapacity);
	bool _CheckLocked(const char* function) const;
	void _RunLoop();
	static status_t _ThreadEntry(void* looper);
	void _HandleNext();
	BHandler* _TargetOf(BMessage* message);
	BHandler* _ResolveScripting(BMessage* message, BHandler* target);
	bool _FilterCommon(BMessage* message, BHandler** target);
	bool _FilterByHandler(BMessage* message, BHandler** target);
	bool _CheckTarget(const BHandler* target) const;
	status_t _Post(const BMessage& message, int32 token, BHandler* replyTo);
	void _HandleQuitRequest(BMessage* message);
	void _CompactHandlers() const;

	std::shared_ptr<BPrivate::LooperCore> fCore; // shared with those who post
	struct Dispatch;
	Dispatch* fDispatch = nullptr; // the innermost one, on the loop's stack
	BHandler* fPreferredHandler = nullptr; // borrowed
	BList* fCommonFilters = nullptr;
	int32 fPriority = B_NORMAL_PRIORITY;
	bool fTerminating = false;
	bool fInCallersThread = false;
	struct HandlerTable;
	std::unique_ptr<HandlerTable> fHandlers;
};
