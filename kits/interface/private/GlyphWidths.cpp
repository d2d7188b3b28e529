#include "interface/private/GlyphWidths.h"

#include <algorithm>
#include <cmath>
#include <memory>
#include <span>

#include "interface/private/FontAccess.h"
#include "interface/private/TextModel.h"
#include "server/paint/FontEngine.h"

namespace BPrivate {

namespace {

struct Range {
	uint32 first, last;
};

// Sorted. Accents, vowel signs, joiners and selectors.
constexpr Range kMarks[] = { { 0x300, 0x36f }, { 0x483, 0x489 }, { 0x591, 0x5bd }, { 0x5bf, 0x5bf },
	{ 0x5c1, 0x5c2 }, { 0x5c4, 0x5c5 }, { 0x5c7, 0x5c7 }, { 0x610, 0x61a }, { 0x64b, 0x65f },
	{ 0x670, 0x670 }, { 0x6d6, 0x6dc }, { 0x6df, 0x6e4 }, { 0x6e7, 0x6e8 }, { 0x6ea, 0x6ed },
	{ 0x900, 0x903 }, { 0x93a, 0x93c }, { 0x93e, 0x94f }, { 0x955, 0x957 }, { 0x962, 0x963 },
	{ 0x981, 0x983 }, { 0x9bc, 0x9bc }, { 0x9be, 0x9cd }, { 0xe31, 0xe31 }, { 0xe34, 0xe3a },
	{ 0xe47, 0xe4e }, { 0xeb1, 0xeb1 }, { 0xeb4, 0xebc }, { 0xec8, 0xece }, { 0x1160, 0x11ff },
	{ 0x1ab0, 0x1aff }, { 0x1dc0, 0x1dff }, { 0x200d, 0x200d }, { 0x20d0, 0x20ff },
	{ 0x302a, 0x302f }, { 0x3099, 0x309a }, { 0xfe00, 0xfe0f }, { 0xfe20, 0xfe2f },
	{ 0x1f3fb, 0x1f3ff }, { 0xe0100, 0xe01ef } };

// Sorted. Scripts whose letters neither join nor carry marks, less the marks above.
constexpr Range kSimple[] = { { 0x20, 0x2ff }, { 0x370, 0x58f }, { 0x10a0, 0x10ff },
	{ 0x1e00, 0x200a }, { 0x2010, 0x2027 }, { 0x202f, 0x205e }, { 0x2070, 0x218f },
	{ 0x2190, 0x25ff }, { 0x2e80, 0xa4cf }, { 0xac00, 0xd7a3 }, { 0xf900, 0xfaff },
	{ 0xff01, 0xffdc }, { 0xfffd, 0xfffd }, { 0x20000, 0x3ffff } };


bool
contains(std::span<const Range> ranges, uint32 character)
{
	const auto after = std::upper_bound(ranges.begin(), ranges.end(), character,
		[](uint32 value, const Range& range) { return value < range.first; });
	return after != ranges.begin() && character <= std::prev(after)->last;
}


// Equal keys give equal widths.
size_t
hash_of(const BFont& font)
{
	const auto mix = [](size_t seed, float value) { return seed * 31 + std::hash<float>()(value); };
	size_t seed = font.FamilyAndStyle();
	seed = mix(seed, font.Size());
	seed = mix(seed, font.Shear());
	seed = mix(seed, font.Rotation());
	return seed * 31 + font.Spacing() + font.Face();
}

struct FontHash {
	size_t operator()(const BFont& font) const { return hash_of(font); }
};

} // namespace


bool
is_simple_character(uint32 character)
{
	if (character < 0x300)
		return true;
	return contains(kSimple, character) && !is_mark_character(character);
}


bool
is_mark_character(uint32 character)
{
	return character >= 0x300 && contains(kMarks, character);
}


const GlyphWidths&
GlyphWidths::For(const BFont& font)
{
	static std::mutex sLock;
	// Never destroyed: threads may still draw while the program ends.
	static auto& sFonts = *new std::unordered_map<BFont, std::unique_ptr<GlyphWidths>, FontHash>();

	const std::lock_guard lock(sLock);
	std::unique_ptr<GlyphWidths>& widths = sFonts[font];
	if (!widths)
		widths = std::make_unique<GlyphWidths>(font);
	return *widths;
}


GlyphWidths::GlyphWidths(const BFont& font) : fFont(font)
{
	font_height height;
	fFont.GetHeight(&height);
	fAscent = std::ceil(height.ascent);
	fLineHeight = std::ceil(height.ascent + height.descent) + 1;

	char bytes[4];
	for (uint32 character = 0; character < fCommon.size(); character++) {
		const int32 length = encode_character(character, bytes);
		fCommon[character] = character < 0x20 ? 0 : fFont.StringWidth(bytes, length);
	}
}


std::vector<float>
GlyphWidths::Advances(const char* text, int32 length) const
{
	const auto run = FontEngine::Get().Run(
		ToFontSpec(fFont), std::string_view(text, static_cast<size_t>(length)));
	std::vector<float> advances(run->glyphs.size());
	for (const PlacedGlyph& glyph : run->glyphs)
		advances[glyph.index] = glyph.advance;
	return advances;
}


float
GlyphWidths::_OtherWidth(uint32 character) const
{
	const std::lock_guard lock(fLock);
	const auto [place, isNew] = fOthers.try_emplace(character, 0.0f);
	if (isNew) {
		char bytes[4];
		place->second = fFont.StringWidth(bytes, encode_character(character, bytes));
	}
	return place->second;
}


} // namespace BPrivate
