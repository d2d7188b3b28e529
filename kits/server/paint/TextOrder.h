// TextOrder: the characters of a line in the order and the forms in which they are drawn.
#pragma once

#include <functional>
#include <string_view>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// Whether any character is of a script that is written from the right, or the text as a whole is
// said to be.
bool RunsFromTheRight(std::string_view text);
bool RunsFromTheRight(uint32 character);

// An accent or a vowel sign of such a script, which stands above or below the letter before it.
bool IsMarkFromTheRight(uint32 character);

// Where a line starts. Of itself: at the side of its first letter, or left without letters.
enum class LineStart : uint8 { OfItself, Left, Right };
LineStart StartOf(const std::vector<uint32>& characters); // OfItself when there is no letter
LineStart SideOf(uint32 character); // OfItself of what is no letter

// Before a text: all of it runs from the left, or from the right, whatever its characters are.
constexpr uint32 kAllFromTheLeft = 0x202d;
constexpr uint32 kAllFromTheRight = 0x202e;

struct OrderedCharacter {
	uint32 character; // as it is drawn
	uint32 index; // in the text
	bool fromRight;
};

// The characters of one line from left to right, by Unicode's rules for mixed directions without
// embeddings: numbers keep their order, brackets are mirrored and stay round what they hold, marks
// follow their letter. Arabic letters are replaced by their joined forms as far as the font has
// them; the second half of a ligature becomes a character without ink and width, so that there are
// as many as in the text.
std::vector<OrderedCharacter> InDrawingOrder(const std::vector<uint32>& characters,
	const std::function<bool(uint32)>& hasForm, LineStart start = LineStart::OfItself);


} // namespace BPrivate
