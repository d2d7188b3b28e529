#include <ResourceForm.h>

#include <bit>
#include <map>
#include <string>
#include <utility>

#include <DataIO.h>
#include <Resources.h>

#include "storage/private/ResourceFormat.h"
#include "storage/private/ResourceReader.h"

using namespace BPrivate;

namespace {

// For a type and id that is taken, the first id behind it that may be free.
typedef std::map<std::pair<type_code, int32>, int32> FreeIds;


int32
FreeId(BResources& resources, type_code type, int32 id, FreeIds& freeIds)
{
	if (!resources.HasResource(type, id))
		return id;
	int32& next = freeIds.emplace(std::pair(type, id), id).first->second;
	do {
		next = static_cast<int32>(static_cast<uint32>(next) + 1);
	} while (resources.HasResource(type, next));
	return next;
}

} // namespace


status_t
examine_resource_file(BPositionIO* file, resource_file_info* _info,
	std::vector<resource_place>* _places, std::vector<resource_damage>* _damages,
	BResources* readable)
{
	if (file == NULL)
		return B_BAD_VALUE;
	ResourceReader reader(*file, true);
	const status_t status = reader.Read();
	if (_info != NULL)
		*_info = reader.Info();
	if (_damages != NULL)
		*_damages = std::move(reader.Damages());

	const bool swapped = reader.Info().big_endian != (std::endian::native == std::endian::big);
	if (_places != NULL)
		_places->reserve(_places->size() + reader.Items().size());
	std::string bytes;
	FreeIds freeIds;
	for (const auto& item : reader.Items()) {
		if (_places != NULL)
			_places->push_back(
				{ item->type, item->id, item->name.c_str(), item->offset, item->size });
		if (readable == NULL || item->offset + static_cast<off_t>(item->size) > reader.FileSize())
			continue;
		bytes.resize(item->size);
		const ssize_t read = file->ReadAt(item->offset, bytes.data(), bytes.size());
		if (read != static_cast<ssize_t>(item->size))
			continue;
		if (swapped)
			SwapResource(item->type, bytes.data(), bytes.size());
		const int32 id = FreeId(*readable, item->type, item->id, freeIds);
		readable->AddResource(
			item->type, id, bytes.data(), bytes.size(), item->named ? item->name.c_str() : NULL);
	}
	return status;
}
