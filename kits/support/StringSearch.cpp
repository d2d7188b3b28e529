// BString: comparing and searching.

#include <String.h>

#include <cstring>

#include "support/private/StringLength.h"

using BPrivate::safe_length;

namespace {

char
lower(char byte)
{
	return byte >= 'A' && byte <= 'Z' ? char(byte + ('a' - 'A')) : byte;
}


int
compare(const char* a, int32 lengthA, const char* b, int32 lengthB, bool ignoreCase)
{
	const int32 common = min_c(lengthA, lengthB);
	for (int32 i = 0; i < common; i++) {
		const auto byteA = static_cast<unsigned char>(ignoreCase ? lower(a[i]) : a[i]);
		const auto byteB = static_cast<unsigned char>(ignoreCase ? lower(b[i]) : b[i]);
		if (byteA != byteB)
			return byteA < byteB ? -1 : 1;
	}
	return lengthA == lengthB ? 0 : (lengthA < lengthB ? -1 : 1);
}


bool
matches(const char* text, const char* pattern, int32 length, bool ignoreCase)
{
	return compare(text, length, pattern, length, ignoreCase) == 0;
}


int32
find_first(const char* text, int32 textLength, const char* pattern, int32 from, bool ignoreCase)
{
	if (pattern == nullptr)
		return B_BAD_VALUE;
	if (from < 0)
		return B_ERROR;
	const int32 length = safe_length(pattern);
	for (int32 at = from; at <= textLength - length; at++) {
		if (matches(text + at, pattern, length, ignoreCase))
			return at;
	}
	return B_ERROR;
}


// The last match that ends at or before the given offset.
int32
find_last(const char* text, int32 textLength, const char* pattern, int32 before, bool ignoreCase)
{
	if (pattern == nullptr)
		return B_BAD_VALUE;
	if (before < 0)
		return B_ERROR;
	const int32 length = safe_length(pattern);
	for (int32 at = min_c(before, textLength) - length; at >= 0; at--) {
		if (matches(text + at, pattern, length, ignoreCase))
			return at;
	}
	return B_ERROR;
}

} // namespace


bool
BString::operator==(const BString& string) const
{
	return Length() == string.Length() && memcmp(fData, string.fData, size_t(Length())) == 0;
}


int
BString::Compare(const BString& string) const
{
	return compare(fData, Length(), string.fData, string.Length(), false);
}


int
BString::Compare(const char* string) const
{
	return compare(fData, Length(), string, safe_length(string), false);
}


int
BString::Compare(const BString& string, int32 length) const
{
	length = max_c(length, 0);
	return compare(
		fData, min_c(length, Length()), string.fData, min_c(length, string.Length()), false);
}


int
BString::Compare(const char* string, int32 length) const
{
	length = max_c(length, 0);
	return compare(fData, min_c(length, Length()), string, safe_length(string, length), false);
}


int
BString::ICompare(const BString& string) const
{
	return compare(fData, Length(), string.fData, string.Length(), true);
}


int
BString::ICompare(const char* string) const
{
	return compare(fData, Length(), string, safe_length(string), true);
}


int
BString::ICompare(const BString& string, int32 length) const
{
	length = max_c(length, 0);
	return compare(
		fData, min_c(length, Length()), string.fData, min_c(length, string.Length()), true);
}


int
BString::ICompare(const char* string, int32 length) const
{
	length = max_c(length, 0);
	return compare(fData, min_c(length, Length()), string, safe_length(string, length), true);
}


// #pragma mark - searching


int32
BString::FindFirst(const BString& string) const
{
	return FindFirst(string.fData, 0);
}


int32
BString::FindFirst(const char* string) const
{
	return FindFirst(string, 0);
}


int32
BString::FindFirst(const BString& string, int32 fromOffset) const
{
	return FindFirst(string.fData, fromOffset);
}


int32
BString::FindFirst(const char* string, int32 fromOffset) const
{
	return find_first(fData, Length(), string, fromOffset, false);
}


int32
BString::FindFirst(char character) const
{
	return FindFirst(character, 0);
}


int32
BString::FindFirst(char character, int32 fromOffset) const
{
	for (int32 i = fromOffset; i >= 0 && i < Length(); i++) {
		if (fData[i] == character)
			return i;
	}
	return B_ERROR;
}


int32
BString::FindLast(const BString& string) const
{
	return FindLast(string.fData, Length());
}


int32
BString::FindLast(const char* string) const
{
	return FindLast(string, Length());
}


int32
BString::FindLast(const BString& string, int32 beforeOffset) const
{
	return FindLast(string.fData, beforeOffset);
}


int32
BString::FindLast(const char* string, int32 beforeOffset) const
{
	return find_last(fData, Length(), string, beforeOffset, false);
}


int32
BString::FindLast(char character) const
{
	return FindLast(character, Length());
}


int32
BString::FindLast(char character, int32 beforeOffset) const
{
	for (int32 i = min_c(max_c(beforeOffset, 0), Length()) - 1; i >= 0; i--) {
		if (fData[i] == character)
			return i;
	}
	return B_ERROR;
}


int32
BString::IFindFirst(const BString& string) const
{
	return IFindFirst(string.fData, 0);
}


int32
BString::IFindFirst(const char* string) const
{
	return IFindFirst(string, 0);
}


int32
BString::IFindFirst(const BString& string, int32 fromOffset) const
{
	return IFindFirst(string.fData, fromOffset);
}


int32
BString::IFindFirst(const char* string, int32 fromOffset) const
{
	return find_first(fData, Length(), string, fromOffset, true);
}


int32
BString::IFindLast(const BString& string) const
{
	return IFindLast(string.fData, Length());
}


int32
BString::IFindLast(const char* string) const
{
	return IFindLast(string, Length());
}


int32
BString::IFindLast(const BString& string, int32 beforeOffset) const
{
	return IFindLast(string.fData, beforeOffset);
}


int32
BString::IFindLast(const char* string, int32 beforeOffset) const
{
	return find_last(fData, Length(), string, beforeOffset, true);
}


bool
BString::StartsWith(const BString& string) const
{
	return StartsWith(string.fData, string.Length());
}


bool
BString::StartsWith(const char* string) const
{
	return StartsWith(string, safe_length(string));
}


bool
BString::StartsWith(const char* string, int32 length) const
{
	return string != nullptr && length >= 0 && length <= Length()
		&& matches(fData, string, length, false);
}


bool
BString::IStartsWith(const BString& string) const
{
	return IStartsWith(string.fData);
}


bool
BString::IStartsWith(const char* string) const
{
	const int32 length = safe_length(string);
	return string != nullptr && length <= Length() && matches(fData, string, length, true);
}


bool
BString::EndsWith(const BString& string) const
{
	return EndsWith(string.fData);
}


bool
BString::EndsWith(const char* string) const
{
	const int32 length = safe_length(string);
	return string != nullptr && length <= Length()
		&& matches(fData + Length() - length, string, length, false);
}


bool
BString::IEndsWith(const BString& string) const
{
	return IEndsWith(string.fData);
}


bool
BString::IEndsWith(const char* string) const
{
	const int32 length = safe_length(string);
	return string != nullptr && length <= Length()
		&& matches(fData + Length() - length, string, length, true);
}


// #pragma mark - for sorting


int
Compare(const BString& a, const BString& b)
{
	return a.Compare(b);
}


int
ICompare(const BString& a, const BString& b)
{
	return a.ICompare(b);
}


int
Compare(const BString* a, const BString* b)
{
	return a->Compare(*b);
}


int
ICompare(const BString* a, const BString* b)
{
	return a->ICompare(*b);
}
