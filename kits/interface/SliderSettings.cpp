// The settings of sliders.
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

namespace {

constexpr int32 kMinimumSnooze = 10000; // microseconds
constexpr int32 kMaximumSnooze = 1000000;

} // namespace


void
BSlider::SetLabel(const char* label)
{
	BControl::SetLabel(label);
}


void
BSlider::SetLimitLabels(const char* minLabel, const char* maxLabel)
{
	fHasMinLabel = minLabel != NULL;
	fHasMaxLabel = maxLabel != NULL;
	fMinLabel = fHasMinLabel ? minLabel : "";
	fMaxLabel = fHasMaxLabel ? maxLabel : "";
	ResizeToPreferred();
	Invalidate();
}


const char*
BSlider::MinLimitLabel() const
{
	return fHasMinLabel ? fMinLabel.c_str() : NULL;
}


const char*
BSlider::MaxLimitLabel() const
{
	return fHasMaxLabel ? fMaxLabel.c_str() : NULL;
}


void
BSlider::SetEnabled(bool enabled)
{
	BControl::SetEnabled(enabled);
}


void
BSlider::SetFlags(uint32 flags)
{
	BControl::SetFlags(flags);
}


void
BSlider::SetResizingMode(uint32 mode)
{
	BControl::SetResizingMode(mode);
}


void
BSlider::SetModificationMessage(BMessage* message)
{
	if (message != fModificationMessage.get())
		fModificationMessage.reset(message);
}


BMessage*
BSlider::ModificationMessage() const
{
	return fModificationMessage.get();
}


void
BSlider::SetSnoozeAmount(int32 microSeconds)
{
	fSnoozeAmount = std::clamp(microSeconds, kMinimumSnooze, kMaximumSnooze);
}


int32
BSlider::SnoozeAmount() const
{
	return fSnoozeAmount;
}


void
BSlider::SetKeyIncrementValue(int32 incrementValue)
{
	fKeyIncrement = incrementValue;
}


int32
BSlider::KeyIncrementValue() const
{
	return fKeyIncrement;
}


void
BSlider::SetHashMarkCount(int32 hashMarkCount)
{
	if (hashMarkCount == fHashMarkCount)
		return;
	fHashMarkCount = hashMarkCount;
	Invalidate();
}


int32
BSlider::HashMarkCount() const
{
	return fHashMarkCount;
}


void
BSlider::SetHashMarks(hash_mark_location where)
{
	if (where == fHashMarks)
		return;
	fHashMarks = where;
	Invalidate();
}


hash_mark_location
BSlider::HashMarks() const
{
	return fHashMarks;
}


void
BSlider::SetStyle(thumb_style style)
{
	if (style == fStyle)
		return;
	fStyle = style;
	Invalidate();
}


thumb_style
BSlider::Style() const
{
	return fStyle;
}


void
BSlider::SetBarColor(rgb_color color)
{
	fBarColor = color;
	Invalidate(BarFrame());
}


rgb_color
BSlider::BarColor() const
{
	return fBarColor;
}


void
BSlider::UseFillColor(bool use, const rgb_color* color)
{
	fUseFillColor = use;
	if (use && color != NULL)
		fFillColor = *color;
	Invalidate(BarFrame());
}


bool
BSlider::FillColor(rgb_color* _color) const
{
	if (_color != NULL && fUseFillColor)
		*_color = fFillColor;
	return fUseFillColor;
}


BView*
BSlider::OffscreenView() const
{
	return const_cast<BSlider*>(this);
}


orientation
BSlider::Orientation() const
{
	return fOrientation;
}


void
BSlider::SetOrientation(orientation posture)
{
	if (posture == fOrientation)
		return;
	fOrientation = posture;
	Invalidate();
}


float
BSlider::BarThickness() const
{
	return fBarThickness;
}


void
BSlider::SetBarThickness(float thickness)
{
	thickness = std::max(1.0f, std::round(thickness));
	if (thickness == fBarThickness)
		return;
	fBarThickness = thickness;
	Invalidate();
}


void
BSlider::SetFont(const BFont* font, uint32 properties)
{
	BControl::SetFont(font, properties);
	Invalidate();
}
