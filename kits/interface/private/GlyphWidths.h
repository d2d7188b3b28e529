// GlyphWidths: how wide each character of a font is, asked from the font once.
#pragma once

#include <array>
#include <mutex>
#include <unordered_map>
#include <vector>

#include <Font.h>

namespace BPrivate {


// One per font, kept for the life of the program. Any thread.
class GlyphWidths {
public:
	static const GlyphWidths& For(const BFont& font);

	explicit GlyphWidths(const BFont& font);

	// Of a character that stands for itself, see is_simple_character().
	float Width(uint32 character) const
	{
		return character < fCommon.size() ? fCommon[character] : _OtherWidth(character);
	}
	// Of characters that may change with their neighbours; asks the font each time.
	std::vector<float> Advances(const char* text, int32 length) const;

	// Whole pixels.
	float Ascent() const { return fAscent; }
	float LineHeight() const { return fLineHeight; }

private:
	float _OtherWidth(uint32 character) const;

	BFont fFont;
	float fAscent;
	float fLineHeight;
	std::array<float, 0x100> fCommon;
	mutable std::mutex fLock;
	mutable std::unordered_map<uint32, float> fOthers;
};


// Whether the character's width never depends on what stands next to it.
bool is_simple_character(uint32 character);
// Whether it is drawn on the character before it, so that no caret belongs between the two.
bool is_mark_character(uint32 character);


} // namespace BPrivate
