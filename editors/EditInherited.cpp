#include "editors/EditInherited.h"

#include <Message.h>
#include <TextControl.h>

#include "archive/LayoutInheritedView.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kClassNameChanged = 'name';


} // namespace


EditInherited::EditInherited() :
	EditorInterface("EditInherited", "Properties of YOUR Class", kOneRowPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + 20;
	fClassNameControl =
		AddTextControl(this, row, "Class name: ", kClassNameChanged, 80, B_FOLLOW_ALL_SIDES);
}


EditInherited::~EditInherited()
{
}


void
EditInherited::MessageReceived(BMessage* message)
{
	if (message->what != kClassNameChanged) {
		BBox::MessageReceived(message);
		return;
	}
	if (TargetLives())
		dynamic_cast<LayoutInherited*>(target)->SetClassName(fClassNameControl->Text());
}


bool
EditInherited::UseView(BView* view)
{
	const LayoutInherited* placeholder = dynamic_cast<LayoutInherited*>(view);
	if (!TakeTarget(placeholder != nullptr ? view : nullptr))
		return false;

	fClassNameControl->SetText(placeholder->ClassName());
	return true;
}
