// The messages that open menus send each other.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

constexpr uint32 kMenuStarted = '_MNs'; // "screen_where", "buttons" when events began to come
constexpr uint32 kMenuAbort = '_MNa';
constexpr uint32 kMenuChanged = '_MNc'; // items have been changed
constexpr uint32 kMenuAdd = '_MNd'; // a menu has more dynamic items
constexpr uint32 kMenuPoll = '_MNp'; // time to ask the tracking hook
constexpr uint32 kMenuScroll = '_MNr'; // the pointer rests on an arrow
constexpr uint32 kMenuWheel = '_MNw';
constexpr uint32 kMenuKey = '_MNk'; // "event": a key that a submenu's window got
constexpr uint32 kMenusEnded = '_MND'; // to the bar: its window's MenusEnded() is due

constexpr float kScrollStep = 12; // pixels

} // namespace BPrivate
