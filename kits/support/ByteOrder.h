// Byte order of numbers and of arrays of typed data.
#pragma once

#include <endian.h>

#include <SupportDefs.h>
#include <TypeConstants.h>

typedef enum {
	B_SWAP_HOST_TO_LENDIAN,
	B_SWAP_HOST_TO_BENDIAN,
	B_SWAP_LENDIAN_TO_HOST,
	B_SWAP_BENDIAN_TO_HOST,
	B_SWAP_ALWAYS
} swap_action;

#ifdef __cplusplus
extern "C" {
#endif

// Swaps in place. The length is in bytes; a rest shorter than one value is left as it is.
// B_BAD_VALUE for a type whose items have no byte order.
status_t swap_data(type_code type, void* data, size_t length, swap_action action);
bool is_type_swapped(type_code type);

double __swap_double(double value);
float __swap_float(float value);

#ifdef __cplusplus
}
#endif

static inline uint16
__swap_int16(uint16 value)
{
	return __builtin_bswap16(value);
}


static inline uint32
__swap_int32(uint32 value)
{
	return __builtin_bswap32(value);
}


static inline uint64
__swap_int64(uint64 value)
{
	return __builtin_bswap64(value);
}

// Integers come out unsigned, whatever they were.
#define B_SWAP_INT16(value) __swap_int16((uint16)(value))
#define B_SWAP_INT32(value) __swap_int32((uint32)(value))
#define B_SWAP_INT64(value) __swap_int64((uint64)(value))
#define B_SWAP_FLOAT(value) __swap_float(value)
#define B_SWAP_DOUBLE(value) __swap_double(value)

#if __BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__
#define B_HOST_IS_LENDIAN 1
#define B_HOST_IS_BENDIAN 0
#define B_HOST_TO_LENDIAN_INT16(value) ((uint16)(value))
#define B_HOST_TO_LENDIAN_INT32(value) ((uint32)(value))
#define B_HOST_TO_LENDIAN_INT64(value) ((uint64)(value))
#define B_HOST_TO_LENDIAN_FLOAT(value) ((float)(value))
#define B_HOST_TO_LENDIAN_DOUBLE(value) ((double)(value))
#define B_HOST_TO_BENDIAN_INT16(value) B_SWAP_INT16(value)
#define B_HOST_TO_BENDIAN_INT32(value) B_SWAP_INT32(value)
#define B_HOST_TO_BENDIAN_INT64(value) B_SWAP_INT64(value)
#define B_HOST_TO_BENDIAN_FLOAT(value) B_SWAP_FLOAT(value)
#define B_HOST_TO_BENDIAN_DOUBLE(value) B_SWAP_DOUBLE(value)
#else
#define B_HOST_IS_LENDIAN 0
#define B_HOST_IS_BENDIAN 1
#define B_HOST_TO_LENDIAN_INT16(value) B_SWAP_INT16(value)
#define B_HOST_TO_LENDIAN_INT32(value) B_SWAP_INT32(value)
#define B_HOST_TO_LENDIAN_INT64(value) B_SWAP_INT64(value)
#define B_HOST_TO_LENDIAN_FLOAT(value) B_SWAP_FLOAT(value)
#define B_HOST_TO_LENDIAN_DOUBLE(value) B_SWAP_DOUBLE(value)
#define B_HOST_TO_BENDIAN_INT16(value) ((uint16)(value))
#define B_HOST_TO_BENDIAN_INT32(value) ((uint32)(value))
#define B_HOST_TO_BENDIAN_INT64(value) ((uint64)(value))
#define B_HOST_TO_BENDIAN_FLOAT(value) ((float)(value))
#define B_HOST_TO_BENDIAN_DOUBLE(value) ((double)(value))
#endif

#define B_LENDIAN_TO_HOST_INT16(value) B_HOST_TO_LENDIAN_INT16(value)
#define B_LENDIAN_TO_HOST_INT32(value) B_HOST_TO_LENDIAN_INT32(value)
#define B_LENDIAN_TO_HOST_INT64(value) B_HOST_TO_LENDIAN_INT64(value)
#define B_LENDIAN_TO_HOST_FLOAT(value) B_HOST_TO_LENDIAN_FLOAT(value)
#define B_LENDIAN_TO_HOST_DOUBLE(value) B_HOST_TO_LENDIAN_DOUBLE(value)
#define B_BENDIAN_TO_HOST_INT16(value) B_HOST_TO_BENDIAN_INT16(value)
#define B_BENDIAN_TO_HOST_INT32(value) B_HOST_TO_BENDIAN_INT32(value)
#define B_BENDIAN_TO_HOST_INT64(value) B_HOST_TO_BENDIAN_INT64(value)
#define B_BENDIAN_TO_HOST_FLOAT(value) B_HOST_TO_BENDIAN_FLOAT(value)
#define B_BENDIAN_TO_HOST_DOUBLE(value) B_HOST_TO_BENDIAN_DOUBLE(value)
