// EditControl: the panel for what every control has: label, message, value, enabled.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BTextControl;
class BControl;


class EditControl : public PanelOf<BControl> {
public:
	EditControl();
	~EditControl() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	void _ShowValue();

	BTextControl* fMessageControl;
	BTextControl* fLabelControl;
	BTextControl* fValueControl;
	BCheckBox* fEnabledBox;
};
