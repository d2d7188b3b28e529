// BRect: a rectangle by its four edges; the right and the bottom edge belong to it.
#pragma once

#include <math.h>

#include <Point.h>


// Width() and Height() are differences of edges: the rectangle covers one pixel more each way.
class BRect {
public:
	float left;
	float top;
	float right;
	float bottom;

	// The default rectangle is (0, 0, -1, -1), which is not valid.
	BRect() : left(0), top(0), right(-1), bottom(-1) {}
	BRect(float left, float top, float right, float bottom) :
		left(left), top(top), right(right), bottom(bottom)
	{
	}
	BRect(BPoint leftTop, BPoint rightBottom) :
		left(leftTop.x), top(leftTop.y), right(rightBottom.x), bottom(rightBottom.y)
	{
	}
	BRect(const BRect& other) = default;
	BRect& operator=(const BRect& other) = default;

	void Set(float newLeft, float newTop, float newRight, float newBottom);
	void PrintToStream() const;

	BPoint LeftTop() const { return BPoint(left, top); }
	BPoint RightBottom() const { return BPoint(right, bottom); }
	BPoint LeftBottom() const { return BPoint(left, bottom); }
	BPoint RightTop() const { return BPoint(right, top); }
	void SetLeftTop(const BPoint point);
	void SetRightBottom(const BPoint point);
	void SetLeftBottom(const BPoint point);
	void SetRightTop(const BPoint point);

	// Insets move all four sides inwards; negative ones outwards.
	void InsetBy(BPoint point);
	void InsetBy(float dx, float dy);
	void OffsetBy(BPoint point);
	void OffsetBy(float dx, float dy);
	void OffsetTo(BPoint point);
	void OffsetTo(float x, float y);

	// The same, returning the changed rectangle (Self) or a changed copy (Copy).
	BRect& InsetBySelf(BPoint point);
	BRect& InsetBySelf(float dx, float dy);
	BRect InsetByCopy(BPoint point) const;
	BRect InsetByCopy(float dx, float dy) const;
	BRect& OffsetBySelf(BPoint point);
	BRect& OffsetBySelf(float dx, float dy);
	BRect OffsetByCopy(BPoint point) const;
	BRect OffsetByCopy(float dx, float dy) const;
	BRect& OffsetToSelf(BPoint point);
	BRect& OffsetToSelf(float x, float y);
	BRect OffsetToCopy(BPoint point) const;
	BRect OffsetToCopy(float x, float y) const;

	bool operator==(BRect other) const;
	bool operator!=(BRect other) const { return !(*this == other); }

	// The intersection (not valid when there is none) and the smallest rectangle round both.
	BRect operator&(BRect other) const;
	BRect operator|(BRect other) const;

	bool IsValid() const { return left <= right && top <= bottom; }
	float Width() const { return right - left; }
	int32 IntegerWidth() const { return (int32)ceilf(right - left); }
	float Height() const { return bottom - top; }
	int32 IntegerHeight() const { return (int32)ceilf(bottom - top); }

	// Edges are inside.
	bool Intersects(BRect rect) const;
	bool Contains(BPoint point) const;
	bool Contains(BRect rect) const;
};
