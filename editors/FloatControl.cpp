#include "editors/FloatControl.h"

#include <cstdio>
#include <cstdlib>


FloatControl::FloatControl(BRect frame, const char* name, const char* label, BMessage* message,
	float value, float min, float max, uint32 resizingMode, uint32 flags) :
	BTextControl(frame, name, label, "", message, resizingMode, flags),
	min(min), max(max)
{
	SetFloatValue(value);
}


void
FloatControl::SetFloatValue(float value)
{
	// Asked this way round, what is not a number becomes the minimum.
	if (!(value > min))
		value = min;
	if (value > max)
		value = max;

	char text[32];
	snprintf(text, sizeof(text), "%g", value);
	SetText(text);
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
	return static_cast<float>(strtod(Text(), nullptr));
}


void
FloatControl::SetMin(float min)
{
	this->min = min > max ? max : min;
	SetFloatValue(FloatValue());
}


void
FloatControl::SetMax(float max)
{
	this->max = max > min ? max : min;
	SetFloatValue(FloatValue());
}


status_t
FloatControl::Invoke(BMessage* message)
{
	SetFloatValue(FloatValue());
	return BTextControl::Invoke(message);
}
