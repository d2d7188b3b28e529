// ViewPrivate: what windows, bars and controls may do to a view beyond its public calls.
#pragma once

#include <View.h>

#include "server/ServerView.h"

class BShelf;

namespace BPrivate {


class ViewPrivate {
public:
	explicit ViewPrivate(const BView* view) : fView(const_cast<BView*>(view)) {}

	ServerView* Node() const { return fView->fNode; }
	ArchiveSource* Source() const { return fView->fSource; }
	ViewExtras* Extras() const { return fView->fExtras; } // NULL while there are none
	ViewExtras* NeedExtras() const { return fView->_Extras(); }

	// A bar enters or leaves its target; NULL takes it out.
	void SetScrollBar(orientation direction, BScrollBar* bar);
	// The view becomes the shelf's container; NULL ends that.
	void SetShelf(BShelf* shelf);
	// The first view of this or an ancestor that has bars; wheel movements go there.
	static bool ScrollByWheel(BView* view, float dx, float dy);

	// The subtree is linked below a node of the window's tree, which is locked: runs the hooks.
	void Attach(BWindow* window);
	// Runs the hooks and takes the subtree out of the window, and out of its parent.
	void Detach();
	// Puts an unattached view, and its subtree, among the children of a node.
	static bool Insert(ServerView* parent, BView* child, BView* before, BWindow* window);

	// The state that a hook sets is undone afterwards.
	void CallDraw(BRect updateRect, bool afterChildren);
	// The pointer has moved while a rectangle follows it; and the outline of that.
	void TrackRect(BPoint screen);
	void DrawTracking();
	// Flags and mode that an archive constructor sets.
	void ForceWord(uint32 flags, uint32 mode);

private:
	BView* fView; // borrowed
};


} // namespace BPrivate
