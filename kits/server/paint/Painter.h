// Painter: carries out drawing calls on a surface.
#pragma once

#include <memory>
#include <string_view>

#include <GraphicsDefs.h>
#include <Region.h>

#include "server/paint/DrawState.h"
#include "server/paint/Path.h"
#include "server/paint/Surface.h"

namespace BPrivate {

struct PaintedLine {
	BPoint start;
	BPoint end;
	rgb_color color;
};


// Coordinates of the calls are those of the view: the state's origin and scale are applied here,
// then the view's place on the surface. Axis-parallel lines, rectangles, triangles and polygons
// are painted in whole pixels, edges included; curves and thick slanted lines are smoothed.
// Nothing changes the state: the caller moves the pen. A painter and its surface belong to one
// thread at a time. Making one is cheap.
class Painter {
public:
	explicit Painter(Surface& surface); // borrowed
	~Painter();
	Painter(const Painter&) = delete;
	Painter& operator=(const Painter&) = delete;

	// Where the view's point (0, 0) lies, in logical pixels of the surface. Patterns start there.
	void SetTransform(BPoint viewOrigin);
	// Logical pixels of the surface; NULL is all of it. Borrowed until the next call.
	void SetClip(const BRegion* clip);
	// Borrowed until the next call; read again at each drawing call.
	void SetState(const DrawState* state);

	void StrokeLine(BPoint from, BPoint to, const pattern& pattern = B_SOLID_HIGH);
	void StrokeLines(const PaintedLine* lines, int32 count);
	void StrokeRect(BRect rect, const pattern& pattern = B_SOLID_HIGH);
	void FillRect(BRect rect, const pattern& pattern = B_SOLID_HIGH);
	void FillRegion(const BRegion& region, const pattern& pattern = B_SOLID_HIGH);
	void StrokeRoundRect(
		BRect rect, float xRadius, float yRadius, const pattern& pattern = B_SOLID_HIGH);
	void FillRoundRect(
		BRect rect, float xRadius, float yRadius, const pattern& pattern = B_SOLID_HIGH);
	void StrokeEllipse(BRect rect, const pattern& pattern = B_SOLID_HIGH);
	void FillEllipse(BRect rect, const pattern& pattern = B_SOLID_HIGH);
	// Degrees, against the clock from the right.
	void StrokeArc(BRect rect, float start, float angle, const pattern& pattern = B_SOLID_HIGH);
	void FillArc(BRect rect, float start, float angle, const pattern& pattern = B_SOLID_HIGH);
	void StrokePolygon(const BPoint* points, int32 count, bool closed = true,
		const pattern& pattern = B_SOLID_HIGH);
	void FillPolygon(const BPoint* points, int32 count, const pattern& pattern = B_SOLID_HIGH);
	// A triangle is a polygon of three points.
	void StrokeTriangle(BPoint a, BPoint b, BPoint c, const pattern& pattern = B_SOLID_HIGH);
	void FillTriangle(BPoint a, BPoint b, BPoint c, const pattern& pattern = B_SOLID_HIGH);
	void StrokeBezier(const BPoint points[4], const pattern& pattern = B_SOLID_HIGH);
	void FillBezier(const BPoint points[4], const pattern& pattern = B_SOLID_HIGH);
	// The path's own coordinates start at the given point.
	void StrokePath(const PathData& path, BPoint at, const pattern& pattern = B_SOLID_HIGH);
	void FillPath(const PathData& path, BPoint at, const pattern& pattern = B_SOLID_HIGH);
	void InvertRect(BRect rect);

	// Returns the pen's place after the text. Each glyph is followed by its part of the delta:
	// nonspace pixels for what can be seen, space pixels for white space.
	BPoint DrawString(std::string_view text, BPoint baseline, float nonspace = 0, float space = 0);

	// Draws the source's rectangle, in its pixels, over the destination's, stretched if they
	// differ. options: B_FILTER_BITMAP_BILINEAR. The source must not be this surface.
	void DrawBitmap(const Surface& bitmap, BRect source, BRect destination, uint32 options = 0);
	// Repeats the bitmap's source rectangle over `area`, one copy lying on the destination
	// rectangle; tiling has B_TILE_BITMAP_X and _Y. Always B_OP_COPY.
	void DrawTiled(const Surface& bitmap, BRect source, BRect destination, BRect area,
		uint32 tiling, uint32 options = 0);

	// Moves pixels of this surface, as scrolling does: a rectangle to one of the same size, in
	// view coordinates. Only what lies inside the clip at both ends is moved; the rest of the
	// destination, in logical pixels of the surface, is added to *_missing if that is given.
	void CopyBits(BRect source, BRect destination, BRegion* _missing = nullptr);

	// What was painted since the last call, in logical pixels of the surface; a few rectangles
	// that may cover somewhat more than the painted pixels.
	void TakeDamage(BRegion* _damage);
	bool HasDamage() const { return fDamageCount > 0; }

private:
	friend class PaintTask;

	static constexpr int32 kMaxDamage = 8;

	void _AddDamage(const clipping_rect& deviceRect);

	Surface& fSurface;
	const BRegion* fClip; // borrowed; NULL for all
	const DrawState* fState; // borrowed
	BPoint fOrigin;
	clipping_rect fDamage[kMaxDamage]; // logical pixels
	int32 fDamageCount;
};


} // namespace BPrivate
