// Compositor: the one place where pixels are written, by mode, pattern, coverage and clip.
#pragma once

#include <GraphicsDefs.h>
#include <Region.h>

#include "server/paint/Blend.h"
#include "server/paint/Surface.h"

namespace BPrivate {


// Works in device pixels; rectangles include their right and bottom edge. Everything is cut to
// the clip and to the surface. Lives for one drawing call.
class Compositor {
public:
	// The clip is in logical pixels, NULL is everything; patterns start at the logical pixel
	// `origin`. All arguments outlive the compositor.
	Compositor(Surface& surface, const BRegion* clip, const Ink& ink, const pattern& pattern,
		int32 originX, int32 originY);

	// Nothing outside of it can be painted; not valid if that is everything.
	const clipping_rect& Bounds() const { return fBounds; }

	void FillRect(const clipping_rect& rect);
	// A byte of coverage a pixel.
	void FillMask(const clipping_rect& rect, const uint8* coverage, int32 bytesPerRow);
	// A pixel of the source for each pixel of the rectangle; pixelsPerRow apart.
	void DrawPixels(const clipping_rect& rect, const uint32* pixels, int32 pixelsPerRow);

	// Calls the function for each part of the rectangle inside the clip.
	template<typename Function>
	void ForEachPart(const clipping_rect& rect, Function function) const;

private:
	enum class PatternKind { kHigh, kLow, kMixed };

	int32 _FirstClipRect(int32 deviceTop) const;
	void _ReadPattern(int32 deviceX, int32 deviceY, int32 count, uint8* bits) const;
	void _FillPart(const clipping_rect& part);
	void _CopyPattern(const clipping_rect& part);

	Surface& fSurface;
	const BRegion* fClip;
	const Ink& fInk;
	const pattern& fPattern;
	PatternKind fKind;
	int32 fOriginX;
	int32 fOriginY;
	clipping_rect fBounds;
	int32 fClipCount;
};

inline clipping_rect
Intersect(const clipping_rect& a, const clipping_rect& b)
{
	return { a.left > b.left ? a.left : b.left, a.top > b.top ? a.top : b.top,
		a.right < b.right ? a.right : b.right, a.bottom < b.bottom ? a.bottom : b.bottom };
}

inline bool
IsValid(const clipping_rect& rect)
{
	return rect.left <= rect.right && rect.top <= rect.bottom;
}

template<typename Function>
void
Compositor::ForEachPart(const clipping_rect& rect, Function function) const
{
	const clipping_rect inside = Intersect(rect, fBounds);
	if (!IsValid(inside))
		return;
	if (fClipCount <= 1) {
		function(inside);
		return;
	}
	for (int32 i = _FirstClipRect(inside.top); i < fClipCount; i++) {
		const clipping_rect clip = fSurface.ToDevice(fClip->RectAtInt(i));
		if (clip.top > inside.bottom)
			break;
		const clipping_rect part = Intersect(inside, clip);
		if (IsValid(part))
			function(part);
	}
}


} // namespace BPrivate
