// BTextView: its settings.
#include "TextView.h"

#include <algorithm>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;


void
BTextView::SetTextRect(BRect rect)
{
	if (!fWrap) {
		const BRect bounds = Bounds();
		rect.right = std::max(rect.left, bounds.Width());
	}
	fTextRect = rect;
	_LayOutAgain();
}


// Its bottom is where the text ends.
BRect
BTextView::TextRect() const
{
	return fTextRect;
}


void
BTextView::SetStylable(bool stylable)
{
	if (fStylable == stylable)
		return;
	fStylable = stylable;
	if (!stylable) {
		fModel->SetStyle(TextStyle(fModel->Runs().front().style));
		_LayOutAgain();
	}
}


bool
BTextView::IsStylable() const
{
	return fStylable;
}


void
BTextView::SetTabWidth(float width)
{
	if (fTabWidth == width)
		return;
	fTabWidth = width;
	fLayout->SetTabWidth(width);
	_LayOutAgain();
}


float
BTextView::TabWidth() const
{
	return fTabWidth;
}


void
BTextView::MakeSelectable(bool selectable)
{
	if (fSelectable == selectable)
		return;
	fSelectable = selectable;
	_InvalidateRange(_Start(), _End());
}


bool
BTextView::IsSelectable() const
{
	return fSelectable;
}


void
BTextView::MakeEditable(bool editable)
{
	if (fEditable == editable)
		return;
	_EndComposition(true);
	fEditable = editable;
	Invalidate(_CaretRect(fCaret));
	_RestartBlinking();
}


bool
BTextView::IsEditable() const
{
	return fEditable;
}


void
BTextView::SetWordWrap(bool wrap)
{
	if (fWrap == wrap)
		return;
	fWrap = wrap;
	if (!wrap)
		fTextRect.right = std::max(fTextRect.left, Bounds().Width());
	_LayOutAgain();
}


bool
BTextView::DoesWordWrap() const
{
	return fWrap;
}


void
BTextView::SetMaxBytes(int32 max)
{
	fMaxBytes = max;
	const int32 limit = _Clamp(std::max<int32>(max, 0));
	if (limit < TextLength())
		Delete(limit, TextLength());
}


int32
BTextView::MaxBytes() const
{
	return fMaxBytes;
}


void
BTextView::DisallowChar(uint32 character)
{
	if (std::find(fDisallowed.begin(), fDisallowed.end(), character) == fDisallowed.end())
		fDisallowed.push_back(character);
}


void
BTextView::AllowChar(uint32 character)
{
	std::erase(fDisallowed, character);
}


void
BTextView::SetAlignment(alignment flag)
{
	if (fAlignment == flag)
		return;
	fAlignment = flag;
	Invalidate();
}


alignment
BTextView::Alignment() const
{
	return fAlignment;
}


void
BTextView::SetAutoindent(bool autoindent)
{
	fAutoindent = autoindent;
}


bool
BTextView::DoesAutoindent() const
{
	return fAutoindent;
}


void
BTextView::SetColorSpace(color_space colors)
{
	fColorSpace = colors;
}


color_space
BTextView::ColorSpace() const
{
	return fColorSpace;
}


void
BTextView::MakeResizable(bool resize, BView* resizeView)
{
	fResizable = resize;
	fContainer = resize ? resizeView : NULL;
	if (!resize)
		return;
	SetWordWrap(false);
	_FitToText();
}


bool
BTextView::IsResizable() const
{
	return fResizable;
}


void
BTextView::SetDoesUndo(bool undo)
{
	fDoesUndo = undo;
	if (!undo)
		fHistory.reset();
}


bool
BTextView::DoesUndo() const
{
	return fDoesUndo;
}


void
BTextView::HideTyping(bool enabled)
{
	if (fHidesTyping == enabled)
		return;
	fHidesTyping = enabled;
	fLayout->SetHidden(enabled);
	_LayOutAgain();
}


bool
BTextView::IsTypingHidden() const
{
	return fHidesTyping;
}
