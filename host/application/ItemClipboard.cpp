#include "host/application/ItemClipboard.h"

#include <Autolock.h>
#include <Clipboard.h>
#include <Message.h>
#include <MessageForm.h>
#include <TypeConstants.h>

using namespace BResEditor;

namespace {


// A flattened message: for each item a message "item" with int32 "type", int32 "id", string "name"
// and, unless it has no bytes, raw "data".
constexpr const char* kItemsType = "application/x-vnd.Archway-items";


status_t
AddItem(BMessage& message, const BResourceItem& item)
{
	BMessage fields;
	status_t status = fields.AddInt32("type", static_cast<int32>(item.Type()));
	if (status == B_OK)
		status = fields.AddInt32("id", item.ID());
	if (status == B_OK)
		status = fields.AddString("name", item.Name());
	if (status == B_OK && item.Size() > 0) {
		status = fields.AddData("data", B_RAW_TYPE, item.Data(), static_cast<ssize_t>(item.Size()));
	}
	return status == B_OK ? message.AddMessage("item", &fields) : status;
}


} // namespace


status_t
CopyToClipboard(const std::vector<BResourceItem>& items)
{
	BMessage message('Itms');
	status_t status = B_OK;
	for (size_t i = 0; i < items.size() && status == B_OK; i++)
		status = AddItem(message, items[i]);
	if (status != B_OK)
		return status;
	std::vector<char> bytes(static_cast<size_t>(message.FlattenedSize()));
	status = message.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
	if (status != B_OK)
		return status;

	if (!be_clipboard->Lock())
		return B_ERROR;
	be_clipboard->Clear();
	status = be_clipboard->Data()->AddData(
		kItemsType, B_MIME_TYPE, bytes.data(), static_cast<ssize_t>(bytes.size()));
	if (status == B_OK)
		status = be_clipboard->Commit();
	be_clipboard->Unlock();
	return status;
}


std::vector<ClipboardItem>
ItemsOnClipboard()
{
	BMessage message;
	if (!be_clipboard->Lock())
		return {};
	const void* bytes;
	ssize_t size;
	const BMessage* clip = be_clipboard->Data();
	const bool isThere = clip->FindData(kItemsType, B_MIME_TYPE, &bytes, &size) == B_OK
		&& unflatten_message(&message, bytes, static_cast<size_t>(size)) == B_OK;
	be_clipboard->Unlock();

	std::vector<ClipboardItem> items;
	BMessage fields;
	for (int32 i = 0; isThere && message.FindMessage("item", i, &fields) == B_OK; i++) {
		int32 type, id;
		const char* name;
		if (fields.FindInt32("type", &type) != B_OK || fields.FindInt32("id", &id) != B_OK
			|| fields.FindString("name", &name) != B_OK)
			continue;
		ClipboardItem item = { static_cast<type_code>(type), id, name, "" };
		if (fields.FindData("data", B_RAW_TYPE, &bytes, &size) == B_OK)
			item.data.assign(static_cast<const char*>(bytes), static_cast<size_t>(size));
		items.push_back(std::move(item));
	}
	return items;
}
