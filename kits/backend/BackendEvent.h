// BackendEvent: what a backend reports, in the platform's units.
#pragma once

#include <string>

#include <Message.h>
#include <Point.h>
#include <Rect.h>

namespace BPrivate {

class BackendWindow;


// Which members count depends on the type. Screen coordinates are logical.
struct BackendEvent {
	enum class Type {
		PointerMoved, // where, buttons
		ButtonPressed, // where, buttons (all that are held now), button (the one)
		ButtonReleased, // the same
		WheelTurned, // where, delta
		PointerLeft, // the pointer is over none of our windows
		KeyPressed, // key, text, rawCharacter, modifiers, repeat
		KeyReleased,
		ModifiersChanged,
		TextEntered, // text, from an input method
		TextComposed, // text not yet confirmed, empty when composition ends
		WindowActivated, // window; NULL when none of ours is active
		WindowChanged, // window, frame: moved or sized
		WindowShown, // window: its pixels are on the screen
		CloseRequested,
		Minimized, // flag
		ScreenChanged,
		ClipboardChanged,
		DragEntered, // where, message: a drag of another program; our own comes home by session
		DragMoved,
		DragLeft,
		Dropped, // where, message
		FolderDropped, // injected only: the desktop's drag ends on the folder that text names
		DragFinished // flag: a desktop drag ended, accepted or not
	};

	Type type = Type::PointerMoved;
	BackendWindow* window = nullptr; // borrowed; the one that the desktop names
	bigtime_t when = 0; // system_time(); 0 is filled in
	BPoint where;
	uint32 buttons = 0;
	uint32 button = 0;
	uint32 modifiers = 0;
	BPoint delta; // wheel notches; positive scrolls down and to the right
	int32 key = 0; // the platform's key codes, 1 (Escape) to 0x7f
	std::string text; // UTF-8, or the platform's character of a special key
	int32 rawCharacter = 0;
	int32 repeat = 0; // how often the held key repeated, 0 for the press itself
	BRect frame;
	bool flag = false;
	BMessage message;
	int32 session = 0; // of our own drag that comes home, 0 for a foreign one
};


} // namespace BPrivate
