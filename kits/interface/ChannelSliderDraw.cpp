// BChannelSlider: where its parts are, and how they are drawn.
#include <ChannelSlider.h>

#include <algorithm>
#include <cmath>

#include <Bitmap.h>
#include <Window.h>

#include "interface/private/ChannelThumb.h"
#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/SliderDefaults.h"

namespace Look = BPrivate::Look;

using BPrivate::label_width;
using BPrivate::LabelMetrics;

namespace {

constexpr float kLaneGap = 3; // pixels between two thumbs' lanes
constexpr float kLineGap = 4; // below each line of text
constexpr float kGrooveHalf = 3; // of the groove's thickness, the middle line left out
constexpr float kMinimumLength = 32;
constexpr float kPreferredLength = 100;


BPoint
MiddleOf(BRect rect)
{
	return BPoint(
		std::floor((rect.left + rect.right) / 2), std::floor((rect.top + rect.bottom) / 2));
}

} // namespace


// #pragma mark - geometry


// A line of text with the gap at it.
float
BChannelSlider::_LineHeight() const
{
	const LabelMetrics metrics(this);
	return metrics.ascent + metrics.descent + kLineGap;
}


BRect
BChannelSlider::_ThumbBounds(int32 channel)
{
	if (const BBitmap* thumb = ThumbFor(channel, false))
		return thumb->Bounds().OffsetToCopy(0, 0);
	const float along = BPrivate::kThumbAlong - 1;
	const float across = BPrivate::kThumbAcross - 1;
	return _IsVertical() ? BRect(0, 0, across, along) : BRect(0, 0, along, across);
}


// From one lane to the next.
float
BChannelSlider::_Pitch()
{
	const BRect thumb = _ThumbBounds(0);
	return (_IsVertical() ? thumb.Width() : thumb.Height()) + 1 + kLaneGap;
}


// Of all lanes, across, in pixels.
float
BChannelSlider::_GroupSize()
{
	return CountChannels() > 0 ? CountChannels() * _Pitch() - kLaneGap : 0;
}


// What the texts leave over.
BRect
BChannelSlider::_Room() const
{
	BRect room = Bounds();
	const float line = _LineHeight();
	if (Label() != NULL)
		room.top += line;
	const bool hasMin = MinLimitLabel()[0] != '\0';
	const bool hasMax = MaxLimitLabel()[0] != '\0';
	if (_IsVertical() && hasMax)
		room.top += line;
	if (hasMin || (!_IsVertical() && hasMax))
		room.bottom -= line;
	return room;
}


BRect
BChannelSlider::ThumbFrameFor(int32 channel)
{
	if (channel < 0 || channel >= CountChannels())
		return BRect();
	BPoint place = _Room().LeftTop();
	if (_IsVertical()) {
		const float spare = Bounds().Width() + 1 - _GroupSize();
		place.x += std::max(0.0f, std::floor(spare / 2)) + channel * _Pitch();
	} else {
		place.y += channel * _Pitch();
	}
	return _ThumbBounds(channel).OffsetToCopy(place);
}


float
BChannelSlider::ThumbRangeFor(int32 channel)
{
	if (channel < 0 || channel >= CountChannels())
		return 0;
	const BRect room = _Room();
	const BRect thumb = _ThumbBounds(channel);
	const float range =
		_IsVertical() ? room.Height() - thumb.Height() : room.Width() - thumb.Width();
	return std::max(0.0f, range);
}


float
BChannelSlider::ThumbDeltaFor(int32 channel)
{
	int32 minimum;
	int32 maximum;
	if (GetLimitsFor(channel, &minimum, &maximum) != B_OK)
		return 0;
	double part = 0;
	if (minimum < maximum) {
		const double limits = static_cast<double>(maximum) - minimum;
		part = std::clamp((static_cast<double>(ValueFor(channel)) - minimum) / limits, 0.0, 1.0);
	}
	if (_IsVertical())
		part = 1 - part;
	return static_cast<float>(std::floor(part * ThumbRangeFor(channel) + 0.5));
}


// All that the channel's thumb can cover.
BRect
BChannelSlider::_Area(int32 channel)
{
	BRect area = ThumbFrameFor(channel);
	if (_IsVertical())
		area.bottom += ThumbRangeFor(channel);
	else
		area.right += ThumbRangeFor(channel);
	return area;
}


int32
BChannelSlider::_ChannelAt(BPoint where)
{
	for (int32 i = 0; i < CountChannels(); i++) {
		if (_Area(i).Contains(where))
			return i;
	}
	return -1;
}


int32
BChannelSlider::_ValueAt(BPoint where, int32 channel)
{
	const double minimum = MinLimitList()[channel];
	const double maximum = MaxLimitList()[channel];
	const double range = ThumbRangeFor(channel);
	if (range <= 0 || minimum >= maximum)
		return ValueFor(channel);
	const BPoint place = where - fGrabbed - MiddleOf(ThumbFrameFor(channel));
	double part = (_IsVertical() ? place.y : place.x) / range;
	// Not clamped: a frame without end gives a place that is no number.
	part = part > 0 ? std::min(part, 1.0) : 0;
	if (_IsVertical())
		part = 1 - part;
	return static_cast<int32>(std::round(minimum + part * (maximum - minimum)));
}


void
BChannelSlider::GetPreferredSize(float* _width, float* _height)
{
	const float line = _LineHeight();
	const float label = label_width(this, Label());
	const float minimum = label_width(this, MinLimitLabel());
	const float maximum = label_width(this, MaxLimitLabel());
	const float lines = (Label() != NULL ? line : 0) + (minimum > 0 ? line : 0);

	float width;
	float height;
	// Along the bars the slider never becomes shorter than it is.
	if (_IsVertical()) {
		width = std::max({ _GroupSize(), label, minimum, maximum }) - 1;
		height = kMinimumLength + lines + (maximum > 0 ? line : 0);
		height = std::max({ height, kPreferredLength, Bounds().Height() });
	} else {
		const float space = std::ceil(StringWidth("M"));
		const float limits = minimum + maximum + (minimum > 0 && maximum > 0 ? 2 * space : 0);
		width = std::max({ label, limits, kPreferredLength, Bounds().Width() });
		height = _GroupSize() + lines + (maximum > 0 && minimum == 0 ? line : 0) - 1;
	}
	if (_width != NULL)
		*_width = std::max(0.0f, width);
	if (_height != NULL)
		*_height = std::max(0.0f, height);
}


// #pragma mark - drawing


bool
BChannelSlider::_IsPressed(int32 channel) const
{
	return IsTracking() && (fMovesAll || channel == CurrentChannel());
}


bool
BChannelSlider::_IsFocused(int32 channel) const
{
	return channel == CurrentChannel() && IsFocus() && IsEnabled() && Window()->IsActive();
}


uint32
BChannelSlider::_LookState(int32 channel, bool pressed) const
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (pressed)
		state |= Look::kPressed;
	if (_IsFocused(channel))
		state |= Look::kFocused;
	return state;
}


void
BChannelSlider::_ChannelChanged(int32 channel)
{
	if (Window() != NULL)
		Invalidate(_Area(channel));
}


void
BChannelSlider::Draw(BRect updateRect)
{
	for (int32 i = 0; i < CountChannels(); i++) {
		const BRect area = _Area(i);
		if (area.Intersects(updateRect))
			DrawChannel(this, i, area, _IsPressed(i));
	}
	_DrawTexts();
}


void
BChannelSlider::DrawChannel(BView* into, int32 channel, BRect area, bool pressed)
{
	const BRect bounds = _ThumbBounds(channel);
	const BPoint thumb = MiddleOf(bounds);
	BPoint from = MiddleOf(area);
	BPoint to = from;
	BPoint place;
	if (_IsVertical()) {
		from.y = area.top + thumb.y;
		to.y = std::max(from.y, area.bottom - (bounds.bottom - thumb.y));
		place = from + BPoint(0, ThumbDeltaFor(channel));
	} else {
		from.x = area.left + thumb.x;
		to.x = std::max(from.x, area.right - (bounds.right - thumb.x));
		place = from + BPoint(ThumbDeltaFor(channel), 0);
	}
	DrawGroove(into, channel, from, to);
	DrawThumb(into, channel, place, pressed);
}


void
BChannelSlider::DrawGroove(BView* into, int32 channel, BPoint leftTop, BPoint rightBottom)
{
	BRect groove(leftTop, rightBottom);
	if (_IsVertical())
		groove.InsetBy(-kGrooveHalf, -1);
	else
		groove.InsetBy(-1, -kGrooveHalf);
	Look::DrawSliderBar(into, groove, Look::BaseColor(this), BPrivate::default_bar_color(),
		_LookState(channel, false));
}


// The slider's own thumb is drawn with lines, which are sharp on every screen.
void
BChannelSlider::DrawThumb(BView* into, int32 channel, BPoint where, bool pressed)
{
	const BBitmap* thumb = ThumbFor(channel, pressed);
	BRect frame = thumb != NULL ? thumb->Bounds().OffsetToCopy(0, 0) : _ThumbBounds(channel);
	frame.OffsetTo(where - MiddleOf(frame));
	if (thumb == NULL || thumb == fThumbs[pressed ? 1 : 0].get()) {
		Look::DrawSliderBlockThumb(
			into, frame, Orientation(), Look::BaseColor(this), _LookState(channel, pressed));
		return;
	}
	into->DrawBitmap(thumb, frame.LeftTop());
	if (_IsFocused(channel))
		Look::DrawRing(into, frame, Look::NavigationColor(), Look::NavigationColor());
}


const BBitmap*
BChannelSlider::ThumbFor(int32, bool pressed)
{
	const uint32 state = (IsEnabled() ? Look::kNormal : Look::kDisabled)
		| (pressed ? Look::kPressed : Look::kNormal);
	std::shared_ptr<BBitmap>& thumb = fThumbs[pressed ? 1 : 0];
	thumb = BPrivate::channel_thumb(Orientation(), state, Look::BaseColor(this));
	return thumb.get();
}


// The label above, the limits at their ends of the bars.
void
BChannelSlider::_DrawTexts()
{
	const LabelMetrics metrics(this);
	const BRect bounds = Bounds();
	const float top = bounds.top + metrics.ascent;
	const float bottom = bounds.bottom - metrics.descent;
	if (_IsVertical()) {
		_DrawLine(Label(), top, B_ALIGN_CENTER);
		_DrawLine(MaxLimitLabel(), top + (Label() != NULL ? _LineHeight() : 0), B_ALIGN_CENTER);
		_DrawLine(MinLimitLabel(), bottom, B_ALIGN_CENTER);
		return;
	}
	_DrawLine(Label(), top, B_ALIGN_LEFT);
	_DrawLine(MinLimitLabel(), bottom, B_ALIGN_LEFT);
	_DrawLine(MaxLimitLabel(), bottom, B_ALIGN_RIGHT);
}


void
BChannelSlider::_DrawLine(const char* text, float baseline, alignment align)
{
	if (text == NULL || text[0] == '\0')
		return;
	const BRect bounds = Bounds();
	float left = bounds.left;
	if (align == B_ALIGN_RIGHT)
		left = bounds.right + 1 - label_width(this, text);
	else if (align == B_ALIGN_CENTER)
		left = bounds.left + std::floor((bounds.Width() + 1 - StringWidth(text)) / 2);
	BPrivate::draw_label(this, text, BPoint(left, baseline), IsEnabled());
}
