// EditTextView: the panel for a text view's switches, alignment and limits.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BMenu;
class BTextView;
class FloatControl;
class IntControl;


class EditTextView : public PanelOf<BTextView> {
public:
	EditTextView();
	~EditTextView() override;

	bool UseView(BView* view) override;

	// Keeps the text rectangle matched to the bounds.
	void FrameChanged() override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	void _AddMenuRow(BRect row);
	void _AddSwitchRows(BRect row);
	void _AddHints(BRect row);
	bool _ApplySwitch(uint32 code);
	void _ApplyResizable();

	BMenu* colorSpaceMenu;
	BMenu* alignmentMenu;
	FloatControl* tabWidthControl;
	BCheckBox* selectableCheckBox;
	BCheckBox* autoIndentCheckBox;
	IntControl* maxBytesControl;
	BCheckBox* editableCheckBox;
	BCheckBox* stylableCheckBox;
	BCheckBox* wordWrapCheckBox;
	BCheckBox* resizableCheckBox;
};
