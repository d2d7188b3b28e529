#include "host/library/ResourceCollection.h"

#include <algorithm>
#include <mutex>
#include <unordered_map>
#include <utility>
#include <vector>

#include <Message.h>
#include <Messenger.h>

#include "host/library/AccessLock.h"
#include "host/library/ResourceAddonBase.h"

namespace BResEditor {

namespace {


uint64
KeyOf(type_code type, int32 id)
{
	return static_cast<uint64>(type) << 32 | static_cast<uint32>(id);
}


// The changes that one user has not seen yet, in the order of their first occurrence.
class PendingChanges {
public:
	void Add(int32 number, uint32 change)
	{
		auto [place, isNew] = fBits.try_emplace(number, 0);
		place->second |= change;
		if (isNew)
			fOrder.push_back(number);
	}

	bool IsEmpty() const { return fNext == fOrder.size(); }

	int32 Take(uint32* _changes)
	{
		const int32 number = fOrder[fNext++];
		auto place = fBits.find(number);
		*_changes = place->second;
		fBits.erase(place);
		if (IsEmpty()) {
			fOrder.clear();
			fNext = 0;
		}
		return number;
	}

private:
	std::vector<int32> fOrder;
	size_t fNext = 0;
	std::unordered_map<int32, uint32> fBits;
};


struct User {
	PendingChanges pending;
	BMessenger messenger; // invalid until the user has read in its window's thread
	bool told = false; // a notice is on its way
};


} // namespace


class BResourceCollection::Private {
public:
	mutable AccessLock access;
	std::vector<std::unique_ptr<BResourceItem>> items; // in the order of the file
	std::unordered_map<int32, BResourceItem*> byNumber;
	std::unordered_map<uint64, BResourceItem*> byKey;
	int32 lastNumber = 0;

	std::mutex usersMutex; // guards the users; the collection's own lock may be held or not
	std::unordered_map<BResourceAddonBase*, User> users;

	void Insert(std::unique_ptr<BResourceItem> item, type_code type, int32 id, int32 index)
	{
		byNumber[item->Handle().fNumber] = item.get();
		byKey[KeyOf(type, id)] = item.get();
		items.insert(items.begin() + index, std::move(item));
	}

	void NoteChange(int32 number, uint32 change)
	{
		std::lock_guard<std::mutex> guard(usersMutex);
		for (auto& [user, state] : users)
			state.pending.Add(number, change);
	}

	// Everyone for whom changes wait and who has not been told so.
	std::vector<BMessenger> TakeWaiting()
	{
		std::lock_guard<std::mutex> guard(usersMutex);
		std::vector<BMessenger> waiting;
		for (auto& [user, state] : users) {
			if (state.pending.IsEmpty() || state.told || !state.messenger.IsValid())
				continue;
			state.told = true;
			waiting.push_back(state.messenger);
		}
		return waiting;
	}
};


BResourceCollection::BResourceCollection() : fPrivate(std::make_unique<Private>())
{
}


BResourceCollection::~BResourceCollection()
{
}


int32
BResourceCollection::CountItems() const
{
	return static_cast<int32>(fPrivate->items.size());
}


BResourceHandle
BResourceCollection::HandleAt(int32 index) const
{
	if (index < 0 || index >= CountItems())
		return BResourceHandle();
	return fPrivate->items[static_cast<size_t>(index)]->Handle();
}


BResourceHandle
BResourceCollection::FindItem(type_code type, int32 id) const
{
	auto found = fPrivate->byKey.find(KeyOf(type, id));
	return found != fPrivate->byKey.end() ? found->second->Handle() : BResourceHandle();
}


const BResourceItem*
BResourceCollection::Item(const BResourceHandle& handle) const
{
	auto found = fPrivate->byNumber.find(handle.fNumber);
	return found != fPrivate->byNumber.end() ? found->second : nullptr;
}


BResourceItem*
BResourceCollection::WriteItem(const BResourceHandle& handle)
{
	return const_cast<BResourceItem*>(Item(handle));
}


status_t
BResourceCollection::AddItem(BResourceHandle* _handle, type_code type, int32 id, const char* name,
	const void* data, size_t size, bool makeUnique, conflict_resolution resolution)
{
	if (data == nullptr && size > 0)
		return B_BAD_VALUE;

	if (BResourceItem* existing = WriteItem(FindItem(type, id))) {
		if (makeUnique || resolution == B_RENUMBER_ON_CONFLICT)
			id = _NextFreeID(type, id);
		else if (resolution == B_REPLACE_ON_CONFLICT) {
			existing->SetName(name);
			if (_handle != nullptr)
				*_handle = existing->Handle();
			return existing->SetData(data, size);
		} else
			return B_NAME_IN_USE;
	}

	std::unique_ptr<BResourceItem> item(
		new BResourceItem(this, BResourceHandle(++fPrivate->lastNumber)));
	item->fType = type;
	item->fID = id;
	item->fName = name != nullptr ? name : "";
	const uint8* bytes = static_cast<const uint8*>(data);
	item->fData = std::make_shared<const std::vector<uint8>>(bytes, bytes + size);

	const BResourceItem* added = item.get();
	fPrivate->Insert(std::move(item), type, id, CountItems());
	fPrivate->NoteChange(added->Handle().fNumber, B_ITEM_CREATED);
	ItemChanges(added, B_ITEM_CREATED);
	if (_handle != nullptr)
		*_handle = added->Handle();
	return B_OK;
}


status_t
BResourceCollection::RemoveItem(const BResourceHandle& handle)
{
	BResourceItem* item = WriteItem(handle);
	if (item == nullptr)
		return B_ENTRY_NOT_FOUND;

	_WillChange(item, B_ITEM_REMOVED);
	fPrivate->byNumber.erase(handle.fNumber);
	fPrivate->byKey.erase(KeyOf(item->Type(), item->ID()));
	fPrivate->items.erase(fPrivate->items.begin() + IndexOf(handle));
	return B_OK;
}


BResourceHandle
BResourceCollection::GetNextChange(BResourceAddonBase* user, uint32* _changes) const
{
	std::lock_guard<std::mutex> guard(fPrivate->usersMutex);
	auto found = fPrivate->users.find(user);
	if (found == fPrivate->users.end() || found->second.pending.IsEmpty()) {
		if (found != fPrivate->users.end())
			found->second.told = false;
		*_changes = 0;
		return BResourceHandle();
	}
	return BResourceHandle(found->second.pending.Take(_changes));
}


// #pragma mark - for derived collections


void
BResourceCollection::StepBegins(const char* operation)
{
}


void
BResourceCollection::ItemChanges(const BResourceItem* item, uint32 change)
{
}


void
BResourceCollection::StepEnds()
{
}


void
BResourceCollection::PrepareData(const BResourceItem* item, std::vector<uint8>& data) const
{
}


bool
BResourceCollection::LockForReading() const
{
	fPrivate->access.LockForReading();
	return true;
}


void
BResourceCollection::UnlockForReading() const
{
	fPrivate->access.UnlockForReading();
}


bool
BResourceCollection::LockForWriting(const char* operation)
{
	if (!fPrivate->access.LockForWriting())
		return false;
	if (fPrivate->access.WriteDepth() == 1)
		StepBegins(operation);
	return true;
}


void
BResourceCollection::UnlockForWriting()
{
	if (fPrivate->access.WriteDepth() == 1)
		StepEnds();
	if (!fPrivate->access.UnlockForWriting())
		return;

	for (const BMessenger& messenger : fPrivate->TakeWaiting())
		messenger.SendMessage(B_RESOURCE_DATA_CHANGED);
}


BResourceItem*
BResourceCollection::RestoreItem(const BResourceItem& state, int32 index)
{
	if (BResourceItem* item = WriteItem(state.Handle())) {
		const uint32 change =
			(item->fData != state.fData ? B_ITEM_DATA_CHANGED : 0) | B_ITEM_ATTRIBUTES_CHANGED;
		_WillChange(item, change);
		_Rekey(item, state.Type(), state.ID());
		item->fName = state.fName;
		item->fData = state.fData;
		return item;
	}

	std::unique_ptr<BResourceItem> copy(new BResourceItem(state));
	BResourceItem* item = copy.get();
	fPrivate->Insert(
		std::move(copy), state.Type(), state.ID(), std::clamp(index, int32(0), CountItems()));
	fPrivate->NoteChange(item->Handle().fNumber, B_ITEM_CREATED);
	ItemChanges(item, B_ITEM_CREATED);
	return item;
}


int32
BResourceCollection::IndexOf(const BResourceHandle& handle) const
{
	const auto& items = fPrivate->items;
	auto found = std::find_if(items.begin(), items.end(),
		[&handle](const auto& item) { return item->Handle() == handle; });
	return found != items.end() ? static_cast<int32>(found - items.begin()) : -1;
}


// #pragma mark - private


int32
BResourceCollection::_NextFreeID(type_code type, int32 id) const
{
	while (FindItem(type, id).IsValid())
		id = id == INT32_MAX ? INT32_MIN : id + 1;
	return id;
}


void
BResourceCollection::_WillChange(BResourceItem* item, uint32 change)
{
	fPrivate->NoteChange(item->Handle().fNumber, change);
	ItemChanges(item, change);
}


void
BResourceCollection::_Rekey(BResourceItem* item, type_code type, int32 id)
{
	// During an undo of several items another one may hold the new key for a moment.
	auto old = fPrivate->byKey.find(KeyOf(item->fType, item->fID));
	if (old != fPrivate->byKey.end() && old->second == item)
		fPrivate->byKey.erase(old);
	item->fType = type;
	item->fID = id;
	fPrivate->byKey[KeyOf(type, id)] = item;
}


void
BResourceCollection::_Register(BResourceAddonBase* user)
{
	std::lock_guard<std::mutex> guard(fPrivate->usersMutex);
	fPrivate->users[user];
}


void
BResourceCollection::_Unregister(BResourceAddonBase* user)
{
	std::lock_guard<std::mutex> guard(fPrivate->usersMutex);
	fPrivate->users.erase(user);
}


void
BResourceCollection::_SetMessenger(BResourceAddonBase* user, const BMessenger& messenger)
{
	std::lock_guard<std::mutex> guard(fPrivate->usersMutex);
	auto found = fPrivate->users.find(user);
	if (found != fPrivate->users.end())
		found->second.messenger = messenger;
}


} // namespace BResEditor
