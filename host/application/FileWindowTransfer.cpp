// FileWindow: the bytes of single items, from and to files of their own.
#include "host/application/FileWindow.h"

#include <vector>

#include <DataIO.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <Path.h>
#include <TypeConstants.h>

#include "host/application/Codes.h"
#include "host/application/ItemList.h"
#include "host/application/ReplaceFile.h"
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
	const BResourceHandle handle = fList->FirstSelected();
	if (!handle.IsValid())
		return;

	std::string name;
	if (const BResourceCollection* collection = fAccess.ReadLock()) {
		if (const BResourceItem* item = collection->Item(handle))
			name = item->Name();
		fAccess.ReadUnlock(collection);
	}
	for (char& character : name)
		character = character == '/' ? '-' : character;

	fExported = handle;
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
