// PaintTask: one drawing call being carried out: coordinates, ink, compositor and damage.
#pragma once

#include <algorithm>
#include <math.h>
#include <vector>

#include "server/paint/Compositor.h"
#include "server/paint/Painter.h"

namespace BPrivate {


// Coverage of a part of the surface, all 0 at first. Its memory is the thread's and used again;
// there is one at a time.
class CoverageMask {
public:
	// Device pixels.
	explicit CoverageMask(const clipping_rect& rect);

	const clipping_rect& Rect() const { return fRect; }
	int32 Width() const { return fRect.right - fRect.left + 1; }
	int32 Height() const { return fRect.bottom - fRect.top + 1; }
	uint8* Bits() { return fBits; }
	uint8* Row(int32 y) { return fBits + (size_t)(y - fRect.top) * Width() - fRect.left; }
	void Fill(const clipping_rect& rect);

private:
	clipping_rect fRect;
	uint8* fBits;
};


class PaintTask {
public:
	PaintTask(Painter& painter, const pattern& pattern);
	// In a mode and with colours of its own.
	PaintTask(Painter& painter, const pattern& pattern, const Ink& ink);

	static Ink InkOf(const Painter& painter);

	const DrawState& State() const { return fState; }
	drawing_mode Mode() const { return fInk.mode; }
	Compositor& Output() { return fOutput; }
	const Surface& Target() const { return fPainter.fSurface; }
	double Scale() const { return fPainter.fSurface.Scale(); }

	// From the call's coordinates to logical pixels of the surface.
	BPoint ToSurface(BPoint point) const;
	clipping_rect ToSurface(BRect rect) const;
	static int32 Round(float coordinate);

	// The pen in whole logical pixels, and how many of them lie before the coordinate: a pen of
	// 2 covers c and c + 1, one of 3 covers c - 1 to c + 1.
	int32 PenSize() const { return std::clamp(Round(fState.Transform(fState.penSize)), 1, 10000); }
	int32 PenBefore() const { return (PenSize() - 1) / 2; }
	int32 PenAfter() const { return PenSize() / 2; }

	void FillLogical(const clipping_rect& rect);
	// A straight line between two logical pixels, as device rectangles that do not overlap.
	template<typename Sink> void TraceLine(BPoint from, BPoint to, int32 penSize, Sink sink) const;
	void FillMask(CoverageMask& mask);
	void AddDamage(const clipping_rect& deviceRect) { fPainter._AddDamage(deviceRect); }

private:
	template<typename Sink>
	void _TraceSlanted(BPoint from, BPoint to, int32 penSize, bool steep, Sink sink) const;

	Painter& fPainter;
	const DrawState& fState;
	Ink fInk;
	Compositor fOutput;
};


// #pragma mark - inline


inline int32
PaintTask::Round(float coordinate)
{
	constexpr float kLimit = 1 << 26;
	if (!(coordinate > -kLimit))
		return coordinate <= -kLimit ? -(1 << 26) : 0;
	if (coordinate >= kLimit)
		return 1 << 26;
	// Cutting and correcting is quicker than a call of floorf().
	const float moved = coordinate + 0.5f;
	const int32 cut = (int32)moved;
	return cut > moved ? cut - 1 : cut;
}


template<typename Sink>
void
PaintTask::TraceLine(BPoint from, BPoint to, int32 penSize, Sink sink) const
{
	const BPoint start(Round(from.x), Round(from.y));
	const BPoint end(Round(to.x), Round(to.y));
	const int32 before = (penSize - 1) / 2;
	const int32 after = penSize / 2;
	const int32 left = std::min(start.x, end.x);
	const int32 right = std::max(start.x, end.x);
	const int32 top = std::min(start.y, end.y);
	const int32 bottom = std::max(start.y, end.y);
	if (top == bottom && left != right)
		sink(Target().ToDevice({ left, top - before, right, bottom + after }));
	else if (left == right && top != bottom)
		sink(Target().ToDevice({ left - before, top, right + after, bottom }));
	else if (left == right)
		sink(Target().ToDevice({ left - before, top - before, right + after, bottom + after }));
	else
		_TraceSlanted(start, end, penSize, bottom - top > right - left, sink);
}


// One step per device pixel of the longer direction; neighbours at the same height are joined.
// The pen's width is measured along the shorter direction.
template<typename Sink>
void
PaintTask::_TraceSlanted(BPoint from, BPoint to, int32 penSize, bool steep, Sink sink) const
{
	if (steep) {
		std::swap(from.x, from.y);
		std::swap(to.x, to.y);
	}
	if (from.x > to.x)
		std::swap(from, to);

	const clipping_rect& bounds = fOutput.Bounds();
	const double scale = Scale();
	const int32 thickness = std::max(1, (int32)floor(penSize * scale + 0.5));
	const int32 first =
		std::max(Target().DeviceEdge((int32)from.x), steep ? bounds.top : bounds.left);
	const int32 last =
		std::min(Target().DeviceEdge((int32)to.x + 1) - 1, steep ? bounds.bottom : bounds.right);
	const double slope = (to.y - from.y) / (double)(to.x - from.x);
	const double middle = ((double)from.x + 0.5) * scale;
	const double startY = ((double)from.y - (penSize - 1) / 2) * scale + 0.5;
	const double endY = startY + (to.y - from.y) * scale;

	// Heights with 32 binary places, so that a step is one addition.
	constexpr double kUnit = 4294967296.0;
	const int64 lowest = llround(std::min(startY, endY) * kUnit);
	const int64 highest = llround(std::max(startY, endY) * kUnit);
	const int64 step = llround(slope * kUnit);
	int64 height = llround((startY + (first + 0.5 - middle) * slope) * kUnit);
	auto heightAt = [&]() { return (int32)(std::clamp(height, lowest, highest) >> 32); };
	for (int32 x = first; x <= last;) {
		const int32 y = heightAt();
		const int32 start = x;
		do {
			x++;
			height += step;
		} while (x <= last && heightAt() == y);
		if (steep)
			sink(clipping_rect { y, start, y + thickness - 1, x - 1 });
		else
			sink(clipping_rect { start, y, x - 1, y + thickness - 1 });
	}
}


} // namespace BPrivate
