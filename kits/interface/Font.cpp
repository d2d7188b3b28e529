#include <Font.h>

#include <algorithm>
#include <math.h>
#include <stdio.h>
#include <string.h>
#include <string>

#include <Errors.h>
#include <Shape.h>
#include <String.h>

#include "interface/private/FontAccess.h"
#include "interface/private/ShapeAccess.h"
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


// Takes one character after the other from an array that has no length, only a number of
// characters; it never reads beyond a final zero.
class CharacterReader {
public:
	CharacterReader(const char* text, int32 count) : fText(text), fLeft(count) {}

	bool Next(uint32* _character)
	{
		if (fText == NULL || fLeft <= 0 || *fText == '\0')
			return false;
		size_t length = 1;
		while (length < 4 && ((uint8)fText[length] & 0xc0) == 0x80)
			length++;
		size_t at = 0;
		*_character = NextCharacter(std::string_view(fText, length), &at);
		fText += at;
		fLeft--;
		return true;
	}

private:
	const char* fText;
	int32 fLeft;
};


bool
IsWhite(uint32 character)
{
	return character == ' ' || character == '\t' || character == '\n' || character == 0xa0;
}


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


// #pragma mark - widths


float
BFont::StringWidth(const char* string) const
{
	return string != NULL ? StringWidth(string, strlen(string)) : 0;
}


float
BFont::StringWidth(const char* string, int32 length) const
{
	if (string == NULL || length <= 0)
		return 0;
	return FontEngine::Get().StringWidth(
		ToFontSpec(*this), std::string_view(string, strnlen(string, length)));
}


void
BFont::GetStringWidths(const char* stringArray[], const int32 lengthArray[], int32 numStrings,
	float widthArray[]) const
{
	if (stringArray == NULL || lengthArray == NULL || widthArray == NULL)
		return;
	for (int32 i = 0; i < numStrings; i++)
		widthArray[i] = StringWidth(stringArray[i], lengthArray[i]);
}


void
BFont::GetEscapements(const char charArray[], int32 numChars, float escapementArray[]) const
{
	GetEscapements(charArray, numChars, NULL, escapementArray);
}


void
BFont::GetEscapements(
	const char charArray[], int32 numChars, escapement_delta* delta, float escapementArray[]) const
{
	if (escapementArray == NULL)
		return;
	const FontSpec spec = ToFontSpec(*this);
	CharacterReader reader(charArray, numChars);
	uint32 character;
	for (int32 i = 0; reader.Next(&character); i++) {
		escapementArray[i] = FontEngine::Get().Escapement(spec, character);
		if (delta != NULL && fSize > 0) {
			escapementArray[i] += (IsWhite(character) ? delta->space : delta->nonspace) / fSize;
		}
	}
}


void
BFont::GetEscapements(
	const char charArray[], int32 numChars, escapement_delta* delta, BPoint escapementArray[]) const
{
	GetEscapements(charArray, numChars, delta, escapementArray, NULL);
}


void
BFont::GetEscapements(const char charArray[], int32 numChars, escapement_delta* delta,
	BPoint escapementArray[], BPoint offsetArray[]) const
{
	if (escapementArray == NULL)
		return;
	const FontSpec spec = ToFontSpec(*this);
	const float angle = fRotation * (float)M_PI / 180;
	CharacterReader reader(charArray, numChars);
	uint32 character;
	for (int32 i = 0; reader.Next(&character); i++) {
		float width = FontEngine::Get().Escapement(spec, character);
		if (delta != NULL && fSize > 0)
			width += (IsWhite(character) ? delta->space : delta->nonspace) / fSize;
		escapementArray[i].Set(width * cosf(angle), -width * sinf(angle));
		if (offsetArray != NULL)
			offsetArray[i].Set(0, 0);
	}
}


void
BFont::GetEdges(const char charArray[], int32 numChars, edge_info edgeArray[]) const
{
	if (edgeArray == NULL)
		return;
	const FontSpec spec = ToFontSpec(*this);
	CharacterReader reader(charArray, numChars);
	uint32 character;
	for (int32 i = 0; reader.Next(&character); i++) {
		const BRect box = BoundsOf(FontEngine::Get().Outline(spec, character));
		const float advance = FontEngine::Get().Escapement(spec, character);
		edgeArray[i].left = box.IsValid() ? box.left : 0;
		edgeArray[i].right = box.IsValid() ? advance - box.right : 0;
	}
}


void
BFont::GetHeight(font_height* height) const
{
	if (height != NULL)
		FontEngine::Get().GetHeight(ToFontSpec(*this), height);
}


// #pragma mark - boxes and shapes


void
BFont::GetBoundingBoxesAsGlyphs(
	const char charArray[], int32 numChars, font_metric_mode mode, BRect boundingBoxArray[]) const
{
	_GetBoxes(charArray, numChars, mode, NULL, false, boundingBoxArray);
}


void
BFont::GetBoundingBoxesAsString(const char charArray[], int32 numChars, font_metric_mode mode,
	escapement_delta* delta, BRect boundingBoxArray[]) const
{
	_GetBoxes(charArray, numChars, mode, delta, true, boundingBoxArray);
}


void
BFont::GetBoundingBoxesForStrings(const char* stringArray[], int32 numStrings,
	font_metric_mode mode, escapement_delta deltas[], BRect boundingBoxArray[]) const
{
	if (stringArray == NULL || boundingBoxArray == NULL)
		return;
	for (int32 i = 0; i < numStrings; i++) {
		boundingBoxArray[i] = BRect();
		const int32 count = stringArray[i] != NULL ? strlen(stringArray[i]) : 0;
		std::vector<BRect> boxes(count);
		_GetBoxes(
			stringArray[i], count, mode, deltas != NULL ? &deltas[i] : NULL, true, boxes.data());
		for (const BRect& box : boxes) {
			if (box.IsValid()) {
				boundingBoxArray[i] =
					boundingBoxArray[i].IsValid() ? boundingBoxArray[i] | box : box;
			}
		}
	}
}


void
BFont::GetGlyphShapes(const char charArray[], int32 numChars, BShape* glyphShapeArray[]) const
{
	if (glyphShapeArray == NULL)
		return;
	const FontSpec spec = ToFontSpec(*this);
	CharacterReader reader(charArray, numChars);
	uint32 character;
	for (int32 i = 0; reader.Next(&character); i++) {
		if (glyphShapeArray[i] == NULL)
			continue;
		PathData& path = ShapeAccess::Path(*glyphShapeArray[i]);
		path = FontEngine::Get().Outline(spec, character);
		for (BPoint& point : path.points)
			point.Set(point.x * fSize, point.y * fSize);
	}
}


void
BFont::GetHasGlyphs(const char charArray[], int32 numChars, bool hasArray[]) const
{
	if (hasArray == NULL)
		return;
	CharacterReader reader(charArray, numChars);
	uint32 character;
	for (int32 i = 0; reader.Next(&character); i++)
		hasArray[i] = FontEngine::Get().Covers(fFamilyAndStyle, character);
}


// Boxes round the ink, each with the pen at (0, 0) or where the string puts it. Boxes for the
// screen are in whole pixels. A character without ink gets an invalid box.
void
BFont::_GetBoxes(const char charArray[], int32 numChars, font_metric_mode mode,
	escapement_delta* delta, bool asString, BRect boxes[]) const
{
	if (boxes == NULL)
		return;
	const FontSpec spec = ToFontSpec(*this);
	CharacterReader reader(charArray, numChars);
	float pen = 0;
	uint32 character;
	for (int32 i = 0; reader.Next(&character); i++) {
		BRect box = BoundsOf(FontEngine::Get().Outline(spec, character));
		if (box.IsValid()) {
			box = BRect(box.left * fSize + pen, box.top * fSize, box.right * fSize + pen,
				box.bottom * fSize);
			if (mode == B_SCREEN_METRIC) {
				box = BRect(
					floorf(box.left), floorf(box.top), ceilf(box.right) - 1, ceilf(box.bottom) - 1);
			}
		}
		boxes[i] = box;
		if (!asString)
			continue;
		pen += FontEngine::Get().Escapement(spec, character) * fSize;
		if (delta != NULL)
			pen += IsWhite(character) ? delta->space : delta->nonspace;
	}
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
