#include <OS.h>

#include <cstring>
#include <string>

#include <sys/mman.h>
#include <unistd.h>

#include "kernel/private/Table.h"

using BPrivate::Table;

namespace {

struct Area {
	std::string name;
	char* address;
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

} // namespace


area_id
create_area(const char* name, void** _address, uint32 addressSpec, size_t size, uint32 lock,
	uint32 protection)
{
	if (_address == nullptr || size == 0 || size % B_PAGE_SIZE != 0)
		return B_BAD_VALUE;

	const int access = ((protection & B_READ_AREA) != 0 ? PROT_READ : PROT_NONE)
		| ((protection & B_WRITE_AREA) != 0 ? PROT_WRITE : PROT_NONE);
	void* wanted = addressSpec == B_ANY_ADDRESS ? nullptr : *_address;
	const int exact = addressSpec == B_EXACT_ADDRESS ? MAP_FIXED_NOREPLACE : 0;
	void* address = mmap(wanted, size, access, MAP_PRIVATE | MAP_ANONYMOUS | exact, -1, 0);
	if (address == MAP_FAILED)
		return B_NO_MEMORY;

	auto area = std::make_shared<Area>();
	area->name = std::string(name != nullptr ? name : "").substr(0, B_OS_NAME_LENGTH - 1);
	area->address = static_cast<char*>(address);
	area->size = size;
	area->protection = protection;
	*_address = address;
	return areas().Add(std::move(area));
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
	const area_id id = areas().Find([place](const Area& area) {
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
_get_area_info(area_id id, area_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(area_info))
		return B_BAD_VALUE;
	std::shared_ptr<Area> area = areas().Get(id);
	if (area == nullptr)
		return B_BAD_VALUE;

	memset(info, 0, sizeof(*info));
	info->area = id;
	strncpy(info->name, area->name.c_str(), B_OS_NAME_LENGTH - 1);
	info->size = area->size;
	info->protection = area->protection;
	info->team = getpid();
	info->address = area->address;
	return B_OK;
}
