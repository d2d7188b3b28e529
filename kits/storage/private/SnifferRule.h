// SnifferRule: tells by the first bytes of a file whether it is of a type.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include <SupportDefs.h>

#include "support/private/Result.h"

namespace BPrivate {

// A rule is a priority from 0.0 to 1.0 and one or more expressions, all of which must match:
//
//	0.8 [0:16] ("%PDF" | "%!PS") (-i "title" | [4] 0xff00 & 0xfff0)
//
// An expression is a list of patterns in parentheses, one of which must match. Its range, or the
// range of each pattern, says where a pattern may begin: the numbers of the first and of the last
// place, or of the only one; without a range it is the first byte. "-i" at the head of a list
// lets capital and small letters be the same. A mask, as long as its pattern, says which bits
// count. Patterns and masks are texts in single or double quotes, bytes as "0x" and pairs of
// hexadecimal digits, or plain words; texts and words may have the escapes of C.
//
// A value; different threads may use one object that none of them changes.
class SnifferRule {
public:
	// Longer texts are no rules, and no rule looks at more bytes: so a match is cheap.
	static constexpr size_t kLongestText = 4096;
	static constexpr size_t kMostBytes = 64 * 1024;

	// B_BAD_MIME_SNIFFER_RULE for what is no rule. `_error`, which may be NULL, says what is wrong
	// then, and at which character, counted from 1.
	static Result<SnifferRule> Parse(std::string_view text, std::string* _error);

	// Whether bytes from the beginning of a file match.
	bool Matches(std::string_view bytes) const;
	double Priority() const { return fPriority; }
	// So many bytes are enough.
	size_t BytesNeeded() const;

private:
	friend class SnifferRuleParser;

	struct Pattern {
		size_t first; // where it may begin
		size_t last;
		std::string value; // not empty; in small letters if case does not count
		std::string mask; // empty, or as long as the value
	};
	struct Expression {
		bool ignoresCase;
		std::vector<Pattern> patterns;
	};

	static bool _Matches(const Expression& expression, std::string_view bytes);
	static bool _MatchesMasked(const Pattern& pattern, std::string_view window);

	double fPriority = 0;
	std::vector<Expression> fExpressions;
};

} // namespace BPrivate
