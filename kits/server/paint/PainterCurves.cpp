#include "server/paint/PaintTask.h"
#include "server/paint/Painter.h"
#include "server/paint/PathPainter.h"

#include <algorithm>

namespace BPrivate {

namespace {

bool
HasCurves(const PathData& path)
{
	return std::find(path.verbs.begin(), path.verbs.end(), PathData::kBezierTo) != path.verbs.end();
}


// The only piece of a path of lines; empty if there are several.
std::vector<BPoint>
SinglePolygon(const PathData& path, BPoint at, bool* _closed)
{
	std::vector<BPoint> points;
	*_closed = false;
	for (size_t i = 0; i < path.verbs.size(); i++) {
		if (path.verbs[i] == PathData::kClose) {
			if (i + 1 != path.verbs.size())
				return {};
			*_closed = true;
		} else if (path.verbs[i] == PathData::kMoveTo && i > 0)
			return {};
	}
	for (BPoint point : path.points)
		points.push_back(point + at);
	return points;
}


PathData
ToSurface(const PaintTask& task, const PathData& path, BPoint at)
{
	PathData result(path);
	for (BPoint& point : result.points)
		point = task.ToSurface(point + at);
	return result;
}

} // namespace


// #pragma mark - round rectangles and ellipses


// The ring between the pen's outer and inner edge, so that the edge pixels are exact.
void
Painter::StrokeRoundRect(BRect rect, float xRadius, float yRadius, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect line = task.ToSurface(rect);
	if (!IsValid(line))
		return;
	const double before = task.PenBefore();
	const double after = task.PenAfter();
	const double rx = task.State().Transform(xRadius);
	const double ry = task.State().Transform(yRadius);
	const double pen = task.PenSize();
	PathPainter path(task);
	path.AddRoundRect(line.left - before, line.top - before, line.right + 1 + after,
		line.bottom + 1 + after, rx + before, ry + before);
	if (line.left + after + 1 < line.right - before
		&& line.top + after + 1 < line.bottom - before) {
		path.AddRoundRect(line.left + after + 1, line.top + after + 1, line.right - before,
			line.bottom - before, std::max(0.0, rx + before - pen),
			std::max(0.0, ry + before - pen));
	}
	path.Fill(true);
}


void
Painter::FillRoundRect(BRect rect, float xRadius, float yRadius, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect area = task.ToSurface(rect);
	if (!IsValid(area))
		return;
	PathPainter path(task);
	path.AddRoundRect(area.left, area.top, area.right + 1, area.bottom + 1,
		task.State().Transform(xRadius), task.State().Transform(yRadius));
	path.Fill();
}


void
Painter::StrokeEllipse(BRect rect, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect line = task.ToSurface(rect);
	if (!IsValid(line))
		return;
	const double before = task.PenBefore();
	const double after = task.PenAfter();
	PathPainter path(task);
	path.AddEllipse(
		line.left - before, line.top - before, line.right + 1 + after, line.bottom + 1 + after);
	if (line.left + after + 1 < line.right - before
		&& line.top + after + 1 < line.bottom - before) {
		path.AddEllipse(
			line.left + after + 1, line.top + after + 1, line.right - before, line.bottom - before);
	}
	path.Fill(true);
}


void
Painter::FillEllipse(BRect rect, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect area = task.ToSurface(rect);
	if (!IsValid(area))
		return;
	PathPainter path(task);
	path.AddEllipse(area.left, area.top, area.right + 1, area.bottom + 1);
	path.Fill();
}


void
Painter::StrokeArc(BRect rect, float start, float angle, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect line = task.ToSurface(rect);
	if (!IsValid(line))
		return;
	PathPainter path(task);
	path.AddArc(
		line.left + 0.5, line.top + 0.5, line.right + 0.5, line.bottom + 0.5, start, angle, false);
	path.Stroke();
}


void
Painter::FillArc(BRect rect, float start, float angle, const pattern& pattern)
{
	PaintTask task(*this, pattern);
	const clipping_rect area = task.ToSurface(rect);
	if (!IsValid(area))
		return;
	PathPainter path(task);
	path.AddArc(area.left, area.top, area.right + 1, area.bottom + 1, start, angle, true);
	path.Fill();
}


// #pragma mark - free curves


void
Painter::StrokeBezier(const BPoint points[4], const pattern& pattern)
{
	PaintTask task(*this, pattern);
	PathPainter path(task);
	path.MoveTo(task.ToSurface(points[0]));
	path.CurveTo(task.ToSurface(points[1]), task.ToSurface(points[2]), task.ToSurface(points[3]));
	path.Stroke();
}


void
Painter::FillBezier(const BPoint points[4], const pattern& pattern)
{
	PaintTask task(*this, pattern);
	PathPainter path(task);
	path.MoveTo(task.ToSurface(points[0]));
	path.CurveTo(task.ToSurface(points[1]), task.ToSurface(points[2]), task.ToSurface(points[3]));
	path.Close();
	path.Fill();
}


// A path of lines follows the rules of polygons, so that its edges are as crisp.
void
Painter::StrokePath(const PathData& path, BPoint at, const pattern& pattern)
{
	bool closed = false;
	if (!HasCurves(path)) {
		const std::vector<BPoint> points = SinglePolygon(path, at, &closed);
		if (!points.empty()) {
			StrokePolygon(points.data(), points.size(), closed, pattern);
			return;
		}
	}
	PaintTask task(*this, pattern);
	PathPainter outline(task);
	outline.AddPath(ToSurface(task, path, at));
	outline.Stroke();
}


void
Painter::FillPath(const PathData& path, BPoint at, const pattern& pattern)
{
	bool closed = false;
	if (!HasCurves(path)) {
		const std::vector<BPoint> points = SinglePolygon(path, at, &closed);
		if (!points.empty()) {
			FillPolygon(points.data(), points.size(), pattern);
			return;
		}
	}
	PaintTask task(*this, pattern);
	PathPainter outline(task);
	outline.AddPath(ToSurface(task, path, at));
	outline.Fill();
}


} // namespace BPrivate
