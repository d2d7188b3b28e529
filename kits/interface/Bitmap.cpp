#include <Bitmap.h>

#include <algorithm>
#include <math.h>
#include <stdlib.h>
#include <string.h>
#include <vector>

#include <Errors.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

#include "interface/private/BitmapAccess.h"
#include "interface/private/OffscreenWindow.h"
#include "interface/private/PixelFormat.h"

using namespace BPrivate;

namespace {

constexpr int32 kMaxSide = 32767;
constexpr size_t kMaxBytes = 1024 * 1024 * 1024;


// Flags of the constructors that take booleans.
uint32
FlagsOf(bool acceptsViews, bool needsContiguous)
{
	return (acceptsViews ? B_BITMAP_ACCEPTS_VIEWS : 0)
		| (needsContiguous ? B_BITMAP_IS_CONTIGUOUS : 0);
}


int32
PaddedRowBytes(color_space space, int32 width)
{
	return (RowBytes(space, width) + 3) & ~3;
}


// The creation flags that an archive holds, in either of its forms.
uint32
ArchivedFlags(const BMessage* data)
{
	int32 flags;
	if (data->FindInt32("_bmflags", &flags) == B_OK)
		return flags;
	bool acceptsViews = false;
	bool contiguous = false;
	data->FindBool("_view_ok", &acceptsViews);
	if (data->FindBool("_contiguous", &contiguous) != B_OK)
		data->FindBool("_continguous", &contiguous);
	return FlagsOf(acceptsViews, contiguous);
}

} // namespace


// #pragma mark - making


BBitmap::BBitmap(
	BRect bounds, uint32 flags, color_space colorSpace, int32 bytesPerRow, screen_id screenID)
{
	_Init(bounds, colorSpace, flags, bytesPerRow);
}


BBitmap::BBitmap(BRect bounds, color_space colorSpace, bool acceptsViews, bool needsContiguous)
{
	_Init(bounds, colorSpace, FlagsOf(acceptsViews, needsContiguous), B_ANY_BYTES_PER_ROW);
}


BBitmap::BBitmap(const BBitmap& source, uint32 flags) : BArchivable()
{
	_InitFrom(source, flags);
}


BBitmap::BBitmap(const BBitmap& source) : BArchivable()
{
	_InitFrom(source, source.fFlags & ~B_BITMAP_ACCEPTS_VIEWS);
}


BBitmap::BBitmap(const BBitmap* source, bool acceptsViews, bool needsContiguous)
{
	if (source != NULL && source->IsValid())
		_InitFrom(*source, FlagsOf(acceptsViews, needsContiguous));
	else
		_Init(BRect(), B_NO_COLOR_SPACE, 0, B_ANY_BYTES_PER_ROW);
}


BBitmap::BBitmap(BMessage* data) : BArchivable(data)
{
	BRect bounds;
	int32 space = B_NO_COLOR_SPACE;
	int32 bytesPerRow = B_ANY_BYTES_PER_ROW;
	const bool complete =
		data->FindRect("_frame", &bounds) == B_OK && data->FindInt32("_cspace", &space) == B_OK;
	if (data->FindInt32("_rowbytes", &bytesPerRow) != B_OK)
		bytesPerRow = B_ANY_BYTES_PER_ROW;
	const void* bits = NULL;
	ssize_t size = 0;
	const bool hasBits = data->FindData("_data", B_RAW_TYPE, &bits, &size) == B_OK;

	// A few bytes of archive must not take a gigabyte: without its pixels a bitmap stays small.
	constexpr float kMaxEmptySide = 2048;
	const float leastSize = bounds.Width() * bounds.Height() / 8;
	if ((!hasBits || size < leastSize)
		&& (bounds.Width() > kMaxEmptySide || bounds.Height() > kMaxEmptySide))
		bounds = BRect();
	_Init(complete ? bounds : BRect(), (color_space)space, ArchivedFlags(data), bytesPerRow);
	if (!IsValid())
		return;
	if (hasBits && size == BitsLength())
		memcpy(fBits, bits, size);
	BMessage view;
	for (int32 i = 0; fWindow != NULL && data->FindMessage("_views", i, &view) == B_OK; i++) {
		BArchivable* object = instantiate_object(&view);
		if (BView* child = dynamic_cast<BView*>(object))
			AddChild(child);
		else
			delete object;
	}
}


BBitmap::~BBitmap()
{
	_Clear();
}


BArchivable*
BBitmap::Instantiate(BMessage* data)
{
	return validate_instantiation(data, "BBitmap") ? new BBitmap(data) : NULL;
}


status_t
BBitmap::Archive(BMessage* data, bool deep) const
{
	status_t status = BArchivable::Archive(data, deep);
	if (status == B_OK)
		status = data->AddRect("_frame", fBounds);
	if (status == B_OK)
		status = data->AddInt32("_cspace", fColorSpace);
	if (status == B_OK)
		status = data->AddInt32("_bmflags", fFlags);
	if (status == B_OK)
		status = data->AddInt32("_rowbytes", fBytesPerRow);
	for (int32 i = 0; status == B_OK && deep && i < CountChildren(); i++) {
		BMessage view;
		status = ChildAt(i)->Archive(&view, true);
		if (status == B_OK)
			status = data->AddMessage("_views", &view);
	}
	// An R5 system reads pixels of the raw type for every colour space.
	if (status == B_OK && fBits != NULL)
		status = data->AddData("_data", B_RAW_TYPE, fBits, BitsLength());
	return status;
}


BBitmap&
BBitmap::operator=(const BBitmap& source)
{
	if (this != &source) {
		_Clear();
		_InitFrom(source, source.fFlags & ~B_BITMAP_ACCEPTS_VIEWS);
	}
	return *this;
}


// #pragma mark - pixels


status_t
BBitmap::LockBits(uint32* state)
{
	return fInitStatus;
}


void
BBitmap::UnlockBits()
{
}


int32
BBitmap::BitsLength() const
{
	return IsValid() ? fBytesPerRow * (fBounds.IntegerHeight() + 1) : 0;
}


void
BBitmap::SetBits(const void* data, int32 length, int32 offset, color_space colorSpace)
{
	ImportBits(data, length, B_ANY_BYTES_PER_ROW, offset, colorSpace);
}


// Rows of the source follow each other into rows of this bitmap, from the offset's pixel on.
status_t
BBitmap::ImportBits(
	const void* data, int32 length, int32 bytesPerRow, int32 offset, color_space colorSpace)
{
	if (!IsValid())
		return B_NO_INIT;
	if (data == NULL || length < 0 || offset < 0 || offset > BitsLength()
		|| RowBytes(colorSpace, 1) == 0)
		return B_BAD_VALUE;
	const int32 width = fBounds.IntegerWidth() + 1;
	if (bytesPerRow < 0)
		bytesPerRow = PaddedRowBytes(colorSpace, width);
	if (colorSpace == fColorSpace && bytesPerRow == fBytesPerRow) {
		memcpy(fBits + offset, data, std::min(length, BitsLength() - offset));
		_LoadSurface();
		return B_OK;
	}

	const int32 top = offset / fBytesPerRow;
	const int32 left = (int64)(offset % fBytesPerRow) * 8 * width
		/ std::max<int64>(1, RowBytes(fColorSpace, width) * 8);
	if (left >= width)
		return B_BAD_VALUE;
	const int32 rows = bytesPerRow > 0 ? (length + bytesPerRow - 1) / bytesPerRow : 0;
	return _Import(static_cast<const uint8*>(data), length, bytesPerRow, colorSpace, 0, 0, left,
		top, width - left, rows);
}


status_t
BBitmap::ImportBits(const void* data, int32 length, int32 bytesPerRow, color_space colorSpace,
	BPoint from, BPoint to, BPoint size)
{
	if (!IsValid())
		return B_NO_INIT;
	if (data == NULL || length < 0 || RowBytes(colorSpace, 1) == 0 || !(size.x >= 0)
		|| !(size.y >= 0))
		return B_BAD_VALUE;
	const BRect limits(-kMaxSide, -kMaxSide, kMaxSide, kMaxSide);
	from.ConstrainTo(limits);
	to.ConstrainTo(limits);
	size.ConstrainTo(limits);
	if (bytesPerRow < 0)
		bytesPerRow = PaddedRowBytes(colorSpace, (int32)size.x + 1);
	return _Import(static_cast<const uint8*>(data), length, bytesPerRow, colorSpace, (int32)from.x,
		(int32)from.y, (int32)to.x, (int32)to.y, (int32)size.x + 1, (int32)size.y + 1);
}


status_t
BBitmap::ImportBits(const BBitmap* bitmap)
{
	if (bitmap == NULL || !bitmap->IsValid())
		return B_BAD_VALUE;
	return ImportBits(
		bitmap, B_ORIGIN, B_ORIGIN, BPoint(bitmap->fBounds.Width(), bitmap->fBounds.Height()));
}


status_t
BBitmap::ImportBits(const BBitmap* bitmap, BPoint from, BPoint to, BPoint size)
{
	if (bitmap == NULL || !bitmap->IsValid())
		return B_BAD_VALUE;
	return ImportBits(bitmap->fBits, bitmap->BitsLength(), bitmap->fBytesPerRow,
		bitmap->fColorSpace, from, to, size);
}


// #pragma mark - private


void
BBitmap::_Init(BRect bounds, color_space space, uint32 flags, int32 bytesPerRow)
{
	fBits = NULL;
	fWindow = NULL;
	fBounds = BRect();
	fColorSpace = B_NO_COLOR_SPACE;
	fFlags = 0;
	fBytesPerRow = 0;
	fInitStatus = B_BAD_VALUE;
	bounds.OffsetTo(B_ORIGIN);
	if (!bounds.IsValid() || !(bounds.right < kMaxSide) || !(bounds.bottom < kMaxSide))
		return;
	const int32 width = bounds.IntegerWidth() + 1;
	const int32 height = bounds.IntegerHeight() + 1;
	const size_t leastBytes = RowBytes(space, width);
	if (leastBytes == 0)
		return;
	if (bytesPerRow < 0)
		bytesPerRow = PaddedRowBytes(space, width);
	if ((size_t)bytesPerRow < leastBytes || (size_t)bytesPerRow * height > kMaxBytes)
		return;

	fBits = static_cast<uint8*>(calloc(height, bytesPerRow));
	if (fBits == NULL) {
		fInitStatus = B_NO_MEMORY;
		return;
	}
	const bool white = (flags & (B_BITMAP_CLEAR_TO_WHITE | B_BITMAP_ACCEPTS_VIEWS)) != 0;
	if (white && space != B_GRAY1) // where 0 is white
		memset(fBits, space == B_CMAP8 ? _WhiteIndex() : 0xff, (size_t)bytesPerRow * height);
	fBounds.Set(0, 0, bounds.IntegerWidth(), bounds.IntegerHeight());
	fColorSpace = space;
	fFlags = flags;
	fBytesPerRow = bytesPerRow;
	fInitStatus = B_OK;
	if ((flags & B_BITMAP_ACCEPTS_VIEWS) != 0)
		_MakeWindow();
}


void
BBitmap::_InitFrom(const BBitmap& source, uint32 flags)
{
	_Init(source.fBounds, source.fColorSpace, flags,
		source.IsValid() ? source.fBytesPerRow : B_ANY_BYTES_PER_ROW);
	if (!IsValid())
		return;
	memcpy(fBits, source.fBits, BitsLength());
	_LoadSurface();
}


void
BBitmap::_MakeWindow()
{
	fSurface = std::make_unique<Surface>();
	const int32 width = fBounds.IntegerWidth() + 1;
	const int32 height = fBounds.IntegerHeight() + 1;
	const SurfaceFormat format =
		fColorSpace == B_RGB32 ? SurfaceFormat::kOpaque : SurfaceFormat::kAlpha;
	const bool native = IsNativeSpace(fColorSpace) && fBytesPerRow % 4 == 0;
	const status_t status = native ? fSurface->Wrap(fBits, width, height, fBytesPerRow, format)
								   : fSurface->SetTo(width, height, 1, format);
	if (status != B_OK) {
		fSurface.reset();
		return;
	}
	_LoadSurface();
	fWindow = NewOffscreenWindow(this, fSurface.get());
}


// Pixels of another kind than the surface's own are brought there and back.
void
BBitmap::_LoadSurface()
{
	if (fSurface == nullptr || reinterpret_cast<uint8*>(fSurface->Row(0)) == fBits)
		return;
	for (int32 y = 0; y < fSurface->Height(); y++) {
		ReadPixels(
			fColorSpace, fBits + (size_t)y * fBytesPerRow, 0, fSurface->Width(), fSurface->Row(y));
	}
}


void
BBitmap::_StoreSurface()
{
	if (fSurface == nullptr || reinterpret_cast<uint8*>(fSurface->Row(0)) == fBits)
		return;
	for (int32 y = 0; y < fSurface->Height(); y++) {
		WritePixels(
			fColorSpace, fBits + (size_t)y * fBytesPerRow, 0, fSurface->Width(), fSurface->Row(y));
	}
}


// Copies what lies inside both the data and this bitmap.
status_t
BBitmap::_Import(const uint8* data, int32 length, int32 bytesPerRow, color_space space, int32 fromX,
	int32 fromY, int32 toX, int32 toY, int32 width, int32 height)
{
	const int32 before = std::max({ 0, -fromX, -toX });
	const int32 above = std::max({ 0, -fromY, -toY });
	fromX += before;
	toX += before;
	fromY += above;
	toY += above;
	width = std::min(width - before, fBounds.IntegerWidth() + 1 - toX);
	height = std::min(height - above, fBounds.IntegerHeight() + 1 - toY);

	const int64 bitsPerPixel = RowBytes(space, 8);
	std::vector<uint32> pixels(std::max(width, 0));
	for (int32 y = 0; y < height; y++) {
		const int64 start = (int64)(fromY + y) * bytesPerRow;
		const int64 bytes = std::min<int64>(bytesPerRow, length - start);
		const int32 count = std::min<int64>(width, bytes * 8 / bitsPerPixel - fromX);
		if (count <= 0)
			break;
		ReadPixels(space, data + start, fromX, count, pixels.data());
		WritePixels(
			fColorSpace, fBits + (size_t)(toY + y) * fBytesPerRow, toX, count, pixels.data());
	}
	_LoadSurface();
	return B_OK;
}


uint8
BBitmap::_WhiteIndex()
{
	const uint32 white = 0xffffffff;
	uint8 index;
	WritePixels(B_CMAP8, &index, 0, 1, &white);
	return index;
}


void
BBitmap::_Clear()
{
	if (fWindow != NULL && fWindow->Lock())
		fWindow->Quit();
	fWindow = NULL;
	fSurface.reset();
	free(fBits);
	fBits = NULL;
	fInitStatus = B_NO_INIT;
}


// #pragma mark - BitmapAccess


std::shared_ptr<const Surface>
BitmapAccess::Pixels(const BBitmap& bitmap)
{
	if (!bitmap.IsValid())
		return nullptr;
	if (!IsNativeSpace(bitmap.fColorSpace) || bitmap.fBytesPerRow % 4 != 0)
		return CopyOf(bitmap);
	auto surface = std::make_shared<Surface>();
	surface->Wrap(bitmap.fBits, bitmap.fBounds.IntegerWidth() + 1,
		bitmap.fBounds.IntegerHeight() + 1, bitmap.fBytesPerRow,
		bitmap.fColorSpace == B_RGB32 ? SurfaceFormat::kOpaque : SurfaceFormat::kAlpha);
	return surface;
}


std::shared_ptr<Surface>
BitmapAccess::CopyOf(const BBitmap& bitmap)
{
	auto surface = std::make_shared<Surface>();
	const SurfaceFormat format =
		bitmap.fColorSpace == B_RGB32 ? SurfaceFormat::kOpaque : SurfaceFormat::kAlpha;
	if (!bitmap.IsValid()
		|| surface->SetTo(
			   bitmap.fBounds.IntegerWidth() + 1, bitmap.fBounds.IntegerHeight() + 1, 1, format)
			!= B_OK)
		return nullptr;
	for (int32 y = 0; y < surface->Height(); y++) {
		ReadPixels(bitmap.fColorSpace, bitmap.fBits + (size_t)y * bitmap.fBytesPerRow, 0,
			surface->Width(), surface->Row(y));
	}
	return surface;
}


Surface*
BitmapAccess::DrawingSurface(BBitmap& bitmap)
{
	return bitmap.fSurface.get();
}


void
BitmapAccess::Finish(BBitmap& bitmap)
{
	bitmap._StoreSurface();
}
