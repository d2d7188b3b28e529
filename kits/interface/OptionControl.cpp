#include <OptionControl.h>

#include <cstring>

#include <Message.h>


BOptionControl::BOptionControl(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags)
{
}


BOptionControl::BOptionControl(BMessage* archive) : BControl(archive)
{
}


BOptionControl::~BOptionControl()
{
}


void
BOptionControl::MessageReceived(BMessage* message)
{
	int32 value;
	if (message->what != B_OPTION_VALUE || message->FindInt32("be:value", &value) != B_OK) {
		BControl::MessageReceived(message);
		return;
	}
	SetValue(value);
	Invoke();
}


status_t
BOptionControl::AddOption(const char* name, int32 value)
{
	return AddOptionAt(name, value, CountOptions());
}


status_t
BOptionControl::SelectOptionFor(int32 value)
{
	int32 found;
	for (int32 i = 0; GetOptionAt(i, NULL, &found); i++) {
		if (found == value) {
			SetValue(value);
			return B_OK;
		}
	}
	return B_ERROR;
}


status_t
BOptionControl::SelectOptionFor(const char* name)
{
	if (name == NULL)
		return B_ERROR;
	const char* found;
	int32 value;
	for (int32 i = 0; GetOptionAt(i, &found, &value); i++) {
		if (strcmp(found, name) == 0) {
			SetValue(value);
			return B_OK;
		}
	}
	return B_ERROR;
}


BMessage*
BOptionControl::MakeValueMessage(int32 value)
{
	BMessage* message = new BMessage(B_OPTION_VALUE);
	message->AddInt32("be:value", value);
	return message;
}
