#include <String.h>

#include <algorithm>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "support/private/Utf8.h"

// The text lies behind a small header, and a final NUL behind it. Empty strings share one static
// block, which is never written to.

namespace {

struct Header {
	int32 length;
	int32 capacity; // bytes of text that fit, the NUL not counted
};

struct EmptyBlock {
	Header header { 0, 0 };
	char text[8] = "";
};

constinit EmptyBlock sEmpty;


char*
empty_text()
{
	return sEmpty.text;
}


Header*
header_of(const char* text)
{
	return reinterpret_cast<Header*>(const_cast<char*>(text) - sizeof(Header));
}


void
free_text(char* text)
{
	if (text != empty_text())
		free(text - sizeof(Header));
}


int32
safe_length(const char* string)
{
	if (string == nullptr)
		return 0;
	return static_cast<int32>(min_c(strlen(string), size_t(INT_MAX - 64)));
}


int32
safe_length(const char* string, int32 maxLength)
{
	if (string == nullptr || maxLength <= 0)
		return 0;
	return static_cast<int32>(strnlen(string, size_t(maxLength)));
}


char
lower(char byte)
{
	return byte >= 'A' && byte <= 'Z' ? char(byte + ('a' - 'A')) : byte;
}


bool
is_space(char byte)
{
	return byte == ' ' || (byte >= '\t' && byte <= '\r');
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


BString::BString() : fData(empty_text())
{
}


BString::BString(const char* string) : fData(empty_text())
{
	SetTo(string);
}


BString::BString(const BString& string) : fData(empty_text())
{
	SetTo(string);
}


BString::BString(BString&& string) : fData(string.fData)
{
	string.fData = empty_text();
}


BString::BString(const char* string, int32 maxLength) : fData(empty_text())
{
	SetTo(string, maxLength);
}


BString::BString(char character, int32 count) : fData(empty_text())
{
	SetTo(character, count);
}


BString::~BString()
{
	free_text(fData);
}


int32
BString::Length() const
{
	return header_of(fData)->length;
}


int32
BString::CountChars() const
{
	return BPrivate::utf8_count_chars(fData, Length());
}


char
BString::ByteAt(int32 index) const
{
	return index >= 0 && index < Length() ? fData[index] : '\0';
}


const char*
BString::CharAt(int32 charIndex, int32* _bytes) const
{
	const char* at = fData;
	const char* end = fData + Length();
	for (int32 i = 0; i < charIndex && at < end; i++)
		at += BPrivate::utf8_char_length(at, static_cast<int32>(end - at));
	if (charIndex < 0 || at >= end)
		return nullptr;
	if (_bytes != nullptr)
		*_bytes = BPrivate::utf8_char_length(at, static_cast<int32>(end - at));
	return at;
}


// #pragma mark - assigning


BString&
BString::operator=(const BString& string)
{
	return SetTo(string);
}


BString&
BString::operator=(BString&& string)
{
	std::swap(fData, string.fData);
	return *this;
}


BString&
BString::operator=(const char* string)
{
	return SetTo(string);
}


BString&
BString::operator=(char character)
{
	return SetTo(character, 1);
}


BString&
BString::SetTo(const char* string)
{
	return SetTo(string, INT_MAX - 64);
}


BString&
BString::SetTo(const char* string, int32 maxLength)
{
	const int32 length = safe_length(string, maxLength);
	// The argument may be a part of this very text.
	if (string >= fData && string <= fData + Length()) {
		memmove(fData, string, size_t(length));
		if (length < Length())
			_Resize(length);
		return *this;
	}
	if (_Resize(length) && length > 0)
		memcpy(fData, string, size_t(length));
	return *this;
}


BString&
BString::SetTo(const BString& string)
{
	return SetTo(string, string.Length());
}


BString&
BString::SetTo(const BString& string, int32 maxLength)
{
	const int32 length = min_c(max_c(maxLength, 0), string.Length());
	if (&string == this)
		return Truncate(length);
	if (_Resize(length) && length > 0)
		memcpy(fData, string.fData, size_t(length));
	return *this;
}


BString&
BString::SetTo(char character, int32 count)
{
	count = max_c(count, 0);
	if (_Resize(count) && count > 0)
		memset(fData, character, size_t(count));
	return *this;
}


BString&
BString::Adopt(BString& from)
{
	if (&from == this)
		return *this;
	free_text(fData);
	fData = from.fData;
	from.fData = empty_text();
	return *this;
}


BString&
BString::Adopt(BString& from, int32 maxLength)
{
	Adopt(from);
	return Truncate(max_c(maxLength, 0));
}


BString&
BString::SetToFormat(const char* format, ...)
{
	va_list args;
	va_start(args, format);
	SetToFormatVarArgs(format, args);
	va_end(args);
	return *this;
}


BString&
BString::SetToFormatVarArgs(const char* format, va_list args)
{
	va_list again;
	va_copy(again, args);
	const int length = vsnprintf(nullptr, 0, format, args);
	// The arguments may point into this text, so the result is made beside it.
	BString result;
	if (length > 0 && result._Resize(length))
		vsnprintf(result.fData, size_t(length) + 1, format, again);
	va_end(again);
	return Adopt(result);
}


// #pragma mark - parts


BString&
BString::CopyInto(BString& into, int32 fromOffset, int32 length) const
{
	if (&into == this) {
		into.Remove(0, fromOffset);
		return into.Truncate(max_c(length, 0));
	}
	if (fromOffset < 0 || fromOffset > Length())
		return into.SetTo("");
	return into.SetTo(fData + fromOffset, min_c(max_c(length, 0), Length() - fromOffset));
}


void
BString::CopyInto(char* into, int32 fromOffset, int32 length) const
{
	if (into == nullptr || fromOffset < 0 || fromOffset > Length() || length <= 0)
		return;
	memcpy(into, fData + fromOffset, size_t(min_c(length, Length() - fromOffset)));
}


BString&
BString::MoveInto(BString& into, int32 fromOffset, int32 length)
{
	if (&into == this)
		return CopyInto(into, fromOffset, length);
	CopyInto(into, fromOffset, length);
	Remove(fromOffset, length);
	return into;
}


bool
BString::MoveInto(char* into, int32 fromOffset, int32 length)
{
	if (into == nullptr || fromOffset < 0 || length < 0 || length > Length() - fromOffset)
		return false;
	CopyInto(into, fromOffset, length);
	into[length] = '\0';
	Remove(fromOffset, length);
	return true;
}


// #pragma mark - appending


BString&
BString::operator+=(const BString& string)
{
	return Append(string);
}


BString&
BString::operator+=(const char* string)
{
	return Append(string);
}


BString&
BString::operator+=(char character)
{
	return Append(character, 1);
}


BString&
BString::Append(const BString& string)
{
	return _InsertAt(string.fData, string.Length(), Length());
}


BString&
BString::Append(const char* string)
{
	return _InsertAt(string, safe_length(string), Length());
}


BString&
BString::Append(const BString& string, int32 length)
{
	return _InsertAt(string.fData, min_c(length, string.Length()), Length());
}


BString&
BString::Append(const char* string, int32 length)
{
	return _InsertAt(string, safe_length(string, length), Length());
}


BString&
BString::Append(char character, int32 count)
{
	return Insert(character, count, Length());
}


BString&
BString::Prepend(const char* string)
{
	return _InsertAt(string, safe_length(string), 0);
}


BString&
BString::Prepend(const BString& string)
{
	return _InsertAt(string.fData, string.Length(), 0);
}


BString&
BString::Prepend(const char* string, int32 length)
{
	return _InsertAt(string, safe_length(string, length), 0);
}


BString&
BString::Prepend(const BString& string, int32 length)
{
	return _InsertAt(string.fData, min_c(length, string.Length()), 0);
}


BString&
BString::Prepend(char character, int32 count)
{
	return Insert(character, count, 0);
}


BString&
BString::Insert(const char* string, int32 position)
{
	return Insert(string, safe_length(string), position);
}


// A negative position cuts that much off the front of what is inserted.
BString&
BString::Insert(const char* string, int32 length, int32 position)
{
	length = safe_length(string, length);
	if (position < 0) {
		const int32 cut = position > -length ? -position : length;
		string += cut;
		length -= cut;
		position = 0;
	}
	return _InsertAt(string, length, min_c(position, Length()));
}


BString&
BString::Insert(const char* string, int32 fromOffset, int32 length, int32 position)
{
	if (fromOffset < 0 || fromOffset > safe_length(string))
		return *this;
	return Insert(string + fromOffset, length, position);
}


BString&
BString::Insert(const BString& string, int32 position)
{
	return Insert(string.fData, string.Length(), position);
}


BString&
BString::Insert(const BString& string, int32 length, int32 position)
{
	return Insert(string.fData, min_c(length, string.Length()), position);
}


BString&
BString::Insert(const BString& string, int32 fromOffset, int32 length, int32 position)
{
	return Insert(string.fData, fromOffset, length, position);
}


BString&
BString::Insert(char character, int32 count, int32 position)
{
	if (count <= 0)
		return *this;
	const BString run(character, count);
	if (position < 0)
		return _InsertAt(run.fData, max_c(count + position, 0), 0);
	return _InsertAt(run.fData, count, min_c(position, Length()));
}


// #pragma mark - removing


BString&
BString::Truncate(int32 newLength, bool)
{
	if (newLength < Length())
		_Resize(max_c(newLength, 0));
	return *this;
}


BString&
BString::Remove(int32 from, int32 length)
{
	if (from < 0 || from >= Length() || length <= 0)
		return *this;
	return _RemoveAt(from, min_c(length, Length() - from));
}


BString&
BString::RemoveFirst(const BString& string)
{
	return RemoveFirst(string.fData);
}


BString&
BString::RemoveLast(const BString& string)
{
	return RemoveLast(string.fData);
}


BString&
BString::RemoveAll(const BString& string)
{
	return RemoveAll(string.fData);
}


BString&
BString::RemoveFirst(const char* string)
{
	return Remove(FindFirst(string), safe_length(string));
}


BString&
BString::RemoveLast(const char* string)
{
	return Remove(FindLast(string), safe_length(string));
}


BString&
BString::RemoveAll(const char* string)
{
	return _ReplaceText(string, "", INT_MAX, 0, false);
}


BString&
BString::RemoveSet(const char* setOfBytesToRemove)
{
	return ReplaceSet(setOfBytesToRemove, "");
}


BString&
BString::RemoveCharsSet(const char* setOfBytesToRemove)
{
	return RemoveSet(setOfBytesToRemove);
}


BString&
BString::Trim()
{
	int32 first = 0;
	int32 end = Length();
	while (first < end && is_space(fData[first]))
		first++;
	while (end > first && is_space(fData[end - 1]))
		end--;
	Truncate(end);
	return Remove(0, first);
}


// #pragma mark - comparing


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


// #pragma mark - direct access


char*
BString::LockBuffer(int32 maxLength)
{
	const int32 length = Length();
	if (maxLength > length) {
		if (!_Resize(maxLength))
			return nullptr;
		// The text ends where it did until the buffer is unlocked.
		fData[length] = '\0';
	} else if (fData == empty_text() && (!_Resize(1) || !_Resize(0)))
		return nullptr;
	return fData;
}


BString&
BString::UnlockBuffer(int32 length)
{
	if (fData == empty_text())
		return *this;
	const int32 capacity = header_of(fData)->capacity;
	if (length < 0)
		length = static_cast<int32>(strnlen(fData, size_t(capacity)));
	length = min_c(length, capacity);
	header_of(fData)->length = length;
	fData[length] = '\0';
	return *this;
}


// #pragma mark - private


bool
BString::_Resize(int32 length)
{
	if (length <= header_of(fData)->capacity) {
		// The shared empty block has no room, so only a length of 0 comes here with it.
		if (fData != empty_text()) {
			header_of(fData)->length = length;
			fData[length] = '\0';
		}
		return true;
	}

	const bool wasEmpty = fData == empty_text();
	if (length > INT_MAX - 64)
		return false;
	// A text that grows again and again gets room for that.
	const int32 capacity =
		wasEmpty ? length : static_cast<int32>(min_c(int64(length) * 3 / 2, int64(INT_MAX - 64)));
	char* block = static_cast<char*>(realloc(
		wasEmpty ? nullptr : fData - sizeof(Header), sizeof(Header) + size_t(capacity) + 1));
	if (block == nullptr)
		return false;
	fData = block + sizeof(Header);
	header_of(fData)->capacity = capacity;
	header_of(fData)->length = length;
	fData[length] = '\0';
	return true;
}


BString&
BString::_InsertAt(const char* string, int32 length, int32 position)
{
	if (string == nullptr || length <= 0 || length > INT_MAX - 64 - Length())
		return *this;
	if (string >= fData && string <= fData + Length()) {
		const BString copy(string, length);
		return _InsertAt(copy.fData, copy.Length(), position);
	}

	const int32 oldLength = Length();
	if (!_Resize(oldLength + length))
		return *this;
	memmove(fData + position + length, fData + position, size_t(oldLength - position));
	memcpy(fData + position, string, size_t(length));
	return *this;
}


BString&
BString::_RemoveAt(int32 position, int32 length)
{
	memmove(fData + position, fData + position + length, size_t(Length() - position - length));
	_Resize(Length() - length);
	return *this;
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
