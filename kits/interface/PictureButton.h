// BPictureButton: a button that shows a picture for each of its states.
#pragma once

#include <PressControl.h>

enum picture_button_behavior : uint32 { B_ONE_STATE_BUTTON = 0, B_TWO_STATE_BUTTON = 1 };


// Pictures are not recorded or played on this platform. A button from an archive keeps the
// archives of its pictures and gives them back unchanged; it draws as a bevelled button with its
// label. Its value, its tracking and its invocation are those of the class.
class _EXPORT BPictureButton : public _BPressControl_ {
public:
	BPictureButton(BRect frame, const char* name, BMessage* message,
		uint32 behavior = B_ONE_STATE_BUTTON, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BPictureButton(BMessage* archive);
	virtual ~BPictureButton();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Draw(BRect updateRect);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();

	virtual void SetBehavior(uint32 behavior);
	uint32 Behavior() const;

protected:
	virtual void Choose();

private:
	BPictureButton(const BPictureButton&) = delete;
	BPictureButton& operator=(const BPictureButton&) = delete;

	uint32 fBehavior;
};
