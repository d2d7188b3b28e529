#include "server/DragSession.h"

#include <algorithm>
#include <atomic>
#include <cmath>
#include <cstring>

#include <AppDefs.h>

#include "server/Desktop.h"

namespace BPrivate {

namespace {

constexpr int32 kMaxImageSide = 8192;

std::atomic<int32> sNextSerial { 1 };


// A grey frame, one pixel wide and half seen through.
ScreenPicture
MakeOutline(int32 width, int32 height)
{
	ScreenPicture picture { width, height, std::vector<uint8>(size_t(width) * height * 4) };
	for (int32 y = 0; y < height; y++) {
		for (int32 x = 0; x < width; x++) {
			if (y > 0 && y < height - 1 && x > 0 && x < width - 1)
				continue;
			const uint8 pixel[4] = { 64, 64, 64, 192 };
			std::memcpy(&picture.bits[(size_t(y) * width + x) * 4], pixel, 4);
		}
	}
	return picture;
}


ScreenPicture
CopyImage(const DragImage& image)
{
	ScreenPicture picture { image.width, image.height,
		std::vector<uint8>(size_t(image.width) * image.height * 4) };
	for (int32 y = 0; y < image.height; y++) {
		uint8* row = &picture.bits[size_t(y) * image.width * 4];
		std::memcpy(row, static_cast<const uint8*>(image.bits) + size_t(y) * image.bytesPerRow,
			size_t(image.width) * 4);
		for (int32 x = 0; x < image.width; x++)
			row[x * 4 + 3] = static_cast<uint8>(row[x * 4 + 3] * image.opacity / 255);
	}
	return picture;
}

} // namespace


DragSession::DragSession(std::unique_ptr<BMessage> message, const DragImage& image) :
	fMessage(std::move(message)), fForeign(false), fSerial(sNextSerial++), fOffset(image.offset)
{
	if (image.width <= 0 || image.height <= 0 || image.width > kMaxImageSide
		|| image.height > kMaxImageSide)
		return;
	fImage = image.bits != nullptr ? CopyImage(image) : MakeOutline(image.width, image.height);
}


DragSession::DragSession(std::unique_ptr<BMessage> message) :
	fMessage(std::move(message)), fForeign(true), fSerial(sNextSerial++)
{
}


ScreenPicture
DragSession::Picture(float scale) const
{
	if (scale == 1 || fImage.width == 0)
		return fImage;

	ScreenPicture picture;
	picture.width = std::max(1, static_cast<int32>(std::lround(fImage.width * scale)));
	picture.height = std::max(1, static_cast<int32>(std::lround(fImage.height * scale)));
	picture.bits.resize(size_t(picture.width) * picture.height * 4);
	for (int32 y = 0; y < picture.height; y++) {
		const size_t fromY = size_t(y) * fImage.height / picture.height;
		for (int32 x = 0; x < picture.width; x++) {
			const size_t fromX = size_t(x) * fImage.width / picture.width;
			std::memcpy(&picture.bits[(size_t(y) * picture.width + x) * 4],
				&fImage.bits[(fromY * fImage.width + fromX) * 4], 4);
		}
	}
	return picture;
}


void
DragSession::AddTo(BMessage& moved) const
{
	moved.AddMessage("be:drag_message", fMessage.get());
	moved.AddInt32("_msg_what_", static_cast<int32>(fMessage->what));
}


std::unique_ptr<BMessage>
DragSession::MakeDrop(BPoint screen, uint32 buttons) const
{
	auto drop = std::make_unique<BMessage>(*fMessage);
	drop->what = _MESSAGE_DROPPED_;
	for (const char* name : { "_original_what", "_drop_point_", "_drop_offset_" })
		drop->RemoveName(name);
	drop->AddInt32("_original_what", static_cast<int32>(fMessage->what));
	drop->AddPoint("_drop_point_", screen);
	drop->AddPoint("_drop_offset_", fOffset);
	int32 known;
	if (drop->FindInt32("buttons", &known) != B_OK)
		drop->AddInt32("buttons", static_cast<int32>(buttons));
	return drop;
}


} // namespace BPrivate
