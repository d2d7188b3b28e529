// EditListView: the panel for a list's type and messages.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BListView;
class BTextControl;


class EditListView : public EditorInterface {
public:
	EditListView();
	~EditListView() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BListView* _Target() const; // of the class that UseView() has tested

	BTextControl* selectMessageControl;
	BTextControl* invokeMessageControl;
	BCheckBox* multipleSelectionCheckBox;
};
