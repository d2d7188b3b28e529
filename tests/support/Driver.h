// Driver: mouse and keys for tests, entered at the headless backend.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include <GraphicsDefs.h>
#include <OS.h>
#include <Point.h>
#include <Rect.h>
#include <SupportDefs.h>

class BView;
class BWindow;

namespace BPrivate {
class ScriptedInput;
struct BackendEvent;
} // namespace BPrivate


// Each call waits until the program is idle, acts, and waits again: what the input has caused is
// done when it returns. Modifiers are the platform's bits; B_CONTROL_KEY and B_COMMAND_KEY are one
// key. Clicks of separate calls never make a double click. Use it from the test's thread, with no
// window locked (a view's place is found under its window's lock).
class Driver {
public:
	Driver();
	~Driver();

	// Screen coordinates of a point in a view, or of the middle of its visible part.
	static BPoint PointIn(BView* view, BPoint where);
	static BPoint MiddleOf(BView* view);

	void MoveTo(BPoint screen, uint32 modifiers = 0);
	void MoveTo(BView* view);
	void MoveTo(BView* view, BPoint where, uint32 modifiers = 0);
	void Press(uint32 button = 1, uint32 modifiers = 0, int32 clicks = 1); // where the pointer is
	void Release(uint32 button = 1, uint32 modifiers = 0);

	void Click(BPoint screen, int32 times = 1, uint32 button = 1, uint32 modifiers = 0);
	void Click(BView* view, int32 times = 1, uint32 button = 1, uint32 modifiers = 0);
	void Click(BView* view, BPoint where, int32 times = 1, uint32 button = 1, uint32 modifiers = 0);
	void Drag(BPoint from, BPoint to, int32 steps = 10, uint32 button = 1, uint32 modifiers = 0);
	void Drag(BView* from, BPoint fromWhere, BView* to, BPoint toWhere, int32 steps = 10);
	void DropFile(const char* path, BPoint screen); // from another program
	void Wheel(BPoint screen, float deltaX, float deltaY);
	void Wheel(BView* view, float deltaX, float deltaY);

	void Type(std::string_view utf8); // '\n' is Return, '\t' Tab
	// A name of the play language ("Return", "Left", "F1", ...) or one character.
	void Key(const char* name, uint32 modifiers = 0, int32 times = 1);
	// A key to which the keyboard's layout gives several bytes, none of them zero.
	void KeyThatTypes(std::string_view bytes);
	void KeyDown(const char* name, uint32 modifiers = 0);
	void KeyUp(const char* name, uint32 modifiers = 0);

	// The times that the events carry: each that much later than the one before, in microseconds,
	// whatever the clock says; 0 for the time when they are entered.
	void SetSpacing(bigtime_t spacing);
	static bigtime_t DoubleClickTime();

	// As by the window's frame, from the desktop.
	void ResizeWindow(BWindow* window, float width, float height); // right - left, bottom - top
	void MoveWindow(BWindow* window, BPoint leftTop);
	void CloseWindow(BWindow* window);
	void ActivateWindow(BWindow* window);

	// Input that is entered without waiting before or after, for races on purpose.
	void SetWaiting(bool wait) { fWait = wait; }

	// Aborts the test after a minute, as a hang.
	static void WaitUntilIdle();

	// What the user has heard so far.
	static int32 CountBeeps();

	// The platform's id of the pointer's shape there.
	int32 CursorAt(BPoint screen);
	rgb_color PixelAt(BPoint screen); // of what the screen shows; scale 1
	rgb_color PixelAt(BView* view, BPoint where);
	bool Screenshot(const char* path); // PNG

private:
	void _Wait() const;
	void _Key(bool down, const char* name, uint32 modifiers);
	void _Window(BWindow* window, BPrivate::BackendEvent event);

	std::unique_ptr<BPrivate::ScriptedInput> fInput;
	bool fWait = true;
};
