#include <Polygon.h>

#include <algorithm>


BPolygon::BPolygon()
{
}


BPolygon::BPolygon(const BPoint* points, int32 count)
{
	AddPoints(points, count);
}


BPolygon::BPolygon(const BPolygon& polygon) : fPoints(polygon.fPoints)
{
}


BPolygon::BPolygon(const BPolygon* polygon)
{
	if (polygon != NULL)
		fPoints = polygon->fPoints;
}


BPolygon::~BPolygon()
{
}


BPolygon&
BPolygon::operator=(const BPolygon& polygon)
{
	fPoints = polygon.fPoints;
	return *this;
}


BRect
BPolygon::Frame() const
{
	if (fPoints.empty())
		return BRect();
	BRect frame(fPoints[0], fPoints[0]);
	for (BPoint point : fPoints)
		frame = frame | BRect(point, point);
	return frame;
}


void
BPolygon::AddPoints(const BPoint* points, int32 count)
{
	if (points != NULL && count > 0)
		fPoints.insert(fPoints.end(), points, points + count);
}


int32
BPolygon::CountPoints() const
{
	return fPoints.size();
}


void
BPolygon::MapTo(BRect sourceRect, BRect destinationRect)
{
	// A source without width or height is only moved.
	const float scaleX = sourceRect.Width() != 0 ? destinationRect.Width() / sourceRect.Width() : 1;
	const float scaleY =
		sourceRect.Height() != 0 ? destinationRect.Height() / sourceRect.Height() : 1;
	for (BPoint& point : fPoints) {
		point.Set(destinationRect.left + (point.x - sourceRect.left) * scaleX,
			destinationRect.top + (point.y - sourceRect.top) * scaleY);
	}
}


void
BPolygon::PrintToStream() const
{
	for (BPoint point : fPoints)
		point.PrintToStream();
}
