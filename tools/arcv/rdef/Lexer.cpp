#include "tools/arcv/rdef/Lexer.h"

#include <stdlib.h>
#include <string.h>

namespace Arcv {

namespace {

constexpr size_t kMostIncludes = 32; // of one another

bool
IsWhite(char character)
{
	return character != '\0' && strchr(" \t\n\r\f", character) != NULL;
}


bool
IsDigit(char character)
{
	return character >= '0' && character <= '9';
}


bool
IsLetter(char character)
{
	return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z')
		|| character == '_';
}


int
HexValue(char character)
{
	if (IsDigit(character))
		return character - '0';
	if (character >= 'a' && character <= 'f')
		return character - 'a' + 10;
	return character >= 'A' && character <= 'F' ? character - 'A' + 10 : -1;
}


bool
IsOctal(char character)
{
	return character >= '0' && character <= '7';
}

} // namespace


Lexer::Lexer(std::string name, std::string text, FileFinder finder) : fFinder(std::move(finder))
{
	fNames.push_back(std::move(name));
	fSources.push_back({ 0, std::move(text) });
}


bool
Lexer::Next(Token* _token)
{
	*_token = Token();
	bool atToken = false;
	while (!atToken) {
		if (!_SkipToToken(_token, &atToken))
			return false;
	}
	if (_token->kind == TokenKind::kMark || _Source().place >= _Source().text.size())
		return true;

	const char next = _Peek();
	if (next == '#')
		return _Hash(_token);
	if (next == '"')
		return _String(_token);
	if (next == '$')
		return _Raw(_token);
	if (next == '\'') {
		_token->kind = TokenKind::kInteger;
		return _CharacterCode(&_token->integer);
	}
	if (IsDigit(next) || (next == '.' && IsDigit(_Peek(1))))
		return _Number(_token);
	return IsLetter(next) ? _Identifier(_token) : _Sign(_token);
}


bool
Lexer::SeesTypeCode()
{
	_SkipWhite();
	return _Peek() == '#';
}


// #pragma mark - private


char
Lexer::_Peek(size_t ahead)
{
	const Source& source = _Source();
	return source.place + ahead < source.text.size() ? source.text[source.place + ahead] : '\0';
}


bool
Lexer::_Fail(const std::string& reason)
{
	fError = { fNames[_Source().file], _Source().line, reason };
	return false;
}


// One step over what is no token, which may be into an included file or out of it.
bool
Lexer::_SkipToToken(Token* _token, bool* _atToken)
{
	_SkipWhite();
	Source& source = _Source();
	_token->file = source.file;
	_token->line = source.line;
	if (source.place >= source.text.size()) {
		*_atToken = fSources.size() == 1;
		if (!*_atToken)
			fSources.pop_back(); // the rest of the file that included this one
		return true;
	}
	if (_Peek() == '/' && (_Peek(1) == '/' || _Peek(1) == '*')) {
		const bool skipped = _SkipComment(_token);
		*_atToken = _token->kind == TokenKind::kMark;
		return skipped;
	}
	if (_Peek() == '#' && source.text.compare(source.place, 8, "#include") == 0)
		return _Include();
	*_atToken = true;
	return true;
}


void
Lexer::_SkipWhite()
{
	Source& source = _Source();
	for (; source.place < source.text.size() && IsWhite(source.text[source.place]);
		 source.place++) {
		if (source.text[source.place] == '\n')
			source.line++;
	}
}


bool
Lexer::_SkipComment(Token* _mark)
{
	Source& source = _Source();
	if (_Peek(1) == '/') {
		source.place = std::min(source.text.find('\n', source.place), source.text.size());
		return true;
	}
	const size_t end = source.text.find("*/", source.place + 2);
	if (end == std::string::npos)
		return _Fail("a comment has no end");
	const std::string text = source.text.substr(source.place + 2, end - source.place - 2);
	for (const char character : text)
		source.line += character == '\n';
	source.place = end + 2;
	if (text == "class") {
		_mark->kind = TokenKind::kMark;
		_mark->text = text;
	}
	return true;
}


bool
Lexer::_Identifier(Token* _token)
{
	_token->kind = TokenKind::kIdentifier;
	while (IsLetter(_Peek()) || IsDigit(_Peek()))
		_token->text += _Source().text[_Source().place++];
	return true;
}


bool
Lexer::_Sign(Token* _token)
{
	const char next = _Peek();
	if (strchr("(){}[],;=|^&+-*/%~", next) == NULL || next == '\0')
		return _Fail("there is a character that means nothing here");
	_token->kind = TokenKind::kSign;
	_token->sign = next;
	_Source().place++;
	return true;
}


bool
Lexer::_Hash(Token* _token)
{
	_token->kind = TokenKind::kTypeCode;
	_Source().place++;
	if (_Peek() == '\'')
		return _CharacterCode(&_token->integer);
	if (!IsDigit(_Peek()))
		return _Fail("a type code is four characters or a number");
	Token number;
	if (!_Number(&number))
		return false;
	if (number.kind != TokenKind::kInteger || number.integer > 0xffffffff)
		return _Fail("a type code has 32 bits");
	_token->integer = number.integer;
	return true;
}


bool
Lexer::_Include()
{
	_Source().place += 8;
	_SkipWhite();
	Token name;
	if (_Peek() != '"')
		return _Fail("#include needs the name of a file");
	if (!_String(&name))
		return false;
	if (fSources.size() >= kMostIncludes)
		return _Fail("files include each other too often");
	std::string path;
	std::string bytes;
	if (!fFinder(name.text, &path, &bytes))
		return _Fail("the included file \"" + name.text + "\" is not found");
	fNames.push_back(path);
	fSources.push_back({ static_cast<int32>(fNames.size() - 1), std::move(bytes) });
	return true;
}


bool
Lexer::_Number(Token* _token)
{
	Source& source = _Source();
	const size_t start = source.place;
	_token->kind = TokenKind::kInteger;
	if (_Peek() == '0' && (_Peek(1) == 'x' || _Peek(1) == 'X' || _Peek(1) == 'b')) {
		const int base = _Peek(1) == 'b' ? 2 : 16;
		source.place += 2;
		std::string digits;
		while (HexValue(_Peek()) >= 0)
			digits += source.text[source.place++];
		return _Integer(digits, base, &_token->integer);
	}

	while (IsDigit(_Peek()))
		source.place++;
	bool real = false;
	if (_Peek() == '.') {
		real = true;
		source.place++;
		while (IsDigit(_Peek()))
			source.place++;
	}
	const size_t exponent = _Peek(1) == '-' || _Peek(1) == '+' ? 2 : 1;
	if ((_Peek() == 'e' || _Peek() == 'E') && IsDigit(_Peek(exponent))) {
		real = true;
		source.place += exponent;
		while (IsDigit(_Peek()))
			source.place++;
	}
	const std::string digits = source.text.substr(start, source.place - start);
	if (real) {
		_token->kind = TokenKind::kFloat;
		_token->real = strtod(digits.c_str(), NULL);
		return true;
	}
	// A zero in front makes it octal, unless a digit says otherwise.
	const bool octal =
		digits.size() > 1 && digits[0] == '0' && digits.find_first_of("89") == std::string::npos;
	return _Integer(digits, octal ? 8 : 10, &_token->integer);
}


bool
Lexer::_Integer(const std::string& digits, int base, uint64* _number)
{
	uint64 number = 0;
	for (const char character : digits) {
		const int digit = HexValue(character);
		if (digit >= base)
			return _Fail("this is no number");
		if (number > (UINT64_MAX - digit) / base)
			return _Fail("the number has more than 64 bits");
		number = number * base + digit;
	}
	if (digits.empty())
		return _Fail("this is no number");
	*_number = number;
	return true;
}


bool
Lexer::_CharacterCode(uint64* _number)
{
	Source& source = _Source();
	if (source.text.size() - source.place < 6 || source.text[source.place + 5] != '\'')
		return _Fail("a code is four characters in quotes");
	uint64 number = 0;
	for (size_t i = 1; i < 5; i++)
		number = number << 8 | static_cast<uint8>(source.text[source.place + i]);
	source.place += 6;
	*_number = number;
	return true;
}


// Strings with only white space between them are one.
bool
Lexer::_String(Token* _token)
{
	_token->kind = TokenKind::kString;
	do {
		Source& source = _Source();
		source.place++;
		for (;;) {
			if (source.place >= source.text.size() || _Peek() == '\n')
				return _Fail("a string has no end on its line");
			const char next = source.text[source.place++];
			if (next == '"')
				break;
			if (next != '\\')
				_token->text += next;
			else if (!_Escape(&_token->text))
				return false;
		}
		_SkipWhite();
	} while (_Peek() == '"');
	return true;
}


bool
Lexer::_Escape(std::string* _text)
{
	Source& source = _Source();
	const auto hex = [&](size_t ahead) {
		const int high = HexValue(_Peek(ahead));
		const int low = high < 0 ? -1 : HexValue(_Peek(ahead + 1));
		return low < 0 ? -1 : high * 16 + low;
	};
	const char next = _Peek();
	if (next == '0' && _Peek(1) == 'x' && hex(2) >= 0) {
		*_text += static_cast<char>(hex(2));
		source.place += 4;
	} else if (next == 'x' && hex(1) >= 0) {
		*_text += static_cast<char>(hex(1));
		source.place += 3;
	} else if (IsOctal(next) && IsOctal(_Peek(1)) && IsOctal(_Peek(2))) {
		*_text += static_cast<char>((next - '0') * 64 + (_Peek(1) - '0') * 8 + (_Peek(2) - '0'));
		source.place += 3;
	} else {
		static const char kLetters[] = "bfnrtv0";
		static const char kValues[] = "\b\f\n\r\t\v\0";
		if (next == '\0' || next == '\n')
			return _Fail("a string has no end on its line");
		const char* letter = strchr(kLetters, next);
		*_text += letter != NULL ? kValues[letter - kLetters] : next;
		source.place++;
	}
	return true;
}


bool
Lexer::_Raw(Token* _token)
{
	_token->kind = TokenKind::kRaw;
	while (_Peek() == '$') {
		if (_Peek(1) != '"')
			return _Fail("raw data are hexadecimal digits in quotes");
		Source& source = _Source();
		source.place += 2;
		while (_Peek() != '"') {
			const int high = HexValue(_Peek());
			const int low = high < 0 ? -1 : HexValue(_Peek(1));
			if (low < 0)
				return _Fail("raw data are an even number of hexadecimal digits");
			_token->text += static_cast<char>(high * 16 + low);
			source.place += 2;
		}
		source.place++;
		_SkipWhite();
	}
	return true;
}

} // namespace Arcv
