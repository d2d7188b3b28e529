// FontList: the typefaces that are installed, found once at the start.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <SupportDefs.h>

#include "server/paint/GlyphFace.h"

namespace BPrivate {


struct FontFamily {
	std::string name;
	bool isFixed = false;
	std::vector<GlyphFace*> styles; // sorted by name; the list's
};


// The first three faces are the plain, the bold and the fixed one; the rest follow in the order of
// families and styles. A face's place is its code. There is always at least a face without a
// file, which has no glyphs.
class FontList {
public:
	FontList();

	const std::vector<FontFamily>& Families() const { return fFamilies; }
	const FontFamily* Find(const char* family) const;
	GlyphFace& FaceAt(uint32 code) const;
	// The best regular face with a glyph for the character, or NULL. Faces that people are used
	// to come first.
	const GlyphFace* FallbackFor(uint32 character) const;

private:
	void _ReadInstalled();
	void _SortFamilies();
	void _ChooseDefaults();
	GlyphFace* _Choose(const char* const* families, uint16 face) const;

	std::vector<std::unique_ptr<GlyphFace>> fOwned;
	std::vector<GlyphFace*> fFaces; // by code
	std::vector<GlyphFace*> fFallbacks;
	std::vector<FontFamily> fFamilies; // sorted by name
};


} // namespace BPrivate
