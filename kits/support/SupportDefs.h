// The basic types of the platform and a few small helpers.
#pragma once

#include <inttypes.h>
#include <stddef.h>
#include <stdint.h>
#include <sys/types.h>

#include <BeBuild.h>
#include <Errors.h>

typedef int8_t int8;
typedef uint8_t uint8;
typedef int16_t int16;
typedef uint16_t uint16;
typedef int32_t int32;
typedef uint32_t uint32;
typedef int64_t int64;
typedef uint64_t uint64;

typedef volatile int8 vint8;
typedef volatile uint8 vuint8;
typedef volatile int16 vint16;
typedef volatile uint16 vuint16;
typedef volatile int32 vint32;
typedef volatile uint32 vuint32;
typedef volatile int64 vint64;
typedef volatile uint64 vuint64;

typedef volatile char vchar;
typedef volatile short vshort;
typedef volatile int vint;
typedef volatile long vlong;
typedef volatile unsigned char vuchar;
typedef volatile unsigned short vushort;
typedef volatile unsigned int vuint;
typedef volatile unsigned long vulong;

typedef unsigned char uchar;
typedef unsigned short unichar;

typedef int32 status_t;
typedef int64 bigtime_t;
typedef int64 nanotime_t;
typedef uint32 type_code;
typedef uint32 perform_code;

#define B_PRId32 PRId32
#define B_PRIu32 PRIu32
#define B_PRIx32 PRIx32
#define B_PRId64 PRId64
#define B_PRIu64 PRIu64

#ifndef NULL
#define NULL 0
#endif

#ifndef TRUE
#define TRUE 1
#endif
#ifndef FALSE
#define FALSE 0
#endif

#define min_c(a, b) ((a) > (b) ? (b) : (a))
#define max_c(a, b) ((a) > (b) ? (a) : (b))

extern const char* B_EMPTY_STRING;

#ifdef __cplusplus
extern "C" {
#endif

// Each returns the value before the change and is a full memory barrier.
int32 atomic_set(vint32* value, int32 newValue);
int32 atomic_test_and_set(vint32* value, int32 newValue, int32 testAgainst);
int32 atomic_add(vint32* value, int32 addValue);
int32 atomic_and(vint32* value, int32 andValue);
int32 atomic_or(vint32* value, int32 orValue);
int32 atomic_get(vint32* value);
int64 atomic_set64(vint64* value, int64 newValue);
int64 atomic_test_and_set64(vint64* value, int64 newValue, int64 testAgainst);
int64 atomic_add64(vint64* value, int64 addValue);
int64 atomic_and64(vint64* value, int64 andValue);
int64 atomic_or64(vint64* value, int64 orValue);
int64 atomic_get64(vint64* value);

#ifdef __cplusplus
}
#endif
