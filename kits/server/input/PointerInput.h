// PointerInput: pointer events of the backend, routed to windows; drags among them.
#pragma once

#include <vector>

#include "backend/BackendEvent.h"
#include "server/DragSession.h"
#include "server/WindowRecord.h"
#include "server/input/ClickCounter.h"
#include "server/input/PressHistory.h"

namespace BPrivate {

class DesktopThread;


// Display thread only. A press captures the pointer for its window until the last button is
// released; the presses in between are not reported. What goes where:
// - the window under the pointer gets everything, unless another has captured it;
// - the window that captured it gets everything up to the release;
// - a window that the pointer leaves gets one more move;
// - windows that want all pointer events get them.
// During a drag the window under the pointer is told although another has captured the pointer.
class PointerInput {
public:
	explicit PointerInput(DesktopThread& desktop);

	void HandleEvent(const BackendEvent& event);

	// The press may be over. A NULL window means that it has gone meanwhile.
	void StartDrag(const WindowReference& source, int32 press, const DragReference& session);
	bool IsDragging() const { return fSession != nullptr; }

	void WindowHidden(const WindowReference& window);
	void WindowGone(const WindowReference& window);
	// Something may have come to be under the resting pointer.
	void WindowsRearranged();
	// Menus want the presses outside all windows too, and a drag its release.
	void UpdateGrab();
	void SetCursorHidden(bool hidden);
	void ObscureCursor();
	void Clear();

private:
	struct Recipient {
		WindowReference window;
		bool elsewhere;
	};

	void _Moved(BackendEvent event, bool transitOnly);
	void _Pressed(const BackendEvent& event);
	void _Released(const BackendEvent& event);
	void _Wheel(const BackendEvent& event);
	void _Left(const BackendEvent& event);
	void _ForeignDrag(const BackendEvent& event);
	void _DragFinished(const BackendEvent& event);

	WindowReference _UnderPointer(const BackendEvent& event) const;
	WindowReference _OpenMenu() const;
	bool _NeedsHolder() const;
	WindowReference _DragHolder() const; // NULL when no window is shown
	std::vector<Recipient> _MoveRecipients(const WindowReference& under) const;
	void _AddWatchers(std::vector<Recipient>& recipients) const;
	void _DeliverMove(const Recipient& recipient, const BackendEvent& event, bool transitOnly,
		const DragSession* session) const;
	void _DeliverRelease(const BackendEvent& event, const WindowReference& under);
	void _SetState(const BackendEvent& event);

	void _StartDrag(int32 press, const DragReference& session);
	void _BeginSession(const DragReference& session);
	void _Replay(const PressRecord& press, const DragSession& session);
	void _Drop(const DragSession& session, const BackendEvent& event, const WindowReference& under);
	void _EndSession();
	bool _LeaveForDesktop();

	DesktopThread& fDesktop;
	BackendEvent fLast; // where the pointer rests
	WindowReference fUnder; // the window that was last told that the pointer is over it
	WindowReference fCaptured; // NULL when no button is down
	bool fDiscarding = false; // the press of a first click, of a blocked window or beside a menu
	int32 fPress = 0; // serial of the last press
	ClickCounter fClicks;
	PressHistory fHistory;
	DragReference fSession; // of ours or a foreign one; NULL when nothing is dragged
	bool fOnDesktop = false; // the session is in the hands of the desktop
	bool fCursorHidden = false;
	bool fCursorObscured = false;
};


} // namespace BPrivate
