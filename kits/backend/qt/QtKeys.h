// QtKeys: keys, buttons, modifiers and cursors in the platform's units.
#pragma once

#include <QCursor>
#include <QKeyEvent>

#include "backend/BackendEvent.h"

namespace BPrivate {

struct CursorShape;


uint32 buttons_of(Qt::MouseButtons buttons);

// Keeps which modifier keys are held on which side; a desktop tells the sides by key events alone.
class ModifierState {
public:
	uint32 Update(Qt::KeyboardModifiers modifiers);
	void Note(const QKeyEvent& event, bool down);
	uint32 Current() const { return fModifiers; }
	void Clear() { fModifiers = fRight = 0; }

private:
	uint32 fModifiers = 0;
	uint32 fRight = 0; // right-hand bits of the keys that are held there
};

// Fills in key, text and rawCharacter.
void describe_key(const QKeyEvent& event, BackendEvent* _event);

QCursor cursor_of(const CursorShape& shape);


} // namespace BPrivate
