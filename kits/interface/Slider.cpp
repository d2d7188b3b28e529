#include <Slider.h>

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/SliderDefaults.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::is_revived;
using BPrivate::LabelMetrics;

BSlider::BSlider(BRect frame, const char* name, const char* label, BMessage* message,
	int32 minValue, int32 maxValue, thumb_style thumbType, uint32 resizingMode, uint32 flags) :
	BSlider(frame, name, label, message, minValue, maxValue, B_HORIZONTAL, thumbType, resizingMode,
		flags)
{
}


BSlider::BSlider(BRect frame, const char* name, const char* label, BMessage* message,
	int32 minValue, int32 maxValue, orientation posture, thumb_style thumbType, uint32 resizingMode,
	uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags),
	fHasMinLabel(false), fHasMaxLabel(false), fSnoozeAmount(BPrivate::kDefaultSnooze),
	fKeyIncrement(1), fHashMarkCount(0), fHashMarks(B_HASH_MARKS_NONE), fStyle(thumbType),
	fOrientation(posture), fMinValue(minValue), fMaxValue(maxValue),
	fBarColor(BPrivate::default_bar_color()), fFillColor(Look::StatusBarColor()),
	fUseFillColor(false), fBarThickness(BPrivate::kDefaultThickness), fValueBefore(0),
	fKeyIsDown(false)
{
	if (minValue <= maxValue)
		SetValueNoUpdate(std::clamp<int32>(0, minValue, maxValue));
}


BSlider::BSlider(BMessage* archive) :
	BControl(archive), fHasMinLabel(false), fHasMaxLabel(false),
	fSnoozeAmount(BPrivate::kDefaultSnooze), fKeyIncrement(1), fHashMarkCount(11),
	fHashMarks(B_HASH_MARKS_NONE), fStyle(B_BLOCK_THUMB), fOrientation(B_HORIZONTAL), fMinValue(0),
	fMaxValue(100), fBarColor(BPrivate::default_bar_color()), fFillColor(Look::StatusBarColor()),
	fUseFillColor(false), fBarThickness(BPrivate::kDefaultThickness), fValueBefore(0),
	fKeyIsDown(false)
{
	_ReadArchive(archive);
}


BSlider::~BSlider()
{
}


// #pragma mark - hooks


void
BSlider::AttachedToWindow()
{
	if (!is_revived(this))
		ResizeToPreferred();
	BControl::AttachedToWindow();

	const char* text = UpdateText();
	fUpdateText = text != NULL ? text : "";
}


void
BSlider::DetachedFromWindow()
{
	fKeyIsDown = false;
	BControl::DetachedFromWindow();
}


void
BSlider::AllAttached()
{
	BControl::AllAttached();
}


void
BSlider::AllDetached()
{
	BControl::AllDetached();
}


void
BSlider::WindowActivated(bool active)
{
	BControl::WindowActivated(active);
}


void
BSlider::MessageReceived(BMessage* message)
{
	BControl::MessageReceived(message);
}


void
BSlider::FrameMoved(BPoint newPosition)
{
	BControl::FrameMoved(newPosition);
}


void
BSlider::FrameResized(float width, float height)
{
	Invalidate();
	BControl::FrameResized(width, height);
}


void
BSlider::Pulse()
{
	BControl::Pulse();
}


// #pragma mark - mouse and keys


void
BSlider::MouseDown(BPoint where)
{
	if (!IsEnabled())
		return;

	fValueBefore = Value();
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
	Invalidate(ThumbFrame());
	_ChangeTo(ValueForPoint(where));
}


void
BSlider::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (IsTracking())
		_ChangeTo(ValueForPoint(where));
}


void
BSlider::MouseUp(BPoint where)
{
	if (!IsTracking())
		return;

	SetTracking(false);
	Invalidate(ThumbFrame());
	if (Value() != fValueBefore)
		Invoke();
}


void
BSlider::KeyDown(const char* bytes, int32 numBytes)
{
	if (!IsEnabled() || numBytes != 1) {
		BControl::KeyDown(bytes, numBytes);
		return;
	}

	int64 value = Value();
	switch (bytes[0]) {
		case B_LEFT_ARROW:
		case B_DOWN_ARROW:
			value -= fKeyIncrement;
			break;
		case B_RIGHT_ARROW:
		case B_UP_ARROW:
			value += fKeyIncrement;
			break;
		case B_HOME:
			value = fMinValue;
			break;
		case B_END:
			value = fMaxValue;
			break;
		default:
			// Not BControl's: Space and Enter have no other value to switch to.
			BView::KeyDown(bytes, numBytes);
			return;
	}

	if (!fKeyIsDown) {
		fKeyIsDown = true;
		fValueBefore = Value();
	}
	if (fMinValue <= fMaxValue)
		_ChangeTo(static_cast<int32>(std::clamp<int64>(value, fMinValue, fMaxValue)));
}


void
BSlider::KeyUp(const char* bytes, int32 numBytes)
{
	BControl::KeyUp(bytes, numBytes);
	if (!fKeyIsDown)
		return;
	fKeyIsDown = false;
	if (Value() != fValueBefore)
		Invoke();
}


// A change by the user, with its modification message.
void
BSlider::_ChangeTo(int32 value)
{
	if (value == Value())
		return;
	SetValue(value);
	if (fModificationMessage != NULL)
		InvokeNotify(fModificationMessage.get(), B_CONTROL_MODIFIED);
}


// #pragma mark - value


void
BSlider::SetValue(int32 value)
{
	if (fMinValue <= fMaxValue)
		value = std::clamp(value, fMinValue, fMaxValue);
	if (value == Value())
		return;

	const BRect oldThumb = ThumbFrame();
	SetValueNoUpdate(value);
	_InvalidateValue(oldThumb);
	UpdateTextChanged();
}


void
BSlider::_InvalidateValue(BRect oldThumb)
{
	BRect changed = oldThumb | ThumbFrame();
	// What the thumb covers is drawn with it: the bar's fill, the marks, the focus.
	changed.InsetBy(-2, -2);
	Invalidate(changed);
}


int32
BSlider::ValueForPoint(BPoint where) const
{
	const double min = _MinPosition();
	const double max = _MaxPosition();
	if (min == max || fMinValue > fMaxValue)
		return fMinValue;
	const double place = fOrientation == B_HORIZONTAL ? where.x : where.y;
	const double range = static_cast<double>(fMaxValue) - fMinValue;
	const double value = std::round((place - min) * range / (max - min)) + fMinValue;
	return static_cast<int32>(
		std::clamp(value, static_cast<double>(fMinValue), static_cast<double>(fMaxValue)));
}


void
BSlider::SetPosition(float position)
{
	const double part = std::clamp(position, 0.0f, 1.0f);
	const double range = static_cast<double>(fMaxValue) - fMinValue;
	SetValue(static_cast<int32>(std::round(part * range) + fMinValue));
}


float
BSlider::Position() const
{
	const double range = static_cast<double>(fMaxValue) - fMinValue;
	if (!(range > 0))
		return 0;
	const double part = (static_cast<double>(Value()) - fMinValue) / range;
	return static_cast<float>(std::clamp(part, 0.0, 1.0));
}


void
BSlider::SetLimits(int32 minValue, int32 maxValue)
{
	if (minValue > maxValue || (minValue == fMinValue && maxValue == fMaxValue))
		return;
	fMinValue = minValue;
	fMaxValue = maxValue;
	SetValue(Value());
	Invalidate();
}


void
BSlider::GetLimits(int32* _minValue, int32* _maxValue) const
{
	if (_minValue != NULL)
		*_minValue = fMinValue;
	if (_maxValue != NULL)
		*_maxValue = fMaxValue;
}


status_t
BSlider::Invoke(BMessage* message)
{
	return BControl::Invoke(message);
}


// #pragma mark - scripting


BHandler*
BSlider::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BControl::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BSlider::GetSupportedSuites(BMessage* message)
{
	return BControl::GetSupportedSuites(message);
}


status_t
BSlider::Perform(perform_code code, void* data)
{
	return BControl::Perform(code, data);
}
