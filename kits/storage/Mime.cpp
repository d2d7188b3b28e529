#include <Mime.h>

#include <stdlib.h>
#include <string.h>
#include <strings.h>

#include <set>
#include <string>

#include <Message.h>
#include <Messenger.h>

#include "storage/private/MimeDatabase.h"
#include "storage/private/MimeSettings.h"
#include "storage/private/MimeWatchers.h"

using namespace BPrivate;

namespace {

bool
IsTypeCharacter(char character)
{
	return static_cast<unsigned char>(character) > 0x20
		&& strchr("/<>@,;:\"()[]?=\\", character) == NULL && character != 0x7f;
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


status_t
BMimeType::SetType(const char* type)
{
	return SetTo(type);
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
	const std::string type = LowerCaseType(fType);
	BMessage settings;
	return MimeDatabase::Get().IsKnown(type) || ReadMimeSettings(type, &settings) == B_OK;
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
	return ChangeMimeSettings(fType, [](BMessage&) -> status_t { return B_OK; });
}


status_t
BMimeType::Delete()
{
	if (fCStatus != B_OK)
		return fCStatus;
	return RemoveMimeSettings(LowerCaseType(fType));
}


// #pragma mark - watching


status_t
BMimeType::StartWatching(BMessenger target)
{
	return MimeWatchers::Get().Start(target);
}


status_t
BMimeType::StopWatching(BMessenger target)
{
	return MimeWatchers::Get().Stop(target);
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
	const std::string prefix = supertype != NULL ? LowerCaseType(supertype) + "/" : "";
	for (const std::string& type : AllTypes()) {
		if (type.compare(0, prefix.size(), prefix) == 0)
			_types->AddString("types", type.c_str());
	}
	return B_OK;
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
