// A surface with a painter, and a plain way to look at pixels.
#pragma once

#include <functional>
#include <gtest/gtest.h>
#include <random>

#include "server/paint/Painter.h"


class PaintFixture {
public:
	explicit PaintFixture(int32 width = 64, int32 height = 64, float scale = 1) : painter(surface)
	{
		surface.SetTo(width, height, scale);
		painter.SetState(&state);
		Clear();
	}

	void Clear(uint32 pixel = 0xffffffff)
	{
		for (int32 y = 0; y < surface.DeviceHeight(); y++)
			std::fill_n(surface.Row(y), surface.DeviceWidth(), pixel);
	}

	void Randomize(std::mt19937& random)
	{
		for (int32 y = 0; y < surface.DeviceHeight(); y++) {
			for (int32 x = 0; x < surface.DeviceWidth(); x++)
				surface.Row(y)[x] = 0xff000000 | (random() & 0xffffff);
		}
	}

	uint32 At(int32 x, int32 y) const { return surface.Row(y)[x]; }

	// All device pixels that are not white, by whether they should be.
	void ExpectInk(std::function<bool(int32 x, int32 y)> expected) const
	{
		for (int32 y = 0; y < surface.DeviceHeight(); y++) {
			for (int32 x = 0; x < surface.DeviceWidth(); x++)
				ASSERT_EQ(expected(x, y), At(x, y) != 0xffffffff) << x << ", " << y;
		}
	}

	BPrivate::Surface surface;
	BPrivate::Painter painter;
	BPrivate::DrawState state;
};

inline bool
IsIn(int32 x, int32 y, const clipping_rect& rect)
{
	return x >= rect.left && x <= rect.right && y >= rect.top && y <= rect.bottom;
}
