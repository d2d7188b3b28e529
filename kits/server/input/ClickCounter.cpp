#include "server/input/ClickCounter.h"

#include <cmath>

namespace BPrivate {


int32
ClickCounter::Press(uint32 window, BPoint where, uint32 button, bigtime_t when, bigtime_t limit)
{
	const bool same = fCount > 0 && window == fWindow && button == fButton && when - fWhen <= limit
		&& std::fabs(where.x - fWhere.x) <= kSpot && std::fabs(where.y - fWhere.y) <= kSpot;

	fCount = same ? fCount + 1 : 1;
	fWindow = window;
	fWhere = where;
	fButton = button;
	fWhen = when;
	return fCount;
}


} // namespace BPrivate
