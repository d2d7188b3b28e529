// BSlider: a thumb that the user moves along a bar to choose a number.
#pragma once

#include <Control.h>

namespace BPrivate {
class ArchiveWriter;
}

enum hash_mark_location : uint32 {
	B_HASH_MARKS_NONE = 0,
	B_HASH_MARKS_TOP = 1,
	B_HASH_MARKS_LEFT = 1,
	B_HASH_MARKS_BOTTOM = 2,
	B_HASH_MARKS_RIGHT = 2,
	B_HASH_MARKS_BOTH = 3
};

enum thumb_style : uint32 { B_BLOCK_THUMB = 0, B_TRIANGLE_THUMB = 1 };


// The modification message is sent at every change by mouse or keys, the control's own message
// when the mouse or the key is released. A vertical slider has its maximum at the top.
class _EXPORT BSlider : public BControl {
public:
	BSlider(BRect frame, const char* name, const char* label, BMessage* message, int32 minValue,
		int32 maxValue, thumb_style thumbType = B_BLOCK_THUMB,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_NAVIGABLE | B_WILL_DRAW | B_FRAME_EVENTS);
	BSlider(BRect frame, const char* name, const char* label, BMessage* message, int32 minValue,
		int32 maxValue, orientation posture, thumb_style thumbType = B_BLOCK_THUMB,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_NAVIGABLE | B_WILL_DRAW | B_FRAME_EVENTS);
	BSlider(BMessage* archive);
	virtual ~BSlider();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;
	virtual status_t Perform(perform_code code, void* data);

	virtual void WindowActivated(bool active);
	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void DetachedFromWindow();
	virtual void MessageReceived(BMessage* message);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void KeyUp(const char* bytes, int32 numBytes);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void Pulse();

	virtual void SetLabel(const char* label);
	// Both are copied; NULL removes. The slider resizes itself to its preferred size.
	virtual void SetLimitLabels(const char* minLabel, const char* maxLabel);
	const char* MinLimitLabel() const;
	const char* MaxLimitLabel() const;
	// Kept within the limits.
	virtual void SetValue(int32 value);
	virtual int32 ValueForPoint(BPoint where) const;
	// The position is between 0 and 1.
	virtual void SetPosition(float position);
	float Position() const;
	virtual void SetEnabled(bool enabled);
	// Nothing happens unless the minimum is at most the maximum.
	void SetLimits(int32 minValue, int32 maxValue);
	void GetLimits(int32* _minValue, int32* _maxValue) const;

	virtual void Draw(BRect updateRect);
	virtual void DrawSlider();
	virtual void DrawBar();
	virtual void DrawHashMarks();
	virtual void DrawThumb();
	virtual void DrawFocusMark();
	virtual void DrawText();
	// The text at the right of the label, which stays the caller's; the default is NULL.
	virtual const char* UpdateText() const;
	// Asks UpdateText() again and redraws when it says something else.
	void UpdateTextChanged();

	virtual BRect BarFrame() const;
	virtual BRect HashMarksFrame() const;
	virtual BRect ThumbFrame() const;

	virtual void SetFlags(uint32 flags);
	virtual void SetResizingMode(uint32 mode);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();
	virtual status_t Invoke(BMessage* message = NULL);
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);

	// Owned.
	virtual void SetModificationMessage(BMessage* message);
	BMessage* ModificationMessage() const;
	// Microseconds, kept between 10,000 and 1,000,000.
	virtual void SetSnoozeAmount(int32 microSeconds);
	int32 SnoozeAmount() const;
	virtual void SetKeyIncrementValue(int32 incrementValue);
	int32 KeyIncrementValue() const;
	virtual void SetHashMarkCount(int32 hashMarkCount);
	int32 HashMarkCount() const;
	virtual void SetHashMarks(hash_mark_location where);
	hash_mark_location HashMarks() const;
	virtual void SetStyle(thumb_style style);
	thumb_style Style() const;
	virtual void SetBarColor(rgb_color color);
	rgb_color BarColor() const;
	// Paints the bar from the minimum to the thumb in another colour. NULL keeps the colour.
	virtual void UseFillColor(bool use, const rgb_color* color = NULL);
	// Answers whether the colour is in use.
	bool FillColor(rgb_color* _color) const;
	// The view in which the Draw hooks draw.
	BView* OffscreenView() const;
	orientation Orientation() const;
	virtual void SetOrientation(orientation posture);
	float BarThickness() const;
	// At least 1.
	virtual void SetBarThickness(float thickness);
	virtual void SetFont(const BFont* font, uint32 properties = B_FONT_ALL);

private:
	BSlider(const BSlider&) = delete;
	BSlider& operator=(const BSlider&) = delete;

	void _ReadArchive(BMessage* archive);
	void _WriteArchive(BPrivate::ArchiveWriter& writer, BMessage* archive) const;
	void _ChangeTo(int32 value);
	bool _HasLimitLabels() const;
	float _LineHeight() const;
	float _MinPosition() const;
	float _MaxPosition() const;
	void _GetMinimumSize(float* _width, float* _height) const;
	uint32 _LookState() const;
	void _DrawTextLine(const char* text, float baseline, alignment align);
	void _InvalidateValue(BRect oldThumb);

	std::unique_ptr<BMessage> fModificationMessage;
	std::string fMinLabel;
	std::string fMaxLabel;
	std::string fUpdateText; // what UpdateText() last said
	bool fHasMinLabel; // false: MinLimitLabel() is NULL
	bool fHasMaxLabel;
	int32 fSnoozeAmount;
	int32 fKeyIncrement;
	int32 fHashMarkCount;
	hash_mark_location fHashMarks;
	thumb_style fStyle;
	orientation fOrientation;
	int32 fMinValue;
	int32 fMaxValue;
	rgb_color fBarColor;
	rgb_color fFillColor;
	bool fUseFillColor;
	float fBarThickness;
	int32 fValueBefore; // when the mouse or the key was pressed
	bool fKeyIsDown; // a key that changes the value
};
