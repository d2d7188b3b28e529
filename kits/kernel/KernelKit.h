// The Kernel Kit in one include.
#pragma once

#include <OS.h>
#include <TLS.h>
#include <image.h>
