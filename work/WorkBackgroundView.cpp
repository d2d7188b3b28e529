#include "work/WorkBackgroundView.h"

namespace {


constexpr rgb_color kLightGray = { 204, 204, 204, 255 };
constexpr rgb_color kMidGray = { 153, 153, 153, 255 };

// Squares of four by four pixels.
constexpr pattern kChecks = { { 0xf0, 0xf0, 0xf0, 0xf0, 0x0f, 0x0f, 0x0f, 0x0f } };


} // namespace


WorkBackgroundView::WorkBackgroundView(
	BRect frame, const char* name, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags)
{
	SetHighColor(kLightGray);
	SetLowColor(kMidGray);
	SetViewColor(B_TRANSPARENT_COLOR);
}


void
WorkBackgroundView::Draw(BRect updateRect)
{
	FillRect(Bounds(), kChecks);
}
