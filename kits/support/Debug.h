// Checks that cost nothing in a release.
#pragma once

#include <stdio.h>

#include <OS.h>

#if defined(NDEBUG)
#define ASSERT(condition) ((void)0)
#define ASSERT_WITH_MESSAGE(condition, message) ((void)0)
#define TRESPASS() ((void)0)
#define TRACE() ((void)0)
#define PRINT(arguments) ((void)0)
#define PRINT_OBJECT(object) ((void)0)
#define SERIAL_PRINT(arguments) ((void)0)
#define SERIAL_TRACE() ((void)0)
#define SET_DEBUG_ENABLED(flag) ((void)0)
#define IS_DEBUG_ENABLED() (0)
#else
#define ASSERT(condition)                                                                          \
	((condition) ? (void)0 : BPrivate::assertion_failed(#condition, __FILE__, __LINE__))
#define ASSERT_WITH_MESSAGE(condition, message)                                                    \
	((condition) ? (void)0 : BPrivate::assertion_failed(message, __FILE__, __LINE__))
#define TRESPASS() BPrivate::assertion_failed("should not be reached", __FILE__, __LINE__)
// What is printed can be switched off while the program runs.
#define SET_DEBUG_ENABLED(flag) BPrivate::set_debug_enabled(flag)
#define IS_DEBUG_ENABLED() BPrivate::is_debug_enabled()
#define PRINT(arguments) (IS_DEBUG_ENABLED() ? (void)printf arguments : (void)0)
#define PRINT_OBJECT(object) (IS_DEBUG_ENABLED() ? (object).PrintToStream() : (void)0)
#define TRACE() PRINT(("%s, line %d, %s\n", __FILE__, __LINE__, __func__))
// There is no serial port: these print like the others.
#define SERIAL_PRINT(arguments) PRINT(arguments)
#define SERIAL_TRACE() TRACE()
#endif

#define STATIC_ASSERT(condition) static_assert(condition)
#define DEBUGGER(message) debugger(message)

namespace BPrivate {

// Reports through debugger().
void assertion_failed(const char* condition, const char* file, int line);

// On at first. Any thread. The result is the state before.
bool set_debug_enabled(bool enabled);
bool is_debug_enabled();

} // namespace BPrivate
