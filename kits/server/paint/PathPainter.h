// PathPainter: outlines with curves, smoothed.
#pragma once

#include <memory>
#include <vector>

#include "server/paint/PaintTask.h"

class QPainterPath;

namespace BPrivate {


// Points are in logical pixels of the surface, and name centres of pixels. A path is made, then
// filled or stroked once.
class PathPainter {
public:
	explicit PathPainter(PaintTask& task); // borrowed
	~PathPainter();

	void MoveTo(BPoint point);
	void LineTo(BPoint point);
	void CurveTo(BPoint control1, BPoint control2, BPoint end);
	void Close();
	void AddPolygon(const std::vector<BPoint>& points, bool closed);
	void AddPath(const PathData& path);

	// Logical edges, the far ones outside. A second shape inside the first leaves a hole.
	void AddEllipse(double left, double top, double right, double bottom);
	void AddRoundRect(
		double left, double top, double right, double bottom, double xRadius, double yRadius);
	// Degrees against the clock; a pie has lines to the middle.
	void AddArc(
		double left, double top, double right, double bottom, double start, double angle, bool pie);

	void Fill(bool leavesHoles = false);
	// By the state's pen, caps and joins.
	void Stroke();

private:
	void _FillPath(const QPainterPath& path);

	PaintTask& fTask;
	std::unique_ptr<QPainterPath> fPath; // device pixels
	double fScale;
};


} // namespace BPrivate
