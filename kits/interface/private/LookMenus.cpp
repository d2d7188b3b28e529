// The look of menus and menu fields.
#include <cmath>

#include "interface/private/LookParts.h"

namespace BPrivate::Look {


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
