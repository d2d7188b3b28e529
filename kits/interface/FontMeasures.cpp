// How wide texts are, and where their ink is.
#include <Font.h>

#include <math.h>
#include <string.h>
#include <vector>

#include <Shape.h>

#include "interface/private/FontAccess.h"
#include "interface/private/ShapeAccess.h"
#include "server/paint/FontEngine.h"

using namespace BPrivate;

namespace {

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
		fBytes += at;
		fLeft--;
		return true;
	}
	size_t Bytes() const { return fBytes; } // read so far

private:
	const char* fText;
	int32 fLeft;
	size_t fBytes = 0;
};


// The glyphs of an array's characters as drawing would place them, in the order of the text.
class GlyphsOfText {
public:
	GlyphsOfText(const BFont& font, const char* text, int32 count, const escapement_delta* delta);

	size_t Count() const { return fGlyphs.size(); }
	const PlacedGlyph& operator[](size_t index) const { return *fGlyphs[index]; }
	// In pixels, with the delta.
	float Advance(size_t index) const { return fGlyphs[index]->advance + _Extra(*fGlyphs[index]); }
	float PenAt(size_t index) const { return fPens[index]; }

private:
	float _Extra(const PlacedGlyph& glyph) const
	{
		return fDelta == NULL ? 0 : (glyph.isSpace ? fDelta->space : fDelta->nonspace);
	}

	std::shared_ptr<const GlyphRun> fRun;
	std::vector<const PlacedGlyph*> fGlyphs; // the run's
	std::vector<float> fPens;
	const escapement_delta* fDelta; // borrowed
};


GlyphsOfText::GlyphsOfText(
	const BFont& font, const char* text, int32 count, const escapement_delta* delta) :
	fDelta(delta)
{
	CharacterReader reader(text, count);
	uint32 character;
	while (reader.Next(&character))
		continue;
	fRun = FontEngine::Get().Run(ToFontSpec(font), std::string_view(text, reader.Bytes()));
	fGlyphs.resize(fRun->glyphs.size());
	fPens.resize(fRun->glyphs.size());
	float extra = 0;
	for (const PlacedGlyph& glyph : fRun->glyphs) {
		fGlyphs[glyph.index] = &glyph;
		fPens[glyph.index] = glyph.x + extra;
		extra += _Extra(glyph);
	}
}

} // namespace


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
	if (escapementArray == NULL || !(fSize > 0))
		return;
	const GlyphsOfText glyphs(*this, charArray, numChars, delta);
	for (size_t i = 0; i < glyphs.Count(); i++)
		escapementArray[i] = glyphs.Advance(i) / fSize;
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
	if (escapementArray == NULL || !(fSize > 0))
		return;
	const GlyphsOfText glyphs(*this, charArray, numChars, delta);
	const float angle = fRotation * (float)M_PI / 180;
	for (size_t i = 0; i < glyphs.Count(); i++) {
		const float width = glyphs.Advance(i) / fSize;
		escapementArray[i].Set(width * cosf(angle), -width * sinf(angle));
		if (offsetArray != NULL)
			offsetArray[i].Set(0, 0);
	}
}


void
BFont::GetEdges(const char charArray[], int32 numChars, edge_info edgeArray[]) const
{
	if (edgeArray == NULL || !(fSize > 0))
		return;
	const GlyphsOfText glyphs(*this, charArray, numChars, NULL);
	for (size_t i = 0; i < glyphs.Count(); i++) {
		const BRect box = BoundsOf(FontEngine::Get().Outline(glyphs[i]));
		edgeArray[i].left = box.IsValid() ? box.left : 0;
		edgeArray[i].right = box.IsValid() ? glyphs[i].advance / fSize - box.right : 0;
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
	const GlyphsOfText glyphs(*this, charArray, numChars, delta);
	for (size_t i = 0; i < glyphs.Count(); i++) {
		BRect box = BoundsOf(FontEngine::Get().Outline(glyphs[i]));
		const float pen = asString ? glyphs.PenAt(i) : 0;
		if (box.IsValid()) {
			box = BRect(box.left * fSize + pen, box.top * fSize, box.right * fSize + pen,
				box.bottom * fSize);
			if (mode == B_SCREEN_METRIC) {
				box = BRect(
					floorf(box.left), floorf(box.top), ceilf(box.right) - 1, ceilf(box.bottom) - 1);
			}
		}
		boxes[i] = box;
	}
}
