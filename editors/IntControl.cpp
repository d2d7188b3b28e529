#include "editors/IntControl.h"


IntControl::IntControl(BRect frame, const char* name, const char* label, BMessage* message,
	int value, int min, int max, uint32 resizingMode, uint32 flags) :
	NumberControl(frame, name, label, message, value, min, max, resizingMode, flags)
{
}


void
IntControl::SetValue(int value)
{
	Show(value);
}


int
IntControl::Value() const
{
	return Shown();
}
