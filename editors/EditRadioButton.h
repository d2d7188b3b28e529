// EditRadioButton: says that a BRadioButton has no settings of its own.
#pragma once

#include "editors/EditorInterface.h"

class BRadioButton;


class EditRadioButton : public PanelOf<BRadioButton> {
public:
	EditRadioButton();
	~EditRadioButton() override;

	bool UseView(BView* view) override;
};
