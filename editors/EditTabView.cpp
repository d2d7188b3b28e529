#include "editors/EditTabView.h"

#include <cfloat>

#include <Button.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>
#include <TabView.h>

#include "editors/FloatControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kTabHeightChanged = 'hght';
constexpr uint32 kTabWidthChosen = 'wdth';
constexpr uint32 kForwardPressed = 'forw';
constexpr uint32 kBackwardPressed = 'bacw';
constexpr uint32 kDeletePressed = 'delt';
constexpr uint32 kInsertPressed = 'inst';

constexpr float kPanelHeight = 74;
constexpr float kButtonWidth = 69;
constexpr float kButtonStep = 80;
constexpr rgb_color kPageColor = { 216, 216, 216, 255 };


} // namespace


EditTabView::EditTabView() : PanelOf("EditTabView", "Properties from BTabView", kPanelHeight)
{
	BRect row = RowArea();
	row.bottom = row.top + 20;
	tabHeightControl = AddFloatControl(this, FrameAt(row.left, row.top, 100, 20),
		"Tab height:", kTabHeightChanged, 0, 0, FLT_MAX, 55, kFollowWidth);
	// The index of an item is its button_width. The field's label is spelt as it is meant to be.
	tabWidthMenu = MakeChoiceMenu(
		{ "B_WIDTH_AS_USUAL", "B_WIDTH_FROM_WIDEST", "B_WIDTH_FROM_LABEL" }, kTabWidthChosen);
	AddMenuField(this, FrameAt(row.right - 200, row.top - 2, 200, 20), "Tab widgh:", tabWidthMenu,
		60, kFollowRightTop);

	BRect frame = FrameAt(row.left, row.top + kRowStep, kButtonWidth, 20);
	AddSentence(this, frame, "Selected tab:");
	frame.OffsetBy(kButtonStep, 0);
	forwardButton = AddButton(this, frame, "forward", kForwardPressed);
	frame.OffsetBy(kButtonStep, 0);
	backwardButton = AddButton(this, frame, "backward", kBackwardPressed);
	frame.OffsetBy(kButtonStep, 0);
	deleteTabButton = AddButton(this, frame, "delete", kDeletePressed);
	frame.OffsetBy(kButtonStep, 0);
	insertTabButton = AddButton(this, frame, "insert", kInsertPressed);
}


EditTabView::~EditTabView()
{
}


bool
EditTabView::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	tabHeightControl->SetFloatValue(_Target()->TabHeight());
	MarkChoice(tabWidthMenu, _Target()->TabWidth());
	return true;
}


bool
EditTabView::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kTabHeightChanged:
			_Target()->SetTabHeight(tabHeightControl->FloatValue());
			break;
		case kTabWidthChosen:
			_Target()->SetTabWidth(static_cast<button_width>(Choice(tabWidthMenu)));
			break;
		case kForwardPressed:
			_MoveForward();
			break;
		case kBackwardPressed:
			_MoveBackward();
			break;
		case kDeletePressed:
			_DeleteTab();
			return true;
		case kInsertPressed:
			_InsertTab();
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}


// Tabs can be appended only, so the tabs behind the exchanged pair go to the end one by one.
void
EditTabView::_MoveForward()
{
	const int32 selection = _Target()->Selection();
	const int32 count = _Target()->CountTabs();
	if (selection <= 0 || selection >= count)
		return;

	_MoveToEnd(selection - 1);
	for (int32 i = 0; i < count - 1 - selection; i++)
		_MoveToEnd(selection);
}


void
EditTabView::_MoveBackward()
{
	const int32 selection = _Target()->Selection();
	const int32 count = _Target()->CountTabs();
	if (selection < 0 || selection >= count - 1)
		return;

	_MoveToEnd(selection + 1);
	for (int32 i = 0; i < count - 1 - selection; i++)
		_MoveToEnd(selection);
	_Target()->Select(selection + 1);
}


// The same tab goes back in, with all that it has.
void
EditTabView::_MoveToEnd(int32 index)
{
	if (BTab* tab = _Target()->RemoveTab(index))
		_Target()->AddTab(tab->View(), tab);
}


void
EditTabView::_DeleteTab()
{
	delete _Target()->RemoveTab(_Target()->Selection());
}


void
EditTabView::_InsertTab()
{
	BRect frame = target->Bounds();
	frame.left += 3;
	frame.top += 2;
	frame.right -= 4;
	frame.bottom -= 5 + _Target()->TabHeight();

	BTab* tab = new BTab;
	BView* page = new BView(frame, NULL, B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	_Target()->AddTab(page, tab);
	page->SetViewColor(kPageColor);
	tab->SetLabel("Tab");
}
