#include "editors/NumberControl.h"

#include <cstdio>
#include <cstdlib>

#include "editors/PanelRows.h"

namespace {


// Long enough for both formats.
constexpr size_t kTextLength = 32;


void
Format(char* text, int number)
{
	snprintf(text, kTextLength, "%d", number);
}


// The shortest form of six digits.
void
Format(char* text, float number)
{
	snprintf(text, kTextLength, "%g", number);
}


void
Parse(const char* text, int& number)
{
	number = NumberFromText(text);
}


void
Parse(const char* text, float& number)
{
	number = static_cast<float>(strtod(text, nullptr));
}


} // namespace


template<class Number>
NumberControl<Number>::NumberControl(BRect frame, const char* name, const char* label,
	BMessage* message, Number value, Number min, Number max, uint32 resizingMode, uint32 flags) :
	BTextControl(frame, name, label, "", message, resizingMode, flags),
	min(min), max(max)
{
	Show(value);
}


template<class Number>
void
NumberControl<Number>::SetMin(Number min)
{
	this->min = min > max ? max : min;
	Show(Shown());
}


template<class Number>
void
NumberControl<Number>::SetMax(Number max)
{
	this->max = max > min ? max : min;
	Show(Shown());
}


template<class Number>
status_t
NumberControl<Number>::Invoke(BMessage* message)
{
	Show(Shown());
	return BTextControl::Invoke(message);
}


template<class Number>
void
NumberControl<Number>::Show(Number value)
{
	// Asked this way round, what is not a number becomes the minimum.
	if (!(value > min))
		value = min;
	if (value > max)
		value = max;

	char text[kTextLength];
	Format(text, value);
	SetText(text);
}


template<class Number>
Number
NumberControl<Number>::Shown() const
{
	Number number;
	Parse(Text(), number);
	return number;
}


template class NumberControl<int>;
template class NumberControl<float>;
