// ClickCounter: which presses belong together.
#pragma once

#include <OS.h>
#include <Point.h>

namespace BPrivate {


class ClickCounter {
public:
	// 1 for a first press, 2 for the second at the same spot of the same window with the same
	// button within the double-click time, and so on.
	int32 Press(uint32 window, BPoint where, uint32 button, bigtime_t when, bigtime_t limit);
	void Reset() { fCount = 0; }

private:
	static constexpr float kSpot = 3; // logical units to any side

	uint32 fWindow = 0;
	BPoint fWhere;
	uint32 fButton = 0;
	bigtime_t fWhen = 0;
	int32 fCount = 0;
};


} // namespace BPrivate
