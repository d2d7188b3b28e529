// BChannelSlider: several thumbs on bars of their own, side by side, for as many values.
#pragma once

#include <ChannelControl.h>

class BBitmap;


// The channels of a horizontal slider lie below each other, with the minimum at the left; those of
// a vertical one beside each other, with the minimum at the bottom. Dragging a thumb moves all of
// them by the same amount, dragging with the secondary button only the one. The arrow keys along
// the bars, Home and End move the thumb of the current channel, with Shift all of them; the arrow
// keys across choose another channel. At every change the modification message is sent, and the
// control's own when the button or the key is released, both by InvokeNotifyChannel().
class _EXPORT BChannelSlider : public BChannelControl {
public:
	BChannelSlider(BRect frame, const char* name, const char* label, BMessage* message,
		int32 channelCount = 1, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW);
	BChannelSlider(BRect frame, const char* name, const char* label, BMessage* message,
		orientation posture, int32 channelCount = 1,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = B_WILL_DRAW);
	BChannelSlider(BMessage* archive);
	virtual ~BChannelSlider();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* into, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void DetachedFromWindow();
	virtual void AllDetached();
	virtual void MessageReceived(BMessage* message);
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void WindowActivated(bool active);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void KeyUp(const char* bytes, int32 numBytes);
	virtual void FrameResized(float width, float height);
	virtual void SetFont(const BFont* font, uint32 mask = B_FONT_ALL);
	virtual void MakeFocus(bool focused = true);
	virtual void SetEnabled(bool enabled);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);

	// 32.
	virtual int32 MaxChannelCount() const;
	// False: one pair of labels stands for all channels.
	virtual bool SupportsIndividualLimits() const;

	orientation Orientation() const;
	void SetOrientation(orientation posture);

	// One channel: its groove and its thumb. The area is all that the thumb can cover.
	virtual void DrawChannel(BView* into, int32 channel, BRect area, bool pressed);
	// The bar whose middle line goes from one point to the other.
	virtual void DrawGroove(BView* into, int32 channel, BPoint leftTop, BPoint rightBottom);
	// Around its middle.
	virtual void DrawThumb(BView* into, int32 channel, BPoint where, bool pressed);
	// The picture of a thumb, which decides how large thumbs are. It stays the slider's and is valid
	// until the slider looks different. A class that answers another one has that drawn.
	virtual const BBitmap* ThumbFor(int32 channel, bool pressed);
	// Where the thumb is when it is as far left or up as it can be.
	virtual BRect ThumbFrameFor(int32 channel);
	// How far the thumb is from there, and how far it can be.
	virtual float ThumbDeltaFor(int32 channel);
	virtual float ThumbRangeFor(int32 channel);

private:
	BChannelSlider(const BChannelSlider&) = delete;
	BChannelSlider& operator=(const BChannelSlider&) = delete;

	virtual void _ChannelChanged(int32 channel);
	bool _IsVertical() const { return fOrientation != B_HORIZONTAL; }
	uint32 _LookState(int32 channel, bool pressed) const;
	float _LineHeight() const;
	bool _IsPressed(int32 channel) const;
	bool _IsFocused(int32 channel) const;
	BRect _ThumbBounds(int32 channel);
	BRect _Area(int32 channel);
	float _Pitch();
	float _GroupSize();
	BRect _Room() const;
	void _DrawTexts();
	void _DrawLine(const char* text, float baseline, alignment align);
	int32 _ChannelAt(BPoint where);
	int32 _ValueAt(BPoint where, int32 channel);
	std::vector<int32> _Values() const;
	void _BeginChange(bool all);
	void _ChangeTo(int64 value);
	void _EndChange();
	void _Report(BMessage* message, uint32 kind, const std::vector<int32>& before);

	int32 fOrientation; // as an archive says it
	std::vector<int32> fValuesBefore; // when the mouse or the key was pressed
	bool fMovesAll;
	bool fKeyIsDown; // a key that changes a value
	BPoint fGrabbed; // from the thumb's middle to where it was taken
	std::shared_ptr<BBitmap> fThumbs[2]; // released and pressed, shared with other sliders
};
