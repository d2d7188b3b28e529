#include <OS.h>

#include <condition_variable>
#include <cstring>
#include <deque>
#include <mutex>
#include <string>
#include <vector>

#include <unistd.h>

#include "kernel/private/Deadline.h"
#include "kernel/private/Table.h"

using BPrivate::Deadline;
using BPrivate::Table;

namespace {

constexpr int32 kMaxCapacity = 4096;
constexpr size_t kMaxMessageSize = 256 * 1024;

struct PortMessage {
	int32 code;
	std::vector<char> data;
};

struct Port {
	std::mutex lock;
	std::condition_variable changed;
	std::string name;
	size_t capacity;
	bool closed = false;
	bool deleted = false;
	int32 written = 0;
	std::deque<PortMessage> messages;
};


Table<Port>&
ports()
{
	static Table<Port>* sPorts = new Table<Port>;
	return *sPorts;
}


// Waits until a message is there. The lock is held.
status_t
wait_for_message(Port& port, std::unique_lock<std::mutex>& lock, uint32 flags, bigtime_t timeout)
{
	const Deadline deadline(flags, timeout);
	const bool inTime = deadline.Wait(
		port.changed, lock, [&] { return port.deleted || port.closed || !port.messages.empty(); });
	if (port.deleted || (port.closed && port.messages.empty()))
		return B_BAD_PORT_ID;
	return inTime ? B_OK : deadline.Error();
}

} // namespace


port_id
create_port(int32 capacity, const char* name)
{
	if (capacity < 1 || capacity > kMaxCapacity)
		return B_BAD_VALUE;
	auto port = std::make_shared<Port>();
	port->capacity = static_cast<size_t>(capacity);
	port->name = std::string(name != nullptr ? name : "").substr(0, B_OS_NAME_LENGTH - 1);
	return ports().Add(std::move(port));
}


port_id
find_port(const char* name)
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const port_id id = ports().Find([name](Port& port) { return port.name == name; });
	return id >= 0 ? id : B_NAME_NOT_FOUND;
}


status_t
close_port(port_id id)
{
	std::shared_ptr<Port> port = ports().Get(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;
	std::unique_lock lock(port->lock);
	port->closed = true;
	port->changed.notify_all();
	return B_OK;
}


status_t
delete_port(port_id id)
{
	std::shared_ptr<Port> port = ports().Remove(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;
	std::unique_lock lock(port->lock);
	port->deleted = true;
	port->changed.notify_all();
	return B_OK;
}


status_t
write_port(port_id id, int32 code, const void* buffer, size_t bufferSize)
{
	return write_port_etc(id, code, buffer, bufferSize, 0, 0);
}


status_t
write_port_etc(
	port_id id, int32 code, const void* buffer, size_t bufferSize, uint32 flags, bigtime_t timeout)
{
	if (bufferSize > kMaxMessageSize || (buffer == nullptr && bufferSize > 0))
		return B_BAD_VALUE;
	std::shared_ptr<Port> port = ports().Get(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;

	const Deadline deadline(flags, timeout);
	std::unique_lock lock(port->lock);
	const bool inTime = deadline.Wait(port->changed, lock,
		[&] { return port->deleted || port->closed || port->messages.size() < port->capacity; });
	if (port->deleted || port->closed)
		return B_BAD_PORT_ID;
	if (!inTime)
		return deadline.Error();

	const char* bytes = static_cast<const char*>(buffer);
	port->messages.push_back({ code, std::vector<char>(bytes, bytes + bufferSize) });
	port->written++;
	port->changed.notify_all();
	return B_OK;
}


ssize_t
read_port(port_id id, int32* _code, void* buffer, size_t bufferSize)
{
	return read_port_etc(id, _code, buffer, bufferSize, 0, 0);
}


ssize_t
read_port_etc(
	port_id id, int32* _code, void* buffer, size_t bufferSize, uint32 flags, bigtime_t timeout)
{
	if (buffer == nullptr && bufferSize > 0)
		return B_BAD_VALUE;
	std::shared_ptr<Port> port = ports().Get(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;

	std::unique_lock lock(port->lock);
	const status_t status = wait_for_message(*port, lock, flags, timeout);
	if (status != B_OK)
		return status;

	const PortMessage message = std::move(port->messages.front());
	port->messages.pop_front();
	port->changed.notify_all();
	const size_t size = min_c(bufferSize, message.data.size());
	if (size > 0)
		memcpy(buffer, message.data.data(), size);
	if (_code != nullptr)
		*_code = message.code;
	return static_cast<ssize_t>(size);
}


ssize_t
port_buffer_size(port_id id)
{
	return port_buffer_size_etc(id, 0, 0);
}


ssize_t
port_buffer_size_etc(port_id id, uint32 flags, bigtime_t timeout)
{
	std::shared_ptr<Port> port = ports().Get(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;
	std::unique_lock lock(port->lock);
	const status_t status = wait_for_message(*port, lock, flags, timeout);
	if (status != B_OK)
		return status;
	return static_cast<ssize_t>(port->messages.front().data.size());
}


ssize_t
port_count(port_id id)
{
	std::shared_ptr<Port> port = ports().Get(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;
	std::unique_lock lock(port->lock);
	return static_cast<ssize_t>(port->messages.size());
}


status_t
set_port_owner(port_id id, team_id team)
{
	if (ports().Get(id) == nullptr)
		return B_BAD_PORT_ID;
	return BPrivate::IsOwnTeam(team) ? B_OK : B_BAD_TEAM_ID;
}


status_t
_get_port_info(port_id id, port_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(port_info))
		return B_BAD_VALUE;
	std::shared_ptr<Port> port = ports().Get(id);
	if (port == nullptr)
		return B_BAD_PORT_ID;

	memset(info, 0, sizeof(*info));
	std::unique_lock lock(port->lock);
	info->port = id;
	info->team = getpid();
	strncpy(info->name, port->name.c_str(), B_OS_NAME_LENGTH - 1);
	info->capacity = static_cast<int32>(port->capacity);
	info->queue_count = static_cast<int32>(port->messages.size());
	info->total_count = port->written;
	return B_OK;
}


status_t
_get_next_port_info(team_id team, int32* cookie, port_info* info, size_t size)
{
	return BPrivate::NextInfo(ports(), team, cookie, info, size, _get_port_info);
}
