// The folders that file panels offer in their menu.
#pragma once

#include <string>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {

struct KnownPlace {
	std::string label;
	std::string path;
	char shortcut; // or 0
};

// Home, desktop and so on, as far as they exist.
std::vector<KnownPlace> KnownPlaces();

// The user's own favourites, one path a line in a file of the user's settings, shared by all
// programs. They are read anew each time; folders that are gone are left out but kept in the file.
std::vector<std::string> FavoriteFolders();
status_t AddFavoriteFolder(const std::string& path);
status_t RemoveFavoriteFolder(const std::string& path);

} // namespace BPrivate
