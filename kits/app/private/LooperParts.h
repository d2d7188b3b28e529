// What the sources of BLooper share.
#pragma once

#include <vector>

#include <Looper.h>


// A message in work. Nested ones lie further in on the same stack.
struct BLooper::Dispatch {
	BMessage* message; // owned; NULL once it was detached
	Dispatch* outer;
};

// The handlers in their order. A removed one leaves a hole until somebody asks for an index, so
// that a window full of views is emptied in linear time.
struct BLooper::HandlerTable {
	std::vector<BHandler*> slots; // borrowed; NULL for a hole
	int32 holes = 0;
};
