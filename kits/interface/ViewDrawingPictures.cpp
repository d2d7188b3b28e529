// The drawing calls of views: bitmaps and text.
#include <View.h>

#include <cstring>

#include <Bitmap.h>
#include <Region.h>
#include <Window.h>

#include "interface/private/BitmapAccess.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"
#include "server/ViewTree.h"
#include "server/paint/Painter.h"

using namespace BPrivate;


void
BView::CopyBits(BRect src, BRect dst)
{
	if (_BeginDrawing() == nullptr)
		return;
	fNode->Tree()->CopyBits(*fNode, src, dst);
}


void
BView::DrawBitmapAsync(const BBitmap* bitmap, BRect srcRect, BRect dstRect)
{
	DrawBitmap(bitmap, srcRect, dstRect);
}


void
BView::DrawBitmapAsync(const BBitmap* bitmap, BRect dstRect)
{
	DrawBitmap(bitmap, dstRect);
}


void
BView::DrawBitmapAsync(const BBitmap* bitmap, BPoint where)
{
	DrawBitmap(bitmap, where);
}


void
BView::DrawBitmapAsync(const BBitmap* bitmap)
{
	DrawBitmap(bitmap);
}


void
BView::DrawBitmap(const BBitmap* bitmap, BRect srcRect, BRect dstRect)
{
	if (bitmap == nullptr || !srcRect.IsValid() || !dstRect.IsValid())
		return;
	Painter* painter = _BeginDrawing();
	if (painter == nullptr)
		return;
	if (const std::shared_ptr<const Surface> pixels = BitmapAccess::Pixels(*bitmap))
		painter->DrawBitmap(*pixels, srcRect, dstRect);
}


void
BView::DrawBitmap(const BBitmap* bitmap, BRect dstRect)
{
	if (bitmap != nullptr)
		DrawBitmap(bitmap, bitmap->Bounds().OffsetToCopy(0, 0), dstRect);
}


void
BView::DrawBitmap(const BBitmap* bitmap, BPoint where)
{
	if (bitmap != nullptr)
		DrawBitmap(bitmap, bitmap->Bounds().OffsetToCopy(where));
}


void
BView::DrawBitmap(const BBitmap* bitmap)
{
	DrawBitmap(bitmap, PenLocation());
}


// #pragma mark - text


void
BView::DrawChar(char character)
{
	DrawString(&character, 1, PenLocation());
}


void
BView::DrawChar(char character, BPoint location)
{
	DrawString(&character, 1, location);
}


void
BView::DrawString(const char* string, escapement_delta* delta)
{
	if (string != nullptr)
		DrawString(string, std::strlen(string), PenLocation(), delta);
}


void
BView::DrawString(const char* string, BPoint location, escapement_delta* delta)
{
	if (string != nullptr)
		DrawString(string, std::strlen(string), location, delta);
}


void
BView::DrawString(const char* string, int32 length, escapement_delta* delta)
{
	DrawString(string, length, PenLocation(), delta);
}


void
BView::DrawString(const char* string, int32 length, BPoint location, escapement_delta* delta)
{
	if (string == nullptr || length <= 0 || fOwner == nullptr)
		return;
	const std::string_view text(string, strnlen(string, length));
	const float nonspace = delta != nullptr ? delta->nonspace : 0;
	const float space = delta != nullptr ? delta->space : 0;
	if (Painter* painter = _BeginDrawing())
		_SetPen(painter->DrawString(text, location, nonspace, space));
	else
		_SetPen(location + BPoint(StringWidth(string, text.size()), 0));
}


// Where a drawing call leaves the pen; unlike MovePenTo() that is nothing to archive.
void
BView::_SetPen(BPoint location)
{
	if (PenLocation() != location)
		_State()->draw.penLocation = location;
}
