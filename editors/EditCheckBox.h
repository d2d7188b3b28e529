// EditCheckBox: says that a BCheckBox has no settings of its own.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;


class EditCheckBox : public PanelOf<BCheckBox> {
public:
	EditCheckBox();
	~EditCheckBox() override;

	bool UseView(BView* view) override;
};
