// EditColorControl: the panel for a colour control's cells.
#pragma once

#include "editors/EditorInterface.h"

class BMenu;
class IntControl;
class BColorControl;


class EditColorControl : public EditorInterface {
public:
	EditColorControl();
	~EditColorControl() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BColorControl* _Target() const; // of the class that UseView() has tested

	BMenu* fLayoutMenu;
	IntControl* fCellSizeControl;
};
