// EditView: the panel for what every view has: its place, flags, font, drawing and colours.
#pragma once

#include "editors/EditorInterface.h"

class BButton;
class BFont;
class BMenu;
class BMenuField;
class BRadioButton;
class BTextControl;
class FloatControl;
class LiveColorControl;


class EditView : public EditorInterface {
public:
	EditView();
	~EditView() override;

	void FrameChanged() override;

	// Accepts every view.
	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	// Which of the view's colours the colour section edits.
	enum class ColorRole { kView, kHigh, kLow };

	void _AddNameRow(BRect area);
	void _AddFrameRow(BRect area);
	void _AddResizingRow(BRect area);
	void _AddFlagsRow(BRect area);
	void _AddFontRows(BRect area);
	void _AddDrawingRow(BRect area);
	void _AddColorSection(BRect area);
	FloatControl* _AddFrameControl(BRect frame, const char* label);

	void LoadFrameValues();
	void _LoadResizingMode();
	void _LoadFlags();
	void _ShowFlagTags();

	bool _ApplyViewEdit(BMessage* message);
	void _ApplyFrame();
	void _ApplyPreferredSize();
	void _ApplyZoom();
	void _ApplyResizingMode();
	void _ApplyFlag(const BMessage* message);

	// EditViewFont.cpp
	void FontChanged();
	void _MarkStandardFont(const BFont& font);
	void _LoadStyles(const char* family, const char* style);
	void _LoadFontAndDrawing();
	bool _ApplyFontEdit(BMessage* message);
	void _ApplyFont(const BFont* font);
	void _ApplyFamilyAndStyle();
	void _ApplyShear();
	void _ApplyRotation();

	// EditViewColors.cpp
	void _TakeRole();
	void _LoadColors();
	bool _ApplyColorEdit(BMessage* message);
	void _ShowRole();
	void _UseDefaultColor();
	void _UseParentColor();
	void _ApplyColor();
	void _SetChildrensColor();

	BTextControl* fNameControl;
	FloatControl* fLeftControl;
	FloatControl* fTopControl;
	FloatControl* fRightControl;
	FloatControl* fBottomControl;
	BMenu* fHorizontalMenu;
	BMenu* fVerticalMenu;
	BMenu* fFlagsMenu;
	BMenuField* fFlagsField;
	BMenu* fFontMenu;
	BMenu* fStyleMenu;
	FloatControl* fSizeControl;
	FloatControl* fShearControl;
	FloatControl* fRotationControl;
	BMenu* fModeMenu;
	FloatControl* fPenSizeControl;
	LiveColorControl* fColorControl;
	BBox* fViewSwatch;
	BBox* fHighSwatch;
	BBox* fLowSwatch;
	BButton* fDefaultButton;
	BRadioButton* fViewRadio;
	BRadioButton* fHighRadio;
	BRadioButton* fLowRadio;
	ColorRole fRole; // what the radio buttons selected when they last reported
};
