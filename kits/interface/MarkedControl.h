// _BMarkedControl_: what check boxes and radio buttons share.
#pragma once

#include <Control.h>


// A mark at the left and a label beside it. Pressing and releasing inside, Space and Enter choose
// it; what choosing means is the derived class's.
class _EXPORT _BMarkedControl_ : public BControl {
public:
	_BMarkedControl_(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode, uint32 flags);
	_BMarkedControl_(BMessage* archive);
	virtual ~_BMarkedControl_();

	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void DetachedFromWindow();
	virtual void GetPreferredSize(float* _width, float* _height);

protected:
	// Sets the value and invokes, as far as that is called for.
	virtual void Choose() = 0;
	// In the look's terms: enabled, pressed and the value are in the state.
	virtual void DrawMark(BPoint leftTop, rgb_color base, uint32 state) = 0;

private:
	_BMarkedControl_(const _BMarkedControl_&) = delete;
	_BMarkedControl_& operator=(const _BMarkedControl_&) = delete;

	bool fPressed; // tracking, with the pointer inside
};
