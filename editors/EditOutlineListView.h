// EditOutlineListView: says that a BOutlineListView has no settings of its own.
#pragma once

#include "editors/EditorInterface.h"

class BOutlineListView;


class EditOutlineListView : public PanelOf<BOutlineListView> {
public:
	EditOutlineListView();
	~EditOutlineListView() override;

	bool UseView(BView* view) override;
};
