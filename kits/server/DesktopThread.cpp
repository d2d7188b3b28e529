#include "server/DesktopThread.h"

#include <algorithm>
#include <condition_variable>
#include <cstdlib>
#include <filesystem>

#include <AppDefs.h>

#include "server/ClipboardBridge.h"
#include "server/Desktop.h"
#include "server/input/KeyboardInput.h"
#include "server/input/PointerInput.h"
#include "server/input/WindowPolicy.h"
#include "server/play/PlayRunner.h"

namespace BPrivate {


class StartSignal {
public:
	void Send(status_t status)
	{
		std::lock_guard lock(fLock);
		fStatus = status;
		fSent = true;
		fChanged.notify_all();
	}

	status_t Wait()
	{
		std::unique_lock lock(fLock);
		fChanged.wait(lock, [this] { return fSent; });
		return fStatus;
	}

private:
	std::mutex fLock;
	std::condition_variable fChanged;
	status_t fStatus = B_OK;
	bool fSent = false;
};


DesktopThread::DesktopThread(ApplicationClient* client) :
	fClient(client), fPointer(std::make_unique<PointerInput>(*this)),
	fKeyboard(std::make_unique<KeyboardInput>(*this)),
	fPolicy(std::make_unique<WindowPolicy>(*this)),
	fClipboard(std::make_unique<ClipboardBridge>(*this))
{
}


DesktopThread::~DesktopThread()
{
	Stop();
}


status_t
DesktopThread::Start()
{
	StartSignal signal;
	fThread = std::thread([this, &signal] { _Run(signal); });
	const status_t status = signal.Wait();
	if (status != B_OK) {
		fThread.join();
		return status;
	}

	const char* script = std::getenv("ARCHWAY_PLAY");
	if (script != nullptr && script[0] != '\0') {
		fPlay = std::make_unique<PlayRunner>(*this, script);
		fPlay->Start();
	}
	return B_OK;
}


void
DesktopThread::Stop()
{
	fPlay.reset();
	if (!fThread.joinable())
		return;

	Post([this] { fBackend->Stop(); });
	fThread.join();
}


void
DesktopThread::_Run(StartSignal& signal)
{
	fThreadId = std::this_thread::get_id();
	std::unique_ptr<Backend> backend = make_backend();
	const status_t status = backend != nullptr ? backend->Open(this) : B_ERROR;
	if (status == B_OK) {
		std::lock_guard lock(fPostLock);
		fBackendName = backend->Name();
		fBackend = std::move(backend);
		_ScreenChanged();
	}
	signal.Send(status);
	if (status != B_OK)
		return;

	fBackend->Run();

	fPointer->Clear();
	fWindows.clear();
	{
		std::lock_guard lock(fPostLock);
		fBackend.reset();
	}
	// The drags, which the backend may have kept, are gone now too.
	for (const std::string& folder : fFolders) {
		std::error_code ignored;
		std::filesystem::remove_all(folder, ignored);
	}
}


// #pragma mark - any thread


void
DesktopThread::Post(std::function<void()> task)
{
	std::lock_guard lock(fPostLock);
	if (fBackend == nullptr)
		return;

	fActivity.AddWork();
	fBackend->Post([this, task = std::move(task)] {
		task();
		fActivity.WorkDone();
	});
}


void
DesktopThread::RunOnDisplay(const std::function<void()>& task)
{
	if (IsDisplayThread()) {
		task();
		return;
	}

	// The signal is sent when the task is let go of, run or not: a loop that ends drops its tasks,
	// and must not leave the caller waiting.
	struct Ender {
		explicit Ender(StartSignal& signal) : signal(signal) {}
		~Ender() { signal.Send(B_OK); }
		StartSignal& signal;
	};
	StartSignal signal;
	auto ender = std::make_shared<Ender>(signal);
	Post([&task, ender = std::move(ender)] { task(); });
	signal.Wait();
}


bool
DesktopThread::IsDisplayThread() const
{
	return std::this_thread::get_id() == fThreadId.load();
}


BRect
DesktopThread::ScreenFrame() const
{
	std::lock_guard lock(fLock);
	return fScreenFrame;
}


void
DesktopThread::PostToApplication(std::unique_ptr<BMessage> message)
{
	if (fClient != nullptr)
		fClient->PostToApplication(message.release());
}


void
DesktopThread::SetInspector(Inspector* inspector)
{
	if (fInspector == inspector)
		return;
	std::lock_guard lock(fInspectorLock);
	fInspector = inspector;
}


bool
DesktopThread::Inspect(const std::function<void(Inspector&)>& use)
{
	std::lock_guard lock(fInspectorLock);
	if (fInspector == nullptr)
		return false;
	use(*fInspector.load());
	return true;
}


WindowReference
DesktopThread::AddWindow(WindowClient* client, const WindowRecord::Properties& properties)
{
	auto window = std::make_shared<WindowRecord>(fNextId++, client, properties);
	Post([this, window] {
		fWindows.push_back(window);
		window->native = fBackend->MakeWindow(&window->Front(), window->Traits());
		window->native->SetCursor(fProgramCursor);
	});
	return window;
}


void
DesktopThread::RemoveWindow(const WindowReference& window)
{
	window->Detach();
	Post([this, window] {
		Show(window, false);
		fPointer->WindowGone(window);
		fPolicy->WindowGone(window);
		std::erase(fWindows, window);
		std::erase_if(fExpectations, [this, &window](const Expectation& expectation) {
			const bool ours = expectation.window == window->Id();
			if (ours)
				fActivity.WorkDone();
			return ours;
		});
		UpdateOwners();
		window->native.reset();
	});
}


void
DesktopThread::ReportQuit()
{
	if (fPlay != nullptr)
		fPlay->ProgramEnds();
}


// #pragma mark - windows


WindowReference
DesktopThread::Find(const BackendWindow* native) const
{
	if (native == nullptr)
		return nullptr;
	for (const WindowReference& window : fWindows) {
		if (window->native.get() == native)
			return window;
	}
	return nullptr;
}


WindowReference
DesktopThread::Find(uint32 id) const
{
	for (const WindowReference& window : fWindows) {
		if (window->Id() == id)
			return window;
	}
	return nullptr;
}


WindowReference
DesktopThread::WindowAt(BPoint screen) const
{
	return Find(fBackend->WindowAt(screen));
}


void
DesktopThread::Show(const WindowReference& window, bool show)
{
	window->wantsShown = show;
	_ShowNative(window, show && fPolicy->MayBeSeen(*window));
}


void
DesktopThread::UpdateFloating()
{
	// Showing a window may end in reports that add or remove others.
	const std::vector<WindowReference> windows = fWindows;
	for (const WindowReference& window : windows) {
		if (window->IsFloating())
			_ShowNative(window, window->wantsShown && fPolicy->MayBeSeen(*window));
	}
}


void
DesktopThread::_ShowNative(const WindowReference& window, bool show)
{
	if (window->native == nullptr || window->nativeShown == show)
		return;

	window->nativeShown = show;
	if (show) {
		window->shownSerial = fNextSerial++;
		UpdateOwners();
		Expect(window->Id(), BackendEvent::Type::WindowShown);
	} else {
		for (const auto event : { BackendEvent::Type::WindowShown,
				 BackendEvent::Type::WindowActivated, BackendEvent::Type::WindowChanged })
			Settle(window->Id(), event);
		fPointer->WindowHidden(window);
		// The desktop will choose another of our windows, or one of another program.
		if (window == fPolicy->Active())
			Expect(kAnyWindow, BackendEvent::Type::WindowActivated);
	}
	window->native->SetShown(show);
	if (window->IsMenu())
		fPointer->UpdateGrab();
	if (!show)
		fPolicy->WindowHidden(window);
	fPointer->WindowsRearranged();
}


void
DesktopThread::ApplyTraits(const WindowReference& window)
{
	if (window->native == nullptr)
		return;
	window->native->SetTraits(window->Traits());
	_ShowNative(window, window->wantsShown && fPolicy->MayBeSeen(*window));
	UpdateOwners();
	fPointer->WindowsRearranged();
}


void
DesktopThread::Activate(const WindowReference& window)
{
	if (window->native == nullptr || !window->nativeShown)
		return;
	if (!window->Traits().takesFocus) {
		window->native->Raise();
		return;
	}
	if (!window->active)
		Expect(window->Id(), BackendEvent::Type::WindowActivated);
	window->native->Activate();
	fPointer->WindowsRearranged();
}


void
DesktopThread::Flush(const WindowReference& window)
{
	window->flushPending = false;
	const BRegion pending = window->Front().TakePending();
	if (window->native == nullptr || pending.CountRects() == 0)
		return;
	window->flushes++;
	for (int32 i = 0; i < pending.CountRects(); i++) {
		const clipping_rect part = pending.RectAtInt(i);
		window->flushedPixels += int64(part.right - part.left + 1) * (part.bottom - part.top + 1);
	}
	window->native->Flush(pending);
}


// A floating or modal window stays above those that it belongs to: its subset, or all.
void
DesktopThread::UpdateOwners()
{
	for (const WindowReference& window : fWindows) {
		if (window->native != nullptr)
			window->native->SetOwner(fPolicy->OwnerOf(window), !window->HasSubset());
	}
}


void
DesktopThread::SetProgramCursor(const CursorShape& shape)
{
	fProgramCursor = shape;
	for (const WindowReference& window : fWindows) {
		if (!window->hasCursor)
			window->native->SetCursor(shape);
	}
}


CursorShape
DesktopThread::CursorAt(BPoint screen) const
{
	const WindowReference window = WindowAt(screen);
	return window != nullptr && window->hasCursor ? window->cursor : fProgramCursor;
}


void
DesktopThread::SetWindowCursor(const WindowReference& window, const CursorShape& shape)
{
	if (window->native == nullptr || (window->hasCursor && window->cursor == shape))
		return;
	window->hasCursor = shape.id != CursorShape::kProgram;
	window->cursor = shape;
	window->native->SetCursor(window->hasCursor ? shape : fProgramCursor);
}


} // namespace BPrivate
