#include "editors/EditMenuField.h"

#include <cfloat>

#include <CheckBox.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <TextControl.h>

#include "editors/FloatControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kLabelChanged = 'labl';
constexpr uint32 kAlignmentChosen = 'algn';
constexpr uint32 kDividerChanged = 'dvdr';
constexpr uint32 kEnabledChanged = 'enbl';


} // namespace


EditMenuField::EditMenuField() :
	PanelOf("EditMenuField", "Properties from BMenuField", kTwoRowPanelHeight)
{
	labelControl = AddTextControl(
		this, TextBesideMenuFrame(), "Label: ", kLabelChanged, 40, B_FOLLOW_ALL_SIDES);
	alignmentMenu = MakeAlignmentMenu(kAlignmentChosen);
	AddMenuField(this, MenuBesideTextFrame(), "", alignmentMenu, 0, B_FOLLOW_RIGHT);

	const BRect area = RowArea();
	BRect frame = FrameAt(area.left, area.top + kRowStep, kColumnWidth, 20);
	dividerControl =
		AddFloatControl(this, frame, "Divider:", kDividerChanged, 0, -FLT_MAX, FLT_MAX, 40);
	frame.OffsetBy(frame.Width() + 30, 0);
	enabledCheckBox = AddCheckBox(this, frame, "Enabled", kEnabledChanged);
}


EditMenuField::~EditMenuField()
{
}


bool
EditMenuField::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	labelControl->SetText(_Target()->Label());
	MarkChoice(alignmentMenu, _Target()->Alignment());
	SetOn(enabledCheckBox, _Target()->IsEnabled());
	dividerControl->SetFloatValue(_Target()->Divider());
	return true;
}


bool
EditMenuField::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kLabelChanged:
			_Target()->SetLabel(labelControl->Text());
			break;
		case kAlignmentChosen:
			_Target()->SetAlignment(static_cast<alignment>(Choice(alignmentMenu)));
			break;
		case kDividerChanged:
			_Target()->SetDivider(dividerControl->FloatValue());
			dividerControl->ShowFloatValue(_Target()->Divider()); // which is a whole number
			break;
		case kEnabledChanged:
			_Target()->SetEnabled(IsOn(enabledCheckBox));
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}
