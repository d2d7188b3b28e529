#include "storage/private/SnifferRuleParser.h"

#include <string.h>

#include <algorithm>
#include <charconv>

namespace BPrivate {

namespace {

// What ends a word unless a backslash stands before it.
constexpr char kSpecial[] = "()[]|&\"'";
constexpr size_t kLastPlace = INT32_MAX;


int
DigitValue(char digit)
{
	if (digit >= '0' && digit <= '9')
		return digit - '0';
	if (digit >= 'a' && digit <= 'f')
		return digit - 'a' + 10;
	if (digit >= 'A' && digit <= 'F')
		return digit - 'A' + 10;
	return 16;
}

} // namespace


bool
SnifferRuleParser::Read(SnifferRule* rule)
{
	if (fText.size() > SnifferRule::kLongestText)
		return _Fail(SnifferRule::kLongestText, "the rule is too long");
	if (!_ReadPriority(&rule->fPriority))
		return false;
	do {
		Expression expression;
		if (!_ReadExpression(&expression))
			return false;
		rule->fExpressions.push_back(std::move(expression));
		_SkipSpace();
	} while (!_AtEnd());
	return true;
}


char
SnifferRuleParser::SmallLetter(char letter)
{
	return letter >= 'A' && letter <= 'Z' ? letter + ('a' - 'A') : letter;
}


// #pragma mark - private


// The point is a point in every language.
bool
SnifferRuleParser::_ReadPriority(double* _priority)
{
	_SkipSpace();
	const size_t start = fPlace;
	const char* text = fText.data() + start;
	const bool number = _SeesDigit(10) || _Sees('.');
	const auto read = std::from_chars(text, fText.data() + fText.size(), *_priority);
	if (!number || read.ec == std::errc::invalid_argument)
		return _Fail(start, "a priority from 0.0 to 1.0 is expected");
	// One that is too small to be told from 0.0 is still refused like one that is too large.
	if (read.ec != std::errc() || *_priority > 1.0)
		return _Fail(start, "the priority is not from 0.0 to 1.0");
	fPlace += read.ptr - text;
	if (!_AtEnd() && !_SeesSpace() && !_Sees('(') && !_Sees('['))
		return _Fail(fPlace, "a space is expected behind the priority");
	return true;
}


bool
SnifferRuleParser::_ReadExpression(Expression* expression)
{
	_SkipSpace();
	Pattern common = { 0, 0, {}, {} };
	const bool ranged = _Sees('[');
	if (ranged && !_ReadRange(&common))
		return false;
	_SkipSpace();
	if (!_Take('('))
		return _Fail(fPlace, ranged ? "\"(\" is expected" : "\"(\" or \"[\" is expected");
	expression->ignoresCase = _ReadFlag();
	do {
		Pattern pattern = common;
		if (!_ReadPattern(&pattern, ranged))
			return false;
		if (expression->ignoresCase) {
			std::string& value = pattern.value;
			std::transform(value.begin(), value.end(), value.begin(), SmallLetter);
		}
		expression->patterns.push_back(std::move(pattern));
		_SkipSpace();
	} while (_Take('|'));
	return _Take(')') || _Fail(fPlace, "\"|\" or \")\" is expected");
}


bool
SnifferRuleParser::_ReadRange(Pattern* pattern)
{
	const size_t start = fPlace++;
	if (!_ReadPlace(&pattern->first))
		return false;
	pattern->last = pattern->first;
	if (_Take(':')) {
		if (!_ReadPlace(&pattern->last))
			return false;
		if (pattern->last < pattern->first)
			return _Fail(start, "the range ends before it begins");
		return _Take(']') || _Fail(fPlace, "\"]\" is expected");
	}
	return _Take(']') || _Fail(fPlace, "\":\" or \"]\" is expected");
}


bool
SnifferRuleParser::_ReadPlace(size_t* _place)
{
	_SkipSpace();
	const size_t start = fPlace;
	if (!_SeesDigit(10))
		return _Fail(start, "a number is expected");
	*_place = 0;
	for (; _SeesDigit(10); fPlace++) {
		*_place = *_place * 10 + DigitValue(fText[fPlace]);
		if (*_place > kLastPlace)
			return _Fail(start, "the number is too large");
	}
	_SkipSpace();
	return true;
}


bool
SnifferRuleParser::_ReadPattern(Pattern* pattern, bool ranged)
{
	_SkipSpace();
	if (_Sees('[')) {
		if (ranged)
			return _Fail(fPlace, "the list of patterns has a range already");
		if (!_ReadRange(pattern))
			return false;
	}
	if (!_ReadString("a pattern is expected", &pattern->value))
		return false;
	_SkipSpace();
	if (!_Take('&'))
		return true;
	_SkipSpace();
	const size_t start = fPlace;
	if (!_ReadString("a mask is expected", &pattern->mask))
		return false;
	return pattern->mask.size() == pattern->value.size()
		|| _Fail(start, "the mask is not as long as its pattern");
}


bool
SnifferRuleParser::_ReadString(const char* what, std::string* _string)
{
	_SkipSpace();
	const size_t start = fPlace;
	bool read = false;
	if (_Sees('"') || _Sees('\''))
		read = _ReadQuoted(_string);
	else if (fText.substr(fPlace, 2) == "0x" || fText.substr(fPlace, 2) == "0X")
		read = _ReadBytes(_string);
	else if (!_AtEnd() && strchr(kSpecial, fText[fPlace]) == NULL)
		read = _ReadWord(_string);
	else
		return _Fail(start, what);
	return read && (!_string->empty() || _Fail(start, "the text is empty"));
}


bool
SnifferRuleParser::_ReadQuoted(std::string* _string)
{
	const size_t start = fPlace;
	const char quote = fText[fPlace++];
	while (!_AtEnd() && !_Sees(quote)) {
		if (_Sees('\\')) {
			if (!_ReadEscape(_string))
				return false;
		} else
			_string->push_back(fText[fPlace++]);
	}
	return _Take(quote) || _Fail(start, "the quotation mark is never closed");
}


bool
SnifferRuleParser::_ReadWord(std::string* _string)
{
	while (!_AtEnd() && !_SeesSpace() && strchr(kSpecial, fText[fPlace]) == NULL) {
		if (_Sees('\\')) {
			if (!_ReadEscape(_string))
				return false;
		} else
			_string->push_back(fText[fPlace++]);
	}
	return true;
}


bool
SnifferRuleParser::_ReadBytes(std::string* _string)
{
	const size_t start = fPlace;
	fPlace += 2;
	int high = -1;
	for (; !_AtEnd() && !_SeesSpace() && strchr(kSpecial, fText[fPlace]) == NULL; fPlace++) {
		const int digit = DigitValue(fText[fPlace]);
		if (digit >= 16)
			return _Fail(fPlace, "a hexadecimal digit is expected");
		if (high >= 0)
			_string->push_back(static_cast<char>(high * 16 + digit));
		high = high >= 0 ? -1 : digit;
	}
	return high < 0 || _Fail(start, "hexadecimal digits come in pairs");
}


// One to three octal digits, "x" and one or two hexadecimal ones, or a character: those that have
// no meaning in C stand for themselves.
bool
SnifferRuleParser::_ReadEscape(std::string* _string)
{
	const size_t start = fPlace++;
	if (_AtEnd())
		return _Fail(start, "nothing follows the backslash");
	int value = 0;
	const bool hexadecimal = _Sees('x');
	if (!hexadecimal && !_SeesDigit(8)) {
		static constexpr char kLetters[] = "abfnrtv";
		static constexpr char kMeanings[] = "\a\b\f\n\r\t\v";
		const char letter = fText[fPlace++];
		const char* found = letter != '\0' ? strchr(kLetters, letter) : NULL;
		_string->push_back(found != NULL ? kMeanings[found - kLetters] : letter);
		return true;
	}
	if (hexadecimal)
		fPlace++;
	const int base = hexadecimal ? 16 : 8;
	int digits = 0;
	for (; digits < (hexadecimal ? 2 : 3) && _SeesDigit(base); digits++)
		value = value * base + DigitValue(fText[fPlace++]);
	if (digits == 0)
		return _Fail(start, "hexadecimal digits are expected behind \"\\x\"");
	if (value > 0xff)
		return _Fail(start, "the octal number is larger than \\377");
	_string->push_back(static_cast<char>(value));
	return true;
}


// "-i" alone; "-icon" is a word.
bool
SnifferRuleParser::_ReadFlag()
{
	_SkipSpace();
	if (fText.substr(fPlace, 2) != "-i")
		return false;
	fPlace += 2;
	if (_AtEnd() || _SeesSpace() || _Sees('"') || _Sees('\'') || _Sees('['))
		return true;
	fPlace -= 2;
	return false;
}


bool
SnifferRuleParser::_SeesSpace() const
{
	return !_AtEnd() && (fText[fPlace] == ' ' || (fText[fPlace] >= '\t' && fText[fPlace] <= '\r'));
}


bool
SnifferRuleParser::_SeesDigit(int base) const
{
	return !_AtEnd() && DigitValue(fText[fPlace]) < base;
}


void
SnifferRuleParser::_SkipSpace()
{
	while (_SeesSpace())
		fPlace++;
}


bool
SnifferRuleParser::_Take(char character)
{
	const bool there = _Sees(character);
	fPlace += there;
	return there;
}


// A character of several bytes is one character.
bool
SnifferRuleParser::_Fail(size_t place, const char* what)
{
	const std::string_view before = fText.substr(0, place);
	const auto characters = std::count_if(before.begin(), before.end(),
		[](char byte) { return (static_cast<unsigned char>(byte) & 0xc0) != 0x80; });
	fError = "character " + std::to_string(characters + 1) + ": " + what;
	return false;
}

} // namespace BPrivate
