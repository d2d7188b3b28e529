#include <Shape.h>

#include <algorithm>
#include <math.h>

#include <Errors.h>
#include <Message.h>

#include "server/paint/Path.h"

using BPrivate::PathData;

namespace {

constexpr const char* kVerbsField = "ops";
constexpr const char* kPointsField = "pts";


size_t
PointsOf(PathData::Verb verb)
{
	switch (verb) {
		case PathData::kMoveTo:
		case PathData::kLineTo:
			return 1;
		case PathData::kBezierTo:
			return 3;
		default:
			return 0;
	}
}


// Approximates the unit circle's piece from one angle over at most a quarter.
void
AddQuarter(std::vector<BPoint>& curve, double start, double sweep)
{
	const double reach = 4.0 / 3 * tan(sweep / 4);
	const double end = start + sweep;
	curve.push_back(BPoint(cos(start) - reach * sin(start), sin(start) + reach * cos(start)));
	curve.push_back(BPoint(cos(end) + reach * sin(end), sin(end) - reach * cos(end)));
	curve.push_back(BPoint(cos(end), sin(end)));
}

} // namespace


// #pragma mark - BShapeIterator


BShapeIterator::BShapeIterator()
{
}


BShapeIterator::~BShapeIterator()
{
}


status_t
BShapeIterator::IterateMoveTo(BPoint* point)
{
	return B_OK;
}


status_t
BShapeIterator::IterateLineTo(int32 lineCount, BPoint* linePoints)
{
	return B_OK;
}


status_t
BShapeIterator::IterateBezierTo(int32 bezierCount, BPoint* bezierPoints)
{
	return B_OK;
}


status_t
BShapeIterator::IterateClose()
{
	return B_OK;
}


status_t
BShapeIterator::Iterate(BShape* shape)
{
	if (shape == NULL)
		return B_BAD_VALUE;
	const std::vector<PathData::Verb>& verbs = shape->fPath->verbs;
	BPoint* points = shape->fPath->points.data();
	for (size_t i = 0; i < verbs.size();) {
		const PathData::Verb verb = verbs[i];
		size_t count = 1;
		while ((verb == PathData::kLineTo || verb == PathData::kBezierTo)
			&& i + count < verbs.size() && verbs[i + count] == verb)
			count++;
		status_t status = B_OK;
		switch (verb) {
			case PathData::kMoveTo:
				status = IterateMoveTo(points);
				break;
			case PathData::kLineTo:
				status = IterateLineTo(count, points);
				break;
			case PathData::kBezierTo:
				status = IterateBezierTo(count, points);
				break;
			case PathData::kClose:
				status = IterateClose();
				break;
		}
		if (status != B_OK)
			return status;
		points += count * PointsOf(verb);
		i += count;
	}
	return B_OK;
}


// #pragma mark - BShape


BShape::BShape() : fPath(std::make_unique<PathData>())
{
}


BShape::BShape(const BShape& shape) : BArchivable(), fPath(std::make_unique<PathData>(*shape.fPath))
{
}


// Parts whose points are missing end the shape.
BShape::BShape(BMessage* data) : BArchivable(data), fPath(std::make_unique<PathData>())
{
	int32 verb;
	int32 next = 0;
	for (int32 i = 0; data->FindInt32(kVerbsField, i, &verb) == B_OK; i++) {
		if (verb < PathData::kMoveTo || verb > PathData::kClose)
			return;
		BPoint points[3];
		const size_t count = PointsOf((PathData::Verb)verb);
		for (size_t k = 0; k < count; k++) {
			if (data->FindPoint(kPointsField, next++, &points[k]) != B_OK)
				return;
		}
		fPath->verbs.push_back((PathData::Verb)verb);
		fPath->points.insert(fPath->points.end(), points, points + count);
	}
}


BShape::~BShape()
{
}


BArchivable*
BShape::Instantiate(BMessage* data)
{
	return validate_instantiation(data, "BShape") ? new BShape(data) : NULL;
}


status_t
BShape::Archive(BMessage* data, bool deep) const
{
	status_t status = BArchivable::Archive(data, deep);
	for (size_t i = 0; status == B_OK && i < fPath->verbs.size(); i++)
		status = data->AddInt32(kVerbsField, fPath->verbs[i]);
	for (size_t i = 0; status == B_OK && i < fPath->points.size(); i++)
		status = data->AddPoint(kPointsField, fPath->points[i]);
	return status;
}


BShape&
BShape::operator=(const BShape& shape)
{
	*fPath = *shape.fPath;
	return *this;
}


bool
BShape::operator==(const BShape& shape) const
{
	return fPath->verbs == shape.fPath->verbs && fPath->points == shape.fPath->points;
}


void
BShape::Clear()
{
	fPath->verbs.clear();
	fPath->points.clear();
}


BRect
BShape::Bounds() const
{
	return BPrivate::BoundsOf(*fPath);
}


BPoint
BShape::CurrentPosition() const
{
	return fPath->points.empty() ? B_ORIGIN : fPath->points.back();
}


status_t
BShape::AddShape(const BShape* shape)
{
	if (shape == NULL)
		return B_BAD_VALUE;
	const PathData other = *shape->fPath;
	fPath->verbs.insert(fPath->verbs.end(), other.verbs.begin(), other.verbs.end());
	fPath->points.insert(fPath->points.end(), other.points.begin(), other.points.end());
	return B_OK;
}


status_t
BShape::MoveTo(BPoint point)
{
	fPath->verbs.push_back(PathData::kMoveTo);
	fPath->points.push_back(point);
	return B_OK;
}


status_t
BShape::LineTo(BPoint point)
{
	_Start();
	fPath->verbs.push_back(PathData::kLineTo);
	fPath->points.push_back(point);
	return B_OK;
}


status_t
BShape::BezierTo(BPoint controlPoints[3])
{
	return BezierTo(controlPoints[0], controlPoints[1], controlPoints[2]);
}


status_t
BShape::BezierTo(const BPoint& control1, const BPoint& control2, const BPoint& end)
{
	_Start();
	fPath->verbs.push_back(PathData::kBezierTo);
	fPath->points.insert(fPath->points.end(), { control1, control2, end });
	return B_OK;
}


// The centre form of an arc from its end points, by the formulas of SVG's appendix on elliptical
// arcs.
status_t
BShape::ArcTo(
	float rx, float ry, float angle, bool largeArc, bool counterClockwise, const BPoint& point)
{
	const BPoint start = CurrentPosition();
	if (rx == 0 || ry == 0 || start == point)
		return LineTo(point);

	const double turn = angle * M_PI / 180;
	const double cosine = cos(turn);
	const double sine = sin(turn);
	double radiusX = fabs(rx);
	double radiusY = fabs(ry);
	const double halfX = (start.x - point.x) / 2;
	const double halfY = (start.y - point.y) / 2;
	const double x = cosine * halfX + sine * halfY;
	const double y = -sine * halfX + cosine * halfY;
	const double excess = x * x / (radiusX * radiusX) + y * y / (radiusY * radiusY);
	if (excess > 1) {
		radiusX *= sqrt(excess);
		radiusY *= sqrt(excess);
	}

	const double product = radiusX * radiusX * radiusY * radiusY;
	const double divisor = radiusX * radiusX * y * y + radiusY * radiusY * x * x;
	double factor = sqrt(std::max(0.0, (product - divisor) / divisor));
	if (largeArc != counterClockwise)
		factor = -factor;
	const double centerX = factor * radiusX * y / radiusY;
	const double centerY = -factor * radiusY * x / radiusX;

	const double first = atan2((y - centerY) / radiusY, (x - centerX) / radiusX);
	double sweep = atan2((-y - centerY) / radiusY, (-x - centerX) / radiusX) - first;
	if (counterClockwise && sweep > 0)
		sweep -= 2 * M_PI;
	else if (!counterClockwise && sweep < 0)
		sweep += 2 * M_PI;

	const int pieces = std::max(1, (int)ceil(fabs(sweep) / (M_PI / 2) - 1e-6));
	std::vector<BPoint> curve;
	for (int i = 0; i < pieces; i++)
		AddQuarter(curve, first + sweep * i / pieces, sweep / pieces);
	for (BPoint& at : curve) {
		const double localX = at.x * radiusX + centerX;
		const double localY = at.y * radiusY + centerY;
		at.Set(cosine * localX - sine * localY + (start.x + point.x) / 2,
			sine * localX + cosine * localY + (start.y + point.y) / 2);
	}
	curve.back() = point;
	for (size_t i = 0; i < curve.size(); i += 3)
		BezierTo(curve[i], curve[i + 1], curve[i + 2]);
	return B_OK;
}


status_t
BShape::Close()
{
	if (!fPath->verbs.empty() && fPath->verbs.back() != PathData::kClose)
		fPath->verbs.push_back(PathData::kClose);
	return B_OK;
}


// A shape that begins with a line begins at the origin.
void
BShape::_Start()
{
	if (fPath->verbs.empty())
		MoveTo(B_ORIGIN);
}
