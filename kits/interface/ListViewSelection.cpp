// BListView: the selection.
#include "ListView.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <strings.h>

#include <AppDefs.h>
#include <Message.h>
#include <Messenger.h>
#include <Window.h>

#include "interface/private/ListViewPrivate.h"

using namespace BPrivate;

void
BListView::SetSelectionMessage(BMessage* message)
{
	if (message != fSelectionMessage.get())
		fSelectionMessage.reset(message);
}


void
BListView::SetInvocationMessage(BMessage* message)
{
	SetMessage(message);
}


BMessage*
BListView::SelectionMessage() const
{
	return fSelectionMessage.get();
}


uint32
BListView::SelectionCommand() const
{
	return fSelectionMessage != nullptr ? fSelectionMessage->what : 0;
}


BMessage*
BListView::InvocationMessage() const
{
	return Message();
}


uint32
BListView::InvocationCommand() const
{
	return Command();
}


void
BListView::SetListType(list_view_type type)
{
	if (type == B_SINGLE_SELECTION_LIST && fFirstSelected != fLastSelected)
		_SelectionDone(_DeselectOutside(fFirstSelected, fFirstSelected));
	fType = type;
}


list_view_type
BListView::ListType() const
{
	return fType;
}


// #pragma mark - selection


void
BListView::Select(int32 index, bool extend)
{
	Select(index, index, extend);
}


void
BListView::Select(int32 from, int32 to, bool extend)
{
	from = std::max<int32>(from, 0);
	to = std::min(to, CountItems() - 1);
	if (from > to)
		return;
	fAnchor = fFocusItem = from;
	_SelectionDone(_SelectRange(from, to, extend));
}


bool
BListView::IsItemSelected(int32 index) const
{
	const BListItem* item = ItemAt(index);
	return item != NULL && item->fSelected;
}


int32
BListView::CurrentSelection(int32 index) const
{
	if (fFirstSelected < 0 || index < 0)
		return -1;
	for (int32 i = fFirstSelected; i <= fLastSelected; i++) {
		if (fItems[i]->fSelected && index-- == 0)
			return i;
	}
	return -1;
}


void
BListView::DeselectAll()
{
	_SelectionDone(_DeselectOutside(-1, -1));
}


void
BListView::DeselectExcept(int32 exceptFrom, int32 exceptTo)
{
	if (exceptFrom > exceptTo || exceptFrom < 0 || exceptTo >= CountItems())
		return;
	_SelectionDone(_DeselectOutside(exceptFrom, exceptTo));
}


void
BListView::Deselect(int32 index)
{
	const bool changed = _SetSelected(index, false);
	if (changed)
		_RescanSelection();
	_SelectionDone(changed);
}


void
BListView::SelectionChanged()
{
}


bool
BListView::_SetSelected(int32 index, bool selected)
{
	BListItem* item = ItemAt(index);
	if (item == NULL || item->fSelected == selected || (selected && !item->fEnabled))
		return false;
	if (selected)
		item->Select();
	else
		item->Deselect();
	InvalidateItem(index);
	return true;
}


bool
BListView::_SelectRange(int32 from, int32 to, bool extend)
{
	bool changed = false;
	if (!extend)
		changed = _DeselectOutside(from, to);
	for (int32 i = from; i <= to; i++)
		changed = _SetSelected(i, true) || changed;
	if (changed)
		_RescanSelection();
	return changed;
}


bool
BListView::_DeselectOutside(int32 from, int32 to)
{
	if (fFirstSelected < 0)
		return false;
	bool changed = false;
	const int32 last = fLastSelected;
	for (int32 i = fFirstSelected; i <= last; i++) {
		if (i < from || i > to)
			changed = _SetSelected(i, false) || changed;
	}
	if (changed)
		_RescanSelection();
	return changed;
}


void
BListView::_RescanSelection()
{
	fFirstSelected = fLastSelected = -1;
	for (int32 i = 0; i < CountItems(); i++) {
		if (!fItems[i]->fSelected)
			continue;
		if (fFirstSelected < 0)
			fFirstSelected = i;
		fLastSelected = i;
	}
}


void
BListView::_SelectionDone(bool changed)
{
	if (!changed)
		return;
	SelectionChanged();
	if (fSelectionMessage != nullptr)
		InvokeNotify(fSelectionMessage.get(), B_CONTROL_MODIFIED);
}


// The selected items' indices go along, in ascending order.
status_t
BListView::Invoke(BMessage* message)
{
	bool notify;
	InvokeKind(&notify);
	if (message == NULL && !notify)
		message = Message();
	if (message == NULL)
		return B_BAD_VALUE;

	BMessage copy(*message);
	copy.AddInt64("when", system_time());
	copy.AddPointer("source", this);
	copy.AddMessenger("be:sender", BMessenger(this));
	for (int32 i = fFirstSelected; i >= 0 && i <= fLastSelected; i++) {
		if (fItems[i]->fSelected)
			copy.AddInt32("index", i);
	}
	return BInvoker::Invoke(&copy);
}
