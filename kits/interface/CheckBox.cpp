#include <CheckBox.h>

#include <Message.h>

#include "interface/private/Look.h"


BCheckBox::BCheckBox(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	_BMarkedControl_(frame, name, label, message, resizingMode, flags)
{
}


BCheckBox::BCheckBox(BMessage* archive) : _BMarkedControl_(archive)
{
}


BCheckBox::~BCheckBox()
{
}


BArchivable*
BCheckBox::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BCheckBox") ? new BCheckBox(archive) : NULL;
}


void
BCheckBox::Choose()
{
	SetValue(Value() == B_CONTROL_ON ? B_CONTROL_OFF : B_CONTROL_ON);
	Invoke();
}


void
BCheckBox::DrawMark(BPoint leftTop, rgb_color base, uint32 state)
{
	BPrivate::Look::DrawCheckBox(this, leftTop, base, state);
}
