// How colour controls are used by mouse and keys.
#include <ColorControl.h>

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <Window.h>

#include "interface/private/ColorControlParts.h"

using namespace BPrivate;

namespace {

constexpr int32 kRepeatsBeforeFast = 4;
constexpr int32 kFastStep = 5;

} // namespace


void
BColorControl::MouseDown(BPoint where)
{
	const int32 ramp = _RampAt(where);
	if (!IsEnabled() || ramp < 0) {
		BControl::MouseDown(where);
		return;
	}

	fTrackedRamp = ramp;
	if (fFocusedRamp != ramp) {
		fFocusedRamp = ramp;
		Invalidate(_PaletteFrame());
	}
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
	_TrackTo(where);
}


void
BColorControl::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (IsTracking())
		_TrackTo(where);
}


void
BColorControl::MouseUp(BPoint where)
{
	SetTracking(false);
	fTrackedRamp = -1;
}


void
BColorControl::_TrackTo(BPoint where)
{
	const BRect frame = _RampFrame(fTrackedRamp);
	const float part = std::clamp((where.x - frame.left) / frame.Width(), 0.0f, 1.0f);
	_ChangeRamp(fTrackedRamp, static_cast<int32>(part * 255));
}


void
BColorControl::KeyDown(const char* bytes, int32 numBytes)
{
	if (!IsEnabled() || numBytes != 1) {
		BControl::KeyDown(bytes, numBytes);
		return;
	}

	int32 repeats = 0;
	const BMessage* message = Window() != nullptr ? Window()->CurrentMessage() : nullptr;
	if (message != nullptr && message->FindInt32("be:key_repeat", &repeats) != B_OK)
		repeats = 0;
	const int32 step = repeats > kRepeatsBeforeFast ? kFastStep : 1;
	// From a colour that is no grey, the grey ramp starts at its red.
	int32 amount = _RampValue(fFocusedRamp);
	if (amount < 0)
		amount = ComponentOf(Value(), 0);

	switch (bytes[0]) {
		case B_UP_ARROW:
		case B_DOWN_ARROW: {
			const int32 direction = bytes[0] == B_UP_ARROW ? -1 : 1;
			fFocusedRamp = std::clamp<int32>(fFocusedRamp + direction, 0, kRampCount - 1);
			Invalidate(_PaletteFrame());
			break;
		}

		case B_LEFT_ARROW:
			_ChangeRamp(fFocusedRamp, amount - step);
			break;
		case B_RIGHT_ARROW:
			_ChangeRamp(fFocusedRamp, amount + step);
			break;
		default:
			// Not BControl's: Space and Enter have no other value to switch to.
			BView::KeyDown(bytes, numBytes);
			break;
	}
}
