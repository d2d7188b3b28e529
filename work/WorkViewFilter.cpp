#include "work/WorkViewFilter.h"

#include <AppDefs.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "archive/EditorCodes.h"
#include "archive/ViewDrag.h"
#include "archive/ViewTree.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkView.h"

namespace {


constexpr uint32 kWindowUpdate = '_UPD'; // the platform's redraw message, without a public name


bool
IsDropCode(uint32 what)
{
	return what == kDroppedView || what == kDroppedProperty || what == B_SIMPLE_DATA;
}


bool
IsKey(uint32 what)
{
	return what == B_KEY_DOWN || what == B_KEY_UP;
}


bool
IsOfInterest(uint32 what)
{
	return what == B_MOUSE_DOWN || what == B_MOUSE_MOVED || what == kWindowUpdate || IsKey(what)
		|| IsDropCode(what);
}


// Whether the place, in the view's coordinates, shows the view and no other.
bool
IsUnderPointer(BView* view, BPoint where)
{
	BWindow* window = view->Window();
	return window->FindView(window->ConvertFromScreen(view->ConvertToScreen(where))) == view;
}


// Whether the view hears of a press or a key only because its archive asks for all of them.
bool
Overhears(const BMessage* message, BView* view)
{
	if (IsKey(message->what))
		return (view->EventMask() & B_KEYBOARD_EVENTS) != 0 && !view->IsFocus();

	BPoint where;
	return (view->EventMask() & B_POINTER_EVENTS) != 0
		&& message->FindPoint("where", &where) == B_OK
		&& !IsUnderPointer(view, where);
}


// Whether the pointer just came over the view with something that the work view takes.
bool
EntersWithDrag(const BMessage* message)
{
	int32 transit, draggedCode;
	return message->FindInt32("be:transit", &transit) == B_OK && transit == B_ENTERED_VIEW
		&& message->FindInt32("_msg_what_", &draggedCode) == B_OK
		&& IsDropCode(static_cast<uint32>(draggedCode));
}


// What is dragged from the desktop has the desktop's pointer.
void
FollowDragPointer(const BMessage* message, bool overDesign)
{
	BMessage dragged;
	if (message->FindMessage("be:drag_message", &dragged) != B_OK) {
		EndDragPointer();
		return;
	}
	int32 transit;
	if (overDesign && dragged.HasMessage(kDroppedViewField)
		&& message->FindInt32("be:transit", &transit) == B_OK)
		ShowDragPointer(transit == B_ENTERED_VIEW || transit == B_INSIDE_VIEW);
}


filter_result
FilterPress(WorkView* workView, BMessage* message, BView* view)
{
	int32 buttons = 0;
	int32 modifiers = 0;
	message->FindInt32("buttons", &buttons);
	message->FindInt32("modifiers", &modifiers);
	if ((buttons & B_PRIMARY_MOUSE_BUTTON) == 0)
		return B_DISPATCH_MESSAGE;

	workView->HandleFilteredMouse(message, view, modifiers);
	return B_SKIP_MESSAGE;
}


} // namespace


filter_result
WorkViewFilter(BMessage* message, BHandler** target, BMessageFilter* filter)
{
	if (!IsOfInterest(message->what))
		return B_DISPATCH_MESSAGE;

	BWindow* window = dynamic_cast<BWindow*>(filter->Looper());
	WorkView* workView =
		window != nullptr ? dynamic_cast<WorkView*>(window->FindView("WorkView")) : nullptr;
	if (workView == nullptr)
		return B_DISPATCH_MESSAGE;

	if (message->what == kWindowUpdate) {
		workView->PostHiliteRedraw();
		return B_DISPATCH_MESSAGE;
	}

	BView* view = dynamic_cast<BView*>(*target);
	const bool overDesign = LiveViewAttached(workView->Container(), view) != nullptr;
	if (message->what == B_MOUSE_MOVED)
		FollowDragPointer(message, overDesign);
	if (!overDesign)
		return B_DISPATCH_MESSAGE;

	if (IsDropCode(message->what)) {
		workView->HandleFilteredDrop(message, view);
		return B_SKIP_MESSAGE;
	}
	if (view == workView->Container())
		return B_DISPATCH_MESSAGE;

	if (message->what == B_MOUSE_DOWN || IsKey(message->what)) {
		if (Overhears(message, view))
			return B_SKIP_MESSAGE;
	}
	if (message->what == B_MOUSE_DOWN)
		return FilterPress(workView, message, view);

	if (message->what == B_MOUSE_MOVED && EntersWithDrag(message)) {
		workView->SetSelectedView(view);
		return B_SKIP_MESSAGE;
	}
	return B_DISPATCH_MESSAGE;
}
