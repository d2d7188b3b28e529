// ScreenPainter: puts windows together to a picture of the screen.
#pragma once

#include "backend/Backend.h"

namespace BPrivate {


// Also serves backends with real windows for pictures of what they show.
class ScreenPainter {
public:
	// A part of the screen in logical coordinates.
	ScreenPainter(BRect screen, float scale);

	void DrawWindow(BRect frame, FrontImage& image);
	// Blended by its alpha.
	void DrawPicture(BPoint leftTop, const ScreenPicture& picture);
	ScreenPicture Take() { return std::move(fPicture); }

private:
	struct Place {
		int32 x, y; // in device pixels of the picture
	};

	Place _PlaceOf(BPoint screen) const;

	float fScale;
	int32 fLeft, fTop; // device pixels of the screen
	ScreenPicture fPicture;
};


// ARCHWAY_SCALE, which is left alone when it is not set; B_BAD_VALUE, with a message, when it makes
// no sense.
status_t scale_of_environment(float* _scale);


} // namespace BPrivate
