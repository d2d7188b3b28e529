// What the desktop reports to the display thread.
#include "server/DesktopThread.h"

#include <algorithm>

#include <AppDefs.h>

#include "server/ClipboardBridge.h"
#include "server/input/KeyboardInput.h"
#include "server/input/PointerInput.h"
#include "server/input/WindowPolicy.h"

namespace BPrivate {

namespace {

// How long a desktop may take to carry out a request before nobody waits for it any more.
constexpr bigtime_t kExpectationTimeout = 1000000;

} // namespace


void
DesktopThread::HandleEvent(const BackendEvent& event)
{
	using Type = BackendEvent::Type;

	switch (event.type) {
		case Type::KeyPressed:
		case Type::KeyReleased:
		case Type::ModifiersChanged:
		case Type::TextEntered:
		case Type::TextComposed:
			fKeyboard->HandleEvent(event);
			break;

		case Type::WindowActivated:
			fPolicy->Activated(Find(event.window));
			break;

		case Type::WindowChanged:
			_WindowChanged(event);
			break;

		case Type::WindowShown:
			if (WindowReference window = Find(event.window)) {
				Settle(window->Id(), Type::WindowShown);
				if (window->IsMenu())
					fPointer->UpdateGrab();
			}
			break;

		case Type::CloseRequested:
			// Desktops show a close button, and have a key, for any window.
			if (WindowReference window = Find(event.window); window && window->MayClose())
				window->Deliver(std::make_unique<BMessage>(B_QUIT_REQUESTED));
			break;

		case Type::Minimized:
			if (WindowReference window = Find(event.window)) {
				auto message = std::make_unique<BMessage>(B_MINIMIZE);
				message->AddInt64("when", system_time());
				message->AddBool("minimize", event.flag);
				window->Deliver(std::move(message));
			}
			break;

		case Type::ScreenChanged:
			_ScreenChanged();
			break;

		case Type::ClipboardChanged:
			fClipboard->Changed();
			break;

		default:
			fPointer->HandleEvent(event);
			break;
	}
}


void
DesktopThread::_WindowChanged(const BackendEvent& event)
{
	WindowReference window = Find(event.window);
	if (window == nullptr)
		return;
	Settle(window->Id(), BackendEvent::Type::WindowChanged);
	if (!window->ReportFrame(event.frame))
		return;

	const BRect before = window->reportedFrame;
	const BRect now = event.frame;
	window->reportedFrame = now;
	if (now.LeftTop() != before.LeftTop()) {
		auto message = std::make_unique<BMessage>(B_WINDOW_MOVED);
		message->AddInt64("when", system_time());
		message->AddPoint("where", now.LeftTop());
		window->Deliver(std::move(message));
	}
	if (now.Width() != before.Width() || now.Height() != before.Height()) {
		auto message = std::make_unique<BMessage>(B_WINDOW_RESIZED);
		message->AddInt64("when", system_time());
		message->AddInt32("width", static_cast<int32>(now.Width()));
		message->AddInt32("height", static_cast<int32>(now.Height()));
		window->Deliver(std::move(message));
	}
	fPointer->WindowsRearranged();
}


void
DesktopThread::_ScreenChanged()
{
	const BRect frame = fBackend->ScreenFrame();
	fScale = fBackend->Scale();
	{
		std::lock_guard lock(fLock);
		fScreenFrame = frame;
	}
	for (const WindowReference& window : fWindows) {
		auto message = std::make_unique<BMessage>(B_SCREEN_CHANGED);
		message->AddInt64("when", system_time());
		message->AddRect("frame", frame);
		message->AddInt32("mode", B_RGB32);
		window->Deliver(std::move(message));
	}
}


void
DesktopThread::Expect(uint32 window, BackendEvent::Type event)
{
	if (fBackend->IsImmediate())
		return;

	const int64 serial = fNextSerial++;
	fActivity.AddWork();
	fExpectations.push_back({ window, event, serial });
	fBackend->PostLater(kExpectationTimeout, [this, serial] {
		const auto expired = [serial](const Expectation& other) { return other.serial == serial; };
		if (std::erase_if(fExpectations, expired) > 0)
			fActivity.WorkDone();
	});
}


void
DesktopThread::Settle(uint32 window, BackendEvent::Type event)
{
	const size_t settled = std::erase_if(fExpectations, [&](const Expectation& expectation) {
		return expectation.window == window && expectation.event == event;
	});
	if (settled > 0)
		fActivity.WorkDone(static_cast<int32>(settled));
}


} // namespace BPrivate
