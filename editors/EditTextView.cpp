#include "editors/EditTextView.h"

#include <cfloat>
#include <climits>

#include <CheckBox.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <TextView.h>

#include "editors/FloatControl.h"
#include "editors/IntControl.h"
#include "editors/PanelRows.h"
#include "editors/TargetLock.h"

namespace {


constexpr uint32 kColorSpaceChosen = 'csps';
constexpr uint32 kAlignmentChosen = 'taln';
constexpr uint32 kEditableChanged = 'edit';
constexpr uint32 kAutoIndentChanged = 'idnt';
constexpr uint32 kSelectableChanged = 'slct';
constexpr uint32 kMaxBytesChanged = 'maxb';
constexpr uint32 kStylableChanged = 'styl';
constexpr uint32 kWordWrapChanged = 'wrap';
constexpr uint32 kResizableChanged = 'rsiz';
constexpr uint32 kTabWidthChanged = 'tabw';

constexpr float kPanelHeight = 154;
constexpr float kSwitchHeight = 18;
constexpr float kSwitchStep = 24;
constexpr float kSwitchGap = 15;
constexpr float kHintStep = 15;
constexpr float kTextInset = 2;


} // namespace


EditTextView::EditTextView() : PanelOf("EditTextView", "Properties from BTextView", kPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + kRowHeight;
	_AddMenuRow(row);
	row.OffsetBy(0, kRowStep);
	_AddSwitchRows(row);
	row.OffsetBy(0, 2 * kSwitchStep + 2);

	BRect line = row;
	line.InsetBy(30, 0);
	line.bottom = line.top + 1;
	AddSeparator(this, line);
	row.OffsetBy(0, 8);
	_AddHints(row);
}


EditTextView::~EditTextView()
{
}


void
EditTextView::FrameChanged()
{
	if (!TargetLives())
		return;

	TargetLock lock(target);
	_Target()->SetTextRect(target->Bounds().InsetByCopy(kTextInset, kTextInset));
}


bool
EditTextView::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	const BTextView* text = _Target();
	MarkChoice(colorSpaceMenu, text->ColorSpace());
	MarkChoice(alignmentMenu, text->Alignment());
	tabWidthControl->SetFloatValue(text->TabWidth());
	SetOn(selectableCheckBox, text->IsSelectable());
	SetOn(autoIndentCheckBox, text->DoesAutoindent());
	maxBytesControl->SetValue(text->MaxBytes());
	SetOn(editableCheckBox, text->IsEditable());
	SetOn(stylableCheckBox, text->IsStylable());
	SetOn(wordWrapCheckBox, text->DoesWordWrap());
	SetOn(resizableCheckBox, text->IsResizable());
	return true;
}


bool
EditTextView::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kColorSpaceChosen:
			// The index itself is the value, though the platform's codes are others: as it is shown.
			_Target()->SetColorSpace(static_cast<color_space>(Choice(colorSpaceMenu)));
			break;
		case kAlignmentChosen:
			_Target()->SetAlignment(static_cast<alignment>(Choice(alignmentMenu)));
			break;
		case kAutoIndentChanged:
			_Target()->SetAutoindent(IsOn(autoIndentCheckBox));
			break;
		case kTabWidthChanged:
			_Target()->SetTabWidth(tabWidthControl->FloatValue());
			break;
		default:
			return _ApplySwitch(message->what);
	}
	target->Invalidate();
	return true;
}


void
EditTextView::_AddMenuRow(BRect row)
{
	colorSpaceMenu =
		MakeChoiceMenu({ "B_NO_COLOR_SPACE", "B_RGB32", "B_RGB24", "B_RGB16", "B_RGB15", "B_RGBA15",
						   "B_CMAP8", "B_GRAY8", "B_GRAY1", "B_RGB32_BIG", "B_RGBA32_BIG",
						   "B_RGB24_BIG", "B_RGB16_BIG", "B_RGB15_BIG", "B_RGBA15_BIG" },
			kColorSpaceChosen);
	AddMenuField(
		this, FrameAt(row.left, row.top, 180, 20), "Offscreen:", colorSpaceMenu, 60, B_FOLLOW_LEFT);
	alignmentMenu = MakeAlignmentMenu(kAlignmentChosen);
	AddMenuField(this, FrameAt(row.right - 180, row.top, 180, 20), "Text:", alignmentMenu, 40,
		B_FOLLOW_RIGHT);
}


void
EditTextView::_AddSwitchRows(BRect row)
{
	const BRect first = FrameAt(row.left, row.top, 70, kSwitchHeight);
	const BRect second = FrameAt(first.right + kSwitchGap, row.top, 80, kSwitchHeight);
	const BRect third = FrameAt(second.right + kSwitchGap, row.top, 70, kSwitchHeight);
	const BRect last(third.right + kSwitchGap, row.top, row.right, row.top + kSwitchHeight);

	editableCheckBox = AddCheckBox(this, first, "Editable", kEditableChanged);
	autoIndentCheckBox = AddCheckBox(this, second, "Auto Indent", kAutoIndentChanged);
	selectableCheckBox = AddCheckBox(this, third, "Selectable", kSelectableChanged);
	maxBytesControl =
		AddIntControl(this, last, "Max bytes:", kMaxBytesChanged, 0, 0, INT_MAX, 56, kFollowWidth);

	stylableCheckBox =
		AddCheckBox(this, first.OffsetByCopy(0, kSwitchStep), "Stylable", kStylableChanged);
	wordWrapCheckBox =
		AddCheckBox(this, second.OffsetByCopy(0, kSwitchStep), "Word Wrap", kWordWrapChanged);
	resizableCheckBox =
		AddCheckBox(this, third.OffsetByCopy(0, kSwitchStep), "Resizable", kResizableChanged);
	tabWidthControl = AddFloatControl(this, last.OffsetByCopy(0, kSwitchStep),
		"Tab width:", kTabWidthChanged, 0, 0, FLT_MAX, 56, kFollowWidth);
}


void
EditTextView::_AddHints(BRect row)
{
	row.left += 1;
	for (const char* hint :
		{ "Hint: Changing \"High Color\" makes special call to BTextView::SetFontAndColor().",
			"Hint: Left-click the view and type text into it.",
			"Hint: Mark \"stylable\" and paste from Be's StyleEdit application." }) {
		AddSentence(this, row, hint, kFollowWidth);
		row.OffsetBy(0, kHintStep);
	}
}


bool
EditTextView::_ApplySwitch(uint32 code)
{
	switch (code) {
		case kEditableChanged:
			_Target()->MakeEditable(IsOn(editableCheckBox));
			break;
		case kSelectableChanged:
			_Target()->MakeSelectable(IsOn(selectableCheckBox));
			break;
		case kStylableChanged:
			_Target()->SetStylable(IsOn(stylableCheckBox));
			break;
		case kWordWrapChanged:
			_Target()->SetWordWrap(IsOn(wordWrapCheckBox));
			break;
		case kResizableChanged:
			_ApplyResizable();
			break;
		case kMaxBytesChanged:
			_Target()->SetMaxBytes(maxBytesControl->Value());
			break;
		default:
			return false;
	}
	return true;
}


// A resizable text view does not wrap; the platform turns that off by itself.
void
EditTextView::_ApplyResizable()
{
	const bool isOn = IsOn(resizableCheckBox);
	_Target()->MakeResizable(isOn, NULL);
	if (isOn)
		SetOn(wordWrapCheckBox, false);
}
