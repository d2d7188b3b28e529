// ViewText: what a play script prints and expects of a view.
#pragma once

#include <string>

#include "server/Inspector.h"

namespace BPrivate {


// False when there is no such property. "pixel" is not one of a node.
bool property_of(const ViewNode& node, const std::string& property, std::string* _value);

// One line a view, indented by two blanks for each level.
std::string tree_of(const ViewNode& node, int32 level = 0);

std::string text_of_rect(BRect rect); // "left,top,right,bottom"
std::string text_of_color(rgb_color color); // "red,green,blue", and alpha unless it is 255


} // namespace BPrivate
