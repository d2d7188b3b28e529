// The field inside of a text control.
#pragma once

#include <TextView.h>

class BTextControl;


// One line; tells its control what happens to it. The name is the one that archives have.
class _BTextInput_ : public BTextView {
public:
	_BTextInput_(BRect frame, BRect textRect, uint32 resizingMode, uint32 flags);
	_BTextInput_(BMessage* archive);
	virtual ~_BTextInput_();

	static BArchivable* Instantiate(BMessage* archive);

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void MakeFocus(bool focus = true);
	virtual void MouseDown(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void FrameResized(float width, float height);
	virtual void WindowActivated(bool active);

	// The control that it lies in, or NULL.
	BTextControl* Control() const;
	void SetFaded(bool faded);
	// The text starts a little inside, and stands in the middle of the height.
	void AlignTextRect();

protected:
	virtual void InsertText(
		const char* text, int32 length, int32 offset, const text_run_array* runs);
	virtual void DeleteText(int32 fromOffset, int32 toOffset);

private:
	bool fPressed = false; // a press brings the focus
};
