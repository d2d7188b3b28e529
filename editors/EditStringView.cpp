#include "editors/EditStringView.h"

#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <StringView.h>
#include <TextControl.h>

#include "editors/PanelRows.h"

namespace {


constexpr uint32 kTextChanged = 'text';
constexpr uint32 kAlignmentChosen = 'algn';


} // namespace


EditStringView::EditStringView() :
	PanelOf("EditStringView", "Properties from BStringView", kOneRowPanelHeight)
{
	fTextControl =
		AddTextControl(this, TextBesideMenuFrame(), "Text: ", kTextChanged, 40, B_FOLLOW_ALL_SIDES);
	fAlignmentMenu = MakeAlignmentMenu(kAlignmentChosen);
	AddMenuField(this, MenuBesideTextFrame(), "", fAlignmentMenu, 0, B_FOLLOW_RIGHT);
}


EditStringView::~EditStringView()
{
}


bool
EditStringView::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	fTextControl->SetText(_Target()->Text());
	MarkChoice(fAlignmentMenu, _Target()->Alignment());
	return true;
}


bool
EditStringView::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kTextChanged:
			_Target()->SetText(fTextControl->Text());
			break;
		case kAlignmentChosen:
			_Target()->SetAlignment(static_cast<alignment>(Choice(fAlignmentMenu)));
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}
