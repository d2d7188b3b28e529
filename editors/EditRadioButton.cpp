#include "editors/EditRadioButton.h"

#include <RadioButton.h>

#include "editors/PanelRows.h"


EditRadioButton::EditRadioButton() :
	EditorInterface("EditRadioButton", "Properties from BRadioButton", kSentencePanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kRowHeight;
	AddSentence(this, row, "The BRadioButton adds no extra settings.");
}


EditRadioButton::~EditRadioButton()
{
}


bool
EditRadioButton::UseView(BView* view)
{
	return TakeTarget(dynamic_cast<BRadioButton*>(view));
}
