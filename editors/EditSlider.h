// EditSlider: the panel for a slider's range, labels, marks, thumb and bar colour.
#pragma once

#include <functional>

#include "editors/EditorInterface.h"
#include "editors/PanelRows.h"

class BMenu;
class BSlider;
class BTextControl;
class IntControl;


// What a slider cannot change once it is made is changed in its archive, and a new slider takes the
// old one's place.
class EditSlider : public PanelOf<BSlider> {
public:
	EditSlider();
	~EditSlider() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	void _AddLimitRow(BRect row, const char* label, uint32 labelCode, BTextControl*& labelControl,
		const char* value, uint32 valueCode, IntControl*& valueControl);
	void _AddMenuRow(BRect row);
	void _AddMarksRow(BRect row);
	bool _ApplyMarks(uint32 code);
	void _ApplyLimitLabels();
	void _ApplyLimits();
	void _Rebuild(const std::function<void(BMessage& archive)>& change);

	IntControl* snoozeControl;
	BarColorGroup fBarColor;
	BTextControl* minLabelControl;
	IntControl* minValueControl;
	BTextControl* maxLabelControl;
	IntControl* maxValueControl;
	IntControl* keyIncrementControl;
	IntControl* hashMarkCountControl;
	BMenu* thumbMenu;
	BMenu* hashMarksMenu;
};
