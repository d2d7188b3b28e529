#include "storage/private/MimeSettings.h"

#include <errno.h>
#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <mutex>
#include <vector>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <FindDirectory.h>
#include <Path.h>

#include "storage/private/AtomicFile.h"
#include "storage/private/Descriptor.h"
#include "storage/private/Errno.h"
#include "storage/private/MimeIndex.h"
#include "storage/private/MimeWatchers.h"

namespace BPrivate {

namespace {

constexpr off_t kLargestSettings = 1024 * 1024;

std::mutex sSettingsLock; // a change is read, changed and written back


// The type's slash would make a folder, so another character stands for it; types have none.
status_t
PathFor(const std::string& type, bool create, BPath* _path)
{
	status_t status = find_directory(B_USER_SETTINGS_DIRECTORY, _path, create);
	if (status == B_OK)
		status = _path->Append("mime");
	if (status == B_OK && create)
		status = create_directory(_path->Path(), 0755);
	std::string leaf = type;
	const size_t slash = leaf.find('/');
	if (slash != std::string::npos)
		leaf[slash] = ',';
	if (status == B_OK && !leaf.empty())
		status = _path->Append(leaf.c_str());
	return status;
}


// While it lives no other thread and no other program changes settings. Where the folder cannot be
// locked, as on some file systems of other machines, only threads wait.
class SettingsLock {
public:
	explicit SettingsLock(bool createFolder) : fGuard(sSettingsLock), fFolder(-1)
	{
		BPath path;
		if (PathFor("", createFolder, &path) == B_OK)
			fFolder = OpenAt(AT_FDCWD, path.Path(), O_RDONLY | O_DIRECTORY);
		if (fFolder < 0)
			return;
		while (flock(fFolder, LOCK_EX) < 0 && errno == EINTR) {
		}
	}

	~SettingsLock()
	{
		if (fFolder >= 0)
			close(fFolder);
	}

private:
	SettingsLock(const SettingsLock&);
	SettingsLock& operator=(const SettingsLock&);

	std::lock_guard<std::mutex> fGuard;
	int fFolder; // open as long as it is locked
};

} // namespace


std::string
MimeSettingsFolder()
{
	BPath path;
	return PathFor("", false, &path) == B_OK ? path.Path() : "";
}


status_t
ReadMimeSettings(const std::string& type, BMessage* _settings)
{
	BPath path;
	status_t status = PathFor(type, false, &path);
	if (status != B_OK)
		return status;
	BFile file(path.Path(), B_READ_ONLY);
	off_t size = 0;
	status = file.GetSize(&size);
	if (status != B_OK)
		return status;
	if (size > kLargestSettings)
		return B_BAD_DATA;
	return _settings->Unflatten(&file);
}


status_t
WriteMimeSettings(const std::string& type, const BMessage& settings)
{
	BPath path;
	status_t status = PathFor(type, true, &path);
	if (status != B_OK)
		return status;
	std::vector<char> bytes(settings.FlattenedSize());
	status = settings.Flatten(bytes.data(), bytes.size());
	AtomicFile file;
	if (status == B_OK)
		status = file.SetTo(path.Path());
	if (status == B_OK)
		status = file.Write(bytes.data(), bytes.size());
	if (status == B_OK)
		status = file.Commit();
	MimeIndex::Forget();
	MimeWatchers::Get().Check(type);
	return status;
}


status_t
RemoveMimeSettings(const std::string& type)
{
	const SettingsLock lock(false);
	BPath path;
	const status_t status = PathFor(type, false, &path);
	if (status != B_OK)
		return status;
	const status_t removed = unlink(path.Path()) < 0 ? LastStatus() : B_OK;
	MimeIndex::Forget();
	MimeWatchers::Get().Check(type);
	return removed;
}


std::set<std::string>
TypesWithMimeSettings()
{
	std::set<std::string> types;
	BPath path;
	if (PathFor("", false, &path) != B_OK)
		return types;
	BDirectory directory(path.Path());
	entry_ref ref;
	while (directory.GetNextRef(&ref) == B_OK) {
		const std::string type = TypeOfMimeSettings(ref.name);
		if (!type.empty())
			types.insert(type);
	}
	return types;
}


// One that begins with a dot is just being written.
std::string
TypeOfMimeSettings(const std::string& leaf)
{
	std::string type = leaf[0] == '.' ? std::string() : leaf;
	const size_t comma = type.find(',');
	if (comma != std::string::npos)
		type[comma] = '/';
	return type;
}


std::string
LowerCaseType(const char* type)
{
	std::string lower(type);
	for (char& character : lower) {
		if (character >= 'A' && character <= 'Z')
			character += 'a' - 'A';
	}
	return lower;
}


BMessage
MimeSettingsOf(const char* type)
{
	BMessage settings;
	if (ReadMimeSettings(LowerCaseType(type), &settings) != B_OK)
		settings.MakeEmpty();
	return settings;
}


status_t
ChangeMimeSettings(const char* type, const std::function<status_t(BMessage& settings)>& change)
{
	const SettingsLock lock(true);
	BMessage settings = MimeSettingsOf(type);
	const status_t status = change(settings);
	return status == B_OK ? WriteMimeSettings(LowerCaseType(type), settings) : status;
}

} // namespace BPrivate
