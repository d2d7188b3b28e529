// What a painter leaves alone, what it says of it, and the pixels that it takes from elsewhere.
#include "server/paint/Painter.h"

#include <algorithm>
#include <math.h>

#include "PaintFixture.h"

using namespace BPrivate;


TEST(Painter, NothingIsPaintedOutsideTheClip)
{
	std::mt19937 random(11);
	for (float scale : { 1.0f, 1.25f, 1.5f, 2.0f }) {
		PaintFixture fixture(64, 64, scale);
		BRegion clip;
		for (int i = 0; i < 8; i++) {
			const float left = random() % 60, top = random() % 60;
			clip.Include(BRect(left, top, left + random() % 20, top + random() % 20));
		}
		fixture.painter.SetClip(&clip);
		fixture.painter.FillRect(BRect(-10, -10, 100, 100));
		fixture.ExpectInk([&](int32 x, int32 y) {
			return clip.Contains(fixture.surface.LogicalAt(x), fixture.surface.LogicalAt(y));
		});
		fixture.Clear();
		fixture.painter.FillEllipse(BRect(0, 0, 63, 63));
		fixture.painter.StrokeLine(BPoint(0, 0), BPoint(63, 40));
		fixture.painter.DrawString("clipped text everywhere", BPoint(0, 30));
		for (int32 y = 0; y < fixture.surface.DeviceHeight(); y++) {
			for (int32 x = 0; x < fixture.surface.DeviceWidth(); x++) {
				if (fixture.At(x, y) != 0xffffffff) {
					ASSERT_TRUE(
						clip.Contains(fixture.surface.LogicalAt(x), fixture.surface.LogicalAt(y)));
				}
			}
		}
	}
}


TEST(Painter, EmptyClipPaintsNothing)
{
	PaintFixture fixture;
	const BRegion clip;
	fixture.painter.SetClip(&clip);
	fixture.painter.FillRect(BRect(0, 0, 63, 63));
	fixture.painter.DrawString("nothing", BPoint(5, 20));
	fixture.ExpectInk([](int32, int32) { return false; });
	EXPECT_FALSE(fixture.painter.HasDamage());
}


TEST(Painter, DamageCoversEveryChangedPixel)
{
	std::mt19937 random(12);
	for (float scale : { 1.0f, 1.5f }) {
		for (int round = 0; round < 30; round++) {
			PaintFixture fixture(64, 64, scale);
			for (int i = 0; i < 40; i++) {
				const BPoint a(random() % 64, random() % 64);
				const BPoint b(random() % 64, random() % 64);
				switch (random() % 5) {
					case 0:
						fixture.painter.StrokeLine(a, b);
						break;
					case 1:
						fixture.painter.FillRect(BRect(a, a + BPoint(3, 2)));
						break;
					case 2:
						fixture.painter.StrokeEllipse(BRect(a, a + BPoint(9, 9)));
						break;
					case 3:
						fixture.painter.DrawString("x", a);
						break;
					case 4:
						fixture.painter.FillTriangle(a, b, BPoint(a.x, b.y));
						break;
				}
			}
			BRegion damage;
			fixture.painter.TakeDamage(&damage);
			for (int32 y = 0; y < fixture.surface.DeviceHeight(); y++) {
				for (int32 x = 0; x < fixture.surface.DeviceWidth(); x++) {
					if (fixture.At(x, y) != 0xffffffff) {
						ASSERT_TRUE(damage.Contains(
							fixture.surface.LogicalAt(x), fixture.surface.LogicalAt(y)));
					}
				}
			}
			fixture.painter.TakeDamage(&damage);
			ASSERT_EQ(0, damage.CountRects());
		}
	}
}


TEST(Painter, DamageOfFewRectsIsExact)
{
	PaintFixture fixture;
	fixture.painter.FillRect(BRect(0, 0, 9, 9));
	fixture.painter.FillRect(BRect(40, 40, 49, 49));
	fixture.painter.FillRect(BRect(2, 2, 4, 4));
	BRegion damage;
	fixture.painter.TakeDamage(&damage);

	BRegion expected(BRect(0, 0, 9, 9));
	expected.Include(BRect(40, 40, 49, 49));
	EXPECT_EQ(expected, damage);
}


// #pragma mark - bitmaps and moving pixels


TEST(Painter, StretchedBitmapRepeatsWholePixels)
{
	PaintFixture fixture;
	Surface bitmap;
	bitmap.SetTo(2, 2);
	const uint32 pixels[] = { 0xff000001, 0xff000002, 0xff000003, 0xff000004 };
	std::copy_n(pixels, 2, bitmap.Row(0));
	std::copy_n(pixels + 2, 2, bitmap.Row(1));

	fixture.painter.DrawBitmap(bitmap, BRect(0, 0, 1, 1), BRect(10, 10, 15, 17));

	for (int32 y = 10; y <= 17; y++) {
		for (int32 x = 10; x <= 15; x++)
			ASSERT_EQ(pixels[(y >= 14 ? 2 : 0) + (x >= 13 ? 1 : 0)], fixture.At(x, y));
	}
	EXPECT_EQ(0xffffffff, fixture.At(16, 10));
}


TEST(Painter, PartsOutsideOfTheBitmapAreNotDrawn)
{
	PaintFixture fixture;
	Surface bitmap;
	bitmap.SetTo(4, 4);
	fixture.painter.DrawBitmap(bitmap, BRect(-2, -2, 5, 5), BRect(10, 10, 17, 17));
	fixture.ExpectInk([](int32 x, int32 y) { return IsIn(x, y, { 12, 12, 15, 15 }); });
}


TEST(Painter, TilesFillTheAreaOnAllSides)
{
	for (float scale : { 1.0f, 1.25f, 2.0f }) {
		PaintFixture fixture(60, 60, scale);
		Surface bitmap;
		bitmap.SetTo(7, 5);
		for (int32 i = 0; i < 35; i++)
			bitmap.Row(i / 7)[i % 7] = 0xff000000 | i;
		fixture.painter.DrawTiled(
			bitmap, BRect(0, 0, 6, 4), BRect(20, 21, 26, 25), BRect(2, 3, 50, 55), B_TILE_BITMAP);
		for (int32 y = 0; y < fixture.surface.DeviceHeight(); y++) {
			for (int32 x = 0; x < fixture.surface.DeviceWidth(); x++) {
				const int32 logicalX = fixture.surface.LogicalAt(x);
				const int32 logicalY = fixture.surface.LogicalAt(y);
				uint32 expected = 0xffffffff;
				if (IsIn(logicalX, logicalY, { 2, 3, 50, 55 }))
					expected = bitmap.Row((logicalY - 21 + 50) % 5)[(logicalX - 20 + 70) % 7];
				ASSERT_EQ(expected, fixture.At(x, y)) << x << ", " << y;
			}
		}
	}
}


TEST(Painter, UntiledBitmapIsDrawnOnce)
{
	PaintFixture fixture;
	Surface bitmap;
	bitmap.SetTo(4, 4);
	fixture.painter.DrawTiled(
		bitmap, BRect(0, 0, 3, 3), BRect(10, 10, 13, 13), BRect(0, 0, 63, 63), 0);
	fixture.ExpectInk([](int32 x, int32 y) { return IsIn(x, y, { 10, 10, 13, 13 }); });
}


TEST(Painter, MovedPixelsAreThoseOfTheSource)
{
	std::mt19937 random(13);
	for (float scale : { 1.0f, 2.0f }) {
		for (int round = 0; round < 200; round++) {
			PaintFixture fixture(48, 48, scale), before(48, 48, scale);
			fixture.Randomize(random);
			before.surface.CopyFrom(fixture.surface, BRegion(BRect(0, 0, 47, 47)));
			BRegion clip(BRect(0, 0, 47, 47));
			for (int i = 0; i < 3; i++) {
				const float left = random() % 40, top = random() % 40;
				clip.Exclude(BRect(left, top, left + random() % 8, top + random() % 8));
			}
			fixture.painter.SetClip(&clip);
			const int32 dx = (int32)(random() % 21) - 10;
			const int32 dy = (int32)(random() % 21) - 10;
			const BRect source(5, 6, 35, 40);
			BRegion missing;

			fixture.painter.CopyBits(source, source.OffsetByCopy(dx, dy), &missing);

			for (int32 y = 0; y < fixture.surface.DeviceHeight(); y++) {
				for (int32 x = 0; x < fixture.surface.DeviceWidth(); x++) {
					const int32 logicalX = fixture.surface.LogicalAt(x);
					const int32 logicalY = fixture.surface.LogicalAt(y);
					const BPoint from(logicalX - dx, logicalY - dy);
					const bool target = clip.Contains(logicalX, logicalY) && source.Contains(from);
					const bool moved = target && clip.Contains(from);
					const int32 deviceX = x - dx * (int32)scale;
					const int32 deviceY = y - dy * (int32)scale;
					ASSERT_EQ(
						moved ? before.At(deviceX, deviceY) : before.At(x, y), fixture.At(x, y));
					ASSERT_EQ(target && !moved, missing.Contains(logicalX, logicalY));
				}
			}
		}
	}
}


TEST(Painter, MovesThatAreNoWholeDevicePixelsAreLeftToPainting)
{
	PaintFixture fixture(40, 40, 1.25f);
	BRegion missing;
	fixture.painter.CopyBits(BRect(0, 0, 9, 9), BRect(3, 0, 12, 9), &missing);
	EXPECT_EQ(BRegion(BRect(3, 0, 12, 9)), missing);
	fixture.painter.CopyBits(BRect(0, 0, 9, 9), BRect(4, 0, 13, 9), &missing);
	EXPECT_EQ(0, missing.CountRects());
}


TEST(Painter, OddNumbersAreSafe)
{
	const float odd[] = { NAN, INFINITY, -INFINITY, 1e30f, -1e30f, 1e9f, 70000.5f };
	for (float a : odd) {
		for (float b : odd) {
			PaintFixture fixture;
			fixture.painter.StrokeLine(BPoint(a, b), BPoint(b, 5));
			fixture.painter.FillRect(BRect(a, b, b, a));
			fixture.painter.StrokeRect(BRect(0, 0, a, b));
			fixture.painter.FillEllipse(BRect(-5, -5, a, b));
			fixture.painter.StrokeRoundRect(BRect(0, 0, a, b), a, b);
			fixture.painter.FillTriangle(BPoint(a, b), BPoint(0, 0), BPoint(b, a));
			fixture.painter.DrawString("text", BPoint(a, b));
			fixture.state.penSize = a;
			fixture.state.font.size = b;
			fixture.painter.StrokeLine(BPoint(0, 0), BPoint(50, 40));
			fixture.painter.DrawString("text", BPoint(5, 5));
			fixture.state.combinedScale = a;
			fixture.painter.StrokeEllipse(BRect(5, 5, 20, 20));
			fixture.painter.CopyBits(BRect(0, 0, a, b), BRect(5, 5, a, b));
		}
	}
}
