#include "server/paint/FontTables.h"

#include <algorithm>
#include <math.h>

#include "server/paint/GlyphFace.h"
#include "server/paint/TextOrder.h"

namespace BPrivate {

namespace {

// Two generations of so many runs are kept.
constexpr size_t kMaxKeptRuns = 8192;


bool
IsSpace(uint32 character)
{
	return character == ' ' || character == 0xa0 || character == '\t' || character == '\n'
		|| (character >= 0x2000 && character <= 0x200a) || character == 0x3000;
}


// Controls, joiners and variation selectors: neither ink nor width.
bool
IsInvisible(uint32 character)
{
	return character < 0x20 || (character >= 0x7f && character < 0xa0)
		|| (character >= 0x200b && character <= 0x200f) || character == 0xfeff
		|| (character >= 0x202a && character <= 0x202e)
		|| (character >= 0xfe00 && character <= 0xfe0f);
}


// In ems, from the pen.
float
InkMiddle(const FaceCharacter& character)
{
	const PathData outline = character.face->Outline(character.glyph);
	if (outline.points.empty())
		return 0;
	const auto [left, right] = std::minmax_element(
		outline.points.begin(), outline.points.end(), [](BPoint a, BPoint b) { return a.x < b.x; });
	return (left->x + right->x) / 2;
}

} // namespace


// The lock is held.
const FaceCharacter&
FontEngine::Tables::Character(const GlyphFace& face, uint32 character)
{
	const auto found = face.known.find(character);
	if (found != face.known.end())
		return found->second;
	// A text in many scripts must not fill the memory.
	if (face.known.size() > 20000)
		face.known.clear();

	FaceCharacter result = { &face, 0, 0, IsSpace(character) };
	if (!IsInvisible(character)) {
		result.glyph = face.GlyphOf(character);
		if (result.glyph == 0) {
			if (const GlyphFace* other = list.FallbackFor(character)) {
				result.face = other;
				result.glyph = other->GlyphOf(character);
			}
		}
		result.advance = result.face->Advance(result.glyph);
	} else
		result.isSpace = true;
	return face.known.emplace(character, result).first->second;
}


// In pixels. With fixed spacing all that has a width has that of the widest Latin letter.
float
FontEngine::Tables::Advance(
	const GlyphFace& face, const FaceCharacter& character, const RunKey& key)
{
	if (key.spacing == Spacing::Fixed && character.advance != 0)
		return Character(face, 'W').advance * key.size;
	return character.advance * key.size;
}


template<typename Use>
void
FontEngine::Tables::ForEach(const GlyphFace& face, std::string_view text, const Use& use)
{
	if (!RunsFromTheRight(text)) {
		uint32 index = 0;
		for (size_t at = 0; at < text.size();)
			use(Character(face, NextCharacter(text, &at)), index++, false);
		return;
	}
	std::vector<uint32> characters;
	for (size_t at = 0; at < text.size();)
		characters.push_back(NextCharacter(text, &at));
	const auto hasForm = [&](uint32 form) { return Character(face, form).glyph != 0; };
	for (const OrderedCharacter& ordered : InDrawingOrder(characters, hasForm)) {
		FaceCharacter found = Character(face, ordered.character);
		const bool isMark = IsMarkFromTheRight(ordered.character);
		if (isMark)
			found.advance = 0;
		use(found, ordered.index, isMark);
	}
}


std::shared_ptr<GlyphRun>
FontEngine::Tables::MakeRun(const RunKey& key)
{
	auto run = std::make_shared<GlyphRun>();
	run->glyphs.reserve(key.text.size());
	const GlyphFace& face = list.FaceAt(key.code);
	float letterX = 0, letterWidth = 0; // of the one that marks belong to
	ForEach(face, key.text, [&](const FaceCharacter& character, uint32 index, bool isMark) {
		const FaceCharacter found = character;
		const float advance = Advance(face, found, key);
		float x = key.spacing == Spacing::Adjusted ? floorf(run->width + 0.5f) : run->width;
		if (isMark) {
			x = letterX + letterWidth / 2 - InkMiddle(found) * key.size;
		} else {
			letterX = x;
			letterWidth = advance;
		}
		run->glyphs.push_back({ found.face, found.glyph, x, advance, index, found.isSpace });
		run->width += advance;
	});
	return run;
}


float
FontEngine::Tables::Measure(const RunKey& key)
{
	float width = 0;
	const GlyphFace& face = list.FaceAt(key.code);
	ForEach(face, key.text, [&](const FaceCharacter& character, uint32, bool) {
		width += Advance(face, FaceCharacter(character), key);
	});
	return width;
}


// The lock is held. When the younger generation is full the older one is forgotten.
std::shared_ptr<const GlyphRun>
FontEngine::Tables::FindRun(const RunKey& key)
{
	const auto found = runs.find(key);
	if (found != runs.end())
		return found->second;

	std::shared_ptr<const GlyphRun> run;
	const auto older = olderRuns.find(key);
	if (older != olderRuns.end())
		run = older->second;
	else
		run = MakeRun(key);
	if (runs.size() >= kMaxKeptRuns) {
		olderRuns = std::move(runs);
		runs.clear();
	}
	runs.emplace(OwnedRunKey { key.code, key.size, key.spacing, std::string(key.text) }, run);
	return run;
}


} // namespace BPrivate
