// Checks that cost nothing in a release.
#pragma once

#include <stdio.h>

#include <OS.h>

#if defined(NDEBUG)
#define ASSERT(condition) ((void)0)
#define TRESPASS() ((void)0)
#define PRINT(arguments) ((void)0)
#else
#define ASSERT(condition)                                                                          \
	((condition) ? (void)0 : BPrivate::assertion_failed(#condition, __FILE__, __LINE__))
#define TRESPASS() BPrivate::assertion_failed("should not be reached", __FILE__, __LINE__)
#define PRINT(arguments) printf arguments
#endif

#define DEBUGGER(message) debugger(message)

namespace BPrivate {

// Reports through debugger().
void assertion_failed(const char* condition, const char* file, int line);

} // namespace BPrivate
