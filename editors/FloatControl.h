// FloatControl: a text control that holds a number in a range.
#pragma once

#include <TextControl.h>


// The number is kept as text only, in the shortest form of six digits.
class FloatControl : public BTextControl {
public:
	// The range is not checked; where min is greater than max, max wins.
	FloatControl(BRect frame, const char* name, const char* label, BMessage* message, float value,
		float min, float max, uint32 resizingMode, uint32 flags);

	// Clamps and shows; what is not a number counts as the minimum.
	void SetFloatValue(float value);

	// The same, but a text that says so already is left alone, with what is selected in it.
	void ShowFloatValue(float value);

	// What the text says; not clamped, 0 for a text without a number at its start.
	float FloatValue() const;

	// A limit beyond the other one takes the other's value. The shown number is clamped at once.
	void SetMin(float min);
	void SetMax(float max);

	// Shows the number as it counts, then sends.
	status_t Invoke(BMessage* message = NULL) override;

private:
	float min;
	float max;
};
