#include "interface/private/PixelFormat.h"

#include <string.h>

namespace BPrivate {

namespace {

constexpr uint32 kOpaque = 0xff000000;
constexpr uint32 kTransparent = 0x00777477;


uint32
Pixel(uint32 alpha, uint32 red, uint32 green, uint32 blue)
{
	return alpha << 24 | red << 16 | green << 8 | blue;
}


uint32
Red(uint32 pixel)
{
	return pixel >> 16 & 0xff;
}
uint32
Green(uint32 pixel)
{
	return pixel >> 8 & 0xff;
}
uint32
Blue(uint32 pixel)
{
	return pixel & 0xff;
}
uint32
Alpha(uint32 pixel)
{
	return pixel >> 24;
}


// Five or six bits to eight, so that the greatest value becomes 255.
uint32
From5(uint32 value)
{
	return (value & 31) << 3 | (value & 31) >> 2;
}
uint32
From6(uint32 value)
{
	return (value & 63) << 2 | (value & 63) >> 4;
}


// Numbers of `kBytes` bytes in either order.
template<int kBytes, bool kBig> struct Number {
	static uint64 Read(const uint8* at)
	{
		uint64 value = 0;
		for (int i = 0; i < kBytes; i++)
			value |= (uint64)at[i] << 8 * (kBig ? kBytes - 1 - i : i);
		return value;
	}
	static void Write(uint8* at, uint64 value)
	{
		for (int i = 0; i < kBytes; i++)
			at[i] = value >> 8 * (kBig ? kBytes - 1 - i : i);
	}
};


template<bool kBig, bool kHasAlpha> struct Rgb32 : Number<4, kBig> {
	static uint32 Decode(uint64 value)
	{
		if (kHasAlpha || value == kTransparent)
			return value;
		return value | kOpaque;
	}
	static uint64 Encode(uint32 pixel)
	{
		if (kHasAlpha)
			return pixel;
		return Alpha(pixel) < 128 ? kTransparent : (pixel | kOpaque);
	}
};


template<bool kBig> struct Rgb24 : Number<3, kBig> {
	static uint32 Decode(uint64 value) { return value | kOpaque; }
	static uint64 Encode(uint32 pixel) { return pixel & 0xffffff; }
};


template<bool kBig> struct Rgb16 : Number<2, kBig> {
	static uint32 Decode(uint64 value)
	{
		return Pixel(255, From5(value >> 11), From6(value >> 5), From5(value));
	}
	static uint64 Encode(uint32 pixel)
	{
		return Red(pixel) >> 3 << 11 | Green(pixel) >> 2 << 5 | Blue(pixel) >> 3;
	}
};


template<bool kBig, bool kHasAlpha> struct Rgb15 : Number<2, kBig> {
	static uint32 Decode(uint64 value)
	{
		if (value == B_TRANSPARENT_MAGIC_RGBA15)
			return kTransparent;
		const uint32 alpha = !kHasAlpha || (value & 0x8000) != 0 ? 255 : 0;
		return Pixel(alpha, From5(value >> 10), From5(value >> 5), From5(value));
	}
	static uint64 Encode(uint32 pixel)
	{
		const bool transparent = Alpha(pixel) < 128;
		if (transparent && !kHasAlpha)
			return B_TRANSPARENT_MAGIC_RGBA15;
		const uint64 color = Red(pixel) >> 3 << 10 | Green(pixel) >> 3 << 5 | Blue(pixel) >> 3;
		return kHasAlpha && !transparent ? color | 0x8000 : color;
	}
};


template<bool kBig> struct Rgb48 : Number<6, kBig> {
	static uint32 Decode(uint64 value)
	{
		return Pixel(255, value >> 40 & 0xff, value >> 24 & 0xff, value >> 8 & 0xff);
	}
	static uint64 Encode(uint32 pixel)
	{
		return (uint64)Red(pixel) * 257 << 32 | (uint64)Green(pixel) * 257 << 16
			| Blue(pixel) * 257;
	}
};


template<bool kBig> struct Rgba64 : Number<8, kBig> {
	static uint32 Decode(uint64 value)
	{
		return Pixel(value >> 56, value >> 40 & 0xff, value >> 24 & 0xff, value >> 8 & 0xff);
	}
	static uint64 Encode(uint32 pixel)
	{
		return (uint64)Alpha(pixel) * 257 << 48 | Rgb48<kBig>::Encode(pixel);
	}
};


struct Cmap8 : Number<1, false> {
	static uint32 Decode(uint64 value)
	{
		if (value == B_TRANSPARENT_MAGIC_CMAP8)
			return kTransparent;
		const rgb_color& color = system_colors()->color_list[value];
		return Pixel(255, color.red, color.green, color.blue);
	}
	static uint64 Encode(uint32 pixel)
	{
		if (Alpha(pixel) < 128)
			return B_TRANSPARENT_MAGIC_CMAP8;
		return system_colors()->index_map[Rgb15<false, false>::Encode(pixel | kOpaque)];
	}
};


struct Gray8 : Number<1, false> {
	static uint32 Decode(uint64 value) { return Pixel(255, value, value, value); }
	static uint64 Encode(uint32 pixel)
	{
		return (77 * Red(pixel) + 150 * Green(pixel) + 29 * Blue(pixel)) >> 8;
	}
};


template<typename Format, int kBytes>
void
Read(const uint8* row, int32 x, int32 count, uint32* pixels)
{
	row += (size_t)x * kBytes;
	for (int32 i = 0; i < count; i++, row += kBytes)
		pixels[i] = Format::Decode(Format::Read(row));
}


template<typename Format, int kBytes>
void
Write(uint8* row, int32 x, int32 count, const uint32* pixels)
{
	row += (size_t)x * kBytes;
	for (int32 i = 0; i < count; i++, row += kBytes)
		Format::Write(row, Format::Encode(pixels[i]));
}


// A set bit is black.
void
ReadGray1(const uint8* row, int32 x, int32 count, uint32* pixels)
{
	for (int32 i = 0; i < count; i++)
		pixels[i] = (row[(x + i) / 8] >> (7 - (x + i) % 8) & 1) != 0 ? kOpaque : 0xffffffff;
}


void
WriteGray1(uint8* row, int32 x, int32 count, const uint32* pixels)
{
	for (int32 i = 0; i < count; i++) {
		const uint8 bit = 1 << (7 - (x + i) % 8);
		uint8& byte = row[(x + i) / 8];
		byte = Gray8::Encode(pixels[i]) < 128 ? byte | bit : byte & ~bit;
	}
}


struct Format {
	color_space space;
	int bits;
	void (*read)(const uint8* row, int32 x, int32 count, uint32* pixels);
	void (*write)(uint8* row, int32 x, int32 count, const uint32* pixels);
};

template<typename Type, int kBytes>
constexpr Format
Make(color_space space)
{
	return { space, kBytes * 8, Read<Type, kBytes>, Write<Type, kBytes> };
}

constexpr Format kFormats[] = {
	Make<Rgb32<false, false>, 4>(B_RGB32),
	Make<Rgb32<false, true>, 4>(B_RGBA32),
	Make<Rgb32<true, false>, 4>(B_RGB32_BIG),
	Make<Rgb32<true, true>, 4>(B_RGBA32_BIG),
	Make<Rgb24<false>, 3>(B_RGB24),
	Make<Rgb24<true>, 3>(B_RGB24_BIG),
	Make<Rgb16<false>, 2>(B_RGB16),
	Make<Rgb16<true>, 2>(B_RGB16_BIG),
	Make<Rgb15<false, false>, 2>(B_RGB15),
	Make<Rgb15<true, false>, 2>(B_RGB15_BIG),
	Make<Rgb15<false, true>, 2>(B_RGBA15),
	Make<Rgb15<true, true>, 2>(B_RGBA15_BIG),
	Make<Rgb48<false>, 6>(B_RGB48),
	Make<Rgb48<true>, 6>(B_RGB48_BIG),
	Make<Rgba64<false>, 8>(B_RGBA64),
	Make<Rgba64<true>, 8>(B_RGBA64_BIG),
	Make<Cmap8, 1>(B_CMAP8),
	Make<Gray8, 1>(B_GRAY8),
	{ B_GRAY1, 1, ReadGray1, WriteGray1 },
};


const Format*
FindFormat(color_space space)
{
	for (const Format& format : kFormats) {
		if (format.space == space)
			return &format;
	}
	return nullptr;
}

} // namespace


size_t
RowBytes(color_space space, int32 width)
{
	const Format* format = FindFormat(space);
	return format != nullptr ? ((size_t)width * format->bits + 7) / 8 : 0;
}


void
ReadPixels(color_space space, const uint8* row, int32 x, int32 count, uint32* pixels)
{
	if (space == B_RGBA32)
		memcpy(pixels, row + (size_t)x * 4, (size_t)count * 4);
	else if (const Format* format = FindFormat(space))
		format->read(row, x, count, pixels);
}


void
WritePixels(color_space space, uint8* row, int32 x, int32 count, const uint32* pixels)
{
	if (space == B_RGBA32)
		memcpy(row + (size_t)x * 4, pixels, (size_t)count * 4);
	else if (const Format* format = FindFormat(space))
		format->write(row, x, count, pixels);
}


} // namespace BPrivate
