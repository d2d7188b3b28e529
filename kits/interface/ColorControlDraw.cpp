// Where the ramps of colour controls are, and how they are drawn.
#include <ColorControl.h>

#include <algorithm>
#include <cmath>

#include <TextControl.h>
#include <Window.h>

#include "interface/private/ColorControlParts.h"
#include "interface/private/Label.h"
#include "interface/private/Look.h"

using namespace BPrivate;


// #pragma mark - geometry


int32
BColorControl::_Rows() const
{
	return 256 / fLayout;
}


// Inside the bevel.
BRect
BColorControl::_PaletteFrame() const
{
	return BRect(kBevel, kBevel, kBevel + static_cast<int32>(fLayout) * fCellSize,
		kBevel + _Rows() * fCellSize - 1);
}


BRect
BColorControl::_RampFrame(int32 ramp) const
{
	const BRect palette = _PaletteFrame();
	const float height = (palette.Height() + 1) / kRampCount;
	return BRect(palette.left, std::floor(palette.top + ramp * height), palette.right,
		std::floor(palette.top + (ramp + 1) * height) - 1);
}


int32
BColorControl::_RampAt(BPoint where) const
{
	for (int32 ramp = 0; ramp < kRampCount; ramp++) {
		if (_RampFrame(ramp).Contains(where))
			return ramp;
	}
	return -1;
}


void
BColorControl::SetCellSize(float size)
{
	fCellSize = std::max(size, kMinimumCellSize);
	_PlaceFields();
	ResizeToPreferred();
	Invalidate();
}


float
BColorControl::CellSize() const
{
	return fCellSize;
}


void
BColorControl::SetLayout(color_control_layout layout)
{
	fLayout = CheckedLayout(layout);
	_PlaceFields();
	ResizeToPreferred();
	Invalidate();
}


color_control_layout
BColorControl::Layout() const
{
	return fLayout;
}


void
BColorControl::GetPreferredSize(float* _width, float* _height)
{
	const BRect palette = _PaletteFrame();
	if (_width != NULL)
		*_width = palette.right + kBevel;
	if (_height != NULL)
		*_height = palette.bottom + kBevel;
	if (const BTextControl* field = _Field(0); field != NULL && _width != NULL)
		*_width += kFieldGap + field->Bounds().Width();
	if (const BTextControl* field = _Field(2); field != NULL && _height != NULL)
		*_height = std::max(*_height, field->Frame().bottom);
}


void
BColorControl::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


// #pragma mark - drawing


void
BColorControl::Draw(BRect updateRect)
{
	const rgb_color base = Look::BaseColor(this);
	BRect frame = _PaletteFrame();
	frame.InsetBy(-kBevel, -kBevel);
	Look::DrawFieldFrame(this, frame, base, IsEnabled() ? Look::kNormal : Look::kDisabled);
	for (int32 ramp = 0; ramp < kRampCount; ramp++) {
		if (_RampFrame(ramp).Intersects(updateRect & Bounds()))
			_DrawRamp(ramp, updateRect & Bounds());
	}

	if (IsFocus() && IsEnabled() && Window()->IsActive()) {
		const rgb_color color = Look::NavigationColor();
		Look::DrawRing(this, _RampFrame(fFocusedRamp), color, color);
	}
}


// Only the columns that are asked for: the cells, and with them the ramp, may be of any size.
void
BColorControl::_DrawRamp(int32 ramp, BRect updateRect)
{
	const BRect frame = _RampFrame(ramp);
	const BRect visible = frame & updateRect;
	const rgb_color base = Look::BaseColor(this);
	const float first = std::floor(visible.left);
	const int32 columns = static_cast<int32>(visible.right - first) + 1;

	BeginLineArray(columns);
	for (int32 i = 0; i < columns; i++) {
		const float x = first + i;
		const float part = std::clamp((x - frame.left) / frame.Width(), 0.0f, 1.0f);
		const uint8 amount = static_cast<uint8>(part * 255);
		rgb_color color = { 0, 0, 0, 255 };
		if (ramp == kGreyRamp || ramp == 1)
			color.red = amount;
		if (ramp == kGreyRamp || ramp == 2)
			color.green = amount;
		if (ramp == kGreyRamp || ramp == 3)
			color.blue = amount;
		if (!IsEnabled())
			color = mix_color(color, base, 128);
		AddLine(BPoint(x, visible.top), BPoint(x, visible.bottom), color);
	}
	EndLineArray();

	const int32 amount = _RampValue(ramp);
	if (amount < 0)
		return;
	const float x = std::floor(frame.left + amount * frame.Width() / 255 + 0.5f);
	Look::DrawColorMarker(this, frame, x, IsEnabled() ? Look::kNormal : Look::kDisabled);
}
