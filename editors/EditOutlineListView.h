// EditOutlineListView: says that a BOutlineListView has no settings of its own.
#pragma once

#include "editors/EditorInterface.h"


class EditOutlineListView : public EditorInterface {
public:
	EditOutlineListView();
	~EditOutlineListView() override;

	bool UseView(BView* view) override;
};
