#include "interface/private/MenuTracker.h"

#include <algorithm>
#include <chrono>
#include <cstring>

#include <AppDefs.h>
#include <Looper.h>
#include <MenuBar.h>
#include <Message.h>
#include <Window.h>

#include "app/private/LooperPrivate.h"
#include "interface/private/MenuCodes.h"
#include "interface/private/MenuWindow.h"
#include "kernel/private/Activity.h"
#include "server/Desktop.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kLockWait = 20000; // microseconds between two looks whether to give up
constexpr bigtime_t kUpdateInterval = 50000; // of a window that waits for its menu
constexpr bigtime_t kHookInterval = 100000;

std::mutex sTrackersLock;
auto& sTrackers = *new std::vector<std::weak_ptr<MenuTracker>>();


std::vector<std::shared_ptr<MenuTracker>>
living_trackers()
{
	const std::lock_guard lock(sTrackersLock);
	std::vector<std::shared_ptr<MenuTracker>> result;
	std::erase_if(sTrackers, [](const auto& weak) { return weak.expired(); });
	for (const auto& weak : sTrackers) {
		if (std::shared_ptr<MenuTracker> tracker = weak.lock())
			result.push_back(std::move(tracker));
	}
	return result;
}


// Of the event that this thread handles, or now.
bigtime_t
time_of_press()
{
	const BLooper* looper = BLooper::LooperForThread(find_thread(NULL));
	const BMessage* message = looper != NULL ? looper->CurrentMessage() : NULL;
	int64 when;
	if (message != NULL && message->FindInt64("when", &when) == B_OK)
		return when;
	return system_time();
}

} // namespace


// #pragma mark - Step


MenuTracker::Step::Step(MenuTracker& tracker) : fTracker(tracker)
{
	if (tracker.fSharing != Sharing::kOwner) {
		tracker.fLoan.lock();
		fLocked = true;
		return;
	}
	while (!tracker.fAborted) {
		const status_t status = tracker.fOwner->LockWithTimeout(kLockWait);
		if (status == B_OK) {
			fLocked = fOwner = true;
			return;
		}
		if (status != B_TIMED_OUT && status != B_WOULD_BLOCK)
			tracker.fAborted = true;
	}
}


MenuTracker::Step::~Step()
{
	if (fOwner)
		fTracker.fOwner->Unlock();
	else if (fLocked)
		fTracker.fLoan.unlock();
}


// #pragma mark - beginning and end


MenuTracker::MenuTracker(const Request& request, Sharing sharing, BWindow* owner) :
	fRequest(request), fSharing(sharing), fOwner(owner), fBar(request.bar), fSticky(request.sticky)
{
}


MenuTracker::~MenuTracker() = default;


BMenuItem*
MenuTracker::Track(const Request& request)
{
	BWindow* window = dynamic_cast<BWindow*>(BLooper::LooperForThread(find_thread(NULL)));
	if (window != NULL && window->LockingThread() != find_thread(NULL))
		window = NULL;
	BWindow* owner = request.menu != NULL ? request.menu->fInstalledWindow : NULL;
	const bool mayLock = owner != NULL && owner->LockingThread() != find_thread(NULL);
	const std::shared_ptr<MenuTracker> tracker(
		new MenuTracker(request, mayLock ? Sharing::kOwner : Sharing::kLoan, owner));
	if (!tracker->_Begin())
		return NULL;
	BMenuItem* item = tracker->_Wait(window);
	if (item != NULL && request.deliver) {
		BInvoker* invoker = item;
		invoker->Invoke();
	}
	return item;
}


void
MenuTracker::Start(const Request& request)
{
	BWindow* owner = request.bar != NULL ? request.bar->Window() : NULL;
	if (owner == NULL && request.menu != NULL)
		owner = request.menu->fInstalledWindow;
	if (owner == NULL)
		owner = dynamic_cast<BWindow*>(BLooper::LooperForThread(find_thread(NULL)));
	const std::shared_ptr<MenuTracker> tracker(
		new MenuTracker(request, owner != NULL ? Sharing::kOwner : Sharing::kNone, owner));
	tracker->_Begin();
}


void
MenuTracker::EndMenusOf(BWindow* window)
{
	for (const std::shared_ptr<MenuTracker>& tracker : living_trackers()) {
		if (tracker->fOwner == window && tracker->fSharing == Sharing::kOwner)
			tracker->Abort();
	}
}


// In the thread that asked for it, which has the owner's lock.
bool
MenuTracker::_Begin()
{
	// One menu at a time: the last one asked for is the one that the user wants.
	for (const std::shared_ptr<MenuTracker>& other : living_trackers())
		other->fFirstMessenger.SendMessage(kMenuAbort);
	BMenu* menu = fRequest.menu;
	if ((fBar != NULL && fBar->fTracker != NULL) || (menu != NULL && menu->fTracker != NULL))
		return false;
	BMenuItem* item = NULL;
	if (fBar != NULL) {
		if (fBar->Window() != NULL)
			fBar->Window()->MenusBeginning();
		fBar->_Opened(this, fBar->ConvertToScreen(BPoint(0, 0)));
		// The hook may have taken the item away.
		if (_IsInOpenMenu(fRequest.barItem))
			item = fRequest.barItem;
		menu = item != NULL && item->IsEnabled() ? item->Submenu() : NULL;
	}

	fStartTime = time_of_press();
	fFirst = new MenuWindow(shared_from_this(), BRect(0, 0, 10, 10));
	fFirstMessenger = BMessenger(fFirst);
	fFirst->Park();
	{
		const std::lock_guard lock(sTrackersLock);
		sTrackers.push_back(weak_from_this());
	}
	if (fBar != NULL)
		fBar->_SelectItem(item);
	if (menu != NULL)
		_Open(menu, fRequest.byKey);
	fFirst->Show();
	_Synchronize();
	return true;
}


// Tells the state of the buttons from which on every event comes to the first menu's window.
void
MenuTracker::_Synchronize()
{
	const BMessenger messenger = fFirstMessenger;
	Desktop* desktop = Desktop::Get();
	desktop->Post([desktop, messenger] {
		BPoint where;
		uint32 buttons;
		desktop->GetMouse(&where, &buttons);
		BMessage message(kMenuStarted);
		message.AddPoint("screen_where", where);
		message.AddInt32("buttons", static_cast<int32>(buttons));
		messenger.SendMessage(&message);
	});
}


// The end of the wait is told by who brings it about, so that there is no moment in which the
// program seems to be idle before this thread has woken up.
BMenuItem*
MenuTracker::_Wait(BWindow* window)
{
	_UpdateWaiting(window);
	std::unique_lock lock(fDoneLock);
	BLooper* looper = BLooper::LooperForThread(find_thread(NULL));
	if (looper != NULL && !fDone) {
		fWaiter = &LooperPrivate(looper).Activity();
		fWaiter->BeginWaiting();
	}
	while (!fDone) {
		if (window == NULL) {
			fDoneCondition.wait(lock);
			continue;
		}
		fDoneCondition.wait_for(lock, std::chrono::microseconds(kUpdateInterval));
		if (fDone)
			break;
		lock.unlock();
		_UpdateWaiting(window);
		lock.lock();
	}
	return fResult;
}


// No step runs meanwhile: a window draws its menus, too.
void
MenuTracker::_UpdateWaiting(BWindow* window)
{
	if (window == NULL || !window->NeedsUpdate())
		return;
	const std::lock_guard<std::recursive_mutex> loan(fLoan);
	window->UpdateIfNeeded();
}


void
MenuTracker::Abort()
{
	const std::shared_ptr<MenuTracker> self = shared_from_this();
	fAborted = true;
	if (find_thread(NULL) == fThread) {
		_Finish(NULL);
	} else {
		fFirstMessenger.SendMessage(kMenuAbort);
		std::unique_lock lock(fDoneLock);
		fDoneCondition.wait(lock, [this] { return fDone.load(); });
	}
	_CloseBar();
}


// With the lock of the bar's window.
void
MenuTracker::_CloseBar()
{
	if (fBar == NULL || fBar->fTracker != this)
		return;
	fBar->_Closed();
	BMessenger(fBar).SendMessage(kMenusEnded);
}


// In the first window's thread. An item that was taken out meanwhile is not chosen.
void
MenuTracker::_Finish(BMenuItem* item)
{
	if (fFinished)
		return;
	fFinished = true;
	fScroller.reset();
	fHookRunner.reset();

	bool chosen = false;
	{
		Step step(*this);
		chosen = step.IsLocked() && item != NULL && _IsInOpenMenu(item);
	}
	_CloseFrom(0);
	{
		Step step(*this);
		chosen = chosen && step.IsLocked();
		// Who ends it by Abort() holds the lock, and closes the bar himself.
		if (step.IsLocked())
			_CloseBar();
		if (chosen && fRequest.deliver && fSharing != Sharing::kLoan) {
			BInvoker* invoker = item;
			invoker->Invoke();
		}
		if (fRequest.autoDestruct)
			delete fRequest.menu;
	}
	fFirst->AllowQuit();
	fFirst->PostMessage(B_QUIT_REQUESTED);

	const std::lock_guard lock(fDoneLock);
	fResult = chosen ? item : NULL;
	fDone = true;
	if (fWaiter != nullptr)
		fWaiter->EndWaiting();
	fDoneCondition.notify_all();
}


bool
MenuTracker::_IsInOpenMenu(const BMenuItem* item) const
{
	const auto has = [item](const BMenu* menu) {
		return std::find(menu->fItems.begin(), menu->fItems.end(), item) != menu->fItems.end();
	};
	return (fBar != NULL && has(fBar))
		|| std::any_of(
			fLevels.begin(), fLevels.end(), [&has](const Level& level) { return has(level.menu); });
}


bool
MenuTracker::IsBar(const BMenu* menu) const
{
	return menu == fBar;
}


void
MenuTracker::MenuChanged(BMenu*)
{
	if (!fChangePosted.exchange(true))
		fFirstMessenger.SendMessage(kMenuChanged);
}


void
MenuTracker::Forward(const BMessage& message)
{
	BMessage copy(kMenuKey);
	copy.AddMessage("event", &message);
	fFirstMessenger.SendMessage(&copy);
}


// #pragma mark - messages


void
MenuTracker::WindowStarted()
{
	fThread = find_thread(NULL);
	if (!fLevels.empty() && fLevels.front().menu->fTrackingHook != NULL) {
		const BMessage poll(kMenuPoll);
		fHookRunner = std::make_unique<BMessageRunner>(fFirstMessenger, &poll, kHookInterval);
	}
}


void
MenuTracker::MessageReceived(BMessage* message)
{
	if (fFinished)
		return;
	switch (message->what) {
		case kMenuStarted: {
			WindowStarted();
			BPoint where;
			int32 buttons = 0;
			message->FindPoint("screen_where", &where);
			message->FindInt32("buttons", &buttons);
			if (!fHasOrigin) {
				fHasOrigin = true;
				fOrigin = where;
			}
			if (buttons == 0 && !fReleased)
				MouseUp(where, fStartTime);
			break;
		}

		case kMenuAbort:
			_Finish(NULL);
			break;

		case kMenuChanged:
			fChangePosted = false;
			_Relayout();
			break;

		case kMenuAdd:
			_AddMoreItems();
			break;

		case kMenuPoll:
			if (_HookEnds())
				_Finish(NULL);
			break;

		case kMenuScroll:
			if (fArrowLevel >= 0)
				_ScrollLevel(fArrowLevel, fArrow * kScrollStep);
			break;

		case kMenuWheel: {
			float delta = 0;
			BPoint where;
			message->FindFloat("be:wheel_delta_y", &delta);
			message->FindPoint("screen_where", &where);
			const Hit hit = _HitTest(where);
			if (hit.level >= 0)
				_ScrollLevel(hit.level, delta * kScrollStep * 3);
			break;
		}

		case kMenuKey: {
			BMessage event;
			const char* bytes;
			if (message->FindMessage("event", &event) == B_OK
				&& event.FindString("bytes", &bytes) == B_OK)
				KeyDown(event, bytes, static_cast<int32>(strlen(bytes)));
			break;
		}
	}
}


bool
MenuTracker::_HookEnds()
{
	if (fLevels.empty())
		return false;
	BMenu* menu = fLevels.front().menu;
	Step step(*this);
	return step.IsLocked() && menu->fTrackingHook != NULL
		&& menu->fTrackingHook(menu, menu->fTrackingState);
}


// #pragma mark - MenuAccess


BRect
MenuAccess::FrameOf(const BMenuItem* item)
{
	return item->fBounds;
}


MenuTracker*
MenuAccess::TrackerOf(const BMenu* menu)
{
	return menu->fTracker;
}


bool
MenuAccess::IsSelected(const BMenuItem* item)
{
	return item->fSelected;
}


} // namespace BPrivate
