// NumberControl: what the controls for whole and other numbers share.
#pragma once

#include <TextControl.h>


// A text control that holds a number in a range. The number is kept as text only.
template<class Number> class NumberControl : public BTextControl {
public:
	// A limit beyond the other one takes the other's value. The shown number is clamped at once.
	void SetMin(Number min);
	void SetMax(Number max);

	// Shows the number as it counts, then sends.
	status_t Invoke(BMessage* message = NULL) override;

protected:
	// The range is not checked; where min is greater than max, max wins.
	NumberControl(BRect frame, const char* name, const char* label, BMessage* message, Number value,
		Number min, Number max, uint32 resizingMode, uint32 flags);

	// Clamps and shows; what is not a number counts as the minimum.
	void Show(Number value);
	// What the text begins with; not clamped, 0 for a text without a number at its start.
	Number Shown() const;

private:
	Number min;
	Number max;
};
