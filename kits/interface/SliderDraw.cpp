// BSlider: where its parts are, and how they are drawn.
#include <Slider.h>

#include <algorithm>
#include <cmath>

#include <Window.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"

namespace Look = BPrivate::Look;

using BPrivate::label_width;
using BPrivate::LabelMetrics;

namespace {

constexpr float kBlockBarInset = 8; // from the view's edges to the ends of the bar
constexpr float kTriangleBarInset = 7;
constexpr float kHashReach = 6; // beyond the bar, on both sides
constexpr float kHashLength = 5;
constexpr float kLineGap = 4; // below each line of text
constexpr float kBlockHalf = 8; // half of the thumb's 17 pixels, the middle one left out
constexpr float kBlockReach = 3; // beyond the bar, on both sides
constexpr float kTriangleHalf = 6;
constexpr float kTriangleHeight = 8;
constexpr float kMinimumLength = 32;
constexpr float kPreferredLength = 100;
constexpr int32 kMaximumDrawnMarks = 1000; // more would be one grey area, and take long to draw

} // namespace


// #pragma mark - geometry


// A line of text with the gap below it.
float
BSlider::_LineHeight() const
{
	const LabelMetrics metrics(this);
	return metrics.ascent + metrics.descent + kLineGap;
}


bool
BSlider::_HasLimitLabels() const
{
	return !fMinLabel.empty() || !fMaxLabel.empty();
}


BRect
BSlider::BarFrame() const
{
	const BRect bounds = Bounds();
	const float inset = fStyle == B_TRIANGLE_THUMB ? kTriangleBarInset : kBlockBarInset;
	const float line = _LineHeight();
	const bool hasTop = Label() != NULL || !fUpdateText.empty();

	BRect frame = bounds;
	if (fOrientation == B_HORIZONTAL) {
		frame.left += inset;
		frame.right -= inset;
		frame.top += kHashReach + (hasTop ? line : 0);
		frame.bottom = frame.top + fBarThickness;
		return frame;
	}

	frame.left += std::floor((bounds.Width() - fBarThickness) / 2);
	frame.right = frame.left + fBarThickness;
	frame.top += inset + (Label() != NULL ? line : 0) + (!fMaxLabel.empty() ? line : 0);
	frame.bottom -= inset + (!fMinLabel.empty() ? line : 0) + (!fUpdateText.empty() ? line : 0);
	return frame;
}


BRect
BSlider::HashMarksFrame() const
{
	BRect frame = BarFrame();
	if (fOrientation == B_HORIZONTAL)
		frame.InsetBy(0, -kHashReach);
	else
		frame.InsetBy(-kHashReach, 0);
	return frame;
}


float
BSlider::_MinPosition() const
{
	const BRect bar = BarFrame();
	return fOrientation == B_HORIZONTAL ? bar.left + 1 : bar.bottom - 1;
}


float
BSlider::_MaxPosition() const
{
	const BRect bar = BarFrame();
	return fOrientation == B_HORIZONTAL ? bar.right - 1 : bar.top + 1;
}


BRect
BSlider::ThumbFrame() const
{
	const BRect bar = BarFrame();
	const float min = _MinPosition();
	const float place = std::floor(min + Position() * (_MaxPosition() - min) + 0.5f);
	const bool horizontal = fOrientation == B_HORIZONTAL;

	if (fStyle == B_TRIANGLE_THUMB) {
		if (horizontal) {
			const float top = bar.bottom - 1;
			return BRect(
				place - kTriangleHalf, top, place + kTriangleHalf, top + kTriangleHeight - 1);
		}
		const float left = bar.right - 1;
		return BRect(
			left, place - kTriangleHalf, left + kTriangleHeight - 1, place + kTriangleHalf);
	}
	if (horizontal) {
		return BRect(place - kBlockHalf, bar.top - kBlockReach, place + kBlockHalf,
			bar.bottom + kBlockReach);
	}
	return BRect(
		bar.left - kBlockReach, place - kBlockHalf, bar.right + kBlockReach, place + kBlockHalf);
}


void
BSlider::_GetMinimumSize(float* _width, float* _height) const
{
	const float line = _LineHeight();
	const float across = 2 * kHashReach + fBarThickness;
	const float label = label_width(this, Label());
	const float status = label_width(this, UpdateText());
	const float min = label_width(this, fMinLabel.c_str());
	const float max = label_width(this, fMaxLabel.c_str());
	const float space = std::ceil(StringWidth("M"));
	const bool hasTop = Label() != NULL || UpdateText() != NULL;

	if (fOrientation == B_HORIZONTAL) {
		const float top = label + status + (status > 0 && label > 0 ? space : 0);
		const float bottom = _HasLimitLabels() ? min + max + 2 * space : 0;
		*_width = std::max({ kMinimumLength, top, bottom });
		*_height = across + (hasTop ? line : 0) + (_HasLimitLabels() ? line : 0);
		return;
	}
	const int lines =
		(Label() != NULL) + (UpdateText() != NULL) + !fMinLabel.empty() + !fMaxLabel.empty();
	*_width = std::max({ across, label, status, min, max });
	*_height = kMinimumLength + lines * line;
}


void
BSlider::GetPreferredSize(float* _width, float* _height)
{
	float width;
	float height;
	_GetMinimumSize(&width, &height);
	// Along the bar the slider never becomes shorter than it is.
	if (fOrientation == B_HORIZONTAL)
		width = std::max({ width, kPreferredLength, Bounds().Width() });
	else
		height = std::max({ height, kPreferredLength, Bounds().Height() });
	if (_width != NULL)
		*_width = width;
	if (_height != NULL)
		*_height = height;
}


void
BSlider::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


// #pragma mark - drawing


uint32
BSlider::_LookState() const
{
	uint32 state = IsEnabled() ? Look::kNormal : Look::kDisabled;
	if (IsTracking())
		state |= Look::kPressed;
	return state;
}


void
BSlider::Draw(BRect updateRect)
{
	DrawSlider();
}


void
BSlider::DrawSlider()
{
	DrawBar();
	DrawHashMarks();
	DrawThumb();
	DrawFocusMark();
	DrawText();
}


void
BSlider::DrawBar()
{
	BRect bar = BarFrame();
	const rgb_color base = Look::BaseColor(this);
	Look::DrawSliderBar(this, bar, base, fBarColor, _LookState());
	if (!fUseFillColor)
		return;

	// From the end of the minimum to the thumb.
	const float min = _MinPosition();
	const float place = std::floor(min + Position() * (_MaxPosition() - min) + 0.5f);
	if (fOrientation == B_HORIZONTAL)
		bar.right = place;
	else
		bar.top = place;
	Look::DrawSliderFill(this, bar, base, fFillColor, _LookState());
}


void
BSlider::DrawHashMarks()
{
	if (fHashMarks == B_HASH_MARKS_NONE)
		return;

	const BRect frame = HashMarksFrame();
	const rgb_color base = Look::BaseColor(this);
	const bool horizontal = fOrientation == B_HORIZONTAL;
	const float first = _MinPosition();
	const float last = _MaxPosition();
	const int32 count = std::clamp<int32>(fHashMarkCount, 2, kMaximumDrawnMarks);

	for (int32 i = 0; i < count; i++) {
		const float place = std::floor(first + (last - first) * i / (count - 1) + 0.5f);
		for (const hash_mark_location side : { B_HASH_MARKS_TOP, B_HASH_MARKS_BOTTOM }) {
			if ((fHashMarks & side) == 0)
				continue;
			const bool atStart = side == B_HASH_MARKS_TOP;
			BPoint from(place, atStart ? frame.top : frame.bottom - kHashLength + 1);
			BPoint to(place, from.y + kHashLength - 1);
			if (!horizontal) {
				from = BPoint(atStart ? frame.left : frame.right - kHashLength + 1, place);
				to = BPoint(from.x + kHashLength - 1, place);
			}
			Look::DrawHashMark(this, from, to, base, _LookState());
		}
	}
}


void
BSlider::DrawThumb()
{
	const rgb_color base = Look::BaseColor(this);
	if (fStyle == B_TRIANGLE_THUMB)
		Look::DrawSliderTriangleThumb(this, ThumbFrame(), fOrientation, base, _LookState());
	else
		Look::DrawSliderBlockThumb(this, ThumbFrame(), fOrientation, base, _LookState());
}


void
BSlider::DrawFocusMark()
{
	if (!IsFocus() || !IsEnabled() || !Window()->IsActive())
		return;

	const uint32 state = _LookState() | Look::kFocused;
	const rgb_color base = Look::BaseColor(this);
	if (fStyle == B_TRIANGLE_THUMB)
		Look::DrawSliderTriangleThumb(this, ThumbFrame(), fOrientation, base, state);
	else
		Look::DrawSliderBlockThumb(this, ThumbFrame(), fOrientation, base, state);
}


void
BSlider::DrawText()
{
	const BRect bounds = Bounds();
	const LabelMetrics metrics(this);
	const float line = metrics.ascent + metrics.descent + kLineGap;
	const float top = bounds.top + metrics.ascent;
	const float bottom = bounds.bottom - metrics.descent;
	const char* status = UpdateText();

	if (fOrientation == B_HORIZONTAL) {
		_DrawTextLine(Label(), top, B_ALIGN_LEFT);
		_DrawTextLine(status, top, B_ALIGN_RIGHT);
		_DrawTextLine(fMinLabel.c_str(), bottom, B_ALIGN_LEFT);
		_DrawTextLine(fMaxLabel.c_str(), bottom, B_ALIGN_RIGHT);
		return;
	}
	_DrawTextLine(Label(), top, B_ALIGN_CENTER);
	_DrawTextLine(fMaxLabel.c_str(), top + (Label() != NULL ? line : 0), B_ALIGN_CENTER);
	_DrawTextLine(status, bottom, B_ALIGN_CENTER);
	_DrawTextLine(fMinLabel.c_str(), bottom - (status != NULL ? line : 0), B_ALIGN_CENTER);
}


void
BSlider::_DrawTextLine(const char* text, float baseline, alignment align)
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


const char*
BSlider::UpdateText() const
{
	return NULL;
}


void
BSlider::UpdateTextChanged()
{
	const char* text = UpdateText();
	if (text == NULL)
		text = "";
	if (fUpdateText == text)
		return;

	// The bar moves when the line of text comes or goes.
	const bool moved = fUpdateText.empty() != (text[0] == '\0');
	fUpdateText = text;
	if (moved) {
		Invalidate();
		return;
	}
	const BRect bounds = Bounds();
	const float line = _LineHeight();
	BRect changed(bounds.left, bounds.top, bounds.right, bounds.top + line);
	if (fOrientation == B_VERTICAL)
		changed.OffsetTo(bounds.left, bounds.bottom - line);
	Invalidate(changed);
}
