#include "storage/private/SnifferRule.h"

#include <string.h>

#include <algorithm>

#include "storage/private/SnifferRuleParser.h"

namespace BPrivate {

Result<SnifferRule>
SnifferRule::Parse(std::string_view text, std::string* _error)
{
	SnifferRule rule;
	SnifferRuleParser parser(text);
	if (parser.Read(&rule))
		return rule;
	if (_error != NULL)
		*_error = parser.Error();
	return B_BAD_MIME_SNIFFER_RULE;
}


bool
SnifferRule::Matches(std::string_view bytes) const
{
	bytes = bytes.substr(0, kMostBytes);
	return std::all_of(fExpressions.begin(), fExpressions.end(),
		[&](const Expression& expression) { return _Matches(expression, bytes); });
}


size_t
SnifferRule::BytesNeeded() const
{
	size_t needed = 0;
	for (const Expression& expression : fExpressions) {
		for (const Pattern& pattern : expression.patterns)
			needed = std::max(needed, pattern.last + pattern.value.size());
	}
	return std::min(needed, kMostBytes);
}


// #pragma mark - private


bool
SnifferRule::_Matches(const Expression& expression, std::string_view bytes)
{
	std::string small;
	if (expression.ignoresCase) {
		small = bytes;
		std::transform(small.begin(), small.end(), small.begin(), SnifferRuleParser::SmallLetter);
		bytes = small;
	}
	for (const Pattern& pattern : expression.patterns) {
		if (pattern.first >= bytes.size())
			continue;
		const size_t places = pattern.last - pattern.first;
		const std::string_view window = bytes.substr(pattern.first, places + pattern.value.size());
		// A plain search takes time that grows with the window alone, whatever the bytes are.
		const bool found = pattern.mask.empty()
			? memmem(window.data(), window.size(), pattern.value.data(), pattern.value.size())
				!= NULL
			: _MatchesMasked(pattern, window);
		if (found)
			return true;
	}
	return false;
}


bool
SnifferRule::_MatchesMasked(const Pattern& pattern, std::string_view window)
{
	const size_t length = pattern.value.size();
	for (size_t at = 0; at + length <= window.size(); at++) {
		size_t same = 0;
		while (
			same < length && ((window[at + same] ^ pattern.value[same]) & pattern.mask[same]) == 0)
			same++;
		if (same == length)
			return true;
	}
	return false;
}

} // namespace BPrivate
