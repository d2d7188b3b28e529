// What a slider has that was told nothing else, and an archive that does not say.
#pragma once

#include "interface/private/Look.h"

namespace BPrivate {


constexpr int32 kDefaultSnooze = 20000; // microseconds
constexpr float kDefaultThickness = 6;

inline rgb_color
default_bar_color()
{
	return tint_color(Look::PanelColor(), B_DARKEN_4_TINT);
}


} // namespace BPrivate
