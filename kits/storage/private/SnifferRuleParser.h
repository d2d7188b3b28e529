// SnifferRuleParser: reads the text of a sniffer rule.
#pragma once

#include <string>
#include <string_view>

#include "storage/private/SnifferRule.h"

namespace BPrivate {

// Reads the text once from front to back, without recursion. The text stays the caller's.
class SnifferRuleParser {
public:
	explicit SnifferRuleParser(std::string_view text) : fText(text), fPlace(0) {}

	// False when it is no rule; Error() says why then, and at which character.
	bool Read(SnifferRule* rule);
	const std::string& Error() const { return fError; }

	static char SmallLetter(char letter);

private:
	using Pattern = SnifferRule::Pattern;
	using Expression = SnifferRule::Expression;

	bool _ReadPriority(double* _priority);
	bool _ReadExpression(Expression* expression);
	bool _ReadRange(Pattern* pattern);
	bool _ReadPlace(size_t* _place);
	// `ranged` when the whole list has a range, so that a pattern has none of its own.
	bool _ReadPattern(Pattern* pattern, bool ranged);
	bool _ReadString(const char* what, std::string* _string);
	bool _ReadQuoted(std::string* _string);
	bool _ReadWord(std::string* _string);
	bool _ReadBytes(std::string* _string);
	bool _ReadEscape(std::string* _string);
	bool _ReadFlag();

	bool _AtEnd() const { return fPlace >= fText.size(); }
	bool _Sees(char character) const { return !_AtEnd() && fText[fPlace] == character; }
	bool _SeesSpace() const;
	bool _SeesDigit(int base) const;
	void _SkipSpace();
	bool _Take(char character);
	bool _Fail(size_t place, const char* what);

	std::string_view fText;
	size_t fPlace; // of the next character
	std::string fError;
};

} // namespace BPrivate
