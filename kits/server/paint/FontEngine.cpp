#include "server/paint/FontEngine.h"

#include <algorithm>
#include <math.h>
#include <string.h>

#include "server/paint/FontTables.h"
#include "server/paint/GlyphFace.h"

namespace BPrivate {

namespace {

// Longer texts are measured afresh each time; they are rarely drawn twice.
constexpr size_t kMaxKeptText = 256;
// Glyphs larger than this many device pixels per em, or beyond so many bytes of images, are drawn
// from their outlines.
constexpr float kMaxImageSize = 96;
constexpr size_t kMaxImageBytes = 32 * 1024 * 1024;
constexpr size_t kMaxStrikes = 256;


// Marks a glyph that was rendered and has no ink.
const GlyphImage kNoInk = {};


Spacing
SpacingOf(const FontSpec& spec)
{
	if (spec.spacing == B_FIXED_SPACING)
		return Spacing::Fixed;
	return spec.spacing == B_STRING_SPACING ? Spacing::Adjusted : Spacing::Outlines;
}

} // namespace


// NULL when there are too many sizes already.
Strike*
FontEngine::Tables::StrikeFor(const StrikeKey& key)
{
	// A text is nearly always of the font of the text before it.
	static thread_local StrikeKey sLastKey = {};
	static thread_local Strike* sLast = nullptr;

	if (sLast != nullptr && sLastKey == key)
		return sLast;
	{
		std::shared_lock shared(strikeLock);
		const auto found = strikes.find(key);
		if (found != strikes.end()) {
			sLastKey = key;
			sLast = found->second.get();
			return sLast;
		}
	}
	std::unique_lock unique(strikeLock);
	if (strikes.size() >= kMaxStrikes && strikes.find(key) == strikes.end())
		return nullptr;
	std::unique_ptr<Strike>& strike = strikes[key];
	if (strike == nullptr)
		strike = std::make_unique<Strike>();
	sLastKey = key;
	sLast = strike.get();
	return sLast;
}


// #pragma mark - FontEngine


// Never deleted: threads may still paint while the program ends.
FontEngine&
FontEngine::Get()
{
	static FontEngine* sEngine = new FontEngine;
	return *sEngine;
}


FontEngine::FontEngine() : fTables(std::make_unique<Tables>())
{
}


FontEngine::~FontEngine() = default;


int32
FontEngine::CountFamilies() const
{
	return fTables->list.Families().size();
}


const char*
FontEngine::FamilyAt(int32 index, uint32* _flags) const
{
	if (index < 0 || index >= CountFamilies())
		return nullptr;
	const FontFamily& family = fTables->list.Families()[index];
	if (_flags != nullptr)
		*_flags = family.isFixed ? B_IS_FIXED : 0;
	return family.name.c_str();
}


int32
FontEngine::CountStyles(const char* family) const
{
	const FontFamily* found = fTables->list.Find(family);
	return found != nullptr ? found->styles.size() : 0;
}


const char*
FontEngine::StyleAt(const char* family, int32 index, uint16* _face, uint32* _flags) const
{
	if (index < 0 || index >= CountStyles(family))
		return nullptr;
	const GlyphFace* face = fTables->list.Find(family)->styles[index];
	if (_face != nullptr)
		*_face = face->face;
	if (_flags != nullptr)
		*_flags = face->isFixed ? B_IS_FIXED : 0;
	return face->style.c_str();
}


status_t
FontEngine::FindCode(const char* family, const char* style, uint32* _code) const
{
	const FontFamily* found = fTables->list.Find(family);
	if (found == nullptr)
		return B_NAME_NOT_FOUND;

	const GlyphFace* chosen = nullptr;
	for (const GlyphFace* face : found->styles) {
		const bool named = style != nullptr && style[0] != '\0';
		if (named ? face->style == style : face->face == B_REGULAR_FACE) {
			chosen = face;
			break;
		}
		if (!named && chosen == nullptr)
			chosen = face;
	}
	if (chosen == nullptr)
		return B_NAME_NOT_FOUND;
	*_code = chosen->code;
	return B_OK;
}


// The style that shares most of what was asked for, and has least that was not.
status_t
FontEngine::FindCode(const char* family, uint16 face, uint32* _code) const
{
	constexpr uint16 kStyleBits =
		B_ITALIC_FACE | B_BOLD_FACE | B_CONDENSED_FACE | B_LIGHT_FACE | B_HEAVY_FACE;

	const FontFamily* found = fTables->list.Find(family);
	if (found == nullptr)
		return B_NAME_NOT_FOUND;
	int best = INT32_MAX;
	for (const GlyphFace* candidate : found->styles) {
		const int differences = __builtin_popcount((candidate->face ^ face) & kStyleBits);
		if (differences < best) {
			best = differences;
			*_code = candidate->code;
		}
	}
	return B_OK;
}


const char*
FontEngine::FamilyOf(uint32 code) const
{
	return fTables->list.FaceAt(code).family.c_str();
}


const char*
FontEngine::StyleOf(uint32 code) const
{
	return fTables->list.FaceAt(code).style.c_str();
}


uint16
FontEngine::FaceOf(uint32 code) const
{
	return fTables->list.FaceAt(code).face;
}


bool
FontEngine::IsFixed(uint32 code) const
{
	return fTables->list.FaceAt(code).isFixed;
}


void
FontEngine::GetHeight(const FontSpec& spec, font_height* _height) const
{
	std::lock_guard locker(fTables->lock);
	*_height = fTables->list.FaceAt(spec.familyAndStyle).Height();
	_height->ascent *= spec.size;
	_height->descent *= spec.size;
	_height->leading *= spec.size;
}


BRect
FontEngine::BoundingBox(uint32 code) const
{
	std::lock_guard locker(fTables->lock);
	return fTables->list.FaceAt(code).BoundingBox();
}


void
FontEngine::GetRanges(uint32 code, uint64 ranges[2]) const
{
	std::lock_guard locker(fTables->lock);
	fTables->list.FaceAt(code).GetRanges(ranges);
}


bool
FontEngine::Covers(uint32 code, uint32 character) const
{
	return fTables->list.FaceAt(code).Includes(character);
}


// #pragma mark - text


float
FontEngine::StringWidth(const FontSpec& spec, std::string_view text)
{
	const RunKey key = { spec.familyAndStyle, spec.size, SpacingOf(spec), text };
	std::lock_guard locker(fTables->lock);
	return text.size() > kMaxKeptText ? fTables->Measure(key) : fTables->FindRun(key)->width;
}


std::shared_ptr<const GlyphRun>
FontEngine::Run(const FontSpec& spec, std::string_view text)
{
	const RunKey key = { spec.familyAndStyle, spec.size, SpacingOf(spec), text };
	std::lock_guard locker(fTables->lock);
	return text.size() > kMaxKeptText ? fTables->MakeRun(key) : fTables->FindRun(key);
}


PathData
FontEngine::Outline(const FontSpec& spec, uint32 character)
{
	std::lock_guard locker(fTables->lock);
	const FaceCharacter& found =
		fTables->Character(fTables->list.FaceAt(spec.familyAndStyle), character);
	return found.isSpace ? PathData() : found.face->Outline(found.glyph);
}


PathData
FontEngine::Outline(const PlacedGlyph& glyph)
{
	std::lock_guard locker(fTables->lock);
	return glyph.isSpace ? PathData() : glyph.face->Outline(glyph.glyph);
}


bool
FontEngine::GetImage(
	const PlacedGlyph& glyph, float deviceSize, int32 phase, bool smooth, const GlyphImage** _image)
{
	*_image = nullptr;
	if (glyph.isSpace || !(deviceSize > 0))
		return true;
	if (deviceSize > kMaxImageSize || glyph.glyph > 65535)
		return false;

	Strike* strike = fTables->StrikeFor({ glyph.face, (int32)lroundf(deviceSize * 64), smooth });
	if (strike == nullptr)
		return false;
	std::atomic<Strike::Page*>& page = strike->pages[glyph.glyph / Strike::kPageGlyphs];
	const uint32 place = glyph.glyph % Strike::kPageGlyphs * kPhases + phase;
	if (Strike::Page* existing = page.load(std::memory_order_acquire)) {
		if (const GlyphImage* image = existing->images[place].load(std::memory_order_acquire)) {
			*_image = image->coverage != nullptr ? image : nullptr;
			return true;
		}
	}
	if (fTables->imageBytes > kMaxImageBytes)
		return false;

	std::lock_guard locker(fTables->lock);
	if (page.load() == nullptr)
		page = new Strike::Page;
	std::atomic<const GlyphImage*>& kept = page.load()->images[place];
	if (kept.load() == nullptr) {
		std::unique_ptr<GlyphImage> image =
			glyph.face->Render(glyph.glyph, (int32)lroundf(deviceSize * 64), phase, smooth);
		if (image != nullptr)
			fTables->imageBytes += image->width * image->height + sizeof(GlyphImage);
		kept.store(image != nullptr ? image.release() : &kNoInk, std::memory_order_release);
	}
	const GlyphImage* image = kept;
	*_image = image->coverage != nullptr ? image : nullptr;
	return true;
}


// #pragma mark - UTF-8


uint32
NextCharacter(std::string_view text, size_t* _at)
{
	constexpr uint32 kReplacement = 0xfffd;
	static constexpr uint32 kLeast[] = { 0, 0x80, 0x800, 0x10000 };

	const uint8 first = text[(*_at)++];
	if (first < 0x80)
		return first;
	const int more = first >= 0xf0 ? 3 : (first >= 0xe0 ? 2 : 1);
	if (first < 0xc2 || first > 0xf4)
		return kReplacement;

	uint32 character = first & (0x3f >> more);
	for (int i = 0; i < more; i++) {
		if (*_at >= text.size() || ((uint8)text[*_at] & 0xc0) != 0x80)
			return kReplacement;
		character = character << 6 | ((uint8)text[(*_at)++] & 0x3f);
	}
	if (character < kLeast[more] || character > 0x10ffff
		|| (character >= 0xd800 && character <= 0xdfff))
		return kReplacement;
	return character;
}


} // namespace BPrivate
