// BRegion: how two regions become one.
#include <Region.h>

#include <algorithm>
#include <stdlib.h>
#include <utility>

#include "interface/private/RegionParts.h"

using namespace BPrivate;

namespace {

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
