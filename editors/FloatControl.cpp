#include "editors/FloatControl.h"


FloatControl::FloatControl(BRect frame, const char* name, const char* label, BMessage* message,
	float value, float min, float max, uint32 resizingMode, uint32 flags) :
	NumberControl(frame, name, label, message, value, min, max, resizingMode, flags)
{
}


void
FloatControl::SetFloatValue(float value)
{
	Show(value);
}


void
FloatControl::ShowFloatValue(float value)
{
	if (FloatValue() != value)
		SetFloatValue(value);
}


float
FloatControl::FloatValue() const
{
	return Shown();
}
