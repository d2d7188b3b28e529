// The part of PointerInput that deals with drags.

#include "server/input/PointerInput.h"

#include "server/DesktopThread.h"
#include "server/DragOffer.h"
#include "server/ServerWindow.h"

namespace BPrivate {


void
PointerInput::StartDrag(const WindowReference& source, int32 serial, const DragReference& session)
{
	_StartDrag(serial, session);
	if (source != nullptr)
		source->Deliver(std::make_unique<BMessage>(kDragDecided));
}


void
PointerInput::_StartDrag(int32 serial, const DragReference& session)
{
	const PressRecord* press = fHistory.Find(serial);
	if (press == nullptr || fSession != nullptr)
		return;
	if (!press->released) {
		_BeginSession(session);
		return;
	}

	// The user has let go already: what would have been seen in time is told now, in order.
	_Replay(*press, *session);
	_Drop(*session, press->release, fDesktop.WindowAt(press->release.where));
}


void
PointerInput::_BeginSession(const DragReference& session)
{
	fSession = session;
	const ScreenPicture picture = session->Picture(fDesktop.Scale());
	if (picture.width > 0)
		fDesktop.GetBackend().SetDragPicture(&picture, session->Offset());
	UpdateGrab();
}


void
PointerInput::_Replay(const PressRecord& press, const DragSession& session)
{
	WindowReference last;
	for (const BackendEvent& move : press.moves) {
		const WindowReference under = fDesktop.WindowAt(move.where);
		if (last != nullptr && last != under)
			_DeliverMove({ last, true }, move, false, &session);
		if (under != nullptr)
			_DeliverMove({ under, false }, move, false, &session);
		last = under;
	}
	if (last != nullptr && last != fDesktop.WindowAt(press.release.where))
		_DeliverMove({ last, true }, press.release, false, nullptr);
}


void
PointerInput::_Drop(
	const DragSession& session, const BackendEvent& event, const WindowReference& under)
{
	if (under == nullptr)
		return;
	const PressRecord* press = fHistory.Find(0);
	under->Deliver(session.MakeDrop(event.where, press != nullptr ? press->buttons : 1));
}


void
PointerInput::_EndSession()
{
	fSession = nullptr;
	fOnDesktop = false;
	fDesktop.GetBackend().SetDragPicture(nullptr, BPoint());
	UpdateGrab();
}


// #pragma mark - the desktop's drags


// Other programs may take what is dragged as soon as the pointer is over none of our windows.
bool
PointerInput::_LeaveForDesktop()
{
	if (fUnder != nullptr)
		_DeliverMove({ fUnder, true }, fLast, false, fSession.get());
	fUnder = nullptr;
	if (!fDesktop.GetBackend().StartDesktopDrag(
			make_drag_offer(fDesktop, fSession), fSession->Serial(), fLast.buttons))
		return false;

	fOnDesktop = true;
	return true;
}


void
PointerInput::_ForeignDrag(const BackendEvent& event)
{
	using Type = BackendEvent::Type;

	const bool ours = fOnDesktop && fSession != nullptr
		&& (event.session == fSession->Serial() || event.type == Type::DragLeft);
	if (!ours && fOnDesktop)
		return;
	if (event.type == Type::DragEntered && !ours) {
		fSession = std::make_shared<DragSession>(make_foreign_drag(event.message));
		return;
	}
	if (fSession == nullptr)
		return;

	switch (event.type) {
		case Type::DragMoved:
			_Moved(event, false);
			break;

		case Type::DragLeft:
			if (fUnder != nullptr)
				_DeliverMove({ fUnder, true }, event, false, fSession.get());
			fUnder = nullptr;
			if (!ours)
				fSession = nullptr;
			break;

		case Type::Dropped: {
			const WindowReference under = _UnderPointer(event);
			_SetState(event);
			const DragReference session =
				ours ? fSession : std::make_shared<DragSession>(make_foreign_drag(event.message));
			if (ours) {
				fHistory.End(event);
				_DeliverRelease(event, under);
			}
			_Drop(*session, event, under);
			// The desktop's own word that the drag is finished comes later, and is then no news.
			_EndSession();
			WindowsRearranged();
			break;
		}

		default:
			break;
	}
}


void
PointerInput::_DragFinished(const BackendEvent& event)
{
	if (!fOnDesktop)
		return;

	BackendEvent release = fLast;
	release.type = BackendEvent::Type::ButtonReleased;
	release.buttons = 0;
	release.when = system_time();
	_SetState(release);
	fHistory.End(release);
	_DeliverRelease(release, nullptr);
	_EndSession();
	WindowsRearranged();
}


} // namespace BPrivate
