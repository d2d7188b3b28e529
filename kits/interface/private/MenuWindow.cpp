#include "interface/private/MenuWindow.h"

#include <Message.h>

#include "interface/private/Look.h"
#include "interface/private/MenuTracker.h"
#include "server/ServerWindow.h"

namespace BPrivate {

namespace {

constexpr float kParkingPlace = -2000; // both coordinates

} // namespace


MenuFrame::MenuFrame(BRect frame, MenuTracker& tracker) :
	BView(frame, "menu frame", B_FOLLOW_ALL, B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE),
	fTracker(tracker)
{
	SetViewColor(Look::MenuColor());
	SetLowColor(Look::MenuColor());
}


void
MenuFrame::AttachedToWindow()
{
	BView::AttachedToWindow();
	SetEventMask(B_POINTER_EVENTS, B_NO_POINTER_HISTORY);
	MakeFocus(true);
}


void
MenuFrame::Draw(BRect)
{
	const BRect bounds = Bounds();
	Look::DrawMenuFrame(this, bounds, LowColor());
	if (!fHasArrows)
		return;
	BRect band = bounds.InsetByCopy(MenuWindow::kBorder, MenuWindow::kBorder);
	const auto color = [](bool enabled) {
		return Look::TextColor(enabled ? Look::kNormal : Look::kDisabled);
	};
	BRect upper = band;
	upper.bottom = upper.top + MenuWindow::kArrowHeight - 1;
	Look::DrawArrow(this, upper, Look::Direction::kUp, color(fCanScrollUp));
	BRect lower = band;
	lower.top = lower.bottom - MenuWindow::kArrowHeight + 1;
	Look::DrawArrow(this, lower, Look::Direction::kDown, color(fCanScrollDown));
}


void
MenuFrame::SetArrows(bool shown, bool canScrollUp, bool canScrollDown)
{
	if (fHasArrows == shown && fCanScrollUp == canScrollUp && fCanScrollDown == canScrollDown)
		return;
	fHasArrows = shown;
	fCanScrollUp = canScrollUp;
	fCanScrollDown = canScrollDown;
	Invalidate();
}


void
MenuFrame::MouseDown(BPoint)
{
	BPoint screen;
	if (_IsFirst() && _GetScreenPoint(&screen))
		fTracker.MouseDown(screen);
}


void
MenuFrame::MouseUp(BPoint)
{
	BPoint screen;
	if (!_IsFirst() || !_GetScreenPoint(&screen))
		return;
	int64 when;
	if (Window()->CurrentMessage()->FindInt64("when", &when) != B_OK)
		when = system_time();
	fTracker.MouseUp(screen, when);
}


void
MenuFrame::MouseMoved(BPoint, uint32, const BMessage*)
{
	BPoint screen;
	if (_IsFirst() && _GetScreenPoint(&screen))
		fTracker.MouseMoved(screen);
}


// The keys come to the menu that was opened last.
void
MenuFrame::KeyDown(const char* bytes, int32 numBytes)
{
	const BMessage* message = Window()->CurrentMessage();
	if (message == NULL)
		return;
	if (_IsFirst())
		fTracker.KeyDown(*message, bytes, numBytes);
	else
		fTracker.Forward(*message);
}


bool
MenuFrame::_GetScreenPoint(BPoint* _point) const
{
	const BMessage* message = Window()->CurrentMessage();
	return message != NULL && message->FindPoint("screen_where", _point) == B_OK;
}


bool
MenuFrame::_IsFirst() const
{
	return fTracker.IsFirst(static_cast<MenuWindow*>(Window()));
}


// #pragma mark - MenuWindow


MenuWindow::MenuWindow(std::shared_ptr<MenuTracker> tracker, BRect frame) :
	BWindow(frame, "menu", B_NO_BORDER_WINDOW_LOOK, static_cast<window_feel>(kMenuWindowFeel),
		B_NOT_MOVABLE | B_NOT_RESIZABLE | B_NOT_CLOSABLE | B_NOT_ZOOMABLE | B_NOT_MINIMIZABLE
			| B_AVOID_FOCUS | B_WILL_ACCEPT_FIRST_CLICK | B_ASYNCHRONOUS_CONTROLS),
	fTracker(std::move(tracker))
{
	fFrame = new MenuFrame(Bounds(), *fTracker);
	AddChild(fFrame);
}


// Only the tracker ends it.
bool
MenuWindow::QuitRequested()
{
	return fMayQuit;
}


void
MenuWindow::MessageReceived(BMessage* message)
{
	if (fTracker->IsFirst(this))
		fTracker->MessageReceived(message);
	else
		BWindow::MessageReceived(message);
}


void
MenuWindow::Park()
{
	MoveTo(kParkingPlace, kParkingPlace);
	ResizeTo(1, 1);
}


} // namespace BPrivate
