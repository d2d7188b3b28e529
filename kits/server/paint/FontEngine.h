// FontEngine: the installed typefaces, their measures and their glyphs.
#pragma once

#include <memory>
#include <string_view>
#include <vector>

#include <Font.h>

#include "server/paint/FontSpec.h"
#include "server/paint/Path.h"

namespace BPrivate {

class GlyphFace;

// A glyph as coverage, to be placed with its left top at pen + (left, top).
struct GlyphImage {
	int32 left;
	int32 top; // negative above the baseline
	int32 width;
	int32 height;
	const uint8* coverage; // width bytes a row; the engine's, for the program's life
};

// A glyph of a run: which, of which face, and how far right of the run's start its pen is.
struct PlacedGlyph {
	const GlyphFace* face; // the engine's
	uint32 glyph;
	float x; // logical pixels
	float advance; // how far it takes the pen on, logical pixels
	uint32 index; // of its character in the text
	bool isSpace;
};

struct GlyphRun {
	std::vector<PlacedGlyph> glyphs; // one per character of the text, from left to right
	float width = 0; // logical pixels
};


// One per program. Every function may be called from any thread; no lock is held on return, and
// the results are values or live as long as the program. Families and styles are those that
// were installed at the start. Measures are those of unhinted outlines at scale 1: they do not
// depend on the screen.
class FontEngine {
public:
	static FontEngine& Get();

	int32 CountFamilies() const;
	const char* FamilyAt(int32 index, uint32* _flags = nullptr) const; // NULL when out of range
	int32 CountStyles(const char* family) const;
	const char* StyleAt(
		const char* family, int32 index, uint16* _face = nullptr, uint32* _flags = nullptr) const;

	// B_NAME_NOT_FOUND when there is no such family or style. No style, NULL or empty, means the
	// regular or else the first one; a face means the style closest to it.
	status_t FindCode(const char* family, const char* style, uint32* _code) const;
	status_t FindCode(const char* family, uint16 face, uint32* _code) const;
	const char* FamilyOf(uint32 code) const;
	const char* StyleOf(uint32 code) const;
	uint16 FaceOf(uint32 code) const;
	bool IsFixed(uint32 code) const;
	static constexpr uint32 kPlainCode = 0;
	static constexpr uint32 kBoldCode = 1;
	static constexpr uint32 kFixedCode = 2;

	void GetHeight(const FontSpec& spec, font_height* _height) const;
	BRect BoundingBox(uint32 code) const; // ems
	// The bits of the OpenType table of covered Unicode ranges, lowest first.
	void GetRanges(uint32 code, uint64 ranges[2]) const;
	// Whether the face itself has the character; others stand in for what it lacks.
	bool Covers(uint32 code, uint32 character) const;

	// Widths are remembered per font and text; the memory for that is bounded.
	float StringWidth(const FontSpec& spec, std::string_view text);
	std::shared_ptr<const GlyphRun> Run(const FontSpec& spec, std::string_view text);

	// In ems, upright; y grows downwards.
	PathData Outline(const FontSpec& spec, uint32 character);
	PathData Outline(const PlacedGlyph& glyph);

	// deviceSize in device pixels per em; phase is the pen's place between two pixels in
	// quarters, 0 to 3. *_image is NULL for a glyph without ink. False means that the glyph is
	// too large to be kept as an image: draw its outline.
	static constexpr int32 kPhases = 4;
	bool GetImage(const PlacedGlyph& glyph, float deviceSize, int32 phase, bool smooth,
		const GlyphImage** _image);

private:
	FontEngine();
	~FontEngine();

	struct Tables;
	std::unique_ptr<Tables> fTables;
};

// The next character of UTF-8 text, which moves *_at on by its bytes; 0xfffd for bad bytes.
// *_at must be below text.size().
uint32 NextCharacter(std::string_view text, size_t* _at);


} // namespace BPrivate
