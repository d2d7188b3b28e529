// PathData: an outline as plain numbers, so that painting need not know BShape.
#pragma once

#include <vector>

#include <Rect.h>

namespace BPrivate {


struct PathData {
	enum Verb : uint8 { kMoveTo, kLineTo, kBezierTo, kClose };

	std::vector<Verb> verbs;
	std::vector<BPoint> points; // one for a move or line, three for a curve, none for a close
};

// The smallest rectangle round all points, control points included; not valid without any.
inline BRect
BoundsOf(const PathData& path)
{
	BRect bounds;
	for (BPoint point : path.points) {
		const BRect single(point, point);
		bounds = bounds.IsValid() ? bounds | single : single;
	}
	return bounds;
}


} // namespace BPrivate
