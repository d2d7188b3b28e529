#include <FindDirectory.h>

#include <pwd.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <string>

#include <Directory.h>
#include <Errors.h>
#include <Path.h>
#include <Volume.h>

namespace {

std::string
Home()
{
	const char* home = getenv("HOME");
	if (home != NULL && home[0] == '/')
		return home;
	const struct passwd* user = getpwuid(getuid());
	return user != NULL && user->pw_dir != NULL ? user->pw_dir : "/";
}


// A relative path in one of these variables is to be ignored.
std::string
UserFolder(const char* variable, const char* folder)
{
	const char* value = getenv(variable);
	return value != NULL && value[0] == '/' ? value : Home() + folder;
}


std::string
TemporaryFolder()
{
	const char* value = getenv("TMPDIR");
	return value != NULL && value[0] == '/' ? value : "/tmp";
}


// Empty for what this system does not have.
std::string
FolderOf(directory_which which)
{
	const std::string data = UserFolder("XDG_DATA_HOME", "/.local/share");
	switch (which) {
		case B_DESKTOP_DIRECTORY:
			return UserFolder("XDG_DESKTOP_DIR", "/Desktop");
		case B_TRASH_DIRECTORY:
			return data + "/Trash/files";

		case B_BEOS_DIRECTORY:
		case B_BEOS_SYSTEM_DIRECTORY:
			return "/usr";
		case B_BEOS_ADDONS_DIRECTORY:
			return "/usr/lib/archway/add-ons";
		case B_BEOS_BOOT_DIRECTORY:
			return "/boot";
		case B_BEOS_FONTS_DIRECTORY:
			return "/usr/share/fonts";
		case B_BEOS_LIB_DIRECTORY:
			return "/usr/lib";
		case B_BEOS_SERVERS_DIRECTORY:
			return "/usr/libexec";
		case B_BEOS_APPS_DIRECTORY:
		case B_BEOS_BIN_DIRECTORY:
		case B_APPS_DIRECTORY:
		case B_PREFERENCES_DIRECTORY:
		case B_UTILITIES_DIRECTORY:
			return "/usr/bin";
		case B_BEOS_ETC_DIRECTORY:
		case B_COMMON_ETC_DIRECTORY:
		case B_COMMON_SETTINGS_DIRECTORY:
			return "/etc";
		case B_BEOS_DOCUMENTATION_DIRECTORY:
			return "/usr/share/doc";
		case B_BEOS_SOUNDS_DIRECTORY:
		case B_COMMON_SOUNDS_DIRECTORY:
			return "/usr/share/sounds";

		case B_COMMON_DIRECTORY:
		case B_COMMON_SYSTEM_DIRECTORY:
			return "/usr/local";
		case B_COMMON_ADDONS_DIRECTORY:
			return "/usr/local/lib/archway/add-ons";
		case B_COMMON_FONTS_DIRECTORY:
			return "/usr/local/share/fonts";
		case B_COMMON_LIB_DIRECTORY:
			return "/usr/local/lib";
		case B_COMMON_BIN_DIRECTORY:
			return "/usr/local/bin";
		case B_COMMON_DOCUMENTATION_DIRECTORY:
			return "/usr/local/share/doc";
		case B_COMMON_DEVELOP_DIRECTORY:
			return "/usr/include";
		case B_COMMON_LOG_DIRECTORY:
			return "/var/log";
		case B_COMMON_SPOOL_DIRECTORY:
			return "/var/spool";
		case B_COMMON_TEMP_DIRECTORY:
			return TemporaryFolder();
		case B_COMMON_VAR_DIRECTORY:
			return "/var";

		case B_USER_DIRECTORY:
			return Home();
		case B_USER_CONFIG_DIRECTORY:
			return UserFolder("XDG_CONFIG_HOME", "/.config");
		case B_USER_SETTINGS_DIRECTORY:
			return UserFolder("XDG_CONFIG_HOME", "/.config") + "/archway";
		case B_USER_ADDONS_DIRECTORY:
			return data + "/archway/add-ons";
		case B_USER_FONTS_DIRECTORY:
			return data + "/fonts";
		case B_USER_LIB_DIRECTORY:
			return Home() + "/.local/lib";
		case B_USER_SOUNDS_DIRECTORY:
			return data + "/sounds";
		default:
			return std::string();
	}
}

} // namespace


status_t
find_directory(directory_which which, BPath* path, bool createIt, BVolume*)
{
	if (path == NULL)
		return B_BAD_VALUE;
	path->Unset();
	const std::string folder = FolderOf(which);
	if (folder.empty())
		return B_UNSUPPORTED;
	if (createIt) {
		const status_t status = create_directory(folder.c_str(), 0755);
		if (status != B_OK)
			return status;
	}
	return path->SetTo(folder.c_str());
}


status_t
find_directory(directory_which which, dev_t, bool createIt, char* pathString, int32 length)
{
	if (pathString == NULL || length <= 0)
		return B_BAD_VALUE;
	BPath path;
	const status_t status = find_directory(which, &path, createIt);
	if (status != B_OK)
		return status;
	if (strlen(path.Path()) >= static_cast<size_t>(length))
		return B_NAME_TOO_LONG;
	strcpy(pathString, path.Path());
	return B_OK;
}
