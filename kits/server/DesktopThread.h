// DesktopThread: what lives on the display thread, behind the Desktop's calls.
#pragma once

#include <atomic>
#include <memory>
#include <mutex>
#include <thread>
#include <vector>

#include "backend/Backend.h"
#include "kernel/private/Activity.h"
#include "server/CursorShape.h"
#include "server/WindowRecord.h"
#include "server/input/InputState.h"

namespace BPrivate {

class ApplicationClient;
class ClipboardBridge;
class Inspector;
class KeyboardInput;
class PlayRunner;
class PointerInput;
class WindowPolicy;


// Windows are given by records; one of a window that has gone is harmless. Unless marked "any
// thread", functions are for the display thread alone.
class DesktopThread : public BackendSink {
public:
	explicit DesktopThread(ApplicationClient* client);
	~DesktopThread() override;

	// Any thread but the display thread itself; Start() returns when the loop is about to run.
	status_t Start();
	void Stop();

	// Any thread.
	void Post(std::function<void()> task);
	void RunOnDisplay(const std::function<void()>& task);
	bool IsDisplayThread() const;
	Worker& Activity() { return fActivity; }
	InputState& Input() { return fInput; }
	BRect ScreenFrame() const;
	float Scale() const { return fScale; }
	const std::string& BackendName() const { return fBackendName; }
	void PostToApplication(std::unique_ptr<BMessage> message);
	void SetInspector(Inspector* inspector);
	// False, and nothing is called, while there is no inspector.
	bool Inspect(const std::function<void(Inspector&)>& use);
	WindowReference AddWindow(WindowClient* client, const WindowRecord::Properties& properties);
	void RemoveWindow(const WindowReference& window);
	void ReportQuit(); // the program is about to end; a script that goes on has failed

	Backend& GetBackend() { return *fBackend; }
	PointerInput& Pointer() { return *fPointer; }
	KeyboardInput& Keyboard() { return *fKeyboard; }
	WindowPolicy& Policy() { return *fPolicy; }
	ClipboardBridge& Clipboard() { return *fClipboard; }

	const std::vector<WindowReference>& Windows() const { return fWindows; }
	WindowReference Find(const BackendWindow* native) const; // NULL if there is none
	WindowReference Find(uint32 id) const;
	WindowReference WindowAt(BPoint screen) const;

	void Show(const WindowReference& window, bool show); // as the program wants it
	// Shows the floating windows that may be seen now, and takes the others off the screen.
	void UpdateFloating();
	void ApplyTraits(const WindowReference& window);
	void Activate(const WindowReference& window);
	void Flush(const WindowReference& window);
	void UpdateOwners();

	// Deletes a folder of ours with its files when the program ends.
	void RemoveLater(const std::string& folder) { fFolders.push_back(folder); }

	// The window's own cursor, else the program's.
	CursorShape CursorAt(BPoint screen) const;
	void SetProgramCursor(const CursorShape& shape);
	void SetWindowCursor(const WindowReference& window, const CursorShape& shape);

	void HandleEvent(const BackendEvent& event) override;

	// Counts as work until Settle() of the same window and event, or a second has gone: a desktop
	// answers such requests in its own time. A window is given by its id, or kAnyWindow.
	static constexpr uint32 kAnyWindow = 0;
	void Expect(uint32 window, BackendEvent::Type event);
	void Settle(uint32 window, BackendEvent::Type event);

private:
	struct Expectation {
		uint32 window;
		BackendEvent::Type event;
		int64 serial;
	};

	void _Run(class StartSignal& signal);
	void _ShowNative(const WindowReference& window, bool show);
	void _WindowChanged(const BackendEvent& event);
	void _ScreenChanged();

	ApplicationClient* fClient; // borrowed
	Worker fActivity;
	InputState fInput;
	std::thread fThread;
	std::atomic<std::thread::id> fThreadId {};
	std::string fBackendName;
	std::atomic<float> fScale { 1 };
	mutable std::mutex fLock; // of the screen's frame
	BRect fScreenFrame;
	std::mutex fInspectorLock; // held while it is used
	std::atomic<Inspector*> fInspector { nullptr }; // borrowed
	std::atomic<uint32> fNextId { 1 };
	std::mutex fPostLock; // of fBackend for posting, while it comes and goes

	std::unique_ptr<Backend> fBackend;
	std::vector<WindowReference> fWindows; // in the order of their making
	std::unique_ptr<PointerInput> fPointer;
	std::unique_ptr<KeyboardInput> fKeyboard;
	std::unique_ptr<WindowPolicy> fPolicy;
	std::unique_ptr<ClipboardBridge> fClipboard;
	CursorShape fProgramCursor;
	std::vector<Expectation> fExpectations;
	int64 fNextSerial = 1;
	std::vector<std::string> fFolders;

	std::unique_ptr<PlayRunner> fPlay;
};


} // namespace BPrivate
