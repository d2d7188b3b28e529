#include "server/paint/Compositor.h"

#include <algorithm>
#include <string.h>

#include "server/paint/RowFill.h"

namespace BPrivate {

namespace {

// Pattern bits are unpacked into pieces of this many pixels.
constexpr int32 kPiece = 256;

// What a mode does to a piece of a row. Bits are one byte a pixel, 0 or 1.
struct RowFunctions {
	void (*fill)(uint32* row, int32 count, bool bit, const Ink& ink);
	void (*fillBits)(uint32* row, const uint8* bits, int32 count, const Ink& ink);
	void (*mask)(uint32* row, const uint8* coverage, int32 count, bool bit, const Ink& ink);
	void (*maskBits)(
		uint32* row, const uint8* coverage, const uint8* bits, int32 count, const Ink& ink);
	void (*pixels)(uint32* row, const uint32* source, int32 count, const Ink& ink);
};


// The modes whose result does not depend on what is there.
bool
IsConstant(drawing_mode mode)
{
	return mode == B_OP_COPY || mode == B_OP_OVER || mode == B_OP_ERASE;
}


template<drawing_mode kMode>
void
FillRow(uint32* row, int32 count, bool bit, const Ink& ink)
{
	for (int32 i = 0; i < count; i++)
		row[i] = BlendBit<kMode>(row[i], bit, ink);
}


template<drawing_mode kMode>
void
FillBits(uint32* row, const uint8* bits, int32 count, const Ink& ink)
{
	for (int32 i = 0; i < count; i++)
		row[i] = BlendBit<kMode>(row[i], bits[i] != 0, ink);
}


// Behind the uncovered pixel at `i` and those that follow it, as far as eight at a time tell.
inline int32
SkipUncovered(const uint8* coverage, int32 i, int32 count)
{
	i++;
	uint64 eight;
	while (i + 8 <= count && (memcpy(&eight, coverage + i, 8), eight) == 0)
		i += 8;
	return i;
}


template<drawing_mode kMode>
void
MaskRow(uint32* row, const uint8* coverage, int32 count, bool bit, const Ink& ink)
{
	if (!bit && LeavesClearBits(kMode))
		return;
	for (int32 i = 0; i < count;) {
		if (coverage[i] == 0) {
			i = SkipUncovered(coverage, i, count);
			continue;
		}
		row[i] = Cover(row[i], BlendBit<kMode>(row[i], bit, ink), coverage[i], ink);
		i++;
	}
}


template<drawing_mode kMode>
void
MaskBits(uint32* row, const uint8* coverage, const uint8* bits, int32 count, const Ink& ink)
{
	for (int32 i = 0; i < count; i++) {
		if (coverage[i] != 0)
			row[i] = Cover(row[i], BlendBit<kMode>(row[i], bits[i] != 0, ink), coverage[i], ink);
	}
}


template<drawing_mode kMode>
void
DrawPixelRow(uint32* row, const uint32* source, int32 count, const Ink& ink)
{
	if (kMode == B_OP_COPY) {
		memcpy(row, source, count * sizeof(uint32));
		return;
	}
	for (int32 i = 0; i < count; i++)
		row[i] = BlendBitmap<kMode>(row[i], source[i], ink);
}


template<drawing_mode kMode>
constexpr RowFunctions kFunctionsOf = { FillRow<kMode>, FillBits<kMode>, MaskRow<kMode>,
	MaskBits<kMode>, DrawPixelRow<kMode> };

constexpr RowFunctions kFunctions[] = { kFunctionsOf<B_OP_COPY>, kFunctionsOf<B_OP_OVER>,
	kFunctionsOf<B_OP_ERASE>, kFunctionsOf<B_OP_INVERT>, kFunctionsOf<B_OP_ADD>,
	kFunctionsOf<B_OP_SUBTRACT>, kFunctionsOf<B_OP_BLEND>, kFunctionsOf<B_OP_MIN>,
	kFunctionsOf<B_OP_MAX>, kFunctionsOf<B_OP_SELECT>, kFunctionsOf<B_OP_ALPHA> };


const RowFunctions&
FunctionsOf(const Ink& ink)
{
	return kFunctions[std::clamp<int32>(ink.mode, B_OP_COPY, B_OP_ALPHA)];
}

} // namespace


Compositor::Compositor(Surface& surface, const BRegion* clip, const Ink& ink,
	const pattern& pattern, int32 originX, int32 originY) :
	fSurface(surface),
	fClip(clip), fInk(ink), fPattern(pattern), fKind(PatternKind::kMixed), fOriginX(originX),
	fOriginY(originY), fBounds { 0, 0, surface.DeviceWidth() - 1, surface.DeviceHeight() - 1 },
	fClipCount(0)
{
	uint64 bits;
	memcpy(&bits, pattern.data, sizeof(bits));
	if (bits == ~(uint64)0)
		fKind = PatternKind::kHigh;
	else if (bits == 0)
		fKind = PatternKind::kLow;

	if (clip != nullptr) {
		fClipCount = clip->CountRects();
		fBounds = fClipCount > 0 ? Intersect(fBounds, surface.ToDevice(clip->FrameInt()))
								 : clipping_rect { 0, 0, -1, -1 };
	}
}


void
Compositor::FillRect(const clipping_rect& rect)
{
	ForEachPart(rect, [this](const clipping_rect& part) { _FillPart(part); });
}


void
Compositor::FillMask(const clipping_rect& rect, const uint8* coverage, int32 bytesPerRow)
{
	const RowFunctions& functions = FunctionsOf(fInk);
	ForEachPart(rect, [&](const clipping_rect& part) {
		const int32 count = part.right - part.left + 1;
		const uint8* from =
			coverage + (size_t)(part.top - rect.top) * bytesPerRow + (part.left - rect.left);
		for (int32 y = part.top; y <= part.bottom; y++, from += bytesPerRow) {
			uint32* row = fSurface.Row(y) + part.left;
			if (fKind != PatternKind::kMixed) {
				functions.mask(row, from, count, fKind == PatternKind::kHigh, fInk);
				continue;
			}
			uint8 bits[kPiece];
			for (int32 at = 0; at < count; at += kPiece) {
				const int32 piece = std::min(kPiece, count - at);
				_ReadPattern(part.left + at, y, piece, bits);
				functions.maskBits(row + at, from + at, bits, piece, fInk);
			}
		}
	});
}


void
Compositor::DrawPixels(const clipping_rect& rect, const uint32* pixels, int32 pixelsPerRow)
{
	const RowFunctions& functions = FunctionsOf(fInk);
	ForEachPart(rect, [&](const clipping_rect& part) {
		const uint32* from =
			pixels + (size_t)(part.top - rect.top) * pixelsPerRow + (part.left - rect.left);
		for (int32 y = part.top; y <= part.bottom; y++, from += pixelsPerRow) {
			functions.pixels(fSurface.Row(y) + part.left, from, part.right - part.left + 1, fInk);
		}
	});
}


// #pragma mark - private


// The index of the first rectangle of the clip that reaches down to the given line.
int32
Compositor::_FirstClipRect(int32 deviceTop) const
{
	const int32 top = fSurface.LogicalAt(deviceTop);
	int32 low = 0;
	int32 high = fClipCount;
	while (low < high) {
		const int32 middle = (low + high) / 2;
		if (fClip->RectAtInt(middle).bottom < top)
			low = middle + 1;
		else
			high = middle;
	}
	return low;
}


void
Compositor::_ReadPattern(int32 deviceX, int32 deviceY, int32 count, uint8* bits) const
{
	const uint8 row = fPattern.data[(fSurface.LogicalAt(deviceY) - fOriginY) & 7];
	if (fSurface.Scale() == 1) {
		for (int32 i = 0; i < count; i++)
			bits[i] = row >> (7 - ((deviceX + i - fOriginX) & 7)) & 1;
		return;
	}
	int32 x = fSurface.LogicalAt(deviceX);
	int32 next = fSurface.DeviceEdge(x + 1);
	for (int32 i = 0; i < count; i++) {
		while (deviceX + i >= next)
			next = fSurface.DeviceEdge(++x + 1);
		bits[i] = row >> (7 - ((x - fOriginX) & 7)) & 1;
	}
}


void
Compositor::_FillPart(const clipping_rect& part)
{
	const RowFunctions& functions = FunctionsOf(fInk);
	const int32 count = part.right - part.left + 1;
	if (fKind != PatternKind::kMixed) {
		const bool bit = fKind == PatternKind::kHigh;
		if (!bit && LeavesClearBits(fInk.mode))
			return;
		if (IsConstant(fInk.mode)) {
			const uint32 pixel = fInk.mode != B_OP_ERASE && bit ? fInk.high : fInk.low;
			const int32 stride = fSurface.BytesPerRow() / sizeof(uint32);
			FillRows(fSurface.Row(part.top) + part.left, stride, part.bottom - part.top + 1, count,
				pixel);
			return;
		}
		for (int32 y = part.top; y <= part.bottom; y++)
			functions.fill(fSurface.Row(y) + part.left, count, bit, fInk);
		return;
	}
	if (fInk.mode == B_OP_COPY && fSurface.Scale() == 1) {
		_CopyPattern(part);
		return;
	}
	for (int32 y = part.top; y <= part.bottom; y++) {
		uint8 bits[kPiece];
		for (int32 at = 0; at < count; at += kPiece) {
			const int32 piece = std::min(kPiece, count - at);
			_ReadPattern(part.left + at, y, piece, bits);
			functions.fillBits(fSurface.Row(y) + part.left + at, bits, piece, fInk);
		}
	}
}


// The same as by single pixels, eight at a time: the cell's rows are made once.
void
Compositor::_CopyPattern(const clipping_rect& part)
{
	uint32 cell[8][8];
	for (int32 y = 0; y < 8; y++) {
		for (int32 x = 0; x < 8; x++) {
			const bool bit = fPattern.data[y] >> (7 - ((x + part.left - fOriginX) & 7)) & 1;
			cell[y][x] = bit ? fInk.high : fInk.low;
		}
	}
	const int32 count = part.right - part.left + 1;
	for (int32 y = part.top; y <= part.bottom; y++) {
		uint32* row = fSurface.Row(y) + part.left;
		const uint32* from = cell[(y - fOriginY) & 7];
		int32 at = 0;
		for (; at + 8 <= count; at += 8)
			memcpy(row + at, from, 8 * sizeof(uint32));
		memcpy(row + at, from, (count - at) * sizeof(uint32));
	}
}


} // namespace BPrivate
