// How a window finds the view for its input, and what reaches which hook.
#include <Window.h>

#include <algorithm>
#include <cstring>

#include <AppDefs.h>
#include <Message.h>

#include "app/private/Delivery.h"
#include "app/private/LooperPrivate.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"
#include "server/Desktop.h"

using namespace BPrivate;

namespace {

// A pointer movement older than this is left out when a newer one waits.
constexpr bigtime_t kStaleMove = 20000;
constexpr bigtime_t kReleaseDelay = 50000; // far more than the display thread needs


int32
transit(bool wasInside, bool isInside)
{
	if (isInside)
		return wasInside ? B_INSIDE_VIEW : B_ENTERED_VIEW;
	return wasInside ? B_EXITED_VIEW : B_OUTSIDE_VIEW;
}


BView*
owner_of(const ServerView* node)
{
	return node != nullptr ? node->Owner() : nullptr;
}


uint32
pointer_options(const BView* view)
{
	const ViewExtras* extras = ViewPrivate(view).Extras();
	return extras != nullptr ? extras->eventOptions | extras->mouseEventOptions : 0;
}


bool
is_key(uint32 what)
{
	return what == B_KEY_DOWN || what == B_KEY_UP || what == B_UNMAPPED_KEY_DOWN
		|| what == B_UNMAPPED_KEY_UP || what == B_MODIFIERS_CHANGED;
}


bool
is_pointer_input(uint32 what)
{
	return what == B_MOUSE_DOWN || what == B_MOUSE_UP || what == B_MOUSE_MOVED
		|| what == B_MOUSE_WHEEL_CHANGED;
}


bool
has_mask(const BView* view, uint32 bit)
{
	const ViewExtras* extras = ViewPrivate(view).Extras();
	return extras != nullptr && ((extras->eventMask | extras->mouseEventMask) & bit) != 0;
}

} // namespace


void
BWindow::_RouteMessage(BMessage* message, BHandler* target)
{
	if (target != nullptr)
		fInternals->Route(message, target);
	else
		delete message;
	fInternals->MessageHandled();
}


void
WindowInternals::Route(BMessage* message, BHandler* target)
{
	if (target != &window) {
		_Deliver(message, target);
		return;
	}
	if (_KeepBack(message))
		return;
	switch (message->what) {
		case ToolTips::kRested:
			delete message;
			tips.Rested();
			break;

		case kDragDecided:
			delete message;
			_DragDecided();
			break;

		case B_MOUSE_DOWN:
		case B_MOUSE_UP:
			_RoutePress(message);
			break;

		case B_MOUSE_MOVED:
			_RouteMove(message);
			break;

		case B_MOUSE_WHEEL_CHANGED:
			_RouteWheel(message);
			break;

		case _MESSAGE_DROPPED_:
			_RouteDrop(message);
			break;

		case B_KEY_DOWN:
		case B_KEY_UP:
		case B_UNMAPPED_KEY_DOWN:
		case B_UNMAPPED_KEY_UP:
		case B_MODIFIERS_CHANGED:
			_RouteKey(message);
			break;

		default:
			_Deliver(message, target);
			break;
	}
}


void
WindowInternals::_Deliver(BMessage* message, BHandler* target)
{
	LooperPrivate(&window).Deliver(message, target);
}


// #pragma mark - input behind a drag


void
WindowInternals::AwaitDrag()
{
	awaitedDrags++;
}


// The rest of the present press passes. Takes the message if it is kept.
bool
WindowInternals::_KeepBack(BMessage* message)
{
	if (awaitedDrags == 0)
		return false;
	const uint32 what = message->what;
	const bool begins = what == B_MOUSE_DOWN || is_key(what);
	if (!begins && (keptInput.empty() || !is_pointer_input(what)))
		return false;
	keptInput.emplace_back(message);
	return true;
}


void
WindowInternals::_DragDecided()
{
	awaitedDrags--;
	while (awaitedDrags == 0 && !keptInput.empty()) {
		BMessage* message = keptInput.front().release();
		keptInput.pop_front();
		Route(message, &window);
	}
}


// #pragma mark - pointer


void
WindowInternals::_RoutePress(BMessage* message)
{
	const std::unique_ptr<BMessage> event(message);
	server->BeginInput(*event);
	_NotePointer(*event);
	const bool elsewhere = event->GetBool(kPointerElsewhere, false);
	const bool isDown = event->what == B_MOUSE_DOWN;
	tips.Dismiss();
	pointerTarget = elsewhere ? nullptr : owner_of(tree.ViewAt(event->FindPoint("where")));
	if (isDown)
		pressed = true;

	inMouseDown = isDown;
	bool delivered = _DeliverToMasks(*event, pointerTarget, false);
	if (pointerTarget != nullptr && !has_mask(pointerTarget, B_POINTER_EVENTS)) {
		_DeliverPointer(*event, pointerTarget, -1);
		delivered = true;
	}
	inMouseDown = false;
	pointerTarget = nullptr;
	if (!delivered && !elsewhere)
		_Deliver(new BMessage(*event), &window);
	if (!isDown)
		_EndPress();
}


// Every view with a pointer mask hears first, then the view that was left, then the one entered.
void
WindowInternals::_RouteMove(BMessage* message)
{
	const std::unique_ptr<BMessage> event(message);
	const bool elsewhere = event->GetBool(kPointerElsewhere, false);
	BView* view = elsewhere ? nullptr : owner_of(tree.ViewAt(event->FindPoint("where")));
	if (view == mouseView && _IsStale(*event))
		return;
	if (server != nullptr)
		server->BeginInput(*event);
	_NotePointer(*event);

	const bool changed = view != mouseView;
	const bool drags = event->HasInt32("_msg_what_");
	const bool otherCursor = changed || drags != dragOver;
	dragOver = drags;
	leftView = changed ? mouseView : nullptr;
	mouseView = view;
	enteredView = changed ? view : nullptr;
	if (otherCursor)
		ApplyCursor();
	if (rectTracker != nullptr)
		ViewPrivate(rectTracker).TrackRect(lastScreen);
	tips.PointerMoved(view, lastScreen, lastButtons == 0 && !drags);

	bool delivered = _DeliverToMasks(*event, view, true);
	if (leftView != nullptr && !has_mask(leftView, B_POINTER_EVENTS)) {
		_DeliverPointer(*event, leftView, B_EXITED_VIEW);
		delivered = true;
	}
	// Hooks may have taken the view out, or have moved the pointer on by a nested loop.
	if (mouseView != nullptr && mouseView == view && !has_mask(view, B_POINTER_EVENTS)) {
		_DeliverPointer(*event, view, transit(enteredView != view, true));
		delivered = true;
	}
	leftView = enteredView = nullptr;
	if (!delivered && !elsewhere)
		_Deliver(new BMessage(*event), &window);
}


// Returns whether any view has got the message.
bool
WindowInternals::_DeliverToMasks(const BMessage& event, BView* under, bool isMove)
{
	if (eventMaskViews.empty())
		return false;
	bool delivered = false;
	// Hooks change masks and take views out.
	const std::vector<BView*> views = eventMaskViews;
	for (BView* view : views) {
		const bool still =
			std::find(eventMaskViews.begin(), eventMaskViews.end(), view) != eventMaskViews.end();
		if (!still || !has_mask(view, B_POINTER_EVENTS))
			continue;
		if (isMove && (pointer_options(view) & B_NO_POINTER_HISTORY) != 0 && _NewerMoveWaits())
			continue;
		int32 how = -1;
		if (isMove) {
			const bool wasInside = view == leftView || (view == under && view != enteredView);
			how = transit(wasInside, view == under);
		}
		_DeliverPointer(event, view, how);
		delivered = true;
	}
	return delivered;
}


// A copy for one view: the place in its coordinates, and the transit if there is one.
void
WindowInternals::_DeliverPointer(const BMessage& event, BView* view, int32 how)
{
	auto copy = new BMessage(event);
	copy->RemoveName(kPointerElsewhere);
	const BPoint where = event.FindPoint("where") - ViewPrivate(view).Node()->Origin();
	if (how >= 0)
		copy->AddInt32(kTransit, how);
	else
		copy->ReplacePoint("where", where);
	copy->AddPoint(kViewWhere, where);
	_Deliver(copy, view);
}


bool
WindowInternals::_NewerMoveWaits()
{
	bool waits = false;
	LooperPrivate(&window).TakeMessage([&waits](const BMessage& message) {
		waits = waits || message.what == B_MOUSE_MOVED;
		return false;
	});
	return waits;
}


// An old movement inside of one view is left out, unless somebody wants them all.
bool
WindowInternals::_IsStale(const BMessage& event)
{
	if (system_time() - event.GetInt64("when", 0) < kStaleMove)
		return false;
	for (const BView* view : eventMaskViews) {
		if ((pointer_options(view) & B_FULL_POINTER_HISTORY) != 0)
			return false;
	}
	return _NewerMoveWaits();
}


void
WindowInternals::_RouteWheel(BMessage* message)
{
	tips.Dismiss();
	BPoint where;
	BView* view = mouseView;
	if (message->FindPoint("where", &where) == B_OK)
		view = owner_of(tree.ViewAt(where));
	_Deliver(message, view != nullptr ? static_cast<BHandler*>(view) : &window);
}


// #pragma mark - polling


bool
WindowInternals::TakePointer(BPoint* _screen, uint32* _buttons)
{
	const std::unique_ptr<BMessage> message(
		LooperPrivate(&window).TakeMessage([](const BMessage& message) {
			return message.what == B_MOUSE_MOVED || message.what == B_MOUSE_UP;
		}));
	if (message == nullptr)
		return false;
	server->BeginInput(*message);
	_NotePointer(*message);
	if (message->what == B_MOUSE_UP)
		_EndPress();
	*_screen = lastScreen;
	*_buttons = lastButtons;
	return true;
}


// During a press everything comes as a message, so the last one tells, and what the desktop knows
// already comes in its turn. Without one for a while there is none, as after a drag.
void
WindowInternals::GetPointer(BPoint* _screen, uint32* _buttons)
{
	Desktop::Get()->GetMouse(_screen, _buttons);
	if (!pressed)
		return;
	if (*_buttons == 0) {
		// The desktop knows of a release just before its message is here.
		if (!TakePointer(_screen, _buttons)) {
			LooperPrivate(&window).WaitForMessage(kReleaseDelay);
			TakePointer(_screen, _buttons);
		}
		return;
	}
	*_screen = lastScreen;
	*_buttons = lastButtons;
}


void
WindowInternals::_NotePointer(const BMessage& message)
{
	lastScreen = message.FindPoint("screen_where");
	lastButtons =
		message.what == B_MOUSE_UP ? 0 : static_cast<uint32>(message.GetInt32("buttons", 0));
}


// #pragma mark - event masks


void
WindowInternals::EventMaskChanged(BView* view)
{
	const bool wanted = has_mask(view, ~0u);
	const auto found = std::find(eventMaskViews.begin(), eventMaskViews.end(), view);
	if (wanted && found == eventMaskViews.end())
		eventMaskViews.push_back(view);
	else if (!wanted && found != eventMaskViews.end())
		eventMaskViews.erase(found);
	_UpdatePointerWish();
}


void
WindowInternals::_EndPress()
{
	pressed = false;
	const std::vector<BView*> views = eventMaskViews;
	for (BView* view : views) {
		ViewExtras* extras = ViewPrivate(view).Extras();
		extras->mouseEventMask = 0;
		extras->mouseEventOptions = 0;
		EventMaskChanged(view);
	}
}


void
WindowInternals::_UpdatePointerWish()
{
	if (server == nullptr)
		return;
	const bool wants = std::any_of(eventMaskViews.begin(), eventMaskViews.end(),
		[](const BView* view) { return has_mask(view, B_POINTER_EVENTS); });
	if (wants != wantsAllPointer) {
		wantsAllPointer = wants;
		server->SetWantsAllPointerEvents(wants);
	}
}


// #pragma mark - drops


// The dragged message arrives under its own code. Its target is found now: the view that was under
// the pointer may have gone meanwhile.
void
WindowInternals::_RouteDrop(BMessage* message)
{
	const BPoint where = window.ConvertFromScreen(message->FindPoint("_drop_point_"));
	message->what = static_cast<uint32>(message->FindInt32("_original_what"));
	message->RemoveName("_original_what");
	const Delivery* delivery = Delivery::Find(*message);
	mark_as_dropped(message, delivery != nullptr ? delivery->replyTo : BMessenger());
	BView* view = owner_of(tree.ViewAt(where));
	_Deliver(message, view != nullptr ? static_cast<BHandler*>(view) : &window);
}
