// What a file panel lists: the files and folders in a folder.
#pragma once

#include <string>
#include <vector>

#include <StorageDefs.h>
#include <SupportDefs.h>

class BRefFilter;

namespace BPrivate {

struct FolderItem {
	std::string name;
	bool isFolder; // links followed
	bool isLink;
	off_t size; // bytes
	time_t modified;
};

struct FolderRules {
	uint32 flavors = B_FILE_NODE; // folders are listed in any case
	bool hidden = false; // names that begin with a dot
	BRefFilter* filter = nullptr; // borrowed
};

// Folders first, both by name without regard to case. Links that lead nowhere, and what is neither
// file nor folder, are left out.
status_t ReadFolder(
	const std::string& path, const FolderRules& rules, std::vector<FolderItem>* _items);

// When the folder was changed last, to see whether it has to be read again. 0 when it is gone.
bigtime_t FolderChangeTime(const std::string& path);

bool IsFolder(const std::string& path);

// `text` as the user typed it: "~" is the home folder, what does not begin with a slash lies in
// `folder`. The result is absolute and tidy.
std::string ResolveTypedPath(const std::string& text, const std::string& folder);

// What completes the typed text to the name of something in its folder, a folder's name with a
// slash at the end: the rest that is to be added, or "" when nothing begins like it. `listed` is
// what is in the folder itself.
std::string CompletionOf(const std::string& typed, const std::string& folder,
	const std::vector<FolderItem>& listed, const FolderRules& rules);

} // namespace BPrivate
