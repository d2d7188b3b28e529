#include <Bitmap.h>

#include <gtest/gtest.h>
#include <memory>
#include <random>
#include <string.h>
#include <vector>

#include <Message.h>

namespace {

constexpr color_space kSpaces[] = { B_RGB32, B_RGBA32, B_RGB24, B_RGB16, B_RGB15, B_RGBA15, B_RGB48,
	B_RGBA64, B_CMAP8, B_GRAY8, B_GRAY1, B_RGB32_BIG, B_RGBA32_BIG, B_RGB24_BIG, B_RGB16_BIG,
	B_RGB15_BIG, B_RGBA15_BIG, B_RGB48_BIG, B_RGBA64_BIG };


uint32
PixelOf(const BBitmap& bitmap, int32 x, int32 y)
{
	const uint8* row = static_cast<const uint8*>(bitmap.Bits()) + (size_t)y * bitmap.BytesPerRow();
	uint32 pixel;
	memcpy(&pixel, row + x * 4, sizeof(pixel));
	return pixel;
}


// One pixel, taken into a space and back.
uint32
ThereAndBack(uint32 pixel, color_space space)
{
	BBitmap source(BRect(0, 0, 0, 0), B_RGBA32);
	memcpy(source.Bits(), &pixel, 4);
	BBitmap middle(BRect(0, 0, 0, 0), space);
	BBitmap result(BRect(0, 0, 0, 0), B_RGBA32);
	EXPECT_EQ(B_OK, middle.ImportBits(&source));
	EXPECT_EQ(B_OK, result.ImportBits(&middle));
	return PixelOf(result, 0, 0);
}


int
Difference(uint32 a, uint32 b)
{
	int most = 0;
	for (int shift = 0; shift < 24; shift += 8)
		most = std::max(most, abs((int)(a >> shift & 255) - (int)(b >> shift & 255)));
	return most;
}

} // namespace


TEST(Bitmap, RowsArePaddedToFourBytes)
{
	EXPECT_EQ(4, BBitmap(BRect(0, 0, 0, 0), B_CMAP8).BytesPerRow());
	EXPECT_EQ(8, BBitmap(BRect(0, 0, 4, 0), B_CMAP8).BytesPerRow());
	EXPECT_EQ(8, BBitmap(BRect(0, 0, 1, 0), B_RGB24).BytesPerRow());
	EXPECT_EQ(4, BBitmap(BRect(0, 0, 31, 0), B_GRAY1).BytesPerRow());
	EXPECT_EQ(8, BBitmap(BRect(0, 0, 32, 0), B_GRAY1).BytesPerRow());
	EXPECT_EQ(20 * 11, BBitmap(BRect(0, 0, 4, 10), B_RGB32).BitsLength());
}


TEST(Bitmap, BoundsBeginAtTheOrigin)
{
	EXPECT_EQ(BRect(0, 0, 9, 4), BBitmap(BRect(5, 6, 14, 10), B_RGB32).Bounds());
}


TEST(Bitmap, BadArgumentsAreSaid)
{
	EXPECT_FALSE(BBitmap(BRect(), B_RGB32).IsValid());
	EXPECT_FALSE(BBitmap(BRect(0, 0, 9, 9), B_NO_COLOR_SPACE).IsValid());
	EXPECT_FALSE(BBitmap(BRect(0, 0, 9, 9), B_YCbCr422).IsValid());
	EXPECT_FALSE(BBitmap(BRect(0, 0, 1e9f, 9), B_RGB32).IsValid());
	EXPECT_FALSE(BBitmap(BRect(0, 0, NAN, 9), B_RGB32).IsValid());
	EXPECT_FALSE(BBitmap(BRect(0, 0, 9, 9), 0, B_RGB32, 8).IsValid());
	BBitmap bad(BRect(), B_RGB32);
	EXPECT_EQ(NULL, bad.Bits());
	EXPECT_EQ(0, bad.BitsLength());
	EXPECT_NE(B_OK, bad.ImportBits("abcd", 4, 4, 0, B_RGB32));
}


TEST(Bitmap, ColoursSurviveEverySpaceAsFarAsItGoes)
{
	std::mt19937 random(2);
	for (color_space space : kSpaces) {
		int allowed = 0;
		if (space == B_RGB16 || space == B_RGB15 || space == B_RGBA15 || space == B_RGB16_BIG
			|| space == B_RGB15_BIG || space == B_RGBA15_BIG)
			allowed = 7;
		if (space == B_CMAP8)
			allowed = 60;
		const bool gray = space == B_GRAY8 || space == B_GRAY1;
		for (int i = 0; i < 300; i++) {
			uint32 pixel = 0xff000000 | (random() & 0xffffff);
			if (gray)
				pixel = 0xff000000 | (random() & 1 ? 0xffffff : 0);
			EXPECT_LE(Difference(pixel, ThereAndBack(pixel, space)), allowed)
				<< std::hex << pixel << " in " << space;
			EXPECT_EQ(255u, ThereAndBack(pixel, space) >> 24);
		}
	}
}


TEST(Bitmap, TransparencySurvivesWhereThereIsSuchAThing)
{
	for (color_space space : { B_RGB32, B_RGBA32, B_RGB15, B_RGBA15, B_CMAP8, B_RGBA64 })
		EXPECT_EQ(0u, ThereAndBack(0x00777477, space) >> 24) << space;
	EXPECT_EQ(0x80u, ThereAndBack(0x80123456, B_RGBA32_BIG) >> 24);
}


TEST(Bitmap, OrdersOfBytesAreAsNamed)
{
	const uint8 rgb[] = { 10, 20, 30, 255 };
	BBitmap bitmap(BRect(0, 0, 0, 0), B_RGBA32);
	ASSERT_EQ(B_OK, bitmap.ImportBits(rgb, 3, 3, 0, B_RGB24_BIG));
	EXPECT_EQ(0xff0a141eu, PixelOf(bitmap, 0, 0));
	ASSERT_EQ(B_OK, bitmap.ImportBits(rgb, 3, 3, 0, B_RGB24));
	EXPECT_EQ(0xff1e140au, PixelOf(bitmap, 0, 0));
}


TEST(Bitmap, GrayBitsAreBlack)
{
	const uint8 bits[] = { 0x80, 0, 0, 0 };
	BBitmap bitmap(BRect(0, 0, 1, 0), B_RGB32);
	bitmap.SetBits(bits, 4, 0, B_GRAY1);
	EXPECT_EQ(0xff000000u, PixelOf(bitmap, 0, 0));
	EXPECT_EQ(0xffffffffu, PixelOf(bitmap, 1, 0));
}


TEST(Bitmap, ImportIsCutToBothSides)
{
	BBitmap source(BRect(0, 0, 9, 9), B_RGB32);
	for (int32 i = 0; i < 100; i++)
		static_cast<uint32*>(source.Bits())[i] = 0xff000000 | i;
	BBitmap target(BRect(0, 0, 9, 9), 0, B_RGB32);

	ASSERT_EQ(B_OK, target.ImportBits(&source, BPoint(5, 5), BPoint(-2, 7), BPoint(20, 20)));

	for (int32 y = 0; y < 10; y++) {
		for (int32 x = 0; x < 10; x++) {
			const int32 fromX = x + 2 + 5;
			const int32 fromY = y - 7 + 5;
			const bool inside = fromX < 10 && y >= 7 && fromY < 10;
			EXPECT_EQ(
				inside ? 0xff000000 | (uint32)(fromY * 10 + fromX) : 0, PixelOf(target, x, y));
		}
	}
}


TEST(Bitmap, ImportNeverReadsBeyondTheData)
{
	std::mt19937 random(4);
	for (int i = 0; i < 3000; i++) {
		BBitmap bitmap(BRect(0, 0, random() % 20, random() % 20), 0, kSpaces[random() % 19]);
		std::vector<uint8> data(random() % 200);
		bitmap.ImportBits(data.data(), data.size(), (int32)(random() % 60) - 1,
			(int32)(random() % 500) - 10, kSpaces[random() % 19]);
		bitmap.ImportBits(data.data(), data.size(), (int32)(random() % 60) - 1,
			kSpaces[random() % 19], BPoint((int32)(random() % 30) - 10, random() % 30),
			BPoint((int32)(random() % 30) - 10, (int32)(random() % 30) - 10),
			BPoint(random() % 40, random() % 40));
		ASSERT_TRUE(bitmap.IsValid());
	}
}


TEST(Bitmap, SetBitsStopsAtTheEnd)
{
	BBitmap bitmap(BRect(0, 0, 3, 1), B_CMAP8);
	std::vector<uint8> data(100, 7);
	bitmap.SetBits(data.data(), 100, 4, B_CMAP8);
	const uint8* bits = static_cast<const uint8*>(bitmap.Bits());
	EXPECT_EQ(0, bits[3]);
	EXPECT_EQ(7, bits[4]);
	EXPECT_EQ(7, bits[7]);
}


TEST(Bitmap, ArchiveHoldsEverythingInOrder)
{
	BBitmap bitmap(BRect(0, 0, 4, 2), B_CMAP8);
	memset(bitmap.Bits(), 9, bitmap.BitsLength());
	BMessage archive;
	ASSERT_EQ(B_OK, bitmap.Archive(&archive));

	BRect frame;
	int32 number;
	const void* data;
	ssize_t size;
	EXPECT_EQ(B_OK, archive.FindRect("_frame", &frame));
	EXPECT_EQ(BRect(0, 0, 4, 2), frame);
	EXPECT_EQ(B_OK, archive.FindInt32("_cspace", &number));
	EXPECT_EQ(B_CMAP8, number);
	EXPECT_EQ(B_OK, archive.FindInt32("_bmflags", &number));
	EXPECT_EQ(B_OK, archive.FindInt32("_rowbytes", &number));
	EXPECT_EQ(8, number);
	EXPECT_EQ(B_OK, archive.FindData("_data", B_RAW_TYPE, &data, &size));
	EXPECT_EQ(24, size);

	std::unique_ptr<BArchivable> copy(BBitmap::Instantiate(&archive));
	BBitmap* revived = dynamic_cast<BBitmap*>(copy.get());
	ASSERT_NE(nullptr, revived);
	ASSERT_TRUE(revived->IsValid());
	EXPECT_EQ(bitmap.Bounds(), revived->Bounds());
	EXPECT_EQ(bitmap.ColorSpace(), revived->ColorSpace());
	EXPECT_EQ(0, memcmp(bitmap.Bits(), revived->Bits(), 24));
}


TEST(Bitmap, DataOfAnotherSizeIsLeftAlone)
{
	BMessage archive;
	archive.AddString("class", "BBitmap");
	archive.AddRect("_frame", BRect(0, 0, 4, 2));
	archive.AddInt32("_cspace", B_CMAP8);
	archive.AddData("_data", B_RAW_TYPE, "short", 5);
	BBitmap bitmap(&archive);
	ASSERT_TRUE(bitmap.IsValid());
	EXPECT_EQ(0, *static_cast<uint8*>(bitmap.Bits()));
}


TEST(Bitmap, IncompleteArchiveIsNoBitmap)
{
	BMessage archive;
	archive.AddString("class", "BBitmap");
	archive.AddRect("_frame", BRect(0, 0, 4, 2));
	EXPECT_FALSE(BBitmap(&archive).IsValid());
}


TEST(Bitmap, SmallArchiveTakesNoHugeMemory)
{
	BMessage archive;
	archive.AddString("class", "BBitmap");
	archive.AddRect("_frame", BRect(0, 0, 15000, 15000));
	archive.AddInt32("_cspace", B_RGB32);
	archive.AddData("_data", B_RAW_TYPE, "tiny", 4);
	EXPECT_FALSE(BBitmap(&archive).IsValid());
}


TEST(Bitmap, CopyIsItsOwn)
{
	BBitmap bitmap(BRect(0, 0, 4, 2), B_RGB32);
	memset(bitmap.Bits(), 9, bitmap.BitsLength());
	BBitmap copy(bitmap);
	BBitmap assigned(BRect(0, 0, 0, 0), B_CMAP8);
	assigned = bitmap;
	memset(bitmap.Bits(), 1, bitmap.BitsLength());
	EXPECT_EQ(0x09090909u, PixelOf(copy, 4, 2));
	EXPECT_EQ(0x09090909u, PixelOf(assigned, 4, 2));
	EXPECT_EQ(B_RGB32, assigned.ColorSpace());
}


TEST(ColorMap, GraysWhiteAndTheTransparentEntryAreInTheirPlaces)
{
	const color_map* map = system_colors();
	for (int i = 0; i < 32; i++)
		EXPECT_EQ(make_color(i * 8, i * 8, i * 8), map->color_list[i]);
	EXPECT_EQ(make_color(255, 255, 255), map->color_list[63]);
	EXPECT_EQ(0, map->color_list[B_TRANSPARENT_8_BIT].alpha);
	EXPECT_EQ(63, map->index_map[32767]) << "white";
	EXPECT_EQ(0, map->index_map[0]) << "black";
	EXPECT_EQ(63, map->inversion_map[0]);
	EXPECT_EQ(0, map->inversion_map[63]);
	for (int i = 0; i < 32768; i++)
		ASSERT_NE(B_TRANSPARENT_8_BIT, map->index_map[i]) << "no colour is transparent";
}


TEST(ColorMap, BitmapsUseIt)
{
	BBitmap bitmap(BRect(0, 0, 2, 0), B_CMAP8);
	const uint32 pixels[] = { 0xffffffff, 0xff000000, 0x00123456 };
	ASSERT_EQ(B_OK, bitmap.ImportBits(pixels, sizeof(pixels), sizeof(pixels), 0, B_RGBA32));
	const uint8* bits = static_cast<const uint8*>(bitmap.Bits());
	EXPECT_EQ(63, bits[0]);
	EXPECT_EQ(0, bits[1]);
	EXPECT_EQ(B_TRANSPARENT_MAGIC_CMAP8, bits[2]);
}


TEST(ColorMap, EveryColourFindsItself)
{
	const color_map* map = system_colors();
	for (int i = 0; i < 255; i++) {
		const rgb_color color = map->color_list[i];
		const int index = color.red >> 3 << 10 | color.green >> 3 << 5 | color.blue >> 3;
		const rgb_color found = map->color_list[map->index_map[index]];
		EXPECT_NEAR(color.red, found.red, 12);
		EXPECT_NEAR(color.green, found.green, 12);
		EXPECT_NEAR(color.blue, found.blue, 12);
	}
}
