#include "editors/EditButton.h"

#include <Button.h>
#include <CheckBox.h>
#include <Message.h>

#include "editors/PanelRows.h"

namespace {


constexpr uint32 kDefaultChanged = 'dflt';


} // namespace


EditButton::EditButton() : PanelOf("EditButton", "Properties from BButton", kOneRowPanelHeight)
{
	const BRect area = RowArea();
	fDefaultBox = AddCheckBox(
		this, FrameAt(area.left, area.top, kColumnWidth, kRowHeight), "Default", kDefaultChanged);
}


EditButton::~EditButton()
{
}


bool
EditButton::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	SetOn(fDefaultBox, _Target()->IsDefault());
	return true;
}


bool
EditButton::ApplyEdit(BMessage* message)
{
	if (message->what != kDefaultChanged)
		return false;

	_Target()->MakeDefault(IsOn(fDefaultBox));
	target->Invalidate();
	return true;
}
