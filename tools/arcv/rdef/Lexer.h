// Cuts resource definition text into tokens.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include <SupportDefs.h>

namespace Arcv {

enum class TokenKind {
	kEnd,
	kIdentifier, // keywords too
	kInteger,
	kFloat,
	kTypeCode,
	kString, // without the final zero
	kRaw,
	kMark, // a comment that means something to us: /*class*/
	kSign, // one character
};

struct Token {
	TokenKind kind = TokenKind::kEnd;
	std::string text; // identifier, string, raw bytes, mark
	uint64 integer = 0; // integer, type code
	double real = 0;
	char sign = 0;
	int32 file = 0; // its number among the lexer's files
	int32 line = 0; // from 1

	bool Is(char character) const { return kind == TokenKind::kSign && sign == character; }
	bool Is(std::string_view word) const { return kind == TokenKind::kIdentifier && text == word; }
};

// Why a text cannot be compiled.
struct RdefError {
	std::string file;
	int32 line;
	std::string reason;
};

class Lexer {
public:
	// Finds an included file by its name; false when there is none.
	using FileFinder =
		std::function<bool(const std::string& name, std::string* _path, std::string* _bytes)>;

	Lexer(std::string name, std::string text, FileFinder finder);

	// False when the text cannot be cut up further; Error() says why.
	bool Next(Token* _token);
	// Whether the next token begins as a type code does.
	bool SeesTypeCode();
	const RdefError& Error() const { return fError; }
	const std::string& FileName(int32 file) const { return fNames[file]; }

private:
	struct Source {
		int32 file;
		std::string text;
		size_t place = 0;
		int32 line = 1;
	};

	Source& _Source() { return fSources.back(); }
	char _Peek(size_t ahead = 0);
	bool _Fail(const std::string& reason);
	bool _SkipToToken(Token* _token, bool* _atToken);
	void _SkipWhite();
	bool _SkipComment(Token* _mark);
	bool _Identifier(Token* _token);
	bool _Sign(Token* _token);
	bool _Hash(Token* _token);
	bool _Include();
	bool _Number(Token* _token);
	bool _Integer(const std::string& digits, int base, uint64* _number);
	bool _CharacterCode(uint64* _number);
	bool _String(Token* _token);
	bool _Escape(std::string* _text);
	bool _Raw(Token* _token);

	std::vector<Source> fSources; // the file that is read, behind those that include it
	std::vector<std::string> fNames;
	FileFinder fFinder;
	RdefError fError;
};

} // namespace Arcv
