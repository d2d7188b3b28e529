// BScrollBar: scrolls a target view along one direction.
#pragma once

#include <BeBuild.h>
#include <View.h>

// Right - left and bottom - top: a bar is one pixel thicker.
#define B_V_SCROLL_BAR_WIDTH 14.0
#define B_H_SCROLL_BAR_HEIGHT 14.0

#define DISABLES_ON_WINDOW_DEACTIVATION 1


// The value stays within the range, rounded to whole numbers. Setting it scrolls the target to it,
// and scrolling the target sets it, without an endless circle. A bar never resizes its target.
class _EXPORT BScrollBar : public BView {
public:
	BScrollBar(
		BRect frame, const char* name, BView* target, float min, float max, orientation direction);
	explicit BScrollBar(BMessage* archive);
	virtual ~BScrollBar();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void Draw(BRect updateRect);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void WindowActivated(bool active);
	virtual void Pulse();

	void SetValue(float value);
	float Value() const;
	// The visible fraction, 0 to 1; 0 means that the thumb does not show one.
	void SetProportion(float proportion);
	float Proportion() const;
	virtual void ValueChanged(float newValue);

	// A minimum above the maximum sets both to 0.
	void SetRange(float min, float max);
	void GetRange(float* min, float* max) const;
	void SetSteps(float smallStep, float largeStep);
	void GetSteps(float* smallStep, float* largeStep) const;

	// The bar forgets a target that leaves its window. A name is looked up in the window.
	void SetTarget(BView* target);
	void SetTarget(const char* targetName);
	BView* Target() const;
	void SetOrientation(orientation direction);
	orientation Orientation() const;

	// BeOS keeps no reference count here either: the target drops its bars when it dies.
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual void MakeFocus(bool state = true);
	virtual void GetPreferredSize(float* width, float* height);
	virtual void ResizeToPreferred();
	virtual status_t Perform(perform_code code, void* argument);

private:
	friend class BPrivate::ViewPrivate;
	friend class BView;

	enum class Part : uint8;

	float _Clamped(float value) const;
	// The target is about to scroll there; returns where it may.
	float _Follow(float position);
	bool _Take(float value);
	void _TargetGone();
	bool _IsUsable() const;
	BRect _ArrowRect(Part part) const;
	BRect _TrackRect() const;
	BRect _ThumbRect() const;
	Part _PartAt(BPoint where) const;
	float _ValueAtThumb(float position) const;
	void _Step(Part part, bool large);
	void _Release();
	void _DrawArrow(Part part);

	float fMin;
	float fMax;
	float fSmallStep;
	float fLargeStep;
	float fValue;
	float fProportion;
	BView* fTarget; // borrowed; it tells us when it goes
	orientation fOrientation;
	Part fPressed;
	bool fRepeats; // the first pause is over
	float fGrabOffset; // from the thumb's start to the pointer
	BPoint fLastWhere;
	class BMessageRunner* fRepeater; // owned; while an arrow or the free area is held
};
