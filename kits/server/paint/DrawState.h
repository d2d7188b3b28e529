// DrawState: what a view's drawing calls depend on besides their arguments.
#pragma once

#include <GraphicsDefs.h>
#include <Point.h>
#include <Region.h>

#include "server/paint/FontSpec.h"

namespace BPrivate {


// One level of a view's state stack; the view keeps the levels and intersects their clipping.
// The defaults are those of a new view.
struct DrawState {
	rgb_color highColor = { 0, 0, 0, 255 };
	rgb_color lowColor = { 255, 255, 255, 255 };
	drawing_mode mode = B_OP_COPY;
	source_alpha sourceAlpha = B_PIXEL_ALPHA;
	alpha_function alphaFunction = B_ALPHA_OVERLAY;
	float penSize = 1;
	cap_mode lineCap = B_BUTT_CAP;
	join_mode lineJoin = B_MITER_JOIN;
	float miterLimit = B_DEFAULT_MITER_LIMIT;
	int32 fillRule = B_NONZERO;
	BPoint penLocation;

	// This level's own, and those of all levels up to it put together; drawing uses the latter.
	BPoint origin;
	float scale = 1;
	BPoint combinedOrigin;
	float combinedScale = 1;

	FontSpec font;

	bool hasClipping = false;
	BRegion clipping; // this level's constraint, in view coordinates; empty allows nothing

	// From the coordinates of a drawing call to the view's own, and lengths alike.
	BPoint Transform(BPoint point) const
	{
		return BPoint(
			combinedOrigin.x + point.x * combinedScale, combinedOrigin.y + point.y * combinedScale);
	}
	float Transform(float length) const { return length * combinedScale; }
};


} // namespace BPrivate
