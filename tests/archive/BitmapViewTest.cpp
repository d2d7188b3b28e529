#include "archive/BitmapView.h"

#include <memory>

#include <gtest/gtest.h>

#include <Bitmap.h>
#include <Message.h>

#include "support/TestWindow.h"

namespace {


constexpr rgb_color kRed = { 255, 0, 0, 255 };
constexpr rgb_color kGreen = { 0, 255, 0, 255 };


// Sixteen by sixteen: the left half red, the right half green.
std::unique_ptr<BBitmap>
MakeBitmap()
{
	auto bitmap = std::make_unique<BBitmap>(BRect(0, 0, 15, 15), B_RGBA32);
	uint8* bits = static_cast<uint8*>(bitmap->Bits());
	for (int32 y = 0; y < 16; y++) {
		for (int32 x = 0; x < 16; x++) {
			uint8* pixel = bits + y * bitmap->BytesPerRow() + x * 4;
			pixel[0] = 0;
			pixel[1] = x < 8 ? 0 : 255;
			pixel[2] = x < 8 ? 255 : 0;
			pixel[3] = 255;
		}
	}
	return bitmap;
}


void
ExpectColor(rgb_color expected, rgb_color found)
{
	EXPECT_EQ(expected.red, found.red);
	EXPECT_EQ(expected.green, found.green);
	EXPECT_EQ(expected.blue, found.blue);
}


} // namespace


TEST(BitmapView, RevivesWithItsBitmapTiledOverTheView)
{
	TestWindow window;
	auto bitmap = MakeBitmap();
	BitmapView original(BRect(10, 10, 109, 89), "picture", B_FOLLOW_NONE, B_WILL_DRAW);
	original.SetBitmap(bitmap.get());
	BMessage archive;
	EXPECT_EQ(B_OK, original.Archive(&archive, true));

	BView* view = dynamic_cast<BView*>(BitmapView::Instantiate(&archive));
	ASSERT_NE(nullptr, view);
	window.Add(view);
	for (float x : { 0.0f, 16.0f, 96.0f }) {
		ExpectColor(kRed, window.driver.PixelAt(view, BPoint(x + 2, 40)));
		if (x + 10 <= 99)
			ExpectColor(kGreen, window.driver.PixelAt(view, BPoint(x + 10, 70)));
	}

	BMessage again;
	view->Archive(&again, true);
	int32 count;
	type_code type;
	EXPECT_EQ(B_OK, again.GetInfo("bitmap", &type, &count));
	EXPECT_EQ(1, count);
}


TEST(BitmapView, HasNoBitmapInAShallowArchive)
{
	TestWindow window;
	auto bitmap = MakeBitmap();
	BitmapView original(BRect(10, 10, 109, 89), "picture", B_FOLLOW_NONE, B_WILL_DRAW);
	original.SetViewColor(kGreen);
	original.SetBitmap(bitmap.get());
	BMessage archive;
	original.Archive(&archive, false);
	EXPECT_FALSE(archive.HasMessage("bitmap"));

	BitmapView* view = dynamic_cast<BitmapView*>(BitmapView::Instantiate(&archive));
	ASSERT_NE(nullptr, view);
	EXPECT_EQ(NULL, view->Bitmap());
	window.Add(view);
	ExpectColor(kGreen, window.driver.PixelAt(view, BPoint(2, 2)));
}


TEST(BitmapView, RefusesTheArchiveOfAnotherClass)
{
	BMessage archive;
	archive.AddString("class", "BView");
	EXPECT_EQ(NULL, BitmapView::Instantiate(&archive));
}
