// ViewPrivate: what windows, bars and controls may do to a view beyond its public calls.
#pragma once

#include <View.h>

#include "server/ServerView.h"

namespace BPrivate {


class ViewPrivate {
public:
	explicit ViewPrivate(const BView* view) : fView(const_cast<BView*>(view)) {}

	static BView* Of(const ServerView* node); // NULL for none and for the top node
	ServerView* Node() const { return fView->fNode; }
	ArchiveSource* Source() const { return fView->fSource; }
	ViewExtras* Extras() const { return fView->fExtras; } // NULL while there are none
	ViewExtras* NeedExtras() const { return fView->_Extras(); }

	// A bar enters or leaves its target; NULL takes it out.
	void SetScrollBar(orientation direction, BScrollBar* bar);

	// The steps of attaching and detaching, for a whole subtree.
	void Attach(BWindow* window);
	void Detach();
	// Deletes a child tree without taking its views out one by one.
	void DeleteChildren();

	void CallDraw(BRect updateRect, bool afterChildren);
	void DropState();
	int16 HideCount() const;
	const char* ToolTip() const;

private:
	void _SetOwner(BWindow* window);

	BView* fView; // borrowed
};


} // namespace BPrivate
