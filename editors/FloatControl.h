// FloatControl: a text control that holds a number in a range.
#pragma once

#include "editors/NumberControl.h"


class FloatControl : public NumberControl<float> {
public:
	FloatControl(BRect frame, const char* name, const char* label, BMessage* message, float value,
		float min, float max, uint32 resizingMode, uint32 flags);

	// Clamps and shows; what is not a number counts as the minimum.
	void SetFloatValue(float value);

	// The same, but a text that says so already is left alone, with what is selected in it.
	void ShowFloatValue(float value);

	// What the text says; not clamped, 0 for a text without a number at its start.
	float FloatValue() const;
};
