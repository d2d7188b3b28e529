// _BPressControl_: what controls share that are pressed as a whole.
#pragma once

#include <Control.h>


// Pressing and releasing inside, Space and Enter choose it; what choosing means is the derived
// class's.
class _EXPORT _BPressControl_ : public BControl {
public:
	_BPressControl_(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode, uint32 flags);
	_BPressControl_(BMessage* archive);
	virtual ~_BPressControl_();

	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void DetachedFromWindow();

protected:
	// Sets the value and invokes, as far as that is called for.
	virtual void Choose() = 0;
	// By the mouse, with the pointer inside.
	bool IsPressed() const { return fPressed; }

private:
	_BPressControl_(const _BPressControl_&) = delete;
	_BPressControl_& operator=(const _BPressControl_&) = delete;

	bool fPressed;
};
