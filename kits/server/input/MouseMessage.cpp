#include "server/input/MouseMessage.h"

#include "server/ServerWindow.h"
#include "server/WindowRecord.h"

namespace BPrivate {


std::unique_ptr<BMessage>
make_mouse_message(
	uint32 what, const WindowRecord& window, const BackendEvent& event, int32 press, bool elsewhere)
{
	auto message = std::make_unique<BMessage>(what);
	message->AddInt64("when", event.when);
	message->AddPoint("where", event.where - window.Frame().LeftTop());
	message->AddPoint("screen_where", event.where);
	message->AddInt32("buttons", static_cast<int32>(event.buttons));
	message->AddInt32("modifiers", static_cast<int32>(event.modifiers));
	message->AddInt32(kPressField, press);
	if (elsewhere)
		message->AddBool(kPointerElsewhere, true);
	return message;
}


} // namespace BPrivate
