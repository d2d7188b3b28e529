// FolderDrop: what a file manager does with a drag that ends on one of its folders.
#pragma once

#include <string>

#include "backend/Backend.h"

namespace BPrivate {


// Copies the files that the offer names into the folder, never over an existing one. Returns
// whether there was at least one and all were copied. Display thread: the data is asked for here.
bool drop_on_folder(const DataOffer& offer, const std::string& folder);

// One "file:" address a line; other lines are left out.
std::vector<std::string> paths_of_uri_list(const std::string& list);
std::string uri_of_path(const std::string& path);


} // namespace BPrivate
