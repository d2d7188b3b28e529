#include "editors/EditSlider.h"

#include <climits>

#include <Beep.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <Slider.h>
#include <TextControl.h>

#include "archive/ViewTree.h"
#include "editors/EditorHost.h"
#include "editors/IntControl.h"
#include "editors/LiveColorControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kSnoozeChanged = 'snoz';
constexpr uint32 kMinLabelChanged = 'minl';
constexpr uint32 kMinValueChanged = 'minv';
constexpr uint32 kMaxLabelChanged = 'maxl';
constexpr uint32 kMaxValueChanged = 'maxv';
constexpr uint32 kHashMarksChosen = 'hash';
constexpr uint32 kThumbChosen = 'styl';
constexpr uint32 kKeyIncrementChanged = 'kinc';
constexpr uint32 kMarkCountChanged = 'mark';

constexpr float kPanelHeight = 232;
constexpr float kGroupHeight = 70;
constexpr rgb_color kDefaultColor = { 80, 80, 80, 0 };


} // namespace


EditSlider::EditSlider() : PanelOf("EditSlider", "Properties from BSlider", kPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kRowHeight;
	snoozeControl =
		AddIntControl(this, row, "Snooze:", kSnoozeChanged, 0, 1, INT_MAX, 60, B_FOLLOW_LEFT_RIGHT);
	row.OffsetBy(0, kRowStep);
	_AddLimitRow(row, "Min Label:", kMinLabelChanged, minLabelControl,
		"Min Value:", kMinValueChanged, minValueControl);
	row.OffsetBy(0, kRowStep);
	_AddLimitRow(row, "Max Label:", kMaxLabelChanged, maxLabelControl,
		"Max Value:", kMaxValueChanged, maxValueControl);
	row.OffsetBy(0, kRowStep);
	_AddMenuRow(row);
	row.OffsetBy(0, kRowStep);
	_AddMarksRow(row);

	row.OffsetBy(0, kRowStep);
	row.bottom = row.top + kGroupHeight;
	fBarColor = AddBarColorGroup(this, row, BPoint(4, 12));
}


EditSlider::~EditSlider()
{
}


bool
EditSlider::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	const BSlider* slider = _Target();
	snoozeControl->SetValue(slider->SnoozeAmount());
	ShowBarColor(fBarColor, slider->BarColor());
	minLabelControl->SetText(slider->MinLimitLabel());
	maxLabelControl->SetText(slider->MaxLimitLabel());
	int32 minimum, maximum;
	slider->GetLimits(&minimum, &maximum);
	minValueControl->SetValue(minimum);
	maxValueControl->SetValue(maximum);
	keyIncrementControl->SetValue(slider->KeyIncrementValue());
	hashMarkCountControl->SetValue(slider->HashMarkCount());
	MarkChoice(thumbMenu, slider->Style());
	MarkChoice(hashMarksMenu, slider->HashMarks());
	return true;
}


bool
EditSlider::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kSnoozeChanged:
			_Target()->SetSnoozeAmount(snoozeControl->Value());
			snoozeControl->SetValue(_Target()->SnoozeAmount()); // which has limits of its own
			break;
		case kKeyIncrementChanged:
			_Target()->SetKeyIncrementValue(keyIncrementControl->Value());
			break;
		case kLiveColorChanged:
		case kColorComponentTyped:
		case kDefaultColorPressed:
			ApplyBarColor(fBarColor, message->what, kDefaultColor, _Target());
			break;
		case kMinLabelChanged:
		case kMaxLabelChanged:
			_ApplyLimitLabels();
			break;
		case kMinValueChanged:
		case kMaxValueChanged:
			_ApplyLimits();
			break;
		default:
			return _ApplyMarks(message->what);
	}
	return true;
}


void
EditSlider::_AddLimitRow(BRect row, const char* label, uint32 labelCode,
	BTextControl*& labelControl, const char* value, uint32 valueCode, IntControl*& valueControl)
{
	BRect frame = row;
	frame.right = row.left + row.right - 160;
	labelControl = AddTextControl(this, frame, label, labelCode, 60, B_FOLLOW_LEFT_RIGHT);
	frame = row;
	frame.left = row.right - 120;
	valueControl =
		AddIntControl(this, frame, value, valueCode, 0, INT_MIN, INT_MAX, 60, B_FOLLOW_RIGHT);
}


// The index of an item is its hash_mark_location or thumb_style.
void
EditSlider::_AddMenuRow(BRect row)
{
	hashMarksMenu = MakeChoiceMenu({ "none", "top", "bottom", "top & bottom" }, kHashMarksChosen);
	AddMenuField(this, BRect(row.left, row.top, row.left + row.right - 160 + 1, row.top + 20),
		"Hash marks:", hashMarksMenu, 61, B_FOLLOW_RIGHT);
	thumbMenu = MakeChoiceMenu({ "block", "triangle" }, kThumbChosen);
	AddMenuField(this, BRect(row.right - 120, row.top, row.right + 1, row.top + 20),
		"Thumb:", thumbMenu, 61, B_FOLLOW_RIGHT);
}


void
EditSlider::_AddMarksRow(BRect row)
{
	BRect frame = row;
	frame.right = row.left + 140;
	keyIncrementControl = AddIntControl(
		this, frame, "Key Increment:", kKeyIncrementChanged, 0, 0, INT_MAX, 80, B_FOLLOW_LEFT);
	frame = row;
	frame.left = row.right - 150;
	hashMarkCountControl = AddIntControl(
		this, frame, "Num Hash Marks:", kMarkCountChanged, 0, 0, INT_MAX, 90, B_FOLLOW_RIGHT);
}


bool
EditSlider::_ApplyMarks(uint32 code)
{
	switch (code) {
		case kMarkCountChanged:
			_Target()->SetHashMarkCount(hashMarkCountControl->Value());
			break;
		case kHashMarksChosen:
			_Target()->SetHashMarks(static_cast<hash_mark_location>(Choice(hashMarksMenu)));
			break;
		case kThumbChosen:
			_Target()->SetStyle(static_cast<thumb_style>(Choice(thumbMenu)));
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}


void
EditSlider::_ApplyLimitLabels()
{
	const char* minimum = minLabelControl->Text();
	const char* maximum = maxLabelControl->Text();
	if (minimum[0] != '\0' || maximum[0] != '\0') {
		_Target()->SetLimitLabels(minimum, maximum);
		return;
	}
	_Rebuild([](BMessage& archive) {
		archive.RemoveData("_minlbl", (int32)0);
		archive.RemoveData("_maxlbl", (int32)0);
	});
}


void
EditSlider::_ApplyLimits()
{
	_Rebuild([this](BMessage& archive) {
		archive.ReplaceInt32("_min", minValueControl->Value());
		archive.ReplaceInt32("_max", maxValueControl->Value());
	});
}


// Selecting the new slider gives it to this panel as the target before the old one goes.
void
EditSlider::_Rebuild(const std::function<void(BMessage& archive)>& change)
{
	BSlider* old = _Target();
	BView* parent = old->Parent();
	if (!HasEditor(this) || parent == nullptr) {
		beep();
		return;
	}

	old->RemoveSelf();
	BMessage archive;
	old->Archive(&archive, true);
	change(archive);
	BSlider* slider = new BSlider(&archive);
	ColorfulAddChild(parent, slider);
	ReplaceInEditor(this, old, slider);
	TakeTarget(slider);
	delete old;
}
