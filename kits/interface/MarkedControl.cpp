#include <MarkedControl.h>

#include <Message.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"

namespace Look = BPrivate::Look;

using BPrivate::LabelMetrics;

namespace {

const BPoint kMarkPlace(1, 3);
constexpr float kLabelLeft = 20;
constexpr float kHorizontalPadding = 22;
constexpr float kVerticalPadding = 6;

} // namespace


_BMarkedControl_::_BMarkedControl_(BRect frame, const char* name, const char* label,
	BMessage* message, uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags),
	fPressed(false)
{
}


_BMarkedControl_::_BMarkedControl_(BMessage* archive) : BControl(archive), fPressed(false)
{
}


_BMarkedControl_::~_BMarkedControl_()
{
}


void
_BMarkedControl_::Draw(BRect updateRect)
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (fPressed)
		state |= Look::kPressed;
	if (Value() == B_CONTROL_PARTIALLY_ON)
		state |= Look::kPartlyOn;
	else if (Value() != B_CONTROL_OFF)
		state |= Look::kOn;
	DrawMark(kMarkPlace, Look::BaseColor(this), state);
	if (Label() == NULL)
		return;

	const float baseline = BPrivate::centered_baseline(
		LabelMetrics(this), kMarkPlace.y, kMarkPlace.y + Look::kCheckBoxSize - 1);
	BPrivate::draw_label(this, Label(), BPoint(kLabelLeft, baseline), IsEnabled());
	if (IsFocus() && IsEnabled() && Window()->IsActive()) {
		Look::DrawFocusLine(
			this, kLabelLeft, kLabelLeft + BPrivate::label_width(this, Label()) - 1, baseline);
	}
}


void
_BMarkedControl_::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;

	fPressed = true;
	Invalidate();
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
}


void
_BMarkedControl_::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (!IsTracking() || fPressed == Bounds().Contains(where))
		return;
	fPressed = !fPressed;
	Invalidate();
}


void
_BMarkedControl_::MouseUp(BPoint where)
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
_BMarkedControl_::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		Choose();
		return;
	}
	BControl::KeyDown(bytes, numBytes);
}


void
_BMarkedControl_::DetachedFromWindow()
{
	fPressed = false;
	BControl::DetachedFromWindow();
}


void
_BMarkedControl_::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL)
		*_width = kHorizontalPadding + BPrivate::label_width(this, Label());
	if (_height != NULL)
		*_height = LabelMetrics(this).lineHeight + kVerticalPadding;
}
