// BScreen: the display that a window is on.
#pragma once

#include <BeBuild.h>
#include <GraphicsDefs.h>
#include <Rect.h>
#include <SupportDefs.h>

class BBitmap;
class BWindow;


// All members answer for the desktop's main screen; any thread may call them.
class _EXPORT BScreen {
public:
	explicit BScreen(screen_id id = B_MAIN_SCREEN_ID);
	explicit BScreen(BWindow* window);
	~BScreen();

	bool IsValid();
	status_t SetToNext();
	color_space ColorSpace();
	// In screen coordinates, from (0, 0).
	BRect Frame();
	screen_id ID();

	status_t WaitForRetrace();
	status_t WaitForRetrace(bigtime_t timeout);

	// Colours of the 8-bit palette.
	uint8 IndexForColor(rgb_color color);
	uint8 IndexForColor(uint8 red, uint8 green, uint8 blue, uint8 alpha = 255);
	rgb_color ColorForIndex(uint8 index);
	uint8 InvertIndex(uint8 index);
	const color_map* ColorMap();

	// A picture of what the screen shows; the caller owns a new bitmap.
	status_t GetBitmap(BBitmap** bitmap, bool drawCursor = true, BRect* bounds = NULL);
	status_t ReadBitmap(BBitmap* bitmap, bool drawCursor = true, BRect* bounds = NULL);

	rgb_color DesktopColor();
	rgb_color DesktopColor(uint32 workspace);

private:
	screen_id fID;
};
