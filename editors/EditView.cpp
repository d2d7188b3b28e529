#include "editors/EditView.h"

#include <cfloat>

#include <Menu.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <ScrollBar.h>
#include <String.h>
#include <TextControl.h>

#include "editors/FloatControl.h"
#include "editors/PanelRows.h"
#include "editors/TargetLock.h"

namespace {


constexpr uint32 kNameChanged = 'name';
constexpr uint32 kFrameChanged = 'rect';
constexpr uint32 kPreferredPressed = 'pref';
constexpr uint32 kZoomPressed = 'zoom';
constexpr uint32 kHorizontalChosen = 'xxxx';
constexpr uint32 kVerticalChosen = 'yyyy';
constexpr uint32 kFlagChosen = 'flag';

constexpr float kPanelHeight = 330;
constexpr float kWideRowStep = 32;

constexpr uint32 kHorizontalMask = 0x0f0f;
constexpr uint32 kVerticalMask = 0xf0f0;

struct ResizingChoice {
	const char* label;
	uint32 mode;
};

constexpr ResizingChoice kHorizontalModes[] = { { "Left", B_FOLLOW_LEFT },
	{ "Right", B_FOLLOW_RIGHT }, { "Left & Right", B_FOLLOW_LEFT_RIGHT },
	{ "H. Center", B_FOLLOW_H_CENTER } };
constexpr ResizingChoice kVerticalModes[] = { { "Top", B_FOLLOW_TOP },
	{ "Bottom", B_FOLLOW_BOTTOM }, { "Top & Bottom", B_FOLLOW_TOP_BOTTOM },
	{ "V. Center", B_FOLLOW_V_CENTER } };

struct FlagChoice {
	const char* label; // in the menu
	const char* tag; // in the closed menu field
};

// From the highest bit down. The reserved ones are offered like the others.
constexpr uint32 kFirstFlag = 0x80000000;
constexpr FlagChoice kFlags[] = { { "B_FULL_UPDATE_ON_RESIZE", "FullUp" },
	{ "_B_RESERVED1_", "r1" }, { "B_WILL_DRAW", "Draw" }, { "B_PULSE_NEEDED", "Pulse" },
	{ "B_NAVIGABLE_JUMP", "NavJump" }, { "B_FRAME_EVENTS", "FrEvts" }, { "B_NAVIGABLE", "Nav" },
	{ "B_SUBPIXEL_PRECISE", "Sub" }, { "B_DRAW_ON_CHILDREN", "DChild" },
	{ "B_INPUT_METHOD_AWARE", "In" }, { "_B_RESERVED7_", "r7" } };
constexpr int32 kFlagCount = sizeof(kFlags) / sizeof(kFlags[0]);


constexpr uint32
FlagAt(int32 index)
{
	return kFirstFlag >> index;
}


constexpr uint32
AllFlags()
{
	uint32 flags = 0;
	for (int32 i = 0; i < kFlagCount; i++)
		flags |= FlagAt(i);
	return flags;
}


template<size_t kCount>
BMenu*
MakeResizingMenu(const char* name, const ResizingChoice (&choices)[kCount], uint32 code)
{
	BMenu* menu = new BMenu(name, B_ITEMS_IN_COLUMN);
	menu->SetLabelFromMarked(true);
	for (const ResizingChoice& choice : choices)
		menu->AddItem(new BMenuItem(choice.label, new BMessage(code)));
	return menu;
}


template<size_t kCount>
void
MarkResizingMode(BMenu* menu, const ResizingChoice (&choices)[kCount], uint32 mode)
{
	for (size_t i = 0; i < kCount; i++)
		menu->ItemAt(static_cast<int32>(i))->SetMarked(choices[i].mode == mode);
}


template<size_t kCount>
uint32
MarkedResizingMode(BMenu* menu, const ResizingChoice (&choices)[kCount])
{
	uint32 mode = 0;
	for (size_t i = 0; i < kCount; i++) {
		if (menu->ItemAt(static_cast<int32>(i))->IsMarked())
			mode |= choices[i].mode;
	}
	return mode;
}


uint32
MarkedFlags(const BMenu* menu)
{
	uint32 flags = 0;
	for (int32 i = 0; i < kFlagCount; i++) {
		if (menu->ItemAt(i)->IsMarked())
			flags |= FlagAt(i);
	}
	return flags;
}


// How far a view that grows moves, so that the edge or centre it is bound to stays in place.
float
ShiftForGrowth(float growth, uint32 mode, uint32 farEdge, uint32 bothEdges, uint32 center)
{
	if (mode == farEdge)
		return -growth;
	if (mode == bothEdges || mode == center)
		return -growth / 2;
	return 0;
}


float
RangeMaximum(const BScrollBar* bar)
{
	float minimum, maximum;
	bar->GetRange(&minimum, &maximum);
	return maximum;
}


} // namespace


EditView::EditView() :
	EditorInterface("EditView", "Properties from BView", kPanelHeight), fRole(ColorRole::kView)
{
	BRect area = RowArea();
	_AddNameRow(area);
	area.top += kRowStep;
	_AddFrameRow(area);
	area.top += kRowStep;
	_AddResizingRow(area);
	area.top += kRowStep;
	_AddFlagsRow(area);
	area.top += kRowStep;
	_AddFontRows(area);
	area.top += 2 * kWideRowStep;
	_AddDrawingRow(area);
	area.top += kWideRowStep;
	_AddColorSection(area);
}


EditView::~EditView()
{
}


void
EditView::FrameChanged()
{
	if (TargetLives())
		LoadFrameValues();
}


bool
EditView::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	fNameControl->SetText(target->Name() != nullptr ? target->Name() : "<unnamed>");
	LoadFrameValues();
	_LoadResizingMode();
	_LoadFlags();
	_LoadFontAndDrawing();
	_LoadColors();
	return true;
}


bool
EditView::ApplyEdit(BMessage* message)
{
	return _ApplyViewEdit(message) || _ApplyFontEdit(message) || _ApplyColorEdit(message);
}


// #pragma mark - rows


void
EditView::_AddNameRow(BRect area)
{
	area.bottom = area.top + kRowHeight;
	fNameControl = AddTextControl(this, area, "Name: ", kNameChanged, 80, B_FOLLOW_ALL_SIDES);
}


void
EditView::_AddFrameRow(BRect area)
{
	AddSentence(this, FrameAt(area.left, area.top, 30, 16), "Frame:");

	BRect frame(area.left + 40, area.top, area.left + 88, area.top + 16);
	fLeftControl = _AddFrameControl(frame, "L:");
	fTopControl = _AddFrameControl(frame.OffsetByCopy(50, 0), "T:");
	fRightControl = _AddFrameControl(frame.OffsetByCopy(100, 0), "R:");
	frame.OffsetBy(150, 0);
	fBottomControl = _AddFrameControl(frame, "B:");

	frame.OffsetBy(54, -3);
	AddButton(this, frame, "preferred", kPreferredPressed);
	frame.OffsetBy(77, 0);
	AddButton(this, frame, "zoom", kZoomPressed, kFollowWidth);
}


void
EditView::_AddResizingRow(BRect area)
{
	fHorizontalMenu = MakeResizingMenu("Left & Right", kHorizontalModes, kHorizontalChosen);
	fVerticalMenu = MakeResizingMenu("Top & Bottom", kVerticalModes, kVerticalChosen);

	area.bottom = area.top + 19;
	BRect left = area;
	left.right = left.left + 150;
	AddMenuField(this, left, "Resizing:", fHorizontalMenu, 50, kFollowLeftTop);

	BRect right = area;
	right.left = right.right - 150;
	AddMenuField(this, right, "Resizing:", fVerticalMenu, 50, B_FOLLOW_RIGHT);
}


void
EditView::_AddFlagsRow(BRect area)
{
	fFlagsMenu = new BMenu("", B_ITEMS_IN_COLUMN);
	fFlagsMenu->SetRadioMode(false);
	for (const FlagChoice& choice : kFlags)
		fFlagsMenu->AddItem(new BMenuItem(choice.label, new BMessage(kFlagChosen)));

	area.bottom = area.top + kRowHeight;
	fFlagsField = new BMenuField(area, NULL, "Flags:", fFlagsMenu, B_FOLLOW_LEFT, kControlFlags);
	fFlagsField->SetDivider(50);
	AddChild(fFlagsField);
}


FloatControl*
EditView::_AddFrameControl(BRect frame, const char* label)
{
	return AddFloatControl(this, frame, label, kFrameChanged, 0, -FLT_MAX, FLT_MAX, 10);
}


// #pragma mark - loading


void
EditView::LoadFrameValues()
{
	TargetLock lock(target);

	const BRect frame = target->ConvertToParent(target->Bounds());
	fLeftControl->ShowFloatValue(frame.left);
	fTopControl->ShowFloatValue(frame.top);
	fRightControl->ShowFloatValue(frame.right);
	fBottomControl->ShowFloatValue(frame.bottom);
}


void
EditView::_LoadResizingMode()
{
	const uint32 mode = target->ResizingMode();
	MarkResizingMode(fHorizontalMenu, kHorizontalModes, mode & kHorizontalMask);
	MarkResizingMode(fVerticalMenu, kVerticalModes, mode & kVerticalMask);
}


void
EditView::_LoadFlags()
{
	const uint32 flags = target->Flags();
	for (int32 i = 0; i < kFlagCount; i++)
		fFlagsMenu->ItemAt(i)->SetMarked((flags & FlagAt(i)) != 0);
	_ShowFlagTags();
}


void
EditView::_ShowFlagTags()
{
	const uint32 flags = MarkedFlags(fFlagsMenu);
	BString tags;
	for (int32 i = 0; i < kFlagCount; i++) {
		if ((flags & FlagAt(i)) == 0)
			continue;
		if (tags.Length() > 0)
			tags << ", ";
		tags << kFlags[i].tag;
	}
	fFlagsField->MenuItem()->SetLabel(tags.String());
}


// #pragma mark - applying


bool
EditView::_ApplyViewEdit(BMessage* message)
{
	switch (message->what) {
		case kNameChanged:
			target->SetName(fNameControl->Text());
			break;
		case kFrameChanged:
			_ApplyFrame();
			break;
		case kPreferredPressed:
			_ApplyPreferredSize();
			break;
		case kZoomPressed:
			_ApplyZoom();
			break;
		case kHorizontalChosen:
		case kVerticalChosen:
			_ApplyResizingMode();
			break;
		case kFlagChosen:
			_ApplyFlag(message);
			break;
		default:
			return false;
	}
	return true;
}


void
EditView::_ApplyFrame()
{
	const BRect frame = target->ConvertToParent(target->Bounds());
	const float left = fLeftControl->FloatValue();
	const float top = fTopControl->FloatValue();
	target->MoveBy(left - frame.left, top - frame.top);
	target->ResizeBy(fRightControl->FloatValue() - left - frame.Width(),
		fBottomControl->FloatValue() - top - frame.Height());
	LoadFrameValues(); // views lie on whole pixels
}


void
EditView::_ApplyPreferredSize()
{
	float width, height;
	target->GetPreferredSize(&width, &height);
	const BRect bounds = target->Bounds();
	const uint32 mode = target->ResizingMode();

	target->MoveBy(ShiftForGrowth(width - bounds.Width(), mode & kHorizontalMask, B_FOLLOW_RIGHT,
					   B_FOLLOW_LEFT_RIGHT, B_FOLLOW_H_CENTER),
		ShiftForGrowth(height - bounds.Height(), mode & kVerticalMask, B_FOLLOW_BOTTOM,
			B_FOLLOW_TOP_BOTTOM, B_FOLLOW_V_CENTER));
	target->ResizeToPreferred();
	target->Invalidate();
	LoadFrameValues();
}


// Fills the parent, or what its scroll bars can show.
void
EditView::_ApplyZoom()
{
	const BView* parent = target->Parent();
	if (parent == nullptr)
		return;

	BRect frame = parent->Bounds().OffsetToCopy(0, 0);
	if (const BScrollBar* bar = parent->ScrollBar(B_VERTICAL)) {
		frame.OffsetBy(0, -bar->Value());
		frame.bottom += RangeMaximum(bar);
	}
	if (const BScrollBar* bar = parent->ScrollBar(B_HORIZONTAL)) {
		frame.OffsetBy(-bar->Value(), 0);
		frame.right += RangeMaximum(bar);
	}
	target->MoveTo(frame.LeftTop());
	target->ResizeTo(frame.Width(), frame.Height());
	LoadFrameValues();
}


void
EditView::_ApplyResizingMode()
{
	target->SetResizingMode(MarkedResizingMode(fHorizontalMenu, kHorizontalModes)
		| MarkedResizingMode(fVerticalMenu, kVerticalModes));
}


// The bits that the menu does not show stay as they are.
void
EditView::_ApplyFlag(const BMessage* message)
{
	int32 index;
	if (message->FindInt32("index", &index) != B_OK)
		return;
	BMenuItem* item = fFlagsMenu->ItemAt(index);
	if (item == nullptr)
		return;

	item->SetMarked(!item->IsMarked());
	_ShowFlagTags();
	target->SetFlags((target->Flags() & ~AllFlags()) | MarkedFlags(fFlagsMenu));
}
