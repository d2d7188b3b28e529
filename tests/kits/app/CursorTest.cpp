#include <Bitmap.h>
#include <Cursor.h>
#include <Point.h>

#include <gtest/gtest.h>


TEST(Cursor, TakesTheClassicData)
{
	unsigned char data[68] = { 16, 1, 3, 4 };
	data[10] = 0xff;

	const BCursor cursor(data);

	EXPECT_EQ(B_OK, cursor.InitCheck());
	EXPECT_TRUE(cursor == BCursor(data));
	data[10] = 0;
	EXPECT_TRUE(cursor != BCursor(data));
	EXPECT_TRUE(cursor != BCursor(B_CURSOR_ID_HELP));
	EXPECT_TRUE(BCursor(cursor) == cursor);
}


TEST(Cursor, RefusesDataOfAnotherShape)
{
	const unsigned char wrongSize[68] = { 32, 1, 0, 0 };
	const unsigned char wrongDepth[68] = { 16, 8, 0, 0 };
	const unsigned char wrongSpot[68] = { 16, 1, 16, 0 };

	EXPECT_EQ(B_BAD_VALUE, BCursor(wrongSize).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BCursor(wrongDepth).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BCursor(wrongSpot).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BCursor((const void*)NULL).InitCheck());
}


TEST(Cursor, TheClassicTwoAreTheDesktopsOwn)
{
	EXPECT_TRUE(BCursor(B_HAND_CURSOR) == *B_CURSOR_SYSTEM_DEFAULT);
	EXPECT_TRUE(BCursor(B_I_BEAM_CURSOR) == *B_CURSOR_I_BEAM);
	EXPECT_EQ(16, B_HAND_CURSOR[0]);
	EXPECT_EQ(16, B_I_BEAM_CURSOR[0]);
}


TEST(Cursor, IsMadeOfABitmap)
{
	BBitmap bitmap(BRect(0, 0, 31, 23), B_RGBA32);
	const BCursor cursor(&bitmap, BPoint(5, 20));
	EXPECT_EQ(B_OK, cursor.InitCheck());
	EXPECT_TRUE(BCursor(cursor) == cursor);
	EXPECT_TRUE(cursor != *B_CURSOR_SYSTEM_DEFAULT);

	BBitmap indexed(BRect(0, 0, 15, 15), B_CMAP8);
	EXPECT_EQ(B_OK, BCursor(&indexed, BPoint(15, 15)).InitCheck());
}


TEST(Cursor, RefusesABitmapWithoutItsHotSpot)
{
	BBitmap bitmap(BRect(0, 0, 31, 23), B_RGBA32);
	EXPECT_EQ(B_BAD_VALUE, BCursor(&bitmap, BPoint(5, 24)).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BCursor(&bitmap, BPoint(-1, 0)).InitCheck());
	BBitmap huge(BRect(0, 0, 256, 10), B_RGBA32);
	EXPECT_EQ(B_BAD_VALUE, BCursor(&huge, BPoint(0, 0)).InitCheck());
	EXPECT_EQ(B_BAD_VALUE, BCursor(static_cast<const BBitmap*>(NULL), BPoint(0, 0)).InitCheck());
}
