// What the sources of BColorControl share.
#pragma once

#include <ColorControl.h>

namespace BPrivate {

constexpr float kMinimumCellSize = 6;
constexpr float kBevel = 2; // round the palette
constexpr float kFieldGap = 6; // between the palette and the fields, a label and its text
constexpr float kFieldHeight = 16; // three of them are as high as a palette of the smallest cells
constexpr int32 kRampCount = 4; // grey, red, green, blue
constexpr int32 kGreyRamp = 0;


// What an archive may say; anything else would leave no palette.
inline color_control_layout
CheckedLayout(int32 layout)
{
	switch (layout) {
		case B_CELLS_8x32:
		case B_CELLS_16x16:
		case B_CELLS_32x8:
		case B_CELLS_64x4:
			return static_cast<color_control_layout>(layout);
		default:
			return B_CELLS_4x64;
	}
}


inline int32
ComponentOf(int32 value, int32 component)
{
	return static_cast<uint32>(value) >> (24 - 8 * component) & 0xff;
}


inline int32
WithComponent(int32 value, int32 component, int32 amount)
{
	const int shift = 24 - 8 * component;
	const uint32 word = static_cast<uint32>(value);
	return static_cast<int32>((word & ~(0xffu << shift)) | static_cast<uint32>(amount) << shift);
}


} // namespace BPrivate
