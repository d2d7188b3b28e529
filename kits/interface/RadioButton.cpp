#include <RadioButton.h>

#include <cmath>

#include <Box.h>
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

bool
IsLabelOfBox(const BView* view)
{
	const BBox* box = dynamic_cast<const BBox*>(view->Parent());
	return box != NULL && box->LabelView() == view;
}


// The first child of the view, or window, whose children are one group. A radio button that is
// the label of a box stands beside that box, not inside it.
BView*
FirstOfGroup(const BRadioButton* button)
{
	const BView* member = IsLabelOfBox(button) ? button->Parent() : button;
	if (const BView* parent = member->Parent())
		return parent->ChildAt(0);
	return member->Window() != NULL ? member->Window()->ChildAt(0) : NULL;
}


// The radio button that the child of the group's parent is, or has as its label.
BRadioButton*
AsGroupMember(BView* view)
{
	if (BBox* box = dynamic_cast<BBox*>(view))
		return dynamic_cast<BRadioButton*>(box->LabelView());
	return IsLabelOfBox(view) ? NULL : dynamic_cast<BRadioButton*>(view);
}

} // namespace


BRadioButton::BRadioButton(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags),
	fPressed(false)
{
}


BRadioButton::BRadioButton(BMessage* archive) : BControl(archive), fPressed(false)
{
}


BRadioButton::~BRadioButton()
{
}


BArchivable*
BRadioButton::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BRadioButton") ? new BRadioButton(archive) : NULL;
}


status_t
BRadioButton::Archive(BMessage* archive, bool deep) const
{
	return BControl::Archive(archive, deep);
}


void
BRadioButton::Draw(BRect updateRect)
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (fPressed)
		state |= Look::kPressed;
	if (Value() != B_CONTROL_OFF)
		state |= Look::kOn;
	Look::DrawRadioButton(this, kBoxPlace, Look::BaseColor(this), state);
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
BRadioButton::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;

	fPressed = true;
	Invalidate();
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
}


void
BRadioButton::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (!IsTracking() || fPressed == Bounds().Contains(where))
		return;
	fPressed = !fPressed;
	Invalidate();
}


void
BRadioButton::MouseUp(BPoint where)
{
	if (!IsTracking())
		return;

	SetTracking(false);
	if (fPressed) {
		fPressed = false;
		Invalidate();
	}
	if (Bounds().Contains(where))
		_Choose();
}


void
BRadioButton::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		_Choose();
		return;
	}
	BControl::KeyDown(bytes, numBytes);
}


void
BRadioButton::_Choose()
{
	if (Value() == B_CONTROL_ON)
		return;
	SetValue(B_CONTROL_ON);
	Invoke();
}


// #pragma mark - hooks


void
BRadioButton::AttachedToWindow()
{
	BControl::AttachedToWindow();
}


void
BRadioButton::DetachedFromWindow()
{
	fPressed = false;
	BControl::DetachedFromWindow();
}


void
BRadioButton::AllAttached()
{
	BControl::AllAttached();
}


void
BRadioButton::AllDetached()
{
	BControl::AllDetached();
}


void
BRadioButton::MessageReceived(BMessage* message)
{
	BControl::MessageReceived(message);
}


void
BRadioButton::WindowActivated(bool active)
{
	BControl::WindowActivated(active);
}


void
BRadioButton::FrameMoved(BPoint newPosition)
{
	BControl::FrameMoved(newPosition);
}


void
BRadioButton::FrameResized(float newWidth, float newHeight)
{
	BControl::FrameResized(newWidth, newHeight);
}


void
BRadioButton::MakeFocus(bool focused)
{
	BControl::MakeFocus(focused);
}


// #pragma mark - properties


void
BRadioButton::SetValue(int32 value)
{
	BControl::SetValue(value);
	if (value == B_CONTROL_OFF)
		return;

	for (BView* sibling = FirstOfGroup(this); sibling != NULL; sibling = sibling->NextSibling()) {
		BRadioButton* other = AsGroupMember(sibling);
		if (other != NULL && other != this)
			other->SetValue(B_CONTROL_OFF);
	}
}


void
BRadioButton::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL)
		*_width = kHorizontalPadding + BPrivate::label_width(this, Label());
	if (_height != NULL)
		*_height = LabelMetrics(this).lineHeight + kVerticalPadding;
}


void
BRadioButton::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


status_t
BRadioButton::Invoke(BMessage* message)
{
	return BControl::Invoke(message);
}


BHandler*
BRadioButton::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BControl::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BRadioButton::GetSupportedSuites(BMessage* message)
{
	return BControl::GetSupportedSuites(message);
}


status_t
BRadioButton::Perform(perform_code code, void* data)
{
	return BControl::Perform(code, data);
}
