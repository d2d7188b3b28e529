// EditStatusBar: the panel for a status bar's texts, values, height and colour.
#pragma once

#include "editors/EditorInterface.h"
#include "editors/PanelRows.h"

class BStatusBar;
class BTextControl;
class FloatControl;


class EditStatusBar : public PanelOf<BStatusBar> {
public:
	EditStatusBar();
	~EditStatusBar() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	void _AddTextRow(BRect row, const char* left, uint32 leftCode, BTextControl*& leftControl,
		const char* right, uint32 rightCode, BTextControl*& rightControl);
	void _AddNumberRow(BRect row);
	void _ApplyTexts();
	void _ApplyValue();
	void _ApplyMax();
	void _ApplyBarHeight();

	BTextControl* fLabelControl;
	BTextControl* fTrailingLabelControl;
	BTextControl* fTextControl;
	BTextControl* fTrailingTextControl;
	FloatControl* fValueControl;
	FloatControl* fMaxControl;
	FloatControl* fBarHeightControl;
	BarColorGroup fBarColor;
};
