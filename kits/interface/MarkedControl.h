// _BMarkedControl_: what check boxes and radio buttons share.
#pragma once

#include <PressControl.h>


// A mark at the left and a label beside it.
class _EXPORT _BMarkedControl_ : public _BPressControl_ {
public:
	_BMarkedControl_(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode, uint32 flags);
	_BMarkedControl_(BMessage* archive);
	virtual ~_BMarkedControl_();

	virtual void Draw(BRect updateRect);
	virtual void GetPreferredSize(float* _width, float* _height);

protected:
	// In the look's terms: enabled, pressed and the value are in the state.
	virtual void DrawMark(BPoint leftTop, rgb_color base, uint32 state) = 0;

private:
	_BMarkedControl_(const _BMarkedControl_&) = delete;
	_BMarkedControl_& operator=(const _BMarkedControl_&) = delete;
};
