// The program's loaded images as the dynamic linker knows them.
#pragma once

#include <string>
#include <vector>

#include <image.h>

namespace BPrivate {

// Changes whenever an image is loaded or unloaded. Cheap enough to ask before each use of
// something found in an image.
uint64 image_generation();

// In load order: the program, its libraries, then what was loaded later, add-ons included.
std::vector<image_info> loaded_images();

// The address of an exported symbol of this very image, NULL when it defines none.
void* symbol_of_image(const image_info& image, const char* name);

// The signature that the image's file carries as an attribute, or an empty text.
std::string image_signature(const image_info& image);

} // namespace BPrivate
