#include "work/WorkViewFilter.h"

#include <AppDefs.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "archive/EditorCodes.h"
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
IsOfInterest(uint32 what)
{
	return what == B_MOUSE_DOWN || what == B_MOUSE_MOVED || what == kWindowUpdate
		|| IsDropCode(what);
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
	if (LiveViewAttached(workView->Container(), view) == nullptr)
		return B_DISPATCH_MESSAGE;

	if (IsDropCode(message->what)) {
		workView->HandleFilteredDrop(message, view);
		return B_SKIP_MESSAGE;
	}
	if (view == workView->Container())
		return B_DISPATCH_MESSAGE;

	if (message->what == B_MOUSE_DOWN)
		return FilterPress(workView, message, view);

	if (message->what == B_MOUSE_MOVED && EntersWithDrag(message)) {
		workView->SetSelectedView(view);
		return B_SKIP_MESSAGE;
	}
	return B_DISPATCH_MESSAGE;
}
