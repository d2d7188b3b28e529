// Marks for names that a shared library offers to others or takes from others.
#pragma once

#define B_BEOS_VERSION_5 0x0500
#define B_BEOS_VERSION B_BEOS_VERSION_5

#define _EXPORT __attribute__((visibility("default")))
#define _IMPORT __attribute__((visibility("default")))
