// Picture: a picture of the screen as a file.
#pragma once

#include <GraphicsDefs.h>

#include "backend/Backend.h"

namespace BPrivate {


status_t save_picture(const ScreenPicture& picture, const char* path); // PNG
rgb_color color_at(const ScreenPicture& picture, int32 x, int32 y); // device pixels; 0 outside


} // namespace BPrivate
