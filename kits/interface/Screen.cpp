#include <Screen.h>

#include <memory>

#include "server/Desktop.h"
#include "server/ScreenPicture.h"
#include <Bitmap.h>
#include <Window.h>

using namespace BPrivate;


BScreen::BScreen(screen_id id) : fID(id)
{
}


BScreen::BScreen(BWindow* window) : fID(B_MAIN_SCREEN_ID)
{
}


BScreen::~BScreen()
{
}


bool
BScreen::IsValid()
{
	return fID.id == B_MAIN_SCREEN_ID.id && Desktop::Get() != nullptr;
}


status_t
BScreen::SetToNext()
{
	return B_ERROR;
}


color_space
BScreen::ColorSpace()
{
	return B_RGB32;
}


BRect
BScreen::Frame()
{
	const Desktop* desktop = Desktop::Get();
	return desktop != nullptr ? desktop->ScreenFrame() : BRect(0, 0, 0, 0);
}


screen_id
BScreen::ID()
{
	return fID;
}


status_t
BScreen::WaitForRetrace()
{
	return WaitForRetrace(B_INFINITE_TIMEOUT);
}


status_t
BScreen::WaitForRetrace(bigtime_t timeout)
{
	return B_UNSUPPORTED;
}


// #pragma mark - palette


uint8
BScreen::IndexForColor(rgb_color color)
{
	return IndexForColor(color.red, color.green, color.blue, color.alpha);
}


uint8
BScreen::IndexForColor(uint8 red, uint8 green, uint8 blue, uint8 alpha)
{
	if (rgb_color { red, green, blue, alpha } == B_TRANSPARENT_COLOR)
		return B_TRANSPARENT_8_BIT;
	return system_colors()->index_map[(red >> 3) << 10 | (green >> 3) << 5 | blue >> 3];
}


rgb_color
BScreen::ColorForIndex(uint8 index)
{
	return system_colors()->color_list[index];
}


uint8
BScreen::InvertIndex(uint8 index)
{
	return system_colors()->inversion_map[index];
}


const color_map*
BScreen::ColorMap()
{
	return system_colors();
}


// #pragma mark - pictures


status_t
BScreen::GetBitmap(BBitmap** _bitmap, bool drawCursor, BRect* bounds)
{
	if (_bitmap == nullptr)
		return B_BAD_VALUE;
	BRect area = bounds != nullptr ? *bounds : Frame();
	auto bitmap = std::make_unique<BBitmap>(area.OffsetToCopy(0, 0), B_RGB32);
	status_t status = bitmap->InitCheck();
	if (status == B_OK)
		status = ReadBitmap(bitmap.get(), drawCursor, &area);
	if (status == B_OK)
		*_bitmap = bitmap.release();
	return status;
}


status_t
BScreen::ReadBitmap(BBitmap* bitmap, bool drawCursor, BRect* bounds)
{
	Desktop* desktop = Desktop::Get();
	if (bitmap == nullptr || desktop == nullptr)
		return B_BAD_VALUE;
	const BRect area = bounds != nullptr ? *bounds : Frame();
	const ScreenPicture picture = desktop->Picture(area);
	if (picture.width == 0 || picture.height == 0)
		return B_ERROR;

	// The bitmap's pixels are logical ones: of a sharper screen every so many are taken.
	const BRect size = bitmap->Bounds();
	const int32 width = size.IntegerWidth() + 1;
	const int32 height = size.IntegerHeight() + 1;
	std::vector<uint8> rows(static_cast<size_t>(width) * height * 4);
	for (int32 y = 0; y < height; y++) {
		const size_t fromY = static_cast<size_t>(y) * picture.height / height;
		for (int32 x = 0; x < width; x++) {
			const size_t fromX = static_cast<size_t>(x) * picture.width / width;
			const uint8* pixel = &picture.bits[(fromY * picture.width + fromX) * 4];
			std::copy(pixel, pixel + 4, &rows[(static_cast<size_t>(y) * width + x) * 4]);
		}
	}
	return bitmap->ImportBits(rows.data(), rows.size(), width * 4, 0, B_RGB32);
}


rgb_color
BScreen::DesktopColor()
{
	return ui_color(B_DESKTOP_COLOR);
}


rgb_color
BScreen::DesktopColor(uint32 workspace)
{
	return DesktopColor();
}
