#include <PictureButton.h>

#include <cmath>

#include <Message.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;


BPictureButton::BPictureButton(BRect frame, const char* name, BMessage* message, uint32 behavior,
	uint32 resizingMode, uint32 flags) :
	BControl(frame, name, NULL, message, resizingMode, flags),
	fBehavior(behavior), fPressed(false)
{
}


BPictureButton::BPictureButton(BMessage* archive) :
	BControl(archive), fBehavior(B_ONE_STATE_BUTTON), fPressed(false)
{
	// The pictures' own fields are never looked up, and so come out as they came in.
	int32 behavior;
	if (archive->FindInt32("_behave", &behavior) == B_OK)
		fBehavior = static_cast<uint32>(behavior);
}


BPictureButton::~BPictureButton()
{
}


BArchivable*
BPictureButton::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BPictureButton") ? new BPictureButton(archive) : NULL;
}


status_t
BPictureButton::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BControl::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	writer.Int32("_behave", static_cast<int32>(fBehavior), B_ONE_STATE_BUTTON);
	return writer.Status();
}


void
BPictureButton::Draw(BRect updateRect)
{
	const BRect bounds = Bounds();
	const bool down = fPressed || Value() != B_CONTROL_OFF;
	Look::DrawRaised(this, bounds, Look::BaseColor(this),
		(IsEnabled() ? Look::kNormal : Look::kDisabled) | (down ? Look::kPressed : Look::kNormal));
	if (Label() != NULL) {
		const float left = std::floor((bounds.Width() + 1 - StringWidth(Label())) / 2);
		const float baseline =
			BPrivate::centered_baseline(BPrivate::LabelMetrics(this), bounds.top, bounds.bottom);
		BPrivate::draw_label(this, Label(), BPoint(left, baseline), IsEnabled());
	}
	if (IsFocus() && IsEnabled() && Window()->IsActive()) {
		BRect ring = bounds;
		ring.InsetBy(2, 2);
		Look::DrawRing(this, ring, Look::NavigationColor(), Look::NavigationColor());
	}
}


void
BPictureButton::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;
	fPressed = true;
	Invalidate();
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
}


void
BPictureButton::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (!IsTracking() || fPressed == Bounds().Contains(where))
		return;
	fPressed = !fPressed;
	Invalidate();
}


void
BPictureButton::MouseUp(BPoint where)
{
	if (!IsTracking())
		return;
	SetTracking(false);
	fPressed = false;
	Invalidate();
	if (Bounds().Contains(where))
		_Activate();
}


void
BPictureButton::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		_Activate();
		return;
	}
	BControl::KeyDown(bytes, numBytes);
}


// A button with two states switches; one with a single state is back at once.
void
BPictureButton::_Activate()
{
	if (fBehavior == B_TWO_STATE_BUTTON) {
		SetValue(Value() == B_CONTROL_ON ? B_CONTROL_OFF : B_CONTROL_ON);
		Invoke();
		return;
	}
	SetValue(B_CONTROL_ON);
	Invoke();
	SetValue(B_CONTROL_OFF);
}


void
BPictureButton::GetPreferredSize(float* _width, float* _height)
{
	BControl::GetPreferredSize(_width, _height);
}


void
BPictureButton::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


void
BPictureButton::SetBehavior(uint32 behavior)
{
	fBehavior = behavior;
}


uint32
BPictureButton::Behavior() const
{
	return fBehavior;
}
