#include "editors/EditBox.h"

#include <Box.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <TextControl.h>

#include "editors/PanelRows.h"

namespace {


constexpr uint32 kLabelChanged = 'labl';
constexpr uint32 kBorderChosen = 'brdr';


} // namespace


EditBox::EditBox() : PanelOf("EditBox", "Properties from BBox", kOneRowPanelHeight)
{
	fLabelControl = AddTextControl(
		this, TextBesideMenuFrame(), "Label: ", kLabelChanged, 40, B_FOLLOW_ALL_SIDES);
	fBorderMenu = MakeBorderMenu(kBorderChosen);
	AddMenuField(this, MenuBesideTextFrame(), "", fBorderMenu, 0, B_FOLLOW_RIGHT);
}


EditBox::~EditBox()
{
}


bool
EditBox::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	fLabelControl->SetText(_Target()->Label());
	MarkChoice(fBorderMenu, _Target()->Border());
	return true;
}


bool
EditBox::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kLabelChanged:
			_Target()->SetLabel(fLabelControl->Text());
			break;
		case kBorderChosen:
			_Target()->SetBorder(static_cast<border_style>(Choice(fBorderMenu)));
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}
