// The names by which archives know classes.
#pragma once

#include <string_view>
#include <typeinfo>

namespace BPrivate {

// Without the name space that private classes moved into, so that "BPrivate::_X" is "_X".
std::string_view plain_class_name(std::string_view name);

// The plain name of a class; the text lives as long as the program. Any thread.
const char* archived_class_name(const std::type_info& type);

} // namespace BPrivate
