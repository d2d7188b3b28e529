// The drawing calls of views: lines, areas and curves.
#include <View.h>

#include <algorithm>

#include <Polygon.h>
#include <Region.h>
#include <Shape.h>
#include <Window.h>

#include "interface/private/ShapeAccess.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"
#include "server/ViewTree.h"
#include "server/paint/Painter.h"

using namespace BPrivate;

namespace {

BRect
ellipse_frame(BPoint center, float xRadius, float yRadius)
{
	return BRect(center.x - xRadius, center.y - yRadius, center.x + xRadius, center.y + yRadius);
}


BRect
frame_of(const BPoint* points, int32 count)
{
	BRect frame(points[0], points[0]);
	for (int32 i = 1; i < count; i++) {
		frame.left = std::min(frame.left, points[i].x);
		frame.top = std::min(frame.top, points[i].y);
		frame.right = std::max(frame.right, points[i].x);
		frame.bottom = std::max(frame.bottom, points[i].y);
	}
	return frame;
}


// The points, stretched and moved so that their own frame becomes the bounds.
BPolygon
mapped(const BPoint* points, int32 count, BRect bounds)
{
	BPolygon polygon(points, count);
	polygon.MapTo(frame_of(points, count), bounds);
	return polygon;
}

} // namespace


// The painter, set up for this view; NULL when nothing can be painted now.
Painter*
BView::_BeginDrawing()
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return nullptr;
	ViewTree* tree = fNode->Tree();
	Painter* painter = tree->BeginDrawing(*fNode,
		[this]() { return fState != nullptr ? fState->Constraint() : std::optional<BRegion>(); });
	if (painter == nullptr)
		return nullptr;
	painter->SetState(&_StateToRead().draw);
	if (!tree->IsUpdating())
		WindowInternals::Of(fOwner).NoteDrawing();
	return painter;
}


// #pragma mark - lines


void
BView::StrokeLine(BPoint toPoint, pattern p)
{
	StrokeLine(PenLocation(), toPoint, p);
}


void
BView::StrokeLine(BPoint start, BPoint end, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->StrokeLine(start, end, p);
	if (fOwner != nullptr)
		_SetPen(end);
}


void
BView::BeginLineArray(int32 count)
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return;
	_Extras()->lines.clear();
	_Extras()->inLineArray = true;
}


void
BView::AddLine(BPoint start, BPoint end, rgb_color color)
{
	if (fExtras != nullptr && fExtras->inLineArray)
		fExtras->lines.push_back({ start, end, color });
}


void
BView::EndLineArray()
{
	if (fExtras == nullptr || !fExtras->inLineArray)
		return;
	fExtras->inLineArray = false;
	Painter* painter = _BeginDrawing();
	if (painter != nullptr && !fExtras->lines.empty())
		painter->StrokeLines(fExtras->lines.data(), fExtras->lines.size());
	fExtras->lines.clear();
}


// #pragma mark - polygons


void
BView::StrokePolygon(const BPolygon* polygon, bool closed, pattern p)
{
	if (polygon != nullptr)
		StrokePolygon(polygon->Points(), polygon->CountPoints(), closed, p);
}


void
BView::StrokePolygon(const BPoint* points, int32 count, bool closed, pattern p)
{
	if (points == nullptr || count <= 0)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->StrokePolygon(points, count, closed, p);
}


void
BView::StrokePolygon(const BPoint* points, int32 count, BRect bounds, bool closed, pattern p)
{
	if (points == nullptr || count <= 0)
		return;
	const BPolygon polygon = mapped(points, count, bounds);
	StrokePolygon(&polygon, closed, p);
}


void
BView::FillPolygon(const BPolygon* polygon, pattern p)
{
	if (polygon != nullptr)
		FillPolygon(polygon->Points(), polygon->CountPoints(), p);
}


void
BView::FillPolygon(const BPoint* points, int32 count, pattern p)
{
	if (points == nullptr || count <= 0)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->FillPolygon(points, count, p);
}


void
BView::FillPolygon(const BPoint* points, int32 count, BRect bounds, pattern p)
{
	if (points == nullptr || count <= 0)
		return;
	const BPolygon polygon = mapped(points, count, bounds);
	FillPolygon(&polygon, p);
}


void
BView::StrokeTriangle(BPoint a, BPoint b, BPoint c, BRect, pattern p)
{
	StrokeTriangle(a, b, c, p);
}


void
BView::StrokeTriangle(BPoint a, BPoint b, BPoint c, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->StrokeTriangle(a, b, c, p);
}


void
BView::FillTriangle(BPoint a, BPoint b, BPoint c, BRect, pattern p)
{
	FillTriangle(a, b, c, p);
}


void
BView::FillTriangle(BPoint a, BPoint b, BPoint c, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->FillTriangle(a, b, c, p);
}


// #pragma mark - rectangles


void
BView::StrokeRect(BRect rect, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->StrokeRect(rect, p);
}


void
BView::FillRect(BRect rect, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->FillRect(rect, p);
}


void
BView::FillRegion(BRegion* region, pattern p)
{
	if (region == nullptr)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->FillRegion(*region, p);
}


void
BView::InvertRect(BRect rect)
{
	if (Painter* painter = _BeginDrawing())
		painter->InvertRect(rect);
}


void
BView::StrokeRoundRect(BRect rect, float xRadius, float yRadius, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->StrokeRoundRect(rect, xRadius, yRadius, p);
}


void
BView::FillRoundRect(BRect rect, float xRadius, float yRadius, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->FillRoundRect(rect, xRadius, yRadius, p);
}


// #pragma mark - curves


void
BView::StrokeEllipse(BPoint center, float xRadius, float yRadius, pattern p)
{
	StrokeEllipse(ellipse_frame(center, xRadius, yRadius), p);
}


void
BView::StrokeEllipse(BRect rect, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->StrokeEllipse(rect, p);
}


void
BView::FillEllipse(BPoint center, float xRadius, float yRadius, pattern p)
{
	FillEllipse(ellipse_frame(center, xRadius, yRadius), p);
}


void
BView::FillEllipse(BRect rect, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->FillEllipse(rect, p);
}


void
BView::StrokeArc(
	BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle, pattern p)
{
	StrokeArc(ellipse_frame(center, xRadius, yRadius), startAngle, arcAngle, p);
}


void
BView::StrokeArc(BRect rect, float startAngle, float arcAngle, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->StrokeArc(rect, startAngle, arcAngle, p);
}


void
BView::FillArc(
	BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle, pattern p)
{
	FillArc(ellipse_frame(center, xRadius, yRadius), startAngle, arcAngle, p);
}


void
BView::FillArc(BRect rect, float startAngle, float arcAngle, pattern p)
{
	if (Painter* painter = _BeginDrawing())
		painter->FillArc(rect, startAngle, arcAngle, p);
}


void
BView::StrokeBezier(BPoint* controlPoints, pattern p)
{
	if (controlPoints == nullptr)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->StrokeBezier(controlPoints, p);
}


void
BView::FillBezier(BPoint* controlPoints, pattern p)
{
	if (controlPoints == nullptr)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->FillBezier(controlPoints, p);
}


void
BView::StrokeShape(BShape* shape, pattern p)
{
	if (shape == nullptr)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->StrokePath(ShapeAccess::Path(*shape), PenLocation(), p);
}


void
BView::FillShape(BShape* shape, pattern p)
{
	if (shape == nullptr)
		return;
	if (Painter* painter = _BeginDrawing())
		painter->FillPath(ShapeAccess::Path(*shape), PenLocation(), p);
}
