// The modifier keys that go with what a view is doing.
#pragma once

#include <SupportDefs.h>

class BView;

namespace BPrivate {


// Those of the event in work, or those held now when the program calls a hook by itself. The view's
// window, if it has one, is locked.
uint32 event_modifiers(const BView& view);


} // namespace BPrivate
