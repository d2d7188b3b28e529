// ScreenPicture: what a screen shows, copied.
#pragma once

#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// Bits of a picture of the screen: 32-bit BGRA rows without gaps.
struct ScreenPicture {
	int32 width = 0, height = 0; // device pixels
	std::vector<uint8> bits;
};


} // namespace BPrivate
