#include "backend/ScreenPainter.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "server/FrontImage.h"
#include "server/paint/Surface.h"

namespace BPrivate {

namespace {

constexpr uint32 kDesktopColor = 0xff336698;
constexpr uint32 kEmptyColor = 0xffd8d8d8; // of a window that has painted nothing yet
constexpr float kMinScale = 0.5f, kMaxScale = 4;


uint8
Blend(uint8 under, uint8 over, uint32 alpha)
{
	return static_cast<uint8>((under * (255 - alpha) + over * alpha + 127) / 255);
}

} // namespace


ScreenPainter::ScreenPainter(BRect screen, float scale) : fScale(scale)
{
	fLeft = Surface::DeviceEdge(static_cast<int32>(screen.left), scale);
	fTop = Surface::DeviceEdge(static_cast<int32>(screen.top), scale);
	const int32 right = Surface::DeviceEdge(static_cast<int32>(screen.right) + 1, scale);
	const int32 bottom = Surface::DeviceEdge(static_cast<int32>(screen.bottom) + 1, scale);
	fPicture.width = std::max(1, right - fLeft);
	fPicture.height = std::max(1, bottom - fTop);
	fPicture.bits.resize(size_t(fPicture.width) * fPicture.height * 4);

	auto* pixels = reinterpret_cast<uint32*>(fPicture.bits.data());
	std::fill_n(pixels, size_t(fPicture.width) * fPicture.height, kDesktopColor);
}


ScreenPainter::Place
ScreenPainter::_PlaceOf(BPoint screen) const
{
	return { Surface::DeviceEdge(static_cast<int32>(screen.x), fScale) - fLeft,
		Surface::DeviceEdge(static_cast<int32>(screen.y), fScale) - fTop };
}


void
ScreenPainter::DrawWindow(BRect frame, FrontImage& image)
{
	const Place place = _PlaceOf(frame.LeftTop());
	const Place end = _PlaceOf(BPoint(frame.right + 1, frame.bottom + 1));
	FrontImage::Guard guard(image);
	const Surface* surface = guard.Pixels();
	auto* pixels = reinterpret_cast<uint32*>(fPicture.bits.data());

	const int32 left = std::max(0, place.x), right = std::min(fPicture.width, end.x);
	for (int32 y = std::max(0, place.y); y < std::min(fPicture.height, end.y); y++) {
		uint32* row = pixels + size_t(y) * fPicture.width;
		int32 x = left;
		if (surface != nullptr && y - place.y < surface->DeviceHeight()) {
			const uint32* from = surface->Row(y - place.y);
			const int32 covered = std::min(right, place.x + surface->DeviceWidth());
			for (; x < covered; x++)
				row[x] = from[x - place.x] | 0xff000000;
		}
		for (; x < right; x++)
			row[x] = kEmptyColor;
	}
}


void
ScreenPainter::DrawPicture(BPoint leftTop, const ScreenPicture& picture)
{
	const Place place = _PlaceOf(leftTop);
	for (int32 y = std::max(0, -place.y); y < picture.height; y++) {
		if (place.y + y >= fPicture.height)
			break;
		for (int32 x = std::max(0, -place.x); x < picture.width; x++) {
			if (place.x + x >= fPicture.width)
				break;
			const uint8* over = &picture.bits[(size_t(y) * picture.width + x) * 4];
			uint8* under = &fPicture.bits[(size_t(place.y + y) * fPicture.width + place.x + x) * 4];
			for (int32 channel = 0; channel < 3; channel++)
				under[channel] = Blend(under[channel], over[channel], over[3]);
		}
	}
}


status_t
scale_of_environment(float* _scale)
{
	const char* variable = std::getenv("ARCHWAY_SCALE");
	if (variable == nullptr || variable[0] == '\0')
		return B_OK;

	char* end = nullptr;
	const float scale = std::strtof(variable, &end);
	if (end == variable || *end != '\0' || !(scale >= kMinScale && scale <= kMaxScale)) {
		std::fprintf(stderr, "ARCHWAY_SCALE=%s: a number from 0.5 to 4 is expected\n", variable);
		return B_BAD_VALUE;
	}
	*_scale = scale;
	return B_OK;
}


} // namespace BPrivate
