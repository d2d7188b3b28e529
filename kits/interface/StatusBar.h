// BStatusBar: shows how far a task has come, with text at both ends above the bar.
#pragma once

#include <View.h>

#include <string>


// B_UPDATE_STATUS_BAR and B_RESET_STATUS_BAR do what Update() and Reset() do, from other threads:
// the first carries float "delta", string "text" and "trailing_text", the second string "label"
// and "trailing_label".
class _EXPORT BStatusBar : public BView {
public:
	BStatusBar(
		BRect frame, const char* name, const char* label = NULL, const char* trailingLabel = NULL);
	BStatusBar(BMessage* archive);
	virtual ~BStatusBar();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void MessageReceived(BMessage* message);
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MakeFocus(bool focused = true);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void WindowActivated(bool active);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();

	virtual void SetBarColor(rgb_color color);
	// Changes the view's height so that the text line keeps its own.
	virtual void SetBarHeight(float height);
	virtual void SetText(const char* text);
	virtual void SetTrailingText(const char* text);
	virtual void SetMaxValue(float max);

	// Adds to the value. A NULL text keeps the text that is shown.
	virtual void Update(float delta, const char* text = NULL, const char* trailingText = NULL);
	// The same with an absolute value, kept within 0 and the maximum.
	virtual void SetTo(float value, const char* text = NULL, const char* trailingText = NULL);
	// Back to 0 of 100, without texts and with these labels.
	virtual void Reset(const char* label = NULL, const char* trailingLabel = NULL);

	float CurrentValue() const;
	float MaxValue() const;
	rgb_color BarColor() const;
	float BarHeight() const;
	// The texts are never NULL.
	const char* Text() const;
	const char* TrailingText() const;
	const char* Label() const;
	const char* TrailingLabel() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

private:
	BStatusBar(const BStatusBar&) = delete;
	BStatusBar& operator=(const BStatusBar&) = delete;

	BRect _BarFrame() const;
	float _TextHeight() const;
	float _FillRight(float value) const;
	void _SetText(std::string& text, const char* newText);
	void _SetValue(float value, float max);
	void _DrawBar();
	void _DrawTexts();

	std::string fLabel;
	std::string fTrailingLabel;
	std::string fText;
	std::string fTrailingText;
	float fMax;
	float fCurrent;
	float fBarHeight;
	rgb_color fBarColor;
	bool fCustomBarHeight; // set by the program, so archived
	bool fCustomBarColor;
};
