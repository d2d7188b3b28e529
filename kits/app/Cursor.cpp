#include <Cursor.h>

#include <string.h>

#include <Bitmap.h>
#include <Message.h>
#include <Point.h>

#include "app/private/CursorPrivate.h"
#include "interface/private/BitmapAccess.h"

namespace {

constexpr uint8 kSide = 16;
constexpr int32 kDataSize = 68;
constexpr int32 kLargestSide = 256;

BCursor sSystemDefault(B_CURSOR_ID_SYSTEM_DEFAULT);
BCursor sIBeam(B_CURSOR_ID_I_BEAM);

} // namespace

const BCursor* B_CURSOR_SYSTEM_DEFAULT = &sSystemDefault;
const BCursor* B_CURSOR_I_BEAM = &sIBeam;

// Size, depth, hot spot (row, column); then the bits of 16 rows and those of the mask.
const unsigned char B_HAND_CURSOR[] = { 16, 1, 2, 2, 0x00, 0x00, 0x00, 0x00, 0x20, 0x00, 0x30, 0x00,
	0x38, 0x00, 0x3c, 0x00, 0x3e, 0x00, 0x3f, 0x00, 0x3f, 0x80, 0x3c, 0x00, 0x36, 0x00, 0x26, 0x00,
	0x03, 0x00, 0x03, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x60, 0x00, 0x70, 0x00, 0x78, 0x00,
	0x7c, 0x00, 0x7e, 0x00, 0x7f, 0x00, 0x7f, 0x80, 0x7f, 0xc0, 0x7f, 0xc0, 0x7f, 0x00, 0x7f, 0x00,
	0x67, 0x80, 0x07, 0x80, 0x03, 0x00, 0x00, 0x00 };

const unsigned char B_I_BEAM_CURSOR[] = { 16, 1, 7, 7, 0x00, 0x00, 0x06, 0xc0, 0x01, 0x00, 0x01,
	0x00, 0x01, 0x00, 0x01, 0x00, 0x01, 0x00, 0x01, 0x00, 0x01, 0x00, 0x01, 0x00, 0x01, 0x00, 0x01,
	0x00, 0x01, 0x00, 0x06, 0xc0, 0x00, 0x00, 0x00, 0x00, 0x0f, 0xe0, 0x0f, 0xe0, 0x0f, 0xe0, 0x03,
	0x80, 0x03, 0x80, 0x03, 0x80, 0x03, 0x80, 0x03, 0x80, 0x03, 0x80, 0x03, 0x80, 0x03, 0x80, 0x03,
	0x80, 0x0f, 0xe0, 0x0f, 0xe0, 0x0f, 0xe0, 0x00, 0x00 };


BCursor::BCursor(const void* cursorData)
{
	const auto* bytes = static_cast<const uint8*>(cursorData);
	// The two classic cursors are those of the desktop.
	if (bytes == B_HAND_CURSOR)
		fID = B_CURSOR_ID_SYSTEM_DEFAULT;
	else if (bytes == B_I_BEAM_CURSOR)
		fID = B_CURSOR_ID_I_BEAM;
	else if (bytes == nullptr || bytes[0] != kSide || bytes[1] != 1 || bytes[2] >= kSide
		|| bytes[3] >= kSide)
		fStatus = B_BAD_VALUE;
	else
		memcpy(fData, bytes, kDataSize);
}


BCursor::BCursor(const BCursor& other) : BArchivable()
{
	*this = other;
}


BCursor::BCursor(BCursorID id) : fID(id)
{
}


// Cursors have no archived form; the instance is the default one.
BCursor::BCursor(BMessage* data) : fID(B_CURSOR_ID_SYSTEM_DEFAULT), fStatus(B_BAD_VALUE)
{
}


BCursor::BCursor(const BBitmap* bitmap, const BPoint& hotspot)
{
	fStatus = B_BAD_VALUE;
	const auto pixels = bitmap != nullptr ? BPrivate::BitmapAccess::Pixels(*bitmap) : nullptr;
	if (pixels == nullptr || pixels->Width() > kLargestSide || pixels->Height() > kLargestSide
		|| !bitmap->Bounds().Contains(hotspot))
		return;

	auto picture = std::make_shared<BPrivate::CursorPicture>();
	picture->width = pixels->Width();
	picture->height = pixels->Height();
	picture->hotX = static_cast<int32>(hotspot.x - bitmap->Bounds().left);
	picture->hotY = static_cast<int32>(hotspot.y - bitmap->Bounds().top);
	const bool opaque = pixels->Format() == BPrivate::SurfaceFormat::kOpaque;
	for (int32 y = 0; y < picture->height; y++) {
		for (int32 x = 0; x < picture->width; x++) {
			const uint32 pixel = pixels->Row(y)[x];
			const bool clear = opaque && (pixel & 0xffffff) == 0x777477;
			picture->pixels.push_back(opaque && !clear ? pixel | 0xff000000 : clear ? 0 : pixel);
		}
	}
	fPicture = std::move(picture);
	fStatus = B_OK;
}


BCursor::~BCursor() = default;


BArchivable*
BCursor::Instantiate(BMessage* data)
{
	return nullptr;
}


status_t
BCursor::Archive(BMessage* archive, bool deep) const
{
	return B_OK;
}


status_t
BCursor::InitCheck() const
{
	return fStatus;
}


BCursor&
BCursor::operator=(const BCursor& other)
{
	memcpy(fData, other.fData, sizeof(fData));
	fID = other.fID;
	fPicture = other.fPicture;
	fStatus = other.fStatus;
	return *this;
}


bool
BCursor::operator==(const BCursor& other) const
{
	return fID == other.fID && fStatus == other.fStatus && fPicture == other.fPicture
		&& memcmp(fData, other.fData, sizeof(fData)) == 0;
}


// #pragma mark - private access


namespace BPrivate {


CursorShape
CursorPrivate::Shape(const BCursor& cursor)
{
	CursorShape shape;
	if (cursor.fStatus != B_OK)
		return shape;
	if (cursor.fPicture != nullptr) {
		shape.id = CursorShape::kFromPicture;
		shape.picture = cursor.fPicture;
		return shape;
	}
	shape.id = cursor.fID != 0 ? cursor.fID : CursorShape::kFromBits;
	memcpy(shape.bits.data(), cursor.fData, shape.bits.size());
	return shape;
}


} // namespace BPrivate
