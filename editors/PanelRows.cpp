#include "editors/PanelRows.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>

#include <Button.h>
#include <CheckBox.h>
#include <Font.h>
#include <Menu.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <RadioButton.h>
#include <StringView.h>
#include <TextControl.h>

#include "editors/FloatControl.h"
#include "editors/IntControl.h"
#include "editors/LiveColorControl.h"

namespace {


constexpr uint32 kNoMessageCode = '----';


// A box takes its parent's colour whenever it is attached, and a panel is attached often.
class Swatch : public BBox {
public:
	using BBox::BBox;

	void AttachedToWindow() override
	{
		const rgb_color color = ViewColor();
		BBox::AttachedToWindow();
		SetViewColor(color);
	}
};


} // namespace


BRect
FrameAt(float left, float top, float width, float height)
{
	return BRect(left, top, left + width, top + height);
}


BTextControl*
AddTextControl(
	BView* panel, BRect frame, const char* label, uint32 code, float divider, uint32 resizingMode)
{
	BTextControl* control =
		new BTextControl(frame, NULL, label, "", new BMessage(code), resizingMode, kControlFlags);
	control->SetDivider(divider);
	panel->AddChild(control);
	return control;
}


IntControl*
AddIntControl(BView* panel, BRect frame, const char* label, uint32 code, int value, int min,
	int max, float divider, uint32 resizingMode)
{
	IntControl* control = new IntControl(
		frame, NULL, label, new BMessage(code), value, min, max, resizingMode, kControlFlags);
	control->SetDivider(divider);
	panel->AddChild(control);
	return control;
}


FloatControl*
AddFloatControl(BView* panel, BRect frame, const char* label, uint32 code, float value, float min,
	float max, float divider, uint32 resizingMode)
{
	FloatControl* control = new FloatControl(
		frame, NULL, label, new BMessage(code), value, min, max, resizingMode, kControlFlags);
	control->SetDivider(divider);
	panel->AddChild(control);
	return control;
}


BCheckBox*
AddCheckBox(BView* panel, BRect frame, const char* label, uint32 code)
{
	BCheckBox* box =
		new BCheckBox(frame, NULL, label, new BMessage(code), kFollowLeftTop, kControlFlags);
	panel->AddChild(box);
	return box;
}


BButton*
AddButton(BView* panel, BRect frame, const char* label, uint32 code, uint32 resizingMode)
{
	BButton* button =
		new BButton(frame, NULL, label, new BMessage(code), resizingMode, kControlFlags);
	panel->AddChild(button);
	return button;
}


BRadioButton*
AddRadioButton(BView* panel, BRect frame, const char* label, uint32 code, uint32 resizingMode)
{
	BRadioButton* button =
		new BRadioButton(frame, NULL, label, new BMessage(code), resizingMode, kControlFlags);
	panel->AddChild(button);
	return button;
}


void
AddSentence(BView* panel, BRect frame, const char* text, uint32 resizingMode)
{
	panel->AddChild(new BStringView(frame, NULL, text, resizingMode, B_WILL_DRAW));
}


void
AddSeparator(BView* panel, BRect frame)
{
	panel->AddChild(new BBox(frame, NULL, kFollowWidth, kGroupFlags, B_FANCY_BORDER));
}


BMenuField*
AddMenuField(
	BView* panel, BRect frame, const char* label, BMenu* menu, float divider, uint32 resizingMode)
{
	BMenuField* field = new BMenuField(frame, "", label, menu, true, resizingMode, kControlFlags);
	field->SetDivider(divider);
	panel->AddChild(field);
	return field;
}


BMenu*
MakeChoiceMenu(std::initializer_list<const char*> labels, uint32 code)
{
	BMenu* menu = new BMenu("", B_ITEMS_IN_COLUMN);
	menu->SetLabelFromMarked(true);
	for (const char* label : labels)
		menu->AddItem(new BMenuItem(label, new BMessage(code)));
	return menu;
}


BMenu*
MakeAlignmentMenu(uint32 code)
{
	return MakeChoiceMenu({ "B_ALIGN_LEFT", "B_ALIGN_RIGHT", "B_ALIGN_CENTER" }, code);
}


BMenu*
MakeBorderMenu(uint32 code)
{
	return MakeChoiceMenu({ "B_PLAIN_BORDER", "B_FANCY_BORDER", "B_NO_BORDER" }, code);
}


void
MarkChoice(BMenu* menu, int32 index)
{
	if (BMenuItem* item = menu->ItemAt(index))
		item->SetMarked(true);
	else if (BMenuItem* marked = menu->FindMarked())
		marked->SetMarked(false);
}


int32
Choice(const BMenu* menu)
{
	BMenu* searched = const_cast<BMenu*>(menu);
	return searched->IndexOf(searched->FindMarked());
}


bool
IsOn(const BCheckBox* box)
{
	return box->Value() != B_CONTROL_OFF;
}


void
SetOn(BCheckBox* box, bool on)
{
	box->SetValue(on ? B_CONTROL_ON : B_CONTROL_OFF);
}


int32
NumberFromText(const char* text)
{
	return static_cast<int32>(std::clamp<long>(strtol(text, nullptr, 10), INT32_MIN, INT32_MAX));
}


int32
WholeNumber(float number)
{
	// The largest float that is no greater than the type's limit is less than it.
	if (number >= static_cast<float>(INT32_MAX))
		return INT32_MAX;
	return number > static_cast<float>(INT32_MIN) ? static_cast<int32>(number) : INT32_MIN;
}


uint32
TakeCode(BTextControl* control)
{
	const char* text = control->Text();
	// Characters count with their sign, so one of 0x80 or more sets all higher bits: that is wanted.
	uint32 code = 0;
	for (int i = 0; i < 4; i++) {
		const signed char character = static_cast<signed char>(*text);
		code = code << 8 | static_cast<uint32>(static_cast<int32>(character));
		if (*text != '\0')
			text++;
	}
	ShowCode(control, code);
	return code;
}


void
ShowCode(BTextControl* control, uint32 code)
{
	const char text[] = { static_cast<char>(code >> 24), static_cast<char>(code >> 16),
		static_cast<char>(code >> 8), static_cast<char>(code), '\0' };
	control->SetText(text);
}


void
ShowMessageCode(BTextControl* control, const BMessage* message)
{
	ShowCode(control, message != NULL ? message->what : kNoMessageCode);
}


bool
SameRGB(rgb_color a, rgb_color b)
{
	return a.red == b.red && a.green == b.green && a.blue == b.blue;
}


BarColorGroup
AddBarColorGroup(BView* panel, BRect frame, BPoint origin)
{
	BBox* group = new BBox(frame, NULL, B_FOLLOW_ALL_SIDES, kGroupFlags, B_PLAIN_BORDER);
	group->SetFont(be_plain_font, B_FONT_ALL);
	group->SetLabel("Bar Color");
	panel->AddChild(group);

	BarColorGroup parts;
	parts.control =
		new LiveColorControl(origin, B_CELLS_32x8, 1, "", new BMessage(kLiveColorChanged), true);
	group->AddChild(parts.control);

	const float width = group->Bounds().right - 4 - (origin.x + 280);
	BRect right = FrameAt(origin.x + 280, origin.y, width, 26);
	parts.swatch = AddSwatch(group, right);

	right.top = right.bottom + 4;
	right.bottom = right.top + 2; // the button takes its own height
	AddButton(group, right, "Use Default", kDefaultColorPressed, B_FOLLOW_LEFT_RIGHT);
	return parts;
}


void
ShowBarColor(const BarColorGroup& group, rgb_color color)
{
	group.control->SetValue(color);
	ShowSwatch(group.swatch, color);
}


bool
TakeBarColor(const BarColorGroup& group, uint32 code, rgb_color defaultColor, rgb_color* color)
{
	if (code == kDefaultColorPressed)
		group.control->SetValue(defaultColor);
	else if (code == kColorComponentTyped)
		group.control->SetValueFromComponents();

	const rgb_color present = *color;
	*color = group.control->ValueAsColor();
	ShowSwatch(group.swatch, *color);
	return !SameRGB(*color, present);
}


void
ShowSwatch(BBox* swatch, rgb_color color)
{
	swatch->SetViewColor(color);
	swatch->Invalidate();
}


BBox*
AddSwatch(BView* panel, BRect frame)
{
	BBox* swatch = new Swatch(frame, "", B_FOLLOW_LEFT_RIGHT, kGroupFlags, B_FANCY_BORDER);
	panel->AddChild(swatch);
	return swatch;
}
