// Icons as attributes and resources keep them: 32×32 or 16×16 bytes of B_CMAP8.
#pragma once

#include <string>

#include <Mime.h>

namespace BPrivate {

// B_BAD_VALUE for a bitmap of another size or colour space.
status_t IconToData(const BBitmap* icon, icon_size size, std::string* _data);
// The bitmap has the size; its colour space may be any that bits can be set in.
status_t DataToIcon(const void* data, size_t length, icon_size size, BBitmap* icon);

// 'ICON' or 'MICN'
type_code IconType(icon_size size);
// "BEOS:L:STD_ICON" or "BEOS:M:STD_ICON"
const char* IconName(icon_size size);

} // namespace BPrivate
