#include "storage/private/FileList.h"

#include <algorithm>
#include <unordered_set>

#include <List.h>
#include <Message.h>
#include <Window.h>

namespace BPrivate {


FileList::FileList(BRect frame, list_view_type type) :
	BListView(frame, "files", type, B_FOLLOW_ALL_SIDES,
		B_WILL_DRAW | B_NAVIGABLE | B_FRAME_EVENTS | B_FULL_UPDATE_ON_RESIZE),
	fQuiet(false)
{
	SetInvocationMessage(new BMessage(kPanelInvoked));
}


FileList::~FileList()
{
	fQuiet = true;
	_DeleteRows();
}


void
FileList::SetItems(const std::vector<FolderItem>& items)
{
	std::unordered_set<std::string> selected;
	for (int32 i = 0, index; (index = CurrentSelection(i)) >= 0; i++)
		selected.insert(RowAt(index)->Item().name);

	fQuiet = true;
	_DeleteRows();
	BList rows;
	for (const FolderItem& item : items)
		rows.AddItem(new FileRow(item));
	AddList(&rows);
	for (int32 i = 0; !selected.empty() && i < CountItems(); i++) {
		if (selected.count(RowAt(i)->Item().name) != 0)
			Select(i, true);
	}
	fQuiet = false;
}


FileRow*
FileList::RowAt(int32 index) const
{
	return static_cast<FileRow*>(ItemAt(index));
}


bool
FileList::SelectName(const std::string& name)
{
	fQuiet = true;
	DeselectAll();
	int32 found = -1;
	for (int32 i = 0; i < CountItems() && found < 0; i++) {
		if (RowAt(i)->Item().name == name)
			found = i;
	}
	if (found >= 0) {
		Select(found);
		ScrollToSelection();
	}
	fQuiet = false;
	return found >= 0;
}


void
FileList::SelectNothing()
{
	fQuiet = true;
	DeselectAll();
	fQuiet = false;
}


void
FileList::SelectionChanged()
{
	if (!fQuiet && Window() != NULL)
		Window()->PostMessage(kPanelSelection);
}


void
FileList::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes == 1 && bytes[0] == B_BACKSPACE)
		Window()->PostMessage(kPanelParent);
	else
		BListView::KeyDown(bytes, numBytes);
}


void
FileList::_DeleteRows()
{
	BList rows;
	for (int32 i = 0; i < CountItems(); i++)
		rows.AddItem(ItemAt(i));
	MakeEmpty();
	for (int32 i = 0; i < rows.CountItems(); i++)
		delete static_cast<FileRow*>(rows.ItemAt(i));
}

} // namespace BPrivate
