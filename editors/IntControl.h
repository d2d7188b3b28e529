// IntControl: a text control that holds a whole number in a range.
#pragma once

#include "editors/NumberControl.h"


// Where the platform's int32 is int, SetValue(int) is also the override of
// BControl::SetValue(int32), whose integer no text control uses.
class IntControl : public NumberControl<int> {
public:
	IntControl(BRect frame, const char* name, const char* label, BMessage* message, int value,
		int min, int max, uint32 resizingMode, uint32 flags);

	// Clamps and shows.
	void SetValue(int value);

	// What the text says; not clamped, 0 for a text without digits at its start.
	int Value() const;
};
