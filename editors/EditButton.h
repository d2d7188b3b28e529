// EditButton: the panel for whether a button is the default one.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BButton;


class EditButton : public EditorInterface {
public:
	EditButton();
	~EditButton() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BButton* _Target() const; // of the class that UseView() has tested

	BCheckBox* fDefaultBox;
};
