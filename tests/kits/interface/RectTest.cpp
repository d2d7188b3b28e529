#include <Rect.h>

#include <gtest/gtest.h>


TEST(Rect, DefaultIsNotValid)
{
	EXPECT_EQ(BRect(0, 0, -1, -1), BRect());
	EXPECT_FALSE(BRect().IsValid());
}


TEST(Rect, OnePixelHasNoWidth)
{
	const BRect rect(3, 4, 3, 4);

	EXPECT_TRUE(rect.IsValid());
	EXPECT_EQ(0, rect.Width());
	EXPECT_EQ(0, rect.Height());
}


TEST(Rect, InsetMovesAllSides)
{
	BRect rect(0, 0, 10, 20);
	rect.InsetBy(1, 2);
	EXPECT_EQ(BRect(1, 2, 9, 18), rect);
	EXPECT_EQ(BRect(-1, -1, 11, 21), rect.InsetByCopy(-2, -3));
}


TEST(Rect, OffsetToKeepsTheSize)
{
	EXPECT_EQ(BRect(5, 6, 15, 26), BRect(1, 2, 11, 22).OffsetToCopy(5, 6));
}


TEST(Rect, EdgesAreInside)
{
	const BRect rect(0, 0, 10, 10);

	EXPECT_TRUE(rect.Contains(BPoint(10, 0)));
	EXPECT_FALSE(rect.Contains(BPoint(10.5f, 0)));
	EXPECT_TRUE(rect.Intersects(BRect(10, 10, 20, 20)));
	EXPECT_FALSE(rect.Intersects(BRect(11, 0, 20, 20)));
}


TEST(Rect, IntersectionAndUnionWorkOnEdges)
{
	EXPECT_EQ(BRect(5, 5, 10, 10), BRect(0, 0, 10, 10) & BRect(5, 5, 20, 20));
	EXPECT_EQ(BRect(0, 0, 20, 20), BRect(0, 0, 10, 10) | BRect(5, 5, 20, 20));
}


TEST(Rect, IntegerSizesAreRoundedUp)
{
	EXPECT_EQ(11, BRect(0, 0, 10.2f, 10).IntegerWidth());
	EXPECT_EQ(10, BRect(0, 0, 10.2f, 10).IntegerHeight());
}


TEST(Point, IsConstrainedToTheNearestPlace)
{
	BPoint point(-5, 7);
	point.ConstrainTo(BRect(0, 0, 5, 5));
	EXPECT_EQ(BPoint(0, 5), point);
}
