// LooperTable: all loopers and windows of the program.

#include <algorithm>
#include <unordered_map>
#include <vector>

#include "app/private/LooperCore.h"

namespace BPrivate {


namespace {

struct WindowEntry {
	BLooper* looper;
	BWindow* window;
};

struct Table {
	std::mutex lock;
	std::unordered_map<const BLooper*, std::shared_ptr<LooperCore>> cores;
	std::vector<BLooper*> loopers;
	std::vector<WindowEntry> windows;
};

// Never destroyed: threads may still lock loopers while the program's static objects go.
Table&
TheLoopers()
{
	static Table* table = new Table;
	return *table;
}

} // namespace


void
LooperTable::Add(BLooper* looper, std::shared_ptr<LooperCore> core)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	table.cores[looper] = std::move(core);
	table.loopers.push_back(looper);
}


void
LooperTable::Remove(BLooper* looper)
{
	Table& table = TheLoopers();
	std::shared_ptr<LooperCore> removed; // goes after the lock
	std::lock_guard lock(table.lock);
	if (const auto found = table.cores.find(looper); found != table.cores.end()) {
		removed = std::move(found->second);
		table.cores.erase(found);
	}
	std::erase(table.loopers, looper);
	std::erase_if(table.windows, [&](const WindowEntry& entry) { return entry.looper == looper; });
}


std::shared_ptr<LooperCore>
LooperTable::Find(const BLooper* looper)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	const auto found = table.cores.find(looper);
	return found == table.cores.end() ? nullptr : found->second;
}


BLooper*
LooperTable::FindByThread(thread_id thread)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	for (BLooper* looper : table.loopers) {
		if (table.cores[looper]->Thread() == thread)
			return looper;
	}
	return nullptr;
}


int32
LooperTable::CountLoopers()
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	return int32(table.loopers.size());
}


BLooper*
LooperTable::LooperAt(int32 index)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	return index >= 0 && index < int32(table.loopers.size()) ? table.loopers[index] : nullptr;
}


void
LooperTable::AddWindow(BLooper* looper, BWindow* window)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	const auto known = std::any_of(table.windows.begin(), table.windows.end(),
		[&](const WindowEntry& entry) { return entry.looper == looper; });
	if (!known)
		table.windows.push_back({ looper, window });
}


int32
LooperTable::CountWindows()
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	return int32(table.windows.size());
}


BWindow*
LooperTable::WindowAt(int32 index)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	return index >= 0 && index < int32(table.windows.size()) ? table.windows[index].window
															 : nullptr;
}


BMessenger
LooperTable::WindowMessenger(int32 index)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	if (index < 0 || index >= int32(table.windows.size()))
		return BMessenger();
	return table.cores[table.windows[index].looper]->OwnMessenger();
}


std::shared_ptr<LooperCore>
LooperTable::NextWindow(const std::vector<std::shared_ptr<LooperCore>>& known)
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	for (const WindowEntry& entry : table.windows) {
		const std::shared_ptr<LooperCore>& core = table.cores[entry.looper];
		if (std::find(known.begin(), known.end(), core) == known.end())
			return core;
	}
	return nullptr;
}


std::vector<std::shared_ptr<LooperCore>>
LooperTable::AllWindows()
{
	Table& table = TheLoopers();
	std::lock_guard lock(table.lock);
	std::vector<std::shared_ptr<LooperCore>> windows;
	for (BLooper* looper : table.loopers) {
		const std::shared_ptr<LooperCore>& core = table.cores[looper];
		if (core->IsWindow())
			windows.push_back(core);
	}
	return windows;
}


} // namespace BPrivate
