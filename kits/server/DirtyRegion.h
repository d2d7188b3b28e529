// DirtyRegion: the part of a window that has to be painted again.
#pragma once

#include <vector>

#include <Region.h>

namespace BPrivate {


// Collects rectangles at a constant cost each and puts them together when the result is wanted,
// by halves. A region that has become too scattered is widened to larger rectangles.
class DirtyRegion {
public:
	bool IsEmpty() const { return fPending.empty() && fRegion.IsEmpty(); }

	void Add(clipping_rect rect);
	void Add(const BRegion& region);
	void MakeEmpty();
	const BRegion& Region();
	BRegion Take();

	// What lies in the area has been moved: its dirty parts have moved along, and what has left
	// the area is gone.
	void Shift(const BRegion& area, int32 dx, int32 dy);

private:
	void _Fold();

	BRegion fRegion;
	std::vector<clipping_rect> fPending;
};


// A region as its list of rectangles, for many questions about small parts of it: each takes time
// for that part alone.
class RegionIndex {
public:
	explicit RegionIndex(const BRegion& region);

	bool Intersects(const clipping_rect& rect) const;
	BRegion Part(const clipping_rect& rect) const;

private:
	size_t _FirstReaching(int32 top) const;

	std::vector<clipping_rect> fRects; // bands from the top, in each from the left
	clipping_rect fFrame;
};


// The union of many rectangles, in time n log n. Empties the vector.
BRegion unite(std::vector<clipping_rect>& rects);

// Whole pixels, and none for an invalid rectangle. Fractions round outwards.
clipping_rect to_pixels(BRect rect);
clipping_rect intersect(const clipping_rect& a, const clipping_rect& b);
inline bool
is_empty(const clipping_rect& rect)
{
	return rect.left > rect.right || rect.top > rect.bottom;
}
inline bool
contains(const clipping_rect& outer, const clipping_rect& inner)
{
	return inner.left >= outer.left && inner.top >= outer.top && inner.right <= outer.right
		&& inner.bottom <= outer.bottom;
}


} // namespace BPrivate
