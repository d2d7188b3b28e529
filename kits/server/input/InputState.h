// InputState: where the pointer is and which keys are held, for any thread to read.
#pragma once

#include <array>
#include <condition_variable>
#include <mutex>

#include <OS.h>
#include <Point.h>

namespace BPrivate {


// Written by the display thread.
class InputState {
public:
	void SetPointer(BPoint screen, uint32 buttons);
	void SetModifiers(uint32 modifiers);
	void SetKey(int32 key, bool down);
	void ReleaseAllKeys();

	void GetPointer(BPoint* _screen, uint32* _buttons) const;
	uint32 PointerSerial() const;
	// False when the serial is still the same after so many microseconds.
	bool WaitForPointer(uint32 serial, bigtime_t timeout) const;
	uint32 Modifiers() const;
	std::array<uint8, 16> KeyStates() const;
	bigtime_t DoubleClickTime() const;
	void SetDoubleClickTime(bigtime_t time);

private:
	mutable std::mutex fLock;
	mutable std::condition_variable fPointerChanged;
	BPoint fWhere;
	uint32 fButtons = 0;
	uint32 fPointerSerial = 0;
	uint32 fModifiers = 0;
	std::array<uint8, 16> fKeys {};
	bigtime_t fDoubleClickTime = 500000;
};


} // namespace BPrivate
