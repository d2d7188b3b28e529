// The walk that paints, clipping, and the moving of pixels.
#include <array>
#include <cmath>

#include "server/ViewTree.h"

namespace BPrivate {

namespace {

constexpr size_t kFewRects = 8;
constexpr int32 kFewAreas = 16;


int32
rounded(float value)
{
	return static_cast<int32>(std::lround(value));
}


// A part of the window in the coordinates of a view, to the nearest pixel.
clipping_rect
in_view(const clipping_rect& rect, BPoint origin)
{
	const int32 x = rounded(origin.x);
	const int32 y = rounded(origin.y);
	return { rect.left - x, rect.top - y, rect.right - x, rect.bottom - y };
}


// The same of a region, for finding some of many children. One that is scattered counts as a whole.
std::vector<clipping_rect>
search_areas(const BRegion& region, BPoint origin)
{
	std::vector<clipping_rect> rects;
	if (region.CountRects() > kFewAreas) {
		rects.push_back(in_view(region.FrameInt(), origin));
		return rects;
	}
	for (int32 i = 0; i < region.CountRects(); i++)
		rects.push_back(in_view(region.RectAtInt(i), origin));
	return rects;
}


// Takes many rectangles out of a region at the cost of one merge.
void
exclude_all(BRegion& region, std::vector<clipping_rect>& rects)
{
	if (rects.size() <= kFewRects) {
		for (const clipping_rect& rect : rects)
			region.Exclude(rect);
		return;
	}
	const BRegion sum = unite(rects);
	region.Exclude(&sum);
}


BRegion
region_of(const clipping_rect& rect)
{
	BRegion region;
	if (!is_empty(rect))
		region.Set(rect);
	return region;
}

} // namespace


void
ViewTree::Update()
{
	if (fPainter == nullptr || fUpdateRegion != nullptr)
		return;

	BRegion dirty = fDirty.Take();
	const BRegion window = region_of(to_pixels(fRoot.Bounds()));
	dirty.IntersectWith(&window);
	if (dirty.IsEmpty())
		return;

	const RegionIndex index(dirty);
	fUpdateRegion = &index;
	fCurrent.view = nullptr;
	std::vector<Step> steps;
	_Collect(fRoot, _PlaceOfParent(fRoot), steps);

	// A hook may add or remove views, although it should not. Then the rest is done by a later
	// update, because the steps may name views that are gone.
	const uint32 version = fAttachVersion;
	bool complete = true;
	for (size_t i = 0; complete && i < steps.size(); i++)
		complete = _UpdateStep(steps[i], false) && version == fAttachVersion;
	for (size_t i = steps.size(); complete && i-- > 0;) {
		if (steps[i].view->Has(kDrawOnChildren))
			complete = _UpdateStep(steps[i], true) && version == fAttachVersion;
	}
	fUpdateRegion = nullptr;
	fCurrent.view = nullptr;
	if (!complete)
		InvalidateWindow(dirty);
}


void
ViewTree::_Collect(ServerView& view, const Place& parent, std::vector<Step>& steps)
{
	const Place place = _PlaceIn(parent, view, view.Frame());
	if (place.hidden || is_empty(place.cut) || !fUpdateRegion->Intersects(place.cut))
		return;
	steps.push_back({ &view, place.origin, place.cut });
	std::vector<clipping_rect> areas;
	if (view.CountChildren() >= ChildIndex::kFewestChildren)
		areas = search_areas(fUpdateRegion->Part(place.cut), place.origin);
	view.ForEachChildIn(areas, nullptr, [&](ServerView& child) {
		fCountVisited++;
		_Collect(child, place, steps);
		return true;
	});
}


// Returns whether the walk may go on; painting may have been made impossible by a hook.
bool
ViewTree::_UpdateStep(const Step& step, bool afterChildren)
{
	ServerView& view = *step.view;
	BRegion visible = fUpdateRegion->Part(step.cut);
	if (!view.Has(kDrawOnChildren))
		_ExcludeChildren(view, step.origin, visible);
	if (visible.IsEmpty())
		return true;

	fCurrent.view = nullptr;
	if (!afterChildren)
		_PaintBackground(view, step, visible);
	if (!view.Has(kWillDraw) || view.Owner() == nullptr)
		return true;

	const BRect updateRect = visible.Frame().OffsetByCopy(-step.origin.x, -step.origin.y);
	fCountDrawn++;
	fClient.DrawView(view, updateRect, afterChildren);
	return fPainter != nullptr;
}


void
ViewTree::_ExcludeChildren(const ServerView& view, BPoint origin, BRegion& region) const
{
	if (view.FirstChild() == nullptr || region.IsEmpty())
		return;
	const clipping_rect frame = region.FrameInt();
	std::vector<clipping_rect> rects;
	std::vector<clipping_rect> areas;
	if (view.CountChildren() >= ChildIndex::kFewestChildren)
		areas = search_areas(region, origin);
	view.ForEachChildIn(areas, nullptr, [&](const ServerView& child) {
		fCountVisited++;
		if (child.HideCount() > 0 || child.Has(kTransparentBackground))
			return true;
		const clipping_rect rect = to_pixels(child.Frame().OffsetByCopy(origin));
		const clipping_rect part = intersect(rect, frame);
		if (!is_empty(part))
			rects.push_back(part);
		return true;
	});
	exclude_all(region, rects);
}


void
ViewTree::_PaintBackground(const ServerView& view, const Step& step, const BRegion& visible)
{
	fPainter->SetTransform(step.origin);
	fPainter->SetClip(&visible);
	fPainter->SetState(&fBackgroundState);
	const BRect area = visible.Frame().OffsetByCopy(-step.origin.x, -step.origin.y);
	if (view.IsOpaque()) {
		fBackgroundState.highColor = view.Color();
		fPainter->FillRect(area);
	}
	if (const ViewBackground* background = view.Background()) {
		fPainter->DrawTiled(*background->image, background->source, background->destination, area,
			background->options & (B_TILE_BITMAP_X | B_TILE_BITMAP_Y),
			background->options & B_FILTER_BITMAP_BILINEAR);
	}
}


// #pragma mark - drawing


void
ViewTree::_SetCurrent(const ServerView& view, const BRegion* constraint)
{
	fCountClippings++;
	fCurrent = { &view, false, BRegion() };
	if (fPainter == nullptr)
		return;
	const Place place = _PlaceOf(view);
	if (place.hidden)
		return;

	BRegion clip = fUpdateRegion != nullptr ? fUpdateRegion->Part(place.cut) : region_of(place.cut);
	if (!view.Has(kDrawOnChildren))
		_ExcludeChildren(view, place.origin, clip);
	if (constraint != nullptr) {
		BRegion inWindow(*constraint);
		inWindow.OffsetBy(rounded(place.origin.x), rounded(place.origin.y));
		clip.IntersectWith(&inWindow);
	}
	fCurrent.clip = std::move(clip);
	fPainter->SetTransform(place.origin);
	fPainter->SetClip(&fCurrent.clip);
}


void
ViewTree::ConstraintChanged(const ServerView& view)
{
	if (fCurrent.view == &view)
		fCurrent.constraintDropped = true;
}


void
ViewTree::GetClipping(const ServerView& view, const BRegion* constraint, BRegion* _region) const
{
	_region->MakeEmpty();
	const Place place = _PlaceOf(view);
	if (place.hidden || is_empty(place.cut))
		return;

	BRegion clip = fUpdateRegion != nullptr ? fUpdateRegion->Part(place.cut) : region_of(place.cut);
	if (!view.Has(kDrawOnChildren))
		_ExcludeChildren(view, place.origin, clip);
	const BRegion covered = _Covering(view, place.cut, true);
	clip.Exclude(&covered);
	clip.OffsetBy(-rounded(place.origin.x), -rounded(place.origin.y));
	if (constraint != nullptr)
		clip.IntersectWith(constraint);
	*_region = std::move(clip);
}


// What later siblings, the view's own and those of its ancestors, take of the area.
BRegion
ViewTree::_Covering(const ServerView& view, const clipping_rect& cut, bool opaqueOnly) const
{
	std::vector<clipping_rect> rects;
	for (const ServerView* level = &view; level->Parent() != nullptr; level = level->Parent()) {
		if (level->Next() == nullptr)
			continue;
		const Place parent = _PlaceOf(*level->Parent());
		const std::array area = { in_view(cut, parent.origin) };
		level->Parent()->ForEachChildIn(area, level, [&](const ServerView& sibling) {
			fCountVisited++;
			if (sibling.HideCount() > 0 || (opaqueOnly && !sibling.IsOpaque()))
				return true;
			const Place place = _PlaceIn(parent, sibling, sibling.Frame());
			const clipping_rect part = intersect(place.cut, cut);
			if (!is_empty(part))
				rects.push_back(part);
			return true;
		});
	}
	return unite(rects);
}


// #pragma mark - moving pixels


// Pixels are moved as they are only if every logical pixel covers as many device pixels at its
// new place as it did at the old one.
bool
ViewTree::_CanShift(int32 dx, int32 dy) const
{
	if (fPainter == nullptr || fUpdateRegion != nullptr)
		return false;
	const float scale = fSurface->Scale();
	return std::floor(scale * dx) == scale * dx && std::floor(scale * dy) == scale * dy;
}


void
ViewTree::ScrollTo(ServerView& view, BPoint leftTop)
{
	const int32 dx = rounded(view.Scroll().x - leftTop.x);
	const int32 dy = rounded(view.Scroll().y - leftTop.y);
	const Place place = _PlaceOf(view);
	view.SetScroll(leftTop);
	fCurrent.view = nullptr;
	if (place.hidden || is_empty(place.cut))
		return;

	const int32 width = place.cut.right - place.cut.left + 1;
	const int32 height = place.cut.bottom - place.cut.top + 1;
	if (!_CanShift(dx, dy) || std::abs(dx) >= width || std::abs(dy) >= height) {
		_MarkDirty(place.cut);
		return;
	}

	// What other views have painted in front stays where it is, and is painted anew.
	BRegion movable = region_of(place.cut);
	const BRegion covered = _Covering(view, place.cut, false);
	movable.Exclude(&covered);
	fDirty.Shift(movable, dx, dy);

	const BRect area(place.cut.left, place.cut.top, place.cut.right, place.cut.bottom);
	BRegion missing;
	fPainter->SetTransform(BPoint(0, 0));
	fPainter->SetClip(&movable);
	fPainter->SetState(&fBackgroundState);
	fPainter->CopyBits(area, area.OffsetByCopy(dx, dy), &missing);
	BRegion exposed = region_of(place.cut);
	const BRegion reached = region_of(intersect(
		{ place.cut.left + dx, place.cut.top + dy, place.cut.right + dx, place.cut.bottom + dy },
		place.cut));
	exposed.Exclude(&reached);
	exposed.Include(&missing);
	exposed.Include(&covered);
	const BRegion cut = region_of(place.cut);
	exposed.IntersectWith(&cut);
	InvalidateWindow(exposed);
}


void
ViewTree::CopyBits(ServerView& view, BRect source, BRect destination)
{
	const Place place = _PlaceOf(view);
	if (place.hidden || fPainter == nullptr)
		return;
	_SetCurrent(view, nullptr);
	if (fCurrent.clip.IsEmpty())
		return;
	fPainter->SetState(&fBackgroundState);
	BRegion missing;
	fPainter->CopyBits(source, destination, &missing);
	// Where the source is dirty the copy is as well.
	if (!fDirty.IsEmpty()) {
		BRegion stale(source.OffsetByCopy(place.origin));
		stale.IntersectWith(&fDirty.Region());
		stale.OffsetBy(
			rounded(destination.left - source.left), rounded(destination.top - source.top));
		missing.Include(&stale);
	}
	missing.IntersectWith(&fCurrent.clip);
	InvalidateWindow(missing);
}


} // namespace BPrivate
