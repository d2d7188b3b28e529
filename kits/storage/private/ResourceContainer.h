// Where in a file the resource section lies.
#pragma once

#include <vector>

#include <ResourceForm.h>
#include <SupportDefs.h>

class BPositionIO;

namespace BPrivate {

struct ResourceDamageReport {
	std::vector<resource_damage> damages;

	// Notes a damage for which the file is refused, and returns the status for it.
	status_t Refuse(off_t offset, const char* reason, status_t status);
};

// Finds out the file's kind by its first bytes. For B_NO_RESOURCE_FILE the status says why.
status_t FindResourceSection(
	BPositionIO& file, off_t fileSize, resource_file_info* _info, ResourceDamageReport& report);

} // namespace BPrivate
