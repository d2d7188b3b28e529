#include "server/paint/GlyphFace.h"

#include <fontconfig/fontconfig.h>
#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_ADVANCES_H
#include FT_OUTLINE_H
#include FT_TRUETYPE_TABLES_H
#include <algorithm>
#include <string.h>

namespace BPrivate {

namespace {

// Larger than any glyph that is kept as an image.
constexpr uint32 kMaxImageSide = 4096;


FT_Library
Library()
{
	static FT_Library sLibrary = [] {
		FT_Library library = nullptr;
		if (FT_Init_FreeType(&library) != 0)
			library = nullptr;
		return library;
	}();
	return sLibrary;
}


// Collects an outline as FreeType takes it apart.
class OutlineCollector {
public:
	OutlineCollector(PathData& path, float unit) : fPath(path), fUnit(unit) {}

	void Collect(FT_Outline& outline)
	{
		FT_Outline_Funcs functions = {};
		functions.move_to = [](const FT_Vector* to, void* self) {
			static_cast<OutlineCollector*>(self)->_MoveTo(*to);
			return 0;
		};
		functions.line_to = [](const FT_Vector* to, void* self) {
			static_cast<OutlineCollector*>(self)->_Add(PathData::kLineTo, { *to });
			return 0;
		};
		functions.conic_to = [](const FT_Vector* control, const FT_Vector* to, void* self) {
			static_cast<OutlineCollector*>(self)->_ConicTo(*control, *to);
			return 0;
		};
		functions.cubic_to = [](const FT_Vector* a, const FT_Vector* b, const FT_Vector* to,
								 void* self) {
			static_cast<OutlineCollector*>(self)->_Add(PathData::kBezierTo, { *a, *b, *to });
			return 0;
		};
		FT_Outline_Decompose(&outline, &functions, this);
		if (fOpen)
			fPath.verbs.push_back(PathData::kClose);
	}

private:
	void _Add(PathData::Verb verb, std::initializer_list<FT_Vector> points)
	{
		fPath.verbs.push_back(verb);
		for (const FT_Vector& point : points)
			fPath.points.push_back(BPoint(point.x * fUnit, -point.y * fUnit));
		fLast = *(points.end() - 1);
	}

	void _MoveTo(const FT_Vector& to)
	{
		if (fOpen)
			fPath.verbs.push_back(PathData::kClose);
		_Add(PathData::kMoveTo, { to });
		fOpen = true;
	}

	void _ConicTo(const FT_Vector& control, const FT_Vector& to)
	{
		auto between = [](const FT_Vector& end, const FT_Vector& control) {
			return FT_Vector { end.x + (control.x - end.x) * 2 / 3,
				end.y + (control.y - end.y) * 2 / 3 };
		};
		_Add(PathData::kBezierTo, { between(fLast, control), between(to, control), to });
	}

	PathData& fPath;
	float fUnit;
	FT_Vector fLast = {};
	bool fOpen = false;
};

} // namespace


GlyphFace::GlyphFace() = default;


GlyphFace::~GlyphFace()
{
	if (fFace != nullptr)
		FT_Done_Face(fFace);
	if (characters != nullptr)
		FcCharSetDestroy(static_cast<FcCharSet*>(characters));
}


bool
GlyphFace::Includes(uint32 character) const
{
	return characters != nullptr
		&& FcCharSetHasChar(static_cast<FcCharSet*>(characters), character);
}


font_height
GlyphFace::Height() const
{
	FT_Face face = _Open();
	if (face == nullptr || face->units_per_EM == 0)
		return { 0.9f, 0.2f, 0 };
	const float unit = 1.0f / face->units_per_EM;
	const float leading = (face->height - face->ascender + face->descender) * unit;
	return { face->ascender * unit, -face->descender * unit, std::max(0.0f, leading) };
}


BRect
GlyphFace::BoundingBox() const
{
	FT_Face face = _Open();
	if (face == nullptr || face->units_per_EM == 0)
		return BRect(0, -0.9f, 1, 0.2f);
	const float unit = 1.0f / face->units_per_EM;
	return BRect(face->bbox.xMin * unit, -face->bbox.yMax * unit, face->bbox.xMax * unit,
		-face->bbox.yMin * unit);
}


void
GlyphFace::GetRanges(uint64 ranges[2]) const
{
	ranges[0] = ranges[1] = 0;
	FT_Face face = _Open();
	if (face == nullptr)
		return;
	if (auto* table = static_cast<TT_OS2*>(FT_Get_Sfnt_Table(face, FT_SFNT_OS2))) {
		ranges[0] = (uint64)(uint32)table->ulUnicodeRange2 << 32 | (uint32)table->ulUnicodeRange1;
		ranges[1] = (uint64)(uint32)table->ulUnicodeRange4 << 32 | (uint32)table->ulUnicodeRange3;
	}
}


uint32
GlyphFace::GlyphOf(uint32 character) const
{
	FT_Face face = _Open();
	return face != nullptr ? FT_Get_Char_Index(face, character) : 0;
}


float
GlyphFace::Advance(uint32 glyph) const
{
	FT_Face face = _Open();
	FT_Fixed advance = 0;
	if (face == nullptr || face->units_per_EM == 0
		|| FT_Get_Advance(face, glyph, FT_LOAD_NO_SCALE, &advance) != 0)
		return 0.6f;
	return (float)advance / face->units_per_EM;
}


PathData
GlyphFace::Outline(uint32 glyph) const
{
	PathData path;
	FT_Face face = _Open();
	if (face == nullptr || face->units_per_EM == 0
		|| FT_Load_Glyph(face, glyph, FT_LOAD_NO_SCALE) != 0
		|| face->glyph->format != FT_GLYPH_FORMAT_OUTLINE)
		return path;
	OutlineCollector(path, 1.0f / face->units_per_EM).Collect(face->glyph->outline);
	return path;
}


std::unique_ptr<GlyphImage>
GlyphFace::Render(uint32 glyph, int32 size26_6, int32 phase, bool smooth) const
{
	FT_Face face = _Open();
	if (face == nullptr)
		return nullptr;
	if (fSize != size26_6) {
		if (FT_Set_Char_Size(face, size26_6, size26_6, 72, 72) != 0)
			return nullptr;
		fSize = size26_6;
	}
	// Light hinting moves outlines up and down only: rows are crisp, widths stay true.
	if (FT_Load_Glyph(face, glyph, FT_LOAD_TARGET_LIGHT | FT_LOAD_NO_BITMAP) != 0
		|| face->glyph->format != FT_GLYPH_FORMAT_OUTLINE)
		return nullptr;
	FT_Outline_Translate(&face->glyph->outline, phase * 64 / FontEngine::kPhases, 0);
	if (FT_Render_Glyph(face->glyph, FT_RENDER_MODE_NORMAL) != 0)
		return nullptr;

	const FT_Bitmap& bitmap = face->glyph->bitmap;
	if (bitmap.width == 0 || bitmap.rows == 0 || bitmap.width > kMaxImageSide
		|| bitmap.rows > kMaxImageSide || bitmap.pixel_mode != FT_PIXEL_MODE_GRAY)
		return nullptr;
	uint8* coverage = new uint8[(size_t)bitmap.width * bitmap.rows];
	for (uint32 y = 0; y < bitmap.rows; y++) {
		const uint8* from = bitmap.buffer + (ptrdiff_t)y * bitmap.pitch;
		uint8* to = coverage + (size_t)y * bitmap.width;
		std::transform(from, from + bitmap.width, to,
			[smooth](uint8 value) { return smooth ? value : (value >= 128 ? 255 : 0); });
	}
	return std::unique_ptr<GlyphImage>(new GlyphImage { face->glyph->bitmap_left,
		-face->glyph->bitmap_top, (int32)bitmap.width, (int32)bitmap.rows, coverage });
}


FT_Face
GlyphFace::_Open() const
{
	if (fTried || file.empty() || Library() == nullptr)
		return fFace;
	fTried = true;
	if (FT_New_Face(Library(), file.c_str(), index, &fFace) != 0)
		fFace = nullptr;
	return fFace;
}


} // namespace BPrivate
