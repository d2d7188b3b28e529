// GlyphFace: one typeface file: its measures, its characters, its outlines.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <unordered_map>

#include <Font.h>

#include "server/paint/FontEngine.h"

struct FT_FaceRec_;

namespace BPrivate {

// A character in a face; all measures in ems.
struct FaceCharacter {
	const GlyphFace* face; // another one where this one lacks the character
	uint32 glyph;
	float advance;
	bool isSpace;
};


// Opened when it is first asked for something. Not thread-safe: the engine locks.
class GlyphFace {
public:
	GlyphFace();
	~GlyphFace();
	GlyphFace(const GlyphFace&) = delete;
	GlyphFace& operator=(const GlyphFace&) = delete;

	// What the list of fonts knows; set once, before anyone asks.
	std::string family;
	std::string style;
	std::string file;
	int32 index = 0;
	uint16 face = 0;
	bool isFixed = false;
	void* characters = nullptr; // fontconfig's set of characters; ours
	uint32 code = 0;

	// Whether the list of fonts says so; needs no open file and no lock.
	bool Includes(uint32 character) const;

	font_height Height() const; // for a size of 1
	BRect BoundingBox() const;
	void GetRanges(uint64 ranges[2]) const;
	// 0 when the face has none.
	uint32 GlyphOf(uint32 character) const;
	float Advance(uint32 glyph) const;
	PathData Outline(uint32 glyph) const;
	// Rendered coverage; NULL without ink. Caller owns it and its coverage (by new[]).
	std::unique_ptr<GlyphImage> Render(
		uint32 glyph, int32 size26_6, int32 phase, bool smooth) const;

	// The engine's memory of this face.
	mutable std::unordered_map<uint32, FaceCharacter> known;

private:
	FT_FaceRec_* _Open() const;

	mutable FT_FaceRec_* fFace = nullptr;
	mutable int32 fSize = 0;
	mutable bool fTried = false;
};


} // namespace BPrivate
