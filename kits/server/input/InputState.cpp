#include "server/input/InputState.h"

#include <chrono>

namespace BPrivate {


void
InputState::SetPointer(BPoint screen, uint32 buttons)
{
	{
		std::lock_guard lock(fLock);
		fWhere = screen;
		fButtons = buttons;
		fPointerSerial++;
	}
	fPointerChanged.notify_all();
}


void
InputState::SetModifiers(uint32 modifiers)
{
	std::lock_guard lock(fLock);
	fModifiers = modifiers;
}


void
InputState::SetKey(int32 key, bool down)
{
	if (key <= 0 || key > 127)
		return;

	std::lock_guard lock(fLock);
	const uint8 bit = static_cast<uint8>(0x80 >> (key % 8));
	if (down)
		fKeys[key / 8] |= bit;
	else
		fKeys[key / 8] &= ~bit;
}


void
InputState::ReleaseAllKeys()
{
	std::lock_guard lock(fLock);
	fKeys.fill(0);
}


void
InputState::GetPointer(BPoint* _screen, uint32* _buttons) const
{
	std::lock_guard lock(fLock);
	if (_screen != nullptr)
		*_screen = fWhere;
	if (_buttons != nullptr)
		*_buttons = fButtons;
}


uint32
InputState::PointerSerial() const
{
	std::lock_guard lock(fLock);
	return fPointerSerial;
}


bool
InputState::WaitForPointer(uint32 serial, bigtime_t timeout) const
{
	std::unique_lock lock(fLock);
	const auto changed = [&] { return fPointerSerial != serial; };
	if (timeout == B_INFINITE_TIMEOUT) {
		fPointerChanged.wait(lock, changed);
		return true;
	}
	return fPointerChanged.wait_for(lock, std::chrono::microseconds(timeout), changed);
}


uint32
InputState::Modifiers() const
{
	std::lock_guard lock(fLock);
	return fModifiers;
}


std::array<uint8, 16>
InputState::KeyStates() const
{
	std::lock_guard lock(fLock);
	return fKeys;
}


bigtime_t
InputState::DoubleClickTime() const
{
	std::lock_guard lock(fLock);
	return fDoubleClickTime;
}


void
InputState::SetDoubleClickTime(bigtime_t time)
{
	std::lock_guard lock(fLock);
	fDoubleClickTime = time;
}


} // namespace BPrivate
