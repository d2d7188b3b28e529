// BCheckBox: a labelled box that is on or off.
#pragma once

#include <Control.h>


// The value changes when the mouse is released inside, or by Space or Enter, and the control
// invokes. B_CONTROL_PARTIALLY_ON is shown too, and clicking it switches on.
class _EXPORT BCheckBox : public BControl {
public:
	BCheckBox(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BCheckBox(BMessage* archive);
	virtual ~BCheckBox();

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
	BCheckBox(const BCheckBox&) = delete;
	BCheckBox& operator=(const BCheckBox&) = delete;

	bool fPressed; // tracking, with the pointer inside
};
