// The look of bars: sliders, ramps, progress, tabs and scroll bars.
#include <algorithm>
#include <cmath>

#include "interface/private/LookParts.h"

namespace BPrivate::Look {


void
DrawProgressBar(BView* view, BRect frame, rgb_color base, rgb_color barColor, float filled)
{
	PlainPen pen(view);
	DrawRing(view, frame, tint_color(base, B_DARKEN_1_TINT), tint_color(base, B_LIGHTEN_2_TINT));
	DrawRing(view, Inset(frame, 1), tint_color(base, B_DARKEN_4_TINT), base);

	BRect inside = Inset(frame, 2);
	if (!inside.IsValid())
		return;
	const float right = inside.right;
	if (filled >= inside.left) {
		inside.right = std::min(filled, right);
		DrawRing(view, inside, tint_color(barColor, B_LIGHTEN_2_TINT),
			tint_color(barColor, B_DARKEN_2_TINT));
		Fill(view, Inset(inside, 1), barColor);
		inside.left = inside.right + 1;
		inside.right = right;
	}
	if (inside.IsValid())
		Fill(view, inside, DocumentColor());
}


// #pragma mark - sliders and tabs


void
DrawSliderBar(BView* view, BRect frame, rgb_color base, rgb_color barColor, uint32 state)
{
	PlainPen pen(view);
	const bool disabled = (state & kDisabled) != 0;
	// An alpha of 0 is kept in archives, but a bar is always seen.
	barColor.alpha = 255;
	const rgb_color color = disabled ? Blend(barColor, base) : barColor;
	DrawRing(view, frame, tint_color(base, B_DARKEN_1_TINT), tint_color(base, B_LIGHTEN_MAX_TINT));
	DrawRing(view, Inset(frame, 1), tint_color(color, B_DARKEN_2_TINT), color);
	Fill(view, Inset(frame, 2), color);
}


void
DrawSliderFill(BView* view, BRect part, rgb_color base, rgb_color fillColor, uint32 state)
{
	PlainPen pen(view);
	fillColor.alpha = 255;
	const rgb_color color = (state & kDisabled) != 0 ? Blend(fillColor, base) : fillColor;
	part.InsetBy(1, 1);
	Fill(view, part, color);
	if (part.IsValid())
		DrawLeftTop(view, part, tint_color(color, B_DARKEN_2_TINT));
}


void
DrawSliderBlockThumb(BView* view, BRect frame, orientation direction, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const bool disabled = (state & kDisabled) != 0;
	const bool focused = (state & kFocused) != 0 && !disabled;
	const rgb_color edge = focused ? NavigationColor()
								   : tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT);
	DrawRoundRing(view, frame, edge);
	DrawRing(view, Inset(frame, 1), tint_color(base, B_LIGHTEN_MAX_TINT),
		tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_2_TINT));
	Fill(view, Inset(frame, 2),
		tint_color(base, (state & kPressed) != 0 ? B_NO_TINT : B_LIGHTEN_2_TINT));

	// The notch that shows the exact place.
	const rgb_color dark = tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_3_TINT);
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	if (direction == B_HORIZONTAL) {
		const float x = std::floor((frame.left + frame.right) / 2);
		DrawLines(view,
			{
				{ BPoint(x, frame.top + 3), BPoint(x, frame.bottom - 3), dark },
				{ BPoint(x + 1, frame.top + 3), BPoint(x + 1, frame.bottom - 3), light },
			});
	} else {
		const float y = std::floor((frame.top + frame.bottom) / 2);
		DrawLines(view,
			{
				{ BPoint(frame.left + 3, y), BPoint(frame.right - 3, y), dark },
				{ BPoint(frame.left + 3, y + 1), BPoint(frame.right - 3, y + 1), light },
			});
	}
}


void
DrawSliderTriangleThumb(
	BView* view, BRect frame, orientation direction, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const bool disabled = (state & kDisabled) != 0;
	const bool focused = (state & kFocused) != 0 && !disabled;
	const rgb_color edge = focused ? NavigationColor()
								   : tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT);
	const rgb_color face = tint_color(base, (state & kPressed) != 0 ? B_NO_TINT : B_LIGHTEN_2_TINT);
	const float x = std::floor((frame.left + frame.right) / 2);
	const float y = std::floor((frame.top + frame.bottom) / 2);

	BPoint tip(x, frame.top);
	BPoint left(frame.left, frame.bottom);
	BPoint right(frame.right, frame.bottom);
	if (direction == B_VERTICAL) {
		tip = BPoint(frame.left, y);
		left = BPoint(frame.right, frame.bottom);
		right = BPoint(frame.right, frame.top);
	}
	view->SetHighColor(face);
	view->FillTriangle(tip, left, right);
	DrawLines(view,
		{
			{ tip, left, edge },
			{ left, right, edge },
			{ right, tip, edge },
		});
}


void
DrawHashMark(BView* view, BPoint from, BPoint to, rgb_color base, uint32 state)
{
	const BPoint beside = from.x == to.x ? BPoint(1, 0) : BPoint(0, 1);
	const bool disabled = (state & kDisabled) != 0;
	DrawLines(view,
		{
			{ from, to, tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_3_TINT) },
			{ from + beside, to + beside, tint_color(base, B_LIGHTEN_MAX_TINT) },
		});
}


void
DrawColorMarker(BView* view, BRect ramp, float x, uint32 state)
{
	PlainPen pen(view);
	BRect ring(x - 2, ramp.top + 1, x + 2, ramp.bottom - 1);
	if (ring.left < ramp.left)
		ring.OffsetTo(ramp.left, ring.top);
	if (ring.right > ramp.right)
		ring.OffsetTo(ramp.right - ring.Width(), ring.top);
	const bool disabled = (state & kDisabled) != 0;
	const rgb_color outside = disabled ? TextColor(state) : rgb_color { 0, 0, 0, 255 };
	DrawRing(view, ring, outside, outside);
	DrawRing(view, Inset(ring, 1), DocumentColor(), DocumentColor());
}


void
DrawTab(BView* view, BRect frame, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const bool front = (state & kOn) != 0;
	const rgb_color face = front ? base : tint_color(base, (1 + B_DARKEN_1_TINT) / 2);
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	const rgb_color dark = tint_color(base, B_DARKEN_2_TINT);
	const rgb_color darker = tint_color(base, B_DARKEN_4_TINT);
	const float bottom = frame.bottom;

	Fill(view, BRect(frame.left + 1, frame.top + 2, frame.right - 1, bottom), face);
	Fill(view, BRect(frame.left + 3, frame.top + 1, frame.right - 3, frame.top + 1), face);
	DrawLines(view,
		{
			// A dark outline with cut corners, and the light that falls on it from the left top.
			{ BPoint(frame.left, bottom), BPoint(frame.left, frame.top + 3), darker },
			{ BPoint(frame.left, frame.top + 3), BPoint(frame.left + 3, frame.top), darker },
			{ BPoint(frame.left + 3, frame.top), BPoint(frame.right - 3, frame.top), darker },
			{ BPoint(frame.right - 3, frame.top), BPoint(frame.right, frame.top + 3), darker },
			{ BPoint(frame.right, frame.top + 3), BPoint(frame.right, bottom), darker },
			{ BPoint(frame.left + 1, bottom), BPoint(frame.left + 1, frame.top + 3), light },
			{ BPoint(frame.left + 1, frame.top + 3), BPoint(frame.left + 3, frame.top + 1), light },
			{ BPoint(frame.left + 3, frame.top + 1), BPoint(frame.right - 3, frame.top + 1),
				light },
			{ BPoint(frame.right - 1, frame.top + 3), BPoint(frame.right - 1, bottom), dark },
		});
}


void
DrawTabBody(BView* view, BRect frame, BRect selectedTab, rgb_color base)
{
	PlainPen pen(view);
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	const rgb_color dark = tint_color(base, B_DARKEN_2_TINT);
	const rgb_color darker = tint_color(base, B_DARKEN_4_TINT);
	BRect gap;
	if (selectedTab.IsValid()) {
		gap = selectedTab;
		gap.InsetBy(1, 0);
	}
	DrawBrokenRing(view, frame, darker, darker, gap);
	BRect innerGap = gap;
	if (gap.IsValid())
		innerGap.right--;
	DrawBrokenRing(view, Inset(frame, 1), light, dark, innerGap);
}


// #pragma mark - scroll bars


void
DrawScrollBarFrame(BView* view, BRect frame, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const rgb_color edge =
		(state & kFocused) != 0 ? NavigationColor() : tint_color(base, B_DARKEN_2_TINT);
	DrawRing(view, frame, edge, edge);
}


void
DrawScrollBarButton(BView* view, BRect frame, Direction direction, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const bool disabled = (state & kDisabled) != 0;
	const bool pressed = (state & kPressed) != 0 && !disabled;
	rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	rgb_color dark = tint_color(base, B_DARKEN_1_TINT);
	rgb_color face = tint_color(base, disabled ? B_LIGHTEN_1_TINT : B_LIGHTEN_2_TINT);
	if (pressed) {
		std::swap(light, dark);
		face = tint_color(base, B_DARKEN_1_TINT);
	}
	DrawRing(view, frame, light, dark);
	Fill(view, Inset(frame, 1), face);
	DrawArrow(view, Inset(frame, 1), direction,
		tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_4_TINT));
}


void
DrawScrollBarArea(BView* view, BRect frame, orientation direction, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	if ((state & kDisabled) != 0) {
		Fill(view, frame, tint_color(base, B_LIGHTEN_1_TINT));
		return;
	}
	Fill(
		view, frame, tint_color(base, (state & kPressed) != 0 ? B_DARKEN_2_TINT : B_DARKEN_1_TINT));
	// The shadow that the frame throws on the sunken ground.
	const rgb_color shadow = tint_color(base, B_DARKEN_2_TINT);
	DrawLines(view,
		{ direction == B_VERTICAL ? Line { frame.LeftTop(), frame.LeftBottom(), shadow }
								  : Line { frame.LeftTop(), frame.RightTop(), shadow } });
}


void
DrawScrollBarThumb(BView* view, BRect frame, orientation direction, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const rgb_color edge = tint_color(base, B_DARKEN_2_TINT);
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	const rgb_color dark = tint_color(base, B_DARKEN_1_TINT);
	const rgb_color face = tint_color(base, (state & kPressed) != 0 ? B_NO_TINT : B_LIGHTEN_2_TINT);

	// Only the lines across the bar belong to the thumb; the bar's frame has the other two.
	if (direction == B_VERTICAL) {
		DrawLines(view,
			{ { frame.LeftTop(), frame.RightTop(), edge },
				{ frame.LeftBottom(), frame.RightBottom(), edge } });
		frame.InsetBy(0, 1);
	} else {
		DrawLines(view,
			{ { frame.LeftTop(), frame.LeftBottom(), edge },
				{ frame.RightTop(), frame.RightBottom(), edge } });
		frame.InsetBy(1, 0);
	}
	DrawRing(view, frame, light, dark);
	Fill(view, Inset(frame, 1), face);

	// Three grip lines across the middle, where there is room for them.
	const float length = direction == B_VERTICAL ? frame.Height() : frame.Width();
	if (length < 14)
		return;
	const float x = std::floor((frame.left + frame.right) / 2);
	const float y = std::floor((frame.top + frame.bottom) / 2);
	for (int grip = -1; grip <= 1; grip++) {
		const float offset = grip * 3.0f;
		if (direction == B_VERTICAL) {
			DrawLines(view,
				{
					{ BPoint(frame.left + 3, y + offset), BPoint(frame.right - 3, y + offset),
						edge },
					{ BPoint(frame.left + 3, y + offset + 1),
						BPoint(frame.right - 3, y + offset + 1), light },
				});
		} else {
			DrawLines(view,
				{
					{ BPoint(x + offset, frame.top + 3), BPoint(x + offset, frame.bottom - 3),
						edge },
					{ BPoint(x + offset + 1, frame.top + 3),
						BPoint(x + offset + 1, frame.bottom - 3), light },
				});
		}
	}
}


// A raised plate with ridges across the corner to take hold of.
void
DrawDragHandle(BView* view, BPoint rightBottom, rgb_color base)
{
	PlainPen pen(view);
	BRect frame(rightBottom, rightBottom);
	frame.left -= kDragHandleSize - 1;
	frame.top -= kDragHandleSize - 1;
	const rgb_color dark = tint_color(base, B_DARKEN_4_TINT);
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	Fill(view, frame, tint_color(base, B_DARKEN_1_TINT));
	DrawRing(view, frame, tint_color(base, B_DARKEN_2_TINT), dark);
	DrawLeftTop(
		view, BRect(frame.left + 1, frame.top + 1, frame.right - 1, frame.bottom - 1), light);
	DrawLines(view,
		{
			{ BPoint(frame.left + 2, frame.bottom - 1), BPoint(frame.right - 1, frame.top + 2),
				dark },
			{ BPoint(frame.left + 3, frame.bottom - 1), BPoint(frame.right - 1, frame.top + 3),
				light },
			{ BPoint(frame.left + 5, frame.bottom - 1), BPoint(frame.right - 1, frame.top + 5),
				dark },
		});
}


} // namespace BPrivate::Look
