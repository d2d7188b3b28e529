// IntControl: a text control that holds a whole number in a range.
#pragma once

#include <TextControl.h>


// The number is kept as text only. Where the platform's int32 is int, SetValue(int) is also the
// override of BControl::SetValue(int32), whose integer no text control uses.
class IntControl : public BTextControl {
public:
	// The range is not checked; where min is greater than max, max wins.
	IntControl(BRect frame, const char* name, const char* label, BMessage* message, int value,
		int min, int max, uint32 resizingMode, uint32 flags);

	// Clamps and shows.
	void SetValue(int value);

	// What the text says; not clamped, 0 for a text without digits at its start.
	int Value() const;

	// A limit beyond the other one takes the other's value. The shown number is clamped at once.
	void SetMin(int min);
	void SetMax(int max);

	// Shows the number as it counts, then sends.
	status_t Invoke(BMessage* message = NULL) override;

private:
	int min;
	int max;
};
