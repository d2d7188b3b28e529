// BCheckBox: a labelled box that is on or off.
#pragma once

#include <MarkedControl.h>


// The value changes when the mouse is released inside, or by Space or Enter, and the control
// invokes. B_CONTROL_PARTIALLY_ON is shown too, and clicking it switches on.
class _EXPORT BCheckBox : public _BMarkedControl_ {
public:
	BCheckBox(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BCheckBox(BMessage* archive);
	virtual ~BCheckBox();

	static BArchivable* Instantiate(BMessage* archive);

protected:
	virtual void Choose();
	virtual void DrawMark(BPoint leftTop, rgb_color base, uint32 state);

private:
	BCheckBox(const BCheckBox&) = delete;
	BCheckBox& operator=(const BCheckBox&) = delete;
};
