// EditCheckBox: says that a BCheckBox has no settings of its own.
#pragma once

#include "editors/EditorInterface.h"


class EditCheckBox : public EditorInterface {
public:
	EditCheckBox();
	~EditCheckBox() override;

	bool UseView(BView* view) override;
};
