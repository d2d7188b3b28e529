// BTextView: fonts and colours of its text.
#include "TextView.h"

#include <algorithm>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;


namespace {

// The part of the font that the mask names.
void
merge_font(BFont& to, const BFont& from, uint32 mask)
{
	if (mask & B_FONT_FAMILY_AND_STYLE)
		to.SetFamilyAndStyle(from.FamilyAndStyle());
	if (mask & B_FONT_SIZE)
		to.SetSize(from.Size());
	if (mask & B_FONT_SHEAR)
		to.SetShear(from.Shear());
	if (mask & B_FONT_ROTATION)
		to.SetRotation(from.Rotation());
	if (mask & B_FONT_SPACING)
		to.SetSpacing(from.Spacing());
	if (mask & B_FONT_ENCODING)
		to.SetEncoding(from.Encoding());
	if (mask & B_FONT_FACE)
		to.SetFace(from.Face());
	if (mask & B_FONT_FLAGS)
		to.SetFlags(from.Flags());
}


// The mask's bits in which the two agree.
uint32
common_font_bits(const BFont& a, const BFont& b, uint32 mask)
{
	const auto drop = [&mask](uint32 bit, bool same) {
		if (!same)
			mask &= ~bit;
	};
	drop(B_FONT_FAMILY_AND_STYLE, a.FamilyAndStyle() == b.FamilyAndStyle());
	drop(B_FONT_SIZE, a.Size() == b.Size());
	drop(B_FONT_SHEAR, a.Shear() == b.Shear());
	drop(B_FONT_ROTATION, a.Rotation() == b.Rotation());
	drop(B_FONT_SPACING, a.Spacing() == b.Spacing());
	drop(B_FONT_ENCODING, a.Encoding() == b.Encoding());
	drop(B_FONT_FACE, a.Face() == b.Face());
	drop(B_FONT_FLAGS, a.Flags() == b.Flags());
	return mask;
}

} // namespace


void
BTextView::SetFontAndColor(const BFont* font, uint32 mode, const rgb_color* color)
{
	if (_Start() != _End() || !fStylable) {
		SetFontAndColor(_Start(), _End(), font, mode, color);
		return;
	}
	TextStyle style = fModel->StyleForInsertion(fCaret);
	if (font != NULL)
		merge_font(style.font, *font, mode);
	if (color != NULL)
		style.color = *color;
	fModel->SetPendingStyle(fCaret, style);
	if (TextLength() == 0)
		_LayOutAgain();
}


void
BTextView::SetFontAndColor(
	int32 startOffset, int32 endOffset, const BFont* font, uint32 mode, const rgb_color* color)
{
	int32 from = _Clamp(startOffset);
	int32 to = _Clamp(endOffset);
	if (!fStylable) {
		from = 0;
		to = TextLength();
	}
	if (from > to || (from == to && TextLength() > 0))
		return;

	TextRuns runs = fModel->CopyRuns(from, to);
	for (TextRun& run : runs) {
		if (font != NULL)
			merge_font(run.style.font, *font, mode);
		if (color != NULL)
			run.style.color = *color;
	}
	fModel->SetRuns(from, to, runs);
	_StyleChanged(from, to);
}


void
BTextView::GetFontAndColor(int32 offset, BFont* _font, rgb_color* _color) const
{
	const TextStyle& style = fModel->StyleAt(_Clamp(offset));
	if (_font != NULL)
		*_font = style.font;
	if (_color != NULL)
		*_color = style.color;
}


void
BTextView::GetFontAndColor(BFont* _font, uint32* _mode, rgb_color* _color, bool* _sameColor) const
{
	TextStyle style = fModel->StyleForInsertion(fCaret);
	uint32 mode = B_FONT_ALL;
	bool sameColor = true;
	if (_Start() != _End()) {
		const TextRuns runs = fModel->CopyRuns(_Start(), _End());
		style = runs.front().style;
		for (const TextRun& run : runs) {
			mode = common_font_bits(style.font, run.style.font, mode);
			sameColor = sameColor && run.style.color == style.color;
		}
	}
	if (_font != NULL)
		*_font = style.font;
	if (_mode != NULL)
		*_mode = mode;
	if (_color != NULL)
		*_color = style.color;
	if (_sameColor != NULL)
		*_sameColor = sameColor;
}


void
BTextView::SetRunArray(int32 startOffset, int32 endOffset, const text_run_array* runs)
{
	if (runs == NULL || runs->count <= 0)
		return;
	const int32 from = _Clamp(startOffset);
	const int32 to = _Clamp(endOffset);
	if (!fStylable) {
		fModel->SetStyle({ runs->runs[0].font, runs->runs[0].color });
		_StyleChanged(0, TextLength());
		return;
	}
	if (from > to)
		return;
	fModel->SetRuns(from, to, runs_from_array(runs, to - from, fModel->StyleAt(from)));
	_StyleChanged(from, to);
}


text_run_array*
BTextView::RunArray(int32 startOffset, int32 endOffset, int32* _size) const
{
	const int32 from = _Clamp(startOffset);
	const int32 to = std::max(from, _Clamp(endOffset));
	const TextRuns runs = fModel->CopyRuns(from, to);
	text_run_array* array = AllocRunArray(static_cast<int32>(runs.size()), _size);
	if (array == NULL)
		return NULL;
	for (size_t i = 0; i < runs.size(); i++)
		array->runs[i] = { runs[i].offset, runs[i].style.font, runs[i].style.color };
	return array;
}
