// The kind and size of one attribute.
#pragma once

#include <sys/types.h>

#include <SupportDefs.h>

struct attr_info {
	uint32 type;
	off_t size;
};
