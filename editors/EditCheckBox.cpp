#include "editors/EditCheckBox.h"

#include <CheckBox.h>

#include "editors/PanelRows.h"


EditCheckBox::EditCheckBox() :
	EditorInterface("EditCheckBox", "Properties from BCheckBox", kSentencePanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kRowHeight;
	AddSentence(this, row, "The BCheckBox adds no extra settings.");
}


EditCheckBox::~EditCheckBox()
{
}


bool
EditCheckBox::UseView(BView* view)
{
	return TakeTarget(dynamic_cast<BCheckBox*>(view));
}
