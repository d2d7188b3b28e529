// EditStringView: the panel for a string view's text and alignment.
#pragma once

#include "editors/EditorInterface.h"

class BMenu;
class BTextControl;
class BStringView;


class EditStringView : public PanelOf<BStringView> {
public:
	EditStringView();
	~EditStringView() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BTextControl* fTextControl;
	BMenu* fAlignmentMenu;
};
