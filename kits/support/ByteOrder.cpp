#include <ByteOrder.h>

#include <cstring>


double
__swap_double(double value)
{
	uint64 bits;
	memcpy(&bits, &value, sizeof(bits));
	bits = __builtin_bswap64(bits);
	memcpy(&value, &bits, sizeof(bits));
	return value;
}


float
__swap_float(float value)
{
	uint32 bits;
	memcpy(&bits, &value, sizeof(bits));
	bits = __builtin_bswap32(bits);
	memcpy(&value, &bits, sizeof(bits));
	return value;
}


// Bytes of one number of the type; 0 for a type without byte order.
static size_t
swap_width(type_code type)
{
	switch (type) {
		case B_INT16_TYPE:
		case B_UINT16_TYPE:
			return 2;

		case B_INT32_TYPE:
		case B_UINT32_TYPE:
		case B_FLOAT_TYPE:
		case B_TIME_TYPE:
		case B_RECT_TYPE:
		case B_POINT_TYPE:
		case B_SIZE_TYPE:
		case B_ALIGNMENT_TYPE:
			return 4;

		case B_INT64_TYPE:
		case B_UINT64_TYPE:
		case B_DOUBLE_TYPE:
		case B_OFF_T_TYPE:
			return 8;

		case B_SIZE_T_TYPE:
		case B_SSIZE_T_TYPE:
		case B_POINTER_TYPE:
			return sizeof(void*);

		default:
			return 0;
	}
}


bool
is_type_swapped(type_code type)
{
	return swap_width(type) != 0;
}


static void
swap_numbers(char* data, size_t length, size_t width)
{
	for (char* number = data; length >= width; number += width, length -= width) {
		for (size_t low = 0, high = width - 1; low < high; low++, high--) {
			const char byte = number[low];
			number[low] = number[high];
			number[high] = byte;
		}
	}
}


status_t
swap_data(type_code type, void* data, size_t length, swap_action action)
{
	const size_t width = swap_width(type);
	if (data == nullptr || width == 0)
		return B_BAD_VALUE;

	const bool hostIsBig = B_HOST_IS_BENDIAN != 0;
	const bool toOrFromBig = action == B_SWAP_HOST_TO_BENDIAN || action == B_SWAP_BENDIAN_TO_HOST;
	if (action == B_SWAP_ALWAYS || toOrFromBig != hostIsBig)
		swap_numbers(static_cast<char*>(data), length, width);
	return B_OK;
}
