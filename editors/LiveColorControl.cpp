#include "editors/LiveColorControl.h"

#include <cstdlib>

#include <Beep.h>
#include <TextControl.h>


LiveColorControl::~LiveColorControl()
{
}


void
LiveColorControl::SetValue(int32 value)
{
	BColorControl::SetValue(value);
	Invoke();
}


void
LiveColorControl::SetValue(rgb_color color)
{
	const uint32 packed = static_cast<uint32>(color.red) << 24
		| static_cast<uint32>(color.green) << 16 | static_cast<uint32>(color.blue) << 8;
	SetValue(static_cast<int32>(packed));
}


void
LiveColorControl::SetValueFromComponents()
{
	const BTextControl* red = dynamic_cast<BTextControl*>(FindView("_red"));
	const BTextControl* green = dynamic_cast<BTextControl*>(FindView("_green"));
	const BTextControl* blue = dynamic_cast<BTextControl*>(FindView("_blue"));
	if (red == nullptr || green == nullptr || blue == nullptr) {
		beep();
		return;
	}

	// Cut, not clamped: 300 is 44.
	const rgb_color color = { static_cast<uint8>(strtol(red->Text(), nullptr, 10)),
		static_cast<uint8>(strtol(green->Text(), nullptr, 10)),
		static_cast<uint8>(strtol(blue->Text(), nullptr, 10)), 0 };
	SetValue(color);
}
