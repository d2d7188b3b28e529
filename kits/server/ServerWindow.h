// ServerWindow: one window of the desktop, as the thread of its BWindow sees it.
#pragma once

#include <memory>
#include <string>

#include <Message.h>
#include <Rect.h>
#include <Region.h>

namespace BPrivate {

class Surface;
class WindowRecord;
struct CursorShape;

// Menus, drawn above everything. Never active; no first click, modality or capture applies to them.
// While one is shown that wants all pointer events, presses outside menus reach only such windows
// (marked "elsewhere") and are lost for the window under the pointer, and keys go to the menu window
// that was shown last instead of the active window.
constexpr uint32 kMenuWindowFeel = 1025;

// The feel of a tool tip's window: above all others as a menu is, but with no part in the input.
constexpr uint32 kTipWindowFeel = 1026;

// A bool in a mouse message: true if the pointer is not over this window, because it is over
// another or outside; such a message concerns views with an event mask, and a view to be left.
constexpr const char* kPointerElsewhere = "be:elsewhere";

// The answer to Desktop::StartDrag(): the drag has begun, or is over because the button had been
// released before; then its drop came first.
constexpr uint32 kDragDecided = '_DDC';


// Receives the events of one window, on the display thread.
class WindowClient {
public:
	virtual ~WindowClient() = default;

	// Takes ownership. May take the lock of a message queue, never that of a looper.
	virtual void PostInput(BMessage* message) = 0;
};


// Calls return at once: they are carried out by the display thread in the order they were made, and
// nothing waits for that thread. Sizes are the platform's (right - left). The object belongs to the
// thread that has the window's lock; functions marked "any thread" may be called without.
class ServerWindow {
public:
	// Look, feel and flags are the platform's values. Hidden until Show().
	ServerWindow(WindowClient* client, BRect frame, const char* title, uint32 look, uint32 feel,
		uint32 flags);
	// No event reaches the client afterwards, not even one that is being delivered.
	~ServerWindow();
	ServerWindow(const ServerWindow&) = delete;
	ServerWindow& operator=(const ServerWindow&) = delete;

	uint32 Id() const; // any thread; unique in the program, never 0

	void SetTitle(const char* title);
	void SetKind(uint32 look, uint32 feel, uint32 flags);
	void SetSizeLimits(float minWidth, float maxWidth, float minHeight, float maxHeight);
	void AddToSubset(const ServerWindow& main); // for subset feels
	void RemoveFromSubset(const ServerWindow& main);

	// The contents in screen coordinates: the frame last set or reported by the desktop, whichever
	// is newer. Every change is reported by B_WINDOW_MOVED and B_WINDOW_RESIZED, also one's own.
	BRect Frame() const; // any thread
	void SetFrame(BRect frame);

	void Show();
	void Hide();
	void Minimize(bool minimize);
	void Activate(bool activate = true); // B_WINDOW_ACTIVATED follows when it has happened
	void SendBehind(const ServerWindow* other); // NULL: behind all
	bool IsShown() const; // any thread
	bool IsActive() const; // any thread; as the display thread sees it
	bool IsFront() const; // any thread

	// While set, every pointer event of the program comes here, see kPointerElsewhere.
	void SetWantsAllPointerEvents(bool wants);
	// To be called before a mouse message is dispatched, so that a drag started meanwhile belongs
	// to the press that is being handled, even if it has long been released.
	void BeginInput(const BMessage& message);
	void SetCursor(const CursorShape& shape);
	void SetTextSpot(BRect screen);

	// The image that the window's thread paints. Its size follows the frame at Prepare(), which
	// keeps the pixels that both sizes share and returns whether the size has changed.
	float Scale() const; // any thread; device pixels per logical unit
	Surface& Back();
	bool Prepare();

	// Shows what was painted; logical window coordinates. One flush, or none if one is pending.
	void Present(const BRegion& damage);

	WindowRecord& Record() const { return *fRecord; }

private:
	std::shared_ptr<WindowRecord> fRecord; // shared with the display thread
	std::unique_ptr<Surface> fBack;
};


} // namespace BPrivate
