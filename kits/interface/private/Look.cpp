#include "interface/private/Look.h"

#include <algorithm>
#include <cmath>

#include "interface/private/LookParts.h"

namespace BPrivate::Look {

namespace {

constexpr float kLargestArrow = 12; // from the middle of its base to an end

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


// #pragma mark - parts


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

} // namespace BPrivate::Look
