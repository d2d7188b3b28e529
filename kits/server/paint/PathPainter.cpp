#include "server/paint/PathPainter.h"

#include <QPainterPath>
#include <QPainterPathStroker>
#include <QPolygonF>
#include <QTransform>
#include <math.h>

#include "server/paint/CoverageRaster.h"

namespace BPrivate {

namespace {

// Keeps Qt's rasterizer within its own coordinates.
double
Limit(double coordinate)
{
	constexpr double kLimit = 1 << 20;
	return coordinate >= -kLimit ? (coordinate <= kLimit ? coordinate : kLimit) : -kLimit;
}


QRectF
MakeRect(double left, double top, double right, double bottom, double scale)
{
	return QRectF(QPointF(Limit(left * scale), Limit(top * scale)),
		QPointF(Limit(right * scale), Limit(bottom * scale)));
}


QPointF
Center(BPoint point, double scale)
{
	return QPointF(Limit((point.x + 0.5) * scale), Limit((point.y + 0.5) * scale));
}

} // namespace


PathPainter::PathPainter(PaintTask& task) :
	fTask(task), fPath(std::make_unique<QPainterPath>()), fScale(task.Scale())
{
	fPath->setFillRule(Qt::WindingFill);
}


PathPainter::~PathPainter() = default;


void
PathPainter::MoveTo(BPoint point)
{
	fPath->moveTo(Center(point, fScale));
}


void
PathPainter::LineTo(BPoint point)
{
	fPath->lineTo(Center(point, fScale));
}


void
PathPainter::CurveTo(BPoint control1, BPoint control2, BPoint end)
{
	fPath->cubicTo(Center(control1, fScale), Center(control2, fScale), Center(end, fScale));
}


void
PathPainter::Close()
{
	fPath->closeSubpath();
}


void
PathPainter::AddPolygon(const std::vector<BPoint>& points, bool closed)
{
	for (size_t i = 0; i < points.size(); i++) {
		if (i == 0)
			MoveTo(points[i]);
		else
			LineTo(points[i]);
	}
	if (closed)
		Close();
}


void
PathPainter::AddPath(const PathData& path)
{
	const BPoint* next = path.points.data();
	for (PathData::Verb verb : path.verbs) {
		switch (verb) {
			case PathData::kMoveTo:
				MoveTo(*next++);
				break;
			case PathData::kLineTo:
				LineTo(*next++);
				break;
			case PathData::kBezierTo:
				CurveTo(next[0], next[1], next[2]);
				next += 3;
				break;
			case PathData::kClose:
				Close();
				break;
		}
	}
}


void
PathPainter::AddEllipse(double left, double top, double right, double bottom)
{
	fPath->addEllipse(MakeRect(left, top, right, bottom, fScale));
}


void
PathPainter::AddRoundRect(
	double left, double top, double right, double bottom, double xRadius, double yRadius)
{
	fPath->addRoundedRect(MakeRect(left, top, right, bottom, fScale), Limit(xRadius * fScale),
		Limit(yRadius * fScale));
}


void
PathPainter::AddArc(
	double left, double top, double right, double bottom, double start, double angle, bool pie)
{
	const QRectF rect = MakeRect(left, top, right, bottom, fScale);
	if (pie)
		fPath->moveTo(rect.center());
	else
		fPath->arcMoveTo(rect, start);
	fPath->arcTo(rect, start, angle);
	if (pie)
		fPath->closeSubpath();
}


void
PathPainter::Fill(bool leavesHoles)
{
	if (leavesHoles || fTask.State().fillRule == B_EVEN_ODD)
		fPath->setFillRule(Qt::OddEvenFill);
	_FillPath(*fPath);
}


void
PathPainter::Stroke()
{
	QPainterPathStroker stroker;
	stroker.setWidth(fTask.PenSize() * fScale);
	stroker.setMiterLimit(fTask.State().miterLimit);
	switch (fTask.State().lineCap) {
		case B_ROUND_CAP:
			stroker.setCapStyle(Qt::RoundCap);
			break;
		case B_SQUARE_CAP:
			stroker.setCapStyle(Qt::SquareCap);
			break;
		default:
			stroker.setCapStyle(Qt::FlatCap);
			break;
	}
	switch (fTask.State().lineJoin) {
		case B_ROUND_JOIN:
			stroker.setJoinStyle(Qt::RoundJoin);
			break;
		case B_MITER_JOIN:
			stroker.setJoinStyle(Qt::SvgMiterJoin);
			break;
		default:
			stroker.setJoinStyle(Qt::BevelJoin);
			break;
	}
	QPainterPath outline = stroker.createStroke(*fPath);
	// An even pen lies half a pixel further right and down: 2 covers c and c + 1.
	if (fTask.PenSize() % 2 == 0)
		outline.translate(fScale / 2, fScale / 2);
	outline.setFillRule(Qt::WindingFill);
	_FillPath(outline);
}


void
PathPainter::_FillPath(const QPainterPath& path)
{
	const QRectF bounds = path.boundingRect();
	const clipping_rect rect = { (int32)floor(bounds.left()), (int32)floor(bounds.top()),
		(int32)ceil(bounds.right()), (int32)ceil(bounds.bottom()) };
	const clipping_rect visible = Intersect(rect, fTask.Output().Bounds());
	if (!IsValid(visible))
		return;

	// Curves become lines that miss them by less than an eighth of what Qt allows for
	// whole pixels.
	constexpr double kFineness = 8;
	CoverageRaster raster(visible);
	for (const QPolygonF& polygon :
		path.toSubpathPolygons(QTransform::fromScale(kFineness, kFineness))) {
		for (qsizetype i = 0; i < polygon.size(); i++) {
			const QPointF from = polygon[i] / kFineness;
			const QPointF to = polygon[i + 1 < polygon.size() ? i + 1 : 0] / kFineness;
			raster.AddLine(from.x(), from.y(), to.x(), to.y());
		}
	}
	fTask.Output().FillMask(visible, raster.Finish(path.fillRule() == Qt::OddEvenFill),
		visible.right - visible.left + 1);
	fTask.AddDamage(visible);
}


} // namespace BPrivate
