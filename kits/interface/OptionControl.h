// BOptionControl: what controls share that offer one of several named values.
#pragma once

#include <Control.h>

// What the parts of such a control send to it, with the value as the int32 "be:value".
enum { B_OPTION_VALUE = '_BMV' };


// Options have a name and a value, in an order that begins with 0; how they are kept and shown is
// the derived class's. Names and values need not differ: where they do not, the first one is found.
// Like all of a view it is used with its window locked.
class _EXPORT BOptionControl : public BControl {
public:
	BOptionControl(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = B_WILL_DRAW);
	BOptionControl(BMessage* archive);
	virtual ~BOptionControl();

	// A B_OPTION_VALUE sets the value and invokes the control.
	virtual void MessageReceived(BMessage* message);

	// Behind all others.
	status_t AddOption(const char* name, int32 value);
	// False, and nothing is stored, without such an option. The name stays the control's and is
	// valid until the option is removed. Either pointer may be NULL.
	virtual bool GetOptionAt(int32 index, const char** _name, int32* _value) = 0;
	virtual void RemoveOptionAt(int32 index) = 0;
	virtual int32 CountOptions() const = 0;
	// The name is copied. B_BAD_VALUE without a name or for an index beyond the end.
	virtual status_t AddOptionAt(const char* name, int32 value, int32 index) = 0;
	// The index of the option that is shown as chosen, or -1.
	virtual int32 SelectedOption(const char** _name = NULL, int32* _value = NULL) const = 0;

	// By its value or by its name. B_ERROR, and nothing changes, when there is none; nothing is
	// sent.
	virtual status_t SelectOptionFor(int32 value);
	virtual status_t SelectOptionFor(const char* name);

protected:
	// A new B_OPTION_VALUE, which the caller owns.
	BMessage* MakeValueMessage(int32 value);

private:
	BOptionControl(const BOptionControl&) = delete;
	BOptionControl& operator=(const BOptionControl&) = delete;
};
