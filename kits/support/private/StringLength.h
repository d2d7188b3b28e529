// The length of texts that may be missing or too long for a BString.
#pragma once

#include <climits>
#include <cstring>

#include <SupportDefs.h>

namespace BPrivate {


// 0 for NULL.
inline int32
safe_length(const char* string)
{
	if (string == nullptr)
		return 0;
	return static_cast<int32>(min_c(strlen(string), size_t(INT_MAX - 64)));
}


// At most that many bytes are looked at.
inline int32
safe_length(const char* string, int32 maxLength)
{
	if (string == nullptr || maxLength <= 0)
		return 0;
	return static_cast<int32>(strnlen(string, size_t(maxLength)));
}


} // namespace BPrivate
