// BString: replacing, letters, escaping and printing.

#include <String.h>

#include <climits>
#include <cstdio>
#include <cstring>

namespace {

char
to_lower(char byte)
{
	return byte >= 'A' && byte <= 'Z' ? char(byte + ('a' - 'A')) : byte;
}


char
to_upper(char byte)
{
	return byte >= 'a' && byte <= 'z' ? char(byte - ('a' - 'A')) : byte;
}


bool
is_letter(char byte)
{
	return to_lower(byte) >= 'a' && to_lower(byte) <= 'z';
}


bool
is_in(char byte, const char* set)
{
	return byte != '\0' && strchr(set, byte) != nullptr;
}


void
replace_bytes(
	char* text, int32 length, char from, char to, int32 maxCount, int32 fromOffset, bool ignoreCase)
{
	const char wanted = ignoreCase ? to_lower(from) : from;
	for (int32 i = max_c(fromOffset, 0); i < length && maxCount > 0; i++) {
		if ((ignoreCase ? to_lower(text[i]) : text[i]) == wanted) {
			text[i] = to;
			maxCount--;
		}
	}
}


void
replace_last_byte(char* text, int32 length, char from, char to, bool ignoreCase)
{
	const char wanted = ignoreCase ? to_lower(from) : from;
	for (int32 i = length - 1; i >= 0; i--) {
		if ((ignoreCase ? to_lower(text[i]) : text[i]) == wanted) {
			text[i] = to;
			return;
		}
	}
}

} // namespace


BString&
BString::ReplaceFirst(char replaceThis, char withThis)
{
	return Replace(replaceThis, withThis, 1);
}


BString&
BString::ReplaceLast(char replaceThis, char withThis)
{
	replace_last_byte(fData, Length(), replaceThis, withThis, false);
	return *this;
}


BString&
BString::ReplaceAll(char replaceThis, char withThis, int32 fromOffset)
{
	return Replace(replaceThis, withThis, INT_MAX, fromOffset);
}


BString&
BString::Replace(char replaceThis, char withThis, int32 maxCount, int32 fromOffset)
{
	replace_bytes(fData, Length(), replaceThis, withThis, maxCount, fromOffset, false);
	return *this;
}


BString&
BString::ReplaceFirst(const char* replaceThis, const char* withThis)
{
	return _ReplaceText(replaceThis, withThis, 1, 0, false);
}


BString&
BString::ReplaceLast(const char* replaceThis, const char* withThis)
{
	const int32 at = FindLast(replaceThis);
	return at >= 0 ? _ReplaceText(replaceThis, withThis, 1, at, false) : *this;
}


BString&
BString::ReplaceAll(const char* replaceThis, const char* withThis, int32 fromOffset)
{
	return _ReplaceText(replaceThis, withThis, INT_MAX, fromOffset, false);
}


BString&
BString::Replace(const char* replaceThis, const char* withThis, int32 maxCount, int32 fromOffset)
{
	return _ReplaceText(replaceThis, withThis, maxCount, fromOffset, false);
}


BString&
BString::IReplaceFirst(char replaceThis, char withThis)
{
	return IReplace(replaceThis, withThis, 1);
}


BString&
BString::IReplaceLast(char replaceThis, char withThis)
{
	replace_last_byte(fData, Length(), replaceThis, withThis, true);
	return *this;
}


BString&
BString::IReplaceAll(char replaceThis, char withThis, int32 fromOffset)
{
	return IReplace(replaceThis, withThis, INT_MAX, fromOffset);
}


BString&
BString::IReplace(char replaceThis, char withThis, int32 maxCount, int32 fromOffset)
{
	replace_bytes(fData, Length(), replaceThis, withThis, maxCount, fromOffset, true);
	return *this;
}


BString&
BString::IReplaceFirst(const char* replaceThis, const char* withThis)
{
	return _ReplaceText(replaceThis, withThis, 1, 0, true);
}


BString&
BString::IReplaceLast(const char* replaceThis, const char* withThis)
{
	const int32 at = IFindLast(replaceThis);
	return at >= 0 ? _ReplaceText(replaceThis, withThis, 1, at, true) : *this;
}


BString&
BString::IReplaceAll(const char* replaceThis, const char* withThis, int32 fromOffset)
{
	return _ReplaceText(replaceThis, withThis, INT_MAX, fromOffset, true);
}


BString&
BString::IReplace(const char* replaceThis, const char* withThis, int32 maxCount, int32 fromOffset)
{
	return _ReplaceText(replaceThis, withThis, maxCount, fromOffset, true);
}


BString&
BString::ReplaceSet(const char* setOfBytes, char with)
{
	if (setOfBytes == nullptr)
		return *this;
	for (int32 i = 0; i < Length(); i++) {
		if (is_in(fData[i], setOfBytes))
			fData[i] = with;
	}
	return *this;
}


// A run of bytes of the set becomes one replacement.
BString&
BString::ReplaceSet(const char* setOfBytes, const char* with)
{
	if (setOfBytes == nullptr || with == nullptr)
		return *this;
	BString result;
	const char* at = fData;
	const char* end = fData + Length();
	while (at < end) {
		const char* start = at;
		while (at < end && !is_in(*at, setOfBytes))
			at++;
		result._InsertAt(start, static_cast<int32>(at - start), result.Length());
		const char* run = at;
		while (at < end && is_in(*at, setOfBytes))
			at++;
		if (at > run)
			result.Append(with);
	}
	return Adopt(result);
}


// #pragma mark - letters


BString&
BString::ToLower()
{
	for (int32 i = 0; i < Length(); i++)
		fData[i] = to_lower(fData[i]);
	return *this;
}


BString&
BString::ToUpper()
{
	for (int32 i = 0; i < Length(); i++)
		fData[i] = to_upper(fData[i]);
	return *this;
}


BString&
BString::Capitalize()
{
	ToLower();
	if (Length() > 0)
		fData[0] = to_upper(fData[0]);
	return *this;
}


BString&
BString::CapitalizeEachWord()
{
	bool inWord = false;
	for (int32 i = 0; i < Length(); i++) {
		fData[i] = inWord ? to_lower(fData[i]) : to_upper(fData[i]);
		inWord = is_letter(fData[i]);
	}
	return *this;
}


// #pragma mark - escaping


BString&
BString::CharacterEscape(const char* original, const char* setOfCharsToEscape, char escapeWith)
{
	if (original == nullptr || setOfCharsToEscape == nullptr)
		return *this;
	BString result;
	for (const char* at = original; *at != '\0'; at++) {
		if (is_in(*at, setOfCharsToEscape))
			result += escapeWith;
		result += *at;
	}
	return Adopt(result);
}


BString&
BString::CharacterEscape(const char* setOfCharsToEscape, char escapeWith)
{
	return CharacterEscape(fData, setOfCharsToEscape, escapeWith);
}


BString&
BString::CharacterDeescape(const char* original, char escapeCharacter)
{
	if (original == nullptr)
		return *this;
	BString result;
	for (const char* at = original; *at != '\0'; at++) {
		if (*at == escapeCharacter && at[1] != '\0')
			at++;
		result += *at;
	}
	return Adopt(result);
}


BString&
BString::CharacterDeescape(char escapeCharacter)
{
	return CharacterDeescape(fData, escapeCharacter);
}


// #pragma mark - printing


BString&
BString::operator<<(const char* string)
{
	return Append(string);
}


BString&
BString::operator<<(const BString& string)
{
	return Append(string);
}


BString&
BString::operator<<(char character)
{
	return Append(character, 1);
}


BString&
BString::operator<<(bool value)
{
	return Append(value ? "true" : "false");
}


BString&
BString::operator<<(int value)
{
	return *this << static_cast<long long>(value);
}


BString&
BString::operator<<(unsigned int value)
{
	return *this << static_cast<unsigned long long>(value);
}


BString&
BString::operator<<(unsigned long value)
{
	return *this << static_cast<unsigned long long>(value);
}


BString&
BString::operator<<(long value)
{
	return *this << static_cast<long long>(value);
}


BString&
BString::operator<<(unsigned long long value)
{
	char text[32];
	snprintf(text, sizeof(text), "%llu", value);
	return Append(text);
}


BString&
BString::operator<<(long long value)
{
	char text[32];
	snprintf(text, sizeof(text), "%lld", value);
	return Append(text);
}


BString&
BString::operator<<(float value)
{
	return *this << static_cast<double>(value);
}


BString&
BString::operator<<(double value)
{
	char text[400];
	snprintf(text, sizeof(text), "%.2f", value);
	return Append(text);
}


// #pragma mark - private


BString&
BString::_ReplaceText(
	const char* from, const char* to, int32 maxCount, int32 fromOffset, bool ignoreCase)
{
	if (from == nullptr || to == nullptr || *from == '\0')
		return *this;

	const int32 fromLength = static_cast<int32>(strlen(from));
	BString result;
	int32 done = 0;
	int32 searchFrom = max_c(fromOffset, 0);
	for (; maxCount > 0; maxCount--) {
		const int32 at = ignoreCase ? IFindFirst(from, searchFrom) : FindFirst(from, searchFrom);
		if (at < 0)
			break;
		result._InsertAt(fData + done, at - done, result.Length());
		result.Append(to);
		done = at + fromLength;
		searchFrom = done;
	}
	if (done == 0)
		return *this;
	result._InsertAt(fData + done, Length() - done, result.Length());
	return Adopt(result);
}
