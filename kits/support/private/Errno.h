// The host's error numbers as status codes.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

// B_OK for 0; B_ERROR for a number that has no counterpart.
status_t status_from_errno(int hostError);

} // namespace BPrivate
