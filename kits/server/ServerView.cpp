#include "server/ServerView.h"

#include <atomic>

#include "server/ViewTree.h"

namespace BPrivate {

namespace {

constexpr uint32 kModeMask = 0xffff;
constexpr uint32 kFollowFarEdgeH = 4; // right
constexpr uint32 kFollowFarEdgeV = 3; // bottom
constexpr uint32 kFollowCenter = 5;

// Counts changes of links anywhere, so that a remembered neighbour is never a stale one.
std::atomic<uint64> sLinkVersion { 1 };

struct ChildPosition {
	const ServerView* parent = nullptr;
	ServerView* child = nullptr;
	int32 index = 0;
	uint64 version = 0;
};

// Programs walk children by number: where the last question ended is where the next one starts.
thread_local ChildPosition sLastChild;


float
edge_shift(uint32 digit, uint32 far, int32 delta)
{
	if (digit == far)
		return delta;
	// An integer division, towards zero: centred views drift on purpose.
	return digit == kFollowCenter ? delta / 2 : 0;
}

} // namespace


BRect
follow_size(BRect rect, uint32 mode, int32 dx, int32 dy)
{
	rect.left += edge_shift((mode >> 8) & 0xf, kFollowFarEdgeH, dx);
	rect.right += edge_shift(mode & 0xf, kFollowFarEdgeH, dx);
	rect.top += edge_shift((mode >> 12) & 0xf, kFollowFarEdgeV, dy);
	rect.bottom += edge_shift((mode >> 4) & 0xf, kFollowFarEdgeV, dy);
	return rect;
}


ServerView::ServerView(BView* owner, BRect frame, uint32 word) :
	fOwner(owner), fFrame(frame), fWord(word)
{
}


ServerView::~ServerView()
{
	sLinkVersion.fetch_add(1, std::memory_order_relaxed);
}


ServerView*
ServerView::ChildAt(int32 index) const
{
	if (index < 0 || index >= fChildCount)
		return nullptr;

	const uint64 version = sLinkVersion.load(std::memory_order_relaxed);
	ServerView* child = fFirst;
	int32 at = 0;
	if (sLastChild.parent == this && sLastChild.version == version) {
		child = sLastChild.child;
		at = sLastChild.index;
	}
	if (index < at / 2) {
		child = fFirst;
		at = 0;
	} else if (index - at > fChildCount - 1 - index) {
		child = fLast;
		at = fChildCount - 1;
	}
	for (; at < index; at++)
		child = child->fNext;
	for (; at > index; at--)
		child = child->fPrevious;

	sLastChild = { this, child, index, version };
	return child;
}


ServerView*
ServerView::NextInTree(const ServerView* top) const
{
	return fFirst != nullptr ? fFirst : NextSkippingChildren(top);
}


ServerView*
ServerView::NextSkippingChildren(const ServerView* top) const
{
	for (const ServerView* view = this; view != top && view != nullptr; view = view->fParent) {
		if (view->fNext != nullptr)
			return view->fNext;
	}
	return nullptr;
}


void
ServerView::InsertChild(ServerView* child, ServerView* before)
{
	child->fParent = this;
	child->fNext = before;
	child->fPrevious = before != nullptr ? before->fPrevious : fLast;
	(child->fPrevious != nullptr ? child->fPrevious->fNext : fFirst) = child;
	(before != nullptr ? before->fPrevious : fLast) = child;
	fChildCount++;
	sLinkVersion.fetch_add(1, std::memory_order_relaxed);
	if (fIndex == nullptr)
		return;
	const uint64 low = child->fPrevious != nullptr ? child->fPrevious->fOrder : 0;
	const uint64 high = before != nullptr ? before->fOrder : low + 2 * ChildIndex::kOrderGap;
	child->fOrder = low + (high - low) / 2;
	if (child->fOrder > low)
		fIndex->Add(*child);
	else
		fIndex.reset(); // no number is left between: all get new ones when it is asked for again
}


void
ServerView::Unlink()
{
	if (fParent == nullptr)
		return;
	if (fParent->fIndex != nullptr)
		fParent->fIndex->Remove(*this, fFrame);
	(fPrevious != nullptr ? fPrevious->fNext : fParent->fFirst) = fNext;
	(fNext != nullptr ? fNext->fPrevious : fParent->fLast) = fPrevious;
	fParent->fChildCount--;
	fParent = fNext = fPrevious = nullptr;
	sLinkVersion.fetch_add(1, std::memory_order_relaxed);
}


void
ServerView::SetFrame(BRect frame)
{
	ChildIndex* index = fParent != nullptr ? fParent->fIndex.get() : nullptr;
	if (index != nullptr)
		index->Remove(*this, fFrame);
	fFrame = frame;
	if (index != nullptr)
		index->Add(*this);
}


BRect
ServerView::Bounds() const
{
	return BRect(fScroll.x, fScroll.y, fScroll.x + fFrame.Width(), fScroll.y + fFrame.Height());
}


BRect
ServerView::Followed(int32 dx, int32 dy) const
{
	return follow_size(fFrame, fWord & kModeMask, dx, dy);
}


bool
ServerView::IsOpaque() const
{
	return fColor != B_TRANSPARENT_COLOR;
}


void
ServerView::SetBackground(std::unique_ptr<ViewBackground> background)
{
	fBackground = std::move(background);
}


bool
ServerView::IsHidden(const ServerView* top) const
{
	for (const ServerView* view = this; view != nullptr && view != top; view = view->fParent) {
		if (view->fHideCount > 0)
			return true;
	}
	return false;
}


const ChildIndex&
ServerView::_Index() const
{
	if (fIndex == nullptr) {
		fIndex = std::make_unique<ChildIndex>(*this);
		if (fTree != nullptr)
			fTree->AddVisited(fChildCount);
	}
	return *fIndex;
}


BPoint
ServerView::Origin() const
{
	BPoint origin(0, 0);
	for (const ServerView* view = this; view != nullptr; view = view->fParent)
		origin += view->fFrame.LeftTop() - view->fScroll;
	return origin;
}


} // namespace BPrivate
