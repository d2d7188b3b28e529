#include "server/paint/PaintTask.h"

#include <string.h>

namespace BPrivate {

namespace {

const DrawState kDefaultState;


uint8*
TakeMaskMemory(size_t bytes)
{
	static thread_local std::vector<uint8> sMemory;

	if (sMemory.size() < bytes)
		sMemory.resize(bytes);
	memset(sMemory.data(), 0, bytes);
	return sMemory.data();
}

} // namespace


CoverageMask::CoverageMask(const clipping_rect& rect) : fRect(rect), fBits(nullptr)
{
	if (IsValid(rect))
		fBits = TakeMaskMemory((size_t)Width() * Height());
}


void
CoverageMask::Fill(const clipping_rect& rect)
{
	const clipping_rect inside = Intersect(rect, fRect);
	if (!IsValid(inside))
		return;
	for (int32 y = inside.top; y <= inside.bottom; y++)
		memset(Row(y) + inside.left, 255, inside.right - inside.left + 1);
}


// #pragma mark - PaintTask


PaintTask::PaintTask(Painter& painter, const pattern& pattern) :
	PaintTask(painter, pattern, InkOf(painter))
{
}


PaintTask::PaintTask(Painter& painter, const pattern& pattern, const Ink& ink) :
	fPainter(painter), fState(painter.fState != nullptr ? *painter.fState : kDefaultState),
	fInk(ink), fOutput(painter.fSurface, painter.fClip, fInk, pattern, Round(painter.fOrigin.x),
				   Round(painter.fOrigin.y))
{
}


Ink
PaintTask::InkOf(const Painter& painter)
{
	const DrawState& state = painter.fState != nullptr ? *painter.fState : kDefaultState;
	Ink ink;
	ink.mode = state.mode;
	ink.alphaFunction = state.alphaFunction;
	ink.low = ToPixel(state.lowColor);
	ink.constantAlpha = state.sourceAlpha == B_CONSTANT_ALPHA ? 0 : -1;
	ink.SetHigh(state.highColor);
	ink.keepsAlpha = painter.fSurface.Format() == SurfaceFormat::kAlpha;
	return ink;
}


BPoint
PaintTask::ToSurface(BPoint point) const
{
	return fState.Transform(point) + fPainter.fOrigin;
}


clipping_rect
PaintTask::ToSurface(BRect rect) const
{
	const BPoint leftTop = ToSurface(rect.LeftTop());
	const BPoint rightBottom = ToSurface(rect.RightBottom());
	return { Round(leftTop.x), Round(leftTop.y), Round(rightBottom.x), Round(rightBottom.y) };
}


void
PaintTask::FillLogical(const clipping_rect& rect)
{
	if (!IsValid(rect))
		return;
	const clipping_rect device = Target().ToDevice(rect);
	fOutput.FillRect(device);
	AddDamage(Intersect(device, fOutput.Bounds()));
}


void
PaintTask::FillMask(CoverageMask& mask)
{
	if (!IsValid(mask.Rect()))
		return;
	fOutput.FillMask(mask.Rect(), mask.Bits(), mask.Width());
	AddDamage(mask.Rect());
}


} // namespace BPrivate
