// What the sources of BTextView share.
#pragma once

#include <TextView.h>

namespace BPrivate {

constexpr bigtime_t kBlinkTime = 450000; // microseconds; a little less than a pulse
constexpr uint32 kAutoScroll = '_TAS';
constexpr const char* kTextType = "text/plain";
constexpr const char* kRunsType = "application/x-vnd.Be-text_run_array";

// Checks everything against the size; NULL for what is no run array.
text_run_array* unflatten_runs(const void* data, ssize_t size);

} // namespace BPrivate
