// FileWindow: the bytes of single items, from and to files of their own.
#include "host/application/FileWindow.h"

#include <vector>

#include <DataIO.h>
#include <Entry.h>
#include <File.h>
#include <ListView.h>
#include <Message.h>
#include <Path.h>
#include <TypeConstants.h>

#include "host/application/Codes.h"
#include "host/application/ItemRow.h"
#include "host/application/StatusText.h"

using namespace BResEditor;

namespace {


constexpr type_code kArchiveType = 'ARCV';
constexpr off_t kLargestItem = 256 * 1024 * 1024;


status_t
ReadBytes(const entry_ref& ref, std::vector<uint8>* _bytes)
{
	BFile file(&ref, B_READ_ONLY);
	off_t size = 0;
	status_t status = file.InitCheck();
	if (status == B_OK)
		status = file.GetSize(&size);
	if (status != B_OK)
		return status;
	if (!file.IsFile() || size > kLargestItem)
		return B_BAD_VALUE;

	_bytes->resize(static_cast<size_t>(size));
	const ssize_t read = file.Read(_bytes->data(), _bytes->size());
	if (read < 0)
		return static_cast<status_t>(read);
	return static_cast<size_t>(read) == _bytes->size() ? B_OK : B_IO_ERROR;
}


// A file beside the target takes its place when it is complete.
status_t
ReplaceFile(const std::string& path, const void* data, size_t size)
{
	const std::string temporary = path + ".archway-new";
	BFile file(temporary.c_str(), B_READ_WRITE | B_CREATE_FILE | B_ERASE_FILE);
	status_t status = file.InitCheck();
	if (status != B_OK)
		return status;
	if (file.Write(data, size) != static_cast<ssize_t>(size))
		status = B_IO_ERROR;
	if (status == B_OK)
		status = file.Sync();
	BEntry entry(temporary.c_str());
	if (status == B_OK)
		status = entry.Rename(path.c_str(), true);
	if (status != B_OK)
		entry.Remove();
	return status;
}


// Flattened archives become items that the view editor opens.
type_code
TypeOf(const std::vector<uint8>& bytes)
{
	BMessage message;
	BMemoryIO data(bytes.data(), bytes.size());
	const bool isArchive =
		!bytes.empty() && message.Unflatten(&data) == B_OK && message.HasString("class");
	return isArchive ? kArchiveType : static_cast<type_code>(B_RAW_TYPE);
}


} // namespace


void
FileWindow::_AskForImport()
{
	if (fImportPanel == nullptr)
		fImportPanel = _MakePanel(B_OPEN_PANEL, kImportChosen, "Import");
	fImportPanel->Show();
}


void
FileWindow::_Import(const BMessage* message)
{
	entry_ref ref;
	for (int32 i = 0; message->FindRef("refs", i, &ref) == B_OK; i++) {
		const status_t status = _ImportFile(ref);
		if (status != B_OK) {
			_Tell(std::string("\"") + ref.name + "\" could not be imported: " + StatusText(status)
				+ ".");
		}
	}
}


// One new item, named like the file.
status_t
FileWindow::_ImportFile(const entry_ref& ref)
{
	std::vector<uint8> bytes;
	status_t status = ReadBytes(ref, &bytes);
	if (status != B_OK)
		return status;

	BResourceCollection* collection = fAccess.WriteLock("Import");
	if (collection == nullptr)
		return B_ERROR;
	status =
		collection->AddItem(nullptr, TypeOf(bytes), 1, ref.name, bytes.data(), bytes.size(), true);
	fAccess.WriteUnlock(collection);
	return status;
}


void
FileWindow::_AskForExport()
{
	const ItemRow* row = dynamic_cast<ItemRow*>(fList->ItemAt(fList->CurrentSelection()));
	if (row == nullptr)
		return;

	std::string name;
	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		if (const BResourceItem* item = collection->Item(row->Handle()))
			name = item->Name();
		fAccess.ReadUnlock(collection);
	}
	for (char& character : name)
		character = character == '/' ? '-' : character;

	fExported = row->Handle();
	if (fExportPanel == nullptr)
		fExportPanel = _MakePanel(B_SAVE_PANEL, kExportChosen, "Export");
	fExportPanel->SetSaveText(name.empty() ? "item" : name.c_str());
	fExportPanel->Show();
}


// What is being typed in the item's own window belongs to it.
void
FileWindow::_Export(const BMessage* message)
{
	const std::string path = _ChosenPath(message);
	if (path.empty())
		return;
	_ApplyItemsThen([this, path] {
		status_t status = B_ENTRY_NOT_FOUND;
		if (const BResourceCollection* collection = fAccess.ReadLock()) {
			if (const BResourceItem* item = collection->Item(fExported))
				status = ReplaceFile(path, item->Data(), item->Size());
			fAccess.ReadUnlock(collection);
		}
		if (status != B_OK)
			_Tell("\"" + path + "\" could not be written: " + StatusText(status) + ".");
	});
}
