// BColorControl: chooses a colour by ramps of its components or by three numbers.
#pragma once

#include <Control.h>

class BTextControl;

// The number of columns of the matrix of 256 cells.
enum color_control_layout : uint32 {
	B_CELLS_4x64 = 4,
	B_CELLS_8x32 = 8,
	B_CELLS_16x16 = 16,
	B_CELLS_32x8 = 32,
	B_CELLS_64x4 = 64
};


// The value is the colour, red << 24 | green << 16 | blue << 8. The size follows from layout and
// cell size. It invokes at every change by the user. The three text controls are its children
// "_red", "_green" and "_blue".
class _EXPORT BColorControl : public BControl {
public:
	BColorControl(BPoint leftTop, color_control_layout layout, float cellSize, const char* name,
		BMessage* message = NULL, bool useOffscreen = false);
	BColorControl(BMessage* archive);
	virtual ~BColorControl();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void SetValue(int32 colorValue);
	void SetValue(rgb_color color);
	rgb_color ValueAsColor();

	virtual void SetEnabled(bool enabled);

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void MessageReceived(BMessage* message);
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void WindowActivated(bool active);
	virtual void MakeFocus(bool focused = true);

	// At least 6; CellSize() answers what is really used.
	virtual void SetCellSize(float size);
	float CellSize() const;
	virtual void SetLayout(color_control_layout layout);
	color_control_layout Layout() const;

	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();
	virtual status_t Invoke(BMessage* message = NULL);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);
	virtual status_t Perform(perform_code code, void* data);

private:
	BColorControl(const BColorControl&) = delete;
	BColorControl& operator=(const BColorControl&) = delete;

	void _CreateFields();
	BTextControl* _Field(int32 component) const; // NULL when it has been taken out
	BTextControl* _CreateField(int32 component);
	void _PlaceFields();
	void _WriteFields();
	void _TakeFields();
	bool _TakeDroppedColor(BMessage* message);
	int32 _Rows() const;
	BRect _PaletteFrame() const;
	BRect _RampFrame(int32 ramp) const;
	int32 _RampAt(BPoint where) const;
	void _TrackTo(BPoint where);
	int32 _RampValue(int32 ramp) const;
	void _ChangeRamp(int32 ramp, int32 value);
	void _DrawRamp(int32 ramp, BRect updateRect);

	color_control_layout fLayout;
	float fCellSize;
	bool fUseOffscreen;
	int32 fTrackedRamp; // -1: none
	int32 fFocusedRamp; // the one that the keys change
};
