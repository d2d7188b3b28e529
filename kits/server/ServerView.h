// ServerView: the node of a view in its window's tree: links, place, and what lies behind it.
#pragma once

#include <memory>
#include <span>

#include <GraphicsDefs.h>
#include <Rect.h>
#include <Region.h>

#include "server/ChildIndex.h"
#include "server/paint/Surface.h"

class BView;

namespace BPrivate {

class ViewTree;


// The picture behind a view. The destination rectangle is in the view's coordinates and follows
// the view's own size by the digits of a resizing mode.
struct ViewBackground {
	std::shared_ptr<const Surface> image;
	BRect source;
	BRect destination;
	uint32 follow = 0;
	uint32 options = 0;
};


// Every view has one, attached or not; it is the only place that knows the links, so the kit's
// view and the server cannot disagree. Nothing here invalidates: ViewTree does, for attached views.
// Adding, removing and the way to a neighbour take constant time.
class ServerView {
public:
	// The word holds the flags and, in its low 16 bits, the resizing mode.
	ServerView(BView* owner, BRect frame, uint32 word);
	~ServerView();
	ServerView(const ServerView&) = delete;
	ServerView& operator=(const ServerView&) = delete;

	BView* Owner() const { return fOwner; } // NULL for the top node of a window
	ViewTree* Tree() const { return fTree; } // NULL while not attached

	ServerView* Parent() const { return fParent; }
	ServerView* FirstChild() const { return fFirst; }
	ServerView* LastChild() const { return fLast; }
	ServerView* Next() const { return fNext; }
	ServerView* Previous() const { return fPrevious; }
	int32 CountChildren() const { return fChildCount; }
	// Asking for consecutive numbers takes constant time each.
	ServerView* ChildAt(int32 index) const;
	// The next one in pre-order that is still below `top`; NULL after the last.
	ServerView* NextInTree(const ServerView* top) const;
	ServerView* NextSkippingChildren(const ServerView* top) const;

	// Calls the function with the children, in their order, that may have pixels in one of the areas
	// (own coordinates), until it returns false; with those behind `after` alone, if that is given.
	// Among many children it takes time for what lies in the areas, and not for the others.
	template<typename Function>
	void ForEachChildIn(
		std::span<const clipping_rect> areas, const ServerView* after, Function&& function) const
	{
		if (!ChildIndex::IsWorthAsking(areas, fChildCount)) {
			ServerView* child = after != nullptr ? after->fNext : fFirst;
			while (child != nullptr && function(*child))
				child = child->fNext;
			return;
		}
		for (ServerView* child : _Index().Find(areas)) {
			if ((after == nullptr || after->fOrder < child->fOrder) && !function(*child))
				return;
		}
	}

	// NULL appends.
	void InsertChild(ServerView* child, ServerView* before);
	void Unlink();

	// In the parent's coordinates; its size is that of the bounds.
	BRect Frame() const { return fFrame; }
	void SetFrame(BRect frame);
	BPoint Scroll() const { return fScroll; }
	void SetScroll(BPoint leftTop) { fScroll = leftTop; }
	BRect Bounds() const;

	uint32 Word() const { return fWord; }
	void SetWord(uint32 word) { fWord = word; }
	bool Has(uint32 flag) const { return (fWord & flag) != 0; }
	// The frame after the parent has grown by whole pixels.
	BRect Followed(int32 dx, int32 dy) const;

	rgb_color Color() const { return fColor; }
	void SetColor(rgb_color color) { fColor = color; }
	bool IsOpaque() const; // paints a background
	ViewBackground* Background() const { return fBackground.get(); }
	void SetBackground(std::unique_ptr<ViewBackground> background);

	// How many Hide() calls are not undone; positive hides.
	int16 HideCount() const { return fHideCount; }
	void SetHideCount(int16 count) { fHideCount = count; }
	// By itself or by an ancestor below `top`, which is left out; NULL asks all.
	bool IsHidden(const ServerView* top = nullptr) const;

	// Where the own point (0, 0) lies in the window, or in the topmost ancestor.
	BPoint Origin() const;

	// Marks for walks that tell every view of a subtree something once.
	uint16 Marks() const { return fMarks; }
	void SetMarks(uint16 marks) { fMarks = marks; }

	// For the parent's index of its children.
	uint64 Order() const { return fOrder; }
	void SetOrder(uint64 order) { fOrder = order; }
	uint32 PlaceInCell() const { return fPlaceInCell; }
	void SetPlaceInCell(uint32 place) { fPlaceInCell = place; }

private:
	friend class ViewTree;

	const ChildIndex& _Index() const;

	BView* fOwner; // borrowed
	ViewTree* fTree = nullptr; // borrowed
	ServerView* fParent = nullptr;
	ServerView* fFirst = nullptr; // child
	ServerView* fLast = nullptr; // child
	ServerView* fNext = nullptr;
	ServerView* fPrevious = nullptr;
	BRect fFrame;
	BPoint fScroll;
	uint32 fWord;
	rgb_color fColor = { 255, 255, 255, 255 };
	int32 fChildCount = 0;
	int16 fHideCount = 0;
	uint16 fMarks = 0;
	uint64 fOrder = 0; // among its siblings, while the parent has an index
	uint32 fPlaceInCell = 0; // of that index
	mutable std::unique_ptr<ChildIndex> fIndex; // NULL until it is asked for
	std::unique_ptr<ViewBackground> fBackground;
};


// One edge of a rectangle that follows its surroundings: the digits are those of a resizing mode.
BRect follow_size(BRect rect, uint32 mode, int32 dx, int32 dy);


} // namespace BPrivate
