// PlayTokens: the words of a line of a play script.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// What was expected and what was found; thrown and caught on the player's thread alone.
struct PlayError {
	std::string expected;
	std::string found;
};


struct PlayToken {
	enum class Kind { Word, String, Arrow, Index };

	Kind kind = Kind::Word;
	std::string text; // of a string without its quotes and escapes
	int32 index = 0; // of "[n]"
};


// A '#' outside of a string starts a comment.
std::vector<PlayToken> play_tokens(std::string_view line);


class PlayTokenReader {
public:
	explicit PlayTokenReader(std::vector<PlayToken> tokens) : fTokens(std::move(tokens)) {}

	bool AtEnd() const { return fNext == fTokens.size(); }
	const PlayToken* Peek() const { return AtEnd() ? nullptr : &fTokens[fNext]; }
	PlayToken Take(const char* expected);
	bool TakeWord(const char* word); // whether it was next
	bool TakeKind(PlayToken::Kind kind, PlayToken* _token);
	std::string TakeText(const char* expected); // a word or a string
	int32 TakeNumber(const char* expected);
	// "X,Y", each any number.
	void TakePair(const char* expected, float* _x, float* _y);
	std::string TakeRest(); // joined by blanks
	void ExpectEnd() const;

private:
	std::vector<PlayToken> fTokens;
	size_t fNext = 0;
};


} // namespace BPrivate
