// A window's views and updates; its input is in WindowInput.cpp and WindowKeys.cpp.
#include "interface/private/WindowInternals.h"

#include <algorithm>

#include <AppDefs.h>
#include <Message.h>
#include <Messenger.h>
#include <View.h>

#include "app/private/CursorPrivate.h"
#include "app/private/LooperPrivate.h"
#include "interface/private/BitmapAccess.h"
#include "interface/private/ViewInspector.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/ViewWalk.h"
#include "support/private/Saturate.h"

namespace BPrivate {

namespace {

bool
is_in(const ServerView* view, const ServerView& top)
{
	while (view != nullptr && view != &top)
		view = view->Parent();
	return view != nullptr;
}


BRect
local_bounds(BRect frame)
{
	return frame.OffsetToCopy(0, 0);
}

} // namespace


WindowInternals::WindowInternals(
	BWindow& window, BRect frame, Surface* bitmapSurface, BBitmap* bitmap) :
	window(window),
	tree(*this, local_bounds(frame)), bitmapSurface(bitmapSurface), bitmap(bitmap)
{
	if (bitmapSurface != nullptr)
		tree.SetSurface(bitmapSurface);
}


WindowInternals::~WindowInternals()
{
	tips.Dismiss();
	// The display thread must not find us half gone.
	server.reset();
}


void
WindowInternals::PostInput(BMessage* message)
{
	LooperPrivate(&window).PostSystem(message);
}


// #pragma mark - views


void
WindowInternals::ViewsEntered(ServerView& top)
{
	tree.Attach(top);
	for (ServerView* node = &top; node != nullptr; node = node->NextInTree(&top)) {
		if (node->Has(B_PULSE_NEEDED))
			NeedPulse();
		const ViewExtras* extras = ViewPrivate(node->Owner()).Extras();
		if (extras != nullptr && extras->eventMask != 0)
			EventMaskChanged(node->Owner());
	}
}


void
WindowInternals::ViewsLeave(ServerView& top)
{
	const auto leaves = [&top](const BView* view) {
		return view != nullptr && is_in(ViewPrivate(view).Node(), top);
	};
	if (leaves(focus)) {
		focus = nullptr;
		window.SetPreferredHandler(nullptr);
	}
	for (BView** view : { &mouseView, &rectTracker, &pointerTarget, &leftView, &enteredView }) {
		if (leaves(*view))
			*view = nullptr;
	}
	if (leaves(tips.View()))
		tips.Forget();
	if (defaultButtonView != nullptr && leaves(defaultButtonView))
		defaultButtonView = nullptr, defaultButton = nullptr;
	if (keyMenuBarView != nullptr && leaves(keyMenuBarView))
		keyMenuBarView = nullptr, keyMenuBar = nullptr;
	std::erase_if(eventMaskViews, leaves);
	std::erase_if(
		shortcuts, [&leaves](const Shortcut& shortcut) { return leaves(shortcut.targetView); });
	_UpdatePointerWish();
	tree.Detach(top);
}


void
WindowInternals::ViewHidden(BView* view)
{
	const ServerView& node = *ViewPrivate(view).Node();
	if (mouseView != nullptr && is_in(ViewPrivate(mouseView).Node(), node))
		mouseView = nullptr;
	if (tips.View() != nullptr && is_in(ViewPrivate(tips.View()).Node(), node))
		tips.Forget();
	if (focus != nullptr && is_in(ViewPrivate(focus).Node(), node))
		focus->MakeFocus(false);
}


void
WindowInternals::FrameChanged(ServerView& node, bool moved, bool resized)
{
	BView* view = node.Owner();
	if (view == nullptr || !node.Has(B_FRAME_EVENTS))
		return;
	LooperPrivate looper(&window);
	const BRect frame = node.Frame();
	if (moved) {
		auto message = new BMessage(B_VIEW_MOVED);
		message->AddInt64("when", system_time());
		message->AddPoint("where", frame.LeftTop());
		looper.PostSystemTo(message, view);
	}
	if (resized) {
		auto message = new BMessage(B_VIEW_RESIZED);
		message->AddInt64("when", system_time());
		message->AddInt32("width", saturated(frame.Width()));
		message->AddInt32("height", saturated(frame.Height()));
		looper.PostSystemTo(message, view);
	}
}


void
WindowInternals::CallWindowActivated(bool isActive)
{
	active = isActive;
	WindowList::SetActive(&window, isActive);
	window.WindowActivated(isActive);
	ViewWalk walk(tree.Root(), walks, ViewWalk::kNotice);
	walk.ParentsFirst([isActive](BView& view) { view.WindowActivated(isActive); });
}


// #pragma mark - pulse


void
WindowInternals::NeedPulse()
{
	pulseNeeded = true;
	UpdatePulse();
}


void
WindowInternals::UpdatePulse()
{
	if (!pulseNeeded || pulseRate <= 0) {
		pulseRunner.reset();
		return;
	}
	if (pulseRunner != nullptr)
		pulseRunner->SetInterval(pulseRate);
	else {
		BMessage pulse(B_PULSE);
		pulseRunner = std::make_unique<BMessageRunner>(BMessenger(&window), &pulse, pulseRate);
	}
}


void
WindowInternals::Pulse()
{
	bool wanted = false;
	const ServerView& root = tree.Root();
	for (const ServerView* node = &root; node != nullptr && !wanted; node = node->NextInTree(&root))
		wanted = node->Has(B_PULSE_NEEDED);
	if (!wanted) {
		pulseNeeded = false;
		UpdatePulse();
		return;
	}
	ViewWalk walk(tree.Root(), walks, ViewWalk::kNotice);
	walk.ParentsFirst([](BView& view) {
		if ((view.Flags() & B_PULSE_NEEDED) != 0)
			view.Pulse();
	});
}


// #pragma mark - updates


void
WindowInternals::UpdateNeeded()
{
	if (server != nullptr && hideCount <= 0 && updatesDisabled == 0)
		LooperPrivate(&window).RequestUpdate();
}


void
WindowInternals::DrawView(ServerView& view, BRect updateRect, bool afterChildren)
{
	ViewPrivate(view.Owner()).CallDraw(updateRect, afterChildren);
}


void
WindowInternals::Update()
{
	if (server == nullptr || hideCount > 0 || updatesDisabled > 0)
		return;
	presentPosted = false;
	PrepareSurface();
	tree.Update();
}


// The surface takes the size and the scale that the window has now.
void
WindowInternals::PrepareSurface()
{
	const bool changed = server->Prepare();
	if (!changed && tree.CanPaint())
		return;
	const float scale = server->Scale();
	tree.SetSurface(&server->Back());
	if (scale != surfaceScale) {
		surfaceScale = scale;
		tree.Invalidate(tree.Root(), tree.Root().Bounds());
	}
}


void
WindowInternals::NoteDrawing()
{
	if (server == nullptr || presentPosted || window.Thread() == find_thread(nullptr))
		return;
	presentPosted = true;
	LooperPrivate(&window).RequestUpdate(); // with nothing dirty it only shows
}


void
WindowInternals::Present()
{
	presentPosted = false;
	presentDue = 0;
	if (bitmap != nullptr) {
		BitmapAccess::Finish(*bitmap);
		return;
	}
	BRegion damage;
	tree.TakeDamage(&damage);
	toPresent.Include(&damage);
	if (transactions > 0 || hideCount > 0 || toPresent.IsEmpty())
		return;
	server->Present(toPresent);
	toPresent.MakeEmpty();
}


// What the window's own thread has drawn is shown with the update that is about to come.
void
WindowInternals::Flush()
{
	const bool updateFollows = server != nullptr && tree.IsDirty() && updatesDisabled == 0
		&& window.Thread() == find_thread(nullptr);
	if (updateFollows)
		_PresentSoon();
	else
		Present();
}


// A message of the window's own thread has been handled: what it has drawn becomes visible, together
// with what the messages that wait draw and with the updates that they cause, but soon in any case.
void
WindowInternals::MessageHandled()
{
	if (server == nullptr || (!tree.HasDamage() && toPresent.IsEmpty()))
		return;
	if (tree.IsDirty() && updatesDisabled == 0)
		return;
	if (window.IsMessageWaiting())
		_PresentSoon();
	else
		Present();
}


void
WindowInternals::_PresentSoon()
{
	if (presentDue == 0)
		presentDue = system_time() + presentDelay;
	else if (system_time() >= presentDue)
		Present();
}


void
WindowInternals::ResizeViews(float width, float height)
{
	tree.ResizeTo(tree.Root(), width, height);
}


void
WindowInternals::FollowServerSize()
{
	const BRect frame = server->Frame();
	ResizeViews(frame.Width(), frame.Height());
}


void
WindowInternals::ApplyCursor()
{
	if (server == nullptr)
		return;
	// While something is dragged the program's pointer shows, for a view's tells of pressing it.
	for (const BView* view = dragOver ? nullptr : mouseView; view != nullptr;
		 view = view->Parent()) {
		const ViewExtras* extras = ViewPrivate(view).Extras();
		if (extras != nullptr && extras->cursor != nullptr) {
			server->SetCursor(CursorPrivate::Shape(*extras->cursor));
			return;
		}
	}
	CursorShape programs;
	programs.id = CursorShape::kProgram;
	server->SetCursor(programs);
}


} // namespace BPrivate
