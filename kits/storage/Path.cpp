#include <Path.h>

#include <limits.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <string>
#include <string_view>
#include <vector>

#include <Directory.h>
#include <Entry.h>
#include <Errors.h>
#include <TypeConstants.h>

#include "storage/private/Descriptor.h"

using namespace BPrivate;

namespace {

// The path from the root, with ".", ".." and doubled slashes taken out as text.
status_t
TidyPath(std::string_view path, std::string* _tidy)
{
	std::string whole;
	if (path.empty() || path[0] != '/') {
		char current[PATH_MAX];
		if (getcwd(current, sizeof(current)) == NULL)
			return B_ENTRY_NOT_FOUND;
		whole = current;
		whole += '/';
	}
	whole += path;

	std::vector<std::string_view> parts;
	const std::string_view view(whole);
	for (size_t start = 0; start < view.size();) {
		const size_t end = std::min(view.find('/', start), view.size());
		const std::string_view part = view.substr(start, end - start);
		start = end + 1;
		if (part == "..") {
			if (!parts.empty())
				parts.pop_back();
		} else if (!part.empty() && part != ".")
			parts.push_back(part);
	}

	_tidy->clear();
	for (const std::string_view part : parts)
		(*_tidy += '/') += part;
	if (_tidy->empty())
		*_tidy = "/";
	return B_OK;
}

} // namespace


BPath::BPath() : fName(NULL), fCStatus(B_NO_INIT)
{
}


BPath::BPath(const BPath& path) : BFlattenable(), fName(NULL), fCStatus(B_NO_INIT)
{
	*this = path;
}


BPath::BPath(const entry_ref* ref) : fName(NULL), fCStatus(B_NO_INIT)
{
	SetTo(ref);
}


BPath::BPath(const BEntry* entry) : fName(NULL), fCStatus(B_NO_INIT)
{
	SetTo(entry);
}


BPath::BPath(const char* directory, const char* leaf, bool normalize) :
	fName(NULL), fCStatus(B_NO_INIT)
{
	SetTo(directory, leaf, normalize);
}


BPath::BPath(const BDirectory* directory, const char* leaf, bool normalize) :
	fName(NULL), fCStatus(B_NO_INIT)
{
	SetTo(directory, leaf, normalize);
}


BPath::~BPath()
{
	Unset();
}


status_t
BPath::InitCheck() const
{
	return fCStatus;
}


status_t
BPath::SetTo(const entry_ref* ref)
{
	Unset();
	if (ref == NULL)
		return fCStatus = B_BAD_VALUE;
	const BEntry entry(ref);
	return SetTo(&entry);
}


status_t
BPath::SetTo(const BEntry* entry)
{
	Unset();
	if (entry == NULL)
		return fCStatus = B_BAD_VALUE;
	const status_t status = entry->GetPath(this);
	return fCStatus = status;
}


status_t
BPath::SetTo(const char* path, const char* leaf, bool normalize)
{
	if (path == NULL || path[0] == '\0' || (leaf != NULL && leaf[0] == '/')) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	std::string whole(path);
	if (leaf != NULL && leaf[0] != '\0')
		(whole += '/') += leaf;

	if (normalize) {
		const BEntry entry(whole.c_str());
		const status_t status = entry.GetPath(this);
		return fCStatus = status;
	}
	std::string tidy;
	const status_t status = TidyPath(whole, &tidy);
	if (status != B_OK) {
		Unset();
		return fCStatus = status;
	}
	return _SetPath(tidy.c_str());
}


status_t
BPath::SetTo(const BDirectory* directory, const char* path, bool normalize)
{
	BEntry entry;
	if (directory == NULL || directory->GetEntry(&entry) != B_OK) {
		Unset();
		return fCStatus = B_BAD_VALUE;
	}
	BPath base;
	const status_t status = entry.GetPath(&base);
	if (status != B_OK) {
		Unset();
		return fCStatus = status;
	}
	return SetTo(base.Path(), path, normalize);
}


void
BPath::Unset()
{
	free(fName);
	fName = NULL;
	fCStatus = B_NO_INIT;
}


status_t
BPath::Append(const char* path, bool normalize)
{
	if (fName == NULL)
		return B_BAD_VALUE;
	const std::string base(fName); // SetTo() frees the name first
	const std::string more(path != NULL ? path : "");
	return SetTo(base.c_str(), more.c_str(), normalize);
}


const char*
BPath::Path() const
{
	return fName;
}


const char*
BPath::Leaf() const
{
	if (fName == NULL)
		return NULL;
	return strrchr(fName, '/') + 1;
}


status_t
BPath::GetParent(BPath* _path) const
{
	if (_path == NULL)
		return B_BAD_VALUE;
	if (fName == NULL)
		return fCStatus;
	const std::string whole(fName);
	if (whole == "/")
		return B_ENTRY_NOT_FOUND;
	const size_t slash = whole.rfind('/');
	return _path->_SetPath(slash == 0 ? "/" : whole.substr(0, slash).c_str());
}


// #pragma mark - operators


bool
BPath::operator==(const BPath& path) const
{
	return *this == path.fName;
}


bool
BPath::operator==(const char* path) const
{
	if (fName == NULL || path == NULL)
		return fName == path;
	return strcmp(fName, path) == 0;
}


bool
BPath::operator!=(const BPath& path) const
{
	return !(*this == path);
}


bool
BPath::operator!=(const char* path) const
{
	return !(*this == path);
}


BPath&
BPath::operator=(const BPath& path)
{
	if (this == &path)
		return *this;
	if (path.fName == NULL) {
		Unset();
		fCStatus = path.fCStatus;
	} else
		_SetPath(path.fName);
	return *this;
}


BPath&
BPath::operator=(const char* path)
{
	if (path == NULL)
		Unset();
	else
		SetTo(path);
	return *this;
}


// #pragma mark - BFlattenable

namespace {

// Device and directory are written as 32 and 64 bits, in the host's order; the name follows, with
// its terminator. Without a name there is nothing behind the numbers.
constexpr size_t kFlatHeader = sizeof(uint32) + sizeof(uint64);

} // namespace


bool
BPath::IsFixedSize() const
{
	return false;
}


type_code
BPath::TypeCode() const
{
	return B_REF_TYPE;
}


ssize_t
BPath::FlattenedSize() const
{
	if (fName == NULL)
		return kFlatHeader;
	entry_ref ref;
	const status_t status = get_ref_for_path(fName, &ref);
	return status == B_OK ? static_cast<ssize_t>(kFlatHeader + strlen(ref.name) + 1) : status;
}


status_t
BPath::Flatten(void* buffer, ssize_t size) const
{
	if (buffer == NULL)
		return B_BAD_VALUE;
	entry_ref ref;
	if (fName != NULL) {
		const status_t status = get_ref_for_path(fName, &ref);
		if (status != B_OK)
			return status;
	}
	const size_t nameSize = ref.name != NULL ? strlen(ref.name) + 1 : 0;
	if (size < static_cast<ssize_t>(kFlatHeader + nameSize))
		return B_BAD_VALUE;

	char* place = static_cast<char*>(buffer);
	const uint32 device = static_cast<uint32>(ref.device);
	const uint64 directory = ref.directory;
	memcpy(place, &device, sizeof(device));
	memcpy(place + sizeof(device), &directory, sizeof(directory));
	if (nameSize > 0)
		memcpy(place + kFlatHeader, ref.name, nameSize);
	return B_OK;
}


bool
BPath::AllowsTypeCode(type_code code) const
{
	return code == B_REF_TYPE;
}


status_t
BPath::Unflatten(type_code code, const void* buffer, ssize_t size)
{
	Unset();
	if (code != B_REF_TYPE || buffer == NULL || size < static_cast<ssize_t>(kFlatHeader))
		return fCStatus = B_BAD_VALUE;
	if (size == static_cast<ssize_t>(kFlatHeader))
		return B_OK; // an unset path

	const char* place = static_cast<const char*>(buffer);
	if (place[size - 1] != '\0')
		return fCStatus = B_BAD_VALUE;
	uint32 device;
	uint64 directory;
	memcpy(&device, place, sizeof(device));
	memcpy(&directory, place + sizeof(device), sizeof(directory));
	const entry_ref ref(device, directory, place + kFlatHeader);
	return SetTo(&ref);
}


// #pragma mark - private


status_t
BPath::_SetPath(const char* path)
{
	char* copy = strdup(path);
	Unset();
	if (copy == NULL)
		return fCStatus = B_NO_MEMORY;
	fName = copy;
	return fCStatus = B_OK;
}
