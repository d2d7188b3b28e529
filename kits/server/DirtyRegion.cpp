#include "server/DirtyRegion.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace BPrivate {

namespace {

constexpr size_t kMaxPending = 512;
constexpr int32 kMaxRects = 1024;
constexpr int32 kCoarseBits = 5; // tiles of 32 pixels

constexpr float kFarthest = 1 << 28; // keeps sums of coordinates within an int32


BRegion
unite_part(std::span<const clipping_rect> rects)
{
	BRegion region;
	if (rects.size() <= 4) {
		for (const clipping_rect& rect : rects)
			region.Include(rect);
		return region;
	}
	const size_t half = rects.size() / 2;
	region = unite_part(rects.first(half));
	const BRegion rest = unite_part(rects.subspan(half));
	region.Include(&rest);
	return region;
}


clipping_rect
coarser(const clipping_rect& rect)
{
	constexpr int32 kMask = (1 << kCoarseBits) - 1;
	return { rect.left & ~kMask, rect.top & ~kMask, rect.right | kMask, rect.bottom | kMask };
}

} // namespace


clipping_rect
to_pixels(BRect rect)
{
	if (!(rect.left <= rect.right && rect.top <= rect.bottom))
		return { 0, 0, -1, -1 };
	const auto pixel = [](float edge) {
		return static_cast<int32>(std::clamp(edge, -kFarthest, kFarthest));
	};
	return { pixel(std::floor(rect.left)), pixel(std::floor(rect.top)),
		pixel(std::ceil(rect.right)), pixel(std::ceil(rect.bottom)) };
}


clipping_rect
intersect(const clipping_rect& a, const clipping_rect& b)
{
	return { std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
		std::min(a.bottom, b.bottom) };
}


BRegion
unite(std::vector<clipping_rect>& rects)
{
	// Sorted from the top, halves lie apart and merging them is mostly joining two lists.
	std::sort(rects.begin(), rects.end(), [](const clipping_rect& a, const clipping_rect& b) {
		return a.top != b.top ? a.top < b.top : a.left < b.left;
	});
	BRegion region = unite_part(rects);
	rects.clear();
	return region;
}


// #pragma mark - RegionIndex


RegionIndex::RegionIndex(const BRegion& region) : fFrame(region.FrameInt())
{
	fRects.reserve(region.CountRects());
	for (int32 i = 0; i < region.CountRects(); i++)
		fRects.push_back(region.RectAtInt(i));
}


// The first rectangle that does not end above.
size_t
RegionIndex::_FirstReaching(int32 top) const
{
	const auto found = std::partition_point(fRects.begin(), fRects.end(),
		[top](const clipping_rect& rect) { return rect.bottom < top; });
	return found - fRects.begin();
}


bool
RegionIndex::Intersects(const clipping_rect& rect) const
{
	for (size_t i = _FirstReaching(rect.top); i < fRects.size() && fRects[i].top <= rect.bottom;
		 i++) {
		if (!is_empty(intersect(fRects[i], rect)))
			return true;
	}
	return false;
}


BRegion
RegionIndex::Part(const clipping_rect& rect) const
{
	std::vector<clipping_rect> parts;
	for (size_t i = _FirstReaching(rect.top); i < fRects.size() && fRects[i].top <= rect.bottom;
		 i++) {
		const clipping_rect part = intersect(fRects[i], rect);
		if (!is_empty(part))
			parts.push_back(part);
	}
	return unite(parts);
}


// #pragma mark - DirtyRegion


void
DirtyRegion::Add(clipping_rect rect)
{
	if (is_empty(rect))
		return;
	// Neighbours are often invalidated one inside the other.
	if (!fPending.empty() && contains(fPending.back(), rect))
		return;
	while (!fPending.empty() && contains(rect, fPending.back()))
		fPending.pop_back();

	fPending.push_back(rect);
	if (fPending.size() >= kMaxPending)
		_Fold();
}


void
DirtyRegion::Add(const BRegion& region)
{
	if (region.CountRects() == 1) {
		Add(region.FrameInt());
		return;
	}
	_Fold();
	fRegion.Include(&region);
}


void
DirtyRegion::MakeEmpty()
{
	fPending.clear();
	fRegion.MakeEmpty();
}


const BRegion&
DirtyRegion::Region()
{
	_Fold();
	return fRegion;
}


BRegion
DirtyRegion::Take()
{
	_Fold();
	BRegion region(std::move(fRegion));
	fRegion.MakeEmpty();
	return region;
}


void
DirtyRegion::Shift(const BRegion& area, int32 dx, int32 dy)
{
	_Fold();
	BRegion moved(fRegion);
	moved.IntersectWith(&area);
	if (moved.IsEmpty())
		return;
	fRegion.Exclude(&area);
	moved.OffsetBy(dx, dy);
	moved.IntersectWith(&area);
	fRegion.Include(&moved);
}


void
DirtyRegion::_Fold()
{
	if (fPending.empty())
		return;
	const BRegion added = unite(fPending);
	fRegion.Include(&added);
	if (fRegion.CountRects() <= kMaxRects)
		return;

	std::vector<clipping_rect> tiles;
	for (int32 i = 0; i < fRegion.CountRects(); i++)
		tiles.push_back(coarser(fRegion.RectAtInt(i)));
	fRegion = unite(tiles);
	if (fRegion.CountRects() > kMaxRects)
		fRegion.Set(fRegion.FrameInt());
}


} // namespace BPrivate
