// CoverageRaster: how much of each pixel lies inside an outline of straight lines.
#pragma once

#include <Region.h>

namespace BPrivate {


// The exact area on the left of each line is summed up, row by row; the running sum along a row is
// then the winding number, with fractions at the edges. Its memory is the thread's and used again:
// one at a time.
class CoverageRaster {
public:
	// Device pixels; must be valid.
	explicit CoverageRaster(const clipping_rect& rect);

	// Device coordinates: pixel x reaches from x to x + 1. Outlines must be closed.
	void AddLine(double x0, double y0, double x1, double y1);
	// A byte a pixel, without gaps; valid until the thread's next raster.
	const uint8* Finish(bool evenOdd);

private:
	void _AddInside(float x0, float y0, float x1, float y1);

	clipping_rect fRect;
	int32 fWidth;
	int32 fHeight;
	float* fSums; // fWidth + 2 a row
};


} // namespace BPrivate
