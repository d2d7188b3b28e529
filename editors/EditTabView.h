// EditTabView: the panel for a tab view's tabs: their height, width, order and number.
#pragma once

#include "editors/EditorInterface.h"

class BButton;
class BMenu;
class BTabView;
class FloatControl;


class EditTabView : public PanelOf<BTabView> {
public:
	EditTabView();
	~EditTabView() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	void _MoveForward();
	void _MoveBackward();
	void _MoveToEnd(int32 index);
	void _DeleteTab();
	void _InsertTab();

	FloatControl* tabHeightControl;
	BMenu* tabWidthMenu;
	BButton* forwardButton;
	BButton* backwardButton;
	BButton* deleteTabButton;
	BButton* insertTabButton;
};
