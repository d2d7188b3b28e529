// BStringView: a line of text that the user cannot edit.
#pragma once

#include <View.h>

#include <string>


// Several lines are shown when the text has newlines. The text stands at the bottom of the view,
// in the high colour, on the low colour.
class _EXPORT BStringView : public BView {
public:
	BStringView(BRect frame, const char* name, const char* text,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = B_WILL_DRAW);
	BStringView(BMessage* archive);
	virtual ~BStringView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// NULL is no text.
	void SetText(const char* text);
	const char* Text() const;
	void SetAlignment(alignment flag);
	alignment Alignment() const;

	// One of the truncation modes of truncate_string(), or B_NO_TRUNCATION.
	void SetTruncation(uint32 truncationMode);
	uint32 Truncation() const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void Draw(BRect updateRect);
	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MakeFocus(bool focused = true);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void WindowActivated(bool active);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

private:
	BStringView(const BStringView&) = delete;
	BStringView& operator=(const BStringView&) = delete;

	void _DrawLine(const char* line, float baseline);

	std::string fText;
	bool fHasText; // false: Text() is NULL
	alignment fAlign;
	uint32 fTruncation;
};
