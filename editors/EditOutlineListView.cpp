#include "editors/EditOutlineListView.h"

#include <OutlineListView.h>


EditOutlineListView::EditOutlineListView() :
	PanelOf("EditOutlineListView", "Properties from BOutlineListView", kSentencePanelHeight)
{
	AddOnlySentence("The BOutlineListView adds no extra settings.");
}


EditOutlineListView::~EditOutlineListView()
{
}


bool
EditOutlineListView::UseView(BView* view)
{
	return TakeTarget(view);
}
