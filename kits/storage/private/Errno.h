// The host's error numbers as the kits' status codes.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

// The status for an errno value; B_OK for 0, B_ERROR for one without a name of its own.
status_t StatusFromErrno(int error);

// The status for the current errno, which must not be 0.
status_t LastStatus();

} // namespace BPrivate
