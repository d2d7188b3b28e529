#include "interface/private/Look.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>

#include <View.h>

namespace BPrivate::Look {

namespace {

constexpr float kLargestArrow = 12; // from the middle of its base to an end

struct Line {
	BPoint from;
	BPoint to;
	rgb_color color;
};

// Gives the view the plain pen that the look draws with, and its own state back in the end.
class PlainPen {
public:
	explicit PlainPen(BView* view) :
		fView(view), fHigh(view->HighColor()), fLow(view->LowColor()), fPen(view->PenLocation()),
		fPenSize(view->PenSize()), fMode(view->DrawingMode())
	{
		if (fPenSize != 1.0f)
			fView->SetPenSize(1.0f);
		if (fMode != B_OP_COPY)
			fView->SetDrawingMode(B_OP_COPY);
	}

	~PlainPen()
	{
		fView->SetHighColor(fHigh);
		fView->SetLowColor(fLow);
		fView->MovePenTo(fPen);
		if (fPenSize != 1.0f)
			fView->SetPenSize(fPenSize);
		if (fMode != B_OP_COPY)
			fView->SetDrawingMode(fMode);
	}

	PlainPen(const PlainPen&) = delete;
	PlainPen& operator=(const PlainPen&) = delete;

private:
	BView* fView;
	rgb_color fHigh;
	rgb_color fLow;
	BPoint fPen;
	float fPenSize;
	drawing_mode fMode;
};

void
DrawLines(BView* view, std::initializer_list<Line> lines)
{
	view->BeginLineArray(static_cast<int32>(lines.size()));
	for (const Line& line : lines)
		view->AddLine(line.from, line.to, line.color);
	view->EndLineArray();
}


void
Fill(BView* view, BRect frame, rgb_color color)
{
	if (!frame.IsValid())
		return;
	view->SetHighColor(color);
	view->FillRect(frame);
}


// A ring without its four corner pixels.
void
DrawRoundRing(BView* view, BRect frame, rgb_color color)
{
	DrawLines(view,
		{
			{ BPoint(frame.left + 1, frame.top), BPoint(frame.right - 1, frame.top), color },
			{ BPoint(frame.right, frame.top + 1), BPoint(frame.right, frame.bottom - 1), color },
			{ BPoint(frame.left + 1, frame.bottom), BPoint(frame.right - 1, frame.bottom), color },
			{ BPoint(frame.left, frame.top + 1), BPoint(frame.left, frame.bottom - 1), color },
		});
}


void
DrawLeftTop(BView* view, BRect frame, rgb_color color)
{
	DrawLines(view,
		{
			{ frame.LeftBottom(), frame.LeftTop(), color },
			{ frame.LeftTop(), frame.RightTop(), color },
		});
}


// A ring whose top line leaves out the columns of the gap.
void
DrawBrokenRing(BView* view, BRect frame, rgb_color leftTop, rgb_color rightBottom, BRect gap)
{
	if (!gap.IsValid()) {
		DrawRing(view, frame, leftTop, rightBottom);
		return;
	}
	DrawLines(view,
		{
			{ frame.LeftBottom(), frame.LeftTop(), leftTop },
			{ frame.RightTop(), frame.RightBottom(), rightBottom },
			{ frame.RightBottom(), frame.LeftBottom(), rightBottom },
		});
	if (gap.left > frame.left) {
		DrawLines(view,
			{ { frame.LeftTop(), BPoint(std::min(gap.left - 1, frame.right), frame.top),
				leftTop } });
	}
	if (gap.right < frame.right) {
		DrawLines(view,
			{ { BPoint(std::max(gap.right + 1, frame.left), frame.top), frame.RightTop(),
				leftTop } });
	}
}


rgb_color
Blend(rgb_color a, rgb_color b)
{
	const auto half = [](int x, int y) { return static_cast<uint8>((x + y) / 2); };
	return { half(a.red, b.red), half(a.green, b.green), half(a.blue, b.blue), 255 };
}


BRect
Inset(BRect frame, float by)
{
	frame.InsetBy(by, by);
	return frame;
}


// The dark ring, the bevels and the face: a push button as it looks when it is not the default.
void
DrawButtonBody(BView* view, BRect frame, rgb_color base, uint32 state)
{
	const bool disabled = (state & kDisabled) != 0;
	DrawRoundRing(view, frame, tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT));

	if ((state & kPressed) != 0 && !disabled) {
		Fill(view, Inset(frame, 1), { 0, 0, 0, 255 });
		return;
	}

	const rgb_color white = tint_color(base, B_LIGHTEN_MAX_TINT);
	Fill(view, Inset(frame, 3), tint_color(base, B_LIGHTEN_2_TINT));
	DrawRing(view, Inset(frame, 1), tint_color(base, B_LIGHTEN_1_TINT),
		tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_2_TINT));
	DrawRing(view, Inset(frame, 2), white, base);
	BRect inner = Inset(frame, 3);
	inner.right--;
	inner.bottom--;
	if (inner.IsValid())
		DrawLeftTop(view, inner, white);
}


// The sunken double ring that frames white fields.
void
DrawSunkenRings(BView* view, BRect frame, rgb_color base, uint32 state)
{
	const bool disabled = (state & kDisabled) != 0;
	DrawRing(view, frame, tint_color(base, B_DARKEN_1_TINT),
		tint_color(base, disabled ? B_LIGHTEN_2_TINT : B_LIGHTEN_MAX_TINT));

	if ((state & kFocused) != 0 && !disabled) {
		DrawRing(view, Inset(frame, 1), NavigationColor(), NavigationColor());
		return;
	}
	DrawRing(view, Inset(frame, 1), tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT),
		base);
}

} // namespace


// #pragma mark - colours


rgb_color
PanelColor()
{
	return ui_color(B_PANEL_BACKGROUND_COLOR);
}


rgb_color
TextColor(uint32 state)
{
	if ((state & kDisabled) != 0)
		return tint_color(PanelColor(), B_DISABLED_LABEL_TINT);
	return { 0, 0, 0, 255 };
}


rgb_color
NavigationColor()
{
	return ui_color(B_KEYBOARD_NAVIGATION_COLOR);
}


rgb_color
MarkColor()
{
	return ui_color(B_KEYBOARD_NAVIGATION_COLOR);
}


rgb_color
DocumentColor()
{
	return { 255, 255, 255, 255 };
}


rgb_color
MenuColor()
{
	return ui_color(B_MENU_BACKGROUND_COLOR);
}


rgb_color
MenuSelectionColor()
{
	return tint_color(MenuColor(), B_HIGHLIGHT_BACKGROUND_TINT);
}


rgb_color
ListSelectionColor(rgb_color listColor)
{
	return tint_color(listColor, B_DARKEN_2_TINT);
}


rgb_color
StatusBarColor()
{
	return { 50, 150, 255, 255 };
}


bool
IsTransparent(rgb_color color)
{
	return color == B_TRANSPARENT_COLOR;
}


rgb_color
ColorOfParent(const BView* view)
{
	const BView* parent = view->Parent();
	if (parent == nullptr)
		return PanelColor();
	const rgb_color color = parent->ViewColor();
	return IsTransparent(color) ? PanelColor() : color;
}


rgb_color
BaseColor(const BView* view)
{
	for (; view != nullptr; view = view->Parent()) {
		const rgb_color color = view->ViewColor();
		if (!IsTransparent(color))
			return color;
	}
	return PanelColor();
}


// #pragma mark - frames


void
DrawRing(BView* view, BRect frame, rgb_color leftTop, rgb_color rightBottom)
{
	if (!frame.IsValid())
		return;
	DrawLines(view,
		{
			{ frame.LeftBottom(), frame.LeftTop(), leftTop },
			{ frame.LeftTop(), frame.RightTop(), leftTop },
			{ frame.RightTop(), frame.RightBottom(), rightBottom },
			{ frame.RightBottom(), frame.LeftBottom(), rightBottom },
		});
}


void
DrawGroove(BView* view, BRect frame, rgb_color base, BRect gap)
{
	PlainPen pen(view);
	frame.right--;
	frame.bottom--;
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	const rgb_color dark = tint_color(base, B_DARKEN_3_TINT);
	DrawBrokenRing(view, frame.OffsetByCopy(1, 1), light, light, gap);
	DrawBrokenRing(view, frame, dark, dark, gap);
}


void
DrawPlainFrame(BView* view, BRect frame, rgb_color base, BRect gap)
{
	PlainPen pen(view);
	DrawBrokenRing(
		view, frame, tint_color(base, B_LIGHTEN_MAX_TINT), tint_color(base, B_DARKEN_3_TINT), gap);
}


void
DrawSeparator(BView* view, BRect frame, rgb_color base)
{
	PlainPen pen(view);
	const rgb_color dark = tint_color(base, B_DARKEN_2_TINT);
	const rgb_color light = tint_color(base, B_LIGHTEN_2_TINT);
	if (frame.Width() >= frame.Height()) {
		const float y = std::floor((frame.top + frame.bottom) / 2);
		DrawLines(view,
			{
				{ BPoint(frame.left, y), BPoint(frame.right, y), dark },
				{ BPoint(frame.left, y + 1), BPoint(frame.right, y + 1), light },
			});
	} else {
		const float x = std::floor((frame.left + frame.right) / 2);
		DrawLines(view,
			{
				{ BPoint(x, frame.top), BPoint(x, frame.bottom), dark },
				{ BPoint(x + 1, frame.top), BPoint(x + 1, frame.bottom), light },
			});
	}
}


void
DrawRaised(BView* view, BRect frame, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const bool disabled = (state & kDisabled) != 0;
	rgb_color face = tint_color(base, B_LIGHTEN_1_TINT);
	rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	rgb_color dark = tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_2_TINT);
	if ((state & kPressed) != 0) {
		face = tint_color(base, B_DARKEN_1_TINT);
		std::swap(light, dark);
	}
	const rgb_color edge = tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT);
	DrawRing(view, frame, edge, edge);
	DrawRing(view, Inset(frame, 1), light, dark);
	Fill(view, Inset(frame, 2), face);
}


void
DrawFieldFrame(BView* view, BRect frame, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	DrawSunkenRings(view, frame, base, state);
}


// #pragma mark - marks


void
DrawButton(BView* view, BRect frame, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	if ((state & kDefault) == 0) {
		DrawRing(view, frame, base, base);
		DrawButtonBody(view, Inset(frame, 1), base, state);
		return;
	}

	// The default button stands inside a second ring, with a moat between the two.
	const bool disabled = (state & kDisabled) != 0;
	DrawRing(view, frame, base, base);
	DrawRoundRing(view, frame, tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT));
	const rgb_color moat = tint_color(base, disabled ? B_NO_TINT : B_DARKEN_1_TINT);
	for (int ring = 1; ring <= 3; ring++)
		DrawRing(view, Inset(frame, ring), moat, moat);
	DrawButtonBody(view, Inset(frame, kDefaultButtonInset + 1), base, state);
}


void
DrawCheckBox(BView* view, BPoint leftTop, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const BRect frame(
		leftTop.x, leftTop.y, leftTop.x + kCheckBoxSize - 1, leftTop.y + kCheckBoxSize - 1);
	const bool disabled = (state & kDisabled) != 0;

	Fill(view, Inset(frame, 2), tint_color(base, disabled ? B_LIGHTEN_2_TINT : B_LIGHTEN_MAX_TINT));
	DrawSunkenRings(view, frame, base, state & ~kFocused);
	if ((state & kPressed) != 0) {
		const rgb_color dark = tint_color(base, B_DARKEN_3_TINT);
		DrawRing(view, Inset(frame, 1), dark, dark);
		DrawRing(view, Inset(frame, 2), dark, dark);
	}

	const rgb_color mark = disabled ? tint_color(base, B_DARKEN_3_TINT) : MarkColor();
	const BRect m = Inset(frame, 3);
	if ((state & kPartlyOn) != 0) {
		Fill(view, BRect(m.left, m.top + 2, m.right, m.bottom - 2), mark);
		return;
	}
	if ((state & kOn) == 0)
		return;

	// Each stroke of the cross is two pixels wide.
	const BPoint right(1, 0);
	DrawLines(view,
		{
			{ m.LeftTop(), m.RightBottom() - right, mark },
			{ m.LeftTop() + right, m.RightBottom(), mark },
			{ m.RightTop(), m.LeftBottom() + right, mark },
			{ m.RightTop() - right, m.LeftBottom(), mark },
		});
}


void
DrawRadioButton(BView* view, BPoint leftTop, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const BRect frame(
		leftTop.x, leftTop.y, leftTop.x + kCheckBoxSize - 1, leftTop.y + kCheckBoxSize - 1);
	const bool disabled = (state & kDisabled) != 0;
	const bool pressed = (state & kPressed) != 0;

	view->SetHighColor(tint_color(base, disabled ? B_LIGHTEN_2_TINT : B_LIGHTEN_MAX_TINT));
	view->FillEllipse(Inset(frame, 1));
	// Light falls from the left top: the upper half of each ring is dark, the lower one light.
	view->SetHighColor(tint_color(base, disabled ? B_LIGHTEN_2_TINT : B_LIGHTEN_MAX_TINT));
	view->StrokeArc(frame, 225, 180);
	view->SetHighColor(tint_color(base, B_DARKEN_1_TINT));
	view->StrokeArc(frame, 45, 180);
	view->SetHighColor(base);
	view->StrokeArc(Inset(frame, 1), 225, 180);
	view->SetHighColor(tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT));
	view->StrokeArc(Inset(frame, 1), 45, 180);
	if (pressed) {
		view->SetHighColor(tint_color(base, B_DARKEN_3_TINT));
		view->StrokeEllipse(Inset(frame, 1));
		view->StrokeEllipse(Inset(frame, 2));
	}

	if ((state & kOn) != 0) {
		view->SetHighColor(disabled ? tint_color(base, B_DARKEN_3_TINT) : MarkColor());
		view->FillEllipse(Inset(frame, 4));
	}
}


void
DrawFocusLine(BView* view, float left, float right, float baseline)
{
	PlainPen pen(view);
	view->SetHighColor(NavigationColor());
	view->StrokeLine(BPoint(left, baseline + 2), BPoint(right, baseline + 2));
}


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


// #pragma mark - arrows


void
DrawArrow(BView* view, BRect frame, Direction direction, rgb_color color)
{
	PlainPen pen(view);
	const float x = std::floor((frame.left + frame.right) / 2);
	const float y = std::floor((frame.top + frame.bottom) / 2);
	const float room = std::min(frame.Width(), frame.Height());
	const float half = std::clamp(std::floor(room / 3), 2.0f, kLargestArrow);
	const float before = std::floor(half / 2);
	const float after = half - before;

	view->SetHighColor(color);
	// Rows of pixels rather than a triangle, so that the tip is one pixel at every size.
	for (float step = 0; step <= half; step++) {
		const float reach = step;
		switch (direction) {
			case Direction::kUp:
				view->StrokeLine(
					BPoint(x - reach, y - before + step), BPoint(x + reach, y - before + step));
				break;
			case Direction::kDown:
				view->StrokeLine(
					BPoint(x - reach, y + after - step), BPoint(x + reach, y + after - step));
				break;
			case Direction::kLeft:
				view->StrokeLine(
					BPoint(x - before + step, y - reach), BPoint(x - before + step, y + reach));
				break;
			case Direction::kRight:
				view->StrokeLine(
					BPoint(x + after - step, y - reach), BPoint(x + after - step, y + reach));
				break;
		}
	}
}


void
DrawLatch(BView* view, BRect frame, bool expanded, bool pressed)
{
	const rgb_color color = tint_color(PanelColor(), pressed ? B_DARKEN_MAX_TINT : B_DARKEN_4_TINT);
	DrawArrow(view, frame, expanded ? Direction::kDown : Direction::kRight, color);
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


// #pragma mark - menus


void
DrawMenuFrame(BView* view, BRect frame, rgb_color base)
{
	PlainPen pen(view);
	const rgb_color edge = tint_color(base, B_DARKEN_3_TINT);
	DrawRing(view, frame, edge, edge);
	DrawRing(view, Inset(frame, 1), tint_color(base, B_LIGHTEN_MAX_TINT),
		tint_color(base, B_DARKEN_1_TINT));
}


void
DrawMenuBarFrame(BView* view, BRect frame, rgb_color base)
{
	PlainPen pen(view);
	DrawRing(view, frame, tint_color(base, B_LIGHTEN_MAX_TINT), tint_color(base, B_DARKEN_1_TINT));
	DrawLines(
		view, { { frame.LeftBottom(), frame.RightBottom(), tint_color(base, B_DARKEN_2_TINT) } });
}


void
DrawMenuItemBackground(BView* view, BRect frame, rgb_color base, uint32 state)
{
	PlainPen pen(view);
	const bool selected = (state & (kOn | kPressed)) != 0;
	Fill(view, frame, selected ? tint_color(base, B_HIGHLIGHT_BACKGROUND_TINT) : base);
}


void
DrawMenuCheckMark(BView* view, BRect frame, uint32 state)
{
	PlainPen pen(view);
	const rgb_color color = TextColor(state);
	const float x = std::floor((frame.left + frame.right) / 2) - 1;
	const float y = std::floor((frame.top + frame.bottom) / 2) + 3;
	DrawLines(view,
		{
			{ BPoint(x - 2, y - 2), BPoint(x, y), color },
			{ BPoint(x - 2, y - 3), BPoint(x, y - 1), color },
			{ BPoint(x, y), BPoint(x + 5, y - 5), color },
			{ BPoint(x, y - 1), BPoint(x + 5, y - 6), color },
		});
}


void
DrawSubmenuMark(BView* view, BRect frame, uint32 state)
{
	DrawArrow(view, frame, Direction::kRight, TextColor(state));
}


void
DrawMenuField(BView* view, BRect frame, rgb_color base, bool popUpMark, uint32 state)
{
	PlainPen pen(view);
	const bool disabled = (state & kDisabled) != 0;
	const rgb_color edge = tint_color(base, disabled ? B_DARKEN_1_TINT : B_DARKEN_3_TINT);
	const rgb_color light = tint_color(base, B_LIGHTEN_MAX_TINT);
	const rgb_color dark = tint_color(base, B_DARKEN_1_TINT);

	// A shadow at the right and at the bottom lifts the field a little.
	DrawRing(view, frame, base, disabled ? base : Blend(base, edge));
	frame.right--;
	frame.bottom--;
	DrawRing(view, frame, edge, edge);
	DrawRing(view, Inset(frame, 1), light, dark);
	Fill(view, Inset(frame, 2),
		(state & kPressed) != 0 ? tint_color(base, B_HIGHLIGHT_BACKGROUND_TINT) : base);
	if (!popUpMark)
		return;

	BRect mark = Inset(frame, 2);
	mark.left = mark.right - kPopUpMarkWidth + 3;
	DrawArrow(view, mark, Direction::kDown,
		tint_color(base, disabled ? B_DARKEN_2_TINT : B_DARKEN_4_TINT));
}

} // namespace BPrivate::Look
