// EditScrollView: the panel for a scroll view's border and bars.
#pragma once

#include "editors/EditorInterface.h"

class BCheckBox;
class BMenu;
class BScrollBar;
class BScrollView;
class FloatControl;
class IntControl;


class EditScrollView : public PanelOf<BScrollView> {
public:
	EditScrollView();
	~EditScrollView() override;

	bool UseView(BView* view) override;

	// Loads the totals and steps, which follow the target's size.
	void FrameChanged() override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	// The controls of one scroll bar.
	struct Bar {
		orientation direction;
		BCheckBox* use;
		FloatControl* total;
		IntControl* smallStep;
		IntControl* bigStep;
	};

	struct BarState;
	struct Codes;

	void _AddBarRow(BRect row, Bar& bar, const char* label, const char* total, const Codes& codes);
	void _LoadBar(Bar& bar);
	void _LoadExtent(Bar& bar);
	float _TargetExtent(const Bar& bar) const;
	void _ApplyTotal(const Bar& bar);
	void _ApplySteps(const Bar& bar);
	void _ToggleBar(const Bar& toggled, const Bar& kept);
	BScrollView* _RebuildAround(BView* child) const;

	BMenu* fBorderMenu;
	Bar fHorizontal;
	Bar fVertical;
};
