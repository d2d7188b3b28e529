// ViewTree: the views of one window: their clipping, what is dirty, and the walk that paints it.
#pragma once

#include <memory>
#include <optional>

#include <Region.h>

#include "server/DirtyRegion.h"
#include "server/ServerView.h"
#include "server/paint/Painter.h"

namespace BPrivate {


// What a tree asks of its window.
class ViewTreeClient {
public:
	virtual ~ViewTreeClient() = default;

	// The view's clipping, its place and its background are done. The rectangle is in its own
	// coordinates.
	virtual void DrawView(ServerView& view, BRect updateRect, bool afterChildren) = 0;
	virtual void FrameChanged(ServerView& view, bool moved, bool resized) = 0;
	// Something has become dirty that was all clean.
	virtual void UpdateNeeded() = 0;
};


// Belongs to whoever holds the window's lock. All views of a window share one dirty region, so that
// a transparent view in front is painted again whenever something behind it is. A view's visible
// region is its bounds without its children, cut by its ancestors; siblings do not clip each other.
class ViewTree {
public:
	// Flags of the view word that matter for painting.
	static constexpr uint32 kFullUpdateOnResize = 0x80000000;
	static constexpr uint32 kWillDraw = 0x20000000;
	static constexpr uint32 kDrawOnChildren = 0x00800000;
	static constexpr uint32 kTransparentBackground = 0x00040000;

	ViewTree(ViewTreeClient& client, BRect bounds);
	~ViewTree();
	ViewTree(const ViewTree&) = delete;
	ViewTree& operator=(const ViewTree&) = delete;

	ServerView& Root() { return fRoot; }
	const ServerView& Root() const { return fRoot; }
	// What is painted on; NULL while nothing can be seen. Borrowed.
	void SetSurface(Surface* surface);
	bool CanPaint() const { return fPainter != nullptr; }

	// The subtree has been linked, or is about to be unlinked.
	void Attach(ServerView& top);
	void Detach(ServerView& top);

	void MoveTo(ServerView& view, BPoint leftTop);
	// Sizes are right - left. Children follow.
	void ResizeTo(ServerView& view, float width, float height);
	// Moves the pixels where it can; only what was not there before becomes dirty.
	void ScrollTo(ServerView& view, BPoint leftTop);
	void SetHideCount(ServerView& view, int16 count);
	// Flags or mode have changed in a way that counts for clipping.
	void ClippingChanged() { fCurrent.view = nullptr; }

	// Own coordinates; all descendants there are meant too.
	void Invalidate(ServerView& view, BRect rect);
	void Invalidate(ServerView& view, const BRegion& region);
	void InvalidateWindow(const BRegion& region);
	bool IsDirty() const { return !fDirty.IsEmpty(); }
	bool IsUpdating() const { return fUpdateRegion != nullptr; }
	const BRegion& Dirty() { return fDirty.Region(); }

	// Paints what is dirty: parents before children, children in their order.
	void Update();
	// Counts for tests and benchmarks.
	int64 CountDrawn() const { return fCountDrawn; }
	int64 CountClippings() const { return fCountClippings; } // made for a view that draws
	int64 CountHitTested() const { return fCountHitTested; } // views asked for a point
	// Children looked at because something is painted or clipped, or to find them quickly later.
	int64 CountVisited() const { return fCountVisited; }
	void AddVisited(int64 count) const { fCountVisited += count; }

	// Makes the view the one that the painter draws for; NULL when nothing of it can be painted.
	// The constraint is in its own coordinates and asked for only when clipping is made anew.
	template<typename MakeConstraint>
	Painter* BeginDrawing(ServerView& view, MakeConstraint&& makeConstraint)
	{
		if (fCurrent.view != &view || fCurrent.constraintDropped) {
			const std::optional<BRegion> constraint = makeConstraint();
			_SetCurrent(view, constraint ? &*constraint : nullptr);
		}
		return fCurrent.clip.IsEmpty() ? nullptr : fPainter.get();
	}
	// The state stack of the view drawn for has another constraint now.
	void ConstraintChanged(const ServerView& view);
	// Shows, in window coordinates, what was painted since the last call.
	void TakeDamage(BRegion* _damage);
	bool HasDamage() const { return fPainter != nullptr && fPainter->HasDamage(); }

	// Own coordinates. Without children and without what later siblings, own or inherited, cover
	// by a background; nothing while hidden.
	void GetClipping(const ServerView& view, const BRegion* constraint, BRegion* _region) const;
	// Moves pixels within the view; what has to be drawn instead of moved becomes dirty.
	void CopyBits(ServerView& view, BRect source, BRect destination);

	// The deepest view at a point of the window, the first of siblings; never the top node.
	ServerView* ViewAt(BPoint point) const;
	// The part of the view that its ancestors leave, in window coordinates; invalid when hidden.
	BRect VisibleFrame(const ServerView& view) const;

private:
	// Where a view lies in the window: its point (0, 0), and what its ancestors leave of it.
	struct Place {
		BPoint origin;
		clipping_rect cut;
		bool hidden;
	};
	struct Step {
		ServerView* view;
		BPoint origin;
		clipping_rect cut;
	};
	struct Current {
		const ServerView* view = nullptr; // borrowed; NULL when clipping must be made anew
		bool constraintDropped = false;
		BRegion clip;
	};

	static Place _PlaceIn(const Place& parent, const ServerView& view, BRect frame);
	Place _PlaceOf(const ServerView& view) const;
	Place _PlaceOfParent(const ServerView& view) const;
	void _MarkDirty(const clipping_rect& rect);
	void _MarkDirty(const Place& parent, const ServerView& view, BRect frame);
	void _SetFrame(ServerView& view, BRect frame, const Place& parent, bool parentDirty);
	void _DirtyAfterResize(const ServerView& view, BRect oldFrame, const Place& parent);
	void _ResizeBackground(ServerView& view, int32 dx, int32 dy);

	void _Collect(ServerView& view, const Place& parent, std::vector<Step>& steps);
	bool _UpdateStep(const Step& step, bool afterChildren);
	void _ExcludeChildren(const ServerView& view, BPoint origin, BRegion& region) const;
	void _PaintBackground(const ServerView& view, const Step& step, const BRegion& visible);
	void _SetCurrent(const ServerView& view, const BRegion* constraint);
	BRegion _Covering(const ServerView& view, const clipping_rect& cut, bool opaqueOnly) const;
	bool _CanShift(int32 dx, int32 dy) const;

	ViewTreeClient& fClient; // borrowed
	ServerView fRoot;
	Surface* fSurface = nullptr; // borrowed
	std::unique_ptr<Painter> fPainter;
	DrawState fBackgroundState;
	DirtyRegion fDirty;
	Current fCurrent;
	const RegionIndex* fUpdateRegion = nullptr; // during an update
	uint32 fAttachVersion = 0;
	int64 fCountDrawn = 0;
	int64 fCountClippings = 0;
	mutable int64 fCountHitTested = 0;
	mutable int64 fCountVisited = 0;
};


} // namespace BPrivate
