#include "server/paint/TextOrder.h"

#include <algorithm>
#include <utility>

#include "server/paint/ArabicForms.h"
#include "server/paint/FontEngine.h"

namespace BPrivate {

namespace {

// The bidirectional classes of Unicode that matter without explicit embeddings.
enum class Kind : uint8 {
	Left,
	Right,
	Arabic,
	Number,
	ArabicNumber,
	Sign, // between two numbers: plus, minus
	Terminator, // beside a number: currencies, percent
	Separator, // within a number: comma, point, colon
	Mark, // belongs to the character before it
	Space,
	Neutral
};


constexpr bool
IsWithin(uint32 character, uint32 first, uint32 last)
{
	return character >= first && character <= last;
}


bool
IsMark(uint32 c)
{
	return IsWithin(c, 0x300, 0x36f) || IsWithin(c, 0x591, 0x5bd) || c == 0x5bf
		|| IsWithin(c, 0x5c1, 0x5c2) || IsWithin(c, 0x5c4, 0x5c5) || c == 0x5c7
		|| IsWithin(c, 0x610, 0x61a) || IsWithin(c, 0x64b, 0x65f) || c == 0x670
		|| IsWithin(c, 0x6d6, 0x6dc) || IsWithin(c, 0x6df, 0x6e4) || IsWithin(c, 0x6e7, 0x6e8)
		|| IsWithin(c, 0x6ea, 0x6ed) || IsWithin(c, 0x8d3, 0x8ff) || c == 0xfb1e;
}


Kind
AsciiKind(uint32 c)
{
	if (IsWithin(c, '0', '9'))
		return Kind::Number;
	if (IsWithin(c | 0x20, 'a', 'z'))
		return Kind::Left;
	if (c == ' ' || c == '\t' || c == '\n')
		return Kind::Space;
	if (c == '+' || c == '-')
		return Kind::Sign;
	if (c == '#' || c == '$' || c == '%')
		return Kind::Terminator;
	return c == ',' || c == '.' || c == '/' || c == ':' ? Kind::Separator : Kind::Neutral;
}


Kind
KindOf(uint32 c)
{
	if (c < 0x80)
		return AsciiKind(c);
	if (IsMark(c))
		return Kind::Mark;
	if (IsWithin(c, 0x660, 0x669) || c == 0x66b || c == 0x66c || c == 0x6dd)
		return Kind::ArabicNumber;
	if (IsWithin(c, 0x6f0, 0x6f9))
		return Kind::Number;
	if (c == 0x66a || IsWithin(c, 0xa2, 0xa5) || c == 0xb0 || c == 0xb1
		|| IsWithin(c, 0x2030, 0x2034) || IsWithin(c, 0x20a0, 0x20cf))
		return Kind::Terminator;
	if (c == 0x60c || c == 0xa0)
		return Kind::Separator;
	if (IsWithin(c, 0x590, 0x5ff) || IsWithin(c, 0x7c0, 0x85f) || IsWithin(c, 0xfb1d, 0xfb4f)
		|| c == 0x200f)
		return Kind::Right;
	if (IsWithin(c, 0x600, 0x7bf) || IsWithin(c, 0x860, 0x8ff) || IsWithin(c, 0xfb50, 0xfdff)
		|| IsWithin(c, 0xfe70, 0xfefe))
		return Kind::Arabic;
	if (IsWithin(c, 0x2000, 0x200a) || c == 0x3000)
		return Kind::Space;
	if (c == 0x200e)
		return Kind::Left;
	const bool isSymbol = IsWithin(c, 0x80, 0xbf) || c == 0xd7 || c == 0xf7
		|| IsWithin(c, 0x200b, 0x20ff) || IsWithin(c, 0x2190, 0x2bff)
		|| IsWithin(c, 0x3001, 0x3004);
	return isSymbol && c != 0xaa && c != 0xb5 && c != 0xba ? Kind::Neutral : Kind::Left;
}


bool
IsRightward(Kind kind)
{
	return kind == Kind::Right || kind == Kind::Arabic;
}


// Numbers count as from the right.
Kind
SideOf(Kind kind)
{
	return kind == Kind::Left ? Kind::Left : Kind::Right;
}


uint32
Mirrored(uint32 c)
{
	static constexpr uint32 kPairs[][2] = { { '(', ')' }, { '[', ']' }, { '{', '}' }, { '<', '>' },
		{ 0xab, 0xbb }, { 0x2039, 0x203a }, { 0x2264, 0x2265 } };
	for (const auto& pair : kPairs) {
		if (c == pair[0] || c == pair[1])
			return c == pair[0] ? pair[1] : pair[0];
	}
	return c;
}


// One line: its characters with their kinds, as the rules change them, and the levels they get.
class Line {
public:
	Line(const std::vector<uint32>& characters, std::vector<uint32> forms, LineStart start);

	std::vector<OrderedCharacter> Ordered();

private:
	Kind _Before(size_t index) const { return index > 0 ? fKinds[index - 1] : fBase; }
	void _FollowOverride();
	void _ResolveMarks();
	void _ResolveNumbers();
	void _ResolveSeparators();
	void _ResolveTerminators();
	void _ResolveBrackets();
	void _ResolvePair(size_t open, size_t close);
	void _ResolveNeutrals();
	void _SetLevels();
	void _Reverse(uint8 level);
	void _MirrorAndMoveMarks(size_t from, size_t to);

	const std::vector<uint32>& fText; // borrowed
	std::vector<OrderedCharacter> fCharacters;
	std::vector<Kind> fKinds;
	std::vector<uint8> fLevels;
	Kind fBase = Kind::Left; // what the line starts and ends with
};


Line::Line(const std::vector<uint32>& characters, std::vector<uint32> forms, LineStart start) :
	fText(characters), fKinds(characters.size()), fLevels(characters.size())
{
	fCharacters.reserve(forms.size());
	for (uint32 i = 0; i < forms.size(); i++)
		fCharacters.push_back({ forms[i], i, false });
	std::transform(characters.begin(), characters.end(), fKinds.begin(), KindOf);
	_FollowOverride();
	if (start == LineStart::OfItself)
		start = StartOf(characters);
	if (start == LineStart::Right)
		fBase = Kind::Right;
}


std::vector<OrderedCharacter>
Line::Ordered()
{
	_ResolveMarks();
	_ResolveNumbers();
	_ResolveSeparators();
	_ResolveTerminators();
	_ResolveBrackets();
	_ResolveNeutrals();
	_SetLevels();
	for (size_t i = 0; i < fLevels.size(); i++)
		fCharacters[i].fromRight = fLevels[i] == 1;
	const uint8 highest = *std::max_element(fLevels.begin(), fLevels.end());
	for (uint8 level = highest; level > 0; level--)
		_Reverse(level);
	return std::move(fCharacters);
}


void
Line::_FollowOverride()
{
	if (fText[0] == kAllFromTheLeft)
		std::fill(fKinds.begin(), fKinds.end(), Kind::Left);
	else if (fText[0] == kAllFromTheRight)
		std::fill(fKinds.begin(), fKinds.end(), Kind::Right);
}


void
Line::_ResolveMarks()
{
	for (size_t i = 0; i < fKinds.size(); i++) {
		if (fKinds[i] == Kind::Mark)
			fKinds[i] = _Before(i);
	}
}


// Behind Arabic letters numbers are Arabic ones; from here on those letters are as others.
void
Line::_ResolveNumbers()
{
	Kind strong = fBase;
	for (Kind& kind : fKinds) {
		if (kind == Kind::Number && strong == Kind::Arabic)
			kind = Kind::ArabicNumber;
		else if (kind == Kind::Left || IsRightward(kind))
			strong = kind;
	}
	std::replace(fKinds.begin(), fKinds.end(), Kind::Arabic, Kind::Right);
}


// One sign or separator between two numbers of one kind belongs to them.
void
Line::_ResolveSeparators()
{
	for (size_t i = 0; i < fKinds.size(); i++) {
		const Kind kind = fKinds[i];
		if (kind != Kind::Sign && kind != Kind::Separator)
			continue;
		const Kind before = _Before(i);
		const bool between = i + 1 < fKinds.size() && before == fKinds[i + 1];
		if (between && (before == Kind::Number || before == Kind::ArabicNumber)
			&& (kind == Kind::Separator || before == Kind::Number))
			fKinds[i] = before;
		else
			fKinds[i] = Kind::Neutral;
	}
}


// Terminators beside a number belong to it. A number of a part that runs from the left is as its
// letters.
void
Line::_ResolveTerminators()
{
	for (size_t i = 0; i < fKinds.size();) {
		if (fKinds[i] != Kind::Terminator) {
			i++;
			continue;
		}
		size_t end = i;
		while (end < fKinds.size() && fKinds[end] == Kind::Terminator)
			end++;
		const bool beside =
			_Before(i) == Kind::Number || (end < fKinds.size() && fKinds[end] == Kind::Number);
		std::fill(fKinds.begin() + i, fKinds.begin() + end, beside ? Kind::Number : Kind::Neutral);
		i = end;
	}
	Kind strong = fBase;
	for (Kind& kind : fKinds) {
		if (kind == Kind::Number && strong == Kind::Left)
			kind = Kind::Left;
		else if (kind == Kind::Left || kind == Kind::Right)
			strong = kind;
	}
}


// Of brackets within each other the outer ones come first.
void
Line::_ResolveBrackets()
{
	static constexpr std::string_view kOpen = "([{", kClose = ")]}";
	std::vector<size_t> open;
	std::vector<std::pair<size_t, size_t>> pairs;
	for (size_t i = 0; i < fText.size(); i++) {
		if (fKinds[i] != Kind::Neutral || fText[i] >= 0x80)
			continue;
		const char bracket = static_cast<char>(fText[i]);
		if (kOpen.find(bracket) != kOpen.npos)
			open.push_back(i);
		const size_t kind = kClose.find(bracket);
		if (kind == kClose.npos)
			continue;
		for (size_t at = open.size(); at-- > 0;) {
			if (fText[open[at]] == static_cast<uint32>(kOpen[kind])) {
				pairs.emplace_back(open[at], i);
				open.resize(at);
				break;
			}
		}
	}
	std::sort(pairs.begin(), pairs.end());
	for (const auto& [from, to] : pairs)
		_ResolvePair(from, to);
}


// Brackets go with what they hold, if that is of the line's own direction or of that before them.
void
Line::_ResolvePair(size_t open, size_t close)
{
	bool holdsBase = false, holdsOther = false;
	for (size_t i = open + 1; i < close; i++) {
		if (fKinds[i] != Kind::Neutral && fKinds[i] != Kind::Space)
			(SideOf(fKinds[i]) == fBase ? holdsBase : holdsOther) = true;
	}
	if (!holdsBase && !holdsOther)
		return;
	Kind before = fBase;
	for (size_t i = open; i-- > 0;) {
		if (fKinds[i] != Kind::Neutral && fKinds[i] != Kind::Space) {
			before = SideOf(fKinds[i]);
			break;
		}
	}
	fKinds[open] = fKinds[close] = holdsBase ? fBase : before;
}


// Between parts of one direction they take that, numbers counting as from the right; otherwise the
// line's own.
void
Line::_ResolveNeutrals()
{
	for (size_t i = 0; i < fKinds.size();) {
		if (fKinds[i] != Kind::Neutral && fKinds[i] != Kind::Space) {
			i++;
			continue;
		}
		size_t end = i;
		while (end < fKinds.size() && (fKinds[end] == Kind::Neutral || fKinds[end] == Kind::Space))
			end++;
		const Kind before = SideOf(_Before(i));
		const Kind behind = end < fKinds.size() ? SideOf(fKinds[end]) : fBase;
		std::fill(fKinds.begin() + i, fKinds.begin() + end, before == behind ? before : fBase);
		i = end;
	}
}


void
Line::_SetLevels()
{
	const uint8 base = fBase == Kind::Right ? 1 : 0;
	for (size_t i = 0; i < fKinds.size(); i++) {
		switch (fKinds[i]) {
			case Kind::Left:
				fLevels[i] = base == 1 ? 2 : 0;
				break;

			case Kind::Number:
			case Kind::ArabicNumber:
				fLevels[i] = 2;
				break;

			default:
				fLevels[i] = 1;
				break;
		}
	}
	// Space at the line's end is on the side where the line ends.
	const bool isForced = fText[0] == kAllFromTheLeft || fText[0] == kAllFromTheRight;
	for (size_t i = fKinds.size(); !isForced && i-- > 0 && KindOf(fText[i]) == Kind::Space;)
		fLevels[i] = base;
}


// Turns round every part of at least that level.
void
Line::_Reverse(uint8 level)
{
	for (size_t i = 0; i < fLevels.size();) {
		if (fLevels[i] < level) {
			i++;
			continue;
		}
		size_t end = i;
		while (end < fLevels.size() && fLevels[end] >= level)
			end++;
		std::reverse(fCharacters.begin() + i, fCharacters.begin() + end);
		std::reverse(fLevels.begin() + i, fLevels.begin() + end);
		if (level == 1)
			_MirrorAndMoveMarks(i, end);
		i = end;
	}
}


// Of a part that was turned round: marks are put behind their letters again.
void
Line::_MirrorAndMoveMarks(size_t from, size_t to)
{
	for (size_t at = from; at < to; at++) {
		if (fLevels[at] == 1)
			fCharacters[at].character = Mirrored(fCharacters[at].character);
	}
	for (size_t at = from; at < to; at++) {
		size_t letter = at;
		while (letter < to && fLevels[letter] == 1 && IsMark(fCharacters[letter].character))
			letter++;
		if (letter > at && letter < to)
			std::reverse(fCharacters.begin() + at, fCharacters.begin() + letter + 1);
		at = letter;
	}
}

} // namespace


bool
RunsFromTheRight(std::string_view text)
{
	for (size_t at = 0; at < text.size();) {
		const uint8 first = text[at];
		// Nothing from the right is below U+0590 in UTF-8.
		if (first < 0xd6) {
			at++;
			continue;
		}
		if (RunsFromTheRight(NextCharacter(text, &at)))
			return true;
	}
	return false;
}


bool
RunsFromTheRight(uint32 character)
{
	const Kind kind = KindOf(character);
	return IsRightward(kind) || kind == Kind::ArabicNumber || character == kAllFromTheRight;
}


bool
IsMarkFromTheRight(uint32 character)
{
	return character >= 0x590 && IsMark(character);
}


LineStart
StartOf(const std::vector<uint32>& characters)
{
	for (const uint32 character : characters) {
		const LineStart side = SideOf(character);
		if (side != LineStart::OfItself)
			return side;
	}
	return LineStart::OfItself;
}


LineStart
SideOf(uint32 character)
{
	const Kind kind = KindOf(character);
	if (kind == Kind::Left || character == kAllFromTheLeft)
		return LineStart::Left;
	const bool isRight = IsRightward(kind) || character == kAllFromTheRight;
	return isRight ? LineStart::Right : LineStart::OfItself;
}


std::vector<OrderedCharacter>
InDrawingOrder(const std::vector<uint32>& characters, const std::function<bool(uint32)>& hasForm,
	LineStart start)
{
	if (characters.empty())
		return {};
	return Line(characters, JoinedForms(characters, hasForm), start).Ordered();
}


} // namespace BPrivate
