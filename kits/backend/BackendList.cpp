#include <cstdio>
#include <cstdlib>
#include <string>

#include "backend/Backend.h"

namespace BPrivate {

namespace {

bool
HasDisplay()
{
	for (const char* name : { "DISPLAY", "WAYLAND_DISPLAY" }) {
		const char* value = std::getenv(name);
		if (value != nullptr && value[0] != '\0')
			return true;
	}
	return false;
}

} // namespace


std::unique_ptr<Backend>
make_backend()
{
	const char* variable = std::getenv("ARCHWAY_BACKEND");
	const std::string name = variable != nullptr ? variable : "";
	if (name == "headless")
		return make_headless_backend();
	if (name == "qt")
		return make_qt_backend();
	if (!name.empty()) {
		std::fprintf(
			stderr, "ARCHWAY_BACKEND=%s: there is a headless and a qt backend\n", name.c_str());
		return nullptr;
	}
	if (HasDisplay())
		return make_qt_backend();

	std::fprintf(stderr, "No display found; windows are kept in memory only.\n");
	return make_headless_backend();
}


} // namespace BPrivate
