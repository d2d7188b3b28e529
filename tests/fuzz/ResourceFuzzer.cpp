// Any bytes as a resource file.

#include <stdlib.h>
#include <string.h>

#include <DataIO.h>
#include <ResourceForm.h>
#include <Resources.h>

#include "storage/private/ResourceReader.h"

namespace {

void
Require(bool condition)
{
	if (!condition)
		abort();
}

} // namespace


extern "C" int
LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
	BMemoryIO strictFile(static_cast<const void*>(data), size);
	BPrivate::ResourceReader strict(strictFile, false);
	const status_t status = strict.Read();
	size_t total = 0;
	for (const auto& item : strict.Items()) {
		if (status == B_OK) {
			Require(item->offset >= 0 && item->offset + item->size <= size);
			total += item->size;
		}
	}
	Require(total <= 2 * size);

	// A tolerant reading answers the same, and never stands on bytes that are not there.
	BMemoryIO tolerantFile(static_cast<const void*>(data), size);
	std::vector<resource_place> places;
	std::vector<resource_damage> damages;
	BResources readable;
	Require(examine_resource_file(&tolerantFile, NULL, &places, &damages, &readable) == status);
	Require((status == B_OK) == damages.empty());
	if (status == B_OK)
		Require(places.size() == strict.Items().size());

	type_code type;
	int32 id;
	const char* name;
	size_t length;
	for (int32 i = 0; readable.GetResourceInfo(i, &type, &id, &name, &length); i++) {
		size_t loaded = 0;
		Require(readable.LoadResource(type, id, &loaded) != NULL && loaded == length);
	}
	return 0;
}
