// BTextControl: a labelled one-line text field.
#pragma once

#include <string>

#include <Control.h>
#include <TextView.h>

class BTextView;
class _BTextInput_;


// The text lives in a child of its own, a BTextView named "_input_". Invoked by Enter, and by
// losing the focus, when the text differs from what it was when the field got the focus.
class BTextControl : public BControl {
public:
	BTextControl(BRect frame, const char* name, const char* label, const char* text,
		BMessage* message, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_NAVIGABLE);
	BTextControl(BMessage* archive);
	virtual ~BTextControl();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// Line breaks become spaces. Sends the modification message but not the invocation; ignored
	// while a modification message is being sent.
	virtual void SetText(const char* text);
	const char* Text() const;

	// The text as a number does not exist. Where int32 is int this is also BControl::SetValue(),
	// so nothing in the kit calls SetValue() on a text control.
	virtual void SetValue(int32 value);
	virtual status_t Invoke(BMessage* message = NULL);

	BTextView* TextView() const;

	// Owned. Sent at every insertion and every deletion in the field, whoever makes it.
	virtual void SetModificationMessage(BMessage* message);
	BMessage* ModificationMessage() const;

	virtual void SetAlignment(alignment labelAlignment, alignment textAlignment);
	void GetAlignment(alignment* _label, alignment* _text) const;
	// The x coordinate between the label and the field, rounded.
	virtual void SetDivider(float position);
	float Divider() const;

	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void AttachedToWindow();
	virtual void MakeFocus(bool focus = true);
	virtual void SetEnabled(bool enabled);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);
	virtual void WindowActivated(bool active);

	virtual void GetPreferredSize(float* _width, float* _height);
	// Moves the divider right behind the label as well.
	virtual void ResizeToPreferred();

	virtual void MessageReceived(BMessage* message);
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* message);
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual void SetFlags(uint32 flags);
	virtual status_t Perform(perform_code code, void* data);

private:
	friend class _BTextInput_;

	void _Init();
	void _CreateInput(uint32 flags);
	BRect _InputFrame() const;
	void _LayOutInput();
	void _RaiseHeight();
	void _ShowEnabled();
	void _CommitText();
	void _SendModification();
	float _LabelWidth() const;
	float _MinimalHeight() const;
	void _InputFocusChanged();

	BTextView* fText; // child; NULL only if an archive has something else of its name
	BMessage* fModificationMessage; // owned
	std::string fCommittedText; // as of SetText(), the last invocation or the coming of the focus
	alignment fLabelAlignment;
	float fDivider;
	bool fInputWasNavigable; // before it was disabled
};
