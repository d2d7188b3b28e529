#include "server/DragOffer.h"

#include <cstring>

#include <AppDefs.h>
#include <Entry.h>
#include <Path.h>

#include "backend/FolderDrop.h"
#include "server/DragFile.h"

namespace BPrivate {

namespace {

constexpr const char* kFileList = "text/uri-list";
constexpr const char* kPlainText = "text/plain";


bool
OffersFile(const BMessage& message)
{
	bool file = false;
	const char* type;
	for (int32 i = 0; message.FindString("be:types", i, &type) == B_OK; i++)
		file = file || std::strcmp(type, "application/octet-stream") == 0;
	if (!file)
		return false;

	int32 action;
	for (int32 i = 0; message.FindInt32("be:actions", i, &action) == B_OK; i++) {
		if (action == B_COPY_TARGET || action == B_MOVE_TARGET)
			return true;
	}
	return false;
}


bool
ListRefs(const BMessage& message, std::string* _list)
{
	entry_ref ref;
	for (int32 i = 0; message.FindRef("refs", i, &ref) == B_OK; i++) {
		const BPath path(&ref);
		if (path.InitCheck() == B_OK)
			*_list += uri_of_path(path.Path()) + "\r\n";
	}
	return !_list->empty();
}


void
AddFields(const BMessage& message, std::vector<std::string>& types)
{
	char* name;
	type_code type;
	for (int32 i = 0; message.GetInfo(B_MIME_TYPE, i, &name, &type) == B_OK; i++) {
		if (std::strchr(name, '/') != nullptr && std::strcmp(name, kFileList) != 0)
			types.push_back(name);
	}
}

} // namespace


DataOffer
make_drag_offer(DesktopThread& desktop, const DragReference& session)
{
	const BMessage& message = session->Message();
	const bool writesFile = OffersFile(message);

	DataOffer offer;
	if (writesFile || message.HasRef("refs"))
		offer.types.push_back(kFileList);
	AddFields(message, offer.types);

	// Whoever takes a file asks several times; it is written once.
	auto file = writesFile ? std::make_shared<DragFile>(desktop, message) : nullptr;
	offer.get = [session, file](const std::string& type, std::string* _data) {
		if (type == kFileList) {
			_data->clear();
			if (ListRefs(session->Message(), _data))
				return true;
			if (file == nullptr || !file->Write())
				return false;
			*_data = uri_of_path(file->Path()) + "\r\n";
			return true;
		}
		const void* data;
		ssize_t size;
		if (session->Message().FindData(type.c_str(), B_MIME_TYPE, &data, &size) != B_OK)
			return false;
		_data->assign(static_cast<const char*>(data), static_cast<size_t>(size));
		return true;
	};
	return offer;
}


std::unique_ptr<BMessage>
make_foreign_drag(const BMessage& data)
{
	auto message = std::make_unique<BMessage>(B_MIME_DATA);
	const void* bytes;
	ssize_t size;
	if (data.FindData(kFileList, B_MIME_TYPE, &bytes, &size) == B_OK) {
		message->what = B_SIMPLE_DATA;
		const std::string list(static_cast<const char*>(bytes), static_cast<size_t>(size));
		for (const std::string& path : paths_of_uri_list(list)) {
			entry_ref ref;
			if (get_ref_for_path(path.c_str(), &ref) == B_OK)
				message->AddRef("refs", &ref);
		}
	}
	// Files are not text, though many programs offer their addresses as such.
	if (message->what == B_MIME_DATA
		&& data.FindData(kPlainText, B_MIME_TYPE, &bytes, &size) == B_OK)
		message->AddData(kPlainText, B_MIME_TYPE, bytes, size, false);
	return message;
}


} // namespace BPrivate
