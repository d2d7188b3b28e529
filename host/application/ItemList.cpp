#include "host/application/ItemList.h"

#include <algorithm>

#include <InterfaceDefs.h>
#include <Message.h>
#include <Window.h>

#include "host/application/Codes.h"
#include "host/application/ItemRow.h"
#include "host/library/ResourceCollection.h"

using namespace BResEditor;

namespace {


// Rows come mostly at the end.
int32
IndexIn(const BResourceCollection* collection, const BResourceHandle& handle)
{
	int32 index = collection->CountItems() - 1;
	while (index > 0 && collection->HandleAt(index) != handle)
		index--;
	return index;
}


} // namespace


ItemList::ItemList(BRect frame) :
	BListView(frame, "items", B_MULTIPLE_SELECTION_LIST, B_FOLLOW_ALL_SIDES,
		B_WILL_DRAW | B_NAVIGABLE | B_FRAME_EVENTS | B_FULL_UPDATE_ON_RESIZE)
{
	SetInvocationMessage(new BMessage(kOpenItem));
}


ItemList::~ItemList()
{
	while (BListItem* row = RemoveItem(CountItems() - 1))
		delete row;
}


bool
ItemList::Update(const BResourceCollection* collection, const BResourceHandle& handle)
{
	const BResourceItem* item = collection->Item(handle);
	const int32 index = _IndexOf(handle);
	if (item == nullptr) {
		delete RemoveItem(index);
		if (CurrentSelection() < 0)
			Select(std::min(index, CountItems() - 1));
		return false;
	}
	if (index < 0) {
		const int32 place = IndexIn(collection, handle);
		return place < CountItems() ? AddItem(new ItemRow(item), place)
									: AddItem(new ItemRow(item));
	}
	_RowAt(index)->SetTo(item);
	InvalidateItem(index);
	return false;
}


std::vector<BResourceHandle>
ItemList::SelectedItems() const
{
	std::vector<BResourceHandle> handles;
	for (int32 i = 0; const ItemRow* row = _RowAt(CurrentSelection(i)); i++)
		handles.push_back(row->Handle());
	return handles;
}


BResourceHandle
ItemList::FirstSelected() const
{
	const ItemRow* row = _RowAt(CurrentSelection());
	return row != nullptr ? row->Handle() : BResourceHandle();
}


void
ItemList::SelectItems(const std::vector<BResourceHandle>& handles)
{
	bool extend = false;
	for (const BResourceHandle& handle : handles) {
		const int32 index = _IndexOf(handle);
		if (index < 0)
			continue;
		Select(index, extend);
		extend = true;
	}
	ScrollToSelection();
}


void
ItemList::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes == 1 && (bytes[0] == B_DELETE || bytes[0] == B_BACKSPACE))
		Window()->PostMessage(kDeleteItem);
	else
		BListView::KeyDown(bytes, numBytes);
}


// #pragma mark - private


ItemRow*
ItemList::_RowAt(int32 index) const
{
	return static_cast<ItemRow*>(ItemAt(index));
}


int32
ItemList::_IndexOf(const BResourceHandle& handle) const
{
	int32 index = CountItems() - 1;
	while (index >= 0 && _RowAt(index)->Handle() != handle)
		index--;
	return index;
}
