// BScrollView: a frame around a target view, with scroll bars.
#pragma once

#include <BeBuild.h>
#include <ScrollBar.h>
#include <View.h>


// The view takes the place around its target: the frame follows from the target's frame, the
// border and the bars. The target is the first child, and belongs to the scroll view like any child.
class _EXPORT BScrollView : public BView {
public:
	BScrollView(const char* name, BView* target, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = 0, bool horizontal = false, bool vertical = false,
		border_style border = B_FANCY_BORDER);
	explicit BScrollView(BMessage* archive);
	virtual ~BScrollView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void Draw(BRect updateRect);
	virtual void WindowActivated(bool active);
	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);

	BScrollBar* ScrollBar(orientation direction) const;

	virtual void SetBorder(border_style border);
	border_style Border() const;
	// Only a fancy border can show the focus.
	virtual status_t SetBorderHighlighted(bool state);
	bool IsBorderHighlighted() const;

	// The old target is taken out and given back to the caller; NULL leaves no content.
	void SetTarget(BView* target);
	BView* Target() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* width, float* height);
	virtual void MakeFocus(bool state = true);
	virtual status_t Perform(perform_code code, void* argument);

private:
	static BRect _FrameFor(BView* target, bool horizontal, bool vertical, border_style border);
	static uint32 _FlagsFor(uint32 flags, border_style border);
	void _AddBars(bool horizontal, bool vertical);
	void _PlaceParts();
	BRect _TargetFrame() const;
	void _AdoptChildren(bool hasTarget);

	BView* fTarget; // child
	BScrollBar* fHorizontal; // child
	BScrollBar* fVertical; // child
	border_style fBorder;
	bool fHighlighted;
	bool fHadTarget; // when it was read from an archive
};
