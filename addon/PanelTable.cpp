#include "addon/PanelTable.h"

#include <vector>

#include "editors/EditorInterface.h"

namespace {


typedef EditorInterface* (*PanelMaker)();

template<class Panel>
EditorInterface*
Make()
{
	return new Panel;
}


// From the top of the stack to its bottom.
const std::vector<PanelMaker> kPanelMakers = {};


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
