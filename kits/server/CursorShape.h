// CursorShape: what the pointer looks like.
#pragma once

#include <array>
#include <memory>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// A picture of any size and colours: 0xAARRGGBB, row by row, alpha not multiplied into the colours.
struct CursorPicture {
	int32 width;
	int32 height;
	int32 hotX;
	int32 hotY;
	std::vector<uint32> pixels;
};


// Either one of the desktop's own shapes, by the platform's cursor id, or 68 bytes of a 16 × 16
// picture: size, depth, hot spot (row, column), 32 bytes of colour, 32 bytes of mask; or a picture.
struct CursorShape {
	static constexpr int32 kFromBits = -1;
	static constexpr int32 kProgram = -2; // a window's: the one that the program has set
	static constexpr int32 kFromPicture = -3;
	static constexpr int32 kArrow = 1;
	static constexpr int32 kTextBeam = 2;
	static constexpr int32 kNone = 12;

	int32 id = kArrow;
	std::array<uint8, 68> bits {};
	std::shared_ptr<const CursorPicture> picture; // with kFromPicture

	bool operator==(const CursorShape&) const = default;
};


} // namespace BPrivate
