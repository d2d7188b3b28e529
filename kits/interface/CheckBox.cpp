#include <CheckBox.h>

#include <cmath>

#include <Message.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::LabelMetrics;

namespace {

const BPoint kBoxPlace(1, 3);
constexpr float kLabelLeft = 20;
constexpr float kHorizontalPadding = 22;
constexpr float kVerticalPadding = 6;

} // namespace


BCheckBox::BCheckBox(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags),
	fPressed(false)
{
}


BCheckBox::BCheckBox(BMessage* archive) : BControl(archive), fPressed(false)
{
}


BCheckBox::~BCheckBox()
{
}


BArchivable*
BCheckBox::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BCheckBox") ? new BCheckBox(archive) : NULL;
}


status_t
BCheckBox::Archive(BMessage* archive, bool deep) const
{
	return BControl::Archive(archive, deep);
}


void
BCheckBox::Draw(BRect updateRect)
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (fPressed)
		state |= Look::kPressed;
	if (Value() == B_CONTROL_PARTIALLY_ON)
		state |= Look::kPartlyOn;
	else if (Value() != B_CONTROL_OFF)
		state |= Look::kOn;
	Look::DrawCheckBox(this, kBoxPlace, Look::BaseColor(this), state);
	if (Label() == NULL)
		return;

	const float baseline = BPrivate::centered_baseline(
		LabelMetrics(this), kBoxPlace.y, kBoxPlace.y + Look::kCheckBoxSize - 1);
	BPrivate::draw_label(this, Label(), BPoint(kLabelLeft, baseline), IsEnabled());
	if (IsFocus() && IsEnabled() && Window()->IsActive()) {
		Look::DrawFocusLine(
			this, kLabelLeft, kLabelLeft + BPrivate::label_width(this, Label()) - 1, baseline);
	}
}


// #pragma mark - mouse and keys


void
BCheckBox::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;

	fPressed = true;
	Invalidate();
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
}


void
BCheckBox::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (!IsTracking() || fPressed == Bounds().Contains(where))
		return;
	fPressed = !fPressed;
	Invalidate();
}


void
BCheckBox::MouseUp(BPoint where)
{
	if (!IsTracking())
		return;

	SetTracking(false);
	if (fPressed) {
		fPressed = false;
		Invalidate();
	}
	if (!Bounds().Contains(where))
		return;
	SetValue(Value() == B_CONTROL_ON ? B_CONTROL_OFF : B_CONTROL_ON);
	Invoke();
}


void
BCheckBox::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		SetValue(Value() == B_CONTROL_ON ? B_CONTROL_OFF : B_CONTROL_ON);
		Invoke();
		return;
	}
	BControl::KeyDown(bytes, numBytes);
}


// #pragma mark - hooks


void
BCheckBox::AttachedToWindow()
{
	BControl::AttachedToWindow();
}


void
BCheckBox::DetachedFromWindow()
{
	fPressed = false;
	BControl::DetachedFromWindow();
}


void
BCheckBox::AllAttached()
{
	BControl::AllAttached();
}


void
BCheckBox::AllDetached()
{
	BControl::AllDetached();
}


void
BCheckBox::MessageReceived(BMessage* message)
{
	BControl::MessageReceived(message);
}


void
BCheckBox::WindowActivated(bool active)
{
	BControl::WindowActivated(active);
}


void
BCheckBox::FrameMoved(BPoint newPosition)
{
	BControl::FrameMoved(newPosition);
}


void
BCheckBox::FrameResized(float newWidth, float newHeight)
{
	BControl::FrameResized(newWidth, newHeight);
}


void
BCheckBox::MakeFocus(bool focused)
{
	BControl::MakeFocus(focused);
}


// #pragma mark - properties


void
BCheckBox::SetValue(int32 value)
{
	BControl::SetValue(value);
}


void
BCheckBox::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL)
		*_width = kHorizontalPadding + BPrivate::label_width(this, Label());
	if (_height != NULL)
		*_height = LabelMetrics(this).lineHeight + kVerticalPadding;
}


void
BCheckBox::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


status_t
BCheckBox::Invoke(BMessage* message)
{
	return BControl::Invoke(message);
}


BHandler*
BCheckBox::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BControl::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BCheckBox::GetSupportedSuites(BMessage* message)
{
	return BControl::GetSupportedSuites(message);
}


status_t
BCheckBox::Perform(perform_code code, void* data)
{
	return BControl::Perform(code, data);
}
