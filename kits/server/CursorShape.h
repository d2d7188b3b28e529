// CursorShape: what the pointer looks like.
#pragma once

#include <array>

#include <SupportDefs.h>

namespace BPrivate {


// Either one of the desktop's own shapes, by the platform's cursor id, or 68 bytes of a 16 × 16
// picture: size, depth, hot spot (row, column), 32 bytes of colour, 32 bytes of mask.
struct CursorShape {
	static constexpr int32 kFromBits = -1;
	static constexpr int32 kProgram = -2; // a window's: the one that the program has set
	static constexpr int32 kArrow = 1;
	static constexpr int32 kTextBeam = 2;
	static constexpr int32 kNone = 12;

	int32 id = kArrow;
	std::array<uint8, 68> bits {};

	bool operator==(const CursorShape&) const = default;
};


} // namespace BPrivate
