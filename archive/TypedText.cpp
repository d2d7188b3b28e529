#include "archive/TypedText.h"

#include <TextControl.h>
#include <TextView.h>
#include <Window.h>


BTextControl*
FieldInUse(const BWindow* window)
{
	const BView* focus = window != nullptr ? window->CurrentFocus() : nullptr;
	return focus != nullptr ? dynamic_cast<BTextControl*>(focus->Parent()) : nullptr;
}


void
SendTypedText(BTextControl* field)
{
	int32 start, end;
	field->TextView()->GetSelection(&start, &end);
	field->MakeFocus(false);
	field->MakeFocus(true);
	field->TextView()->Select(start, end);
}
