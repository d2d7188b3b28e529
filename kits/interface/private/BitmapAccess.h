// BitmapAccess: a bitmap's pixels for those who paint them.
#pragma once

#include <memory>

#include <Bitmap.h>

#include "server/paint/Surface.h"

namespace BPrivate {


class BitmapAccess {
public:
	// The pixels as a surface, for reading: shared with the bitmap where they are 32-bit ones,
	// else a converted copy. NULL for a bitmap without pixels. The bitmap must outlive it.
	static std::shared_ptr<const Surface> Pixels(const BBitmap& bitmap);

	// An own copy of the pixels, for who keeps them longer than the bitmap (a drag's image, a
	// view's bitmap).
	static std::shared_ptr<Surface> CopyOf(const BBitmap& bitmap);

	// What views of the bitmap draw in; NULL unless it accepts views.
	static Surface* DrawingSurface(BBitmap& bitmap);
	// To be called when drawing has been finished (Sync(), Flush(), Unlock()): brings the pixels
	// into the bitmap's own colour space where that is not a 32-bit one.
	static void Finish(BBitmap& bitmap);
};


} // namespace BPrivate
