// BString: a text that owns its bytes.
#pragma once

#include <stdarg.h>
#include <string.h>

#include <SupportDefs.h>

// Lengths, offsets and counts are in bytes unless a name says otherwise. The text is meant to be
// UTF-8 but any bytes without a NUL are kept. Offsets out of range are clamped or change nothing;
// a NULL string counts as empty. Not thread-safe.
class BString {
public:
	BString();
	BString(const char* string);
	BString(const BString& string);
	BString(BString&& string);
	BString(const char* string, int32 maxLength);
	BString(char character, int32 count);
	~BString();

	const char* String() const { return fData; }
	int32 Length() const;
	int32 CountChars() const;
	bool IsEmpty() const { return Length() == 0; }

	char operator[](int32 index) const { return fData[index]; }
	char& operator[](int32 index) { return fData[index]; }
	char ByteAt(int32 index) const; // 0 when out of range
	const char* CharAt(int32 charIndex, int32* _bytes = NULL) const;

	// Assigning
	BString& operator=(const BString& string);
	BString& operator=(BString&& string);
	BString& operator=(const char* string);
	BString& operator=(char character);
	BString& SetTo(const char* string);
	BString& SetTo(const char* string, int32 maxLength);
	BString& SetTo(const BString& string);
	BString& SetTo(const BString& string, int32 maxLength);
	BString& SetTo(char character, int32 count);
	BString& Adopt(BString& from);
	BString& Adopt(BString& from, int32 maxLength);
	BString& SetToFormat(const char* format, ...) __attribute__((__format__(__printf__, 2, 3)));
	BString& SetToFormatVarArgs(const char* format, va_list args);

	// Parts. The result is truncated or moved into the argument.
	BString& CopyInto(BString& into, int32 fromOffset, int32 length) const;
	void CopyInto(char* into, int32 fromOffset, int32 length) const;
	BString& MoveInto(BString& into, int32 fromOffset, int32 length);
	bool MoveInto(char* into, int32 fromOffset, int32 length);

	// Appending
	BString& operator+=(const BString& string);
	BString& operator+=(const char* string);
	BString& operator+=(char character);
	BString& Append(const BString& string);
	BString& Append(const char* string);
	BString& Append(const BString& string, int32 length);
	BString& Append(const char* string, int32 length);
	BString& Append(char character, int32 count);
	BString& Prepend(const char* string);
	BString& Prepend(const BString& string);
	BString& Prepend(const char* string, int32 length);
	BString& Prepend(const BString& string, int32 length);
	BString& Prepend(char character, int32 count);
	BString& Insert(const char* string, int32 position);
	BString& Insert(const char* string, int32 length, int32 position);
	BString& Insert(const char* string, int32 fromOffset, int32 length, int32 position);
	BString& Insert(const BString& string, int32 position);
	BString& Insert(const BString& string, int32 length, int32 position);
	BString& Insert(const BString& string, int32 fromOffset, int32 length, int32 position);
	BString& Insert(char character, int32 count, int32 position);

	// Removing
	BString& Truncate(int32 newLength, bool lazy = true);
	BString& Remove(int32 from, int32 length);
	BString& RemoveFirst(const BString& string);
	BString& RemoveLast(const BString& string);
	BString& RemoveAll(const BString& string);
	BString& RemoveFirst(const char* string);
	BString& RemoveLast(const char* string);
	BString& RemoveAll(const char* string);
	BString& RemoveSet(const char* setOfBytesToRemove);
	BString& RemoveCharsSet(const char* setOfBytesToRemove);
	BString& Trim(); // white space at both ends

	// Comparing
	bool operator<(const BString& string) const { return Compare(string) < 0; }
	bool operator<=(const BString& string) const { return Compare(string) <= 0; }
	bool operator==(const BString& string) const;
	bool operator>=(const BString& string) const { return Compare(string) >= 0; }
	bool operator>(const BString& string) const { return Compare(string) > 0; }
	bool operator!=(const BString& string) const { return !(*this == string); }
	bool operator<(const char* string) const { return Compare(string) < 0; }
	bool operator<=(const char* string) const { return Compare(string) <= 0; }
	bool operator==(const char* string) const { return Compare(string) == 0; }
	bool operator>=(const char* string) const { return Compare(string) >= 0; }
	bool operator>(const char* string) const { return Compare(string) > 0; }
	bool operator!=(const char* string) const { return Compare(string) != 0; }
	int Compare(const BString& string) const;
	int Compare(const char* string) const;
	int Compare(const BString& string, int32 length) const;
	int Compare(const char* string, int32 length) const;
	int ICompare(const BString& string) const; // case is ignored in ASCII letters
	int ICompare(const char* string) const;
	int ICompare(const BString& string, int32 length) const;
	int ICompare(const char* string, int32 length) const;

	// Searching; B_ERROR when it is not there
	int32 FindFirst(const BString& string) const;
	int32 FindFirst(const char* string) const;
	int32 FindFirst(const BString& string, int32 fromOffset) const;
	int32 FindFirst(const char* string, int32 fromOffset) const;
	int32 FindFirst(char character) const;
	int32 FindFirst(char character, int32 fromOffset) const;
	int32 FindLast(const BString& string) const;
	int32 FindLast(const char* string) const;
	int32 FindLast(const BString& string, int32 beforeOffset) const;
	int32 FindLast(const char* string, int32 beforeOffset) const;
	int32 FindLast(char character) const;
	int32 FindLast(char character, int32 beforeOffset) const;
	int32 IFindFirst(const BString& string) const;
	int32 IFindFirst(const char* string) const;
	int32 IFindFirst(const BString& string, int32 fromOffset) const;
	int32 IFindFirst(const char* string, int32 fromOffset) const;
	int32 IFindLast(const BString& string) const;
	int32 IFindLast(const char* string) const;
	int32 IFindLast(const BString& string, int32 beforeOffset) const;
	int32 IFindLast(const char* string, int32 beforeOffset) const;
	bool StartsWith(const BString& string) const;
	bool StartsWith(const char* string) const;
	bool StartsWith(const char* string, int32 length) const;
	bool IStartsWith(const BString& string) const;
	bool IStartsWith(const char* string) const;
	bool EndsWith(const BString& string) const;
	bool EndsWith(const char* string) const;
	bool IEndsWith(const BString& string) const;
	bool IEndsWith(const char* string) const;

	// Replacing
	BString& ReplaceFirst(char replaceThis, char withThis);
	BString& ReplaceLast(char replaceThis, char withThis);
	BString& ReplaceAll(char replaceThis, char withThis, int32 fromOffset = 0);
	BString& Replace(char replaceThis, char withThis, int32 maxCount, int32 fromOffset = 0);
	BString& ReplaceFirst(const char* replaceThis, const char* withThis);
	BString& ReplaceLast(const char* replaceThis, const char* withThis);
	BString& ReplaceAll(const char* replaceThis, const char* withThis, int32 fromOffset = 0);
	BString& Replace(
		const char* replaceThis, const char* withThis, int32 maxCount, int32 fromOffset = 0);
	BString& IReplaceFirst(char replaceThis, char withThis);
	BString& IReplaceLast(char replaceThis, char withThis);
	BString& IReplaceAll(char replaceThis, char withThis, int32 fromOffset = 0);
	BString& IReplace(char replaceThis, char withThis, int32 maxCount, int32 fromOffset = 0);
	BString& IReplaceFirst(const char* replaceThis, const char* withThis);
	BString& IReplaceLast(const char* replaceThis, const char* withThis);
	BString& IReplaceAll(const char* replaceThis, const char* withThis, int32 fromOffset = 0);
	BString& IReplace(
		const char* replaceThis, const char* withThis, int32 maxCount, int32 fromOffset = 0);
	BString& ReplaceSet(const char* setOfBytes, char with);
	BString& ReplaceSet(const char* setOfBytes, const char* with);

	// Direct access: the buffer holds maxLength bytes and a NUL until UnlockBuffer(), which takes
	// the length of the text, or finds it by the NUL when it is -1.
	char* LockBuffer(int32 maxLength);
	BString& UnlockBuffer(int32 length = -1);

	// Letters, ASCII only
	BString& ToLower();
	BString& ToUpper();
	BString& Capitalize();
	BString& CapitalizeEachWord();

	// Escaping
	BString& CharacterEscape(const char* original, const char* setOfCharsToEscape, char escapeWith);
	BString& CharacterEscape(const char* setOfCharsToEscape, char escapeWith);
	BString& CharacterDeescape(const char* original, char escapeCharacter);
	BString& CharacterDeescape(char escapeCharacter);

	// Printing into the end
	BString& operator<<(const char* string);
	BString& operator<<(const BString& string);
	BString& operator<<(char character);
	BString& operator<<(bool value);
	BString& operator<<(int value);
	BString& operator<<(unsigned int value);
	BString& operator<<(unsigned long value);
	BString& operator<<(long value);
	BString& operator<<(unsigned long long value);
	BString& operator<<(long long value);
	BString& operator<<(float value); // two decimals
	BString& operator<<(double value);

private:
	bool _Resize(int32 length); // keeps what fits; the new bytes are undefined
	BString& _InsertAt(const char* string, int32 length, int32 position);
	BString& _RemoveAt(int32 position, int32 length);
	BString& _ReplaceText(
		const char* from, const char* to, int32 maxCount, int32 fromOffset, bool ignoreCase);

	char* fData; // never NULL; its length and room lie in front of it, see String.cpp
};

// Comparing with the text first
inline bool
operator<(const char* a, const BString& b)
{
	return b > a;
}

inline bool
operator>(const char* a, const BString& b)
{
	return b < a;
}

inline bool
operator<=(const char* a, const BString& b)
{
	return b >= a;
}

inline bool
operator>=(const char* a, const BString& b)
{
	return b <= a;
}

inline bool
operator==(const char* a, const BString& b)
{
	return b == a;
}

inline bool
operator!=(const char* a, const BString& b)
{
	return b != a;
}

inline BString
operator+(const BString& a, const BString& b)
{
	return BString(a).Append(b);
}

inline BString
operator+(const BString& a, const char* b)
{
	return BString(a).Append(b);
}

inline BString
operator+(const char* a, const BString& b)
{
	return BString(a).Append(b);
}

// For sorting: compare the texts, or BStrings through pointers to them.
int Compare(const BString& a, const BString& b);
int ICompare(const BString& a, const BString& b);
int Compare(const BString* a, const BString* b);
int ICompare(const BString* a, const BString* b);
