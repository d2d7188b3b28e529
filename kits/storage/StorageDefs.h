// Constants and types that the whole Storage Kit shares.
#pragma once

#include <fcntl.h>
#include <limits.h>
#include <stdint.h>
#include <stdio.h>
#include <sys/types.h>

#include <SupportDefs.h>

#ifndef B_FILE_NAME_LENGTH
// Of a leaf name, without the terminator.
#define B_FILE_NAME_LENGTH 255
#endif
#ifndef B_PATH_NAME_LENGTH
#define B_PATH_NAME_LENGTH 4096
#endif
// Shorter than on the original system: the host's attribute names carry a prefix.
#define B_ATTR_NAME_LENGTH 247
#define B_MIME_TYPE_LENGTH 239
#define B_DEV_NAME_LENGTH 128
#define B_MAX_SYMLINKS 16
#ifndef B_DEV_NAME_LENGTH
#define B_DEV_NAME_LENGTH 128
#endif

// The host's own values, so that both families of names may be mixed.
#define B_READ_ONLY O_RDONLY
#define B_WRITE_ONLY O_WRONLY
#define B_READ_WRITE O_RDWR
#define B_FAIL_IF_EXISTS O_EXCL
#define B_CREATE_FILE O_CREAT
#define B_ERASE_FILE O_TRUNC
#define B_OPEN_AT_END O_APPEND

enum node_flavor {
	B_FILE_NODE = 0x01,
	B_SYMLINK_NODE = 0x02,
	B_DIRECTORY_NODE = 0x04,
	B_ANY_NODE = 0x07
};
