#include "editors/EditCheckBox.h"

#include <CheckBox.h>


EditCheckBox::EditCheckBox() :
	PanelOf("EditCheckBox", "Properties from BCheckBox", kSentencePanelHeight)
{
	AddOnlySentence("The BCheckBox adds no extra settings.");
}


EditCheckBox::~EditCheckBox()
{
}


bool
EditCheckBox::UseView(BView* view)
{
	return TakeTarget(view);
}
