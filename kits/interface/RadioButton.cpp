#include <RadioButton.h>

#include <Box.h>
#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"

namespace {

bool
IsLabelOfBox(const BView* view)
{
	const BBox* box = dynamic_cast<const BBox*>(view->Parent());
	return box != NULL && box->LabelView() == view;
}


// The first child of the view, or window, whose children are one group. A radio button that is
// the label of a box stands beside that box, not inside it.
BView*
FirstOfGroup(const BRadioButton* button)
{
	const BView* member = IsLabelOfBox(button) ? button->Parent() : button;
	if (const BView* parent = member->Parent())
		return parent->ChildAt(0);
	return member->Window() != NULL ? member->Window()->ChildAt(0) : NULL;
}


// The radio button that the child of the group's parent is, or has as its label.
BRadioButton*
AsGroupMember(BView* view)
{
	if (BBox* box = dynamic_cast<BBox*>(view))
		return dynamic_cast<BRadioButton*>(box->LabelView());
	return IsLabelOfBox(view) ? NULL : dynamic_cast<BRadioButton*>(view);
}

} // namespace


BRadioButton::BRadioButton(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	_BMarkedControl_(frame, name, label, message, resizingMode, flags)
{
}


BRadioButton::BRadioButton(BMessage* archive) : _BMarkedControl_(archive)
{
}


BRadioButton::~BRadioButton()
{
}


BArchivable*
BRadioButton::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BRadioButton") ? new BRadioButton(archive) : NULL;
}


void
BRadioButton::SetValue(int32 value)
{
	BControl::SetValue(value);
	if (value == B_CONTROL_OFF)
		return;

	for (BView* sibling = FirstOfGroup(this); sibling != NULL; sibling = sibling->NextSibling()) {
		BRadioButton* other = AsGroupMember(sibling);
		if (other != NULL && other != this)
			other->SetValue(B_CONTROL_OFF);
	}
}


void
BRadioButton::Choose()
{
	if (Value() == B_CONTROL_ON)
		return;
	SetValue(B_CONTROL_ON);
	Invoke();
}


// There is no half way.
void
BRadioButton::DrawMark(BPoint leftTop, rgb_color base, uint32 state)
{
	namespace Look = BPrivate::Look;
	if ((state & Look::kPartlyOn) != 0)
		state = (state & ~static_cast<uint32>(Look::kPartlyOn)) | Look::kOn;
	Look::DrawRadioButton(this, leftTop, base, state);
}
