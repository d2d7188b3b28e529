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
		case kScrollRepeat:
			if (fPressed == Part::kNone || fRepeater == nullptr)
				break;
			if (!fRepeats) {
				fRepeats = true;
				fRepeater->SetInterval(kScrollPause);
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
