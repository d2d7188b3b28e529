// FileWindow: what the user does to the items of the list.
#include "host/application/FileWindow.h"

#include <algorithm>

#include <Application.h>
#include <Message.h>

#include "host/application/AddonRoster.h"
#include "host/application/AttributesWindow.h"
#include "host/application/Codes.h"
#include "host/application/ItemClipboard.h"
#include "host/application/ItemList.h"
#include "host/application/ItemRow.h"
#include "host/application/ItemWindow.h"
#include "host/application/ResourceDocument.h"
#include "host/application/StatusText.h"

using namespace BResEditor;

namespace {


constexpr float kItemWindowOffset = 24;


} // namespace


void
FileWindow::_OpenHandle(const BResourceHandle& handle)
{
	for (const OpenWindow& open : fItemWindows) {
		if (open.handle == handle) {
			open.window->Lock();
			open.window->Activate(true);
			open.window->Unlock();
			return;
		}
	}

	const BRect frame =
		BRect(0, 0, 400, 300)
			.OffsetToCopy(Frame().LeftTop() + BPoint(kItemWindowOffset, kItemWindowOffset));
	ItemWindow* window =
		new ItemWindow(frame, BMessenger(this), fDocument.get(), fHandlers.get(), handle);
	fItemWindows.push_back({ window, BMessenger(window), handle });
	window->Show();
}


void
FileWindow::_OpenSelection()
{
	for (const BResourceHandle& handle : fList->SelectedItems())
		_OpenHandle(handle);
}


void
FileWindow::_DeleteSelection(const char* operation)
{
	const std::vector<BResourceHandle> handles = fList->SelectedItems();
	for (const OpenWindow& open : fItemWindows) {
		if (std::find(handles.begin(), handles.end(), open.handle) != handles.end())
			open.messenger.SendMessage(B_QUIT_REQUESTED);
	}
	if (handles.empty())
		return;
	if (BResourceCollection* collection = fAccess.WriteLock(operation)) {
		for (const BResourceHandle& handle : handles)
			collection->RemoveItem(handle);
		fAccess.WriteUnlock(collection);
	}
}


void
FileWindow::_DuplicateSelection()
{
	const std::vector<BResourceHandle> handles = fList->SelectedItems();
	if (handles.empty())
		return;
	if (BResourceCollection* collection = fAccess.WriteLock("Duplicate")) {
		for (const BResourceHandle& handle : handles) {
			if (const BResourceItem* item = collection->Item(handle)) {
				collection->AddItem(nullptr, item->Type(), item->ID(), item->Name(), item->Data(),
					item->Size(), true);
			}
		}
		fAccess.WriteUnlock(collection);
	}
}


// False when nothing was copied, of which the user is told.
bool
FileWindow::_CopySelection()
{
	const std::vector<BResourceHandle> handles = fList->SelectedItems();
	if (handles.empty())
		return false;
	std::vector<BResourceItem> items; // which share their bytes with the document's
	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		for (const BResourceHandle& handle : handles) {
			if (const BResourceItem* item = collection->Item(handle))
				items.push_back(*item);
		}
		fAccess.ReadUnlock(collection);
	}
	const status_t status = CopyToClipboard(items);
	if (status != B_OK)
		_Tell(std::string("The resources could not be copied: ") + StatusText(status) + ".");
	return status == B_OK;
}


// Under the next free numbers, where the own ones are taken.
void
FileWindow::_Paste()
{
	const std::vector<ClipboardItem> items = ItemsOnClipboard();
	if (items.empty())
		return;
	if (BResourceCollection* collection = fAccess.WriteLock("Paste")) {
		for (const ClipboardItem& item : items) {
			collection->AddItem(nullptr, item.type, item.id, item.name.c_str(), item.data.data(),
				item.data.size(), true);
		}
		fAccess.WriteUnlock(collection);
	}
}


void
FileWindow::_AskForAttributes()
{
	_CloseAttributes();
	fDescribed = fList->FirstSelected();
	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		if (const BResourceItem* item = collection->Item(fDescribed)) {
			AttributesWindow* window = new AttributesWindow(Frame(), BMessenger(this), item);
			fAttributesWindow = BMessenger(window);
			window->Show();
		}
		fAccess.ReadUnlock(collection);
	}
}


void
FileWindow::_SetAttributes(const BMessage* message)
{
	status_t status = B_ENTRY_NOT_FOUND;
	if (BResourceCollection* collection = fAccess.WriteLock("Change Attributes")) {
		if (BResourceItem* item = collection->WriteItem(fDescribed)) {
			status = item->SetKey(
				static_cast<type_code>(message->GetInt32("type", 0)), message->GetInt32("id", 0));
			if (status == B_OK)
				status = item->SetName(message->GetString("name", ""));
		}
		fAccess.WriteUnlock(collection);
	}
	if (status == B_NAME_IN_USE)
		_Tell("There is already a resource of that type and ID.");
	else
		_CloseAttributes();
}


void
FileWindow::_CloseAttributes()
{
	fAttributesWindow.SendMessage(B_QUIT_REQUESTED);
}


void
FileWindow::_Generate(BMessage* request)
{
	const auto& handlers = fHandlers->Handlers();
	const size_t index = static_cast<size_t>(request->GetInt32("handler", -1));
	if (index >= handlers.size())
		return;

	BResourceHandle handle;
	const status_t status = handlers[index]->GenerateResource(
		&handle, request, 1, "", true, BResourceCollection::B_FAIL_ON_CONFLICT);
	if (status == B_OK)
		_OpenHandle(handle);
	else
		_Tell(std::string("The resource could not be made: ") + StatusText(status) + ".");
}
