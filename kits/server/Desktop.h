// Desktop: the display thread with its backend, its windows and its input.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include <Message.h>
#include <Point.h>
#include <Rect.h>

#include "server/CursorShape.h"
#include "server/ScreenPicture.h"

namespace BPrivate {

class Backend;
class DesktopThread;
class Inspector;
class ServerWindow;
class Worker;
struct BackendEvent;


constexpr uint32 kClipboardChanged = 'CLCH';


// What the application hears from its desktop, on the display thread.
class ApplicationClient {
public:
	virtual ~ApplicationClient() = default;

	// B_APP_ACTIVATED, B_REFS_RECEIVED, B_QUIT_REQUESTED, kClipboardChanged. Takes ownership; may
	// take the lock of a message queue, never that of a looper.
	virtual void PostToApplication(BMessage* message) = 0;
};


struct DragImage {
	const void* bits = nullptr; // 32-bit BGRA at scale 1, copied by the call; NULL: an outline
	int32 width = 0, height = 0; // of the picture or of the outline
	int32 bytesPerRow = 0;
	BPoint offset; // of the pointer in the picture
	uint8 opacity = 255;
};


// One per program, started by BApplication. Unless a function says otherwise any thread may call
// it, with any lock held: it only posts to the display thread or reads a copied state.
class Desktop {
public:
	// Starts the display thread with the backend of the environment and returns when it runs.
	static status_t Start(ApplicationClient* client);
	// Ends the display thread; every ServerWindow is gone before. Not with a lock held.
	static void Stop();
	static Desktop* Get(); // NULL while there is none

	// Runs a task on the display thread, after those that were posted before.
	void Post(std::function<void()> task);
	// The same, and waits. The task takes no lock that the caller may hold.
	void RunOnDisplay(const std::function<void()>& task);
	bool IsDisplayThread() const;
	Worker& Activity();

	BRect ScreenFrame() const;
	float Scale() const;

	void GetMouse(BPoint* _screen, uint32* _buttons) const;
	// How many pointer events there were: unchanged means that nothing has moved since.
	uint32 PointerSerial() const;
	// Blocks until the serial differs from this one; false after so many microseconds.
	bool WaitForPointer(uint32 serial, bigtime_t timeout) const;
	uint32 Modifiers() const; // held now
	void GetKeyStates(uint8 states[16]) const; // key k is bit 7 - k % 8 of byte k / 8
	bigtime_t DoubleClickTime() const;
	void SetDoubleClickTime(bigtime_t time);
	uint32 ActiveWindow() const; // the id, 0 for none

	void SetCursor(const CursorShape& shape); // where a window has not set its own
	void SetCursorHidden(bool hidden);
	void ObscureCursor(); // until the pointer moves
	void Beep();

	// Drags a message for the press that `window` is handling; see DragSession. Takes the message,
	// with "buttons" and the reply target in it. Nothing happens if the button was never down.
	void StartDrag(ServerWindow& window, std::unique_ptr<BMessage> message, const DragImage& image);

	// The system clipboard: fields named by MIME type, 'MIME' each. Reading may ask another program
	// and waits for it. The serial changes whenever the contents do.
	void SetClipboard(const BMessage& data);
	status_t GetClipboard(BMessage* _data);
	uint32 ClipboardSerial() const;

	// For tests and play scripts.
	// At the backend's own entry. The id is of the window that the event names, 0 for none.
	void Inject(const BackendEvent& event, uint32 window = 0);
	ScreenPicture Picture(BRect screen);
	CursorShape CursorAt(BPoint screen); // of the pointer when it is there
	status_t SavePicture(const char* path, BRect screen); // PNG
	void OpenFile(const char* path); // what the desktop does when a file is opened
	// Borrowed; NULL before it goes, which waits until nobody is using it.
	void SetInspector(Inspector* inspector);
	std::string BackendName() const;

	DesktopThread& Thread() { return *fThread; }

private:
	explicit Desktop(ApplicationClient* client);
	~Desktop();

	std::unique_ptr<DesktopThread> fThread;
};


} // namespace BPrivate
