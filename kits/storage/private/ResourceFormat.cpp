#include "storage/private/ResourceFormat.h"

#include <algorithm>

#include <TypeConstants.h>

namespace BPrivate {

namespace {

constexpr type_code kVersionInfo = 'APPV';
constexpr size_t kVersionInfoNumbers = 20; // five words; the texts behind them stay


// Bytes of one number; 0 for a type without numbers.
size_t
UnitSize(type_code type)
{
	switch (type) {
		case B_INT16_TYPE:
		case B_UINT16_TYPE:
			return 2;
		case B_INT32_TYPE:
		case B_UINT32_TYPE:
		case B_SIZE_T_TYPE:
		case B_SSIZE_T_TYPE:
		case B_TIME_TYPE:
		case B_FLOAT_TYPE:
		case B_POINT_TYPE:
		case B_RECT_TYPE:
		case B_POINTER_TYPE:
		case kVersionInfo:
			return 4;
		case B_INT64_TYPE:
		case B_UINT64_TYPE:
		case B_OFF_T_TYPE:
		case B_DOUBLE_TYPE:
			return 8;
		default:
			return 0;
	}
}

} // namespace


uint32
InfoChecksum(const uint8* bytes, size_t size)
{
	uint32 sum = 0;
	while (size > 0) {
		const size_t group = std::min<size_t>(size, 4);
		uint32 number = 0;
		for (size_t i = 0; i < group; i++)
			number = number << 8 | bytes[i];
		sum += number;
		bytes += group;
		size -= group;
	}
	return sum;
}


bool
IsSwapped(type_code type)
{
	return UnitSize(type) != 0;
}


bool
SwapResource(type_code type, void* data, size_t size)
{
	const size_t unit = UnitSize(type);
	if (unit == 0)
		return false;
	if (type == kVersionInfo)
		size = std::min(size, kVersionInfoNumbers);
	uint8* bytes = static_cast<uint8*>(data);
	for (size_t start = 0; start + unit <= size; start += unit)
		std::reverse(bytes + start, bytes + start + unit);
	return true;
}

} // namespace BPrivate
