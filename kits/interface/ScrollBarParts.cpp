// The parts of scroll bars: where they are, how they are used and drawn.
#include <ScrollBar.h>

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Message.h>
#include <MessageRunner.h>
#include <Messenger.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/ScrollBarPrivate.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewPrivate.h"

using namespace BPrivate;

namespace {

constexpr float kMinThumb = 14; // right - left of the smallest thumb


// An inactive window only shows its bars flat; they work all the same. One that never becomes active
// always shows what they are.
bool
shows_flat_bars(const BWindow* window)
{
	return window == nullptr || (!window->IsActive() && (window->Flags() & B_AVOID_FOCUS) == 0);
}

} // namespace


// #pragma mark - parts


bool
BScrollBar::_IsUsable() const
{
	return fMax > fMin && fProportion < 1;
}


BRect
BScrollBar::_ArrowRect(Part part) const
{
	BRect inside = Bounds().InsetByCopy(1, 1);
	// Square, but never more than half of a short bar.
	if (fOrientation == B_VERTICAL) {
		const float side = std::min(inside.Width(), std::floor((inside.Height() - 1) / 2));
		if (part == Part::kBackArrow)
			inside.bottom = inside.top + side;
		else
			inside.top = inside.bottom - side;
	} else {
		const float side = std::min(inside.Height(), std::floor((inside.Width() - 1) / 2));
		if (part == Part::kBackArrow)
			inside.right = inside.left + side;
		else
			inside.left = inside.right - side;
	}
	return inside;
}


// Between the arrows, where the thumb runs.
BRect
BScrollBar::_TrackRect() const
{
	BRect track = Bounds().InsetByCopy(1, 1);
	if (fOrientation == B_VERTICAL) {
		track.top = _ArrowRect(Part::kBackArrow).bottom + 1;
		track.bottom = _ArrowRect(Part::kForthArrow).top - 1;
	} else {
		track.left = _ArrowRect(Part::kBackArrow).right + 1;
		track.right = _ArrowRect(Part::kForthArrow).left - 1;
	}
	return track;
}


// Not valid where there is no thumb.
BRect
BScrollBar::_ThumbRect() const
{
	const BRect track = _TrackRect();
	const bool vertical = fOrientation == B_VERTICAL;
	const float length = vertical ? track.Height() : track.Width();
	if (!_IsUsable() || length < kMinThumb)
		return BRect();
	const float size = std::max(kMinThumb, std::floor(length * fProportion));
	const float start = std::round((fValue - fMin) / (fMax - fMin) * (length - size));
	BRect thumb = track;
	if (vertical) {
		thumb.top = track.top + start;
		thumb.bottom = thumb.top + size;
	} else {
		thumb.left = track.left + start;
		thumb.right = thumb.left + size;
	}
	return thumb;
}


BScrollBar::Part
BScrollBar::_PartAt(BPoint where) const
{
	if (!Bounds().Contains(where))
		return Part::kNone;
	if (_ArrowRect(Part::kBackArrow).Contains(where))
		return Part::kBackArrow;
	if (_ArrowRect(Part::kForthArrow).Contains(where))
		return Part::kForthArrow;
	const BRect thumb = _ThumbRect();
	if (!thumb.IsValid())
		return Part::kNone;
	const bool vertical = fOrientation == B_VERTICAL;
	const float at = vertical ? where.y : where.x;
	if (at < (vertical ? thumb.top : thumb.left))
		return Part::kBackArea;
	return at > (vertical ? thumb.bottom : thumb.right) ? Part::kForthArea : Part::kThumb;
}


// The value that the thumb shows when its start is at that coordinate.
float
BScrollBar::_ValueAtThumb(float position) const
{
	const BRect track = _TrackRect();
	const BRect thumb = _ThumbRect();
	const bool vertical = fOrientation == B_VERTICAL;
	const float start = vertical ? track.top : track.left;
	const float room = vertical ? track.Height() - thumb.Height() : track.Width() - thumb.Width();
	if (room <= 0)
		return fValue;
	return fMin + (position - start) / room * (fMax - fMin);
}


// #pragma mark - mouse


void
BScrollBar::MouseDown(BPoint where)
{
	if (!_IsUsable())
		return;
	const BMessage* message = Window() != nullptr ? Window()->CurrentMessage() : nullptr;
	const uint32 buttons =
		message != nullptr ? message->GetInt32("buttons", B_PRIMARY_MOUSE_BUTTON) : 0;
	const bool large = message != nullptr && (message->GetInt32("modifiers", 0) & B_SHIFT_KEY) != 0;

	_Release();
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
	fLastWhere = where;
	fPressed = _PartAt(where);
	const bool vertical = fOrientation == B_VERTICAL;
	const float at = vertical ? where.y : where.x;
	BRect thumb = _ThumbRect();
	if ((buttons & B_SECONDARY_MOUSE_BUTTON) != 0 && thumb.IsValid() && fPressed != Part::kBackArrow
		&& fPressed != Part::kForthArrow) {
		fPressed = Part::kThumb;
		fGrabOffset = std::floor((vertical ? thumb.Height() : thumb.Width()) / 2);
		SetValue(_ValueAtThumb(at - fGrabOffset));
	} else if (fPressed == Part::kThumb)
		fGrabOffset = at - (vertical ? thumb.top : thumb.left);
	else if (fPressed != Part::kNone) {
		_Step(fPressed, large);
		BMessage repeat(kScrollRepeat);
		fRepeats = false;
		fRepeater = new BMessageRunner(BMessenger(this), &repeat, kFirstScrollPause);
	}
	Invalidate();
}


void
BScrollBar::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	fLastWhere = where;
	if (fPressed == Part::kThumb)
		SetValue(_ValueAtThumb((fOrientation == B_VERTICAL ? where.y : where.x) - fGrabOffset));
}


void
BScrollBar::MouseUp(BPoint where)
{
	_Release();
}


void
BScrollBar::_Release()
{
	delete fRepeater;
	fRepeater = nullptr;
	if (fPressed == Part::kNone)
		return;
	fPressed = Part::kNone;
	Invalidate();
}


void
BScrollBar::_Step(Part part, bool large)
{
	switch (part) {
		case Part::kBackArrow:
			SetValue(fValue - (large ? fLargeStep : fSmallStep));
			break;
		case Part::kForthArrow:
			SetValue(fValue + (large ? fLargeStep : fSmallStep));
			break;
		case Part::kBackArea:
			SetValue(fValue - fLargeStep);
			break;
		case Part::kForthArea:
			SetValue(fValue + fLargeStep);
			break;
		case Part::kNone:
		case Part::kThumb:
			break;
	}
}


// #pragma mark - drawing


void
BScrollBar::Draw(BRect updateRect)
{
	const bool flat = !_IsUsable() || shows_flat_bars(Window());
	const uint32 state = flat ? Look::kDisabled : Look::kNormal;
	const rgb_color base = Look::PanelColor();
	Look::DrawScrollBarFrame(this, Bounds(), base, state);
	_DrawArrow(Part::kBackArrow);
	_DrawArrow(Part::kForthArrow);

	const BRect track = _TrackRect();
	if (!track.IsValid())
		return;
	const BRect thumb = _ThumbRect();
	if (flat || !thumb.IsValid()) {
		Look::DrawScrollBarArea(this, track, fOrientation, base, state);
		return;
	}
	const bool vertical = fOrientation == B_VERTICAL;
	BRect before = track;
	BRect after = track;
	(vertical ? before.bottom : before.right) = (vertical ? thumb.top : thumb.left) - 1;
	(vertical ? after.top : after.left) = (vertical ? thumb.bottom : thumb.right) + 1;
	const auto area_state = [this](Part part) {
		return fPressed == part ? Look::kPressed : Look::kNormal;
	};
	if (before.IsValid())
		Look::DrawScrollBarArea(this, before, fOrientation, base, area_state(Part::kBackArea));
	if (after.IsValid())
		Look::DrawScrollBarArea(this, after, fOrientation, base, area_state(Part::kForthArea));
	Look::DrawScrollBarThumb(this, thumb, fOrientation, base, area_state(Part::kThumb));
}


void
BScrollBar::_DrawArrow(Part part)
{
	const bool flat = !_IsUsable() || shows_flat_bars(Window());
	uint32 state = flat ? Look::kDisabled : Look::kNormal;
	if (fPressed == part)
		state |= Look::kPressed;
	Look::Direction direction;
	if (fOrientation == B_VERTICAL)
		direction = part == Part::kBackArrow ? Look::Direction::kUp : Look::Direction::kDown;
	else
		direction = part == Part::kBackArrow ? Look::Direction::kLeft : Look::Direction::kRight;
	Look::DrawScrollBarButton(this, _ArrowRect(part), direction, Look::PanelColor(), state);
}
