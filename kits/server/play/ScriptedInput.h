// ScriptedInput: mouse and keys of a script or a test, entered at the backend.
#pragma once

#include <string_view>

#include <OS.h>
#include <Point.h>

#include "backend/BackendEvent.h"
#include "backend/KeyTable.h"

namespace BPrivate {


// Events carry times of their own, which go on far enough between two gestures that separate
// clicks are never taken for a double click. Nothing here waits. One thread.
class ScriptedInput {
public:
	BPoint Where() const { return fWhere; }
	uint32 Buttons() const { return fButtons; }

	// Modifiers as the platform's bits; they are held until another call says otherwise.
	void SetModifiers(uint32 modifiers);
	// Whatever the clock says, the next events follow each other at exactly that distance in
	// microseconds; 0 lets them have the time when they are entered.
	void SetSpacing(bigtime_t spacing) { fSpacing = spacing; }
	void BeginGesture();
	void Move(BPoint screen);
	void Leave(); // off all windows, with the button as it is
	void Press(uint32 button);
	void Release(uint32 button);
	void Wheel(BPoint delta);

	void KeyDown(const KeyStroke& stroke, int32 repeat = 0);
	void KeyUp(const KeyStroke& stroke);

	// A drag of another program over our windows: the field is named by its type.
	void ForeignDrag(BackendEvent::Type type, const BMessage& data);
	void DropOnFolder(const char* path);

private:
	BackendEvent _Event(BackendEvent::Type type);
	static void _Enter(const BackendEvent& event);

	BPoint fWhere;
	uint32 fButtons = 0;
	uint32 fModifiers = 0;
	bigtime_t fTime = 0;
	bigtime_t fSpacing = 0;
};


} // namespace BPrivate
