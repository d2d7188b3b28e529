#include <ResourceForm.h>

#include <bit>
#include <string>

#include <DataIO.h>
#include <Resources.h>

#include "storage/private/ResourceFormat.h"
#include "storage/private/ResourceReader.h"

using namespace BPrivate;


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
	std::string bytes;
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
		if (!readable->HasResource(item->type, item->id))
			readable->AddResource(item->type, item->id, bytes.data(), bytes.size(),
				item->named ? item->name.c_str() : NULL);
	}
	return status;
}
