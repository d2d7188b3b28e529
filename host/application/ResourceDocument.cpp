#include "host/application/ResourceDocument.h"

#include <algorithm>
#include <cstring>
#include <set>

#include <sys/stat.h>

#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <MessageForm.h>
#include <ResourceForm.h>
#include <Resources.h>

using namespace BResEditor;

namespace {


status_t
AddItemTo(BResources& resources, const BResourceItem& item)
{
	const void* data = item.Size() > 0 ? item.Data() : "";
	return resources.AddResource(item.Type(), item.ID(), data, item.Size(), item.Name());
}


// Moves a resource to the end, as it is.
status_t
AddAgain(BResources& resources, type_code type, int32 id)
{
	const char* name;
	size_t size;
	const void* data = resources.LoadResource(type, id, &size);
	if (data == nullptr || !resources.GetResourceInfo(type, id, &name, &size))
		return B_IO_ERROR;
	return resources.AddResource(type, id, data, size, name);
}


std::vector<std::pair<type_code, int32>>
KeysOf(BResources& resources)
{
	std::vector<std::pair<type_code, int32>> keys;
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++)
		keys.emplace_back(type, id);
	return keys;
}


} // namespace


class ResourceDocument::ReadAccess {
public:
	explicit ReadAccess(const ResourceDocument* document) : fDocument(document)
	{
		fDocument->LockForReading();
	}
	~ReadAccess() { fDocument->UnlockForReading(); }

private:
	const ResourceDocument* fDocument; // borrowed
};


class ResourceDocument::WriteAccess {
public:
	WriteAccess(ResourceDocument* document, const char* operation) : fDocument(document)
	{
		fDocument->LockForWriting(operation);
	}
	~WriteAccess() { fDocument->UnlockForWriting(); }

private:
	ResourceDocument* fDocument; // borrowed
};


ResourceDocument::ResourceDocument() : fReplaying(false)
{
}


ResourceDocument::~ResourceDocument()
{
}


status_t
ResourceDocument::Load(const char* path)
{
	BFile file(path, B_READ_ONLY);
	status_t status = file.InitCheck();
	if (status != B_OK)
		return status;
	BResources resources;
	status = resources.SetTo(&file);
	if (status != B_OK)
		return status;

	// Everything is in memory before the present items go.
	const FileStamp stamp = _StampOf(path);
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		if (resources.LoadResource(type, id, &size) == nullptr && size > 0)
			return B_IO_ERROR;
	}

	WriteAccess access(this, NULL);
	fReplaying = true; // loading is no undo step
	while (CountItems() > 0)
		RemoveItem(HandleAt(CountItems() - 1));
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		const void* data = resources.LoadResource(type, id, &size);
		AddItem(NULL, type, id, name, data, size);
	}
	fReplaying = false;

	fUndoSteps.clear();
	fRedoSteps.clear();
	fPath = path;
	fSaved = _PresentItems();
	fStamp = stamp;
	return B_OK;
}


status_t
ResourceDocument::Save()
{
	if (fPath.empty())
		return B_NO_INIT;

	ReadAccess access(this);
	const SavedItems present = _PresentItems();
	const bool isThere = BEntry(fPath.c_str()).Exists();
	const status_t status =
		isThere ? _WriteDifferences(fPath.c_str(), present) : _WriteAll(fPath.c_str());
	if (status == B_OK) {
		fSaved = present;
		fStamp = _StampOf(fPath.c_str());
	}
	return status;
}


status_t
ResourceDocument::SaveAs(const char* path)
{
	if (fPath == path)
		return Save();

	ReadAccess access(this);
	const status_t status = _WriteAll(path);
	if (status == B_OK) {
		fPath = path;
		fSaved = _PresentItems();
		fStamp = _StampOf(path);
	}
	return status;
}


const char*
ResourceDocument::Path() const
{
	return fPath.c_str();
}


const char*
ResourceDocument::Name() const
{
	if (fPath.empty())
		return "Untitled";
	const size_t slash = fPath.rfind('/');
	return fPath.c_str() + (slash == std::string::npos ? 0 : slash + 1);
}


bool
ResourceDocument::IsModified() const
{
	ReadAccess access(this);
	if (static_cast<size_t>(CountItems()) != fSaved.size())
		return true;

	for (int32 i = 0; i < CountItems(); i++) {
		const BResourceItem* item = Item(HandleAt(i));
		auto saved = fSaved.find({ item->Type(), item->ID() });
		if (saved == fSaved.end() || saved->second.name != item->Name()
			|| saved->second.data.size() != item->Size()
			|| (item->Size() > 0
				&& memcmp(saved->second.data.data(), item->Data(), item->Size()) != 0))
			return true;
	}
	return false;
}


bool
ResourceDocument::IsChangedOnDisk() const
{
	const FileStamp present = _StampOf(fPath.c_str());
	return present != FileStamp() && present != fStamp;
}


const char*
ResourceDocument::UndoName() const
{
	return fUndoSteps.empty() ? nullptr : fUndoSteps.back().name.String();
}


const char*
ResourceDocument::RedoName() const
{
	return fRedoSteps.empty() ? nullptr : fRedoSteps.back().name.String();
}


bool
ResourceDocument::Undo()
{
	return _Replay(fUndoSteps, fRedoSteps, true);
}


bool
ResourceDocument::Redo()
{
	return _Replay(fRedoSteps, fUndoSteps, false);
}


// #pragma mark - undo steps


void
ResourceDocument::StepBegins(const char* operation)
{
	fOpenStep.name = operation != nullptr ? operation : "Edit";
	fOpenStep.changes.clear();
}


// Keeps the state from before the step's first change of each item.
void
ResourceDocument::ItemChanges(const BResourceItem* item, uint32 change)
{
	if (fReplaying)
		return;

	for (const Change& known : fOpenStep.changes) {
		if (known.handle == item->Handle())
			return;
	}

	Change entry;
	entry.handle = item->Handle();
	entry.index = IndexOf(entry.handle);
	if (change != B_ITEM_CREATED)
		entry.before = std::make_shared<const BResourceItem>(*item);
	fOpenStep.changes.push_back(std::move(entry));
}


void
ResourceDocument::StepEnds()
{
	if (fReplaying || fOpenStep.changes.empty())
		return;

	for (Change& change : fOpenStep.changes) {
		if (const BResourceItem* item = Item(change.handle))
			change.after = std::make_shared<const BResourceItem>(*item);
	}
	fUndoSteps.push_back(std::move(fOpenStep));
	fOpenStep = Step();
	fRedoSteps.clear();
}


void
ResourceDocument::PrepareData(const BResourceItem* item, std::vector<uint8>& data) const
{
	message_form_info former, given;
	if (get_message_form(item->Data(), item->Size(), &former) != B_OK
		|| get_message_form(data.data(), data.size(), &given) != B_OK || former.form == given.form)
		return;

	BMessage message;
	if (unflatten_message(&message, data.data(), data.size()) != B_OK)
		return;
	const ssize_t size = flattened_message_size(message, former.form);
	if (size <= 0)
		return;
	std::vector<uint8> converted(static_cast<size_t>(size));
	if (flatten_message(message, former.form, converted.data(), size) == B_OK)
		data = std::move(converted);
}


bool
ResourceDocument::_Replay(std::vector<Step>& from, std::vector<Step>& to, bool undo)
{
	WriteAccess access(this, NULL);
	if (from.empty())
		return false;

	fReplaying = true;
	Step step = std::move(from.back());
	from.pop_back();
	if (undo) {
		for (auto change = step.changes.rbegin(); change != step.changes.rend(); ++change)
			_ReplayChange(*change, true);
	} else {
		for (const Change& change : step.changes)
			_ReplayChange(change, false);
	}
	to.push_back(std::move(step));
	fReplaying = false;
	return true;
}


void
ResourceDocument::_ReplayChange(const Change& change, bool undo)
{
	const BResourceItem* state = undo ? change.before.get() : change.after.get();
	if (state != nullptr)
		RestoreItem(*state, change.index);
	else
		RemoveItem(change.handle);
}


// #pragma mark - the file


ResourceDocument::FileStamp
ResourceDocument::_StampOf(const char* path)
{
	struct stat info;
	if (stat(path, &info) != 0)
		return FileStamp();
	return { info.st_mtim.tv_sec, info.st_mtim.tv_nsec, info.st_size };
}


ResourceDocument::SavedItems
ResourceDocument::_PresentItems() const
{
	SavedItems items;
	for (int32 i = 0; i < CountItems(); i++) {
		const BResourceItem* item = Item(HandleAt(i));
		const uint8* bytes = static_cast<const uint8*>(item->Data());
		items[{ item->Type(), item->ID() }] = { item->Name(),
			std::vector<uint8>(bytes, bytes + item->Size()) };
	}
	return items;
}


// What an existing file holds, whatever it is, is replaced in one step, once everything is written.
status_t
ResourceDocument::_WriteAll(const char* path) const
{
	BResources resources;
	status_t status = B_OK;
	for (int32 i = 0; status == B_OK && i < CountItems(); i++)
		status = AddItemTo(resources, *Item(HandleAt(i)));
	if (status != B_OK)
		return status;

	const bool isNew = !BEntry(path).Exists();
	BFile file(path, B_READ_WRITE | B_CREATE_FILE);
	status = file.InitCheck();
	if (status == B_OK)
		status = write_resources_over(&resources, &file);
	if (status != B_OK && isNew)
		BEntry(path).Remove();
	return status;
}


// Only what differs is touched, so that everything else in the file stays as it is, also what
// another program has put there since it was read.
status_t
ResourceDocument::_WriteDifferences(const char* path, const SavedItems& present)
{
	BFile file(path, B_READ_WRITE);
	status_t status = file.InitCheck();
	if (status != B_OK)
		return status;
	BResources resources;
	status = resources.SetTo(&file);
	if (status != B_OK)
		return status;

	for (const auto& [key, saved] : fSaved) {
		if (present.find(key) == present.end())
			resources.RemoveResource(key.first, key.second);
	}
	status = _WriteChanged(resources, present);
	return status == B_OK ? resources.Sync() : status;
}


// What is added goes to the end. So from the first item that changes or moves on, all are added
// again.
status_t
ResourceDocument::_WriteChanged(BResources& resources, const SavedItems& present) const
{
	const std::vector<ItemKey> former = KeysOf(resources);
	const std::vector<ItemKey> order = _OrderInFile(former, present);
	size_t first = 0;
	while (first < order.size() && first < former.size() && order[first] == former[first]
		&& !_HasChanged(order[first], present))
		first++;

	status_t status = B_OK;
	for (size_t i = first; i < order.size() && status == B_OK; i++) {
		const auto [type, id] = order[i];
		status = _HasChanged(order[i], present) ? AddItemTo(resources, *Item(FindItem(type, id)))
												: AddAgain(resources, type, id);
	}
	return status;
}


// The document's order, with the items that only the file has behind those that they follow there.
std::vector<ResourceDocument::ItemKey>
ResourceDocument::_OrderInFile(const std::vector<ItemKey>& former, const SavedItems& present) const
{
	const std::set<ItemKey> inFile(former.begin(), former.end());
	std::vector<ItemKey> order;
	for (int32 i = 0; i < CountItems(); i++) {
		const BResourceItem* item = Item(HandleAt(i));
		const ItemKey key(item->Type(), item->ID());
		if (inFile.count(key) > 0 || _HasChanged(key, present))
			order.push_back(key);
	}
	for (size_t i = 0; i < former.size(); i++) {
		if (present.count(former[i]) > 0)
			continue;
		const auto before =
			i == 0 ? order.end() : std::find(order.begin(), order.end(), former[i - 1]);
		order.insert(before == order.end() ? order.begin() : before + 1, former[i]);
	}
	return order;
}


// Whether the item is new or differs from what was last read or saved.
bool
ResourceDocument::_HasChanged(const ItemKey& key, const SavedItems& present) const
{
	const auto item = present.find(key);
	if (item == present.end())
		return false;
	const auto saved = fSaved.find(key);
	return saved == fSaved.end() || saved->second.name != item->second.name
		|| saved->second.data != item->second.data;
}
