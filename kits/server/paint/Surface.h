// Surface: an image of 32-bit pixels with a scale from logical to device pixels.
#pragma once

#include <memory>

#include <GraphicsDefs.h>
#include <Region.h>

namespace BPrivate {

// What the highest byte of a pixel means.
enum class SurfaceFormat {
	kOpaque, // nothing, except that the value 0x00777477 counts as transparent (B_RGB32)
	kAlpha // alpha, not multiplied into the colours (B_RGBA32); a window's surface as well
};


// Pixels are 0xAARRGGBB as native 32-bit words, that is blue, green, red, alpha in memory. Logical
// pixels are those of the programs. A logical rectangle l..r covers the device pixels
// DeviceEdge(l) up to, not including, DeviceEdge(r + 1): painting, clipping and damage all use
// this one rule, so neighbours neither overlap nor leave gaps. One thread at a time.
class Surface {
public:
	Surface();
	~Surface();
	Surface(const Surface&) = delete;
	Surface& operator=(const Surface&) = delete;

	// Own memory, all pixels 0. B_BAD_VALUE for a size below 1 or above 32767 device pixels,
	// B_NO_MEMORY; the surface is then as it was.
	status_t SetTo(int32 width, int32 height, float scale = 1.0f,
		SurfaceFormat format = SurfaceFormat::kAlpha);
	// The caller's memory, which must outlive the surface or the next call; scale 1.
	status_t Wrap(void* bits, int32 width, int32 height, int32 bytesPerRow, SurfaceFormat format);
	// Keeps what both sizes share when the scale stays. New pixels are 0.
	status_t Resize(int32 width, int32 height, float scale);
	void Unset();

	bool IsValid() const { return fBits != nullptr; }
	SurfaceFormat Format() const { return fFormat; }
	int32 Width() const { return fWidth; } // logical pixels
	int32 Height() const { return fHeight; }
	clipping_rect LogicalBounds() const { return { 0, 0, fWidth - 1, fHeight - 1 }; }
	float Scale() const { return fScale; }
	int32 DeviceWidth() const { return fDeviceWidth; }
	int32 DeviceHeight() const { return fDeviceHeight; }
	int32 BytesPerRow() const { return fBytesPerRow; }

	uint32* Row(int32 deviceY)
	{
		return reinterpret_cast<uint32*>(fBits + (size_t)deviceY * fBytesPerRow);
	}
	const uint32* Row(int32 deviceY) const
	{
		return reinterpret_cast<const uint32*>(fBits + (size_t)deviceY * fBytesPerRow);
	}

	// round(logical * scale); halves go up.
	static int32 DeviceEdge(int32 logical, float scale);
	int32 DeviceEdge(int32 logical) const
	{
		return fScale == 1 ? logical : DeviceEdge(logical, fScale);
	}
	// The logical pixel whose device pixels include this one.
	static int32 LogicalAt(int32 device, float scale);
	int32 LogicalAt(int32 device) const { return fScale == 1 ? device : LogicalAt(device, fScale); }
	// Right and bottom are inside in both; not cut to the surface.
	static clipping_rect ToDevice(const clipping_rect& logical, float scale);
	clipping_rect ToDevice(const clipping_rect& logical) const
	{
		return fScale == 1 ? logical : ToDevice(logical, fScale);
	}

	// Copies the rectangles, logical ones, from the same place of a surface of the same scale;
	// what lies outside either surface is left out.
	void CopyFrom(const Surface& source, const BRegion& region);

	// Colour of the first device pixel of a logical pixel; all zero outside.
	rgb_color PixelAt(int32 x, int32 y) const;

	// A PNG file of the device pixels, replaced atomically. Opaque unless keepAlpha.
	status_t WritePng(const char* path, bool keepAlpha = false) const;

private:
	struct Free {
		void operator()(uint8* bits) const;
	};

	uint8* fBits;
	std::unique_ptr<uint8[], Free> fOwned; // NULL when the memory is the caller's
	int32 fWidth;
	int32 fHeight;
	int32 fDeviceWidth;
	int32 fDeviceHeight;
	int32 fBytesPerRow;
	float fScale;
	SurfaceFormat fFormat;
};

inline uint32
ToPixel(rgb_color color)
{
	return (uint32)color.alpha << 24 | (uint32)color.red << 16 | (uint32)color.green << 8
		| color.blue;
}

inline rgb_color
ToColor(uint32 pixel)
{
	return { (uint8)(pixel >> 16), (uint8)(pixel >> 8), (uint8)pixel, (uint8)(pixel >> 24) };
}


} // namespace BPrivate
