#include "host/application/ItemClipboard.h"

#include <Autolock.h>
#include <Clipboard.h>
#include <Message.h>
#include <MessageForm.h>
#include <TypeConstants.h>

using namespace BResEditor;

namespace {


// A flattened message: for each item an int32 "type", an int32 "id", a string "name" and its bytes
// as raw "data".
constexpr const char* kItemsType = "application/x-vnd.Archway-items";


} // namespace


status_t
CopyToClipboard(const std::vector<BResourceItem>& items)
{
	BMessage message('Itms');
	for (const BResourceItem& item : items) {
		message.AddInt32("type", static_cast<int32>(item.Type()));
		message.AddInt32("id", item.ID());
		message.AddString("name", item.Name());
		message.AddData("data", B_RAW_TYPE, item.Size() > 0 ? item.Data() : "",
			static_cast<ssize_t>(item.Size()), false);
	}
	std::vector<char> bytes(static_cast<size_t>(message.FlattenedSize()));
	status_t status = message.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size()));
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
	int32 type, id;
	const char* name;
	for (int32 i = 0; isThere && message.FindInt32("type", i, &type) == B_OK
		 && message.FindInt32("id", i, &id) == B_OK && message.FindString("name", i, &name) == B_OK
		 && message.FindData("data", B_RAW_TYPE, i, &bytes, &size) == B_OK;
		 i++) {
		items.push_back({ static_cast<type_code>(type), id, name,
			std::string(static_cast<const char*>(bytes), static_cast<size_t>(size)) });
	}
	return items;
}
