#include <Button.h>

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::is_revived;
using BPrivate::LabelMetrics;

namespace {

constexpr float kMinimumWidth = 75;
constexpr float kLabelPadding = 20;
constexpr float kVerticalPadding = 12;
constexpr float kDefaultGrowth = 2 * Look::kDefaultButtonInset;
constexpr bigtime_t kFlashTime = 50000;

} // namespace


BButton::BButton(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags),
	fIsDefault(false)
{
}


BButton::BButton(BMessage* archive) : BControl(archive), fIsDefault(false)
{
	bool isDefault;
	if (archive->FindBool("_default", &isDefault) == B_OK)
		fIsDefault = isDefault;
}


BButton::~BButton()
{
}


BArchivable*
BButton::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BButton") ? new BButton(archive) : NULL;
}


status_t
BButton::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BControl::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	writer.Bool("_default", fIsDefault, false, fIsDefault);
	return writer.Status();
}


// #pragma mark - drawing


void
BButton::Draw(BRect updateRect)
{
	const BRect bounds = Bounds();
	const rgb_color base = Look::BaseColor(this);
	const bool pressed = Value() != B_CONTROL_OFF;
	const uint32 state = (IsEnabled() ? Look::kNormal : Look::kDisabled)
		| (pressed ? Look::kPressed : Look::kNormal)
		| (fIsDefault ? Look::kDefault : Look::kNormal);
	Look::DrawButton(this, bounds, base, state);
	if (Label() == NULL)
		return;

	const float width = StringWidth(Label());
	const float left = std::floor(bounds.left + (bounds.Width() - width) / 2 + 0.5f);
	const float baseline =
		BPrivate::centered_baseline(LabelMetrics(this), bounds.top, bounds.bottom);

	const rgb_color color = HighColor();
	const rgb_color low = LowColor();
	if (pressed && IsEnabled()) {
		SetHighColor(255, 255, 255);
		SetLowColor(0, 0, 0);
	} else
		SetLowColor(tint_color(base, B_LIGHTEN_2_TINT));
	BPrivate::draw_label(this, Label(), BPoint(left, baseline), IsEnabled());
	SetHighColor(color);
	SetLowColor(low);

	if (IsFocus() && IsEnabled() && Window()->IsActive())
		Look::DrawFocusLine(this, left, left + std::ceil(width) - 1, baseline);
}


// #pragma mark - mouse and keys


void
BButton::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;

	SetValue(B_CONTROL_ON);
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
}


void
BButton::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (IsTracking())
		SetValue(Bounds().Contains(where) ? B_CONTROL_ON : B_CONTROL_OFF);
}


void
BButton::MouseUp(BPoint where)
{
	if (!IsTracking())
		return;

	SetTracking(false);
	SetValue(B_CONTROL_OFF);
	if (Bounds().Contains(where))
		Invoke();
}


void
BButton::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes == 1 && (bytes[0] == B_ENTER || bytes[0] == B_SPACE)) {
		if (IsEnabled()) {
			_Flash();
			Invoke();
		}
		return;
	}
	BControl::KeyDown(bytes, numBytes);
}


// Long enough to be seen, then the button looks as before.
void
BButton::_Flash()
{
	if (Window() == NULL || IsTracking())
		return;
	SetValue(B_CONTROL_ON);
	Window()->UpdateIfNeeded();
	snooze(kFlashTime);
	SetValue(B_CONTROL_OFF);
}


// #pragma mark - hooks


void
BButton::AttachedToWindow()
{
	BControl::AttachedToWindow();

	if (!is_revived(this)) {
		float height;
		GetPreferredSize(NULL, &height);
		if (Bounds().Height() < height)
			ResizeTo(Bounds().Width(), height);
		if (fIsDefault)
			Window()->SetDefaultButton(this);
	} else if (fIsDefault && Window()->DefaultButton() == NULL) {
		// Where there is one already, both keep the flag and the frame that they were archived
		// with.
		Window()->SetDefaultButton(this);
	}
}


void
BButton::DetachedFromWindow()
{
	if (IsTracking())
		SetValueNoUpdate(B_CONTROL_OFF);
	BControl::DetachedFromWindow();
}


void
BButton::AllAttached()
{
	BControl::AllAttached();
}


void
BButton::AllDetached()
{
	BControl::AllDetached();
}


void
BButton::MessageReceived(BMessage* message)
{
	BControl::MessageReceived(message);
}


void
BButton::WindowActivated(bool active)
{
	BControl::WindowActivated(active);
}


void
BButton::FrameMoved(BPoint newPosition)
{
	BControl::FrameMoved(newPosition);
}


void
BButton::FrameResized(float newWidth, float newHeight)
{
	// The whole picture depends on the size, also where B_FULL_UPDATE_ON_RESIZE was not asked for.
	Invalidate();
	BControl::FrameResized(newWidth, newHeight);
}


void
BButton::MakeFocus(bool focused)
{
	BControl::MakeFocus(focused);
}


// #pragma mark - properties


void
BButton::MakeDefault(bool flag)
{
	BWindow* window = Window();
	const bool isWindowsDefault = window != NULL && window->DefaultButton() == this;

	if (flag) {
		if (!fIsDefault) {
			fIsDefault = true;
			ResizeBy(kDefaultGrowth, kDefaultGrowth);
			MoveBy(-Look::kDefaultButtonInset, -Look::kDefaultButtonInset);
			Invalidate();
		}
		if (window != NULL && !isWindowsDefault)
			window->SetDefaultButton(this);
		return;
	}

	if (!fIsDefault)
		return;
	fIsDefault = false;
	ResizeBy(-kDefaultGrowth, -kDefaultGrowth);
	MoveBy(Look::kDefaultButtonInset, Look::kDefaultButtonInset);
	Invalidate();
	if (isWindowsDefault)
		window->SetDefaultButton(NULL);
}


bool
BButton::IsDefault() const
{
	return fIsDefault;
}


void
BButton::SetLabel(const char* label)
{
	BControl::SetLabel(label);
}


void
BButton::SetValue(int32 value)
{
	BControl::SetValue(value);
}


void
BButton::SetEnabled(bool enabled)
{
	BControl::SetEnabled(enabled);
}


void
BButton::GetPreferredSize(float* _width, float* _height)
{
	const float growth = fIsDefault ? kDefaultGrowth : 0;
	if (_width != NULL) {
		*_width =
			std::max(kMinimumWidth, kLabelPadding + BPrivate::label_width(this, Label())) + growth;
	}
	if (_height != NULL)
		*_height = LabelMetrics(this).lineHeight + kVerticalPadding + growth;
}


void
BButton::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


// #pragma mark - invocation and scripting


status_t
BButton::Invoke(BMessage* message)
{
	return BControl::Invoke(message);
}


BHandler*
BButton::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BControl::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BButton::GetSupportedSuites(BMessage* message)
{
	return BControl::GetSupportedSuites(message);
}


status_t
BButton::Perform(perform_code code, void* data)
{
	return BControl::Perform(code, data);
}
