#include <algorithm>
#include <math.h>
#include <string.h>
#include <vector>

#include "server/paint/PaintTask.h"
#include "server/paint/Painter.h"

namespace BPrivate {

namespace {

constexpr uint32 kTransparentOpaque = 0x00777477; // B_TRANSPARENT_MAGIC_RGBA32


// Which pixel of a bitmap's row or column belongs to each device pixel of an interval; -1 for
// those that get none.
class SourceMap {
public:
	// size: of the bitmap. source: first pixel and number of pixels that are drawn.
	SourceMap(int32 size, int32 source, int32 sourceCount) :
		fSize(size), fSource(source), fSourceCount(sourceCount)
	{
	}

	// The device pixels from first to last show the source stretched over start to end.
	void Stretch(int32 first, int32 last, int32 start, int32 end)
	{
		const int32 count = end - start + 1;
		for (int32 at = first; at <= last; at++)
			_Add(((int64)(at - start) * 2 + 1) * fSourceCount / (2 * (int64)count));
	}

	// The same in logical pixels, repeated or once.
	void Tile(const Surface& target, int32 first, int32 last, int32 start, int32 end, bool repeat)
	{
		const int32 period = end - start + 1;
		for (int32 at = first; at <= last; at++) {
			int32 place = target.LogicalAt(at) - start;
			if (repeat)
				place = (place % period + period) % period;
			if (place < 0 || place >= period)
				fMap.push_back(-1);
			else
				_Add(((int64)place * 2 + 1) * fSourceCount / (2 * (int64)period));
		}
	}

	int32 operator[](int32 index) const { return fMap[index]; }
	int32 Count() const { return fMap.size(); }

	bool IsConsecutive() const
	{
		for (size_t i = 0; i < fMap.size(); i++) {
			if (fMap[i] != fMap[0] + (int32)i)
				return false;
		}
		return !fMap.empty() && fMap[0] >= 0;
	}

private:
	void _Add(int64 offset)
	{
		const int64 pixel = fSource + offset;
		fMap.push_back(pixel >= 0 && pixel < fSize ? (int32)pixel : -1);
	}

	int32 fSize;
	int32 fSource;
	int32 fSourceCount;
	std::vector<int32> fMap;
};


// Draws runs of device pixels whose source is known, row by row.
class BitmapTask {
public:
	BitmapTask(PaintTask& task, const Surface& bitmap) : fTask(task), fBitmap(bitmap) {}

	void Draw(const clipping_rect& device, const SourceMap& columns, const SourceMap& rows);
	void DrawSmooth(
		const clipping_rect& visible, const clipping_rect& whole, const clipping_rect& source);

private:
	uint32 _Pixel(uint32 pixel) const;
	void _DrawRow(const clipping_rect& row, const SourceMap& columns, const uint32* source);

	PaintTask& fTask;
	const Surface& fBitmap;
	std::vector<uint32> fRow;
};


// Gives pixels without alpha the alpha that they stand for.
uint32
BitmapTask::_Pixel(uint32 pixel) const
{
	if (fBitmap.Format() == SurfaceFormat::kAlpha)
		return pixel;
	if (pixel == kTransparentOpaque && fTask.Mode() != B_OP_COPY)
		return 0;
	return pixel | 0xff000000;
}


void
BitmapTask::Draw(const clipping_rect& device, const SourceMap& columns, const SourceMap& rows)
{
	const bool direct = fBitmap.Format() == SurfaceFormat::kAlpha && columns.IsConsecutive();
	if (direct && rows.IsConsecutive()) {
		fTask.Output().DrawPixels(
			device, fBitmap.Row(rows[0]) + columns[0], fBitmap.BytesPerRow() / 4);
		fTask.AddDamage(device);
		return;
	}
	for (int32 y = device.top; y <= device.bottom; y++) {
		const int32 sourceY = rows[y - device.top];
		if (sourceY < 0)
			continue;
		const clipping_rect row = { device.left, y, device.right, y };
		if (direct)
			fTask.Output().DrawPixels(row, fBitmap.Row(sourceY) + columns[0], 0);
		else
			_DrawRow(row, columns, fBitmap.Row(sourceY));
	}
	fTask.AddDamage(device);
}


void
BitmapTask::_DrawRow(const clipping_rect& row, const SourceMap& columns, const uint32* source)
{
	fRow.resize(columns.Count());
	for (int32 i = 0; i < columns.Count();) {
		const int32 start = i;
		for (; i < columns.Count() && columns[i] >= 0; i++)
			fRow[i] = _Pixel(source[columns[i]]);
		if (i > start) {
			fTask.Output().DrawPixels(
				{ row.left + start, row.top, row.left + i - 1, row.top }, &fRow[start], 0);
		}
		while (i < columns.Count() && columns[i] < 0)
			i++;
	}
}


// Each device pixel is a mixture of the four source pixels round its centre.
void
BitmapTask::DrawSmooth(
	const clipping_rect& visible, const clipping_rect& whole, const clipping_rect& source)
{
	const double stepX = (double)(source.right - source.left + 1) / (whole.right - whole.left + 1);
	const double stepY = (double)(source.bottom - source.top + 1) / (whole.bottom - whole.top + 1);
	auto limitX = [&](int32 x) {
		return std::clamp(x, std::max(source.left, 0), std::min(source.right, fBitmap.Width() - 1));
	};
	auto limitY = [&](int32 y) {
		return std::clamp(
			y, std::max(source.top, 0), std::min(source.bottom, fBitmap.Height() - 1));
	};
	fRow.resize(visible.right - visible.left + 1);
	for (int32 y = visible.top; y <= visible.bottom; y++) {
		const double placeY = source.top + (y - whole.top + 0.5) * stepY - 0.5;
		const int32 y0 = (int32)floor(placeY);
		const int32 shareY = (int32)((placeY - y0) * 255);
		const uint32* above = fBitmap.Row(limitY(y0));
		const uint32* below = fBitmap.Row(limitY(y0 + 1));
		for (int32 x = visible.left; x <= visible.right; x++) {
			const double placeX = source.left + (x - whole.left + 0.5) * stepX - 0.5;
			const int32 x0 = (int32)floor(placeX);
			const int32 shareX = (int32)((placeX - x0) * 255);
			const int32 left = limitX(x0);
			const int32 right = limitX(x0 + 1);
			auto mix = [](uint32 a, uint32 b, int32 share) {
				const int32 alpha =
					(int32)Alpha(a) + ((int32)Alpha(b) - (int32)Alpha(a)) * share / 255;
				return WithAlpha(MixComponents(a, b, share), alpha);
			};
			fRow[x - visible.left] = mix(mix(_Pixel(above[left]), _Pixel(above[right]), shareX),
				mix(_Pixel(below[left]), _Pixel(below[right]), shareX), shareY);
		}
		fTask.Output().DrawPixels({ visible.left, y, visible.right, y }, fRow.data(), 0);
	}
	fTask.AddDamage(visible);
}


clipping_rect
ToPixels(BRect rect)
{
	return { PaintTask::Round(rect.left), PaintTask::Round(rect.top), PaintTask::Round(rect.right),
		PaintTask::Round(rect.bottom) };
}

} // namespace


void
Painter::DrawBitmap(const Surface& bitmap, BRect source, BRect destination, uint32 options)
{
	const clipping_rect from = ToPixels(source);
	PaintTask task(*this, B_SOLID_HIGH);
	const clipping_rect device = fSurface.ToDevice(task.ToSurface(destination));
	if (!bitmap.IsValid() || !IsValid(from) || !IsValid(device))
		return;
	const clipping_rect visible = Intersect(device, task.Output().Bounds());
	if (!IsValid(visible))
		return;

	const int32 width = from.right - from.left + 1;
	const int32 height = from.bottom - from.top + 1;
	const bool stretched =
		device.right - device.left + 1 != width || device.bottom - device.top + 1 != height;
	const bool inside = from.left < bitmap.Width() && from.top < bitmap.Height() && from.right >= 0
		&& from.bottom >= 0;
	if ((options & B_FILTER_BITMAP_BILINEAR) != 0 && stretched && inside) {
		BitmapTask(task, bitmap).DrawSmooth(visible, device, from);
		return;
	}
	SourceMap columns(bitmap.Width(), from.left, width);
	columns.Stretch(visible.left, visible.right, device.left, device.right);
	SourceMap rows(bitmap.Height(), from.top, height);
	rows.Stretch(visible.top, visible.bottom, device.top, device.bottom);
	BitmapTask(task, bitmap).Draw(visible, columns, rows);
}


void
Painter::DrawTiled(const Surface& bitmap, BRect source, BRect destination, BRect area,
	uint32 tiling, uint32 options)
{
	Ink ink = PaintTask::InkOf(*this);
	ink.mode = B_OP_COPY;
	PaintTask task(*this, B_SOLID_HIGH, ink);
	const clipping_rect from = ToPixels(source);
	const clipping_rect tile = task.ToSurface(destination);
	const clipping_rect visible =
		Intersect(fSurface.ToDevice(task.ToSurface(area)), task.Output().Bounds());
	if (!bitmap.IsValid() || !IsValid(from) || !IsValid(tile) || !IsValid(visible))
		return;
	SourceMap columns(bitmap.Width(), from.left, from.right - from.left + 1);
	columns.Tile(fSurface, visible.left, visible.right, tile.left, tile.right,
		(tiling & B_TILE_BITMAP_X) != 0);
	SourceMap rows(bitmap.Height(), from.top, from.bottom - from.top + 1);
	rows.Tile(fSurface, visible.top, visible.bottom, tile.top, tile.bottom,
		(tiling & B_TILE_BITMAP_Y) != 0);
	BitmapTask(task, bitmap).Draw(visible, columns, rows);
}


// #pragma mark - moving pixels


namespace {

bool
IsWhole(double number)
{
	return number == floor(number);
}


// Moves the rectangles in an order in which none is overwritten before it was moved.
void
MoveRects(Surface& surface, const BRegion& region, int32 dx, int32 dy)
{
	const int32 deviceX = surface.DeviceEdge(dx);
	const int32 deviceY = surface.DeviceEdge(dy);
	std::vector<clipping_rect> rects;
	for (int32 i = 0; i < region.CountRects(); i++)
		rects.push_back(surface.ToDevice(region.RectAtInt(i)));
	std::sort(rects.begin(), rects.end(), [dx, dy](const clipping_rect& a, const clipping_rect& b) {
		if (a.top != b.top)
			return dy > 0 ? a.top > b.top : a.top < b.top;
		return dx > 0 ? a.left > b.left : a.left < b.left;
	});
	for (const clipping_rect& to : rects) {
		const size_t bytes = (size_t)(to.right - to.left + 1) * sizeof(uint32);
		const int32 height = to.bottom - to.top + 1;
		for (int32 i = 0; i < height; i++) {
			const int32 y = dy > 0 ? to.bottom - i : to.top + i;
			memmove(surface.Row(y) + to.left, surface.Row(y - deviceY) + to.left - deviceX, bytes);
		}
	}
}

} // namespace


void
Painter::CopyBits(BRect source, BRect destination, BRegion* _missing)
{
	PaintTask task(*this, B_SOLID_HIGH);
	const clipping_rect from = task.ToSurface(source);
	const clipping_rect to = task.ToSurface(destination);
	if (!IsValid(from) || !IsValid(to))
		return;
	const int32 dx = to.left - from.left;
	const int32 dy = to.top - from.top;

	BRegion clip;
	clip.Set(fSurface.LogicalBounds());
	if (fClip != nullptr)
		clip.IntersectWith(fClip);
	BRegion target;
	target.Set(to);
	target.IntersectWith(&clip);
	BRegion moved;
	moved.Set(from);
	moved.IntersectWith(&clip);
	moved.OffsetBy(dx, dy);
	moved.IntersectWith(&target);
	// Where the way is no whole number of device pixels, moved pixels would not be those that
	// painting puts there: all of it is painted anew.
	if (!IsWhole(dx * task.Scale()) || !IsWhole(dy * task.Scale()))
		moved.MakeEmpty();

	if (dx != 0 || dy != 0) {
		MoveRects(fSurface, moved, dx, dy);
		for (int32 i = 0; i < moved.CountRects(); i++)
			_AddDamage(fSurface.ToDevice(moved.RectAtInt(i)));
	}
	if (_missing != nullptr) {
		*_missing = target;
		_missing->Exclude(&moved);
	}
}


} // namespace BPrivate
