// DraggerList: the draggers of all windows of the program.
#pragma once

class BDragger;

namespace BPrivate {


// Any thread may call it; a dragger is added and removed under its window's lock.
class DraggerList {
public:
	static void Add(const BDragger* dragger);
	static void Remove(const BDragger* dragger);

	// Tells all draggers by a message (_SHOW_DRAG_HANDLES_) when it changes.
	static void SetDrawn(bool drawn);
	static bool IsDrawn();
};


} // namespace BPrivate
