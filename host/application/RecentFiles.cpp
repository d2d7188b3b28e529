#include "host/application/RecentFiles.h"

#include <algorithm>
#include <mutex>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <FindDirectory.h>
#include <Message.h>
#include <Path.h>

#include "host/application/ReplaceFile.h"

namespace {


constexpr size_t kCount = 10;
std::mutex sLock; // between the windows of this program


BPath
SettingsFolder()
{
	BPath path;
	find_directory(B_USER_SETTINGS_DIRECTORY, &path);
	return path;
}


BPath
SettingsFile()
{
	return BPath(SettingsFolder().Path(), "recent-files");
}


std::vector<std::string>
Read()
{
	std::vector<std::string> paths;
	BFile file(SettingsFile().Path(), B_READ_ONLY);
	BMessage settings;
	if (settings.Unflatten(&file) != B_OK)
		return paths;
	const char* path;
	for (int32 i = 0; settings.FindString("path", i, &path) == B_OK; i++)
		paths.emplace_back(path);
	return paths;
}


void
Write(const std::vector<std::string>& paths)
{
	BMessage settings;
	for (const std::string& path : paths)
		settings.AddString("path", path.c_str());
	std::vector<char> bytes(static_cast<size_t>(settings.FlattenedSize()));
	if (settings.Flatten(bytes.data(), static_cast<ssize_t>(bytes.size())) == B_OK
		&& create_directory(SettingsFolder().Path(), 0755) == B_OK)
		ReplaceFile(SettingsFile().Path(), bytes.data(), bytes.size());
}


} // namespace


void
RecentFiles::Add(const std::string& path)
{
	const std::lock_guard guard(sLock);
	std::vector<std::string> paths = Read();
	std::erase(paths, path);
	paths.insert(paths.begin(), path);
	paths.resize(std::min(paths.size(), kCount));
	Write(paths);
}


std::vector<std::string>
RecentFiles::Paths()
{
	const std::lock_guard guard(sLock);
	std::vector<std::string> paths = Read();
	std::erase_if(paths, [](const std::string& path) { return !BEntry(path.c_str()).Exists(); });
	return paths;
}
