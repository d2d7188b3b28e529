// LiveColorControl: a colour control that reports every change at once, also while it is dragged.
#pragma once

#include <ColorControl.h>

// What the panels' colour controls send, and what the platform's fields for the components do.
constexpr uint32 kLiveColorChanged = 'colr';
constexpr uint32 kColorComponentTyped = 'ccol';


// The message is sent for each value that is set, by the user or by the program: who loads the
// control from a view gets the message too.
class LiveColorControl : public BColorControl {
public:
	using BColorControl::BColorControl;
	~LiveColorControl() override;

	void SetValue(int32 value) override;
	void SetValue(rgb_color color); // without the alpha

	// Takes what is typed into the three component fields, the low eight bits of each. Beeps when
	// a field is missing.
	void SetValueFromComponents();
};
