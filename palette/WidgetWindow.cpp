#include "palette/WidgetWindow.h"

#include <AppDefs.h>
#include <Message.h>
#include <ScrollView.h>

#include "archive/ViewDrag.h"
#include "palette/WidgetListView.h"

namespace {


constexpr float kWidth = 200;
constexpr float kHeight = 280;
constexpr float kScrollBarSize = 14;
constexpr float kMinHeight = 201;
constexpr float kMaxHeight = 600;
constexpr uint32 kWindowFlags = B_ASYNCHRONOUS_CONTROLS | B_AVOID_FOCUS | B_NOT_ZOOMABLE
	| B_NOT_CLOSABLE | B_WILL_ACCEPT_FIRST_CLICK;


} // namespace


int32 widgetWindowCount = 0;
WidgetWindow* widgetWindow = nullptr;


WidgetWindow::WidgetWindow(BPoint leftTop) :
	BWindow(BRect(leftTop.x, leftTop.y, leftTop.x + kWidth, leftTop.y + kHeight), "Widgets",
		B_FLOATING_WINDOW_LOOK, B_FLOATING_APP_WINDOW_FEEL, kWindowFlags)
{
	SetSizeLimits(kWidth, kWidth, kMinHeight, kMaxHeight);

	BRect frame = Bounds();
	frame.right -= kScrollBarSize;
	AddChild(new BScrollView(
		"", new WidgetListView(frame, ""), B_FOLLOW_ALL_SIDES, 0, false, true, B_FANCY_BORDER));
}


void
WidgetWindow::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_COPY_TARGET:
			WriteDraggedView(message);
			break;
		case B_TRASH_TARGET:
			break;
		default:
			BWindow::MessageReceived(message);
	}
}
