// BMessage: the specifiers of a scripting message, which say what it is about.

#include <Message.h>

#include <cstring>

#include <AppDefs.h>

namespace {

constexpr const char* kSpecifiers = "specifiers";
constexpr const char* kProperty = "property";

} // namespace


status_t
BMessage::AddSpecifier(const char* property)
{
	BMessage specifier(B_DIRECT_SPECIFIER);
	const status_t status = specifier.AddString(kProperty, property);
	return status == B_OK ? AddSpecifier(&specifier) : status;
}


status_t
BMessage::AddSpecifier(const char* property, int32 index)
{
	BMessage specifier(B_INDEX_SPECIFIER);
	status_t status = specifier.AddString(kProperty, property);
	if (status == B_OK)
		status = specifier.AddInt32("index", index);
	return status == B_OK ? AddSpecifier(&specifier) : status;
}


status_t
BMessage::AddSpecifier(const char* property, int32 index, int32 range)
{
	if (range < 0)
		return B_BAD_VALUE;
	BMessage specifier(B_RANGE_SPECIFIER);
	status_t status = specifier.AddString(kProperty, property);
	if (status == B_OK)
		status = specifier.AddInt32("index", index);
	if (status == B_OK)
		status = specifier.AddInt32("range", range);
	return status == B_OK ? AddSpecifier(&specifier) : status;
}


status_t
BMessage::AddSpecifier(const char* property, const char* name)
{
	BMessage specifier(B_NAME_SPECIFIER);
	status_t status = specifier.AddString(kProperty, property);
	if (status == B_OK)
		status = specifier.AddString("name", name);
	return status == B_OK ? AddSpecifier(&specifier) : status;
}


// The last one added is the first to be resolved.
status_t
BMessage::AddSpecifier(const BMessage* specifier)
{
	const status_t status = AddMessage(kSpecifiers, specifier);
	if (status == B_OK)
		fCurrentSpecifier++;
	return status;
}


status_t
BMessage::SetCurrentSpecifier(int32 index)
{
	int32 count = 0;
	GetInfo(kSpecifiers, nullptr, &count);
	if (index < 0 || index >= count)
		return B_BAD_INDEX;
	fCurrentSpecifier = index;
	return B_OK;
}


status_t
BMessage::GetCurrentSpecifier(
	int32* index, BMessage* specifier, int32* form, const char** property) const
{
	if (index != nullptr)
		*index = fCurrentSpecifier;
	if (fCurrentSpecifier < 0)
		return B_BAD_SCRIPT_SYNTAX;

	BMessage current;
	const status_t status = FindMessage(kSpecifiers, fCurrentSpecifier, &current);
	if (status != B_OK)
		return B_BAD_SCRIPT_SYNTAX;
	if (form != nullptr)
		*form = int32(current.what);
	// The text lies in the specifier's contents, which this message shares.
	if (property != nullptr && current.FindString(kProperty, property) != B_OK)
		return B_BAD_SCRIPT_SYNTAX;
	if (specifier != nullptr)
		*specifier = current;
	return B_OK;
}


bool
BMessage::HasSpecifiers() const
{
	return HasMessage(kSpecifiers);
}


status_t
BMessage::PopSpecifier()
{
	if (fCurrentSpecifier < 0)
		return B_BAD_VALUE;
	fCurrentSpecifier--;
	return B_OK;
}
