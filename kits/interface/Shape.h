// BShape: an outline of lines and curves.
#pragma once

#include <memory>

#include <Archivable.h>
#include <Point.h>
#include <Rect.h>

class BShape;

namespace BPrivate {
class ShapeAccess;
struct PathData;
} // namespace BPrivate


// Calls one hook per part of a shape, consecutive lines and curves together. A hook's points are
// a loan. A result other than B_OK ends the walk and becomes its result.
class BShapeIterator {
public:
	BShapeIterator();
	virtual ~BShapeIterator();

	virtual status_t IterateMoveTo(BPoint* point);
	virtual status_t IterateLineTo(int32 lineCount, BPoint* linePoints);
	virtual status_t IterateBezierTo(int32 bezierCount, BPoint* bezierPoints);
	virtual status_t IterateClose();

	status_t Iterate(BShape* shape);
};


class BShape : public BArchivable {
public:
	BShape();
	BShape(const BShape& shape);
	BShape(BMessage* data);
	virtual ~BShape();

	static BArchivable* Instantiate(BMessage* data);
	virtual status_t Archive(BMessage* data, bool deep = true) const;

	BShape& operator=(const BShape& shape);
	bool operator==(const BShape& shape) const;
	bool operator!=(const BShape& shape) const { return !(*this == shape); }

	void Clear();
	BRect Bounds() const; // of all points, control points included
	BPoint CurrentPosition() const;

	status_t AddShape(const BShape* shape);
	status_t MoveTo(BPoint point);
	status_t LineTo(BPoint point);
	status_t BezierTo(BPoint controlPoints[3]);
	status_t BezierTo(const BPoint& control1, const BPoint& control2, const BPoint& end);
	// A piece of an ellipse, as in scalable vector graphics; kept as curves. Degrees.
	status_t ArcTo(
		float rx, float ry, float angle, bool largeArc, bool counterClockwise, const BPoint& point);
	status_t Close();

private:
	friend class BShapeIterator;
	friend class BPrivate::ShapeAccess;

	void _Start();

	std::unique_ptr<BPrivate::PathData> fPath;
};
