// TextOrder: the characters of a line in the order and the forms in which they are drawn.
#pragma once

#include <functional>
#include <string_view>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {


// Whether any character is of a script that is written from the right.
bool RunsFromTheRight(std::string_view text);

// An accent or a vowel sign of such a script, which stands above or below the letter before it.
bool IsMarkFromTheRight(uint32 character);

// The characters of one line from left to right, by Unicode's rules for mixed directions without
// explicit embeddings: numbers keep their order, brackets are mirrored and stay round what they hold, marks follow their letter.
// The first letter decides the line's own direction. Arabic letters are replaced by their joined
// forms as far as the font has them; the second half of a ligature becomes a character without ink
// and width, so that there are as many as in the text.
std::vector<uint32> InDrawingOrder(
	const std::vector<uint32>& characters, const std::function<bool(uint32)>& hasForm);


} // namespace BPrivate
