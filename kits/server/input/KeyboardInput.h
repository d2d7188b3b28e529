// KeyboardInput: key events of the backend, routed to the active window or to an open menu.
#pragma once

#include "backend/BackendEvent.h"
#include "server/WindowRecord.h"

namespace BPrivate {

class DesktopThread;


// Display thread only.
class KeyboardInput {
public:
	explicit KeyboardInput(DesktopThread& desktop);

	void HandleEvent(const BackendEvent& event);

private:
	WindowReference _Target() const;
	void _Key(const BackendEvent& event, bool down);
	void _Text(const BackendEvent& event);
	void _Compose(const BackendEvent& event);
	void _SetModifiers(const BackendEvent& event);
	std::unique_ptr<BMessage> _MakeMessage(uint32 what, const BackendEvent& event) const;

	DesktopThread& fDesktop;
	bool fComposing = false;
};


} // namespace BPrivate
