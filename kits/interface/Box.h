// BBox: a border round a group of views, with a label of text or a view as its label.
#pragma once

#include <View.h>

#include <string>


// A label view is a child of the box, always the first. Neither border nor label moves the other
// children; InnerFrame() tells the room that is left for them.
class _EXPORT BBox : public BView {
public:
	BBox(BRect frame, const char* name = NULL, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE_JUMP,
		border_style border = B_FANCY_BORDER);
	BBox(BMessage* archive);
	virtual ~BBox();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void SetBorder(border_style border);
	border_style Border() const;

	// The room inside border and label, in the box's coordinates.
	BRect InnerFrame();

	// NULL removes the label. A label view that was there is removed and deleted.
	void SetLabel(const char* label);
	// The box owns the view, as a child. NULL removes the label and answers B_OK.
	status_t SetLabel(BView* viewLabel);
	// NULL when there is none or when it is a view.
	const char* Label() const;
	BView* LabelView() const;

	virtual void Draw(BRect updateRect);
	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void WindowActivated(bool active);
	virtual void MakeFocus(bool focused = true);
	// Never smaller than the box is.
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

private:
	BBox(const BBox&) = delete;
	BBox& operator=(const BBox&) = delete;

	bool _HasLabel() const;
	void _ClearLabel();
	// The part of the top that the border leaves out; invalid without a label.
	BRect _LabelGap() const;
	float _BorderTop() const;
	void _InvalidateStrips(BRect oldBounds, BRect newBounds);

	std::string fLabel; // empty: none
	BView* fLabelView; // child; it is the label as long as it is the first one
	BRect fOldBounds;
	border_style fBorder;
};
