// PathData: an outline as plain numbers, so that painting need not know BShape.
#pragma once

#include <vector>

#include <Point.h>

namespace BPrivate {


struct PathData {
	enum Verb : uint8 { kMoveTo, kLineTo, kBezierTo, kClose };

	std::vector<Verb> verbs;
	std::vector<BPoint> points; // one for a move or line, three for a curve, none for a close
};


} // namespace BPrivate
