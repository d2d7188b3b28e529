// Changing a resource file, or a copy of it.
#pragma once

#include <functional>
#include <string>

#include <Resources.h>

namespace Arcv {

using ResourceChange = std::function<int(BResources& resources)>;

// Lets `change` work on the resources of `file`, and saves. With an output the file stays as it is
// and the output becomes the changed one. A missing file counts as an empty one if `create` is
// set. Returns an exit status: that of `change`, which must have changed nothing unless it is fine,
// or kUnreadable after a complaint.
int EditFile(
	const std::string& file, const std::string& output, bool create, const ResourceChange& change);

} // namespace Arcv
