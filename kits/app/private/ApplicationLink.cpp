#include "app/private/ApplicationLink.h"

#include <AppDefs.h>
#include <Application.h>
#include <Message.h>

#include "app/private/ClipboardStore.h"
#include "app/private/LooperPrivate.h"

namespace BPrivate {


void
ApplicationLink::PostToApplication(BMessage* message)
{
	// Watchers hear of it though the application's loop may not be running.
	if (message->what == B_CLIPBOARD_CHANGED) {
		delete message;
		ClipboardStore::SystemChanged();
		return;
	}
	LooperPrivate(fApplication).PostSystem(message);
}


} // namespace BPrivate
