#include "editors/IntControl.h"

#include <cstdio>

#include "editors/PanelRows.h"


IntControl::IntControl(BRect frame, const char* name, const char* label, BMessage* message,
	int value, int min, int max, uint32 resizingMode, uint32 flags) :
	BTextControl(frame, name, label, "", message, resizingMode, flags),
	min(min), max(max)
{
	SetValue(value);
}


void
IntControl::SetValue(int value)
{
	if (value < min)
		value = min;
	if (value > max)
		value = max;

	char text[16];
	snprintf(text, sizeof(text), "%d", value);
	SetText(text);
}


int
IntControl::Value() const
{
	return NumberFromText(Text());
}


void
IntControl::SetMin(int min)
{
	this->min = min > max ? max : min;
	SetValue(Value());
}


void
IntControl::SetMax(int max)
{
	this->max = max < min ? min : max;
	SetValue(Value());
}


status_t
IntControl::Invoke(BMessage* message)
{
	SetValue(Value());
	return BTextControl::Invoke(message);
}
