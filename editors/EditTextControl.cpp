#include "editors/EditTextControl.h"

#include <cfloat>

#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <TextControl.h>

#include "editors/FloatControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kLabelAlignmentChosen = 'laln';
constexpr uint32 kTextAlignmentChosen = 'taln';
constexpr uint32 kDividerChanged = 'dvdr';
constexpr uint32 kMessageChanged = 'mssg';


} // namespace


EditTextControl::EditTextControl() :
	PanelOf("EditTextControl", "Properties from BTextControl", kTwoRowPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + 20;
	fLabelAlignMenu = MakeAlignmentMenu(kLabelAlignmentChosen);
	AddMenuField(this, BRect(row.left, row.top, row.left + 180, row.bottom),
		"Label:", fLabelAlignMenu, 40, B_FOLLOW_LEFT);
	fTextAlignMenu = MakeAlignmentMenu(kTextAlignmentChosen);
	AddMenuField(this, BRect(row.right - 180, row.top, row.right, row.bottom),
		"Text:", fTextAlignMenu, 40, B_FOLLOW_RIGHT);

	row.OffsetBy(0, kRowStep);
	row.bottom = row.top + 18;
	fDividerControl =
		AddFloatControl(this, BRect(row.left, row.top, row.left + kColumnWidth, row.bottom),
			"Divider:", kDividerChanged, 0, -FLT_MAX, FLT_MAX, 40);
	// The label says invocation, but it is the modification message that is shown: this is wanted.
	fMessageControl = AddTextControl(this, BRect(row.right - 150, row.top, row.right, row.bottom),
		"Invocation message:", kMessageChanged, 110, kFollowRightTop);
}


EditTextControl::~EditTextControl()
{
}


bool
EditTextControl::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	ShowMessageCode(fMessageControl, _Target()->ModificationMessage());
	alignment label, text;
	_Target()->GetAlignment(&label, &text);
	MarkChoice(fLabelAlignMenu, label);
	MarkChoice(fTextAlignMenu, text);
	fDividerControl->SetFloatValue(_Target()->Divider());
	return true;
}


bool
EditTextControl::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kLabelAlignmentChosen:
		case kTextAlignmentChosen:
			_Target()->SetAlignment(static_cast<alignment>(Choice(fLabelAlignMenu)),
				static_cast<alignment>(Choice(fTextAlignMenu)));
			break;
		case kDividerChanged:
			_Target()->SetDivider(fDividerControl->FloatValue());
			fDividerControl->ShowFloatValue(_Target()->Divider()); // which is a whole number
			break;
		case kMessageChanged:
			TakeMessageCode(fMessageControl, _Target()->ModificationMessage(),
				[&](BMessage* made) { _Target()->SetModificationMessage(made); });
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}
