#include <MarkedControl.h>

#include <algorithm>

#include <Message.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"

namespace Look = BPrivate::Look;

using BPrivate::LabelMetrics;

namespace {

const BPoint kMarkPlace(1, 3);
constexpr float kLabelLeft = 20;
constexpr float kClosestLabelLeft = 16; // where the label would be cut otherwise
constexpr float kHorizontalPadding = 22;
constexpr float kVerticalPadding = 6;


// In the middle of the mark.
float
LabelBaseline(const LabelMetrics& metrics)
{
	return BPrivate::centered_baseline(
		metrics, kMarkPlace.y, kMarkPlace.y + Look::kCheckBoxSize - 1);
}

} // namespace


_BMarkedControl_::_BMarkedControl_(BRect frame, const char* name, const char* label,
	BMessage* message, uint32 resizingMode, uint32 flags) :
	_BPressControl_(frame, name, label, message, resizingMode, flags)
{
	// Never less high than its mark and its label.
	const LabelMetrics metrics(this);
	const float height =
		std::max(kMarkPlace.y + Look::kCheckBoxSize, LabelBaseline(metrics) + metrics.descent);
	if (Bounds().Height() < height)
		ResizeTo(Bounds().Width(), height);
}


_BMarkedControl_::_BMarkedControl_(BMessage* archive) : _BPressControl_(archive)
{
}


_BMarkedControl_::~_BMarkedControl_()
{
}


void
_BMarkedControl_::Draw(BRect updateRect)
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (IsPressed())
		state |= Look::kPressed;
	if (Value() == B_CONTROL_PARTIALLY_ON)
		state |= Look::kPartlyOn;
	else if (Value() != B_CONTROL_OFF)
		state |= Look::kOn;
	DrawMark(kMarkPlace, Look::BaseColor(this), state);
	if (Label() == NULL)
		return;

	const float baseline = LabelBaseline(LabelMetrics(this));
	const float width = BPrivate::label_width(this, Label());
	const float left = std::clamp(Bounds().right + 1 - width, kClosestLabelLeft, kLabelLeft);
	BPrivate::draw_label(this, Label(), BPoint(left, baseline), IsEnabled());
	if (IsFocus() && IsEnabled() && Window()->IsActive())
		Look::DrawFocusLine(this, left, left + width - 1, baseline);
}


void
_BMarkedControl_::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL)
		*_width = kHorizontalPadding + BPrivate::label_width(this, Label());
	if (_height != NULL)
		*_height = LabelMetrics(this).lineHeight + kVerticalPadding;
}
