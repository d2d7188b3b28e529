// The formulas of the drawing modes, for one pixel each.
#pragma once

#include <algorithm>

#include <GraphicsDefs.h>

namespace BPrivate {

// What a drawing call paints with. Pixels are 0xAARRGGBB.
struct Ink {
	drawing_mode mode = B_OP_COPY;
	alpha_function alphaFunction = B_ALPHA_OVERLAY;
	uint32 high = 0xff000000;
	uint32 low = 0xffffffff;
	// With a constant alpha this is that of the high colour, else -1.
	int32 constantAlpha = -1;
	// The destination's alpha means something (SurfaceFormat::kAlpha).
	bool keepsAlpha = false;

	void SetHigh(rgb_color color)
	{
		high = (uint32)color.alpha << 24 | (uint32)color.red << 16 | (uint32)color.green << 8
			| color.blue;
		if (constantAlpha >= 0)
			constantAlpha = color.alpha;
	}
};

inline uint32
Alpha(uint32 pixel)
{
	return pixel >> 24;
}

inline int32
Brightness(uint32 pixel)
{
	return 77 * (pixel >> 16 & 0xff) + 150 * (pixel >> 8 & 0xff) + 29 * (pixel & 0xff);
}

inline uint32
WithAlpha(uint32 pixel, uint32 alpha)
{
	return (pixel & 0x00ffffff) | alpha << 24;
}

// Applies a function of two components to red, green and blue; alpha is the greater of both.
template<typename Function>
inline uint32
PerComponent(uint32 a, uint32 b, Function function)
{
	const uint32 red = function(a >> 16 & 0xff, b >> 16 & 0xff);
	const uint32 green = function(a >> 8 & 0xff, b >> 8 & 0xff);
	const uint32 blue = function(a & 0xff, b & 0xff);
	return std::max(Alpha(a), Alpha(b)) << 24 | red << 16 | green << 8 | blue;
}

// d + (s - d) * a / 255, cut towards d.
inline uint32
MixComponents(uint32 d, uint32 s, int32 alpha)
{
	return PerComponent(
		d, s, [alpha](int32 from, int32 to) { return from + (to - from) * alpha / 255; });
}

// Porter and Duff's "over" on colours that alpha is not multiplied into.
inline uint32
ComposeOver(uint32 d, uint32 s, uint32 sourceAlpha)
{
	const uint32 destinationAlpha = Alpha(d);
	const uint32 alpha = sourceAlpha + destinationAlpha * (255 - sourceAlpha) / 255;
	if (alpha == 0)
		return 0;
	const uint32 sourceShare = sourceAlpha * 255 / alpha;
	return WithAlpha(MixComponents(d, s, sourceShare), alpha);
}

inline uint32
BlendAlpha(uint32 d, uint32 s, uint32 alpha, const Ink& ink)
{
	if (ink.alphaFunction != B_ALPHA_OVERLAY && ink.keepsAlpha)
		return ComposeOver(d, s, alpha);
	return MixComponents(d, s, alpha) | 0xff000000;
}

// The result where a source pixel meets a destination pixel, in the modes that need no pattern
// bit to say so.
template<drawing_mode kMode>
inline uint32
BlendPixel(uint32 d, uint32 s, const Ink& ink)
{
	switch (kMode) {
		case B_OP_COPY:
		case B_OP_OVER:
			return s;
		case B_OP_ERASE:
			return ink.low;
		case B_OP_INVERT:
			return d ^ 0x00ffffff;
		case B_OP_ADD:
			return PerComponent(d, s, [](uint32 a, uint32 b) { return std::min(255u, a + b); });
		case B_OP_SUBTRACT:
			return PerComponent(d, s, [](uint32 a, uint32 b) { return a > b ? a - b : 0; });
		case B_OP_BLEND:
			return PerComponent(d, s, [](uint32 a, uint32 b) { return (a + b) / 2; });
		case B_OP_MIN:
			return Brightness(s) < Brightness(d) ? s : d;
		case B_OP_MAX:
			return Brightness(s) > Brightness(d) ? s : d;
		case B_OP_SELECT:
			if (((d ^ ink.high) & 0x00ffffff) == 0)
				return ink.low;
			return ((d ^ ink.low) & 0x00ffffff) == 0 ? ink.high : d;
		case B_OP_ALPHA:
			return BlendAlpha(d, s, ink.constantAlpha >= 0 ? ink.constantAlpha : Alpha(s), ink);
	}
	return d;
}

// The modes in which a clear pattern bit leaves the destination alone.
constexpr bool
LeavesClearBits(drawing_mode mode)
{
	return mode == B_OP_OVER || mode == B_OP_ERASE || mode == B_OP_INVERT || mode == B_OP_SELECT;
}

template<drawing_mode kMode>
inline uint32
BlendBit(uint32 d, bool bit, const Ink& ink)
{
	if (LeavesClearBits(kMode))
		return bit ? BlendPixel<kMode>(d, ink.high, ink) : d;
	return BlendPixel<kMode>(d, bit ? ink.high : ink.low, ink);
}

// A bitmap's pixel with alpha 0 changes nothing, except in B_OP_COPY.
template<drawing_mode kMode>
inline uint32
BlendBitmap(uint32 d, uint32 s, const Ink& ink)
{
	if (kMode != B_OP_COPY && Alpha(s) == 0)
		return d;
	return BlendPixel<kMode>(d, s, ink);
}

// A result that covers only a part of its pixel; coverage from 0 to 255.
inline uint32
Cover(uint32 d, uint32 result, uint32 coverage, const Ink& ink)
{
	if (coverage == 255)
		return result;
	if (ink.keepsAlpha && Alpha(d) != 255)
		return ComposeOver(d, result, Alpha(result) * coverage / 255);

	// Two components at a time, with one spare byte each.
	const uint32 rest = 256 - (coverage + (coverage >> 7));
	const uint32 share = 256 - rest;
	const uint32 redBlue = (((d & 0xff00ff) * rest + (result & 0xff00ff) * share) >> 8) & 0xff00ff;
	const uint32 alphaGreen =
		((d >> 8 & 0xff00ff) * rest + (result >> 8 & 0xff00ff) * share) & 0xff00ff00;
	return redBlue | alphaGreen;
}


} // namespace BPrivate
