#include "server/paint/Painter.h"

#include <algorithm>
#include <stdlib.h>
#include <vector>

#include "server/paint/PaintTask.h"
#include "server/paint/PathPainter.h"

namespace BPrivate {

namespace {

// Slanted lines up to this pen size are painted in whole pixels, thicker ones as smooth outlines.
constexpr int32 kMaxSolidPen = 2;


int64
Area(const clipping_rect& rect)
{
	return (int64)(rect.right - rect.left + 1) * (rect.bottom - rect.top + 1);
}


clipping_rect
Union(const clipping_rect& a, const clipping_rect& b)
{
	return { std::min(a.left, b.left), std::min(a.top, b.top), std::max(a.right, b.right),
		std::max(a.bottom, b.bottom) };
}


bool
Includes(const clipping_rect& outer, const clipping_rect& inner)
{
	return outer.left <= inner.left && inner.right <= outer.right && outer.top <= inner.top
		&& inner.bottom <= outer.bottom;
}


// Device pixels round all points, with room for the pen.
clipping_rect
BoundsOf(const PaintTask& task, const std::vector<BPoint>& points)
{
	clipping_rect bounds = { INT32_MAX, INT32_MAX, INT32_MIN, INT32_MIN };
	for (BPoint point : points) {
		const int32 x = PaintTask::Round(point.x);
		const int32 y = PaintTask::Round(point.y);
		bounds = Union(bounds, { x, y, x, y });
	}
	const int32 room = task.PenSize();
	return task.Target().ToDevice(
		{ bounds.left - room, bounds.top - room, bounds.right + room, bounds.bottom + room });
}


std::vector<BPoint>
ToSurface(const PaintTask& task, const BPoint* points, int32 count)
{
	std::vector<BPoint> result(points, points + count);
	for (BPoint& point : result)
		point = task.ToSurface(point);
	return result;
}


void
TraceOutline(PaintTask& task, CoverageMask& mask, const std::vector<BPoint>& points, bool closed,
	int32 penSize)
{
	auto fill = [&mask](const clipping_rect& rect) { mask.Fill(rect); };
	for (size_t i = 1; i < points.size(); i++)
		task.TraceLine(points[i - 1], points[i], penSize, fill);
	if (closed || points.size() == 1)
		task.TraceLine(points.back(), points.front(), penSize, fill);
}


// Fills the device pixels whose centres lie inside the polygon through the points' centres.
void
FillInterior(PaintTask& task, CoverageMask& mask, const std::vector<BPoint>& points)
{
	struct Crossing {
		double x;
		int32 direction;
	};
	const double scale = task.Scale();
	const bool evenOdd = task.State().fillRule == B_EVEN_ODD;
	std::vector<Crossing> crossings;
	for (int32 y = mask.Rect().top; y <= mask.Rect().bottom; y++) {
		const double middle = y + 0.5;
		crossings.clear();
		for (size_t i = 0; i < points.size(); i++) {
			const BPoint a = points[i];
			const BPoint b = points[i + 1 < points.size() ? i + 1 : 0];
			const double topY = (PaintTask::Round(a.y) + 0.5) * scale;
			const double endY = (PaintTask::Round(b.y) + 0.5) * scale;
			if ((topY <= middle) == (endY <= middle))
				continue;
			const double topX = (PaintTask::Round(a.x) + 0.5) * scale;
			const double endX = (PaintTask::Round(b.x) + 0.5) * scale;
			crossings.push_back(
				{ topX + (endX - topX) * (middle - topY) / (endY - topY), topY < endY ? 1 : -1 });
		}
		std::sort(crossings.begin(), crossings.end(),
			[](const Crossing& a, const Crossing& b) { return a.x < b.x; });
		int32 winding = 0;
		for (size_t i = 0; i + 1 < crossings.size(); i++) {
			winding += evenOdd ? (i % 2 == 0 ? 1 : -1) : crossings[i].direction;
			if (winding == 0)
				continue;
			const double left = std::max(crossings[i].x, (double)mask.Rect().left);
			const double right = std::min(crossings[i + 1].x, mask.Rect().right + 1.0);
			mask.Fill({ (int32)ceil(left - 0.5), y, (int32)ceil(right - 0.5) - 1, y });
		}
	}
}


void
StrokeOneLine(PaintTask& task, BPoint from, BPoint to)
{
	const BPoint start = task.ToSurface(from);
	const BPoint end = task.ToSurface(to);
	const int32 width = abs(PaintTask::Round(start.x) - PaintTask::Round(end.x));
	const int32 height = abs(PaintTask::Round(start.y) - PaintTask::Round(end.y));
	if (task.PenSize() > kMaxSolidPen && width > 0 && height > 0) {
		PathPainter path(task);
		path.MoveTo(start);
		path.LineTo(end);
		path.Stroke();
		return;
	}

	clipping_rect damage = { INT32_MAX, INT32_MAX, INT32_MIN, INT32_MIN };
	task.TraceLine(start, end, task.PenSize(), [&](const clipping_rect& rect) {
		task.Output().FillRect(rect);
		damage = Union(damage, rect);
	});
	task.AddDamage(Intersect(damage, task.Output().Bounds()));
}

} // namespace


Painter::Painter(Surface& surface) :
	fSurface(surface), fClip(nullptr), fState(nullptr), fDamageCount(0)
{
}


Painter::~Painter() = default;


void
Painter::SetTransform(BPoint viewOrigin)
{
	fOrigin = viewOrigin;
}


void
Painter::SetClip(const BRegion* clip)
{
	fClip = clip;
}


void
Painter::SetState(const DrawState* state)
{
	fState = state;
}


// #pragma mark - lines


void
Painter::StrokeLine(BPoint from, BPoint to, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	StrokeOneLine(task, from, to);
}


void
Painter::StrokeLines(const PaintedLine* lines, int32 count)
{
	Ink ink = PaintTask::InkOf(*this);
	for (int32 i = 0; i < count; i++) {
		ink.SetHigh(lines[i].color);
		PaintTask task(*this, B_SOLID_HIGH, ink);
		StrokeOneLine(task, lines[i].start, lines[i].end);
	}
}


// #pragma mark - rectangles


void
Painter::StrokeRect(BRect rect, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect line = task.ToSurface(rect);
	if (!IsValid(line))
		return;

	const int32 before = task.PenBefore();
	const int32 after = task.PenAfter();
	const clipping_rect outer = { line.left - before, line.top - before, line.right + after,
		line.bottom + after };
	const clipping_rect inner = { line.left + after + 1, line.top + after + 1,
		line.right - before - 1, line.bottom - before - 1 };
	if (!IsValid(inner)) {
		task.FillLogical(outer);
		return;
	}
	task.FillLogical({ outer.left, outer.top, outer.right, inner.top - 1 });
	task.FillLogical({ outer.left, inner.bottom + 1, outer.right, outer.bottom });
	task.FillLogical({ outer.left, inner.top, inner.left - 1, inner.bottom });
	task.FillLogical({ inner.right + 1, inner.top, outer.right, inner.bottom });
}


void
Painter::FillRect(BRect rect, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	task.FillLogical(task.ToSurface(rect));
}


void
Painter::FillRegion(const BRegion& region, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	for (int32 i = 0; i < region.CountRects(); i++)
		task.FillLogical(task.ToSurface(region.RectAt(i)));
}


void
Painter::InvertRect(BRect rect)
{
	Ink ink = PaintTask::InkOf(*this);
	ink.mode = B_OP_INVERT;
	PaintTask task(*this, B_SOLID_HIGH, ink);
	task.FillLogical(task.ToSurface(rect));
}


// #pragma mark - polygons


void
Painter::StrokePolygon(const BPoint* points, int32 count, bool closed, const pattern& pattern)
{
	if (count < 1)
		return;
	PaintTask task(*this, pattern);
	const std::vector<BPoint> corners = ToSurface(task, points, count);
	if (task.PenSize() > kMaxSolidPen) {
		PathPainter path(task);
		path.AddPolygon(corners, closed);
		path.Stroke();
		return;
	}
	CoverageMask mask(Intersect(BoundsOf(task, corners), task.Output().Bounds()));
	if (!IsValid(mask.Rect()))
		return;
	TraceOutline(task, mask, corners, closed, task.PenSize());
	task.FillMask(mask);
}


void
Painter::FillPolygon(const BPoint* points, int32 count, const pattern& pattern)
{
	if (count < 1)
		return;
	PaintTask task(*this, pattern);
	const std::vector<BPoint> corners = ToSurface(task, points, count);
	CoverageMask mask(Intersect(BoundsOf(task, corners), task.Output().Bounds()));
	if (!IsValid(mask.Rect()))
		return;
	FillInterior(task, mask, corners);
	TraceOutline(task, mask, corners, true, 1);
	task.FillMask(mask);
}


void
Painter::StrokeTriangle(BPoint a, BPoint b, BPoint c, const pattern& pattern)
{
	const BPoint points[] = { a, b, c };
	StrokePolygon(points, 3, true, pattern);
}


void
Painter::FillTriangle(BPoint a, BPoint b, BPoint c, const pattern& pattern)
{
	const BPoint points[] = { a, b, c };
	FillPolygon(points, 3, pattern);
}


// #pragma mark - damage


void
Painter::TakeDamage(BRegion* _damage)
{
	_damage->MakeEmpty();
	for (int32 i = 0; i < fDamageCount; i++)
		_damage->Include(fDamage[i]);
	fDamageCount = 0;
}


// Joins the rectangle to one that grows little by it; with no room left, to the one that grows
// least.
void
Painter::_AddDamage(const clipping_rect& deviceRect)
{
	if (!IsValid(deviceRect))
		return;
	const clipping_rect rect = { fSurface.LogicalAt(deviceRect.left),
		fSurface.LogicalAt(deviceRect.top), fSurface.LogicalAt(deviceRect.right),
		fSurface.LogicalAt(deviceRect.bottom) };

	// Most of what is painted lies in what has been painted already.
	for (int32 i = 0; i < fDamageCount; i++) {
		if (Includes(fDamage[i], rect))
			return;
	}
	int32 best = -1;
	int64 leastWaste = INT64_MAX;
	for (int32 i = fDamageCount - 1; i >= 0; i--) {
		const int64 waste = Area(Union(fDamage[i], rect)) - Area(fDamage[i]) - Area(rect);
		if (waste < leastWaste) {
			leastWaste = waste;
			best = i;
		}
	}
	const bool joins = best >= 0 && leastWaste <= Area(rect) / 8;
	if (joins || fDamageCount == kMaxDamage)
		fDamage[best] = Union(fDamage[best], rect);
	else
		fDamage[fDamageCount++] = rect;
}


} // namespace BPrivate
