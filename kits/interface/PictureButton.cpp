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
	_BPressControl_(frame, name, NULL, message, resizingMode, flags),
	fBehavior(behavior)
{
}


BPictureButton::BPictureButton(BMessage* archive) :
	_BPressControl_(archive), fBehavior(B_ONE_STATE_BUTTON)
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
	const bool down = IsPressed() || Value() != B_CONTROL_OFF;
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


// A button with two states switches; one with a single state is back at once.
void
BPictureButton::Choose()
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
