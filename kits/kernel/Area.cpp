#include <OS.h>

#include <cstring>
#include <memory>
#include <mutex>
#include <string>

#include <sys/mman.h>
#include <unistd.h>

#include "kernel/private/Table.h"

using BPrivate::Table;

namespace {

// The pages of an area and of its clones: a file without a name.
struct Memory {
	int fd;

	~Memory() { close(fd); }
};

struct Area {
	std::string name;
	std::shared_ptr<Memory> memory;
	char* address;
	std::mutex lock; // guards what follows
	size_t size;
	uint32 protection;

	~Area() { munmap(address, size); }
};


Table<Area>&
areas()
{
	static Table<Area>* sAreas = new Table<Area>;
	return *sAreas;
}

int
host_protection(uint32 protection)
{
	return ((protection & B_READ_AREA) != 0 ? PROT_READ : PROT_NONE)
		| ((protection & B_WRITE_AREA) != 0 ? PROT_WRITE : PROT_NONE);
}


area_id
map_area(const char* name, void** _address, uint32 addressSpec, size_t size, uint32 protection,
	std::shared_ptr<Memory> memory)
{
	void* wanted = addressSpec == B_ANY_ADDRESS ? nullptr : *_address;
	const int exact = addressSpec == B_EXACT_ADDRESS ? MAP_FIXED_NOREPLACE : 0;
	void* address =
		mmap(wanted, size, host_protection(protection), MAP_SHARED | exact, memory->fd, 0);
	if (address == MAP_FAILED)
		return B_NO_MEMORY;

	auto area = std::make_shared<Area>();
	area->name = std::string(name != nullptr ? name : "").substr(0, B_OS_NAME_LENGTH - 1);
	area->memory = std::move(memory);
	area->address = static_cast<char*>(address);
	area->size = size;
	area->protection = protection;
	*_address = address;
	return areas().Add(std::move(area));
}

} // namespace


area_id
create_area(const char* name, void** _address, uint32 addressSpec, size_t size, uint32 lock,
	uint32 protection)
{
	if (_address == nullptr || size == 0 || size % B_PAGE_SIZE != 0)
		return B_BAD_VALUE;

	auto memory = std::make_shared<Memory>();
	memory->fd = memfd_create("area", MFD_CLOEXEC);
	if (memory->fd < 0 || ftruncate(memory->fd, static_cast<off_t>(size)) < 0)
		return B_NO_MEMORY;
	return map_area(name, _address, addressSpec, size, protection, std::move(memory));
}


area_id
clone_area(const char* name, void** _address, uint32 addressSpec, uint32 protection, area_id source)
{
	if (_address == nullptr)
		return B_BAD_VALUE;
	std::shared_ptr<Area> area = areas().Get(source);
	if (area == nullptr)
		return B_BAD_VALUE;
	std::unique_lock lock(area->lock);
	return map_area(name, _address, addressSpec, area->size, protection, area->memory);
}


area_id
find_area(const char* name)
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const area_id id = areas().Find([name](const Area& area) { return area.name == name; });
	return id >= 0 ? id : B_NAME_NOT_FOUND;
}


area_id
area_for(void* address)
{
	const char* place = static_cast<const char*>(address);
	const area_id id = areas().Find([place](Area& area) {
		std::unique_lock lock(area.lock);
		return place >= area.address && place < area.address + area.size;
	});
	return id >= 0 ? id : B_ERROR;
}


status_t
delete_area(area_id id)
{
	return areas().Remove(id) != nullptr ? B_OK : B_ERROR;
}


status_t
set_area_protection(area_id id, uint32 protection)
{
	std::shared_ptr<Area> area = areas().Get(id);
	if (area == nullptr)
		return B_BAD_VALUE;
	std::unique_lock lock(area->lock);
	if (mprotect(area->address, area->size, host_protection(protection)) < 0)
		return B_ERROR;
	area->protection = protection;
	return B_OK;
}


status_t
resize_area(area_id id, size_t newSize)
{
	std::shared_ptr<Area> area = areas().Get(id);
	if (area == nullptr || newSize == 0 || newSize % B_PAGE_SIZE != 0)
		return B_BAD_VALUE;
	std::unique_lock lock(area->lock);
	// A clone would find its end cut off.
	if (area->memory.use_count() > 1)
		return B_ERROR;
	if (newSize > area->size && ftruncate(area->memory->fd, static_cast<off_t>(newSize)) < 0)
		return B_NO_MEMORY;
	if (mremap(area->address, area->size, newSize, 0) == MAP_FAILED)
		return B_ERROR;
	// Failing to give pages back costs memory only.
	if (newSize < area->size)
		(void)!ftruncate(area->memory->fd, static_cast<off_t>(newSize));
	area->size = newSize;
	return B_OK;
}


status_t
_get_area_info(area_id id, area_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(area_info))
		return B_BAD_VALUE;
	std::shared_ptr<Area> area = areas().Get(id);
	if (area == nullptr)
		return B_BAD_VALUE;

	memset(info, 0, sizeof(*info));
	std::unique_lock lock(area->lock);
	info->area = id;
	strncpy(info->name, area->name.c_str(), B_OS_NAME_LENGTH - 1);
	info->size = area->size;
	info->protection = area->protection;
	info->team = getpid();
	info->ram_size = static_cast<uint32>(area->size);
	info->address = area->address;
	return B_OK;
}


status_t
_get_next_area_info(team_id team, ssize_t* cookie, area_info* info, size_t size)
{
	if (cookie == nullptr)
		return B_BAD_VALUE;
	int32 last = static_cast<int32>(*cookie);
	const status_t status = BPrivate::NextInfo(areas(), team, &last, info, size, _get_area_info);
	*cookie = last;
	return status;
}
