#include <OptionPopUp.h>

#include <algorithm>
#include <cmath>
#include <cstring>

#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>

#include "interface/private/Label.h"
#include "interface/private/ViewArchive.h"

namespace {

constexpr const char* kFieldName = "_menu";
constexpr float kLabelSpace = 8; // from the label's end to the divider
constexpr float kBarMargin = 2; // between the divider and the bar, and behind the bar


// False for an item that stands for no value, as a separator.
bool
FindValue(const BMenuItem* item, int32* _value)
{
	const BMessage* message = item->Message();
	return message != NULL && message->FindInt32("be:value", _value) == B_OK;
}


bool
StandsFor(const BMenuItem* item, int32 value)
{
	int32 own;
	return FindValue(item, &own) && own == value;
}


bool
Describe(const BMenuItem* item, const char** _name, int32* _value)
{
	if (item == NULL)
		return false;
	if (_name != NULL)
		*_name = item->Label() != NULL ? item->Label() : "";
	if (_value != NULL && !FindValue(item, _value))
		*_value = 0;
	return true;
}

} // namespace


BOptionPopUp::BOptionPopUp(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	BOptionPopUp(frame, name, label, message, false, resizingMode, flags)
{
}


BOptionPopUp::BOptionPopUp(BRect frame, const char* name, const char* label, BMessage* message,
	bool fixedSize, uint32 resizingMode, uint32 flags) :
	BOptionControl(frame, name, label, message, resizingMode, flags & ~B_NAVIGABLE)
{
	_CreateField(fixedSize);
}


BOptionPopUp::BOptionPopUp(BMessage* archive) : BOptionControl(archive)
{
	// Options, mark and state came with the child.
}


BOptionPopUp::~BOptionPopUp()
{
}


BArchivable*
BOptionPopUp::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BOptionPopUp") ? new BOptionPopUp(archive) : NULL;
}


status_t
BOptionPopUp::Archive(BMessage* archive, bool deep) const
{
	return BOptionControl::Archive(archive, deep);
}


// #pragma mark - menu field


void
BOptionPopUp::_CreateField(bool fixedSize)
{
	BMenuField* field = new BMenuField(Bounds(), kFieldName, Label(), new BPopUpMenu(kFieldName),
		fixedSize, B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	field->SetEnabled(IsEnabled());
	AddChild(field);
}


BMenuField*
BOptionPopUp::_Field() const
{
	// The field is a view like others: it may be taken out, and another one put in its place.
	for (BView* child = ChildAt(0); child != NULL; child = child->NextSibling()) {
		BMenuField* field = dynamic_cast<BMenuField*>(child);
		if (field != NULL && field->Name() != NULL && strcmp(field->Name(), kFieldName) == 0)
			return field;
	}
	return NULL;
}


BMenu*
BOptionPopUp::_Menu() const
{
	const BMenuField* field = _Field();
	return field != NULL ? field->Menu() : NULL;
}


BMenuField*
BOptionPopUp::MenuField()
{
	if (_Field() == NULL)
		_CreateField(false);
	return _Field();
}


// #pragma mark - options


bool
BOptionPopUp::GetOptionAt(int32 index, const char** _name, int32* _value)
{
	const BMenu* menu = _Menu();
	return menu != NULL && Describe(menu->ItemAt(index), _name, _value);
}


void
BOptionPopUp::RemoveOptionAt(int32 index)
{
	if (BMenu* menu = _Menu())
		delete menu->RemoveItem(index);
}


int32
BOptionPopUp::CountOptions() const
{
	const BMenu* menu = _Menu();
	return menu != NULL ? menu->CountItems() : 0;
}


status_t
BOptionPopUp::AddOptionAt(const char* name, int32 value, int32 index)
{
	const int32 count = CountOptions();
	if (name == NULL || index < 0 || index > count)
		return B_BAD_VALUE;
	BMenu* menu = MenuField()->Menu();
	if (menu == NULL)
		return B_NO_INIT;

	BMenuItem* item = new BMenuItem(name, MakeValueMessage(value));
	if (!menu->AddItem(item, index)) {
		delete item;
		return B_ERROR;
	}
	item->SetTarget(this);
	if (count == 0)
		SetValue(value);
	return B_OK;
}


int32
BOptionPopUp::SelectedOption(const char** _name, int32* _value) const
{
	BMenu* menu = _Menu();
	BMenuItem* marked = menu != NULL ? menu->FindMarked() : NULL;
	return Describe(marked, _name, _value) ? menu->IndexOf(marked) : -1;
}


void
BOptionPopUp::SetValue(int32 value)
{
	BOptionControl::SetValue(value);
	BMenu* menu = _Menu();
	if (menu == NULL)
		return;
	// The user may have marked a later one of several with that value.
	BMenuItem* marked = menu->FindMarked();
	if (marked != NULL && StandsFor(marked, value))
		return;
	for (int32 i = 0; BMenuItem* item = menu->ItemAt(i); i++) {
		if (StandsFor(item, value)) {
			item->SetMarked(true);
			return;
		}
	}
}


// #pragma mark - hooks


void
BOptionPopUp::AttachedToWindow()
{
	BOptionControl::AttachedToWindow();
}


// The items' messages go through the control, also those that had the window as their target.
void
BOptionPopUp::AllAttached()
{
	BOptionControl::AllAttached();
	if (BMenu* menu = _Menu())
		menu->SetTargetForItems(this);
}


void
BOptionPopUp::MessageReceived(BMessage* message)
{
	BOptionControl::MessageReceived(message);
}


void
BOptionPopUp::MakeFocus(bool focused)
{
	if (BMenuField* field = _Field())
		field->MakeFocus(focused);
	else
		BOptionControl::MakeFocus(focused);
}


// The menu field draws all there is, unless the archive had none.
void
BOptionPopUp::Draw(BRect updateRect)
{
	if (_Field() != NULL || Label() == NULL)
		return;
	const float baseline =
		BPrivate::centered_baseline(BPrivate::LabelMetrics(this), Bounds().top, Bounds().bottom);
	BPrivate::draw_label(this, Label(), BPoint(Bounds().left, baseline), IsEnabled());
}


// #pragma mark - look


void
BOptionPopUp::SetLabel(const char* label)
{
	BOptionControl::SetLabel(label);
	if (BMenuField* field = _Field())
		field->SetLabel(Label());
}


void
BOptionPopUp::SetEnabled(bool enabled)
{
	BOptionControl::SetEnabled(enabled);
	if (BMenuField* field = _Field())
		field->SetEnabled(enabled);
}


float
BOptionPopUp::_PreferredDivider() const
{
	const BMenuField* field = _Field();
	if (field == NULL || Label() == NULL)
		return 0;
	return std::ceil(field->StringWidth(Label())) + kLabelSpace;
}


void
BOptionPopUp::GetPreferredSize(float* _width, float* _height)
{
	BMenuField* field = _Field();
	if (field == NULL) {
		BOptionControl::GetPreferredSize(_width, _height);
		return;
	}
	float height = 0;
	field->GetPreferredSize(NULL, &height);

	float width = _PreferredDivider() + 2 * kBarMargin;
	if (BMenuBar* bar = field->MenuBar()) {
		float barWidth = 0;
		bar->GetPreferredSize(&barWidth, NULL);
		const BMenuItem* shown = bar->ItemAt(0);
		const float shownWidth = shown != NULL ? BPrivate::label_width(bar, shown->Label()) : 0;
		float widest = shownWidth;
		const char* name;
		for (int32 i = 0; GetOptionAt(i, &name, NULL); i++)
			widest = std::max(widest, BPrivate::label_width(bar, name));
		width += barWidth + widest - shownWidth;
	}
	if (_width != NULL)
		*_width = std::ceil(width);
	if (_height != NULL)
		*_height = height;
}


void
BOptionPopUp::ResizeToPreferred()
{
	BOptionControl::ResizeToPreferred();
	if (BMenuField* field = _Field()) {
		field->ResizeTo(Bounds().Width(), Bounds().Height());
		field->SetDivider(_PreferredDivider());
	}
}
