// EditListView: the panel for a list's type and messages.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BListView;
class BTextControl;


class EditListView : public PanelOf<BListView> {
public:
	EditListView();
	~EditListView() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BTextControl* selectMessageControl;
	BTextControl* invokeMessageControl;
	BCheckBox* multipleSelectionCheckBox;
};
