#include "server/paint/Surface.h"

#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>

#include <gtest/gtest.h>
#include <vector>

#include "server/paint/ImageDecoder.h"

using namespace BPrivate;


TEST(Surface, EdgesOfNeighboursMeet)
{
	for (float scale : { 1.0f, 1.1f, 1.25f, 1.5f, 1.75f, 2.0f, 3.0f }) {
		for (int32 i = -50; i < 200; i++) {
			const clipping_rect here = Surface::ToDevice({ i, i, i, i }, scale);
			const clipping_rect next = Surface::ToDevice({ i + 1, i, i + 1, i }, scale);
			EXPECT_EQ(here.right + 1, next.left);
			EXPECT_LE(here.left, here.right);
			for (int32 device = here.left; device <= here.right; device++)
				EXPECT_EQ(i, Surface::LogicalAt(device, scale));
		}
	}
}


TEST(Surface, HasTheDevicePixelsOfItsLastLogicalOne)
{
	Surface surface;
	ASSERT_EQ(B_OK, surface.SetTo(101, 33, 1.25f));
	EXPECT_EQ(Surface::DeviceEdge(101, 1.25f), surface.DeviceWidth());
	EXPECT_EQ(Surface::DeviceEdge(33, 1.25f), surface.DeviceHeight());
}


TEST(Surface, BadSizesAreRefused)
{
	Surface surface;
	EXPECT_NE(B_OK, surface.SetTo(0, 5));
	EXPECT_NE(B_OK, surface.SetTo(5, -1));
	EXPECT_NE(B_OK, surface.SetTo(40000, 1));
	EXPECT_NE(B_OK, surface.SetTo(5, 5, 0));
	EXPECT_FALSE(surface.IsValid());
}


TEST(Surface, ResizingKeepsWhatBothShare)
{
	Surface surface;
	surface.SetTo(10, 10);
	surface.Row(5)[5] = 0xff123456;
	surface.Resize(20, 6, 1);
	EXPECT_EQ(0xff123456, surface.Row(5)[5]);
	EXPECT_EQ(0u, surface.Row(5)[15]);
	EXPECT_EQ(make_color(0x12, 0x34, 0x56), surface.PixelAt(5, 5));
}


TEST(Surface, WrapsForeignMemory)
{
	std::vector<uint32> bits(8 * 4);
	Surface surface;
	ASSERT_EQ(B_OK, surface.Wrap(bits.data(), 6, 4, 32, SurfaceFormat::kAlpha));
	surface.Row(2)[3] = 7;
	EXPECT_EQ(7u, bits[2 * 8 + 3]);
	EXPECT_NE(B_OK, surface.Wrap(bits.data(), 9, 4, 32, SurfaceFormat::kAlpha));
}


TEST(Surface, CopiesOnlyTheRegion)
{
	Surface from, to;
	from.SetTo(10, 10, 1.5f);
	to.SetTo(10, 10, 1.5f);
	for (int32 y = 0; y < from.DeviceHeight(); y++)
		std::fill_n(from.Row(y), from.DeviceWidth(), 9);
	to.CopyFrom(from, BRegion(BRect(2, 3, 4, 5)));
	const clipping_rect copied = to.ToDevice({ 2, 3, 4, 5 });
	for (int32 y = 0; y < to.DeviceHeight(); y++) {
		for (int32 x = 0; x < to.DeviceWidth(); x++) {
			const bool inside =
				x >= copied.left && x <= copied.right && y >= copied.top && y <= copied.bottom;
			EXPECT_EQ(inside ? 9u : 0u, to.Row(y)[x]);
		}
	}
}


TEST(Surface, APictureFileReadsBackPixelByPixel)
{
	Surface surface;
	ASSERT_EQ(B_OK, surface.SetTo(37, 5));
	for (int32 y = 0; y < 5; y++) {
		for (int32 x = 0; x < 37; x++)
			surface.Row(y)[x] = (uint32)x * 0x07050301u + (uint32)y * 0x00ff1133u;
	}
	const std::string path = testing::TempDir() + "surface.png";
	for (const bool alpha : { true, false }) {
		ASSERT_EQ(B_OK, surface.WritePng(path.c_str(), alpha));
		std::ifstream file(path, std::ios::binary);
		const std::string bytes { std::istreambuf_iterator<char>(file), {} };
		Result<DecodedImage> image = DecodeImage(bytes.data(), bytes.size());
		ASSERT_TRUE(image);
		ASSERT_EQ(37, image->surface->DeviceWidth());
		ASSERT_EQ(5, image->surface->DeviceHeight());
		for (int32 y = 0; y < 5; y++) {
			for (int32 x = 0; x < 37; x++) {
				const uint32 expected = surface.Row(y)[x] | (alpha ? 0 : 0xff000000);
				ASSERT_EQ(expected, image->surface->Row(y)[x]) << x << ", " << y;
			}
		}
	}
	std::remove(path.c_str());
}
