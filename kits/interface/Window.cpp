#include <Window.h>

#include <cmath>

#include <AppDefs.h>
#include <Application.h>
#include <Button.h>
#include <Debug.h>
#include <MenuBar.h>
#include <Message.h>
#include <MessageQueue.h>
#include <Screen.h>

#include "app/private/LooperPrivate.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/OffscreenWindow.h"
#include "interface/private/ViewInspector.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/WindowInternals.h"

using namespace BPrivate;

namespace {

BRect
whole_frame(BRect frame)
{
	return BRect(std::round(frame.left), std::round(frame.top), std::round(frame.right),
		std::round(frame.bottom));
}

} // namespace


BWindow::BWindow(BRect frame, BBitmap* bitmap, Surface* surface) :
	BLooper("offscreen bitmap"), fInternals(new WindowInternals(*this, frame, surface, bitmap))
{
}


BWindow::~BWindow()
{
	if (fInternals == nullptr)
		return;
	WindowList::Remove(this);
	_DeleteViews();
	delete fInternals;
	fInternals = nullptr;
}


void
BWindow::_Init(BRect frame, const char* title, window_look look, window_feel feel, uint32 flags,
	uint32 workspaces, window_type type)
{
	frame = whole_frame(frame);
	fInternals = new WindowInternals(*this, frame, nullptr, nullptr);
	fInternals->title = title != nullptr ? title : "";
	fInternals->type = type;
	fInternals->look = look;
	fInternals->feel = feel;
	fInternals->flags = flags;
	fInternals->workspaces = workspaces;
	fInternals->server = std::make_unique<ServerWindow>(
		fInternals, frame, fInternals->title.c_str(), look, feel, flags);
	LooperPrivate(this).MarkAsWindow();
	ViewInspector::Install();
	WindowList::Add(this, fInternals->server->Id());
	WindowList::SetTitle(this, fInternals->title.c_str());
	WindowList::SetFrame(this, frame);
}


// Every view leaves its window before it is deleted, so that its hooks find both whole.
void
BWindow::_DeleteViews()
{
	ServerView& root = fInternals->tree.Root();
	while (ServerView* node = root.FirstChild()) {
		BView* view = node->Owner();
		view->RemoveSelf();
		delete view;
	}
}


void
BWindow::Quit()
{
	if (!IsLocked()) {
		debugger("A window must be locked before Quit().");
		return;
	}
	const bool quitsApplication =
		(Flags() & B_QUIT_ON_WINDOW_CLOSE) != 0 && be_app != nullptr && fInternals->shownOnce;
	MenuTracker::EndMenusOf(this);
	while (fInternals->server != nullptr && !IsHidden())
		Hide();
	// Quit by another thread, the window still handles what waits in its queue, with its views.
	if (!LooperPrivate(this).IsRunning() || Thread() == find_thread(NULL))
		_DeleteViews();
	if (quitsApplication)
		be_app->PostMessage(B_QUIT_REQUESTED);
	BLooper::Quit();
}


bool
BWindow::QuitRequested()
{
	return BLooper::QuitRequested();
}


thread_id
BWindow::Run()
{
	return BLooper::Run();
}


// #pragma mark - views


void
BWindow::AddChild(BView* child, BView* before)
{
	const bool locked = Lock();
	ViewPrivate::Insert(&fInternals->tree.Root(), child, before, this);
	if (locked)
		Unlock();
}


bool
BWindow::RemoveChild(BView* child)
{
	if (child == nullptr || child->Window() != this || child->Parent() != nullptr)
		return false;
	return child->RemoveSelf();
}


int32
BWindow::CountChildren() const
{
	return fInternals->tree.Root().CountChildren();
}


BView*
BWindow::ChildAt(int32 index) const
{
	const ServerView* node = fInternals->tree.Root().ChildAt(index);
	return node != nullptr ? node->Owner() : nullptr;
}


BView*
BWindow::FindView(const char* name) const
{
	const ServerView& root = fInternals->tree.Root();
	for (ServerView* node = root.FirstChild(); node != nullptr; node = node->Next()) {
		if (BView* found = node->Owner()->FindView(name))
			return found;
	}
	return nullptr;
}


BView*
BWindow::FindView(BPoint point) const
{
	const ServerView* node = fInternals->tree.ViewAt(point);
	return node != nullptr ? node->Owner() : nullptr;
}


BView*
BWindow::CurrentFocus() const
{
	return fInternals->focus;
}


BView*
BWindow::LastMouseMovedView() const
{
	return fInternals->mouseView;
}


// #pragma mark - showing


void
BWindow::Show()
{
	if (fInternals->server == nullptr)
		return;
	const bool wasLocked = IsLocked();
	if (!wasLocked && !Lock())
		return;

	WindowInternals& internals = *fInternals;
	internals.hideCount--;
	if (internals.hideCount == 0) {
		internals.PrepareSurface();
		internals.tree.Invalidate(internals.tree.Root(), internals.tree.Root().Bounds());
		internals.server->Show();
		WindowList::SetShown(this, true);
		internals.UpdateNeeded();
	}
	const bool starts = !internals.shownOnce;
	internals.shownOnce = true;
	if (starts) {
		LooperPrivate(this).RegisterWindow(this);
		Run(); // lets go of the lock that the constructor took
	}
	if (!wasLocked)
		Unlock();
}


void
BWindow::Hide()
{
	if (fInternals->server == nullptr)
		return;
	const bool wasLocked = IsLocked();
	if (!wasLocked && !Lock())
		return;
	if (fInternals->hideCount++ == 0) {
		fInternals->tips.Dismiss();
		fInternals->server->Hide();
		WindowList::SetShown(this, false);
	}
	if (!wasLocked)
		Unlock();
}


bool
BWindow::IsHidden() const
{
	return fInternals->bitmap == nullptr && fInternals->hideCount > 0;
}


bool
BWindow::IsMinimized() const
{
	return fInternals->minimized;
}


void
BWindow::Minimize(bool minimize)
{
	if (fInternals->server == nullptr || IsModal() || IsHidden())
		return;
	fInternals->minimized = minimize;
	fInternals->server->Minimize(minimize);
}


void
BWindow::Activate(bool active)
{
	if (fInternals->server != nullptr && !IsHidden())
		fInternals->server->Activate(active);
}


bool
BWindow::IsActive() const
{
	return fInternals->active;
}


bool
BWindow::IsFront() const
{
	return fInternals->server != nullptr && fInternals->server->IsFront();
}


status_t
BWindow::SendBehind(const BWindow* window)
{
	if (fInternals->server == nullptr)
		return B_ERROR;
	const ServerWindow* other = window != nullptr ? window->fInternals->server.get() : nullptr;
	fInternals->server->SendBehind(other);
	return B_OK;
}


// #pragma mark - updates


bool
BWindow::NeedsUpdate() const
{
	return fInternals->tree.IsDirty();
}


void
BWindow::UpdateIfNeeded()
{
	if (fInternals->server == nullptr || Thread() != find_thread(nullptr) || !IsLocked())
		return;
	if (fInternals->tree.IsUpdating())
		return;
	if (fInternals->tree.IsDirty()) {
		LooperPrivate looper(this);
		looper.CancelUpdate();
		looper.Deliver(new BMessage(_UPDATE_), this);
	}
	fInternals->Present();
}


void
BWindow::Flush() const
{
	if (IsLocked())
		fInternals->Flush();
}


void
BWindow::Sync() const
{
	if (IsLocked())
		fInternals->Present();
}


void
BWindow::DisableUpdates()
{
	fInternals->updatesDisabled++;
}


void
BWindow::EnableUpdates()
{
	if (fInternals->updatesDisabled == 0 || --fInternals->updatesDisabled > 0)
		return;
	if (fInternals->tree.IsDirty())
		fInternals->UpdateNeeded();
}


void
BWindow::BeginViewTransaction()
{
	fInternals->transactions++;
}


void
BWindow::EndViewTransaction()
{
	if (fInternals->transactions > 0 && --fInternals->transactions == 0)
		fInternals->MessageHandled();
}


bool
BWindow::InViewTransaction() const
{
	return fInternals->transactions > 0;
}


// #pragma mark - private


BWindow*
BPrivate::NewOffscreenWindow(BBitmap* bitmap, Surface* surface)
{
	return WindowInternals::NewOffscreen(bitmap, surface);
}


BWindow*
WindowInternals::NewOffscreen(BBitmap* bitmap, Surface* surface)
{
	const BRect frame(0, 0, surface->Width() - 1, surface->Height() - 1);
	BWindow* window = new BWindow(frame, bitmap, surface);
	window->Unlock();
	return window;
}
