// Fields that several controls write in the same way.
#pragma once

#include <memory>
#include <string>

#include <GraphicsDefs.h>
#include <SupportDefs.h>

class BMessage;

namespace BPrivate {

class ArchiveWriter;

// Texts for which empty and absent are the same thing: an empty one is not written, unless it was
// read.
std::string read_text(const BMessage* archive, const char* name);
void write_text(
	ArchiveWriter& writer, BMessage* archive, const char* name, const std::string& text);

// Colours as the four bytes red, green, blue, alpha in memory order, taken as an int32.
rgb_color color_from_bytes(int32 bytes);
int32 color_to_bytes(rgb_color color);

// The message of a field, or nothing. Old archives hold it flattened in a raw field.
std::unique_ptr<BMessage> read_message(const BMessage* archive, const char* name);
void write_message(
	ArchiveWriter& writer, BMessage* archive, const char* name, const BMessage* message);

} // namespace BPrivate
