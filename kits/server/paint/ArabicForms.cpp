#include "server/paint/ArabicForms.h"

#include <cstddef>

namespace BPrivate {

namespace {

constexpr uint32 kLam = 0x644;
constexpr uint32 kStretcher = 0x640;
constexpr uint32 kJoiner = 0x200d;
constexpr uint32 kNoInk = 0x200b;

// A letter and the first of its forms in Unicode's tables: alone, at the end of a word, and, if it
// joins to what follows it, at the beginning and in the middle.
struct Letter {
	uint32 letter;
	uint32 forms;
	int32 count; // 1: joins to nothing
};

constexpr Letter kLetters[] = { { 0x621, 0xfe80, 1 }, { 0x622, 0xfe81, 2 }, { 0x623, 0xfe83, 2 },
	{ 0x624, 0xfe85, 2 }, { 0x625, 0xfe87, 2 }, { 0x626, 0xfe89, 4 }, { 0x627, 0xfe8d, 2 },
	{ 0x628, 0xfe8f, 4 }, { 0x629, 0xfe93, 2 }, { 0x62a, 0xfe95, 4 }, { 0x62b, 0xfe99, 4 },
	{ 0x62c, 0xfe9d, 4 }, { 0x62d, 0xfea1, 4 }, { 0x62e, 0xfea5, 4 }, { 0x62f, 0xfea9, 2 },
	{ 0x630, 0xfeab, 2 }, { 0x631, 0xfead, 2 }, { 0x632, 0xfeaf, 2 }, { 0x633, 0xfeb1, 4 },
	{ 0x634, 0xfeb5, 4 }, { 0x635, 0xfeb9, 4 }, { 0x636, 0xfebd, 4 }, { 0x637, 0xfec1, 4 },
	{ 0x638, 0xfec5, 4 }, { 0x639, 0xfec9, 4 }, { 0x63a, 0xfecd, 4 }, { 0x641, 0xfed1, 4 },
	{ 0x642, 0xfed5, 4 }, { 0x643, 0xfed9, 4 }, { 0x644, 0xfedd, 4 }, { 0x645, 0xfee1, 4 },
	{ 0x646, 0xfee5, 4 }, { 0x647, 0xfee9, 4 }, { 0x648, 0xfeed, 2 }, { 0x649, 0xfeef, 2 },
	{ 0x64a, 0xfef1, 4 }, { 0x67e, 0xfb56, 4 }, { 0x686, 0xfb7a, 4 }, { 0x698, 0xfb8a, 2 },
	{ 0x6a9, 0xfb8e, 4 }, { 0x6af, 0xfb92, 4 }, { 0x6cc, 0xfbfc, 4 } };

// Lam with an alef behind it is one sign: alone, and at the end of a word.
constexpr Letter kLigatures[] = { { 0x622, 0xfef5, 2 }, { 0x623, 0xfef7, 2 }, { 0x625, 0xfef9, 2 },
	{ 0x627, 0xfefb, 2 } };


template<size_t Count>
const Letter*
Find(const Letter (&letters)[Count], uint32 character)
{
	for (const Letter& letter : letters) {
		if (letter.letter == character)
			return &letter;
	}
	return nullptr;
}


bool
IsArabic(uint32 character)
{
	return character >= 0x600 && character <= 0x6ff;
}


// Vowels and other marks above and below do not part letters.
bool
IsMark(uint32 c)
{
	return (c >= 0x610 && c <= 0x61a) || (c >= 0x64b && c <= 0x65f) || c == 0x670
		|| (c >= 0x6d6 && c <= 0x6ed && c != 0x6dd && c != 0x6de && c != 0x6e5 && c != 0x6e6
			&& c != 0x6e9);
}


bool
JoinsToNext(uint32 character)
{
	if (character == kStretcher || character == kJoiner)
		return true;
	const Letter* letter = Find(kLetters, character);
	return letter != nullptr && letter->count == 4;
}


bool
JoinsToPrevious(uint32 character)
{
	if (character == kStretcher || character == kJoiner)
		return true;
	const Letter* letter = Find(kLetters, character);
	return letter != nullptr && letter->count > 1;
}

} // namespace


std::vector<uint32>
JoinedForms(std::vector<uint32> characters, const std::function<bool(uint32)>& hasForm)
{
	const std::vector<uint32> text = characters;
	uint32 previous = 0; // the last one that is no mark
	for (size_t i = 0; i < text.size(); i++) {
		if (IsMark(text[i]))
			continue;
		const Letter* letter = IsArabic(text[i]) ? Find(kLetters, text[i]) : nullptr;
		const uint32 before = previous;
		previous = text[i];
		if (letter == nullptr)
			continue;

		size_t next = i + 1;
		while (next < text.size() && IsMark(text[next]))
			next++;
		const uint32 following = next < text.size() ? text[next] : 0;
		const int32 joinsBefore = JoinsToNext(before) && letter->count > 1 ? 1 : 0;
		const Letter* ligature = text[i] == kLam ? Find(kLigatures, following) : nullptr;
		if (ligature != nullptr && hasForm(ligature->forms + joinsBefore)) {
			characters[i] = ligature->forms + joinsBefore;
			characters[next] = kNoInk;
			previous = following;
			i = next;
			continue;
		}
		const int32 joinsNext = letter->count == 4 && JoinsToPrevious(following) ? 2 : 0;
		const uint32 form = letter->forms + joinsBefore + joinsNext;
		if (hasForm(form))
			characters[i] = form;
	}
	return characters;
}


} // namespace BPrivate
