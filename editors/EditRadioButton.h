// EditRadioButton: says that a BRadioButton has no settings of its own.
#pragma once

#include "editors/EditorInterface.h"


class EditRadioButton : public EditorInterface {
public:
	EditRadioButton();
	~EditRadioButton() override;

	bool UseView(BView* view) override;
};
