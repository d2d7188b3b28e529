#include "server/Desktop.h"

#include <atomic>
#include <cstring>

#include <AppDefs.h>
#include <Entry.h>

#include "server/ClipboardBridge.h"
#include "server/DesktopThread.h"
#include "server/DragSession.h"
#include "server/ServerWindow.h"
#include "server/input/PointerInput.h"
#include "server/input/WindowPolicy.h"
#include "server/play/Picture.h"

namespace BPrivate {

namespace {

std::atomic<Desktop*> sDesktop { nullptr };

} // namespace


status_t
Desktop::Start(ApplicationClient* client)
{
	if (Get() != nullptr)
		return B_NOT_ALLOWED;

	auto* desktop = new Desktop(client);
	sDesktop = desktop;
	const status_t status = desktop->fThread->Start();
	if (status != B_OK) {
		sDesktop = nullptr;
		delete desktop;
	}
	return status;
}


void
Desktop::Stop()
{
	Desktop* desktop = sDesktop;
	if (desktop == nullptr)
		return;

	desktop->fThread->ReportQuit();
	desktop->fThread->Stop();
	sDesktop = nullptr;
	delete desktop;
}


Desktop*
Desktop::Get()
{
	return sDesktop;
}


Desktop::Desktop(ApplicationClient* client) : fThread(std::make_unique<DesktopThread>(client))
{
}


Desktop::~Desktop() = default;


void
Desktop::Post(std::function<void()> task)
{
	fThread->Post(std::move(task));
}


void
Desktop::RunOnDisplay(const std::function<void()>& task)
{
	fThread->RunOnDisplay(task);
}


bool
Desktop::IsDisplayThread() const
{
	return fThread->IsDisplayThread();
}


Worker&
Desktop::Activity()
{
	return fThread->Activity();
}


BRect
Desktop::ScreenFrame() const
{
	return fThread->ScreenFrame();
}


float
Desktop::Scale() const
{
	return fThread->Scale();
}


// #pragma mark - input


void
Desktop::GetMouse(BPoint* _screen, uint32* _buttons) const
{
	fThread->Input().GetPointer(_screen, _buttons);
}


uint32
Desktop::PointerSerial() const
{
	return fThread->Input().PointerSerial();
}


bool
Desktop::WaitForPointer(uint32 serial, bigtime_t timeout) const
{
	return fThread->Input().WaitForPointer(serial, timeout);
}


uint32
Desktop::Modifiers() const
{
	return fThread->Input().Modifiers();
}


void
Desktop::GetKeyStates(uint8 states[16]) const
{
	const std::array<uint8, 16> keys = fThread->Input().KeyStates();
	std::memcpy(states, keys.data(), keys.size());
}


bigtime_t
Desktop::DoubleClickTime() const
{
	return fThread->Input().DoubleClickTime();
}


void
Desktop::SetDoubleClickTime(bigtime_t time)
{
	fThread->Input().SetDoubleClickTime(time);
}


uint32
Desktop::ActiveWindow() const
{
	return fThread->Policy().ActiveId();
}


void
Desktop::SetCursor(const CursorShape& shape)
{
	Post([this, shape] { fThread->SetProgramCursor(shape); });
}


void
Desktop::SetCursorHidden(bool hidden)
{
	Post([this, hidden] { fThread->Pointer().SetCursorHidden(hidden); });
}


void
Desktop::ObscureCursor()
{
	Post([this] { fThread->Pointer().ObscureCursor(); });
}


void
Desktop::Beep()
{
	Post([this] { fThread->GetBackend().Beep(); });
}


void
Desktop::StartDrag(ServerWindow& window, std::unique_ptr<BMessage> message, const DragImage& image)
{
	auto session = std::make_shared<DragSession>(std::move(message), image);
	const int32 press = window.Record().handledPress;
	Post([this, id = window.Id(), press, session] {
		fThread->Pointer().StartDrag(fThread->Find(id), press, session);
	});
}


// #pragma mark - clipboard


void
Desktop::SetClipboard(const BMessage& data)
{
	fThread->Clipboard().Announce();
	Post([this, data] { fThread->Clipboard().Set(data); });
}


status_t
Desktop::GetClipboard(BMessage* _data)
{
	status_t status = B_ERROR;
	RunOnDisplay([&] { status = fThread->Clipboard().Get(_data); });
	return status;
}


uint32
Desktop::ClipboardSerial() const
{
	return fThread->Clipboard().Serial();
}


// #pragma mark - tests and scripts


void
Desktop::Inject(const BackendEvent& event, uint32 window)
{
	Post([this, event, window] {
		BackendEvent entered = event;
		if (window != 0) {
			const WindowReference record = fThread->Find(window);
			if (record == nullptr)
				return;
			entered.window = record->native.get();
			if (event.type == BackendEvent::Type::WindowChanged && event.frame != record->Frame())
				fThread->Expect(window, event.type);
		}
		fThread->GetBackend().Inject(entered);
	});
}


ScreenPicture
Desktop::Picture(BRect screen)
{
	ScreenPicture picture;
	RunOnDisplay([&] { picture = fThread->GetBackend().Picture(screen); });
	return picture;
}


CursorShape
Desktop::CursorAt(BPoint screen)
{
	CursorShape shape;
	RunOnDisplay([&] { shape = fThread->CursorAt(screen); });
	return shape;
}


status_t
Desktop::SavePicture(const char* path, BRect screen)
{
	return save_picture(Picture(screen), path);
}


void
Desktop::OpenFile(const char* path)
{
	entry_ref ref;
	if (get_ref_for_path(path, &ref) != B_OK)
		return;
	auto message = std::make_unique<BMessage>(B_REFS_RECEIVED);
	message->AddRef("refs", &ref);
	fThread->PostToApplication(std::move(message));
}


void
Desktop::SetInspector(Inspector* inspector)
{
	fThread->SetInspector(inspector);
}


std::string
Desktop::BackendName() const
{
	return fThread->BackendName();
}


} // namespace BPrivate
