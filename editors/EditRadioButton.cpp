#include "editors/EditRadioButton.h"

#include <RadioButton.h>


EditRadioButton::EditRadioButton() :
	PanelOf("EditRadioButton", "Properties from BRadioButton", kSentencePanelHeight)
{
	AddOnlySentence("The BRadioButton adds no extra settings.");
}


EditRadioButton::~EditRadioButton()
{
}


bool
EditRadioButton::UseView(BView* view)
{
	return TakeTarget(view);
}
