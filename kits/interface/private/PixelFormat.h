// Reading and writing the pixels of the colour spaces that bitmaps support.
#pragma once

#include <GraphicsDefs.h>

namespace BPrivate {


// Bytes of a row of so many pixels without padding; 0 for a space without bitmaps.
size_t RowBytes(color_space space, int32 width);

// Between pixels of a space and 0xAARRGGBB. `row` is the first byte of the row, `x` the first
// pixel. Spaces without alpha read as opaque, except that their transparent colour, where they
// have one, reads with alpha 0 and is written for pixels whose alpha is below 128.
void ReadPixels(color_space space, const uint8* row, int32 x, int32 count, uint32* pixels);
void WritePixels(color_space space, uint8* row, int32 x, int32 count, const uint32* pixels);

// Whether the pixels are 0xAARRGGBB words already, alpha counting or not.
inline bool
IsNativeSpace(color_space space)
{
	return space == B_RGB32 || space == B_RGBA32;
}


} // namespace BPrivate
