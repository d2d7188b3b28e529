#include <Mime.h>

#include <stdlib.h>
#include <string.h>
#include <strings.h>

#include <mutex>
#include <set>
#include <string>
#include <vector>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <NodeInfo.h>
#include <Path.h>
#include <TypeConstants.h>

#include "storage/private/IconData.h"
#include "storage/private/MimeDatabase.h"
#include "storage/private/MimeSettings.h"

using namespace BPrivate;

namespace {

constexpr char kShortDescription[] = "short_description";
constexpr char kLongDescription[] = "long_description";
constexpr char kExtensions[] = "extensions";
constexpr char kPreferredApp[] = "preferred_app";
constexpr char kAttrInfo[] = "attr_info";
constexpr char kAppHint[] = "app_hint";

std::mutex sSettingsLock; // a change is read, changed and written back


std::string
LowerCase(const char* text)
{
	std::string lower(text);
	for (char& character : lower) {
		if (character >= 'A' && character <= 'Z')
			character += 'a' - 'A';
	}
	return lower;
}


bool
IsTypeCharacter(char character)
{
	return static_cast<unsigned char>(character) > 0x20
		&& strchr("/<>@,;:\"()[]?=\\", character) == NULL && character != 0x7f;
}


// The type's settings; an empty message when it has none.
BMessage
SettingsOf(const char* type)
{
	BMessage settings;
	if (ReadMimeSettings(LowerCase(type), &settings) != B_OK)
		settings.MakeEmpty();
	return settings;
}


// Lets `change` work on the settings and writes them back.
template<typename Change>
status_t
ChangeSettings(const char* type, Change change)
{
	std::lock_guard<std::mutex> guard(sSettingsLock);
	BMessage settings = SettingsOf(type);
	const status_t status = change(settings);
	return status == B_OK ? WriteMimeSettings(LowerCase(type), settings) : status;
}


status_t
SetText(const char* type, const char* field, const char* text)
{
	if (text != NULL && strlen(text) > B_MIME_TYPE_LENGTH)
		return B_BAD_VALUE;
	return ChangeSettings(type, [&](BMessage& settings) -> status_t {
		settings.RemoveName(field);
		return text != NULL ? settings.AddString(field, text) : B_OK;
	});
}


status_t
GetText(const char* type, const char* field, const std::string& standard, char* buffer)
{
	const BMessage settings = SettingsOf(type);
	const char* text = NULL;
	if (settings.FindString(field, &text) != B_OK)
		text = standard.c_str();
	if (text[0] == '\0')
		return B_ENTRY_NOT_FOUND;
	strncpy(buffer, text, B_MIME_TYPE_LENGTH);
	buffer[B_MIME_TYPE_LENGTH] = '\0';
	return B_OK;
}


std::string
IconField(const char* type, icon_size size)
{
	const std::string prefix = size == B_LARGE_ICON ? "large_icon" : "mini_icon";
	return type == NULL ? prefix : prefix + ":" + LowerCase(type);
}


status_t
SetGuess(const std::string& type, BMimeType* _type)
{
	return _type->SetTo(type.empty() ? B_FILE_MIME_TYPE : type.c_str());
}

} // namespace


BMimeType::BMimeType() : fType(NULL), fCStatus(B_NO_INIT)
{
}


BMimeType::BMimeType(const char* type) : fType(NULL), fCStatus(B_NO_INIT)
{
	SetTo(type);
}


BMimeType::~BMimeType()
{
	Unset();
}


status_t
BMimeType::SetTo(const char* type)
{
	if (!IsValid(type)) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	char* copy = strdup(type);
	Unset();
	if (copy == NULL)
		return fCStatus = B_NO_MEMORY;
	fType = copy;
	return fCStatus = B_OK;
}


void
BMimeType::Unset()
{
	free(fType);
	fType = NULL;
	fCStatus = B_NO_INIT;
}


status_t
BMimeType::InitCheck() const
{
	return fCStatus;
}


const char*
BMimeType::Type() const
{
	return fType;
}


bool
BMimeType::IsValid() const
{
	return fType != NULL;
}


bool
BMimeType::IsSupertypeOnly() const
{
	return fType != NULL && strchr(fType, '/') == NULL;
}


bool
BMimeType::IsInstalled() const
{
	if (fType == NULL)
		return false;
	const std::string type = LowerCase(fType);
	BMessage settings;
	if (MimeDatabase::Get().IsKnown(type) || ReadMimeSettings(type, &settings) == B_OK)
		return true;
	if (!IsSupertypeOnly())
		return false;
	const auto& types = MimeDatabase::Get().Types();
	const auto first = types.lower_bound(type + "/");
	return first != types.end() && first->compare(0, type.size() + 1, type + "/") == 0;
}


status_t
BMimeType::GetSupertype(BMimeType* _type) const
{
	if (_type == NULL)
		return B_BAD_VALUE;
	_type->Unset();
	const char* slash = fType != NULL ? strchr(fType, '/') : NULL;
	if (slash == NULL)
		return B_BAD_VALUE;
	return _type->SetTo(std::string(fType, slash - fType).c_str());
}


bool
BMimeType::Contains(const BMimeType* type) const
{
	if (fType == NULL || type == NULL || type->fType == NULL)
		return false;
	if (*this == *type)
		return true;
	const size_t length = strlen(fType);
	return IsSupertypeOnly() && strncasecmp(fType, type->fType, length) == 0
		&& type->fType[length] == '/';
}


bool
BMimeType::operator==(const BMimeType& type) const
{
	return *this == type.fType;
}


bool
BMimeType::operator==(const char* type) const
{
	if (fType == NULL || type == NULL)
		return fType == type;
	return strcasecmp(fType, type) == 0;
}


status_t
BMimeType::Install()
{
	if (fCStatus != B_OK)
		return fCStatus;
	return ChangeSettings(fType, [](BMessage&) -> status_t { return B_OK; });
}


status_t
BMimeType::Delete()
{
	if (fCStatus != B_OK)
		return fCStatus;
	std::lock_guard<std::mutex> guard(sSettingsLock);
	return RemoveMimeSettings(LowerCase(fType));
}


// #pragma mark - properties


status_t
BMimeType::GetShortDescription(char* description) const
{
	if (description == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const std::string standard = MimeDatabase::Get().DescriptionOf(LowerCase(fType));
	return GetText(fType, kShortDescription, standard, description);
}


status_t
BMimeType::SetShortDescription(const char* description)
{
	return fCStatus != B_OK ? fCStatus : SetText(fType, kShortDescription, description);
}


status_t
BMimeType::GetLongDescription(char* description) const
{
	if (description == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const std::string standard = MimeDatabase::Get().DescriptionOf(LowerCase(fType));
	return GetText(fType, kLongDescription, standard, description);
}


status_t
BMimeType::SetLongDescription(const char* description)
{
	return fCStatus != B_OK ? fCStatus : SetText(fType, kLongDescription, description);
}


status_t
BMimeType::GetFileExtensions(BMessage* _extensions) const
{
	if (_extensions == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	_extensions->MakeEmpty();
	const BMessage settings = SettingsOf(fType);
	if (settings.FindMessage(kExtensions, _extensions) == B_OK)
		return B_OK;
	for (const std::string& extension : MimeDatabase::Get().ExtensionsOf(LowerCase(fType)))
		_extensions->AddString("extensions", extension.c_str());
	return _extensions->HasString("extensions") ? B_OK : B_ENTRY_NOT_FOUND;
}


namespace {

status_t
SetMessage(const char* type, const char* field, const BMessage* message)
{
	return ChangeSettings(type, [&](BMessage& settings) -> status_t {
		settings.RemoveName(field);
		return message != NULL ? settings.AddMessage(field, message) : B_OK;
	});
}

} // namespace


status_t
BMimeType::SetFileExtensions(const BMessage* extensions)
{
	return fCStatus != B_OK ? fCStatus : SetMessage(fType, kExtensions, extensions);
}


status_t
BMimeType::GetPreferredApp(char* signature, app_verb) const
{
	if (signature == NULL)
		return B_BAD_VALUE;
	return fCStatus != B_OK ? fCStatus : GetText(fType, kPreferredApp, "", signature);
}


status_t
BMimeType::SetPreferredApp(const char* signature, app_verb)
{
	return fCStatus != B_OK ? fCStatus : SetText(fType, kPreferredApp, signature);
}


status_t
BMimeType::GetAttrInfo(BMessage* _info) const
{
	if (_info == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	return SettingsOf(fType).FindMessage(kAttrInfo, _info) == B_OK
		? static_cast<status_t>(B_OK)
		: static_cast<status_t>(B_ENTRY_NOT_FOUND);
}


status_t
BMimeType::SetAttrInfo(const BMessage* info)
{
	return fCStatus != B_OK ? fCStatus : SetMessage(fType, kAttrInfo, info);
}


// A path is kept: the numbers of a folder mean nothing to another program.
status_t
BMimeType::GetAppHint(entry_ref* _ref) const
{
	if (_ref == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const BMessage settings = SettingsOf(fType);
	const char* path = NULL;
	if (settings.FindString(kAppHint, &path) != B_OK)
		return B_ENTRY_NOT_FOUND;
	return get_ref_for_path(path, _ref);
}


status_t
BMimeType::SetAppHint(const entry_ref* ref)
{
	if (fCStatus != B_OK)
		return fCStatus;
	BPath path;
	if (ref != NULL) {
		const status_t status = path.SetTo(ref);
		if (status != B_OK)
			return status;
	}
	return ChangeSettings(fType, [&](BMessage& settings) -> status_t {
		settings.RemoveName(kAppHint);
		return ref != NULL ? settings.AddString(kAppHint, path.Path()) : B_OK;
	});
}


status_t
BMimeType::GetIcon(BBitmap* icon, icon_size size) const
{
	return GetIconForType(NULL, icon, size);
}


status_t
BMimeType::SetIcon(const BBitmap* icon, icon_size size)
{
	return SetIconForType(NULL, icon, size);
}


status_t
BMimeType::GetIconForType(const char* type, BBitmap* icon, icon_size size) const
{
	if (icon == NULL || (type != NULL && !IsValid(type)))
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const BMessage settings = SettingsOf(fType);
	const void* data;
	ssize_t length;
	if (settings.FindData(IconField(type, size).c_str(), IconType(size), &data, &length) != B_OK)
		return B_ENTRY_NOT_FOUND;
	return DataToIcon(data, length, size, icon);
}


status_t
BMimeType::SetIconForType(const char* type, const BBitmap* icon, icon_size size)
{
	if (type != NULL && !IsValid(type))
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	std::string data;
	if (icon != NULL) {
		const status_t status = IconToData(icon, size, &data);
		if (status != B_OK)
			return status;
	}
	return ChangeSettings(fType, [&](BMessage& settings) -> status_t {
		const std::string field = IconField(type, size);
		settings.RemoveName(field.c_str());
		return icon != NULL
			? settings.AddData(field.c_str(), IconType(size), data.data(), data.size())
			: B_OK;
	});
}


// #pragma mark - all types

namespace {

std::set<std::string>
AllTypes()
{
	std::set<std::string> types = MimeDatabase::Get().Types();
	types.merge(TypesWithMimeSettings());
	return types;
}

} // namespace


status_t
BMimeType::GetInstalledSupertypes(BMessage* _supertypes)
{
	if (_supertypes == NULL)
		return B_BAD_VALUE;
	_supertypes->MakeEmpty();
	std::string last;
	for (const std::string& type : AllTypes()) {
		const std::string supertype = type.substr(0, type.find('/'));
		if (supertype != last)
			_supertypes->AddString("super_types", supertype.c_str());
		last = supertype;
	}
	return B_OK;
}


status_t
BMimeType::GetInstalledTypes(BMessage* _types)
{
	return GetInstalledTypes(NULL, _types);
}


status_t
BMimeType::GetInstalledTypes(const char* supertype, BMessage* _types)
{
	if (_types == NULL || (supertype != NULL && !IsValid(supertype)))
		return B_BAD_VALUE;
	_types->MakeEmpty();
	const std::string prefix = supertype != NULL ? LowerCase(supertype) + "/" : "";
	for (const std::string& type : AllTypes()) {
		if (type.compare(0, prefix.size(), prefix) == 0)
			_types->AddString("types", type.c_str());
	}
	return B_OK;
}


status_t
BMimeType::GuessMimeType(const entry_ref* file, BMimeType* _type)
{
	if (file == NULL || file->name == NULL || _type == NULL)
		return B_BAD_VALUE;
	const BEntry entry(file);
	struct stat stat;
	const status_t status = entry.GetStat(&stat);
	if (status != B_OK)
		return status;
	if (S_ISDIR(stat.st_mode))
		return _type->SetTo("application/x-vnd.Be-directory");
	if (S_ISLNK(stat.st_mode))
		return _type->SetTo("application/x-vnd.Be-symlink");

	std::vector<char> start(S_ISREG(stat.st_mode) ? MimeDatabase::Get().BytesNeeded() : 0);
	BFile opened;
	ssize_t read = 0;
	if (!start.empty() && opened.SetTo(&entry, B_READ_ONLY) == B_OK)
		read = opened.ReadAt(0, start.data(), start.size());
	return SetGuess(
		MimeDatabase::Get().TypeOf(file->name, start.data(), read > 0 ? read : 0), _type);
}


status_t
BMimeType::GuessMimeType(const void* buffer, int32 length, BMimeType* _type)
{
	if (buffer == NULL || length < 0 || _type == NULL)
		return B_BAD_VALUE;
	return SetGuess(MimeDatabase::Get().TypeOfBytes(buffer, length), _type);
}


status_t
BMimeType::GuessMimeType(const char* filename, BMimeType* _type)
{
	if (filename == NULL || _type == NULL)
		return B_BAD_VALUE;
	const char* slash = strrchr(filename, '/');
	return SetGuess(MimeDatabase::Get().TypeOfName(slash != NULL ? slash + 1 : filename), _type);
}


bool
BMimeType::IsValid(const char* type)
{
	if (type == NULL || type[0] == '\0' || strlen(type) > B_MIME_TYPE_LENGTH)
		return false;
	const char* slash = strchr(type, '/');
	if (slash == type || (slash != NULL && slash[1] == '\0'))
		return false;
	for (const char* place = type; *place != '\0'; place++) {
		if (!IsTypeCharacter(*place) && place != slash)
			return false;
	}
	return true;
}


status_t
update_mime_info(const char* path, int recursive, int, int force)
{
	if (path == NULL)
		return B_BAD_VALUE;
	const BEntry entry(path);
	entry_ref ref;
	status_t status = entry.GetRef(&ref);
	if (status == B_OK && !entry.Exists())
		status = B_ENTRY_NOT_FOUND;
	if (status != B_OK)
		return status;

	BNode node(&entry);
	attr_info info;
	if (force != 0 || node.GetAttrInfo("BEOS:TYPE", &info) != B_OK) {
		BMimeType type;
		status = BMimeType::GuessMimeType(&ref, &type);
		if (status == B_OK)
			status = BNodeInfo(&node).SetType(type.Type());
	}
	if (status != B_OK || recursive == 0 || !entry.IsDirectory())
		return status;
	BDirectory directory(&entry);
	BEntry child;
	while (status == B_OK && directory.GetNextEntry(&child) == B_OK) {
		BPath childPath;
		if (child.GetPath(&childPath) == B_OK)
			status = update_mime_info(childPath.Path(), 1, 1, force);
	}
	return status;
}
