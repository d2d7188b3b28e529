#include <String.h>

#include <algorithm>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "support/private/StringLength.h"
#include "support/private/Utf8.h"

using BPrivate::safe_length;

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
