#include "app/private/Port.h"

#include <mutex>
#include <unordered_map>

#include <Message.h>

namespace BPrivate {
namespace {

struct Table {
	std::mutex lock;
	std::unordered_map<int32, std::shared_ptr<Port>> ports;
	int32 nextId = 1;
};

// Never destroyed: threads may still send while the program's static objects go.
Table&
ThePorts()
{
	static Table* table = new Table;
	return *table;
}

} // namespace


int32
PortTable::Add(std::shared_ptr<Port> port)
{
	Table& table = ThePorts();
	std::lock_guard lock(table.lock);
	while (!table.ports.try_emplace(table.nextId, port).second)
		table.nextId = table.nextId == INT32_MAX ? 1 : table.nextId + 1;

	const int32 id = table.nextId;
	table.nextId = id == INT32_MAX ? 1 : id + 1;
	return id;
}


void
PortTable::Remove(int32 id)
{
	Table& table = ThePorts();
	std::shared_ptr<Port> removed; // goes after the lock
	std::lock_guard lock(table.lock);
	if (const auto found = table.ports.find(id); found != table.ports.end()) {
		removed = std::move(found->second);
		table.ports.erase(found);
	}
}


std::shared_ptr<Port>
PortTable::Find(int32 id)
{
	Table& table = ThePorts();
	std::lock_guard lock(table.lock);
	const auto found = table.ports.find(id);
	return found == table.ports.end() ? nullptr : found->second;
}


} // namespace BPrivate
