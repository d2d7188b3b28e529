// The filter that a work view puts on its window.
#pragma once

#include <MessageFilter.h>

// Takes presses and drops on edited views away from them and hands them to the work view named
// "WorkView" in the filter's window; has the highlight drawn again after every update; and shows
// by the selection which view would receive what is dragged over it.
filter_result WorkViewFilter(BMessage* message, BHandler** target, BMessageFilter* filter);
