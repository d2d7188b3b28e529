#include "editors/EditColorControl.h"

#include <climits>

#include <ColorControl.h>
#include <Menu.h>
#include <MenuField.h>
#include <Message.h>

#include "editors/IntControl.h"
#include "editors/PanelRows.h"

namespace {


constexpr uint32 kLayoutChosen = 'cell';
constexpr uint32 kCellSizeChanged = 'size';
constexpr float kPanelHeight = 48;

// In the order of the menu.
constexpr color_control_layout kLayouts[] = { B_CELLS_4x64, B_CELLS_8x32, B_CELLS_16x16,
	B_CELLS_32x8, B_CELLS_64x4 };
constexpr int32 kLayoutCount = sizeof(kLayouts) / sizeof(kLayouts[0]);


// The index and not the layout is compared with 64, so the largest layout marks the one before it.
// This is wanted.
int32
IndexOfLayout(color_control_layout layout)
{
	int32 index = layout / 4 - 1;
	if (index == 3)
		index = 2;
	if (index == 64)
		index = 4;
	if (index > 4)
		index = 3;
	return index;
}


} // namespace


EditColorControl::EditColorControl() :
	PanelOf("EditColorControl", "Properties from BColorControl", kPanelHeight)
{
	const BRect area = RowArea();
	fLayoutMenu = MakeChoiceMenu(
		{ "B_CELLS_4x64", "B_CELLS_8x32", "B_CELLS_16x16", "B_CELLS_32x8", "B_CELLS_64x4" },
		kLayoutChosen);
	AddMenuField(this, FrameAt(area.left, area.top, 180, 20), "Cell layout:", fLayoutMenu, 70,
		B_FOLLOW_LEFT);
	fCellSizeControl = AddIntControl(this, FrameAt(area.right - 100, area.top, 100, 20),
		"Cell size:", kCellSizeChanged, 1, 1, INT_MAX, 70, kFollowRightTop);
}


EditColorControl::~EditColorControl()
{
}


bool
EditColorControl::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	MarkChoice(fLayoutMenu, IndexOfLayout(_Target()->Layout()));
	fCellSizeControl->SetValue(WholeNumber(_Target()->CellSize()));
	return true;
}


bool
EditColorControl::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kLayoutChosen: {
			const int32 index = Choice(fLayoutMenu);
			if (index >= 0 && index < kLayoutCount)
				_Target()->SetLayout(kLayouts[index]);
			break;
		}
		case kCellSizeChanged:
			_Target()->SetCellSize(static_cast<float>(fCellSizeControl->Value()));
			break;
		default:
			return false;
	}
	target->Invalidate();
	return true;
}
