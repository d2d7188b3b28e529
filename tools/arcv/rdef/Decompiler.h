// Writes resources as resource definition text.
#pragma once

#include <string>

#include <Message.h>
#include <SupportDefs.h>

namespace Arcv {

// The text of one resource, which the Compiler turns into the same bytes, or, for a flattened
// message, into one with the same fields in the same order. Only what the language has is written,
// but for the mark /*class*/, a comment for other compilers.
std::string ResourceText(
	type_code type, int32 id, const std::string& name, const void* data, size_t size);

} // namespace Arcv
