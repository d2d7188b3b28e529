// EditTabView: the panel for a tab view's tabs: their height, width, order and number.
#pragma once

#include "editors/EditorInterface.h"

class BButton;
class BMenu;
class BTabView;
class FloatControl;


class EditTabView : public EditorInterface {
public:
	EditTabView();
	~EditTabView() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	BTabView* _Target() const; // of the class that UseView() has tested
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
