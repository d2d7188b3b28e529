// BButton: a push button, possibly the window's default button.
#pragma once

#include <Control.h>


// Its value is 1 while it is held down. It invokes when the mouse is released inside, or by Enter
// or Space, when it flashes; the default button of a window answers Enter wherever the focus is.
class _EXPORT BButton : public BControl {
public:
	BButton(BRect frame, const char* name, const char* label, BMessage* message,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BButton(BMessage* archive);
	virtual ~BButton();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void MessageReceived(BMessage* message);
	virtual void WindowActivated(bool active);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void MakeFocus(bool focused = true);
	virtual void AllAttached();
	virtual void AllDetached();

	// A default button is larger by 6 in both directions and moves by 3 to the left and up.
	virtual void MakeDefault(bool flag);
	bool IsDefault() const;

	virtual void SetLabel(const char* label);
	virtual void SetValue(int32 value);
	virtual void SetEnabled(bool enabled);

	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();
	virtual status_t Invoke(BMessage* message = NULL);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

private:
	BButton(const BButton&) = delete;
	BButton& operator=(const BButton&) = delete;

	void _Flash();

	bool fIsDefault;
};
