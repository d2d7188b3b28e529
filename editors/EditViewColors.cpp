// EditView: the view, high and low colour.

#include <Beep.h>
#include <Button.h>
#include <Font.h>
#include <Message.h>
#include <RadioButton.h>
#include <TextView.h>

#include "editors/EditView.h"
#include "editors/LiveColorControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kDefaultPressed = 'dflt';
constexpr uint32 kParentPressed = 'prnt';
constexpr uint32 kChildrenPressed = 'chld';
constexpr uint32 kViewChosen = 'view';
constexpr uint32 kHighChosen = 'high';
constexpr uint32 kLowChosen = 'low ';

constexpr float kSectionHeight = 100;
constexpr float kInset = 6;
constexpr float kFirstRow = 10;
constexpr float kSwatchHeight = 24;
constexpr float kSwatchStep = 29;
constexpr float kRadioWidth = 54;
constexpr float kGap = 6;
constexpr float kButtonTop = 59;
constexpr float kButtonStep = 90;
constexpr float kButtonWidth = 84;
constexpr float kButtonHeight = 24;

constexpr rgb_color kBlack = { 0, 0, 0, 0 };
constexpr rgb_color kPanelGray = { 216, 216, 216, 0 };


// A text view's text has its own colour.
void
SetHighColorOf(BView* view, rgb_color color)
{
	view->SetHighColor(color);
	if (BTextView* textView = dynamic_cast<BTextView*>(view))
		textView->SetFontAndColor(NULL, 0, &color);
}


// The low colour of a view whose colours are alike follows its view colour.
void
SetViewColorOf(BView* view, rgb_color color)
{
	if (SameRGB(view->ViewColor(), view->LowColor()))
		view->SetLowColor(color);
	view->SetViewColor(color);
}


template<class Function>
void
ForEachDescendant(BView* view, const Function& function)
{
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		function(child);
		ForEachDescendant(child, function);
	}
}


} // namespace


void
EditView::_AddColorSection(BRect area)
{
	area.bottom = area.top + kSectionHeight;
	BBox* section = new BBox(area, NULL, B_FOLLOW_ALL_SIDES, kGroupFlags, B_PLAIN_BORDER);
	section->SetFont(be_plain_font, B_FONT_ALL);
	section->SetLabel("View (background), High, and Low Color");
	AddChild(section);

	fColorControl = new LiveColorControl(
		BPoint(kInset, kFirstRow), B_CELLS_32x8, 1, "", new BMessage(kLiveColorChanged), true);
	section->AddChild(fColorControl);

	const float radioLeft = section->Bounds().right - kInset - kRadioWidth;
	BRect frame(fColorControl->Frame().right + kGap, kFirstRow, radioLeft - kGap,
		kFirstRow + kSwatchHeight);
	for (BBox** swatch : { &fViewSwatch, &fHighSwatch, &fLowSwatch }) {
		*swatch = AddSwatch(section, frame);
		frame.OffsetBy(0, kSwatchStep);
	}

	BRect button = FrameAt(kInset, kButtonTop, kButtonWidth, kButtonHeight);
	fDefaultButton = AddButton(section, button, "216 Gray", kDefaultPressed);
	button.OffsetBy(kButtonStep, 0);
	AddButton(section, button, "Use Parent", kParentPressed);
	button.OffsetBy(kButtonStep, 0);
	AddButton(section, button, "Set Children", kChildrenPressed);

	BRect radio = FrameAt(radioLeft, kFirstRow, kRadioWidth, kSwatchHeight);
	fViewRadio = AddRadioButton(section, radio, "View", kViewChosen, B_FOLLOW_RIGHT);
	radio.OffsetBy(0, kSwatchStep);
	fHighRadio = AddRadioButton(section, radio, "High", kHighChosen, B_FOLLOW_RIGHT);
	radio.OffsetBy(0, kSwatchStep);
	fLowRadio = AddRadioButton(section, radio, "Low", kLowChosen, B_FOLLOW_RIGHT);
	fViewRadio->SetValue(B_CONTROL_ON);
}


// The radio buttons may be ahead of the messages, which are carried out one by one.
void
EditView::_TakeRole()
{
	if (fHighRadio->Value() != B_CONTROL_OFF)
		fRole = ColorRole::kHigh;
	else if (fLowRadio->Value() != B_CONTROL_OFF)
		fRole = ColorRole::kLow;
	else
		fRole = ColorRole::kView;
}


void
EditView::_LoadColors()
{
	ShowSwatch(fViewSwatch, target->ViewColor());
	ShowSwatch(fHighSwatch, target->HighColor());
	ShowSwatch(fLowSwatch, target->LowColor());
	_TakeRole();
	_ShowRole();
}


bool
EditView::_ApplyColorEdit(BMessage* message)
{
	switch (message->what) {
		case kViewChosen:
		case kHighChosen:
		case kLowChosen:
			_TakeRole();
			_ShowRole();
			break;
		case kColorComponentTyped:
			fColorControl->SetValueFromComponents();
			_ApplyColor();
			break;
		case kLiveColorChanged:
			_ApplyColor();
			break;
		case kDefaultPressed:
			_UseDefaultColor();
			_ApplyColor();
			break;
		case kParentPressed:
			_UseParentColor();
			_ApplyColor();
			break;
		case kChildrenPressed:
			_SetChildrensColor();
			break;
		default:
			return false;
	}
	return true;
}


// Loads the control with the colour that the radio buttons select, and names its default.
void
EditView::_ShowRole()
{
	switch (fRole) {
		case ColorRole::kView:
			fColorControl->SetValue(target->ViewColor());
			fDefaultButton->SetLabel("216 Gray");
			break;
		case ColorRole::kHigh:
			fColorControl->SetValue(target->HighColor());
			fDefaultButton->SetLabel("Black");
			break;
		case ColorRole::kLow:
			fColorControl->SetValue(target->LowColor());
			fDefaultButton->SetLabel("Use View Color");
			break;
	}
}


void
EditView::_UseDefaultColor()
{
	switch (fRole) {
		case ColorRole::kView:
			fColorControl->SetValue(kPanelGray);
			break;
		case ColorRole::kHigh:
			fColorControl->SetValue(kBlack);
			break;
		case ColorRole::kLow:
			fColorControl->SetValue(target->ViewColor());
			break;
	}
}


void
EditView::_UseParentColor()
{
	const BView* parent = target->Parent();
	if (parent == nullptr) {
		beep();
		return;
	}

	switch (fRole) {
		case ColorRole::kView:
			fColorControl->SetValue(parent->ViewColor());
			break;
		case ColorRole::kHigh:
			fColorControl->SetValue(parent->HighColor());
			break;
		case ColorRole::kLow:
			fColorControl->SetValue(parent->LowColor());
			break;
	}
}


// A colour that the view has already is not set again: loading the control reports it too, and the
// control knows nothing of alpha and transparency.
void
EditView::_ApplyColor()
{
	const rgb_color color = fColorControl->ValueAsColor();
	switch (fRole) {
		case ColorRole::kView:
			if (SameRGB(color, target->ViewColor()))
				return;
			if (SameRGB(fViewSwatch->ViewColor(), fLowSwatch->ViewColor())) {
				target->SetLowColor(color);
				ShowSwatch(fLowSwatch, color);
			}
			target->SetViewColor(color);
			ShowSwatch(fViewSwatch, color);
			break;
		case ColorRole::kHigh:
			if (SameRGB(color, target->HighColor()))
				return;
			SetHighColorOf(target, color);
			ShowSwatch(fHighSwatch, color);
			break;
		case ColorRole::kLow:
			if (SameRGB(color, target->LowColor()))
				return;
			target->SetLowColor(color);
			ShowSwatch(fLowSwatch, color);
			break;
	}
	target->Invalidate();
}


void
EditView::_SetChildrensColor()
{
	const rgb_color color = fColorControl->ValueAsColor();
	const ColorRole role = fRole;
	ForEachDescendant(target, [color, role](BView* view) {
		switch (role) {
			case ColorRole::kView:
				SetViewColorOf(view, color);
				break;
			case ColorRole::kHigh:
				SetHighColorOf(view, color);
				break;
			case ColorRole::kLow:
				view->SetLowColor(color);
				break;
		}
		view->Invalidate();
	});
}
