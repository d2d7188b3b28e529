// BMimeType: what is known about a type.

#include <Mime.h>

#include <string.h>

#include <string>

#include <Entry.h>
#include <Message.h>
#include <Path.h>
#include <TypeConstants.h>

#include "storage/private/IconData.h"
#include "storage/private/MimeDatabase.h"
#include "storage/private/MimeSettings.h"

using namespace BPrivate;

namespace {


status_t
SetText(const char* type, const char* field, const char* text)
{
	if (text != NULL && strlen(text) > B_MIME_TYPE_LENGTH)
		return B_BAD_VALUE;
	return ChangeMimeSettings(type, [&](BMessage& settings) -> status_t {
		settings.RemoveName(field);
		return text != NULL ? settings.AddString(field, text) : B_OK;
	});
}


status_t
GetText(const char* type, const char* field, const std::string& standard, char* buffer)
{
	const BMessage settings = MimeSettingsOf(type);
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
	const std::string prefix = size == B_LARGE_ICON ? kMimeLargeIcon : kMimeMiniIcon;
	return type == NULL ? prefix : prefix + ":" + LowerCaseType(type);
}

} // namespace


status_t
BMimeType::GetShortDescription(char* description) const
{
	if (description == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const std::string standard = MimeDatabase::Get().DescriptionOf(LowerCaseType(fType));
	return GetText(fType, kMimeShortDescription, standard, description);
}


status_t
BMimeType::SetShortDescription(const char* description)
{
	return fCStatus != B_OK ? fCStatus : SetText(fType, kMimeShortDescription, description);
}


status_t
BMimeType::GetLongDescription(char* description) const
{
	if (description == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const std::string standard = MimeDatabase::Get().DescriptionOf(LowerCaseType(fType));
	return GetText(fType, kMimeLongDescription, standard, description);
}


status_t
BMimeType::SetLongDescription(const char* description)
{
	return fCStatus != B_OK ? fCStatus : SetText(fType, kMimeLongDescription, description);
}


status_t
BMimeType::GetFileExtensions(BMessage* _extensions) const
{
	if (_extensions == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	_extensions->MakeEmpty();
	const BMessage settings = MimeSettingsOf(fType);
	if (settings.FindMessage(kMimeExtensions, _extensions) == B_OK)
		return B_OK;
	for (const std::string& extension : MimeDatabase::Get().ExtensionsOf(LowerCaseType(fType)))
		_extensions->AddString("extensions", extension.c_str());
	return _extensions->HasString("extensions") ? B_OK : B_ENTRY_NOT_FOUND;
}


namespace {

status_t
SetMessage(const char* type, const char* field, const BMessage* message)
{
	return ChangeMimeSettings(type, [&](BMessage& settings) -> status_t {
		settings.RemoveName(field);
		return message != NULL ? settings.AddMessage(field, message) : B_OK;
	});
}

} // namespace


status_t
BMimeType::SetFileExtensions(const BMessage* extensions)
{
	return fCStatus != B_OK ? fCStatus : SetMessage(fType, kMimeExtensions, extensions);
}


status_t
BMimeType::GetPreferredApp(char* signature, app_verb) const
{
	if (signature == NULL)
		return B_BAD_VALUE;
	return fCStatus != B_OK ? fCStatus : GetText(fType, kMimePreferredApp, "", signature);
}


status_t
BMimeType::SetPreferredApp(const char* signature, app_verb)
{
	return fCStatus != B_OK ? fCStatus : SetText(fType, kMimePreferredApp, signature);
}


status_t
BMimeType::GetAttrInfo(BMessage* _info) const
{
	if (_info == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	return MimeSettingsOf(fType).FindMessage(kMimeAttrInfo, _info) == B_OK
		? static_cast<status_t>(B_OK)
		: static_cast<status_t>(B_ENTRY_NOT_FOUND);
}


status_t
BMimeType::SetAttrInfo(const BMessage* info)
{
	return fCStatus != B_OK ? fCStatus : SetMessage(fType, kMimeAttrInfo, info);
}


// A path is kept: the numbers of a folder mean nothing to another program.
status_t
BMimeType::GetAppHint(entry_ref* _ref) const
{
	if (_ref == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	const BMessage settings = MimeSettingsOf(fType);
	const char* path = NULL;
	if (settings.FindString(kMimeAppHint, &path) != B_OK)
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
	return ChangeMimeSettings(fType, [&](BMessage& settings) -> status_t {
		settings.RemoveName(kMimeAppHint);
		return ref != NULL ? settings.AddString(kMimeAppHint, path.Path()) : B_OK;
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
	const BMessage settings = MimeSettingsOf(fType);
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
	return ChangeMimeSettings(fType, [&](BMessage& settings) -> status_t {
		const std::string field = IconField(type, size);
		settings.RemoveName(field.c_str());
		return icon != NULL
			? settings.AddData(field.c_str(), IconType(size), data.data(), data.size())
			: B_OK;
	});
}
