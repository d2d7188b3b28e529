#include "editors/EditListView.h"

#include <CheckBox.h>
#include <ListView.h>
#include <Message.h>
#include <TextControl.h>

#include "editors/PanelRows.h"

namespace {


constexpr uint32 kMultipleSelectionChanged = 'msel';
constexpr uint32 kSelectMessageChanged = 'mssg';
constexpr uint32 kInvokeMessageChanged = 'imsg';


} // namespace


EditListView::EditListView() :
	PanelOf("EditListView", "Properties from BListView", kTwoRowPanelHeight)
{
	const BRect area = RowArea();
	BRect frame = FrameAt(area.left, area.top, 120, kRowHeight);
	multipleSelectionCheckBox =
		AddCheckBox(this, frame, "Multiple Selection", kMultipleSelectionChanged);
	frame.OffsetBy(130, 0);
	selectMessageControl =
		AddTextControl(this, frame, "Select Message:", kSelectMessageChanged, 82);
	frame.OffsetTo(Bounds().right - 4 - frame.Width(), frame.top);
	invokeMessageControl =
		AddTextControl(this, frame, "Invoke Message:", kInvokeMessageChanged, 82);
}


EditListView::~EditListView()
{
}


bool
EditListView::UseView(BView* view)
{
	if (!TakeTarget(view))
		return false;

	const bool isMultiple = _Target()->ListType() != B_SINGLE_SELECTION_LIST;
	SetOn(multipleSelectionCheckBox, isMultiple);
	ShowMessageCode(selectMessageControl, _Target()->SelectionMessage());
	ShowMessageCode(invokeMessageControl, _Target()->InvocationMessage());
	return true;
}


// A new code gives a new message: the fields of the former one are dropped.
bool
EditListView::ApplyEdit(BMessage* message)
{
	switch (message->what) {
		case kMultipleSelectionChanged:
			_Target()->SetListType(IsOn(multipleSelectionCheckBox) ? B_MULTIPLE_SELECTION_LIST
																   : B_SINGLE_SELECTION_LIST);
			target->Invalidate();
			break;
		case kSelectMessageChanged:
			_Target()->SetSelectionMessage(new BMessage(TakeCode(selectMessageControl)));
			break;
		case kInvokeMessageChanged:
			_Target()->SetInvocationMessage(new BMessage(TakeCode(invokeMessageControl)));
			break;
		default:
			return false;
	}
	return true;
}
