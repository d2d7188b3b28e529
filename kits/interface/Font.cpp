#include <Font.h>

#include <algorithm>
#include <math.h>
#include <stdio.h>
#include <string.h>
#include <string>

#include <Errors.h>
#include <String.h>

#include "interface/private/FontAccess.h"
#include "server/paint/FontEngine.h"

using namespace BPrivate;

namespace {

constexpr float kDefaultSize = 10;


BFont
MakeFont(uint32 code)
{
	BFont font;
	font.SetFamilyAndStyle(code);
	return font;
}


const BFont sPlainFont = MakeFont(FontEngine::kPlainCode);
const BFont sBoldFont = MakeFont(FontEngine::kBoldCode);
const BFont sFixedFont = MakeFont(FontEngine::kFixedCode);


void
CopyName(const char* from, char* to, size_t size)
{
	strncpy(to, from, size - 1);
	to[size - 1] = '\0';
}

} // namespace


const BFont* be_plain_font = &sPlainFont;
const BFont* be_bold_font = &sBoldFont;
const BFont* be_fixed_font = &sFixedFont;


FontSpec
BPrivate::ToFontSpec(const BFont& font)
{
	FontSpec spec;
	spec.familyAndStyle = font.FamilyAndStyle();
	spec.size = font.Size();
	spec.shear = font.Shear();
	spec.rotation = font.Rotation();
	spec.falseBoldWidth = font.FalseBoldWidth();
	spec.flags = font.Flags();
	spec.face = font.Face();
	spec.spacing = font.Spacing();
	spec.encoding = font.Encoding();
	return spec;
}


// #pragma mark - unicode_block


bool
unicode_block::Includes(const unicode_block& block) const
{
	return (*this & block) == block;
}


unicode_block
unicode_block::operator&(const unicode_block& block) const
{
	return unicode_block(fData[1] & block.fData[1], fData[0] & block.fData[0]);
}


unicode_block
unicode_block::operator|(const unicode_block& block) const
{
	return unicode_block(fData[1] | block.fData[1], fData[0] | block.fData[0]);
}


bool
unicode_block::operator==(const unicode_block& block) const
{
	return fData[0] == block.fData[0] && fData[1] == block.fData[1];
}


// #pragma mark - making and setting


BFont::BFont() :
	fFamilyAndStyle(FontEngine::kPlainCode), fSize(kDefaultSize), fShear(90), fRotation(0),
	fFalseBoldWidth(0), fFlags(0), fFace(0), fSpacing(B_BITMAP_SPACING), fEncoding(B_UNICODE_UTF8)
{
}


BFont::BFont(const BFont* font) : BFont()
{
	if (font != NULL)
		*this = *font;
}


status_t
BFont::SetFamilyAndStyle(const font_family family, const font_style style)
{
	FontEngine& engine = FontEngine::Get();
	return engine.FindCode(
		family != NULL ? family : engine.FamilyOf(fFamilyAndStyle), style, &fFamilyAndStyle);
}


void
BFont::SetFamilyAndStyle(uint32 code)
{
	fFamilyAndStyle = code;
}


status_t
BFont::SetFamilyAndFace(const font_family family, uint16 face)
{
	FontEngine& engine = FontEngine::Get();
	const status_t status = engine.FindCode(
		family != NULL ? family : engine.FamilyOf(fFamilyAndStyle), face, &fFamilyAndStyle);
	if (status == B_OK)
		fFace = face;
	return status;
}


void
BFont::SetSize(float size)
{
	fSize = size;
}


void
BFont::SetShear(float shear)
{
	fShear = shear;
}


void
BFont::SetRotation(float rotation)
{
	fRotation = rotation;
}


void
BFont::SetSpacing(uint8 spacing)
{
	fSpacing = spacing;
}


void
BFont::SetEncoding(uint8 encoding)
{
	fEncoding = encoding;
}


void
BFont::SetFace(uint16 face)
{
	if (face != fFace)
		SetFamilyAndFace(NULL, face);
}


void
BFont::SetFlags(uint32 flags)
{
	fFlags = flags;
}


void
BFont::SetFalseBoldWidth(float width)
{
	fFalseBoldWidth = width;
}


// #pragma mark - asking


void
BFont::GetFamilyAndStyle(font_family* family, font_style* style) const
{
	const FontEngine& engine = FontEngine::Get();
	if (family != NULL)
		CopyName(engine.FamilyOf(fFamilyAndStyle), *family, sizeof(font_family));
	if (style != NULL)
		CopyName(engine.StyleOf(fFamilyAndStyle), *style, sizeof(font_style));
}


uint32
BFont::FamilyAndStyle() const
{
	return fFamilyAndStyle;
}


font_direction
BFont::Direction() const
{
	return B_FONT_LEFT_TO_RIGHT;
}


bool
BFont::IsFixed() const
{
	return FontEngine::Get().IsFixed(fFamilyAndStyle);
}


bool
BFont::IsFullAndHalfFixed() const
{
	// Wide characters come from another face as a rule, so they are not twice as wide.
	return false;
}


BRect
BFont::BoundingBox() const
{
	return FontEngine::Get().BoundingBox(fFamilyAndStyle);
}


unicode_block
BFont::Blocks() const
{
	uint64 ranges[2];
	FontEngine::Get().GetRanges(fFamilyAndStyle, ranges);
	return unicode_block(ranges[1], ranges[0]);
}


font_file_format
BFont::FileFormat() const
{
	return B_TRUETYPE_WINDOWS;
}


int32
BFont::CountTuned() const
{
	return 0;
}


void
BFont::GetTunedInfo(int32 index, tuned_font_info* info) const
{
	if (info != NULL)
		*info = tuned_font_info();
}


bool
BFont::operator==(const BFont& font) const
{
	return fFamilyAndStyle == font.fFamilyAndStyle && fSize == font.fSize && fShear == font.fShear
		&& fRotation == font.fRotation && fFalseBoldWidth == font.fFalseBoldWidth
		&& fFlags == font.fFlags && fFace == font.fFace && fSpacing == font.fSpacing
		&& fEncoding == font.fEncoding;
}


void
BFont::PrintToStream() const
{
	const FontEngine& engine = FontEngine::Get();
	printf("BFont { %s, %s, 0x%x, %.1f/%.1f, %.1f }\n", engine.FamilyOf(fFamilyAndStyle),
		engine.StyleOf(fFamilyAndStyle), (unsigned)fFace, fRotation, fShear, fSize);
}


// #pragma mark - families and styles


int32
count_font_families()
{
	return FontEngine::Get().CountFamilies();
}


status_t
get_font_family(int32 index, font_family* name, uint32* flags)
{
	const char* family = FontEngine::Get().FamilyAt(index, flags);
	if (family == NULL || name == NULL)
		return B_BAD_VALUE;
	CopyName(family, *name, sizeof(font_family));
	return B_OK;
}


int32
count_font_styles(font_family name)
{
	return name != NULL ? FontEngine::Get().CountStyles(name) : 0;
}


status_t
get_font_style(font_family family, int32 index, font_style* name, uint32* flags)
{
	return get_font_style(family, index, name, NULL, flags);
}


status_t
get_font_style(font_family family, int32 index, font_style* name, uint16* face, uint32* flags)
{
	if (family == NULL || name == NULL)
		return B_BAD_VALUE;
	const char* style = FontEngine::Get().StyleAt(family, index, face, flags);
	if (style == NULL)
		return B_BAD_VALUE;
	CopyName(style, *name, sizeof(font_style));
	return B_OK;
}


bool
update_font_families(bool checkOnly)
{
	// The fonts are those of the program's start.
	return false;
}
