// BPolygon: a list of points, to be stroked or filled.
#pragma once

#include <vector>

#include <Rect.h>


class BPolygon {
public:
	BPolygon(const BPoint* points, int32 count);
	BPolygon(const BPolygon& polygon);
	BPolygon(const BPolygon* polygon);
	BPolygon();
	virtual ~BPolygon();

	BPolygon& operator=(const BPolygon& polygon);

	BRect Frame() const;
	void AddPoints(const BPoint* points, int32 count);
	int32 CountPoints() const;
	// Scales and moves all points so that a point of the first rectangle comes to the same place
	// of the second.
	void MapTo(BRect sourceRect, BRect destinationRect);
	void PrintToStream() const;

	// For those who draw it; valid until the next change.
	const BPoint* Points() const { return fPoints.data(); }

private:
	std::vector<BPoint> fPoints;
};
