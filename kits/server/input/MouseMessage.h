// MouseMessage: backend events in the form that windows receive.
#pragma once

#include <memory>

#include <Message.h>

#include "backend/BackendEvent.h"

namespace BPrivate {

class WindowRecord;

// An int32 that numbers the press a mouse message belongs to.
constexpr const char* kPressField = "be:press";


// "where" is in window coordinates; the window's thread makes view coordinates of it where due.
std::unique_ptr<BMessage> make_mouse_message(uint32 what, const WindowRecord& window,
	const BackendEvent& event, int32 press, bool elsewhere);


} // namespace BPrivate
