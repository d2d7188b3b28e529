#include "editors/EditStatusBar.h"

#include <cfloat>

#include <Message.h>
#include <StatusBar.h>
#include <String.h>
#include <TextControl.h>

#include "editors/FloatControl.h"
#include "editors/LiveColorControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kLabelChanged = 'labl';
constexpr uint32 kTrailingLabelChanged = 'tlab';
constexpr uint32 kTextChanged = 'text';
constexpr uint32 kTrailingTextChanged = 'ttxt';
constexpr uint32 kValueChanged = 'valu';
constexpr uint32 kMaxChanged = 'max ';
constexpr uint32 kBarHeightChanged = 'barh';

constexpr float kPanelHeight = 177;
constexpr float kGroupTop = 84; // below the first row's top
constexpr float kLeftWidth = 130;
constexpr float kRightWidth = 180;
constexpr float kNumberWidth = 110;
constexpr rgb_color kDefaultColor = { 50, 150, 255, 0 };


} // namespace


EditStatusBar::EditStatusBar() :
	PanelOf("EditStatusBar", "Properties from BStatusBar", kPanelHeight)
{
	const BRect area = RowArea();
	BRect row = area;
	row.bottom = row.top + kRowHeight;
	_AddTextRow(row, "Label:", kLabelChanged, fLabelControl,
		"Trailing label:", kTrailingLabelChanged, fTrailingLabelControl);
	row.OffsetBy(0, kRowStep);
	_AddTextRow(row, "Text:", kTextChanged, fTextControl, "Trailing text: ", kTrailingTextChanged,
		fTrailingTextControl);
	row.OffsetBy(0, kRowStep);
	_AddNumberRow(row);

	row.Set(area.left, area.top + kGroupTop, area.right, Bounds().bottom - area.left);
	fBarColor = AddBarColorGroup(this, row, BPoint(12, 12));
}


EditStatusBar::~EditStatusBar()
{
}


bool
EditStatusBar::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	const BStatusBar* bar = _Target();
	fLabelControl->SetText(bar->Label());
	fTrailingLabelControl->SetText(bar->TrailingLabel());
	fTextControl->SetText(bar->Text());
	fTrailingTextControl->SetText(bar->TrailingText());
	fMaxControl->SetFloatValue(bar->MaxValue());
	fValueControl->SetMax(bar->MaxValue());
	fValueControl->SetFloatValue(bar->CurrentValue());
	fBarHeightControl->SetFloatValue(bar->BarHeight());
	ShowBarColor(fBarColor, bar->BarColor());
	return true;
}


bool
EditStatusBar::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kLabelChanged:
		case kTrailingLabelChanged:
		case kTextChanged:
		case kTrailingTextChanged:
			_ApplyTexts();
			break;
		case kValueChanged:
			_ApplyValue();
			break;
		case kMaxChanged:
			_ApplyMax();
			_ApplyBarHeight();
			break;
		case kBarHeightChanged:
			_ApplyBarHeight();
			break;
		case kLiveColorChanged:
		case kColorComponentTyped:
		case kDefaultColorPressed:
			ApplyBarColor(fBarColor, message->what, kDefaultColor, _Target());
			break;
		default:
			return false;
	}
	return true;
}


void
EditStatusBar::_AddTextRow(BRect row, const char* left, uint32 leftCode, BTextControl*& leftControl,
	const char* right, uint32 rightCode, BTextControl*& rightControl)
{
	BRect frame = row;
	frame.right = row.left + kLeftWidth;
	leftControl = AddTextControl(this, frame, left, leftCode, 40, B_FOLLOW_LEFT);
	frame = row;
	frame.left = row.right - kRightWidth;
	rightControl = AddTextControl(this, frame, right, rightCode, 90, B_FOLLOW_RIGHT);
}


void
EditStatusBar::_AddNumberRow(BRect row)
{
	BRect frame = row;
	frame.right = row.left + kNumberWidth;
	fValueControl =
		AddFloatControl(this, frame, "Value:", kValueChanged, 0, 0, 100, 40, B_FOLLOW_LEFT);
	frame.OffsetTo((row.left + row.right - kNumberWidth) / 2, row.top);
	fMaxControl =
		AddFloatControl(this, frame, "Max:", kMaxChanged, 0, 0.01f, FLT_MAX, 30, B_FOLLOW_H_CENTER);
	frame.OffsetTo(row.right - kNumberWidth, row.top);
	fBarHeightControl = AddFloatControl(
		this, frame, "Bar height:", kBarHeightChanged, 12, 1, FLT_MAX, 50, B_FOLLOW_RIGHT);
}


// Resetting is the one way to set the labels, and clears the value and the maximum.
void
EditStatusBar::_ApplyTexts()
{
	const float value = _Target()->CurrentValue();
	const float maximum = _Target()->MaxValue();
	_Target()->Reset(fLabelControl->Text(), fTrailingLabelControl->Text());
	_Target()->SetMaxValue(maximum);
	_Target()->Update(value);
	_Target()->SetText(fTextControl->Text());
	_Target()->SetTrailingText(fTrailingTextControl->Text());
	target->Invalidate();
}


// The value changes by a difference, which may be too coarse for a small number the first time.
void
EditStatusBar::_ApplyValue()
{
	const float value = fValueControl->FloatValue();
	_Target()->Update(value - _Target()->CurrentValue());
	if (_Target()->CurrentValue() != value)
		_Target()->Update(value - _Target()->CurrentValue());
}


void
EditStatusBar::_ApplyMax()
{
	const float maximum = fMaxControl->FloatValue();
	_Target()->SetMaxValue(maximum);
	fValueControl->SetMax(maximum);
	_ApplyValue();
}


void
EditStatusBar::_ApplyBarHeight()
{
	_Target()->SetBarHeight(fBarHeightControl->FloatValue());
	target->Invalidate();
}
