// EditColorControl: the panel for a colour control's cells.
#pragma once

#include "editors/EditorInterface.h"

class BMenu;
class IntControl;
class BColorControl;


class EditColorControl : public PanelOf<BColorControl> {
public:
	EditColorControl();
	~EditColorControl() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BMenu* fLayoutMenu;
	IntControl* fCellSizeControl;
};
