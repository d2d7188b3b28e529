#include "editors/EditOutlineListView.h"

#include <OutlineListView.h>

#include "editors/PanelRows.h"


EditOutlineListView::EditOutlineListView() :
	EditorInterface("EditOutlineListView", "Properties from BOutlineListView", kSentencePanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kRowHeight;
	AddSentence(this, row, "The BOutlineListView adds no extra settings.");
}


EditOutlineListView::~EditOutlineListView()
{
}


bool
EditOutlineListView::UseView(BView* view)
{
	return TakeTarget(dynamic_cast<BOutlineListView*>(view));
}
