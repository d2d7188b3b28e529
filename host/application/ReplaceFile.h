// Files that are written as a whole or not at all.
#pragma once

#include <string>

#include <SupportDefs.h>

// Writes the bytes into a new file beside the path, which takes its place when it is complete. On
// an error what was there before is left alone.
status_t ReplaceFile(const std::string& path, const void* data, size_t size);
