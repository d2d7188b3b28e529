#include "interface/private/EventModifiers.h"

#include <InterfaceDefs.h>
#include <Message.h>
#include <View.h>
#include <Window.h>

namespace BPrivate {


uint32
event_modifiers(const BView& view)
{
	const BMessage* message = view.Window() != nullptr ? view.Window()->CurrentMessage() : nullptr;
	int32 held;
	if (message != nullptr && message->FindInt32("modifiers", &held) == B_OK)
		return static_cast<uint32>(held);
	return modifiers();
}


} // namespace BPrivate
