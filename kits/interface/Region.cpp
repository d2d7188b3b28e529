#include <Region.h>

#include <algorithm>
#include <math.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <utility>

namespace {

// Far outside of every drawing, yet no sum of two overflows.
constexpr int32 kMaxCoordinate = 0x3fffffff;

constexpr clipping_rect kEmptyRect = { 0, 0, -1, -1 };


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


// One band: consecutive rectangles of the same top and bottom.
struct Band {
	const clipping_rect* begin;
	const clipping_rect* end;
};


// Walks the bands of a region from the top.
class BandWalker {
public:
	BandWalker(const clipping_rect* rects, int32 count) : fNext(rects), fEnd(rects + count)
	{
		Advance();
	}

	bool AtEnd() const { return fBand.begin == fBand.end; }
	int32 Top() const { return fBand.begin->top; }
	int32 End() const { return fBand.begin->bottom + 1; }
	bool Covers(int32 y) const { return !AtEnd() && Top() <= y; }
	const Band& Current() const { return fBand; }

	// The next line below y where this region changes.
	int32 NextChange(int32 y) const
	{
		if (AtEnd())
			return kMaxCoordinate + 2;
		return Covers(y) ? End() : Top();
	}

	void Advance()
	{
		fBand.begin = fNext;
		while (fNext != fEnd && fNext->top == fBand.begin->top)
			fNext++;
		fBand.end = fNext;
	}

private:
	const clipping_rect* fNext;
	const clipping_rect* fEnd;
	Band fBand;
};


// Walks the left and right ends of a band's rectangles.
class EdgeWalker {
public:
	EdgeWalker(const Band& band) : fRect(band.begin), fEnd(band.end) {}

	bool Inside() const { return fInside; }
	int32 Next() const
	{
		if (fRect == fEnd)
			return kMaxCoordinate + 2;
		return fInside ? fRect->right + 1 : fRect->left;
	}
	void PassTo(int32 x)
	{
		if (Next() != x)
			return;
		if (fInside)
			fRect++;
		fInside = !fInside;
	}

private:
	const clipping_rect* fRect;
	const clipping_rect* fEnd;
	bool fInside = false;
};

} // namespace


enum class BRegion::Operation { kUnion, kIntersection, kDifference, kEither };


// Collects the rectangles of a result band by band, and joins a band to the one above it when
// both have the same columns.
class BRegion::Builder {
public:
	~Builder() { free(fRects); }

	bool Failed() const { return fFailed; }
	int32 Count() const { return fCount; }
	const clipping_rect* Rects() const { return fRects; }
	clipping_rect* Detach() { return std::exchange(fRects, nullptr); }

	void Add(const clipping_rect& rect);
	void EndBand();

private:
	bool _SameColumns() const;

	clipping_rect* fRects = NULL;
	int32 fCount = 0;
	int32 fCapacity = 0;
	int32 fBand = 0; // where the band that is being built begins
	int32 fPreviousBand = 0;
	bool fFailed = false;
};


void
BRegion::Builder::Add(const clipping_rect& rect)
{
	if (fCount == fCapacity) {
		const int32 capacity = std::max(8, fCapacity * 2);
		void* rects = realloc(fRects, capacity * sizeof(clipping_rect));
		if (rects == NULL) {
			fFailed = true;
			return;
		}
		fRects = static_cast<clipping_rect*>(rects);
		fCapacity = capacity;
	}
	fRects[fCount++] = rect;
}


void
BRegion::Builder::EndBand()
{
	if (fBand == fCount)
		return;
	if (_SameColumns()) {
		for (int32 i = fPreviousBand; i < fBand; i++)
			fRects[i].bottom = fRects[fBand].bottom;
		fCount = fBand;
		return;
	}
	fPreviousBand = fBand;
	fBand = fCount;
}


bool
BRegion::Builder::_SameColumns() const
{
	const int32 width = fCount - fBand;
	if (fBand - fPreviousBand != width || fBand == 0
		|| fRects[fPreviousBand].bottom + 1 != fRects[fBand].top)
		return false;
	for (int32 i = 0; i < width; i++) {
		const clipping_rect& above = fRects[fPreviousBand + i];
		const clipping_rect& here = fRects[fBand + i];
		if (above.left != here.left || above.right != here.right)
			return false;
	}
	return true;
}


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


// #pragma mark - merging


// One pass from top to bottom over both lists; within each strip, where neither changes, one pass
// from left to right. Without memory for the result the region stays as it is.
void
BRegion::_Combine(const BRegion& other, Operation operation)
{
	auto holds = [operation](bool a, bool b) {
		switch (operation) {
			case Operation::kUnion:
				return a || b;
			case Operation::kIntersection:
				return a && b;
			case Operation::kDifference:
				return a && !b;
			default:
				return a != b;
		}
	};

	Builder builder;
	BandWalker a(_Rects(), fCount);
	BandWalker b(other._Rects(), other.fCount);
	int32 y = -kMaxCoordinate - 1;
	while (!a.AtEnd() || !b.AtEnd()) {
		const int32 end = std::min(a.NextChange(y), b.NextChange(y));
		EdgeWalker edgesA(a.Covers(y) ? a.Current() : Band());
		EdgeWalker edgesB(b.Covers(y) ? b.Current() : Band());
		bool inside = false;
		int32 start = 0;
		for (;;) {
			const int32 x = std::min(edgesA.Next(), edgesB.Next());
			if (x > kMaxCoordinate + 1)
				break;
			edgesA.PassTo(x);
			edgesB.PassTo(x);
			if (holds(edgesA.Inside(), edgesB.Inside()) == inside)
				continue;
			if (inside)
				builder.Add({ start, y, x - 1, end - 1 });
			start = x;
			inside = !inside;
		}
		builder.EndBand();

		y = end;
		if (!a.AtEnd() && a.End() == y)
			a.Advance();
		if (!b.AtEnd() && b.End() == y)
			b.Advance();
	}
	_Adopt(builder);
}


void
BRegion::_Adopt(Builder& builder)
{
	if (builder.Failed())
		return;
	const int32 count = builder.Count();
	if (count <= 1) {
		const clipping_rect rect = count == 1 ? builder.Rects()[0] : kEmptyRect;
		MakeEmpty();
		if (count == 1)
			Set(rect);
		return;
	}

	free(fRects);
	fRects = builder.Detach();
	fCount = count;
	fBounds = { fRects[0].left, fRects[0].top, fRects[0].right, fRects[count - 1].bottom };
	for (int32 i = 1; i < count; i++) {
		fBounds.left = std::min(fBounds.left, fRects[i].left);
		fBounds.right = std::max(fBounds.right, fRects[i].right);
	}
}
