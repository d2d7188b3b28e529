// FontSpec: everything that decides how a text looks and how wide it is, as one small value.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {


struct FontSpec {
	uint32 familyAndStyle = 0; // the engine's code; 0 is the plain font
	float size = 10; // pixels per em
	float shear = 90; // degrees
	float rotation = 0; // degrees against the clock
	float falseBoldWidth = 0;
	uint32 flags = 0;
	uint16 face = 0;
	uint8 spacing = 2; // B_BITMAP_SPACING
	uint8 encoding = 0;

	bool operator==(const FontSpec& other) const = default;
};


} // namespace BPrivate
