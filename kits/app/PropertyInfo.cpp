#include <PropertyInfo.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <AppDefs.h>
#include <Message.h>

#include "app/private/PropertyForm.h"

namespace {

// A list without entries stands for everything.
bool
Contains(const uint32 (&list)[10], uint32 wanted)
{
	if (list[0] == 0)
		return true;
	for (uint32 value : list) {
		if (value == 0)
			return false;
		if (value == wanted)
			return true;
	}
	return false;
}

} // namespace


BPropertyInfo::BPropertyInfo(property_info* properties, value_info* values, bool freeOnDelete) :
	fProperties(properties), fValues(values), fFreeOnDelete(freeOnDelete)
{
}


BPropertyInfo::~BPropertyInfo()
{
	_Release();
}


int32
BPropertyInfo::FindMatch(BMessage* message, int32 index, BMessage* specifier, int32 form,
	const char* property, void* data) const
{
	if (property == nullptr)
		return -1;
	for (int32 i = 0; i < CountProperties(); i++) {
		const property_info& entry = fProperties[i];
		// A command is for the object that the last specifier names.
		const bool commandFits =
			index != 0 || message == nullptr || Contains(entry.commands, message->what);
		if (strcmp(entry.name, property) == 0 && commandFits
			&& Contains(entry.specifiers, uint32(form))) {
			if (data != nullptr)
				*static_cast<uint32*>(data) = entry.extra_data;
			return i;
		}
	}
	return -1;
}


const property_info*
BPropertyInfo::Properties() const
{
	return fProperties;
}


const value_info*
BPropertyInfo::Values() const
{
	return fValues;
}


int32
BPropertyInfo::CountProperties() const
{
	int32 count = 0;
	while (fProperties != nullptr && fProperties[count].name != nullptr)
		count++;
	return count;
}


int32
BPropertyInfo::CountValues() const
{
	int32 count = 0;
	while (fValues != nullptr && fValues[count].name != nullptr)
		count++;
	return count;
}


void
BPropertyInfo::PrintToStream() const
{
	for (int32 i = 0; i < CountProperties(); i++)
		printf("%-20s %s\n", fProperties[i].name,
			fProperties[i].usage != nullptr ? fProperties[i].usage : "");
	for (int32 i = 0; i < CountValues(); i++)
		printf("%-20s 0x%08x\n", fValues[i].name, unsigned(fValues[i].value));
}


// #pragma mark - flattening


bool
BPropertyInfo::IsFixedSize() const
{
	return false;
}


type_code
BPropertyInfo::TypeCode() const
{
	return B_PROPERTY_INFO_TYPE;
}


ssize_t
BPropertyInfo::FlattenedSize() const
{
	return static_cast<ssize_t>(BPrivate::FlattenProperties(fProperties, fValues).size());
}


status_t
BPropertyInfo::Flatten(void* buffer, ssize_t size) const
{
	const std::string bytes = BPrivate::FlattenProperties(fProperties, fValues);
	if (buffer == nullptr || size < 0)
		return B_BAD_VALUE;
	if (static_cast<size_t>(size) < bytes.size())
		return B_BUFFER_OVERFLOW;
	memcpy(buffer, bytes.data(), bytes.size());
	return B_OK;
}


status_t
BPropertyInfo::Unflatten(type_code code, const void* buffer, ssize_t size)
{
	if (!AllowsTypeCode(code))
		return B_BAD_TYPE;
	if (buffer == nullptr || size < 0)
		return B_BAD_VALUE;

	_Release();
	auto tables = BPrivate::UnflattenProperties({ static_cast<const char*>(buffer), size_t(size) });
	if (tables == nullptr)
		return B_BAD_DATA;
	fUnflattened = std::move(tables);
	fProperties = fUnflattened->properties.data();
	fValues = fUnflattened->values.data();
	return B_OK;
}


void
BPropertyInfo::_Release()
{
	if (fFreeOnDelete && fUnflattened == nullptr) {
		free(fProperties);
		free(fValues);
	}
	fUnflattened.reset();
	fProperties = nullptr;
	fValues = nullptr;
}
