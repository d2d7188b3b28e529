// EditView: the panel for what every view has: name, frame, resizing mode and flags.
#pragma once

#include "editors/EditorInterface.h"

class BMenu;
class BMenuField;
class BTextControl;
class FloatControl;


class EditView : public EditorInterface {
public:
	EditView();
	~EditView() override;

	void FrameChanged() override;
	void MessageReceived(BMessage* message) override;

	// Accepts every view.
	bool UseView(BView* view) override;

private:
	void _AddNameRow(BRect area);
	void _AddFrameRow(BRect area);
	void _AddResizingRow(BRect area);
	void _AddFlagsRow(BRect area);
	FloatControl* _AddFrameControl(BRect frame, const char* label);

	void LoadFrameValues();
	void _LoadResizingMode();
	void _LoadFlags();
	void _ShowFlagTags();

	bool _ApplyEdit(BMessage* message);
	void _ApplyFrame();
	void _ApplyPreferredSize();
	void _ApplyZoom();
	void _ApplyResizingMode();
	void _ApplyFlag(const BMessage* message);

	BTextControl* fNameControl;
	FloatControl* fLeftControl;
	FloatControl* fTopControl;
	FloatControl* fRightControl;
	FloatControl* fBottomControl;
	BMenu* fHorizontalMenu;
	BMenu* fVerticalMenu;
	BMenu* fFlagsMenu;
	BMenuField* fFlagsField;
};
