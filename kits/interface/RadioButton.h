// BRadioButton: one choice among its sibling radio buttons.
#pragma once

#include <Control.h>


// Switching one on by mouse, key or SetValue() switches off the other radio buttons of the same
// parent (or of the window, at the top level), without invoking them. Choosing the one that is
// on already does nothing.
class _EXPORT BRadioButton : public BControl {
public:
	BRadioButton(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BRadioButton(BMessage* archive);
	virtual ~BRadioButton();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Draw(BRect updateRect);
	virtual void AttachedToWindow();
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MessageReceived(BMessage* message);
	virtual void WindowActivated(bool active);
	virtual void DetachedFromWindow();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void MakeFocus(bool focused = true);
	virtual void AllAttached();
	virtual void AllDetached();

	virtual void SetValue(int32 value);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();
	virtual status_t Invoke(BMessage* message = NULL);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

private:
	BRadioButton(const BRadioButton&) = delete;
	BRadioButton& operator=(const BRadioButton&) = delete;

	void _Choose();

	bool fPressed; // tracking, with the pointer inside
};
