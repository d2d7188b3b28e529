#include <ScrollBar.h>

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Message.h>
#include <MessageRunner.h>
#include <Messenger.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"
#include "interface/private/ViewPrivate.h"

using namespace BPrivate;

enum class BScrollBar::Part : uint8 {
	kNone,
	kBackArrow,
	kForthArrow,
	kBackArea,
	kForthArea,
	kThumb
};

namespace {

constexpr uint32 kRepeat = 'srpt';
constexpr bigtime_t kFirstPause = 300000;
constexpr bigtime_t kPause = 25000;
constexpr float kMinThumb = 14; // right - left of the smallest thumb

constexpr uint32 kFlags = B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE | B_FRAME_EVENTS;


uint32
mode_for(orientation direction)
{
	return direction == B_VERTICAL ? B_FOLLOW_TOP_BOTTOM | B_FOLLOW_RIGHT
								   : B_FOLLOW_LEFT_RIGHT | B_FOLLOW_BOTTOM;
}

} // namespace


BScrollBar::BScrollBar(
	BRect frame, const char* name, BView* target, float min, float max, orientation direction) :
	BView(frame, name, mode_for(direction), kFlags),
	fMin(std::min(min, max) == min ? min : 0), fMax(std::min(min, max) == min ? max : 0),
	fSmallStep(1), fLargeStep(10), fValue(0), fProportion(0), fTarget(nullptr),
	fOrientation(direction), fPressed(Part::kNone), fRepeats(false), fGrabOffset(0),
	fRepeater(nullptr)
{
	SetViewColor(B_TRANSPARENT_COLOR);
	fValue = _Clamped(0);
	SetTarget(target);
}


BScrollBar::BScrollBar(BMessage* archive) :
	BView(archive), fTarget(nullptr), fPressed(Part::kNone), fRepeats(false), fGrabOffset(0),
	fRepeater(nullptr)
{
	fMin = archive->GetFloat("_range", 0, 0);
	fMax = archive->GetFloat("_range", 1, 0);
	fSmallStep = archive->GetFloat("_steps", 0, 1);
	fLargeStep = archive->GetFloat("_steps", 1, 10);
	fValue = archive->GetFloat("_val", 0);
	fOrientation =
		archive->GetInt32("_orient", B_VERTICAL) == B_HORIZONTAL ? B_HORIZONTAL : B_VERTICAL;
	fProportion = archive->GetFloat("_prop", 0);
}


BScrollBar::~BScrollBar()
{
	delete fRepeater;
	SetTarget(static_cast<BView*>(nullptr));
}


BArchivable*
BScrollBar::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BScrollBar") ? new BScrollBar(archive) : nullptr;
}


status_t
BScrollBar::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;
	ArchiveWriter writer(archive);
	const float range[] = { fMin, fMax };
	const float noRange[] = { 0, 0 };
	writer.Floats("_range", range, noRange);
	const float steps[] = { fSmallStep, fLargeStep };
	const float usualSteps[] = { 1, 10 };
	writer.Floats("_steps", steps, usualSteps);
	writer.Float("_val", fValue, 0);
	// Any number but 0 is read as vertical.
	const int32 read = writer.Source().GetInt32("_orient", B_VERTICAL);
	if (!writer.Keep("_orient", (read == B_HORIZONTAL) == (fOrientation == B_HORIZONTAL)))
		writer.Int32("_orient", fOrientation, -1);
	writer.Float("_prop", fProportion, 0);
	return writer.Status();
}


// #pragma mark - hooks


void
BScrollBar::AttachedToWindow()
{
	BView::AttachedToWindow();
}


void
BScrollBar::DetachedFromWindow()
{
	_Release();
	BView::DetachedFromWindow();
}


void
BScrollBar::AllAttached()
{
	BView::AllAttached();
}


void
BScrollBar::AllDetached()
{
	BView::AllDetached();
}


void
BScrollBar::WindowActivated(bool active)
{
	Invalidate();
}


void
BScrollBar::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BScrollBar::FrameResized(float newWidth, float newHeight)
{
	BView::FrameResized(newWidth, newHeight);
}


void
BScrollBar::Pulse()
{
	BView::Pulse();
}


void
BScrollBar::MakeFocus(bool state)
{
	BView::MakeFocus(state);
}


void
BScrollBar::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case kRepeat:
			if (fPressed == Part::kNone || fRepeater == nullptr)
				break;
			if (!fRepeats) {
				fRepeats = true;
				fRepeater->SetInterval(kPause);
			}
			// Only while the pointer is still on what was pressed, which the thumb may have reached.
			if (_PartAt(fLastWhere) == fPressed)
				_Step(fPressed, false);
			break;

		case B_MOUSE_WHEEL_CHANGED: {
			constexpr float kLinesPerNotch = 3;
			float delta = message->FindFloat("be:wheel_delta_y");
			if (delta == 0)
				delta = message->FindFloat("be:wheel_delta_x");
			SetValue(fValue + delta * fSmallStep * kLinesPerNotch);
			break;
		}

		case B_VALUE_CHANGED: {
			int32 value;
			if (message->FindInt32("value", &value) == B_OK)
				ValueChanged(value);
			break;
		}

		default:
			BView::MessageReceived(message);
			break;
	}
}


// #pragma mark - values


float
BScrollBar::_Clamped(float value) const
{
	return std::clamp(std::round(value), fMin, std::max(fMin, fMax));
}


// Takes the value over without scrolling; returns whether it is another one.
bool
BScrollBar::_Take(float value)
{
	value = _Clamped(value);
	if (value == fValue)
		return false;
	fValue = value;
	Invalidate();
	return true;
}


void
BScrollBar::SetValue(float value)
{
	if (!_Take(value))
		return;
	if (fTarget != nullptr && fTarget->Window() == Window()) {
		BPoint where = fTarget->Bounds().LeftTop();
		(fOrientation == B_VERTICAL ? where.y : where.x) = fValue;
		fTarget->ScrollTo(where);
	}
	ValueChanged(fValue);
}


float
BScrollBar::_Follow(float position)
{
	if (_Take(position))
		ValueChanged(fValue);
	return fValue;
}


float
BScrollBar::Value() const
{
	return fValue;
}


void
BScrollBar::ValueChanged(float newValue)
{
}


void
BScrollBar::SetProportion(float proportion)
{
	proportion = std::clamp(proportion, 0.0f, 1.0f);
	if (proportion == fProportion)
		return;
	fProportion = proportion;
	Invalidate();
}


float
BScrollBar::Proportion() const
{
	return fProportion;
}


void
BScrollBar::SetRange(float min, float max)
{
	if (!(min <= max))
		min = max = 0;
	min = std::round(min);
	max = std::round(max);
	if (min == fMin && max == fMax)
		return;
	fMin = min;
	fMax = max;
	Invalidate();
	if (fValue != _Clamped(fValue))
		SetValue(fValue);
}


void
BScrollBar::GetRange(float* min, float* max) const
{
	if (min != nullptr)
		*min = fMin;
	if (max != nullptr)
		*max = fMax;
}


void
BScrollBar::SetSteps(float smallStep, float largeStep)
{
	fSmallStep = smallStep;
	fLargeStep = largeStep;
}


void
BScrollBar::GetSteps(float* smallStep, float* largeStep) const
{
	if (smallStep != nullptr)
		*smallStep = fSmallStep;
	if (largeStep != nullptr)
		*largeStep = fLargeStep;
}


void
BScrollBar::SetTarget(BView* target)
{
	if (target == fTarget)
		return;
	if (fTarget != nullptr)
		ViewPrivate(fTarget).SetScrollBar(fOrientation, nullptr);
	fTarget = target;
	if (fTarget != nullptr)
		ViewPrivate(fTarget).SetScrollBar(fOrientation, this);
}


void
BScrollBar::SetTarget(const char* targetName)
{
	if (targetName == nullptr)
		SetTarget(static_cast<BView*>(nullptr));
	else if (Window() != nullptr)
		SetTarget(Window()->FindView(targetName));
}


BView*
BScrollBar::Target() const
{
	return fTarget;
}


void
BScrollBar::_TargetGone()
{
	fTarget = nullptr;
}


void
BScrollBar::SetOrientation(orientation direction)
{
	if (direction == fOrientation)
		return;
	BView* target = fTarget;
	SetTarget(static_cast<BView*>(nullptr));
	fOrientation = direction;
	SetTarget(target);
	Invalidate();
}


orientation
BScrollBar::Orientation() const
{
	return fOrientation;
}


void
BScrollBar::GetPreferredSize(float* width, float* height)
{
	const bool vertical = fOrientation == B_VERTICAL;
	if (width != nullptr)
		*width = vertical ? B_V_SCROLL_BAR_WIDTH : Bounds().Width();
	if (height != nullptr)
		*height = vertical ? Bounds().Height() : B_H_SCROLL_BAR_HEIGHT;
}


void
BScrollBar::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


BHandler*
BScrollBar::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BScrollBar::GetSupportedSuites(BMessage* data)
{
	return BView::GetSupportedSuites(data);
}


status_t
BScrollBar::Perform(perform_code code, void* argument)
{
	return BView::Perform(code, argument);
}


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
		BMessage repeat(kRepeat);
		fRepeats = false;
		fRepeater = new BMessageRunner(BMessenger(this), &repeat, kFirstPause);
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
	// An inactive window only shows its bars flat; they work all the same.
	const bool flat = !_IsUsable() || Window() == nullptr || !Window()->IsActive();
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
	const bool flat = !_IsUsable() || Window() == nullptr || !Window()->IsActive();
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
