#include "server/paint/CoverageRaster.h"

#include <gtest/gtest.h>
#include <math.h>
#include <random>
#include <vector>

using namespace BPrivate;

namespace {

struct Corner {
	double x;
	double y;
};


std::vector<uint8>
Render(const std::vector<Corner>& corners, const clipping_rect& rect, bool evenOdd = false)
{
	CoverageRaster raster(rect);
	for (size_t i = 0; i < corners.size(); i++) {
		const Corner& from = corners[i];
		const Corner& to = corners[(i + 1) % corners.size()];
		raster.AddLine(from.x, from.y, to.x, to.y);
	}
	const uint8* coverage = raster.Finish(evenOdd);
	const size_t size = (size_t)(rect.right - rect.left + 1) * (rect.bottom - rect.top + 1);
	return std::vector<uint8>(coverage, coverage + size);
}


// By 16 x 16 samples a pixel.
int
Sampled(const std::vector<Corner>& corners, int32 x, int32 y, bool evenOdd)
{
	int inside = 0;
	for (int i = 0; i < 256; i++) {
		const double sampleX = x + (i % 16 + 0.5) / 16;
		const double sampleY = y + (i / 16 + 0.5) / 16;
		int winding = 0;
		for (size_t k = 0; k < corners.size(); k++) {
			const Corner& a = corners[k];
			const Corner& b = corners[(k + 1) % corners.size()];
			if ((a.y <= sampleY) == (b.y <= sampleY))
				continue;
			if (a.x + (b.x - a.x) * (sampleY - a.y) / (b.y - a.y) < sampleX)
				winding += a.y < b.y ? 1 : -1;
		}
		inside += evenOdd ? (winding & 1) : winding != 0;
	}
	return inside * 255 / 256;
}

} // namespace


TEST(CoverageRaster, CoverageIsTheArea)
{
	const std::vector<uint8> coverage =
		Render({ { 1.25, 1.5 }, { 3, 1.5 }, { 3, 3 }, { 1.25, 3 } }, { 0, 0, 3, 3 });
	EXPECT_EQ(0, coverage[0]);
	EXPECT_NEAR(255 * 0.75 * 0.5, coverage[1 * 4 + 1], 1);
	EXPECT_NEAR(255 * 0.5, coverage[1 * 4 + 2], 1);
	EXPECT_NEAR(255 * 0.75, coverage[2 * 4 + 1], 1);
	EXPECT_EQ(255, coverage[2 * 4 + 2]);
	EXPECT_EQ(0, coverage[2 * 4 + 3]);
}


TEST(CoverageRaster, AgreesWithSamples)
{
	std::mt19937 random(21);
	for (int round = 0; round < 100; round++) {
		// A triangle, whose edges cannot cross in ways that a sum of areas cannot tell.
		std::vector<Corner> corners(3);
		for (Corner& corner : corners)
			corner = { random() % 4000 / 100.0 - 8, random() % 4000 / 100.0 - 8 };
		const std::vector<uint8> coverage = Render(corners, { 0, 0, 23, 23 });
		for (int32 y = 0; y < 24; y++) {
			for (int32 x = 0; x < 24; x++) {
				ASSERT_NEAR(Sampled(corners, x, y, false), coverage[y * 24 + x], 20)
					<< x << ", " << y << " round " << round;
			}
		}
	}
}


TEST(CoverageRaster, PartsAreTheSameAsTheWhole)
{
	std::mt19937 random(22);
	for (int round = 0; round < 200; round++) {
		std::vector<Corner> corners(5);
		for (Corner& corner : corners)
			corner = { random() % 6000 / 100.0 - 15, random() % 6000 / 100.0 - 15 };
		const clipping_rect part = { (int32)(random() % 15), (int32)(random() % 15), 20, 22 };
		const bool evenOdd = round % 2 == 0;
		const std::vector<uint8> whole = Render(corners, { 0, 0, 31, 31 }, evenOdd);
		const std::vector<uint8> cut = Render(corners, part, evenOdd);
		const int32 width = part.right - part.left + 1;
		for (int32 y = part.top; y <= part.bottom; y++) {
			for (int32 x = part.left; x <= part.right; x++) {
				ASSERT_NEAR(whole[y * 32 + x], cut[(y - part.top) * width + x - part.left], 1);
			}
		}
	}
}


TEST(CoverageRaster, WindingDecidesWhatIsInside)
{
	// Twice round the same square.
	const std::vector<Corner> twice = { { 1, 1 }, { 3, 1 }, { 3, 3 }, { 1, 3 }, { 1, 1 }, { 3, 1 },
		{ 3, 3 }, { 1, 3 } };
	EXPECT_EQ(255, Render(twice, { 0, 0, 3, 3 }, false)[2 * 4 + 2]);
	EXPECT_EQ(0, Render(twice, { 0, 0, 3, 3 }, true)[2 * 4 + 2]);
}
