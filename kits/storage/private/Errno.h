// Why the host's last call failed.
#pragma once

#include <errno.h>

#include "support/private/Errno.h"

namespace BPrivate {

inline status_t
LastStatus()
{
	return status_from_errno(errno);
}

} // namespace BPrivate
