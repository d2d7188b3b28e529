// Whole numbers of any float, which archives may hold anything in.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

// The nearest number that there is, towards zero; 0 for what is no number.
inline int32
saturated(float value)
{
	constexpr float kEnd = 2147483648.0f;
	if (!(value > -kEnd))
		return value <= -kEnd ? INT32_MIN : 0;
	return value < kEnd ? static_cast<int32>(value) : INT32_MAX;
}

} // namespace BPrivate
