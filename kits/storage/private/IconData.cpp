#include "storage/private/IconData.h"

#include <string.h>

#include <Bitmap.h>

namespace BPrivate {

namespace {

bool
HasSize(const BBitmap* icon, icon_size size)
{
	return icon != NULL && icon->InitCheck() == B_OK && icon->Bounds().IntegerWidth() + 1 == size
		&& icon->Bounds().IntegerHeight() + 1 == size;
}

} // namespace


status_t
IconToData(const BBitmap* icon, icon_size size, std::string* _data)
{
	if (!HasSize(icon, size) || icon->ColorSpace() != B_CMAP8)
		return B_BAD_VALUE;
	_data->clear();
	const char* row = static_cast<const char*>(icon->Bits());
	for (int32 y = 0; y < size; y++, row += icon->BytesPerRow())
		_data->append(row, size);
	return B_OK;
}


status_t
DataToIcon(const void* data, size_t length, icon_size size, BBitmap* icon)
{
	if (!HasSize(icon, size))
		return B_BAD_VALUE;
	if (length != static_cast<size_t>(size * size))
		return B_BAD_DATA;
	icon->SetBits(data, length, 0, B_CMAP8);
	return B_OK;
}


type_code
IconType(icon_size size)
{
	return size == B_LARGE_ICON ? 'ICON' : 'MICN';
}


const char*
IconName(icon_size size)
{
	return size == B_LARGE_ICON ? "BEOS:L:STD_ICON" : "BEOS:M:STD_ICON";
}

} // namespace BPrivate
