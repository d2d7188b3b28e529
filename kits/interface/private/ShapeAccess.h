// ShapeAccess: a shape's outline for those who paint it.
#pragma once

#include <Shape.h>

#include "server/paint/Path.h"

namespace BPrivate {


class ShapeAccess {
public:
	static const PathData& Path(const BShape& shape) { return *shape.fPath; }
	static PathData& Path(BShape& shape) { return *shape.fPath; }
};


} // namespace BPrivate
