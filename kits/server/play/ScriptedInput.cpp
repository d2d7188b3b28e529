#include "server/play/ScriptedInput.h"

#include <algorithm>

#include <InterfaceDefs.h>

#include "server/Desktop.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kBetweenEvents = 1000;

} // namespace


BackendEvent
ScriptedInput::_Event(BackendEvent::Type type)
{
	if (fSpacing > 0)
		fTime += fSpacing;
	else
		fTime = std::max(system_time(), fTime + kBetweenEvents);

	BackendEvent event;
	event.type = type;
	event.when = fTime;
	event.where = fWhere;
	event.buttons = fButtons;
	event.modifiers = fModifiers;
	return event;
}


void
ScriptedInput::_Enter(const BackendEvent& event)
{
	if (Desktop* desktop = Desktop::Get())
		desktop->Inject(event);
}


void
ScriptedInput::SetModifiers(uint32 modifiers)
{
	modifiers = complete_modifiers(modifiers);
	if (modifiers == fModifiers)
		return;
	fModifiers = modifiers;
	_Enter(_Event(BackendEvent::Type::ModifiersChanged));
}


void
ScriptedInput::BeginGesture()
{
	if (const Desktop* desktop = Desktop::Get())
		fTime = std::max(system_time(), fTime + desktop->DoubleClickTime() + kBetweenEvents);
}


void
ScriptedInput::Move(BPoint screen)
{
	fWhere = screen;
	_Enter(_Event(BackendEvent::Type::PointerMoved));
}


void
ScriptedInput::Leave()
{
	_Enter(_Event(BackendEvent::Type::PointerLeft));
}


void
ScriptedInput::Press(uint32 button)
{
	fButtons |= button;
	BackendEvent event = _Event(BackendEvent::Type::ButtonPressed);
	event.button = button;
	_Enter(event);
}


void
ScriptedInput::Release(uint32 button)
{
	fButtons &= ~button;
	BackendEvent event = _Event(BackendEvent::Type::ButtonReleased);
	event.button = button;
	_Enter(event);
}


void
ScriptedInput::Wheel(BPoint delta)
{
	BackendEvent event = _Event(BackendEvent::Type::WheelTurned);
	event.delta = delta;
	_Enter(event);
}


void
ScriptedInput::KeyDown(const KeyStroke& stroke, int32 repeat)
{
	BackendEvent event = _Event(BackendEvent::Type::KeyPressed);
	event.key = stroke.key;
	event.text = stroke.text;
	event.rawCharacter = stroke.rawCharacter;
	event.repeat = repeat;
	if (stroke.shift)
		event.modifiers = complete_modifiers(event.modifiers | B_SHIFT_KEY);
	_Enter(event);
}


void
ScriptedInput::KeyUp(const KeyStroke& stroke)
{
	BackendEvent event = _Event(BackendEvent::Type::KeyReleased);
	event.key = stroke.key;
	event.text = stroke.text;
	event.rawCharacter = stroke.rawCharacter;
	if (stroke.shift)
		event.modifiers = complete_modifiers(event.modifiers | B_SHIFT_KEY);
	_Enter(event);
}


void
ScriptedInput::ForeignDrag(BackendEvent::Type type, const BMessage& data)
{
	BackendEvent event = _Event(type);
	event.message = data;
	_Enter(event);
}


void
ScriptedInput::DropOnFolder(const char* path)
{
	fButtons = 0;
	BackendEvent event = _Event(BackendEvent::Type::FolderDropped);
	event.text = path;
	_Enter(event);
}


} // namespace BPrivate
