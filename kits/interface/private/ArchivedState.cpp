#include "interface/private/ArchivedState.h"

#include <cmath>

#include <InterfaceDefs.h>
#include <View.h>

#include "interface/private/FontAccess.h"

namespace BPrivate {

namespace {

void
read_font(const BMessage& archive, FontSpec* _font)
{
	const char* family;
	const char* style;
	if (archive.FindString("_fname", 0, &family) == B_OK
		&& archive.FindString("_fname", 1, &style) == B_OK) {
		// A family that is not installed does not lose the style: what was bold stays bold.
		BFont font;
		if (font.SetFamilyAndStyle(family, style) == B_OK
			|| font.SetFamilyAndStyle(NULL, style) == B_OK) {
			const FontSpec spec = ToFontSpec(font);
			_font->familyAndStyle = spec.familyAndStyle;
			_font->face = spec.face;
		}
	}
	float value;
	if (archive.FindFloat("_fflt", 0, &value) == B_OK && value > 0)
		_font->size = value;
	if (archive.FindFloat("_fflt", 1, &value) == B_OK && value >= 45 && value <= 135)
		_font->shear = value;
	if (archive.FindFloat("_fflt", 2, &value) == B_OK && value >= 0 && value <= 360)
		_font->rotation = value;
}


void
read_colors(const BMessage& archive, rgb_color colors[ArchivedState::kColors])
{
	for (int32 i = 0; i < ArchivedState::kColors; i++) {
		int32 value;
		if (archive.FindInt32("_color", i, &value) == B_OK)
			colors[i] = unpacked(value);
		int32 which;
		if (archive.FindInt32("_uicolor", i, &which) == B_OK && which != B_NO_COLOR) {
			float tint;
			if (archive.FindFloat("_uitint", i, &tint) != B_OK)
				tint = B_NO_TINT;
			colors[i] = tint_color(ui_color(static_cast<color_which>(which)), tint);
		}
	}
}


void
read_modes(const BMessage& archive, DrawState* _draw)
{
	_draw->origin = archive.GetPoint("_origin", _draw->origin);
	_draw->scale = archive.GetFloat("_scale", _draw->scale);
	_draw->penSize = archive.GetFloat("_psize", _draw->penSize);
	_draw->penLocation = archive.GetPoint("_ploc", _draw->penLocation);

	int16 cap, join, source, function;
	float miter;
	if (archive.FindInt16("_lmcapjoin", 0, &cap) == B_OK
		&& archive.FindInt16("_lmcapjoin", 1, &join) == B_OK
		&& archive.FindFloat("_lmmiter", &miter) == B_OK) {
		_draw->lineCap = static_cast<cap_mode>(cap);
		_draw->lineJoin = static_cast<join_mode>(join);
		_draw->miterLimit = miter;
	}
	if (archive.FindInt16("_blend", 0, &source) == B_OK
		&& archive.FindInt16("_blend", 1, &function) == B_OK) {
		_draw->sourceAlpha = static_cast<source_alpha>(source);
		_draw->alphaFunction = static_cast<alpha_function>(function);
	}
	_draw->mode = static_cast<drawing_mode>(archive.GetInt32("_dmod", _draw->mode));
	_draw->combinedOrigin = _draw->origin;
	_draw->combinedScale = _draw->scale;
}

} // namespace


ArchivedState
read_archived_state(const BMessage& archive)
{
	ArchivedState state;
	const BRect frame = archive.GetRect("_frame", state.frame);
	state.frame.Set(std::round(frame.left), std::round(frame.top), std::round(frame.right),
		std::round(frame.bottom));
	state.mode = static_cast<uint32>(archive.GetInt32("_resize_mode", 0)) & _RESIZE_MASK_;
	state.flags = static_cast<uint32>(archive.GetInt32("_flags", 0)) & ~_RESIZE_MASK_;
	int32 mask, options;
	if (archive.FindInt32("_evmask", 0, &mask) == B_OK
		&& archive.FindInt32("_evmask", 1, &options) == B_OK) {
		state.eventMask = mask;
		state.eventOptions = options;
	}
	read_font(archive, &state.draw.font);
	read_colors(archive, state.colors);
	state.draw.highColor = state.colors[0];
	state.draw.lowColor = state.colors[1];
	read_modes(archive, &state.draw);
	state.hideCount = archive.GetInt16("_show", 0);
	return state;
}


uint32
packed(rgb_color color)
{
	return static_cast<uint32>(color.red) << 24 | static_cast<uint32>(color.green) << 16
		| static_cast<uint32>(color.blue) << 8 | color.alpha;
}


rgb_color
unpacked(uint32 value)
{
	return { static_cast<uint8>(value >> 24), static_cast<uint8>(value >> 16),
		static_cast<uint8>(value >> 8), static_cast<uint8>(value) };
}


bool
same_font(const FontSpec& a, const FontSpec& b)
{
	return a.familyAndStyle == b.familyAndStyle && a.size == b.size && a.shear == b.shear
		&& a.rotation == b.rotation;
}


bool
is_default(const DrawState& draw)
{
	const DrawState usual;
	return draw.highColor == usual.highColor && draw.lowColor == usual.lowColor
		&& draw.mode == usual.mode && draw.sourceAlpha == usual.sourceAlpha
		&& draw.alphaFunction == usual.alphaFunction && draw.penSize == usual.penSize
		&& draw.lineCap == usual.lineCap && draw.lineJoin == usual.lineJoin
		&& draw.miterLimit == usual.miterLimit && draw.penLocation == usual.penLocation
		&& draw.origin == usual.origin && draw.scale == usual.scale && draw.font == usual.font;
}


} // namespace BPrivate
