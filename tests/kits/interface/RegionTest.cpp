#include <Region.h>

#include <gtest/gtest.h>
#include <random>
#include <vector>

namespace {

constexpr int32 kSide = 40;

// A region as a plain bitmap.
class Bitmap {
public:
	Bitmap() : fPixels(kSide * kSide, false) {}

	bool Get(int32 x, int32 y) const
	{
		return x >= 0 && y >= 0 && x < kSide && y < kSide && fPixels[y * kSide + x];
	}
	void Set(const clipping_rect& rect)
	{
		for (int32 y = rect.top; y <= rect.bottom; y++) {
			for (int32 x = rect.left; x <= rect.right; x++)
				fPixels[y * kSide + x] = true;
		}
	}
	template<class Function> void Combine(const Bitmap& other, Function function)
	{
		for (size_t i = 0; i < fPixels.size(); i++)
			fPixels[i] = function(fPixels[i], other.fPixels[i]);
	}

private:
	std::vector<bool> fPixels;
};


std::mt19937 sRandom(7);


int32
Random(int32 count)
{
	return sRandom() % count;
}


clipping_rect
RandomRect()
{
	const int32 left = Random(kSide);
	const int32 top = Random(kSide);
	return { left, top, left + Random(kSide - left), top + Random(kSide - top) };
}


void
RandomRegion(BRegion& region, Bitmap& bitmap)
{
	for (int32 i = Random(8); i > 0; i--) {
		const clipping_rect rect = RandomRect();
		region.Include(rect);
		bitmap.Set(rect);
	}
}


void
ExpectSame(const BRegion& region, const Bitmap& bitmap)
{
	Bitmap drawn;
	for (int32 i = 0; i < region.CountRects(); i++)
		drawn.Set(region.RectAtInt(i));
	for (int32 y = 0; y < kSide; y++) {
		for (int32 x = 0; x < kSide; x++) {
			ASSERT_EQ(bitmap.Get(x, y), drawn.Get(x, y)) << x << ", " << y;
			ASSERT_EQ(bitmap.Get(x, y), region.Contains(x, y)) << x << ", " << y;
		}
	}
}


// Sorted bands, no two rectangles of a band touch, no two bands could be one.
void
ExpectCanonical(const BRegion& region)
{
	BRect bounds;
	for (int32 i = 0; i < region.CountRects(); i++) {
		const clipping_rect rect = region.RectAtInt(i);
		ASSERT_TRUE(region.RectAt(i).IsValid());
		bounds = i == 0 ? region.RectAt(i) : bounds | region.RectAt(i);
		if (i == 0)
			continue;
		const clipping_rect last = region.RectAtInt(i - 1);
		if (rect.top == last.top) {
			ASSERT_EQ(last.bottom, rect.bottom);
			ASSERT_GT(rect.left, last.right + 1);
		} else
			ASSERT_GT(rect.top, last.bottom);
	}
	ASSERT_EQ(bounds, region.Frame());
}

} // namespace


TEST(Region, DefaultIsEmpty)
{
	const BRegion region;

	EXPECT_EQ(0, region.CountRects());
	EXPECT_FALSE(region.Frame().IsValid());
	EXPECT_FALSE(region.Contains(BPoint(0, 0)));
}


TEST(Region, InvalidRectGivesEmptyRegion)
{
	EXPECT_EQ(0, BRegion(BRect(0, 0, -1, 5)).CountRects());
}


TEST(Region, FractionsAreRoundedOutwards)
{
	EXPECT_EQ(BRect(1, 2, 5, 7), BRegion(BRect(1.4f, 2.9f, 4.1f, 6.5f)).Frame());
}


TEST(Region, RandomOperationsAgreeWithBitmaps)
{
	for (int i = 0; i < 2000; i++) {
		BRegion a, b;
		Bitmap bitmapA, bitmapB;
		RandomRegion(a, bitmapA);
		RandomRegion(b, bitmapB);
		switch (i % 4) {
			case 0:
				a.Include(&b);
				bitmapA.Combine(bitmapB, [](bool x, bool y) { return x || y; });
				break;
			case 1:
				a.Exclude(&b);
				bitmapA.Combine(bitmapB, [](bool x, bool y) { return x && !y; });
				break;
			case 2:
				a.IntersectWith(&b);
				bitmapA.Combine(bitmapB, [](bool x, bool y) { return x && y; });
				break;
			case 3:
				a.ExclusiveInclude(&b);
				bitmapA.Combine(bitmapB, [](bool x, bool y) { return x != y; });
				break;
		}
		ExpectSame(a, bitmapA);
		ExpectCanonical(a);
		if (testing::Test::HasFatalFailure())
			return;
	}
}


TEST(Region, SamePixelsHaveOneForm)
{
	for (int i = 0; i < 300; i++) {
		std::vector<clipping_rect> rects(1 + Random(6));
		for (clipping_rect& rect : rects)
			rect = RandomRect();

		BRegion forwards, backwards;
		for (const clipping_rect& rect : rects)
			forwards.Include(rect);
		for (size_t k = rects.size(); k > 0; k--)
			backwards.Include(rects[k - 1]);

		ASSERT_EQ(forwards, backwards);
	}
}


TEST(Region, IntersectsAgreesWithIntersection)
{
	for (int i = 0; i < 1000; i++) {
		BRegion region;
		Bitmap bitmap;
		RandomRegion(region, bitmap);
		const clipping_rect rect = RandomRect();

		BRegion common;
		common.Set(rect);
		common.IntersectWith(&region);

		ASSERT_EQ(common.CountRects() > 0, region.Intersects(rect));
	}
}


TEST(Region, OffsetMovesEveryRectangle)
{
	BRegion region(BRect(0, 0, 9, 9));
	region.Exclude(BRect(3, 3, 5, 5));
	BRegion moved(region);

	moved.OffsetBy(20, -7);

	ASSERT_EQ(region.CountRects(), moved.CountRects());
	for (int32 i = 0; i < region.CountRects(); i++)
		EXPECT_EQ(region.RectAt(i).OffsetByCopy(20, -7), moved.RectAt(i));
	EXPECT_EQ(BRect(20, -7, 29, 2), moved.Frame());
}


TEST(Region, CombiningWithItselfIsSafe)
{
	BRegion region(BRect(0, 0, 9, 9));
	region.Exclude(BRect(3, 3, 5, 5));
	const BRegion before(region);

	region.Include(&region);
	EXPECT_EQ(before, region);
	region.IntersectWith(&region);
	EXPECT_EQ(before, region);
	region.Exclude(&region);
	EXPECT_EQ(0, region.CountRects());
}


TEST(Region, HugeAndOddNumbersAreLimited)
{
	BRegion region(BRect(-INFINITY, -1e30f, INFINITY, 1e30f));
	EXPECT_EQ(1, region.CountRects());
	EXPECT_TRUE(region.Contains(0, 0));
	region.Exclude(BRect(0, 0, 0, 0));
	EXPECT_EQ(4, region.CountRects());
	region.OffsetBy(2000000000, 2000000000);

	EXPECT_EQ(0, BRegion(BRect(NAN, NAN, NAN, NAN)).CountRects());
}
