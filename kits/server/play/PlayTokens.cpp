#include "server/play/PlayTokens.h"

#include <cctype>
#include <cstdlib>

namespace BPrivate {

namespace {

std::string
ReadString(std::string_view line, size_t& at)
{
	std::string text;
	for (at++; at < line.size() && line[at] != '"'; at++) {
		if (line[at] != '\\' || at + 1 == line.size()) {
			text += line[at];
			continue;
		}
		at++;
		text += line[at] == 'n' ? '\n' : line[at] == 't' ? '\t' : line[at];
	}
	if (at == line.size())
		throw PlayError { "a closing quote", "the end of the line" };
	at++;
	return text;
}


bool
ReadIndex(std::string_view line, size_t& at, int32* _index)
{
	size_t end = at + 1;
	while (end < line.size() && std::isdigit(static_cast<unsigned char>(line[end])))
		end++;
	if (end == at + 1 || end - at > 9 || end == line.size() || line[end] != ']')
		return false;
	*_index = std::atoi(std::string(line.substr(at + 1, end - at - 1)).c_str());
	at = end + 1;
	return true;
}


bool
ParseNumber(const std::string& text, float* _number)
{
	char* end = nullptr;
	*_number = std::strtof(text.c_str(), &end);
	return end != text.c_str() && *end == '\0';
}

} // namespace


std::vector<PlayToken>
play_tokens(std::string_view line)
{
	std::vector<PlayToken> tokens;
	size_t at = 0;
	while (at < line.size()) {
		PlayToken token;
		if (std::isspace(static_cast<unsigned char>(line[at]))) {
			at++;
			continue;
		}
		if (line[at] == '#')
			break;
		if (line[at] == '"') {
			token.kind = PlayToken::Kind::String;
			token.text = ReadString(line, at);
		} else if (line[at] == '>') {
			token.kind = PlayToken::Kind::Arrow;
			at++;
		} else if (line[at] == '[' && ReadIndex(line, at, &token.index)) {
			token.kind = PlayToken::Kind::Index;
		} else {
			do
				token.text += line[at++];
			while (at < line.size() && !std::isspace(static_cast<unsigned char>(line[at]))
				&& line[at] != '"' && line[at] != '[' && line[at] != '>');
		}
		tokens.push_back(std::move(token));
	}
	return tokens;
}


PlayToken
PlayTokenReader::Take(const char* expected)
{
	if (AtEnd())
		throw PlayError { expected, "the end of the line" };
	return fTokens[fNext++];
}


bool
PlayTokenReader::TakeWord(const char* word)
{
	const PlayToken* next = Peek();
	if (next == nullptr || next->kind != PlayToken::Kind::Word || next->text != word)
		return false;
	fNext++;
	return true;
}


bool
PlayTokenReader::TakeKind(PlayToken::Kind kind, PlayToken* _token)
{
	const PlayToken* next = Peek();
	if (next == nullptr || next->kind != kind)
		return false;
	*_token = *next;
	fNext++;
	return true;
}


std::string
PlayTokenReader::TakeText(const char* expected)
{
	const PlayToken token = Take(expected);
	if (token.kind != PlayToken::Kind::Word && token.kind != PlayToken::Kind::String)
		throw PlayError { expected, token.kind == PlayToken::Kind::Arrow ? ">" : "[n]" };
	return token.text;
}


int32
PlayTokenReader::TakeNumber(const char* expected)
{
	const std::string text = TakeText(expected);
	float number;
	if (!ParseNumber(text, &number))
		throw PlayError { expected, text };
	return static_cast<int32>(number);
}


void
PlayTokenReader::TakePair(const char* expected, float* _x, float* _y)
{
	const std::string text = TakeText(expected);
	const size_t comma = text.find(',');
	if (comma == std::string::npos || !ParseNumber(text.substr(0, comma), _x)
		|| !ParseNumber(text.substr(comma + 1), _y))
		throw PlayError { expected, text };
}


std::string
PlayTokenReader::TakeRest()
{
	std::string rest;
	while (!AtEnd()) {
		if (!rest.empty())
			rest += ' ';
		rest += Take("a value").text;
	}
	return rest;
}


void
PlayTokenReader::ExpectEnd() const
{
	if (!AtEnd())
		throw PlayError { "the end of the line", fTokens[fNext].text };
}


} // namespace BPrivate
