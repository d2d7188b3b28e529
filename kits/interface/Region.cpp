#include <Region.h>

#include <algorithm>
#include <math.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <utility>

#include "interface/private/RegionParts.h"

using namespace BPrivate;

namespace {

bool
IsValid(const clipping_rect& rect)
{
	return rect.left <= rect.right && rect.top <= rect.bottom;
}


int32
Limit(int64 coordinate)
{
	return (int32)std::clamp<int64>(coordinate, -kMaxCoordinate, kMaxCoordinate);
}


clipping_rect
Limit(const clipping_rect& rect)
{
	return { Limit(rect.left), Limit(rect.top), Limit(rect.right), Limit(rect.bottom) };
}


// Not-a-number becomes 0.
int32
ToInteger(float rounded)
{
	if (!(rounded > -kMaxCoordinate))
		return isnan(rounded) ? 0 : -kMaxCoordinate;
	return rounded < kMaxCoordinate ? (int32)rounded : kMaxCoordinate;
}


clipping_rect
ToClipping(const BRect& rect)
{
	if (!rect.IsValid())
		return kEmptyRect;
	return { ToInteger(floorf(rect.left)), ToInteger(floorf(rect.top)),
		ToInteger(ceilf(rect.right)), ToInteger(ceilf(rect.bottom)) };
}


BRect
ToRect(const clipping_rect& rect)
{
	return BRect(rect.left, rect.top, rect.right, rect.bottom);
}


bool
Contains(const clipping_rect& outer, const clipping_rect& inner)
{
	return outer.left <= inner.left && inner.right <= outer.right && outer.top <= inner.top
		&& inner.bottom <= outer.bottom;
}


clipping_rect
Intersection(const clipping_rect& a, const clipping_rect& b)
{
	return { std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
		std::min(a.bottom, b.bottom) };
}


bool
Overlap(const clipping_rect& a, const clipping_rect& b)
{
	return IsValid(Intersection(a, b));
}


} // namespace


// #pragma mark - making and comparing


BRegion::BRegion() : fCount(0), fBounds(kEmptyRect), fRects(NULL)
{
}


BRegion::BRegion(const BRegion& region) : BRegion()
{
	*this = region;
}


BRegion::BRegion(BRegion&& region) noexcept : BRegion()
{
	*this = std::move(region);
}


BRegion::BRegion(const BRect rect) : BRegion()
{
	Set(rect);
}


BRegion::~BRegion()
{
	free(fRects);
}


BRegion&
BRegion::operator=(const BRegion& region)
{
	if (this == &region)
		return *this;

	clipping_rect* rects = NULL;
	if (region.fRects != NULL) {
		rects = static_cast<clipping_rect*>(malloc(region.fCount * sizeof(clipping_rect)));
		if (rects == NULL)
			return *this;
		memcpy(rects, region.fRects, region.fCount * sizeof(clipping_rect));
	}
	free(fRects);
	fRects = rects;
	fCount = region.fCount;
	fBounds = region.fBounds;
	return *this;
}


BRegion&
BRegion::operator=(BRegion&& region) noexcept
{
	std::swap(fRects, region.fRects);
	std::swap(fCount, region.fCount);
	std::swap(fBounds, region.fBounds);
	return *this;
}


bool
BRegion::operator==(const BRegion& other) const
{
	return fCount == other.fCount
		&& (fCount == 0 || memcmp(_Rects(), other._Rects(), fCount * sizeof(clipping_rect)) == 0);
}


void
BRegion::Set(BRect rect)
{
	Set(ToClipping(rect));
}


void
BRegion::Set(clipping_rect rect)
{
	MakeEmpty();
	if (!IsValid(rect))
		return;
	fBounds = Limit(rect);
	fCount = 1;
}


void
BRegion::MakeEmpty()
{
	free(fRects);
	fRects = NULL;
	fCount = 0;
	fBounds = kEmptyRect;
}


// #pragma mark - asking


BRect
BRegion::Frame() const
{
	return ToRect(fBounds);
}


BRect
BRegion::RectAt(int32 index) const
{
	return ToRect(RectAtInt(index));
}


clipping_rect
BRegion::RectAtInt(int32 index) const
{
	return index >= 0 && index < fCount ? _Rects()[index] : kEmptyRect;
}


bool
BRegion::Intersects(BRect rect) const
{
	return Intersects(ToClipping(rect));
}


bool
BRegion::Intersects(clipping_rect rect) const
{
	if (fCount == 0 || !IsValid(rect) || !Overlap(rect, fBounds))
		return false;

	const clipping_rect* end = _Rects() + fCount;
	const clipping_rect* at = std::lower_bound(_Rects(), end, rect.top,
		[](const clipping_rect& candidate, int32 top) { return candidate.bottom < top; });
	for (; at != end && at->top <= rect.bottom; at++) {
		if (at->left <= rect.right && rect.left <= at->right)
			return true;
	}
	return false;
}


bool
BRegion::Contains(BPoint point) const
{
	return Contains(ToInteger(floorf(point.x)), ToInteger(floorf(point.y)));
}


bool
BRegion::Contains(int32 x, int32 y) const
{
	return Intersects(clipping_rect { x, y, x, y });
}


// #pragma mark - combining


void
BRegion::Include(BRect rect)
{
	Include(ToClipping(rect));
}


void
BRegion::Include(clipping_rect rect)
{
	BRegion other;
	other.Set(rect);
	Include(&other);
}


void
BRegion::Include(const BRegion* region)
{
	if (region->fCount == 0 || (fCount == 1 && ::Contains(fBounds, region->fBounds)))
		return;
	if (fCount == 0 || (region->fCount == 1 && ::Contains(region->fBounds, fBounds))) {
		*this = *region;
		return;
	}
	_Combine(*region, Operation::kUnion);
}


void
BRegion::Exclude(BRect rect)
{
	Exclude(ToClipping(rect));
}


void
BRegion::Exclude(clipping_rect rect)
{
	BRegion other;
	other.Set(rect);
	Exclude(&other);
}


void
BRegion::Exclude(const BRegion* region)
{
	if (fCount == 0 || region->fCount == 0 || !Overlap(fBounds, region->fBounds))
		return;
	if (region->fCount == 1 && ::Contains(region->fBounds, fBounds)) {
		MakeEmpty();
		return;
	}
	_Combine(*region, Operation::kDifference);
}


void
BRegion::IntersectWith(const BRegion* region)
{
	if (fCount == 0)
		return;
	if (region->fCount == 0 || !Overlap(fBounds, region->fBounds)) {
		MakeEmpty();
		return;
	}
	if (region->fCount == 1 && ::Contains(region->fBounds, fBounds))
		return;
	if (fCount == 1 && region->fCount == 1) {
		fBounds = Intersection(fBounds, region->fBounds);
		return;
	}
	if (fCount == 1 && ::Contains(fBounds, region->fBounds)) {
		*this = *region;
		return;
	}
	_Combine(*region, Operation::kIntersection);
}


void
BRegion::ExclusiveInclude(const BRegion* region)
{
	if (region->fCount == 0)
		return;
	_Combine(*region, Operation::kEither);
}


void
BRegion::OffsetBy(int32 dx, int32 dy)
{
	auto move = [dx, dy](clipping_rect& rect) {
		rect = { Limit((int64)rect.left + dx), Limit((int64)rect.top + dy),
			Limit((int64)rect.right + dx), Limit((int64)rect.bottom + dy) };
	};

	if (fCount == 0)
		return;
	move(fBounds);
	for (int32 i = 0; fRects != NULL && i < fCount; i++)
		move(fRects[i]);
}


void
BRegion::OffsetBy(const BPoint& point)
{
	OffsetBy(ToInteger(roundf(point.x)), ToInteger(roundf(point.y)));
}


void
BRegion::PrintToStream() const
{
	Frame().PrintToStream();
	for (int32 i = 0; i < fCount; i++) {
		const clipping_rect rect = RectAtInt(i);
		printf("%d: (%d, %d, %d, %d)\n", (int)i, (int)rect.left, (int)rect.top, (int)rect.right,
			(int)rect.bottom);
	}
}
