#include "server/paint/FontEngine.h"

#include <algorithm>
#include <atomic>
#include <math.h>
#include <mutex>
#include <shared_mutex>
#include <string.h>
#include <string>
#include <unordered_map>

#include "server/paint/FontList.h"
#include "server/paint/GlyphFace.h"
#include "server/paint/TextOrder.h"

namespace BPrivate {

namespace {

// Longer texts are measured afresh each time; they are rarely drawn twice.
constexpr size_t kMaxKeptText = 256;
// Two generations of so many runs are kept.
constexpr size_t kMaxKeptRuns = 8192;
// Glyphs larger than this many device pixels per em, or beyond so many bytes of images, are drawn
// from their outlines.
constexpr float kMaxImageSize = 96;
constexpr size_t kMaxImageBytes = 32 * 1024 * 1024;
constexpr size_t kMaxStrikes = 256;


// How far a glyph takes the pen on. Most spacings take the outline's own measure.
enum class Spacing : uint8 { Outlines, WholePixels, Fixed };

struct RunKey {
	uint32 code;
	float size;
	Spacing spacing;
	std::string_view text;

	bool operator==(const RunKey& other) const = default;
};

struct OwnedRunKey {
	uint32 code;
	float size;
	Spacing spacing;
	std::string text;

	operator RunKey() const { return { code, size, spacing, text }; }
};

struct RunKeyHash {
	using is_transparent = void;
	size_t operator()(const RunKey& key) const
	{
		uint32 size;
		memcpy(&size, &key.size, sizeof(size));
		return std::hash<std::string_view>()(key.text)
			^ ((size_t)key.code << 32 | size) * (0x9e3779b1 + 2 * (size_t)key.spacing);
	}
	size_t operator()(const OwnedRunKey& key) const { return (*this)((RunKey)key); }
};

struct RunKeyEqual {
	using is_transparent = void;
	template<typename A, typename B> bool operator()(const A& a, const B& b) const
	{
		return (RunKey)a == (RunKey)b;
	}
};

using RunMap =
	std::unordered_map<OwnedRunKey, std::shared_ptr<const GlyphRun>, RunKeyHash, RunKeyEqual>;


// The images of one face at one size. Reading takes no lock.
class Strike {
public:
	static constexpr uint32 kPageGlyphs = 32;

	struct Page {
		std::atomic<const GlyphImage*> images[kPageGlyphs * FontEngine::kPhases] = {};
	};

	// A place for each glyph number there can be.
	std::atomic<Page*> pages[65536 / kPageGlyphs] = {};
};

struct StrikeKey {
	const GlyphFace* face;
	int32 size26_6;
	bool smooth;

	bool operator==(const StrikeKey& other) const = default;
};

struct StrikeKeyHash {
	size_t operator()(const StrikeKey& key) const
	{
		return ((size_t)key.face >> 4) * 31 + key.size26_6 * 2 + key.smooth;
	}
};


// Marks a glyph that was rendered and has no ink.
const GlyphImage kNoInk = {};


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


Spacing
SpacingOf(const FontSpec& spec)
{
	if (spec.spacing == B_FIXED_SPACING)
		return Spacing::Fixed;
	return spec.spacing == B_STRING_SPACING ? Spacing::WholePixels : Spacing::Outlines;
}

} // namespace


struct FontEngine::Tables {
	FontList list;
	std::mutex lock; // faces, runs
	RunMap runs;
	RunMap olderRuns;
	std::shared_mutex strikeLock;
	std::unordered_map<StrikeKey, std::unique_ptr<Strike>, StrikeKeyHash> strikes;
	std::atomic<size_t> imageBytes = 0;

	const FaceCharacter& Character(const GlyphFace& face, uint32 character);
	float Advance(const GlyphFace& face, const FaceCharacter& character, Spacing spacing);
	// Calls with every character in the order of drawing, and whether it is a mark that stands
	// above or below the letter before it.
	template<typename Use>
	void ForEach(const GlyphFace& face, std::string_view text, const Use& use);
	std::shared_ptr<GlyphRun> MakeRun(const RunKey& key);
	float Measure(const RunKey& key);
	Strike* StrikeFor(const StrikeKey& key);
	std::shared_ptr<const GlyphRun> FindRun(const RunKey& key);
};


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


// In ems. With fixed spacing all that has a width has that of the widest Latin letter.
float
FontEngine::Tables::Advance(const GlyphFace& face, const FaceCharacter& character, Spacing spacing)
{
	if (spacing != Spacing::Fixed || character.advance == 0)
		return character.advance;
	return Character(face, 'W').advance;
}


template<typename Use>
void
FontEngine::Tables::ForEach(const GlyphFace& face, std::string_view text, const Use& use)
{
	if (!RunsFromTheRight(text)) {
		for (size_t at = 0; at < text.size();)
			use(Character(face, NextCharacter(text, &at)), false);
		return;
	}
	std::vector<uint32> characters;
	for (size_t at = 0; at < text.size();)
		characters.push_back(NextCharacter(text, &at));
	const auto hasForm = [&](uint32 form) { return Character(face, form).glyph != 0; };
	for (const uint32 character : InDrawingOrder(characters, hasForm)) {
		FaceCharacter found = Character(face, character);
		const bool isMark = IsMarkFromTheRight(character);
		if (isMark)
			found.advance = 0;
		use(found, isMark);
	}
}


std::shared_ptr<GlyphRun>
FontEngine::Tables::MakeRun(const RunKey& key)
{
	auto run = std::make_shared<GlyphRun>();
	run->glyphs.reserve(key.text.size());
	const GlyphFace& face = list.FaceAt(key.code);
	float letterX = 0, letterWidth = 0; // of the one that marks belong to
	ForEach(face, key.text, [&](const FaceCharacter& character, bool isMark) {
		const FaceCharacter found = character;
		const float advance = Advance(face, found, key.spacing) * key.size;
		float x = key.spacing == Spacing::WholePixels ? floorf(run->width + 0.5f) : run->width;
		if (isMark) {
			x = letterX + letterWidth / 2 - InkMiddle(found) * key.size;
		} else {
			letterX = x;
			letterWidth = advance;
		}
		run->glyphs.push_back({ found.face, found.glyph, x, found.isSpace });
		run->width += advance;
	});
	return run;
}


float
FontEngine::Tables::Measure(const RunKey& key)
{
	float width = 0;
	const GlyphFace& face = list.FaceAt(key.code);
	ForEach(face, key.text, [&](const FaceCharacter& character, bool) {
		width += Advance(face, FaceCharacter(character), key.spacing) * key.size;
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


float
FontEngine::Escapement(const FontSpec& spec, uint32 character)
{
	std::lock_guard locker(fTables->lock);
	const GlyphFace& face = fTables->list.FaceAt(spec.familyAndStyle);
	const FaceCharacter found = fTables->Character(face, character);
	return fTables->Advance(face, found, SpacingOf(spec));
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
