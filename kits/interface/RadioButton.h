// BRadioButton: one choice among its sibling radio buttons.
#pragma once

#include <MarkedControl.h>


// Switching one on by mouse, key or SetValue() switches off the other radio buttons of the same
// parent (or of the window, at the top level), without invoking them. Choosing the one that is
// on already does nothing.
class _EXPORT BRadioButton : public _BMarkedControl_ {
public:
	BRadioButton(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BRadioButton(BMessage* archive);
	virtual ~BRadioButton();

	static BArchivable* Instantiate(BMessage* archive);

	virtual void SetValue(int32 value);

protected:
	virtual void Choose();
	virtual void DrawMark(BPoint leftTop, rgb_color base, uint32 state);

private:
	BRadioButton(const BRadioButton&) = delete;
	BRadioButton& operator=(const BRadioButton&) = delete;
};
