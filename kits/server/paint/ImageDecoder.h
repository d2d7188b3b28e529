// ImageDecoder: between the bytes of an image file and a surface.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "server/paint/Surface.h"
#include "support/private/Result.h"

namespace BPrivate {

// Larger images are refused from their header, before memory is taken for their pixels.
constexpr int32 kMaxImageSide = 16384;
constexpr int64 kMaxImagePixels = 64 * 1024 * 1024;


struct DecodedImage {
	std::unique_ptr<Surface> surface; // kAlpha
	std::string format; // "png", "jpeg" and so on
};

// The bytes may be anything. B_BAD_TYPE: no known format; B_BAD_DATA: damaged or over the
// limits; B_NO_MEMORY. Any thread.
Result<DecodedImage> DecodeImage(const void* data, size_t size);

// The format by the first bytes alone; B_BAD_TYPE if none is known.
Result<std::string> IdentifyImage(const void* data, size_t size);

// The surface as a file of the format ("png", "jpeg", "bmp", ...), or B_BAD_TYPE.
Result<std::string> EncodeImage(const Surface& surface, const std::string& format);

// What can be read and what can be written here, sorted by name.
std::vector<std::string> ReadableImageFormats();
std::vector<std::string> WritableImageFormats();


} // namespace BPrivate
