#include "storage/private/FolderContents.h"

#include <strings.h>
#include <sys/stat.h>

#include <algorithm>

#include <Directory.h>
#include <Entry.h>
#include <FilePanel.h>
#include <FindDirectory.h>
#include <Mime.h>
#include <Node.h>
#include <NodeInfo.h>
#include <Path.h>

namespace BPrivate {

namespace {


bool
ComesBefore(const FolderItem& a, const FolderItem& b)
{
	if (a.isFolder != b.isFolder)
		return a.isFolder;
	const int order = strcasecmp(a.name.c_str(), b.name.c_str());
	return order != 0 ? order < 0 : a.name < b.name;
}


bool
PassesFilter(const entry_ref& ref, struct stat& stat, BRefFilter* filter)
{
	if (filter == nullptr)
		return true;

	BNode node(&ref);
	char type[B_MIME_TYPE_LENGTH + 1] = "";
	if (BNodeInfo(&node).GetType(type) != B_OK)
		type[0] = '\0';
	return filter->Filter(&ref, &node, &stat, type);
}


bool
ReadItem(
	const BDirectory& folder, const entry_ref& ref, const FolderRules& rules, FolderItem* _item)
{
	struct stat stat;
	if ((!rules.hidden && ref.name[0] == '.') || folder.GetStatFor(ref.name, &stat) != B_OK)
		return false;

	_item->isLink = S_ISLNK(stat.st_mode);
	if (_item->isLink && BEntry(&ref, true).GetStat(&stat) != B_OK)
		return false;
	_item->isFolder = S_ISDIR(stat.st_mode);
	const uint32 wanted = _item->isLink ? B_FILE_NODE | B_SYMLINK_NODE : B_FILE_NODE;
	if (!_item->isFolder && (!S_ISREG(stat.st_mode) || (rules.flavors & wanted) == 0))
		return false;

	_item->name = ref.name;
	_item->size = stat.st_size;
	_item->modified = stat.st_mtime;
	return PassesFilter(ref, stat, rules.filter);
}


std::string
HomeFolder()
{
	BPath path;
	return find_directory(B_USER_DIRECTORY, &path) == B_OK ? path.Path() : "/";
}


bool
BeginsWith(const std::string& text, const std::string& beginning)
{
	return text.compare(0, beginning.size(), beginning) == 0;
}


} // namespace


status_t
ReadFolder(const std::string& path, const FolderRules& rules, std::vector<FolderItem>* _items)
{
	_items->clear();
	BDirectory folder(path.c_str());
	status_t status = folder.InitCheck();
	entry_ref ref;
	while (status == B_OK && (status = folder.GetNextRef(&ref)) == B_OK) {
		FolderItem item;
		if (ReadItem(folder, ref, rules, &item))
			_items->push_back(std::move(item));
	}
	std::sort(_items->begin(), _items->end(), ComesBefore);
	return status == B_ENTRY_NOT_FOUND && folder.InitCheck() == B_OK ? B_OK : status;
}


bigtime_t
FolderChangeTime(const std::string& path)
{
	struct stat stat;
	if (::stat(path.c_str(), &stat) != 0)
		return 0;
	return static_cast<bigtime_t>(stat.st_mtim.tv_sec) * 1000000 + stat.st_mtim.tv_nsec / 1000;
}


bool
IsFolder(const std::string& path)
{
	struct stat stat;
	return ::stat(path.c_str(), &stat) == 0 && S_ISDIR(stat.st_mode);
}


std::string
ResolveTypedPath(const std::string& text, const std::string& folder)
{
	std::string path = text;
	if (path == "~" || BeginsWith(path, "~/"))
		path = HomeFolder() + path.substr(1);
	else if (!BeginsWith(path, "/"))
		path = folder + "/" + path;
	const BPath tidy(path.c_str());
	return tidy.InitCheck() == B_OK ? tidy.Path() : path;
}


std::string
CompletionOf(const std::string& typed, const std::string& folder,
	const std::vector<FolderItem>& listed, const FolderRules& rules)
{
	const size_t slash = typed.rfind('/');
	const std::string beginning = slash == std::string::npos ? typed : typed.substr(slash + 1);
	if (beginning.empty())
		return "";

	std::vector<FolderItem> others;
	const std::vector<FolderItem>* items = &listed;
	if (slash != std::string::npos) {
		FolderRules deeper = rules;
		deeper.hidden = beginning[0] == '.';
		ReadFolder(ResolveTypedPath(typed.substr(0, slash + 1), folder), deeper, &others);
		items = &others;
	}
	for (const FolderItem& item : *items) {
		if (BeginsWith(item.name, beginning))
			return item.name.substr(beginning.size()) + (item.isFolder ? "/" : "");
	}
	return "";
}

} // namespace BPrivate
