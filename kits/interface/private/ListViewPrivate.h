// What the sources of BListView share.
#pragma once

#include <string>

#include <ListView.h>
#include <MessageRunner.h>

namespace BPrivate {

constexpr uint32 kListScroll = '_LAS'; // the pointer is held outside of the list

} // namespace BPrivate


// A press of the mouse until its release.
struct BListView::Tracking {
	BPoint press;
	int32 index; // of the item that was hit
	bool wasSelected; // before the press
	bool mayDrag; // InitiateDrag() has not been asked yet
	bool reduces; // a release without a move leaves only this item selected
	std::unique_ptr<BMessageRunner> scroller; // while the pointer is outside
};


// What was typed to find an item.
struct BListView::TypeAhead {
	std::string text;
	bigtime_t when;
};
