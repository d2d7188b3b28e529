#include "editors/EditControl.h"

#include <cstdio>

#include <CheckBox.h>
#include <Control.h>
#include <Message.h>
#include <TextControl.h>

#include "editors/PanelRows.h"

namespace {


constexpr uint32 kLabelChanged = 'labl';
constexpr uint32 kEnabledChanged = 'enbl';
constexpr uint32 kMessageChanged = 'mssg';
constexpr uint32 kValueChanged = 'valu';


} // namespace


EditControl::EditControl() : PanelOf("EditControl", "Properties from BControl", kTwoRowPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kRowHeight;
	fLabelControl = AddTextControl(this, row, "Label: ", kLabelChanged, 60, B_FOLLOW_LEFT_RIGHT);

	row.OffsetBy(0, kRowStep);
	row.right = row.left + kColumnWidth;
	fEnabledBox = AddCheckBox(this, row, "Enabled", kEnabledChanged);
	row.OffsetBy(kColumnStep, 0);
	fMessageControl = AddTextControl(this, row, "Message: ", kMessageChanged, 50);
	row.OffsetBy(kColumnStep, 0);
	fValueControl = AddTextControl(this, row, "Value: ", kValueChanged, 50);
}


EditControl::~EditControl()
{
}


bool
EditControl::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	ShowMessageCode(fMessageControl, _Target()->Message());
	fLabelControl->SetText(_Target()->Label());
	_ShowValue();
	SetOn(fEnabledBox, _Target()->IsEnabled());
	return true;
}


bool
EditControl::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kLabelChanged:
			_Target()->SetLabel(fLabelControl->Text());
			break;
		case kEnabledChanged:
			_Target()->SetEnabled(IsOn(fEnabledBox));
			break;
		case kValueChanged:
			_Target()->SetValue(NumberFromText(fValueControl->Text()));
			_ShowValue();
			break;
		case kMessageChanged:
			TakeMessageCode(fMessageControl, _Target()->Message(),
				[&](BMessage* made) { _Target()->SetMessage(made); });
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}


void
EditControl::_ShowValue()
{
	char value[16];
	snprintf(value, sizeof(value), "%ld", static_cast<long>(_Target()->Value()));
	fValueControl->SetText(value);
}
