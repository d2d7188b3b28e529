// Each drawing mode against its formula, written down once more as plainly as can be.
#include <algorithm>

#include "PaintFixture.h"

using namespace BPrivate;

namespace {

struct Colors {
	rgb_color high;
	rgb_color low;
};


int
Luminance(rgb_color color)
{
	return 77 * color.red + 150 * color.green + 29 * color.blue;
}


bool
SameColor(rgb_color a, rgb_color b)
{
	return a.red == b.red && a.green == b.green && a.blue == b.blue;
}


template<typename Function>
rgb_color
Each(rgb_color d, rgb_color s, Function function)
{
	return make_color(function(d.red, s.red), function(d.green, s.green), function(d.blue, s.blue));
}


// d is what is there, s the source pixel; `leaves` says that the mode does nothing here.
rgb_color
Expected(const DrawState& state, rgb_color d, rgb_color s, bool leaves)
{
	const bool keepsHere = state.mode == B_OP_OVER || state.mode == B_OP_ERASE
		|| state.mode == B_OP_INVERT || state.mode == B_OP_SELECT;
	if (keepsHere && leaves)
		return d;
	switch (state.mode) {
		case B_OP_COPY:
		case B_OP_OVER:
			return s;
		case B_OP_ERASE:
			return state.lowColor;
		case B_OP_INVERT:
			return Each(d, s, [](int x, int) { return 255 - x; });
		case B_OP_ADD:
			return Each(d, s, [](int x, int y) { return std::min(255, x + y); });
		case B_OP_SUBTRACT:
			return Each(d, s, [](int x, int y) { return std::max(0, x - y); });
		case B_OP_BLEND:
			return Each(d, s, [](int x, int y) { return (x + y) / 2; });
		case B_OP_MIN:
			return Luminance(s) < Luminance(d) ? s : d;
		case B_OP_MAX:
			return Luminance(s) > Luminance(d) ? s : d;
		case B_OP_SELECT:
			if (SameColor(d, state.highColor))
				return state.lowColor;
			return SameColor(d, state.lowColor) ? state.highColor : d;
		case B_OP_ALPHA: {
			const int alpha =
				state.sourceAlpha == B_CONSTANT_ALPHA ? state.highColor.alpha : s.alpha;
			return Each(d, s, [alpha](int x, int y) { return x + (y - x) * alpha / 255; });
		}
	}
	return d;
}


rgb_color
RandomColor(std::mt19937& random, uint8 alpha = 255)
{
	const uint32 bits = random();
	return make_color(bits, bits >> 8, bits >> 16, alpha);
}


// Some pixels are the very colours that B_OP_SELECT looks for.
void
SprinkleColors(PaintFixture& fixture, std::mt19937& random)
{
	for (int i = 0; i < 400; i++) {
		const rgb_color color = random() % 2 ? fixture.state.highColor : fixture.state.lowColor;
		fixture.surface.Row(random() % 64)[random() % 64] = ToPixel(color) | 0xff000000;
	}
}

} // namespace


class DrawingMode : public testing::TestWithParam<int> {};


TEST_P(DrawingMode, FillsByItsFormulaWithAnyPattern)
{
	std::mt19937 random(GetParam());
	for (int round = 0; round < 20; round++) {
		PaintFixture fixture;
		fixture.state.mode = (drawing_mode)GetParam();
		const bool usesAlpha = fixture.state.mode == B_OP_ALPHA;
		fixture.state.highColor = RandomColor(random, usesAlpha ? random() : 255);
		fixture.state.lowColor = RandomColor(random, usesAlpha ? random() : 255);
		fixture.state.sourceAlpha = round % 2 ? B_CONSTANT_ALPHA : B_PIXEL_ALPHA;
		fixture.Randomize(random);
		SprinkleColors(fixture, random);
		PaintFixture before;
		before.surface.CopyFrom(fixture.surface, BRegion(BRect(0, 0, 63, 63)));

		pattern pattern = B_SOLID_HIGH;
		if (round % 3 == 1)
			pattern = B_SOLID_LOW;
		if (round % 3 == 2)
			std::generate_n(pattern.data, 8, [&random]() { return (uint8)random(); });
		const BPoint origin(5, 3);
		fixture.painter.SetTransform(origin);
		fixture.painter.FillRect(BRect(-1, 2, 50, 40), pattern);

		for (int32 y = 0; y < 64; y++) {
			for (int32 x = 0; x < 64; x++) {
				const rgb_color d = before.surface.PixelAt(x, y);
				rgb_color expected = d;
				if (x >= 4 && x <= 55 && y >= 5 && y <= 43) {
					const int32 viewX = x - 5 + 8;
					const int32 viewY = y - 3 + 8;
					const bool bit = pattern.data[viewY % 8] >> (7 - viewX % 8) & 1;
					expected = Expected(fixture.state, d,
						bit ? fixture.state.highColor : fixture.state.lowColor, !bit);
				}
				ASSERT_TRUE(SameColor(expected, fixture.surface.PixelAt(x, y)))
					<< x << ", " << y << " round " << round;
			}
		}
	}
}


TEST_P(DrawingMode, DrawsBitmapsByItsFormula)
{
	std::mt19937 random(100 + GetParam());
	for (int round = 0; round < 10; round++) {
		PaintFixture fixture;
		fixture.state.mode = (drawing_mode)GetParam();
		fixture.state.highColor = RandomColor(random, random());
		fixture.state.lowColor = RandomColor(random);
		fixture.state.sourceAlpha = round % 2 ? B_CONSTANT_ALPHA : B_PIXEL_ALPHA;
		fixture.Randomize(random);
		SprinkleColors(fixture, random);
		PaintFixture before;
		before.surface.CopyFrom(fixture.surface, BRegion(BRect(0, 0, 63, 63)));
		Surface bitmap;
		bitmap.SetTo(32, 32);
		for (int32 i = 0; i < 32 * 32; i++) {
			const uint32 alpha = std::min<uint32>(255, random() % 3 * 100);
			bitmap.Row(i / 32)[i % 32] = alpha << 24 | (random() & 0xffffff);
		}

		fixture.painter.DrawBitmap(bitmap, BRect(0, 0, 31, 31), BRect(10, 20, 41, 51));

		for (int32 y = 0; y < 64; y++) {
			for (int32 x = 0; x < 64; x++) {
				const rgb_color d = before.surface.PixelAt(x, y);
				rgb_color expected = d;
				if (IsIn(x, y, { 10, 20, 41, 51 })) {
					const rgb_color s = bitmap.PixelAt(x - 10, y - 20);
					if (s.alpha != 0 || fixture.state.mode == B_OP_COPY)
						expected = Expected(fixture.state, d, s, false);
				}
				ASSERT_TRUE(SameColor(expected, fixture.surface.PixelAt(x, y)))
					<< x << ", " << y << " round " << round;
			}
		}
	}
}


TEST_P(DrawingMode, FractionalScalesPaintEachPixelOnce)
{
	for (float scale : { 1.25f, 1.5f, 1.75f, 2.0f }) {
		std::mt19937 random(GetParam());
		PaintFixture fixture(40, 40, scale);
		fixture.state.mode = (drawing_mode)GetParam();
		fixture.state.highColor = RandomColor(random);
		fixture.state.lowColor = RandomColor(random);
		fixture.Randomize(random);
		PaintFixture before(40, 40, scale);
		before.surface.CopyFrom(fixture.surface, BRegion(BRect(0, 0, 39, 39)));

		// Neighbours side by side must be one large rectangle.
		for (int32 y = 0; y < 40; y += 5) {
			for (int32 x = 0; x < 40; x += 4)
				fixture.painter.FillRect(BRect(x, y, x + 3, y + 4), B_MIXED_COLORS);
		}

		for (int32 y = 0; y < fixture.surface.DeviceHeight(); y++) {
			for (int32 x = 0; x < fixture.surface.DeviceWidth(); x++) {
				const int32 logicalX = fixture.surface.LogicalAt(x);
				const int32 logicalY = fixture.surface.LogicalAt(y);
				const bool bit = B_MIXED_COLORS.data[logicalY % 8] >> (7 - logicalX % 8) & 1;
				const rgb_color expected = Expected(fixture.state, ToColor(before.At(x, y)),
					bit ? fixture.state.highColor : fixture.state.lowColor, !bit);
				ASSERT_TRUE(SameColor(expected, ToColor(fixture.At(x, y)))) << x << ", " << y;
			}
		}
	}
}

INSTANTIATE_TEST_SUITE_P(All, DrawingMode, testing::Range<int>(B_OP_COPY, B_OP_ALPHA + 1));


TEST(DrawingModes, CompositeAlphaKeepsTheResultsOwnAlpha)
{
	PaintFixture fixture;
	fixture.Clear(0);
	fixture.state.mode = B_OP_ALPHA;
	fixture.state.highColor = make_color(200, 100, 50, 128);
	fixture.state.alphaFunction = B_ALPHA_COMPOSITE;

	fixture.painter.FillRect(BRect(0, 0, 9, 9));

	EXPECT_EQ(make_color(200, 100, 50, 128), fixture.surface.PixelAt(5, 5));
	EXPECT_EQ(0u, fixture.At(10, 10));
}


TEST(DrawingModes, SmoothEdgesOnTransparentGroundKeepTheirColour)
{
	PaintFixture fixture;
	fixture.Clear(0);
	fixture.state.highColor = make_color(200, 100, 50);

	fixture.painter.FillEllipse(BRect(4, 4, 30, 30));

	int32 smooth = 0;
	for (int32 y = 0; y < 64; y++) {
		for (int32 x = 0; x < 64; x++) {
			const rgb_color color = fixture.surface.PixelAt(x, y);
			if (color.alpha == 0)
				continue;
			smooth += color.alpha != 255;
			EXPECT_NEAR(200, color.red, 2);
			EXPECT_NEAR(100, color.green, 2);
		}
	}
	EXPECT_GT(smooth, 10);
}


TEST(DrawingModes, InvertingTwiceRestoresEverything)
{
	std::mt19937 random(3);
	PaintFixture fixture;
	fixture.Randomize(random);
	PaintFixture before;
	before.surface.CopyFrom(fixture.surface, BRegion(BRect(0, 0, 63, 63)));

	fixture.painter.InvertRect(BRect(3, 4, 40, 50));
	EXPECT_EQ(before.At(10, 10) ^ 0xffffff, fixture.At(10, 10));
	fixture.painter.InvertRect(BRect(3, 4, 40, 50));

	for (int32 y = 0; y < 64; y++) {
		for (int32 x = 0; x < 64; x++)
			ASSERT_EQ(before.At(x, y), fixture.At(x, y));
	}
}


TEST(DrawingModes, BitmapsWithoutAlphaHaveOneTransparentColour)
{
	PaintFixture fixture;
	Surface bitmap;
	bitmap.SetTo(2, 1, 1, SurfaceFormat::kOpaque);
	bitmap.Row(0)[0] = 0x00777477;
	bitmap.Row(0)[1] = 0x00102030;
	fixture.state.mode = B_OP_OVER;

	fixture.painter.DrawBitmap(bitmap, BRect(0, 0, 1, 0), BRect(0, 0, 1, 0));

	EXPECT_EQ(0xffffffff, fixture.At(0, 0));
	EXPECT_EQ(0xff102030, fixture.At(1, 0));
}
