// entry_ref: a place in a folder.

#include <Entry.h>

#include <errno.h>
#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <string>
#include <tuple>
#include <utility>

#include <Directory.h>
#include <Errors.h>
#include <Path.h>

#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/KnownDirectories.h"
#include "storage/private/SetStat.h"

using namespace BPrivate;


entry_ref::entry_ref() : device(static_cast<dev_t>(-1)), directory(0), name(NULL)
{
}


entry_ref::entry_ref(dev_t device, ino_t directory, const char* name) :
	device(device), directory(directory), name(NULL)
{
	set_name(name);
}


entry_ref::entry_ref(const entry_ref& other) :
	device(other.device), directory(other.directory), name(NULL)
{
	set_name(other.name);
}


entry_ref::entry_ref(entry_ref&& other) noexcept :
	device(other.device), directory(other.directory), name(std::exchange(other.name, nullptr))
{
}


entry_ref::~entry_ref()
{
	free(name);
}


status_t
entry_ref::set_name(const char* newName)
{
	char* copy = NULL;
	if (newName != NULL) {
		copy = strdup(newName);
		if (copy == NULL)
			return B_NO_MEMORY;
	}
	free(name);
	name = copy;
	return B_OK;
}


bool
entry_ref::operator==(const entry_ref& other) const
{
	if (device != other.device || directory != other.directory)
		return false;
	if (name == NULL || other.name == NULL)
		return name == other.name;
	return strcmp(name, other.name) == 0;
}


bool
entry_ref::operator!=(const entry_ref& other) const
{
	return !(*this == other);
}


entry_ref&
entry_ref::operator=(const entry_ref& other)
{
	if (this != &other) {
		device = other.device;
		directory = other.directory;
		set_name(other.name);
	}
	return *this;
}


entry_ref&
entry_ref::operator=(entry_ref&& other) noexcept
{
	device = other.device;
	directory = other.directory;
	std::swap(name, other.name);
	return *this;
}


bool
operator<(const entry_ref& a, const entry_ref& b)
{
	const auto place = std::tie(a.device, a.directory);
	const auto otherPlace = std::tie(b.device, b.directory);
	if (place != otherPlace)
		return place < otherPlace;
	if (a.name == NULL || b.name == NULL)
		return a.name == NULL && b.name != NULL;
	return strcmp(a.name, b.name) < 0;
}


status_t
get_ref_for_path(const char* path, entry_ref* _ref)
{
	if (path == NULL || _ref == NULL)
		return B_BAD_VALUE;
	const BEntry entry(path);
	return entry.GetRef(_ref);
}
