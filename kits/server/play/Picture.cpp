#include "server/play/Picture.h"

#include <cstring>

#include "server/paint/Surface.h"

namespace BPrivate {


status_t
save_picture(const ScreenPicture& picture, const char* path)
{
	Surface surface;
	const status_t status = surface.SetTo(picture.width, picture.height);
	if (status != B_OK)
		return status;
	const size_t row = size_t(picture.width) * 4;
	for (int32 y = 0; y < picture.height; y++)
		std::memcpy(surface.Row(y), &picture.bits[y * row], row);
	return surface.WritePng(path);
}


rgb_color
color_at(const ScreenPicture& picture, int32 x, int32 y)
{
	if (x < 0 || y < 0 || x >= picture.width || y >= picture.height)
		return { 0, 0, 0, 0 };
	const uint8* pixel = &picture.bits[(size_t(y) * picture.width + x) * 4];
	return { pixel[2], pixel[1], pixel[0], 255 };
}


} // namespace BPrivate
