// Bitmaps that accept views.
#include <Bitmap.h>

#include <gtest/gtest.h>
#include <memory>
#include <string.h>

#include <Application.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

namespace {

uint32
PixelOf(const BBitmap& bitmap, int32 x, int32 y)
{
	uint32 pixel;
	memcpy(&pixel, static_cast<const uint8*>(bitmap.Bits()) + y * bitmap.BytesPerRow() + x * 4,
		sizeof(pixel));
	return pixel;
}

} // namespace


class BitmapViews : public testing::Test {
protected:
	BApplication fApplication { "application/x-vnd.Archway-test" };
};


TEST_F(BitmapViews, DrawingLandsInTheBits)
{
	BBitmap bitmap(BRect(0, 0, 19, 19), B_RGBA32, true);
	BView* view = new BView(bitmap.Bounds(), "canvas", B_FOLLOW_NONE, B_WILL_DRAW);
	ASSERT_TRUE(bitmap.Lock());
	bitmap.AddChild(view);
	EXPECT_NE(nullptr, view->Window());
	EXPECT_EQ(nullptr, view->Parent());
	view->SetHighColor(10, 20, 30);
	view->FillRect(BRect(5, 5, 9, 9));
	view->Sync();
	EXPECT_EQ(0xff0a141e, PixelOf(bitmap, 5, 5));
	EXPECT_EQ(0xff0a141e, PixelOf(bitmap, 9, 9));
	EXPECT_EQ(0xffffffff, PixelOf(bitmap, 10, 10));
	bitmap.Unlock();
}


TEST_F(BitmapViews, OtherColourSpacesAreConverted)
{
	BBitmap bitmap(BRect(0, 0, 19, 19), B_GRAY8, true);
	BView* view = new BView(bitmap.Bounds(), "canvas", B_FOLLOW_NONE, B_WILL_DRAW);
	ASSERT_TRUE(bitmap.Lock());
	bitmap.AddChild(view);
	view->SetHighColor(100, 100, 100);
	view->FillRect(BRect(0, 0, 3, 3));
	view->Sync();
	bitmap.Unlock();
	const uint8* bits = static_cast<const uint8*>(bitmap.Bits());
	EXPECT_EQ(100, bits[0]);
	EXPECT_EQ(255, bits[4]);
}


TEST_F(BitmapViews, RemovedViewIsUsableElsewhere)
{
	BBitmap bitmap(BRect(0, 0, 19, 19), B_RGBA32, true);
	std::unique_ptr<BView> view(new BView(bitmap.Bounds(), "canvas", B_FOLLOW_NONE, B_WILL_DRAW));
	ASSERT_TRUE(bitmap.Lock());
	bitmap.AddChild(view.get());
	EXPECT_EQ(1, bitmap.CountChildren());
	EXPECT_EQ(view.get(), bitmap.FindView("canvas"));
	EXPECT_TRUE(bitmap.RemoveChild(view.get()));
	EXPECT_EQ(nullptr, view->Window());
	EXPECT_EQ(0, bitmap.CountChildren());
	bitmap.Unlock();
}


TEST_F(BitmapViews, BitmapDrawsIntoAnother)
{
	BBitmap stamp(BRect(0, 0, 3, 3), B_RGBA32);
	for (int32 i = 0; i < 16; i++)
		static_cast<uint32*>(stamp.Bits())[i] = i % 2 ? 0xff00ff00 : 0;
	BBitmap bitmap(BRect(0, 0, 19, 19), B_RGBA32, true);
	BView* view = new BView(bitmap.Bounds(), "canvas", B_FOLLOW_NONE, B_WILL_DRAW);
	ASSERT_TRUE(bitmap.Lock());
	bitmap.AddChild(view);
	view->SetDrawingMode(B_OP_OVER);
	view->DrawBitmap(&stamp, BPoint(8, 8));
	view->Sync();
	bitmap.Unlock();
	EXPECT_EQ(0xffffffff, PixelOf(bitmap, 8, 8));
	EXPECT_EQ(0xff00ff00, PixelOf(bitmap, 9, 8));
}


TEST_F(BitmapViews, DeepArchiveHoldsTheViews)
{
	BBitmap bitmap(BRect(0, 0, 9, 9), B_RGBA32, true);
	ASSERT_TRUE(bitmap.Lock());
	bitmap.AddChild(new BView(BRect(1, 2, 3, 4), "kept", B_FOLLOW_NONE, B_WILL_DRAW));
	bitmap.Unlock();
	BMessage archive;
	ASSERT_EQ(B_OK, bitmap.Archive(&archive, true));

	std::unique_ptr<BArchivable> copy(BBitmap::Instantiate(&archive));
	BBitmap* revived = dynamic_cast<BBitmap*>(copy.get());
	ASSERT_NE(nullptr, revived);
	ASSERT_TRUE(revived->Lock());
	BView* view = revived->FindView("kept");
	ASSERT_NE(nullptr, view);
	EXPECT_EQ(BRect(1, 2, 3, 4), view->Frame());
	revived->Unlock();
}


TEST_F(BitmapViews, BitmapThatRefusesViewsHasNone)
{
	BBitmap bitmap(BRect(0, 0, 9, 9), B_RGBA32);
	EXPECT_FALSE(bitmap.Lock());
	EXPECT_FALSE(bitmap.IsLocked());
	EXPECT_EQ(0, bitmap.CountChildren());
	EXPECT_EQ(nullptr, bitmap.ChildAt(0));
}
