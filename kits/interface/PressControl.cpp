#include <PressControl.h>

#include <Message.h>
#include <Window.h>


_BPressControl_::_BPressControl_(BRect frame, const char* name, const char* label,
	BMessage* message, uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags),
	fPressed(false)
{
}


_BPressControl_::_BPressControl_(BMessage* archive) : BControl(archive), fPressed(false)
{
}


_BPressControl_::~_BPressControl_()
{
}


void
_BPressControl_::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;

	fPressed = true;
	Invalidate();
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
}


void
_BPressControl_::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (!IsTracking() || fPressed == Bounds().Contains(where))
		return;
	fPressed = !fPressed;
	Invalidate();
}


void
_BPressControl_::MouseUp(BPoint where)
{
	if (!IsTracking())
		return;

	SetTracking(false);
	if (fPressed) {
		fPressed = false;
		Invalidate();
	}
	if (Bounds().Contains(where))
		Choose();
}


void
_BPressControl_::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		Choose();
		return;
	}
	BControl::KeyDown(bytes, numBytes);
}


void
_BPressControl_::DetachedFromWindow()
{
	fPressed = false;
	BControl::DetachedFromWindow();
}
