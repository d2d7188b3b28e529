// BTextView: how it and its caret are drawn.
#include "TextView.h"

#include <algorithm>
#include <cmath>

#include <Region.h>
#include <ScrollView.h>
#include <Window.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;


void
BTextView::Draw(BRect updateRect)
{
	const int32 first = LineAt(BPoint(0, updateRect.top));
	const int32 count = CountLines();
	PushState();
	SetDrawingMode(B_OP_OVER);
	for (int32 i = first; i < count; i++) {
		if (fTextRect.top + fLayout->Top(i) > updateRect.bottom)
			break;
		_DrawLine(i, updateRect);
	}
	PopState();

	if (_ShowsSelection())
		_InvertRange(_Start(), _End(), updateRect);
	if (fHighlightStart < fHighlightEnd)
		_InvertRange(fHighlightStart, fHighlightEnd, updateRect);
	_DrawComposition(updateRect);
	if (_ShowsCaret())
		InvertRect(_CaretRect(fCaret));
	if (fDropPlace >= 0)
		InvertRect(_CaretRect(fDropPlace));
}


void
BTextView::_DrawLine(int32 line, BRect updateRect)
{
	std::vector<TextLayout::Piece> pieces;
	fLayout->GetPieces(line, pieces);
	const float left = _LineLeft(line);
	const float baseline = fTextRect.top + fLayout->Top(line) + fLayout->Ascent(line);
	const rgb_color faded = tint_color(ViewColor(), B_DISABLED_LABEL_TINT);
	std::string text;
	for (const TextLayout::Piece& piece : pieces) {
		// Slanted letters reach a little beyond their place.
		const float overhang = piece.style->font.Size();
		const float x = left + piece.x;
		if (x - overhang > updateRect.right || x + piece.width + overhang < updateRect.left)
			continue;
		SetFont(&piece.style->font);
		SetHighColor(fFaded ? faded : piece.style->color);
		const int32 length = piece.end - piece.start;
		const char* bytes = fModel->Buffer().Contiguous(piece.start, length);
		if (!fHidesTyping && piece.order == TextLayout::PieceOrder::OfItself) {
			DrawString(bytes, length, BPoint(x, baseline));
			continue;
		}
		text = TextLayout::OrderMark(piece.order);
		if (!fHidesTyping)
			text.append(bytes, length);
		for (int32 at = piece.start; fHidesTyping && at < piece.end; at = fModel->NextCharacter(at))
			text += B_UTF8_BULLET;
		DrawString(text.data(), static_cast<int32>(text.size()), BPoint(x, baseline));
	}
}


void
BTextView::_InvertRange(int32 from, int32 to, BRect updateRect)
{
	BRegion region;
	GetTextRegion(from, to, &region);
	for (int32 i = 0; i < region.CountRects(); i++) {
		const BRect rect = region.RectAt(i) & updateRect;
		if (rect.IsValid())
			InvertRect(rect);
	}
}


// #pragma mark - caret


BRect
BTextView::_CaretRect(int32 offset) const
{
	return _ExtentOf(offset);
}


bool
BTextView::_ShowsCaret() const
{
	return fCaretVisible && fActive && fEditable && fAnchor == fCaret;
}


bool
BTextView::_ShowsSelection() const
{
	return fActive && (fSelectable || fEditable) && fAnchor != fCaret;
}


// After every change the caret shows for a whole phase.
void
BTextView::_RestartBlinking()
{
	fCaretTime = system_time();
	fCaretVisible = true;
	if (Window() != NULL && fActive)
		Invalidate(_CaretRect(fCaret));
}


void
BTextView::_SetActive(bool active)
{
	if (fActive == active)
		return;
	if (!active) {
		_EndComposition(true);
		if (fHistory != nullptr)
			fHistory->BreakTyping();
	}
	fActive = active;
	fCaretVisible = active;
	fCaretTime = system_time();
	if (Window() == NULL)
		return;
	if (BScrollView* scroller = dynamic_cast<BScrollView*>(Parent()))
		scroller->SetBorderHighlighted(active);
	Invalidate(_CaretRect(fCaret));
	_InvalidateRange(_Start(), _End());
}
