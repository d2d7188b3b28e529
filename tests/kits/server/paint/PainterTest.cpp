#include "server/paint/Painter.h"

#include <algorithm>
#include <math.h>

#include "PaintFixture.h"

using namespace BPrivate;


// #pragma mark - lines and rectangles


TEST(Painter, LineIncludesBothEnds)
{
	PaintFixture fixture;
	fixture.painter.StrokeLine(BPoint(3, 7), BPoint(12, 7));
	fixture.ExpectInk([](int32 x, int32 y) { return y == 7 && x >= 3 && x <= 12; });
}


TEST(Painter, LineOfOnePointIsOnePixel)
{
	PaintFixture fixture;
	fixture.painter.StrokeLine(BPoint(3, 7), BPoint(3, 7));
	fixture.ExpectInk([](int32 x, int32 y) { return x == 3 && y == 7; });
}


TEST(Painter, PenOfNoSizeIsOnePixel)
{
	PaintFixture fixture;
	fixture.state.penSize = 0;
	fixture.painter.StrokeLine(BPoint(5, 20), BPoint(5, 10));
	fixture.ExpectInk([](int32 x, int32 y) { return x == 5 && y >= 10 && y <= 20; });
}


TEST(Painter, PenOfTwoCoversTheCoordinateAndTheNext)
{
	PaintFixture fixture;
	fixture.state.penSize = 2;
	fixture.painter.StrokeLine(BPoint(3, 7), BPoint(12, 7));
	fixture.ExpectInk([](int32 x, int32 y) { return (y == 7 || y == 8) && x >= 3 && x <= 12; });
}


TEST(Painter, PenOfThreeIsCentred)
{
	PaintFixture fixture;
	fixture.state.penSize = 3;
	fixture.painter.StrokeLine(BPoint(7, 3), BPoint(7, 12));
	fixture.ExpectInk([](int32 x, int32 y) { return x >= 6 && x <= 8 && y >= 3 && y <= 12; });
}


TEST(Painter, DiagonalIsOnePixelAStep)
{
	PaintFixture fixture;
	fixture.painter.StrokeLine(BPoint(3, 3), BPoint(20, 20));
	fixture.ExpectInk([](int32 x, int32 y) { return x == y && x >= 3 && x <= 20; });
}


TEST(Painter, SlantedLineIsTheSameBothWays)
{
	std::mt19937 random(5);
	for (int i = 0; i < 200; i++) {
		const BPoint a(random() % 64, random() % 64);
		const BPoint b(random() % 64, random() % 64);
		PaintFixture there, back;
		there.painter.StrokeLine(a, b);
		back.painter.StrokeLine(b, a);

		EXPECT_NE(0xffffffff, there.At(a.x, a.y));
		EXPECT_NE(0xffffffff, there.At(b.x, b.y));
		there.ExpectInk([&](int32 x, int32 y) { return back.At(x, y) != 0xffffffff; });
	}
}


TEST(Painter, StrokedRectIsItsBorderAlone)
{
	PaintFixture fixture;
	fixture.painter.StrokeRect(BRect(5, 6, 20, 30));
	fixture.ExpectInk([](int32 x, int32 y) {
		return IsIn(x, y, { 5, 6, 20, 30 }) && !IsIn(x, y, { 6, 7, 19, 29 });
	});
}


TEST(Painter, FrameOfPenTwoStaysInsideBoundsLessOne)
{
	PaintFixture fixture;
	fixture.state.penSize = 2;
	fixture.painter.StrokeRect(BRect(0, 0, 40 - 1, 30 - 1));
	fixture.ExpectInk([](int32 x, int32 y) {
		return IsIn(x, y, { 0, 0, 40, 30 }) && !IsIn(x, y, { 2, 2, 38, 28 });
	});
}


TEST(Painter, StrokedCornersAreBlendedOnce)
{
	PaintFixture fixture;
	fixture.Clear(0xff000000);
	fixture.state.mode = B_OP_ADD;
	fixture.state.highColor = make_color(10, 10, 10);
	fixture.state.penSize = 3;
	fixture.painter.StrokeRect(BRect(10, 10, 30, 30));
	for (int32 y = 0; y < 64; y++) {
		for (int32 x = 0; x < 64; x++)
			ASSERT_LE(fixture.At(x, y) & 0xff, 10u);
	}
	EXPECT_EQ(10u, fixture.At(9, 9) & 0xff);
}


TEST(Painter, RectOneWideIsOneLine)
{
	PaintFixture fixture;
	fixture.painter.StrokeRect(BRect(5, 6, 5, 30));
	fixture.ExpectInk([](int32 x, int32 y) { return IsIn(x, y, { 5, 6, 5, 30 }); });
}


TEST(Painter, FilledRectIncludesRightAndBottom)
{
	PaintFixture fixture;
	fixture.painter.FillRect(BRect(5, 6, 20, 30));
	fixture.ExpectInk([](int32 x, int32 y) { return IsIn(x, y, { 5, 6, 20, 30 }); });
}


TEST(Painter, InvalidRectsPaintNothing)
{
	PaintFixture fixture;
	fixture.painter.FillRect(BRect(20, 6, 5, 30));
	fixture.painter.StrokeRect(BRect(20, 6, 5, 30));
	fixture.painter.FillEllipse(BRect());
	fixture.ExpectInk([](int32, int32) { return false; });
}


TEST(Painter, OriginAndScaleOfTheStateApply)
{
	PaintFixture fixture;
	fixture.state.combinedOrigin = BPoint(4, 5);
	fixture.state.combinedScale = 2;
	fixture.painter.SetTransform(BPoint(10, 10));
	fixture.painter.FillRect(BRect(1, 1, 5, 6));
	fixture.ExpectInk([](int32 x, int32 y) { return IsIn(x, y, { 16, 17, 24, 27 }); });
}


// #pragma mark - triangles and polygons


TEST(Painter, ResizeTriangleCoversItsEdges)
{
	PaintFixture fixture;
	const BRect bounds(0, 0, 50, 40);
	fixture.painter.FillTriangle(BPoint(bounds.right - 7, bounds.bottom - 2),
		BPoint(bounds.right - 2, bounds.bottom - 7), BPoint(bounds.right - 2, bounds.bottom - 2));
	fixture.ExpectInk([](int32 x, int32 y) {
		return IsIn(x, y, { 43, 33, 48, 38 }) && (x - 43) + (y - 33) >= 5;
	});
}


TEST(Painter, FillIncludesTheOutline)
{
	std::mt19937 random(9);
	for (int i = 0; i < 300; i++) {
		BPoint points[5];
		for (BPoint& point : points)
			point.Set(random() % 64, random() % 64);
		const int32 count = 1 + i % 5;
		PaintFixture filled, stroked;
		filled.painter.FillPolygon(points, count);
		stroked.painter.StrokePolygon(points, count);
		for (int32 y = 0; y < 64; y++) {
			for (int32 x = 0; x < 64; x++) {
				if (stroked.At(x, y) != 0xffffffff) {
					ASSERT_NE(0xffffffff, filled.At(x, y)) << x << ", " << y;
				}
			}
		}
	}
}


TEST(Painter, FillHasEveryPixelWhoseCentreIsInside)
{
	std::mt19937 random(10);
	for (int i = 0; i < 200; i++) {
		const BPoint a(random() % 64, random() % 64);
		const BPoint b(random() % 64, random() % 64);
		const BPoint c(random() % 64, random() % 64);
		auto side = [](BPoint p, BPoint q, int32 x, int32 y) {
			return (q.x - p.x) * (y - p.y) - (q.y - p.y) * (x - p.x);
		};
		PaintFixture fixture;
		fixture.painter.FillTriangle(a, b, c);
		for (int32 y = 0; y < 64; y++) {
			for (int32 x = 0; x < 64; x++) {
				const float s1 = side(a, b, x, y), s2 = side(b, c, x, y), s3 = side(c, a, x, y);
				const bool inside = (s1 > 0 && s2 > 0 && s3 > 0) || (s1 < 0 && s2 < 0 && s3 < 0);
				if (inside) {
					ASSERT_NE(0xffffffff, fixture.At(x, y)) << x << ", " << y;
				}
			}
		}
	}
}


TEST(Painter, DegeneratePolygonIsALine)
{
	PaintFixture fixture;
	const BPoint points[] = { BPoint(5, 5), BPoint(15, 5), BPoint(5, 5) };
	fixture.painter.FillPolygon(points, 3);
	fixture.ExpectInk([](int32 x, int32 y) { return y == 5 && x >= 5 && x <= 15; });
}


// #pragma mark - curves


TEST(Painter, EllipseFillsItsRectangleEdges)
{
	for (float scale : { 1.0f, 1.5f, 2.0f }) {
		PaintFixture fixture(64, 64, scale);
		fixture.painter.FillEllipse(BRect(10, 12, 40, 50));
		const clipping_rect device = fixture.surface.ToDevice({ 10, 12, 40, 50 });
		bool left = false, right = false, top = false, bottom = false;
		for (int32 y = 0; y < fixture.surface.DeviceHeight(); y++) {
			for (int32 x = 0; x < fixture.surface.DeviceWidth(); x++) {
				if (fixture.At(x, y) == 0xffffffff)
					continue;
				ASSERT_TRUE(IsIn(x, y, device)) << x << ", " << y;
				left |= x == device.left;
				right |= x == device.right;
				top |= y == device.top;
				bottom |= y == device.bottom;
			}
		}
		EXPECT_TRUE(left && right && top && bottom);
	}
}


TEST(Painter, StrokedEllipseLeavesTheMiddle)
{
	PaintFixture fixture;
	fixture.painter.StrokeEllipse(BRect(10, 10, 40, 40));
	EXPECT_EQ(0xffffffff, fixture.At(25, 25));
	EXPECT_NE(0xffffffff, fixture.At(25, 10));
	EXPECT_NE(0xffffffff, fixture.At(40, 25));
	EXPECT_EQ(0xffffffff, fixture.At(10, 10));
}


TEST(Painter, ArcGoesAgainstTheClock)
{
	PaintFixture fixture;
	fixture.painter.FillArc(BRect(0, 0, 63, 63), 0, 90);
	EXPECT_EQ(0xff000000, fixture.At(45, 20));
	EXPECT_EQ(0xffffffff, fixture.At(20, 20));
	EXPECT_EQ(0xffffffff, fixture.At(45, 45));
}


TEST(Painter, CurvesFollowModesAndPatterns)
{
	PaintFixture fixture;
	fixture.state.mode = B_OP_INVERT;
	fixture.painter.FillEllipse(BRect(10, 10, 50, 50), B_MIXED_COLORS);
	EXPECT_EQ(0xff000000, fixture.At(30, 30));
	EXPECT_EQ(0xffffffff, fixture.At(31, 30));
}
