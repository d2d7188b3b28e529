// What the sources of BScrollBar share.
#pragma once

#include <OS.h>
#include <ScrollBar.h>

namespace BPrivate {

constexpr uint32 kScrollRepeat = 'srpt'; // while a part is held
constexpr bigtime_t kFirstScrollPause = 300000; // microseconds
constexpr bigtime_t kScrollPause = 25000;

} // namespace BPrivate


enum class BScrollBar::Part : uint8 {
	kNone,
	kBackArrow,
	kForthArrow,
	kBackArea,
	kForthArea,
	kThumb
};
