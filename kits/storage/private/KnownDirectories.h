// Where the directories lie whose numbers were given out.
#pragma once

#include <sys/types.h>

namespace BPrivate {

// The host cannot open a directory by its number, so the path of each directory that an entry_ref
// or a node_ref named is remembered here. Safe on any thread.
void RememberDirectory(int fd);

// An O_PATH descriptor for the caller to close, or -1 when the directory is unknown, or is no
// longer where it was seen last.
int OpenKnownDirectory(dev_t device, ino_t node);

} // namespace BPrivate
