// EditBox: the panel for a box's label and border.
#pragma once

#include "editors/EditorInterface.h"

class BMenu;
class BTextControl;
class BBox;


class EditBox : public PanelOf<BBox> {
public:
	EditBox();
	~EditBox() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BTextControl* fLabelControl;
	BMenu* fBorderMenu;
};
