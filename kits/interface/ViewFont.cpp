// The font of views, and how wide texts are in it.
#include <View.h>

#include <cmath>

#include <Window.h>

#include "interface/private/FontAccess.h"
#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"

using namespace BPrivate;


void
BView::SetFont(const BFont* font, uint32 mask)
{
	if (font == nullptr || mask == 0)
		return;
	_CheckLock();
	FontSpec& to = _State()->draw.font;
	const FontSpec from = ToFontSpec(*font);
	if ((mask & B_FONT_FAMILY_AND_STYLE) != 0) {
		to.familyAndStyle = from.familyAndStyle;
		to.face = from.face;
	}
	if ((mask & B_FONT_SIZE) != 0)
		to.size = from.size;
	if ((mask & B_FONT_SHEAR) != 0)
		to.shear = from.shear;
	if ((mask & B_FONT_ROTATION) != 0)
		to.rotation = from.rotation;
	if ((mask & B_FONT_SPACING) != 0)
		to.spacing = from.spacing;
	if ((mask & B_FONT_ENCODING) != 0)
		to.encoding = from.encoding;
	if ((mask & B_FONT_FACE) != 0) {
		BFont styled;
		styled.SetFamilyAndStyle(to.familyAndStyle);
		styled.SetFace(font->Face());
		to.familyAndStyle = ToFontSpec(styled).familyAndStyle;
		to.face = from.face;
	}
	if ((mask & B_FONT_FLAGS) != 0)
		to.flags = from.flags;
	if ((mask & B_FONT_FALSE_BOLD_WIDTH) != 0)
		to.falseBoldWidth = from.falseBoldWidth;
	fTouched |= kTouchedFont;
}


void
BView::GetFont(BFont* font) const
{
	if (font == nullptr)
		return;
	*font = BFont();
	if (fState == nullptr)
		return;
	const FontSpec& spec = fState->draw.font;
	if (spec.familyAndStyle != 0)
		font->SetFamilyAndStyle(spec.familyAndStyle);
	font->SetSize(spec.size);
	font->SetShear(spec.shear);
	font->SetRotation(spec.rotation);
	font->SetSpacing(spec.spacing);
	font->SetEncoding(spec.encoding);
	if (spec.face != font->Face())
		font->SetFace(spec.face);
	font->SetFlags(spec.flags);
	font->SetFalseBoldWidth(spec.falseBoldWidth);
}


void
BView::SetFontSize(float size)
{
	BFont font;
	font.SetSize(size);
	SetFont(&font, B_FONT_SIZE);
}


void
BView::ForceFontAliasing(bool enable)
{
	BFont font;
	font.SetFlags(enable ? B_DISABLE_ANTIALIASING : 0);
	SetFont(&font, B_FONT_FLAGS);
}


void
BView::GetFontHeight(font_height* height) const
{
	BFont font;
	GetFont(&font);
	font.GetHeight(height);
}


float
BView::StringWidth(const char* string) const
{
	BFont font;
	GetFont(&font);
	return font.StringWidth(string);
}


float
BView::StringWidth(const char* string, int32 length) const
{
	BFont font;
	GetFont(&font);
	return font.StringWidth(string, length);
}


void
BView::GetStringWidths(char* strings[], int32 lengths[], int32 count, float widths[]) const
{
	BFont font;
	GetFont(&font);
	font.GetStringWidths(const_cast<const char**>(strings), lengths, count, widths);
}


void
BView::TruncateString(BString* string, uint32 mode, float width) const
{
	BFont font;
	GetFont(&font);
	font.TruncateString(string, mode, width);
}
