// EditButton: the panel for whether a button is the default one.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BButton;


class EditButton : public PanelOf<BButton> {
public:
	EditButton();
	~EditButton() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BCheckBox* fDefaultBox;
};
