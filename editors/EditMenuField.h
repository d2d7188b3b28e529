// EditMenuField: the panel for a menu field's label, divider and state.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BMenu;
class BMenuField;
class BTextControl;
class FloatControl;


class EditMenuField : public PanelOf<BMenuField> {
public:
	EditMenuField();
	~EditMenuField() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BTextControl* labelControl;
	BMenu* alignmentMenu;
	BCheckBox* enabledCheckBox;
	FloatControl* dividerControl;
};
