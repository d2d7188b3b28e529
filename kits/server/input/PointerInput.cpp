#include "server/input/PointerInput.h"

#include <algorithm>

#include <AppDefs.h>

#include "server/DesktopThread.h"
#include "server/input/MouseMessage.h"
#include "server/input/WindowPolicy.h"

namespace BPrivate {


PointerInput::PointerInput(DesktopThread& desktop) : fDesktop(desktop)
{
}


void
PointerInput::HandleEvent(const BackendEvent& event)
{
	using Type = BackendEvent::Type;

	switch (event.type) {
		case Type::PointerMoved:
			_Moved(event, false);
			break;
		case Type::ButtonPressed:
			_Pressed(event);
			break;
		case Type::ButtonReleased:
			_Released(event);
			break;
		case Type::WheelTurned:
			_Wheel(event);
			break;
		case Type::PointerLeft:
			_Left(event);
			break;
		case Type::DragEntered:
		case Type::DragMoved:
		case Type::DragLeft:
		case Type::Dropped:
			_ForeignDrag(event);
			break;
		case Type::DragFinished:
			_DragFinished(event);
			break;
		default:
			break;
	}
}


void
PointerInput::_SetState(const BackendEvent& event)
{
	fLast = event;
	fLast.window = nullptr;
	fDesktop.Input().SetPointer(event.where, event.buttons);
	if (fCursorObscured) {
		fCursorObscured = false;
		fDesktop.GetBackend().SetCursorHidden(fCursorHidden);
	}
}


// While a button is down the desktop names the window of the press, wherever the pointer is; a drag
// in its hands is over the window that it names.
WindowReference
PointerInput::_UnderPointer(const BackendEvent& event) const
{
	using Type = BackendEvent::Type;

	if (event.type == Type::PointerLeft)
		return nullptr;
	const bool desktopDrag = event.type == Type::DragMoved || event.type == Type::Dropped;
	const bool free = fCaptured == nullptr && fSession == nullptr;
	if ((free || desktopDrag) && event.window != nullptr)
		return fDesktop.Find(event.window);
	return fDesktop.WindowAt(event.where);
}


WindowReference
PointerInput::_OpenMenu() const
{
	const WindowReference menu = fDesktop.Policy().LastMenu();
	return menu != nullptr && menu->wantsAllPointerEvents ? menu : nullptr;
}


// #pragma mark - moves


void
PointerInput::_Moved(BackendEvent event, bool transitOnly)
{
	// Until the desktop's drag has ended it tells where the pointer is in another way.
	if (fOnDesktop && event.type == BackendEvent::Type::PointerMoved && !transitOnly)
		return;

	const WindowReference under = _UnderPointer(event);
	_SetState(event);
	if (!transitOnly)
		fHistory.Move(event);
	if (fSession != nullptr && !fSession->IsForeign() && !fOnDesktop && under == nullptr
		&& event.buttons != 0 && !transitOnly && _LeaveForDesktop())
		return;

	for (const Recipient& recipient : _MoveRecipients(under))
		_DeliverMove(recipient, event, transitOnly, fSession.get());

	const bool told = fCaptured == nullptr || fCaptured == under || fSession != nullptr
		|| (under != nullptr && under->IsMenu());
	fUnder = told ? under : nullptr;
}


std::vector<PointerInput::Recipient>
PointerInput::_MoveRecipients(const WindowReference& under) const
{
	std::vector<Recipient> recipients;
	if (fUnder != nullptr && fUnder != under)
		recipients.push_back({ fUnder, true });
	if (fCaptured != nullptr && fCaptured != under && fCaptured != fUnder)
		recipients.push_back({ fCaptured, true });
	_AddWatchers(recipients);
	std::erase_if(recipients, [&](const Recipient& other) { return other.window == under; });

	if (under != nullptr
		&& (fCaptured == nullptr || fCaptured == under || fSession != nullptr || under->IsMenu()
			|| under->wantsAllPointerEvents))
		recipients.push_back({ under, false });
	return recipients;
}


void
PointerInput::_AddWatchers(std::vector<Recipient>& recipients) const
{
	for (const WindowReference& window : fDesktop.Windows()) {
		if (!window->wantsAllPointerEvents || !window->nativeShown)
			continue;
		const auto same = [&](const Recipient& other) { return other.window == window; };
		if (std::none_of(recipients.begin(), recipients.end(), same))
			recipients.push_back({ window, true });
	}
}


void
PointerInput::_DeliverMove(const Recipient& recipient, const BackendEvent& event, bool transitOnly,
	const DragSession* session) const
{
	auto message =
		make_mouse_message(B_MOUSE_MOVED, *recipient.window, event, fPress, recipient.elsewhere);
	if (transitOnly)
		message->AddBool("be:transit_only", true);
	if (session != nullptr)
		session->AddTo(*message);
	recipient.window->Deliver(std::move(message));
}


void
PointerInput::_Left(const BackendEvent& event)
{
	if (fCaptured != nullptr) {
		_Moved(event, false);
		return;
	}
	if (fUnder != nullptr)
		_DeliverMove({ fUnder, true }, event, true, fSession.get());
	fUnder = nullptr;
}


// #pragma mark - buttons


void
PointerInput::_Pressed(const BackendEvent& event)
{
	const bool another = (event.buttons & ~event.button) != 0;
	const WindowReference under = another ? nullptr : _UnderPointer(event);
	_SetState(event);
	if (another || fOnDesktop)
		return;

	fPress++;
	fHistory.Begin(fPress, event);
	fCaptured = under;

	const WindowReference menu = _OpenMenu();
	const bool besideMenu = menu != nullptr && (under == nullptr || !under->IsMenu());
	fDiscarding = besideMenu || (under != nullptr && !fDesktop.Policy().AcceptsPress(under));

	std::vector<Recipient> recipients;
	if (under != nullptr && !fDiscarding)
		recipients.push_back({ under, false });
	_AddWatchers(recipients);
	if (menu != nullptr)
		std::erase_if(recipients, [](const Recipient& one) { return !one.window->IsMenu(); });
	if (recipients.empty())
		return;

	const int32 clicks = fClicks.Press(under != nullptr ? under->Id() : 0, event.where,
		event.button, event.when, fDesktop.Input().DoubleClickTime());
	for (const Recipient& recipient : recipients) {
		if (fDiscarding && recipient.window == under)
			continue;
		auto message =
			make_mouse_message(B_MOUSE_DOWN, *recipient.window, event, fPress, recipient.elsewhere);
		message->AddInt32("clicks", clicks);
		recipient.window->Deliver(std::move(message));
	}
}


void
PointerInput::_Released(const BackendEvent& event)
{
	if (fOnDesktop)
		return;
	const WindowReference under = _UnderPointer(event);
	_SetState(event);
	if (event.buttons != 0)
		return;

	fHistory.End(event);
	_DeliverRelease(event, under);
	if (fSession != nullptr && !fSession->IsForeign()) {
		const DragReference session = fSession;
		_EndSession();
		_Drop(*session, event, under);
	}
	WindowsRearranged();
}


// Ends the capture. During a drag the window under the pointer is told as well.
void
PointerInput::_DeliverRelease(const BackendEvent& event, const WindowReference& under)
{
	std::vector<Recipient> recipients;
	if (fCaptured != nullptr && !fDiscarding)
		recipients.push_back({ fCaptured, fCaptured != under });
	if (under != nullptr && under != fCaptured && (fSession != nullptr || under->IsMenu()))
		recipients.push_back({ under, false });
	_AddWatchers(recipients);

	for (const Recipient& recipient : recipients) {
		if (fDiscarding && recipient.window == fCaptured
			&& !recipient.window->wantsAllPointerEvents)
			continue;
		const bool elsewhere = recipient.window != under;
		recipient.window->Deliver(
			make_mouse_message(B_MOUSE_UP, *recipient.window, event, fPress, elsewhere));
	}
	fCaptured = nullptr;
	fDiscarding = false;
}


void
PointerInput::_Wheel(const BackendEvent& event)
{
	const WindowReference under = _UnderPointer(event);
	if (under == nullptr)
		return;
	auto message = make_mouse_message(B_MOUSE_WHEEL_CHANGED, *under, event, fPress, false);
	message->AddFloat("be:wheel_delta_x", event.delta.x);
	message->AddFloat("be:wheel_delta_y", event.delta.y);
	under->Deliver(std::move(message));
}


// #pragma mark - windows come and go


void
PointerInput::WindowHidden(const WindowReference& window)
{
	if (fUnder == window)
		fUnder = nullptr;
	if (fCaptured == window)
		fCaptured = nullptr;
	if (_NeedsHolder() && _DragHolder() == nullptr)
		_EndSession();
	else
		UpdateGrab();
}


void
PointerInput::WindowGone(const WindowReference& window)
{
	WindowHidden(window);
}


void
PointerInput::WindowsRearranged()
{
	if (fCaptured != nullptr || fSession != nullptr)
		return;
	BackendEvent event = fLast;
	event.type = BackendEvent::Type::PointerMoved;
	const WindowReference under = fDesktop.WindowAt(event.where);
	if (under == fUnder)
		return;

	event.when = system_time();
	if (fUnder != nullptr)
		_DeliverMove({ fUnder, true }, event, true, nullptr);
	fUnder = under;
	if (under != nullptr)
		_DeliverMove({ under, false }, event, true, nullptr);
}


void
PointerInput::UpdateGrab()
{
	WindowReference holder = _OpenMenu();
	if (holder == nullptr && _NeedsHolder())
		holder = _DragHolder();
	fDesktop.GetBackend().SetPointerGrab(holder != nullptr ? holder->native.get() : nullptr);
}


// The desktop tells the window of the press where the pointer is, also outside of all windows. When
// that window has gone during a drag, another one is to hear of the release.
bool
PointerInput::_NeedsHolder() const
{
	return fSession != nullptr && !fSession->IsForeign() && !fOnDesktop && fCaptured == nullptr;
}


WindowReference
PointerInput::_DragHolder() const
{
	for (const WindowReference& window : fDesktop.Windows()) {
		if (window->nativeShown && window->native != nullptr)
			return window;
	}
	return nullptr;
}


void
PointerInput::SetCursorHidden(bool hidden)
{
	fCursorHidden = hidden;
	fDesktop.GetBackend().SetCursorHidden(fCursorHidden || fCursorObscured);
}


void
PointerInput::ObscureCursor()
{
	fCursorObscured = true;
	fDesktop.GetBackend().SetCursorHidden(true);
}


void
PointerInput::Clear()
{
	fUnder = nullptr;
	fCaptured = nullptr;
	fSession = nullptr;
}


} // namespace BPrivate
