// BWindow: what derived windows override, and what comes to a window as input.
#include <Window.h>

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Application.h>
#include <Button.h>
#include <MenuBar.h>
#include <Message.h>
#include <MessageQueue.h>
#include <Screen.h>

#include "app/private/LooperPrivate.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/ViewInspector.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewScripting.h"
#include "interface/private/WindowInternals.h"

using namespace BPrivate;


void
BWindow::MessageReceived(BMessage* message)
{
	const bool asks = message->what == B_GET_PROPERTY || message->what == B_SET_PROPERTY
		|| message->what == B_COUNT_PROPERTIES;
	if (!asks || !handle_window_property(this, message))
		BLooper::MessageReceived(message);
}


void
BWindow::FrameMoved(BPoint newPosition)
{
}


void
BWindow::FrameResized(float newWidth, float newHeight)
{
}


void
BWindow::WorkspacesChanged(uint32 oldWorkspaces, uint32 newWorkspaces)
{
}


void
BWindow::WorkspaceActivated(int32 workspace, bool state)
{
}


void
BWindow::WindowActivated(bool active)
{
}


void
BWindow::ScreenChanged(BRect screenSize, color_space format)
{
}


void
BWindow::MenusBeginning()
{
}


void
BWindow::MenusEnded()
{
}


void
BWindow::Zoom(BPoint leftTop, float width, float height)
{
	MoveTo(leftTop);
	ResizeTo(width, height);
}


// The largest frame that the limits and the screen allow, and back to the one before.
void
BWindow::Zoom()
{
	const BRect now = Frame();
	if (fInternals->beforeZoom.IsValid()) {
		const BRect before = fInternals->beforeZoom;
		fInternals->beforeZoom = BRect();
		Zoom(before.LeftTop(), before.Width(), before.Height());
		return;
	}
	fInternals->beforeZoom = now;
	const BRect screen = BScreen(this).Frame();
	const float width =
		std::min({ screen.Width(), fInternals->maxWidth, fInternals->zoomMaxWidth });
	const float height =
		std::min({ screen.Height(), fInternals->maxHeight, fInternals->zoomMaxHeight });
	const BPoint leftTop(
		std::min(now.left, screen.right - width), std::min(now.top, screen.bottom - height));
	Zoom(leftTop, width, height);
}


void
BWindow::SetZoomLimits(float maxWidth, float maxHeight)
{
	fInternals->zoomMaxWidth = maxWidth;
	fInternals->zoomMaxHeight = maxHeight;
}


// #pragma mark - input


void
BWindow::SetPulseRate(bigtime_t rate)
{
	if (rate < 0 || rate == fInternals->pulseRate)
		return;
	fInternals->pulseRate = rate;
	fInternals->UpdatePulse();
}


bigtime_t
BWindow::PulseRate() const
{
	return fInternals->pulseRate;
}


void
BWindow::AddShortcut(uint32 key, uint32 modifiers, BMessage* message)
{
	fInternals->AddShortcut(key, modifiers, message, nullptr, false);
}


void
BWindow::AddShortcut(uint32 key, uint32 modifiers, BMessage* message, BHandler* target)
{
	fInternals->AddShortcut(key, modifiers, message, target, true);
}


void
BWindow::RemoveShortcut(uint32 key, uint32 modifiers)
{
	fInternals->RemoveShortcut(key, modifiers);
}


void
BWindow::SetDefaultButton(BButton* button)
{
	BButton* previous = fInternals->defaultButton;
	if (previous == button)
		return;
	// The pointer changes first: MakeDefault() calls back.
	fInternals->defaultButton = button;
	fInternals->defaultButtonView = button;
	if (previous != nullptr) {
		previous->MakeDefault(false);
		previous->Invalidate();
	}
	if (button != nullptr) {
		button->MakeDefault(true);
		button->Invalidate();
	}
}


BButton*
BWindow::DefaultButton() const
{
	return fInternals->defaultButton;
}


void
BWindow::SetKeyMenuBar(BMenuBar* bar)
{
	fInternals->keyMenuBar = bar;
	fInternals->keyMenuBarView = bar;
}


BMenuBar*
BWindow::KeyMenuBar() const
{
	return fInternals->keyMenuBar;
}
