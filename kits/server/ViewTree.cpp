#include "server/ViewTree.h"

#include <array>
#include <cmath>

namespace BPrivate {

namespace {

constexpr clipping_rect kNothing = { 0, 0, -1, -1 };


int32
rounded(float value)
{
	return static_cast<int32>(std::lround(value));
}

} // namespace


ViewTree::ViewTree(ViewTreeClient& client, BRect bounds) :
	fClient(client), fRoot(nullptr, bounds, 0)
{
	fRoot.fTree = this;
}


ViewTree::~ViewTree() = default;


void
ViewTree::SetSurface(Surface* surface)
{
	fSurface = surface;
	fPainter = surface != nullptr ? std::make_unique<Painter>(*surface) : nullptr;
	fCurrent.view = nullptr;
}


void
ViewTree::Attach(ServerView& top)
{
	for (ServerView* view = &top; view != nullptr; view = view->NextInTree(&top))
		view->fTree = this;
	fAttachVersion++;
	fCurrent.view = nullptr;
	_MarkDirty(_PlaceOfParent(top), top, top.Frame());
}


void
ViewTree::Detach(ServerView& top)
{
	_MarkDirty(_PlaceOfParent(top), top, top.Frame());
	for (ServerView* view = &top; view != nullptr; view = view->NextInTree(&top))
		view->fTree = nullptr;
	fAttachVersion++;
	fCurrent.view = nullptr;
}


// #pragma mark - frames


void
ViewTree::MoveTo(ServerView& view, BPoint leftTop)
{
	_SetFrame(view, view.Frame().OffsetToCopy(leftTop), _PlaceOfParent(view), false);
}


void
ViewTree::ResizeTo(ServerView& view, float width, float height)
{
	BRect frame = view.Frame();
	frame.right = frame.left + width;
	frame.bottom = frame.top + height;
	_SetFrame(view, frame, _PlaceOfParent(view), false);
}


// Gives the view its frame, and its children theirs. Once an area is known to be dirty, what lies
// in it is not marked again.
void
ViewTree::_SetFrame(ServerView& view, BRect frame, const Place& parent, bool parentDirty)
{
	const BRect old = view.Frame();
	if (frame == old)
		return;
	const bool moved = frame.LeftTop() != old.LeftTop();
	const int32 dx = rounded(frame.Width() - old.Width());
	const int32 dy = rounded(frame.Height() - old.Height());
	const bool resized = frame.Width() != old.Width() || frame.Height() != old.Height();

	view.SetFrame(frame);
	fCurrent.view = nullptr;
	if (moved && !parentDirty) {
		_MarkDirty(parent, view, old);
		_MarkDirty(parent, view, frame);
	} else if (resized && !parentDirty)
		_DirtyAfterResize(view, old, parent);

	if (resized) {
		_ResizeBackground(view, dx, dy);
		const bool allDirty = parentDirty || moved || view.Has(kFullUpdateOnResize);
		const Place place = _PlaceIn(parent, view, frame);
		for (ServerView* child = view.FirstChild(); child != nullptr; child = child->Next())
			_SetFrame(*child, child->Followed(dx, dy), place, allDirty);
	}
	fClient.FrameChanged(view, moved, resized);
}


// The left top has stayed: what is new of the view, and what it leaves to its parent, are dirty.
void
ViewTree::_DirtyAfterResize(const ServerView& view, BRect oldFrame, const Place& parent)
{
	const BRect frame = view.Frame();
	const bool all = view.Has(kFullUpdateOnResize)
		|| (view.Background() != nullptr && view.Background()->follow != 0x1212);
	if (all) {
		_MarkDirty(parent, view, oldFrame | frame);
		return;
	}
	// A strip at the right and one at the bottom, whether they have come or gone.
	const float right = std::max(oldFrame.right, frame.right);
	const float bottom = std::max(oldFrame.bottom, frame.bottom);
	const float innerRight = std::min(oldFrame.right, frame.right);
	const float innerBottom = std::min(oldFrame.bottom, frame.bottom);
	_MarkDirty(parent, view, BRect(innerRight + 1, frame.top, right, bottom));
	_MarkDirty(parent, view, BRect(frame.left, innerBottom + 1, right, bottom));
}


void
ViewTree::_ResizeBackground(ServerView& view, int32 dx, int32 dy)
{
	if (ViewBackground* background = view.Background())
		background->destination = follow_size(background->destination, background->follow, dx, dy);
}


void
ViewTree::SetHideCount(ServerView& view, int16 count)
{
	const bool wasHidden = view.HideCount() > 0;
	const Place parent = _PlaceOfParent(view);
	if (!wasHidden)
		_MarkDirty(parent, view, view.Frame());
	view.SetHideCount(count);
	fCurrent.view = nullptr;
	if (wasHidden)
		_MarkDirty(parent, view, view.Frame());
}


// #pragma mark - places


ViewTree::Place
ViewTree::_PlaceIn(const Place& parent, const ServerView& view, BRect frame)
{
	Place place;
	const BRect inWindow = frame.OffsetByCopy(parent.origin);
	place.origin = inWindow.LeftTop() - view.Scroll();
	place.cut = intersect(to_pixels(inWindow), parent.cut);
	place.hidden = parent.hidden || view.HideCount() > 0;
	return place;
}


ViewTree::Place
ViewTree::_PlaceOf(const ServerView& view) const
{
	// From the view outwards, so that no recursion depends on the depth of the tree.
	BPoint origin(0, 0);
	BRect cut = view.Frame();
	bool hidden = view.HideCount() > 0;
	BPoint ownLeftTop(0, 0);
	for (const ServerView* parent = view.Parent(); parent != nullptr; parent = parent->Parent()) {
		hidden = hidden || parent->HideCount() > 0;
		cut = cut & parent->Bounds();
		const BPoint shift = parent->Frame().LeftTop() - parent->Scroll();
		cut.OffsetBy(shift);
		ownLeftTop += shift;
	}
	origin = ownLeftTop + view.Frame().LeftTop() - view.Scroll();
	return { origin, to_pixels(cut), hidden };
}


ViewTree::Place
ViewTree::_PlaceOfParent(const ServerView& view) const
{
	if (view.Parent() != nullptr)
		return _PlaceOf(*view.Parent());
	constexpr int32 kFar = 1 << 28;
	return { BPoint(0, 0), { -kFar, -kFar, kFar, kFar }, false };
}


BRect
ViewTree::VisibleFrame(const ServerView& view) const
{
	const Place place = _PlaceOf(view);
	if (place.hidden || is_empty(place.cut))
		return BRect();
	return BRect(place.cut.left, place.cut.top, place.cut.right, place.cut.bottom);
}


ServerView*
ViewTree::ViewAt(BPoint point) const
{
	// A point names the pixel that it lies in, also between two whole coordinates.
	point.Set(std::floor(point.x), std::floor(point.y));
	const ServerView* view = &fRoot;
	BPoint where = point; // in the view's coordinates
	ServerView* found = nullptr;
	while (view != nullptr) {
		const ServerView* hit = nullptr;
		const std::array area = { to_pixels(BRect(where, where)) };
		view->ForEachChildIn(area, nullptr, [&](const ServerView& child) {
			fCountHitTested++;
			if (child.HideCount() <= 0 && child.Frame().Contains(where))
				hit = &child;
			return hit == nullptr;
		});
		if (hit != nullptr) {
			where = where - hit->Frame().LeftTop() + hit->Scroll();
			found = const_cast<ServerView*>(hit);
		}
		view = hit;
	}
	return found;
}


// #pragma mark - dirt


void
ViewTree::Invalidate(ServerView& view, BRect rect)
{
	const Place place = _PlaceOf(view);
	if (place.hidden || !rect.IsValid())
		return;
	_MarkDirty(intersect(to_pixels(rect.OffsetByCopy(place.origin)), place.cut));
}


void
ViewTree::Invalidate(ServerView& view, const BRegion& region)
{
	const Place place = _PlaceOf(view);
	if (place.hidden || is_empty(place.cut))
		return;
	BRegion inWindow(region);
	inWindow.OffsetBy(rounded(place.origin.x), rounded(place.origin.y));
	BRegion cut;
	cut.Set(place.cut);
	inWindow.IntersectWith(&cut);
	InvalidateWindow(inWindow);
}


void
ViewTree::InvalidateWindow(const BRegion& region)
{
	if (region.IsEmpty())
		return;
	const bool wasClean = fDirty.IsEmpty();
	fDirty.Add(region);
	if (wasClean)
		fClient.UpdateNeeded();
}


void
ViewTree::_MarkDirty(const clipping_rect& rect)
{
	if (is_empty(rect))
		return;
	const bool wasClean = fDirty.IsEmpty();
	fDirty.Add(rect);
	if (wasClean)
		fClient.UpdateNeeded();
}


void
ViewTree::_MarkDirty(const Place& parent, const ServerView& view, BRect frame)
{
	if (parent.hidden || view.HideCount() > 0 || !frame.IsValid())
		return;
	_MarkDirty(intersect(to_pixels(frame.OffsetByCopy(parent.origin)), parent.cut));
}


void
ViewTree::TakeDamage(BRegion* _damage)
{
	_damage->MakeEmpty();
	if (fPainter != nullptr)
		fPainter->TakeDamage(_damage);
}


} // namespace BPrivate
