#include "server/paint/Surface.h"

#include <algorithm>
#include <math.h>
#include <stdlib.h>
#include <string.h>

#include <Errors.h>

namespace BPrivate {

namespace {

constexpr int32 kMaxSide = 32767;


clipping_rect
Common(const clipping_rect& a, const clipping_rect& b)
{
	return { std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
		std::min(a.bottom, b.bottom) };
}

} // namespace


Surface::Surface() :
	fBits(nullptr), fWidth(0), fHeight(0), fDeviceWidth(0), fDeviceHeight(0), fBytesPerRow(0),
	fScale(1), fFormat(SurfaceFormat::kAlpha)
{
}


Surface::~Surface() = default;


status_t
Surface::SetTo(int32 width, int32 height, float scale, SurfaceFormat format)
{
	if (width < 1 || height < 1 || width > kMaxSide || height > kMaxSide || !(scale > 0)
		|| scale > 16)
		return B_BAD_VALUE;
	const int32 deviceWidth = DeviceEdge(width, scale);
	const int32 deviceHeight = DeviceEdge(height, scale);
	if (deviceWidth < 1 || deviceHeight < 1 || deviceWidth > kMaxSide || deviceHeight > kMaxSide)
		return B_BAD_VALUE;

	uint8* bits = static_cast<uint8*>(calloc(deviceHeight, (size_t)deviceWidth * 4));
	if (bits == nullptr)
		return B_NO_MEMORY;
	fOwned.reset(bits);
	fBits = bits;
	fWidth = width;
	fHeight = height;
	fDeviceWidth = deviceWidth;
	fDeviceHeight = deviceHeight;
	fBytesPerRow = deviceWidth * 4;
	fScale = scale;
	fFormat = format;
	return B_OK;
}


status_t
Surface::Wrap(void* bits, int32 width, int32 height, int32 bytesPerRow, SurfaceFormat format)
{
	if (bits == nullptr || width < 1 || height < 1 || width > kMaxSide || height > kMaxSide
		|| bytesPerRow < width * 4)
		return B_BAD_VALUE;
	fOwned.reset();
	fBits = static_cast<uint8*>(bits);
	fWidth = fDeviceWidth = width;
	fHeight = fDeviceHeight = height;
	fBytesPerRow = bytesPerRow;
	fScale = 1;
	fFormat = format;
	return B_OK;
}


status_t
Surface::Resize(int32 width, int32 height, float scale)
{
	if (width == fWidth && height == fHeight && scale == fScale && fBits != nullptr)
		return B_OK;

	Surface resized;
	const status_t status = resized.SetTo(width, height, scale, fFormat);
	if (status != B_OK)
		return status;
	if (fBits != nullptr && scale == fScale) {
		const size_t bytes = (size_t)std::min(fDeviceWidth, resized.fDeviceWidth) * 4;
		const int32 rows = std::min(fDeviceHeight, resized.fDeviceHeight);
		for (int32 y = 0; y < rows; y++)
			memcpy(resized.Row(y), Row(y), bytes);
	}
	fOwned = std::move(resized.fOwned);
	fBits = resized.fBits;
	fWidth = width;
	fHeight = height;
	fDeviceWidth = resized.fDeviceWidth;
	fDeviceHeight = resized.fDeviceHeight;
	fBytesPerRow = resized.fBytesPerRow;
	fScale = scale;
	return B_OK;
}


void
Surface::Unset()
{
	fOwned.reset();
	fBits = nullptr;
	fWidth = fHeight = fDeviceWidth = fDeviceHeight = fBytesPerRow = 0;
}


int32
Surface::DeviceEdge(int32 logical, float scale)
{
	if (scale == 1)
		return logical;
	return (int32)floor((double)logical * scale + 0.5);
}


int32
Surface::LogicalAt(int32 device, float scale)
{
	if (scale == 1)
		return device;
	int32 logical = (int32)floor((device + 0.5) / scale);
	while (DeviceEdge(logical, scale) > device)
		logical--;
	while (DeviceEdge(logical + 1, scale) <= device)
		logical++;
	return logical;
}


clipping_rect
Surface::ToDevice(const clipping_rect& logical, float scale)
{
	if (scale == 1)
		return logical;
	return { DeviceEdge(logical.left, scale), DeviceEdge(logical.top, scale),
		DeviceEdge(logical.right + 1, scale) - 1, DeviceEdge(logical.bottom + 1, scale) - 1 };
}


void
Surface::CopyFrom(const Surface& source, const BRegion& region)
{
	if (fScale != source.fScale)
		return;
	const clipping_rect shared = { 0, 0, std::min(fDeviceWidth, source.fDeviceWidth) - 1,
		std::min(fDeviceHeight, source.fDeviceHeight) - 1 };
	for (int32 i = 0; i < region.CountRects(); i++) {
		const clipping_rect rect = Common(shared, ToDevice(region.RectAtInt(i)));
		if (rect.left > rect.right)
			continue;
		const size_t bytes = (size_t)(rect.right - rect.left + 1) * 4;
		for (int32 y = rect.top; y <= rect.bottom; y++)
			memcpy(Row(y) + rect.left, source.Row(y) + rect.left, bytes);
	}
}


rgb_color
Surface::PixelAt(int32 x, int32 y) const
{
	if (x < 0 || y < 0 || x >= fWidth || y >= fHeight)
		return { 0, 0, 0, 0 };
	const int32 deviceX = std::min(DeviceEdge(x), fDeviceWidth - 1);
	const int32 deviceY = std::min(DeviceEdge(y), fDeviceHeight - 1);
	rgb_color color = ToColor(Row(deviceY)[deviceX]);
	if (fFormat == SurfaceFormat::kOpaque)
		color.alpha = 255;
	return color;
}


void
Surface::Free::operator()(uint8* bits) const
{
	free(bits);
}


} // namespace BPrivate
