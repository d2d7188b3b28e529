// BMimeType: which programs support which types.

#include <Mime.h>

#include <algorithm>
#include <string>
#include <vector>

#include <Message.h>

#include "storage/private/MimeIndex.h"
#include "storage/private/MimeSettings.h"

using namespace BPrivate;

namespace {

// In small letters and without doubles, as "types"; B_BAD_VALUE for what is no type.
status_t
ReadTypes(const BMessage* message, std::vector<std::string>* _types)
{
	const char* type;
	for (int32 i = 0; message != NULL && message->FindString("types", i, &type) == B_OK; i++) {
		if (!BMimeType::IsValid(type))
			return B_BAD_VALUE;
		const std::string lower = LowerCaseType(type);
		if (std::find(_types->begin(), _types->end(), lower) == _types->end())
			_types->push_back(lower);
	}
	return B_OK;
}


// Adds those that were supported before and no longer are to those that are stranded.
status_t
Strand(const std::vector<std::string>& supported, BMessage* settings)
{
	BMessage former;
	BMessage stranded;
	std::vector<std::string> types;
	settings->FindMessage(kMimeStrandedTypes, &stranded);
	settings->FindMessage(kMimeSupportedTypes, &former);
	status_t status = ReadTypes(&stranded, &types);
	if (status == B_OK)
		status = ReadTypes(&former, &types);
	stranded.MakeEmpty();
	for (const std::string& type : types) {
		if (std::find(supported.begin(), supported.end(), type) == supported.end())
			stranded.AddString("types", type.c_str());
	}
	settings->RemoveName(kMimeStrandedTypes);
	if (status == B_OK && stranded.HasString("types"))
		status = settings->AddMessage(kMimeStrandedTypes, &stranded);
	return status;
}


status_t
AddApps(const std::vector<std::string>& apps, const std::vector<std::string>& known,
	const char* countField, BMessage* _apps)
{
	int32 count = 0;
	status_t status = B_OK;
	for (const std::string& app : apps) {
		if (status != B_OK || std::find(known.begin(), known.end(), app) != known.end())
			continue;
		status = _apps->AddString("applications", app.c_str());
		count++;
	}
	return status == B_OK ? _apps->AddInt32(countField, count) : status;
}

} // namespace


status_t
BMimeType::GetSupportingApps(BMessage* _signatures) const
{
	if (_signatures == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	_signatures->MakeEmpty();
	const auto index = MimeIndex::Get();
	const std::string type = LowerCaseType(fType);
	const std::vector<std::string> apps = index->SupportersOf(type);
	if (IsSupertypeOnly())
		return AddApps(apps, {}, "be:super", _signatures);
	const status_t status = AddApps(apps, {}, "be:sub", _signatures);
	if (status != B_OK)
		return status;
	return AddApps(
		index->SupportersOf(type.substr(0, type.find('/'))), apps, "be:super", _signatures);
}


status_t
BMimeType::GetWildcardApps(BMessage* _signatures)
{
	if (_signatures == NULL)
		return B_BAD_VALUE;
	_signatures->MakeEmpty();
	const std::vector<std::string> apps = MimeIndex::Get()->SupportersOf(B_FILE_MIME_TYPE);
	const status_t status = AddApps(apps, {}, "be:sub", _signatures);
	return status == B_OK ? _signatures->AddInt32("be:super", 0) : status;
}


status_t
BMimeType::GetSupportedTypes(BMessage* _types) const
{
	if (_types == NULL)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	_types->MakeEmpty();
	if (MimeSettingsOf(fType).FindMessage(kMimeSupportedTypes, _types) == B_OK)
		return B_OK;
	return B_ENTRY_NOT_FOUND;
}


status_t
BMimeType::SetSupportedTypes(const BMessage* types, bool fullSync)
{
	if (fCStatus != B_OK)
		return fCStatus;
	std::vector<std::string> supported;
	status_t status = ReadTypes(types, &supported);
	if (status != B_OK)
		return status;
	status = ChangeMimeSettings(fType, [&](BMessage& settings) -> status_t {
		const status_t stranded = fullSync ? B_OK : Strand(supported, &settings);
		if (fullSync)
			settings.RemoveName(kMimeStrandedTypes);
		settings.RemoveName(kMimeSupportedTypes);
		if (stranded != B_OK || types == NULL)
			return stranded;
		return settings.AddMessage(kMimeSupportedTypes, types);
	});
	for (size_t i = 0; status == B_OK && i < supported.size(); i++) {
		BMimeType type(supported[i].c_str());
		if (!type.IsInstalled())
			status = type.Install();
	}
	return status;
}
