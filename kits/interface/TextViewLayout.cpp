// BTextView: where text is, and how it is drawn.
#include "TextView.h"

#include <algorithm>
#include <cctype>
#include <cmath>

#include <Region.h>
#include <ScrollBar.h>
#include <Window.h>

#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;

namespace {

constexpr float kCaretRoom = 1; // behind right-aligned text
constexpr float kNarrowestText = 3; // of a view that grows with its text

} // namespace


int32
BTextView::CountLines() const
{
	return fLayout->CountLines();
}


int32
BTextView::CurrentLine() const
{
	return LineAt(_Start());
}


void
BTextView::GoToLine(int32 line)
{
	const int32 offset = OffsetAt(line);
	Select(offset, offset);
}


int32
BTextView::LineAt(int32 offset) const
{
	return fLayout->LineAtOffset(std::clamp<int32>(offset, 0, TextLength()));
}


int32
BTextView::LineAt(BPoint point) const
{
	return fLayout->LineAtY(point.y - fTextRect.top);
}


BPoint
BTextView::PointAt(int32 offset, float* _height) const
{
	offset = _Clamp(offset);
	const int32 line = fLayout->LineAtOffset(offset);
	if (_height != NULL)
		*_height = fLayout->Height(line);
	return BPoint(_LineLeft(line) + fLayout->XAt(line, offset), fTextRect.top + fLayout->Top(line));
}


int32
BTextView::OffsetAt(BPoint point) const
{
	return _PlaceAt(point).offset;
}


int32
BTextView::OffsetAt(int32 line) const
{
	if (line < 0)
		return 0;
	return line < CountLines() ? fLayout->LineStart(line) : TextLength();
}


float
BTextView::LineWidth(int32 line) const
{
	return line >= 0 && line < CountLines() ? std::ceil(fLayout->Width(line)) : 0;
}


float
BTextView::LineHeight(int32 line) const
{
	return line >= 0 && line < CountLines() ? fLayout->Height(line) : 0;
}


float
BTextView::TextHeight(int32 startLine, int32 endLine) const
{
	const int32 last = CountLines() - 1;
	startLine = std::clamp<int32>(startLine, 0, last);
	endLine = std::clamp<int32>(endLine, 0, last);
	if (startLine > endLine)
		std::swap(startLine, endLine);
	return fLayout->Top(endLine + 1) - fLayout->Top(startLine);
}


// The rest of the first line, whole lines, the start of the last one. Where letters run both ways a
// part of a line may be in several places.
void
BTextView::GetTextRegion(int32 startOffset, int32 endOffset, BRegion* _region) const
{
	if (_region == NULL)
		return;
	_region->MakeEmpty();
	const int32 from = _Clamp(startOffset);
	const int32 to = _Clamp(endOffset);
	if (from >= to)
		return;

	const int32 first = fLayout->LineAtOffset(from);
	const int32 last = fLayout->LineAtOffset(to);
	_AddSpans(first, from, to, _region);
	if (first == last)
		return;
	const float top = fTextRect.top;
	if (last > first + 1) {
		_region->Include(BRect(fTextRect.left, top + fLayout->Top(first + 1),
			std::max(fTextRect.right, Bounds().right), top + fLayout->Top(last) - 1));
	}
	_AddSpans(last, from, to, _region);
}


// What of the range is in the line.
void
BTextView::_AddSpans(int32 line, int32 from, int32 to, BRegion* region) const
{
	const float top = fTextRect.top + fLayout->Top(line);
	const float bottom = fTextRect.top + fLayout->Top(line + 1) - 1;
	const float end = std::max(fTextRect.right, Bounds().right);
	const float lineLeft = _LineLeft(line);
	std::vector<TextLayout::Span> spans;
	fLayout->GetSpans(line, from, to, spans);
	for (const TextLayout::Span& span : spans) {
		const float left = std::floor(lineLeft + span.left);
		const float right = std::isinf(span.right) ? end : std::ceil(lineLeft + span.right) - 1;
		if (right >= left)
			region->Include(BRect(left, top, right, bottom));
	}
}


// Blanks, and letters of scripts that have none.
bool
BTextView::CanEndLine(int32 offset)
{
	if (offset < 0 || offset >= TextLength())
		return true;
	const uchar byte = ByteAt(offset);
	if (byte == ' ' || byte == '\t' || byte == '\n')
		return true;
	if (byte == '-') {
		const uchar next = ByteAt(offset + 1);
		const uchar before = offset > 0 ? ByteAt(offset - 1) : ' ';
		return before != ' ' && !(next >= '0' && next <= '9');
	}
	if (byte < 0xe2)
		return false;
	const uint32 character = fModel->CharacterAt(offset);
	if (character == 0x200b || character == 0x3000)
		return true;
	const uint32 next = fModel->CharacterAt(fModel->NextCharacter(offset));
	const bool closes = next == 0x3001 || next == 0x3002 || next == 0x300d || next == 0xff01
		|| next == 0xff09 || next == 0xff0c || next == 0xff1f;
	return character >= 0x2e80 && character <= 0xfaff && !closes && character != 0x300c;
}


void
BTextView::FindWord(int32 offset, int32* _fromOffset, int32* _toOffset)
{
	offset = _Clamp(offset);
	const auto kind = [this](int32 at) {
		const uint32 character = fModel->CharacterAt(at);
		if (character == '\n')
			return 0;
		if (character == ' ' || character == '\t')
			return 1;
		if (character < 0x80 && !isalnum(static_cast<int>(character)) && character != '_')
			return 2;
		return character >= 0x2000 && character < 0x2e00 ? 2 : 3;
	};
	int32 from = offset;
	int32 to = offset;
	if (offset < TextLength()) {
		const int wanted = kind(offset);
		to = fModel->NextCharacter(offset);
		while (wanted != 0 && to < TextLength() && kind(to) == wanted)
			to = fModel->NextCharacter(to);
		while (wanted != 0 && from > 0 && kind(fModel->PreviousCharacter(from)) == wanted)
			from = fModel->PreviousCharacter(from);
	}
	if (_fromOffset != NULL)
		*_fromOffset = from;
	if (_toOffset != NULL)
		*_toOffset = to;
}


void
BTextView::ScrollToOffset(int32 offset)
{
	if (Window() == NULL)
		return;
	const BRect bounds = Bounds();
	BRect extent = _ExtentOf(_Clamp(offset));
	if (extent.bottom >= fTextRect.bottom - 1)
		extent.bottom = _ContentHeight();
	BPoint where = bounds.LeftTop();
	if (extent.left < bounds.left)
		where.x = std::max(0.0f, extent.left - fTextRect.left - std::floor(bounds.Width() / 4));
	else if (extent.right > bounds.right)
		where.x = extent.right - bounds.Width() + (fWrap ? 0 : std::floor(bounds.Width() / 4));
	if (extent.top < bounds.top)
		where.y = extent.top - (extent.top <= fTextRect.top ? fTextRect.top : 0);
	else if (extent.bottom > bounds.bottom && extent.Height() <= bounds.Height())
		where.y = extent.bottom - bounds.Height();
	// A view that cannot be scrolled by a bar stays where it shows the most.
	if (ScrollBar(B_HORIZONTAL) == NULL)
		where.x = std::min(where.x, std::max(0.0f, _ContentWidth() - bounds.Width()));
	if (ScrollBar(B_VERTICAL) == NULL)
		where.y = std::min(where.y, std::max(0.0f, _ContentHeight() - bounds.Height()));
	where.x = std::max(0.0f, std::ceil(where.x));
	where.y = std::max(0.0f, std::ceil(where.y));
	if (where != bounds.LeftTop())
		ScrollTo(where);
}


void
BTextView::ScrollToSelection()
{
	ScrollToOffset(fCaret);
}


// Calling it again for the same part takes the highlight away.
void
BTextView::Highlight(int32 startOffset, int32 endOffset)
{
	const int32 from = _Clamp(startOffset);
	const int32 to = _Clamp(endOffset);
	_InvalidateRange(fHighlightStart, fHighlightEnd);
	if (from >= to || (from == fHighlightStart && to == fHighlightEnd)) {
		fHighlightStart = fHighlightEnd = 0;
	} else {
		fHighlightStart = from;
		fHighlightEnd = to;
		_InvalidateRange(from, to);
	}
}


void
BTextView::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


// Wrapped text keeps its width.
void
BTextView::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL)
		*_width = fWrap ? Bounds().Width() : _ContentWidth();
	if (_height != NULL)
		*_height = _ContentHeight();
}


// #pragma mark - layout


// Negative: no wrapping.
float
BTextView::_WrapWidth() const
{
	return fWrap ? std::max(0.0f, fTextRect.Width()) : -1;
}


void
BTextView::_LayOutAgain()
{
	fLayout->SetWrapWidth(_WrapWidth());
	fLayout->LayOut();
	_TextHeightChanged();
	_FitToText();
	_UpdateScrollBars();
	Invalidate();
}


void
BTextView::_TextHeightChanged()
{
	fTextRect.bottom = fTextRect.top + fLayout->TotalHeight();
}


void
BTextView::_TextChanged(int32 offset, int32 removed, int32 inserted)
{
	const float oldBottom = fTextRect.top + fLayout->TotalHeight();
	const TextLayout::Difference difference = fLayout->Change(offset, removed, inserted);
	_TextHeightChanged();

	if (difference.heightDelta == 0 && difference.oldCount == difference.newCount) {
		_InvalidateLines(difference.first, difference.first + difference.newCount);
	} else {
		BRect rect = Bounds();
		rect.top = std::max(rect.top, fTextRect.top + fLayout->Top(difference.first));
		rect.bottom =
			std::min(rect.bottom, std::max(oldBottom, fTextRect.top + fLayout->TotalHeight()));
		Invalidate(rect);
	}
	fHighlightStart = fHighlightEnd = 0;
	_FitToText();
	_UpdateScrollBars();
	_KeepInView();
	_RestartBlinking();
}


void
BTextView::_StyleChanged(int32 from, int32 to)
{
	const float oldBottom = fTextRect.top + fLayout->TotalHeight();
	fLayout->Change(from, to - from, to - from);
	_TextHeightChanged();
	BRect rect = Bounds();
	rect.top = std::max(rect.top, fTextRect.top + fLayout->Top(fLayout->LineAtOffset(from)));
	rect.bottom =
		std::min(rect.bottom, std::max(oldBottom, fTextRect.top + fLayout->TotalHeight()));
	Invalidate(rect);
	_FitToText();
	_UpdateScrollBars();
}


// A resizable view takes the size of its text, and its container grows by as much.
void
BTextView::_FitToText()
{
	if (!fResizable)
		return;
	const BRect bounds = Bounds();
	const float textWidth = std::max(kNarrowestText, std::ceil(fLayout->KnownWidth()));
	const float width = fTextRect.left * 2 + textWidth;
	const float height = std::max(bounds.Height(), _ContentHeight());
	const float dx = width - bounds.Width();
	const float dy = height - bounds.Height();
	fTextRect.right = fTextRect.left + textWidth;
	if (dx == 0 && dy == 0)
		return;

	BView* view = fContainer != NULL ? fContainer : this;
	if (fAlignment == B_ALIGN_CENTER)
		view->MoveBy(std::floor(-dx / 2), 0);
	else if (fAlignment == B_ALIGN_RIGHT)
		view->MoveBy(-dx, 0);
	view->ResizeBy(dx, dy);
	// A container that this view does not follow.
	if (Bounds().Width() != width || Bounds().Height() != height)
		ResizeTo(width, height);
}


float
BTextView::_ContentWidth() const
{
	return std::ceil(fLayout->KnownWidth()) + fTextRect.left * 2 + kCaretRoom;
}


// With the space above once more below; bottom - top.
float
BTextView::_ContentHeight() const
{
	return fLayout->TotalHeight() + fTextRect.top * 2 - 1;
}


void
BTextView::_UpdateScrollBars()
{
	if (Window() == NULL)
		return;
	const BRect bounds = Bounds();
	if (BScrollBar* bar = ScrollBar(B_VERTICAL)) {
		const float height = _ContentHeight();
		bar->SetRange(0, std::max(0.0f, std::ceil(height - bounds.Height())));
		bar->SetProportion(height > 0 ? std::min(1.0f, bounds.Height() / height) : 1);
		bar->SetSteps(LineHeight(0), std::max(LineHeight(0), bounds.Height() - LineHeight(0)));
	}
	if (BScrollBar* bar = ScrollBar(B_HORIZONTAL)) {
		const float width = fWrap ? bounds.Width() : _ContentWidth();
		bar->SetRange(0, std::max(0.0f, std::ceil(width - bounds.Width())));
		bar->SetProportion(width > 0 ? std::min(1.0f, bounds.Width() / width) : 1);
		bar->SetSteps(12, std::max(12.0f, bounds.Width() - 12));
	}
}


// Without scroll bars, a text that became shorter shall not leave the view empty.
void
BTextView::_KeepInView()
{
	if (Window() == NULL)
		return;
	const BRect bounds = Bounds();
	BPoint where = bounds.LeftTop();
	if (where.x > 0 && ScrollBar(B_HORIZONTAL) == NULL)
		where.x = std::clamp(_ContentWidth() - bounds.Width(), 0.0f, where.x);
	if (where.y > 0 && ScrollBar(B_VERTICAL) == NULL)
		where.y = std::clamp(_ContentHeight() - bounds.Height(), 0.0f, where.y);
	if (where != bounds.LeftTop())
		ScrollTo(where);
}


float
BTextView::_LineLeft(int32 line) const
{
	if (fAlignment != B_ALIGN_RIGHT && fAlignment != B_ALIGN_CENTER)
		return fTextRect.left;
	const float room = std::max(0.0f, fTextRect.Width() - kCaretRoom - fLayout->Width(line));
	return fTextRect.left + std::floor(fAlignment == B_ALIGN_CENTER ? room / 2 : room);
}


// The caret's column there, over the whole height of the line.
BRect
BTextView::_ExtentOf(int32 offset) const
{
	offset = _Clamp(offset);
	const int32 line = fLayout->LineAtOffset(offset);
	const TextPlace place = { offset, fCaretBehind && offset == fCaret };
	const float x = std::floor(_LineLeft(line) + fLayout->XAt(line, place));
	const float top = fTextRect.top + fLayout->Top(line);
	return BRect(x, top, x, top + fLayout->Height(line) - 1);
}


TextPlace
BTextView::_PlaceAt(BPoint point) const
{
	if (point.y < fTextRect.top)
		return fLayout->PlaceAtX(0, point.x - _LineLeft(0));
	if (point.y >= fTextRect.top + fLayout->TotalHeight() && CountLines() > 1)
		return TextLength();
	const int32 line = LineAt(point);
	return fLayout->PlaceAtX(line, point.x - _LineLeft(line));
}


void
BTextView::_InvalidateLines(int32 from, int32 to)
{
	BRect rect = Bounds();
	rect.top = std::max(rect.top, fTextRect.top + fLayout->Top(from));
	rect.bottom = std::min(rect.bottom, fTextRect.top + fLayout->Top(to) - 1);
	if (rect.IsValid())
		Invalidate(rect);
}


void
BTextView::_InvalidateRange(int32 from, int32 to)
{
	if (from == to || Window() == NULL)
		return;
	BRegion region;
	GetTextRegion(from, to, &region);
	for (int32 i = 0; i < region.CountRects(); i++) {
		const BRect rect = region.RectAt(i) & Bounds();
		if (rect.IsValid())
			Invalidate(rect);
	}
}
