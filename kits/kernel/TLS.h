// Storage of one thread; see OS.h.
#pragma once

#include <OS.h>
