// BString: putting text in and taking it out.

#include <String.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "support/private/StringLength.h"
#include "support/private/Utf8.h"

using BPrivate::safe_length;

namespace {

bool
is_space(char byte)
{
	return byte == ' ' || (byte >= '\t' && byte <= '\r');
}

} // namespace


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
