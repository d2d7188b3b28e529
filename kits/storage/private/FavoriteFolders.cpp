#include "storage/private/FavoriteFolders.h"

#include <algorithm>

#include <File.h>
#include <FindDirectory.h>
#include <Path.h>

#include "storage/private/AtomicFile.h"
#include "storage/private/FolderContents.h"

namespace BPrivate {

namespace {


constexpr const char* kFileName = "favorite-folders";
constexpr off_t kLargestFile = 64 * 1024;


status_t
GetFilePath(bool create, BPath* _path)
{
	const status_t status = find_directory(B_USER_SETTINGS_DIRECTORY, _path, create);
	return status == B_OK ? _path->Append(kFileName) : status;
}


std::vector<std::string>
ReadLines()
{
	std::vector<std::string> lines;
	BPath path;
	if (GetFilePath(false, &path) != B_OK)
		return lines;
	BFile file(path.Path(), B_READ_ONLY);
	off_t size = 0;
	if (file.InitCheck() != B_OK || file.GetSize(&size) != B_OK || size > kLargestFile)
		return lines;

	std::string text(static_cast<size_t>(size), '\0');
	const ssize_t read = file.Read(text.data(), text.size());
	text.resize(static_cast<size_t>(std::max<ssize_t>(read, 0)));
	for (size_t start = 0; start < text.size();) {
		const size_t end = std::min(text.find('\n', start), text.size());
		if (text[start] == '/')
			lines.push_back(text.substr(start, end - start));
		start = end + 1;
	}
	return lines;
}


status_t
WriteLines(const std::vector<std::string>& lines)
{
	BPath path;
	status_t status = GetFilePath(true, &path);
	AtomicFile file;
	if (status == B_OK)
		status = file.SetTo(path.Path());
	for (const std::string& line : lines) {
		if (status == B_OK)
			status = file.Write((line + "\n").data(), line.size() + 1);
	}
	return status == B_OK ? file.Commit() : status;
}


} // namespace


std::vector<KnownPlace>
KnownPlaces()
{
	struct Named {
		directory_which which;
		const char* label;
		char shortcut;
	};
	const Named kNamed[] = { { B_USER_DIRECTORY, "Home", 'H' },
		{ B_DESKTOP_DIRECTORY, "Desktop", 'D' },
		{ B_COMMON_TEMP_DIRECTORY, "Temporary files", 0 } };

	std::vector<KnownPlace> places;
	BPath path;
	for (const Named& named : kNamed) {
		if (find_directory(named.which, &path) == B_OK && IsFolder(path.Path()))
			places.push_back({ named.label, path.Path(), named.shortcut });
	}
	if (find_directory(B_USER_DIRECTORY, &path) == B_OK) {
		for (const char* name : { "Documents", "Downloads" }) {
			const BPath place(path.Path(), name);
			if (IsFolder(place.Path()))
				places.push_back({ name, place.Path(), 0 });
		}
	}
	places.push_back({ "All files", "/", 0 });
	return places;
}


std::vector<std::string>
FavoriteFolders()
{
	std::vector<std::string> folders = ReadLines();
	std::erase_if(folders, [](const std::string& path) { return !IsFolder(path); });
	return folders;
}


status_t
AddFavoriteFolder(const std::string& path)
{
	if (path.find('\n') != std::string::npos)
		return B_BAD_VALUE;
	std::vector<std::string> lines = ReadLines();
	if (std::find(lines.begin(), lines.end(), path) != lines.end())
		return B_OK;
	lines.push_back(path);
	return WriteLines(lines);
}


status_t
RemoveFavoriteFolder(const std::string& path)
{
	std::vector<std::string> lines = ReadLines();
	return std::erase(lines, path) > 0 ? WriteLines(lines) : B_OK;
}

} // namespace BPrivate
