#include "editors/EditOutlineListView.h"

#include <OutlineListView.h>


EditOutlineListView::EditOutlineListView() :
	EditorInterface("EditOutlineListView", "Properties from BOutlineListView", kSentencePanelHeight)
{
	AddOnlySentence("The BOutlineListView adds no extra settings.");
}


EditOutlineListView::~EditOutlineListView()
{
}


bool
EditOutlineListView::UseView(BView* view)
{
	return TakeTarget(dynamic_cast<BOutlineListView*>(view));
}
