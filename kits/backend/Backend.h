// Backend: the narrow seam to the desktop. It shows pixels and reports input, nothing else.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <Message.h>
#include <Point.h>
#include <Rect.h>
#include <Region.h>

#include "backend/BackendEvent.h"
#include "server/ScreenPicture.h"

namespace BPrivate {

class FrontImage;
struct CursorShape;


// What a native window is to its desktop; the server derives it from look, feel and flags.
struct WindowTraits {
	enum class Kind { Normal, Floating, Modal, Menu };

	Kind kind = Kind::Normal;
	std::string title;
	BRect frame; // contents, logical screen coordinates
	float minWidth = 0, maxWidth = 32767, minHeight = 0, maxHeight = 32767; // right - left
	bool hasBorder = true;
	bool hasTitle = true;
	bool movable = true, resizable = true, closable = true, minimizable = true, zoomable = true;
	bool takesFocus = true;
};


// One native window. Display thread only.
class BackendWindow {
public:
	virtual ~BackendWindow() = default;

	// Everything may change while the window is shown. Moves and sizes are reported back as
	// events, with the frame that the desktop really gave.
	virtual void SetTraits(const WindowTraits& traits) = 0;
	// Stays above its owner, NULL for none; or above all normal windows of the program, where the
	// owner stands for them on desktops that cannot do better.
	virtual void SetOwner(BackendWindow* owner, bool aboveAll) = 0;
	virtual void SetShown(bool shown) = 0;
	virtual void SetMinimized(bool minimized) = 0;
	virtual void Activate() = 0; // raise, and ask for the keyboard
	virtual void Raise() = 0;
	virtual void PutBehind(BackendWindow* other) = 0; // NULL: behind all
	virtual void SetCursor(const CursorShape& shape) = 0;
	virtual void SetTextSpot(BRect screen) = 0; // where an input method shows its window

	// The front image has changed in these device pixels; shows them with one flush.
	virtual void Flush(const BRegion& devicePixels) = 0;
};


// What the server does with reports. Display thread only.
class BackendSink {
public:
	virtual ~BackendSink() = default;
	virtual void HandleEvent(const BackendEvent& event) = 0;
};


// What another program is offered of a drag or of the clipboard. Data of a type is asked for when
// it is wanted, on the display thread.
struct DataOffer {
	std::vector<std::string> types;
	std::function<bool(const std::string& type, std::string* _data)> get;
};


// One display. Made, run and deleted on the display thread; only Post() and Inject() may be called
// by other threads.
class Backend {
public:
	virtual ~Backend() = default;

	virtual const char* Name() const = 0;
	virtual status_t Open(BackendSink* sink) = 0;
	virtual void Run() = 0; // until Stop(); posted tasks run in the order of their posting
	virtual void Stop() = 0;
	virtual void Post(std::function<void()> task) = 0;
	// Runs a task after this many microseconds; display thread only.
	virtual void PostLater(bigtime_t delay, std::function<void()> task) = 0;
	// Handles what is waiting, and waits up to this many microseconds for more; display thread only.
	virtual void RunNested(bigtime_t timeout) = 0;

	virtual BRect ScreenFrame() const = 0; // logical
	virtual float Scale() const = 0; // device pixels per logical unit
	// Whether requests to windows are carried out, and reported, before the call returns.
	virtual bool IsImmediate() const = 0;

	// The window shows what this image holds, which outlives it.
	virtual std::unique_ptr<BackendWindow> MakeWindow(
		FrontImage* image, const WindowTraits& traits) = 0;
	virtual BackendWindow* WindowAt(BPoint screen) const = 0; // of ours, frontmost; or NULL

	// Enters an event at the place where the desktop's own would come in. Its window is found by
	// its place, or is the active one.
	virtual void Inject(const BackendEvent& event) = 0;

	// Whether the desktop made this window active because of the press that is being reported.
	virtual bool ActivatedByPress(const BackendWindow* window) const = 0;
	virtual void SetPointerGrab(BackendWindow* window) = 0; // every press comes in; NULL ends it
	virtual void SetCursorHidden(bool hidden) = 0;
	virtual void Beep() = 0;

	// The translucent picture under the pointer; NULL ends it. Bits are 32-bit BGRA, device pixels.
	virtual void SetDragPicture(const ScreenPicture* picture, BPoint offset) = 0;
	// Hands the drag over to the desktop, until a DragFinished event comes. False if it cannot.
	virtual bool StartDesktopDrag(const DataOffer& offer, int32 session, uint32 buttons) = 0;

	virtual void SetClipboard(const DataOffer& offer) = 0;
	virtual DataOffer Clipboard() = 0; // valid until control returns to the loop
	virtual bool OwnsClipboard() const = 0;

	// What the screen shows, or a part of it in logical coordinates.
	virtual ScreenPicture Picture(BRect screen) = 0;
};


// Made of the environment: ARCHWAY_BACKEND names one; without it a display is used if there is one,
// and the headless one otherwise. NULL, with a message on standard error, when the name is unknown.
std::unique_ptr<Backend> make_backend();

std::unique_ptr<Backend> make_headless_backend();
std::unique_ptr<Backend> make_qt_backend();


} // namespace BPrivate
