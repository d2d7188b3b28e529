// ViewState: the parts of a view that most views never need.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <Cursor.h>
#include <View.h>

#include "server/paint/DrawState.h"
#include "server/paint/Painter.h"

class BShelf;

namespace BPrivate {


// One level of a view's graphics state.
struct ViewState {
	DrawState draw;
	std::unique_ptr<ViewState> below; // the saved level; NULL for the lowest
	bool isFloor = false; // made for one Draw(); PopState() stops here

	// After a change of the level's own origin or scale.
	void Combine();
	// All levels' constraints put together; none when no level has one.
	std::optional<BRegion> Constraint() const;
};


// The outline of BeginRectTracking().
struct RectTracking {
	BRect rect; // the view's coordinates, as are the others
	BRect start;
	BPoint pressed; // where the pointer was at the beginning
	uint32 style;

	void Follow(BPoint pointer);
};


struct ViewExtras {
	BScrollBar* bars[2] = { nullptr, nullptr }; // borrowed; by orientation
	uint32 eventMask = 0;
	uint32 eventOptions = 0;
	uint32 mouseEventMask = 0; // until the next mouse-up
	uint32 mouseEventOptions = 0;
	BShelf* shelf = nullptr; // borrowed; this view is its container
	std::unique_ptr<BCursor> cursor;
	std::string toolTip;
	std::vector<PaintedLine> lines; // between BeginLineArray() and EndLineArray()
	bool inLineArray = false;
	std::unique_ptr<RectTracking> tracking; // while a rectangle follows the pointer
};


// Which settings were ever changed by a setter, for the archive.
enum Touched : uint32 {
	kTouchedFont = 1 << 0,
	kTouchedEventMask = 1 << 1,
	kTouchedOrigin = 1 << 2,
	kTouchedScale = 1 << 3,
	kTouchedPenSize = 1 << 4,
	kTouchedPenLocation = 1 << 5,
	kTouchedLineMode = 1 << 6,
	kTouchedBlending = 1 << 7,
	kTouchedDrawingMode = 1 << 8,
};


} // namespace BPrivate
