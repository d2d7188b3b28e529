// EditTextControl: the panel for a text control's alignments, divider and message.
#pragma once

#include "editors/EditorInterface.h"

class BMenu;
class FloatControl;
class BTextControl;


class EditTextControl : public PanelOf<BTextControl> {
public:
	EditTextControl();
	~EditTextControl() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BMenu* fLabelAlignMenu;
	BMenu* fTextAlignMenu;
	FloatControl* fDividerControl;
	BTextControl* fMessageControl;
};
