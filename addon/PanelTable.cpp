#include "addon/PanelTable.h"

#include "editors/EditBox.h"
#include "editors/EditButton.h"
#include "editors/EditCheckBox.h"
#include "editors/EditColorControl.h"
#include "editors/EditControl.h"
#include "editors/EditInherited.h"
#include "editors/EditListView.h"
#include "editors/EditMenuBar.h"
#include "editors/EditMenuField.h"
#include "editors/EditOutlineListView.h"
#include "editors/EditRadioButton.h"
#include "editors/EditScrollView.h"
#include "editors/EditSlider.h"
#include "editors/EditStatusBar.h"
#include "editors/EditStringView.h"
#include "editors/EditTabView.h"
#include "editors/EditTextControl.h"
#include "editors/EditTextView.h"

namespace {


typedef EditorInterface* (*PanelMaker)();

template<class Panel>
EditorInterface*
Make()
{
	return new Panel;
}


// From the top of the stack to its bottom.
constexpr PanelMaker kPanelMakers[] = { Make<EditControl>, Make<EditButton>, Make<EditStringView>,
	Make<EditBox>, Make<EditCheckBox>, Make<EditRadioButton>, Make<EditStatusBar>,
	Make<EditTextControl>, Make<EditTextView>, Make<EditSlider>, Make<EditScrollView>,
	Make<EditColorControl>, Make<EditTabView>, Make<EditListView>, Make<EditOutlineListView>,
	Make<EditMenuField>, Make<EditMenuBar>, Make<EditInherited> };


} // namespace


int32
MakePanels(EditorInterface** panels, int32 capacity)
{
	int32 count = 0;
	for (PanelMaker make : kPanelMakers) {
		if (count < capacity - 1)
			panels[count++] = make();
	}
	panels[count] = nullptr;
	return count;
}
