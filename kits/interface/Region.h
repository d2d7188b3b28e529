// BRegion: a set of whole pixels, kept as rectangles that do not overlap.
#pragma once

#include <Rect.h>

// Edges in whole pixels; right and bottom are inside.
struct clipping_rect {
	int32 left;
	int32 top;
	int32 right;
	int32 bottom;
};


// The rectangles lie in bands, sorted from top to bottom and within a band from left to right; no
// two rectangles of a band touch, and no two bands that touch have the same columns. So one set
// has one form, and every operation is one merge of two sorted lists. A region of one rectangle
// needs no memory of its own. Not thread-safe.
class BRegion {
public:
	BRegion();
	BRegion(const BRegion& region);
	BRegion(BRegion&& region) noexcept;
	// Fractional edges are rounded outwards. An invalid rectangle gives the empty region.
	BRegion(const BRect rect);
	virtual ~BRegion();

	BRegion& operator=(const BRegion& region);
	BRegion& operator=(BRegion&& region) noexcept;
	bool operator==(const BRegion& other) const;
	bool operator!=(const BRegion& other) const { return !(*this == other); }

	void Set(BRect rect);
	void Set(clipping_rect rect);
	void MakeEmpty();

	// The smallest rectangle round everything; not valid when empty.
	BRect Frame() const;
	clipping_rect FrameInt() const { return fBounds; }
	// Out of range gives an invalid rectangle.
	BRect RectAt(int32 index) const;
	clipping_rect RectAtInt(int32 index) const;
	int32 CountRects() const { return fCount; }
	bool IsEmpty() const { return fCount == 0; }

	bool Intersects(BRect rect) const;
	bool Intersects(clipping_rect rect) const;
	bool Contains(BPoint point) const;
	bool Contains(int32 x, int32 y) const;

	void Include(BRect rect);
	void Include(clipping_rect rect);
	void Include(const BRegion* region);
	void Exclude(BRect rect);
	void Exclude(clipping_rect rect);
	void Exclude(const BRegion* region);
	void IntersectWith(const BRegion* region);
	// Keeps what is in exactly one of the two.
	void ExclusiveInclude(const BRegion* region);

	void OffsetBy(int32 dx, int32 dy);
	void OffsetBy(const BPoint& point);
	void PrintToStream() const;

private:
	class Builder;
	enum class Operation;

	const clipping_rect* _Rects() const { return fRects != NULL ? fRects : &fBounds; }
	void _Combine(const BRegion& other, Operation operation);
	void _Adopt(Builder& builder);

	int32 fCount;
	clipping_rect fBounds;
	clipping_rect* fRects; // ours, by malloc(); NULL for none or one rectangle
};
