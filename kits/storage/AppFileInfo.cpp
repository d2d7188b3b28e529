#include <AppFileInfo.h>

#include <string.h>

#include <vector>

#include <File.h>
#include <Message.h>
#include <Resources.h>
#include <TypeConstants.h>

#include "storage/private/IconData.h"
#include "storage/private/NodeAttributes.h"

using namespace BPrivate;

namespace {

constexpr int32 kItemId = 1;
constexpr int32 kIconId = 101;
constexpr size_t kVersionSize = 340; // five numbers and two texts
constexpr type_code kFlagsType = 'APPF';
constexpr type_code kVersionType = 'APPV';

} // namespace


// Something that the file says, as an attribute and as a resource of the same name.
struct BAppFileInfo::Item {
	type_code type;
	int32 id;
	std::string name;
};


BAppFileInfo::BAppFileInfo() : fWhere(B_USE_BOTH_LOCATIONS)
{
}


BAppFileInfo::BAppFileInfo(BFile* file) : fWhere(B_USE_BOTH_LOCATIONS)
{
	SetTo(file);
}


BAppFileInfo::~BAppFileInfo()
{
}


status_t
BAppFileInfo::SetTo(BFile* file)
{
	fResources.reset();
	fWhere = B_USE_BOTH_LOCATIONS;
	const status_t status = BNodeInfo::SetTo(file);
	if (status != B_OK)
		return status;
	// Not every file can hold resources; the attributes remain.
	auto resources = std::make_unique<BResources>();
	if (resources->SetTo(file) == B_OK)
		fResources = std::move(resources);
	else
		fWhere = B_USE_ATTRIBUTES;
	return B_OK;
}


status_t
BAppFileInfo::GetType(char* type) const
{
	if (type == NULL)
		return B_BAD_VALUE;
	const status_t status = _ReadText({ B_MIME_STRING_TYPE, 2, "BEOS:TYPE" }, type);
	return status == B_OK ? status : BNodeInfo::GetType(type);
}


status_t
BAppFileInfo::SetType(const char* type)
{
	if (type != NULL && strlen(type) > B_MIME_TYPE_LENGTH)
		return B_BAD_VALUE;
	return _Write(
		{ B_MIME_STRING_TYPE, 2, "BEOS:TYPE" }, type, type != NULL ? strlen(type) + 1 : 0);
}


status_t
BAppFileInfo::GetSignature(char* signature) const
{
	if (signature == NULL)
		return B_BAD_VALUE;
	return _ReadText({ B_MIME_STRING_TYPE, kItemId, "BEOS:APP_SIG" }, signature);
}


status_t
BAppFileInfo::SetSignature(const char* signature)
{
	if (signature != NULL && strlen(signature) > B_MIME_TYPE_LENGTH)
		return B_BAD_VALUE;
	return _Write({ B_MIME_STRING_TYPE, kItemId, "BEOS:APP_SIG" }, signature,
		signature != NULL ? strlen(signature) + 1 : 0);
}


status_t
BAppFileInfo::GetAppFlags(uint32* _flags) const
{
	if (_flags == NULL)
		return B_BAD_VALUE;
	std::string data;
	const status_t status = _Read({ kFlagsType, kItemId, "BEOS:APP_FLAGS" }, &data);
	if (status != B_OK)
		return status;
	if (data.size() != sizeof(uint32))
		return B_BAD_DATA;
	memcpy(_flags, data.data(), sizeof(uint32));
	return B_OK;
}


status_t
BAppFileInfo::SetAppFlags(uint32 flags)
{
	return _Write({ kFlagsType, kItemId, "BEOS:APP_FLAGS" }, &flags, sizeof(flags));
}


status_t
BAppFileInfo::GetSupportedTypes(BMessage* _types) const
{
	if (_types == NULL)
		return B_BAD_VALUE;
	std::string data;
	const status_t status = _Read({ B_MESSAGE_TYPE, kItemId, "BEOS:FILE_TYPES" }, &data);
	if (status != B_OK)
		return status;
	BMemoryIO stream(static_cast<const void*>(data.data()), data.size());
	return _types->Unflatten(&stream);
}


status_t
BAppFileInfo::SetSupportedTypes(const BMessage* types)
{
	return SetSupportedTypes(types, false);
}


status_t
BAppFileInfo::SetSupportedTypes(const BMessage* types, bool syncAll)
{
	const char* type;
	for (int32 i = 0; types != NULL && types->FindString("types", i, &type) == B_OK; i++) {
		if (!BMimeType::IsValid(type))
			return B_BAD_VALUE;
	}
	const Item item = { B_MESSAGE_TYPE, kItemId, "BEOS:FILE_TYPES" };
	std::vector<char> bytes(types != NULL ? types->FlattenedSize() : 0);
	status_t status = types != NULL ? types->Flatten(bytes.data(), bytes.size()) : B_OK;
	if (status == B_OK)
		status = _Write(item, types != NULL ? bytes.data() : NULL, bytes.size());
	// A file without a signature says nothing about a program.
	char signature[B_MIME_TYPE_LENGTH + 1];
	if (status != B_OK || GetSignature(signature) != B_OK || !BMimeType::IsValid(signature))
		return status;
	return BMimeType(signature).SetSupportedTypes(types, syncAll);
}


bool
BAppFileInfo::IsSupportedType(const char* type) const
{
	BMimeType mime(type);
	return Supports(&mime);
}


bool
BAppFileInfo::Supports(BMimeType* type) const
{
	BMessage types;
	if (type == NULL || type->InitCheck() != B_OK || GetSupportedTypes(&types) != B_OK)
		return false;
	const char* supported;
	for (int32 i = 0; types.FindString("types", i, &supported) == B_OK; i++) {
		if (BMimeType(supported).Contains(type))
			return true;
	}
	return false;
}


status_t
BAppFileInfo::GetIcon(BBitmap* icon, icon_size size) const
{
	return GetIconForType(NULL, icon, size);
}


status_t
BAppFileInfo::SetIcon(const BBitmap* icon, icon_size size)
{
	return SetIconForType(NULL, icon, size);
}


status_t
BAppFileInfo::GetIconForType(const char* type, BBitmap* icon, icon_size size) const
{
	if (icon == NULL || (type != NULL && !BMimeType::IsValid(type)))
		return B_BAD_VALUE;
	const std::string prefix = size == B_LARGE_ICON ? "BEOS:L:" : "BEOS:M:";
	const std::string name = type != NULL ? prefix + type : IconName(size);
	std::string data;
	const status_t status = _Read({ IconType(size), kIconId, name }, &data);
	return status == B_OK ? DataToIcon(data.data(), data.size(), size, icon) : status;
}


status_t
BAppFileInfo::SetIconForType(const char* type, const BBitmap* icon, icon_size size)
{
	if (type != NULL && !BMimeType::IsValid(type))
		return B_BAD_VALUE;
	const std::string prefix = size == B_LARGE_ICON ? "BEOS:L:" : "BEOS:M:";
	const Item item = { IconType(size), type != NULL ? 0 : kIconId,
		type != NULL ? prefix + type : IconName(size) };
	if (icon == NULL)
		return _Write(item, NULL, 0);
	std::string data;
	const status_t status = IconToData(icon, size, &data);
	return status == B_OK ? _Write(item, data.data(), data.size()) : status;
}


// The resource holds the program's version and, behind it, that of the system it was made for.
status_t
BAppFileInfo::GetVersionInfo(version_info* _info, version_kind kind) const
{
	if (_info == NULL)
		return B_BAD_VALUE;
	std::string data;
	const status_t status = _Read({ kVersionType, kItemId, "BEOS:APP_VERSION" }, &data);
	if (status != B_OK)
		return status;
	const size_t start = kind == B_SYSTEM_VERSION_KIND ? kVersionSize : 0;
	if (data.size() < start + kVersionSize)
		return B_ENTRY_NOT_FOUND;
	memcpy(_info, data.data() + start, kVersionSize);
	_info->short_info[sizeof(_info->short_info) - 1] = '\0';
	_info->long_info[sizeof(_info->long_info) - 1] = '\0';
	return B_OK;
}


status_t
BAppFileInfo::SetVersionInfo(const version_info* info, version_kind kind)
{
	static_assert(sizeof(version_info) == kVersionSize);
	const Item item = { kVersionType, kItemId, "BEOS:APP_VERSION" };
	if (info == NULL)
		return _Write(item, NULL, 0);
	std::string data;
	_Read(item, &data);
	const size_t start = kind == B_SYSTEM_VERSION_KIND ? kVersionSize : 0;
	data.resize(std::max(data.size(), start + kVersionSize));
	memcpy(data.data() + start, info, kVersionSize);
	return _Write(item, data.data(), data.size());
}


void
BAppFileInfo::SetInfoLocation(info_location location)
{
	const uint32 possible = fResources != nullptr ? B_USE_BOTH_LOCATIONS : B_USE_ATTRIBUTES;
	const uint32 where = location & possible;
	fWhere = where != 0 ? static_cast<info_location>(where) : B_USE_ATTRIBUTES;
}


bool
BAppFileInfo::IsUsingAttributes() const
{
	return InitCheck() == B_OK && (fWhere & B_USE_ATTRIBUTES) != 0;
}


bool
BAppFileInfo::IsUsingResources() const
{
	return InitCheck() == B_OK && (fWhere & B_USE_RESOURCES) != 0;
}


// #pragma mark - private


status_t
BAppFileInfo::_Read(const Item& item, std::string* _data) const
{
	if (InitCheck() != B_OK)
		return InitCheck();
	AttributeValue value;
	if (IsUsingAttributes() && ReadAttribute(fNode->_Fd(), item.name.c_str(), &value) == B_OK) {
		*_data = std::move(value.data);
		return B_OK;
	}
	if (!IsUsingResources())
		return B_ENTRY_NOT_FOUND;
	size_t size = 0;
	const void* data = fResources->LoadResource(item.type, item.name.c_str(), &size);
	if (data == NULL)
		return B_ENTRY_NOT_FOUND;
	_data->assign(static_cast<const char*>(data), size);
	return B_OK;
}


// NULL takes it away everywhere.
status_t
BAppFileInfo::_Write(const Item& item, const void* data, size_t size)
{
	if (InitCheck() != B_OK)
		return InitCheck();
	if (IsUsingAttributes()) {
		const AttributeValue value = { item.type,
			std::string(static_cast<const char*>(data), size) };
		const status_t status = data != NULL
			? WriteAttribute(fNode->_Fd(), item.name.c_str(), value)
			: RemoveAttribute(fNode->_Fd(), item.name.c_str());
		if (status != B_OK && !(data == NULL && status == B_ENTRY_NOT_FOUND))
			return status;
	}
	if (!IsUsingResources())
		return B_OK;

	int32 id = item.id;
	const bool there = fResources->GetResourceInfo(item.type, item.name.c_str(), &id, NULL);
	status_t status = B_OK;
	if (data != NULL) {
		// A new one must not push out another of the same number.
		while (!there && fResources->HasResource(item.type, id))
			id++;
		status = fResources->AddResource(item.type, id, data, size, item.name.c_str());
	} else if (there)
		status = fResources->RemoveResource(item.type, id);
	return status == B_OK ? fResources->Sync() : status;
}


status_t
BAppFileInfo::_ReadText(const Item& item, char* buffer) const
{
	std::string data;
	const status_t status = _Read(item, &data);
	if (status != B_OK)
		return status;
	if (data.empty() || data.size() > B_MIME_TYPE_LENGTH + 1 || data.back() != '\0')
		return B_BAD_DATA;
	strcpy(buffer, data.c_str());
	return B_OK;
}
