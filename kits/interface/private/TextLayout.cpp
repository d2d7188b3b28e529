#include "interface/private/TextLayout.h"

#include <algorithm>
#include <atomic>
#include <cmath>

#include <TextView.h>

#include "interface/private/GlyphWidths.h"
#include "interface/private/TextWalker.h"

namespace BPrivate {

namespace {

// A text with more lines is measured as far as it is shown.
constexpr int32 kMeasureAllLines = 2000;

std::atomic<int64> sLaidOut = 0; // lines

} // namespace


int64
TextLayout::CountLaidOut()
{
	return sLaidOut;
}


TextLayout::TextLayout(BTextView& view, TextModel& model) : fView(view), fModel(model)
{
	float height;
	fLines.push_back(_MakeLine(0, 0, -1, &height));
	fLines.push_back({ 0, height, 0, 0 });
}


void
TextLayout::LayOut()
{
	fLines.clear();
	fLines.shrink_to_fit();
	fStepLine = fStepOffset = 0;
	fStepTop = 0;

	const int32 length = fModel.Length();
	float top = 0;
	int32 offset = 0;
	do {
		float width;
		const int32 end = _FindEnd(offset, &width);
		float height;
		fLines.push_back(_MakeLine(offset, end, width, &height));
		fLines.back().top = top;
		top += height;
		offset = end;
		if (offset == length && length > 0 && fLines.back().offset < length
			&& fModel.Buffer().ByteAt(length - 1) == '\n') {
			fLines.push_back(_MakeLine(offset, offset, 0, &height));
			fLines.back().top = top;
			top += height;
		}
	} while (offset < length);
	fLines.push_back({ length, top, 0, 0 });
}


TextLayout::Difference
TextLayout::Change(int32 offset, int32 removed, int32 inserted)
{
	const int32 delta = inserted - removed;
	const int32 length = fModel.Length();
	const int32 oldCount = CountLines();

	int32 first = LineAtOffset(offset);
	// A word may go back to the line before.
	if (fWrapWidth >= 0 && first > 0 && fModel.Buffer().ByteAt(LineStart(first) - 1) != '\n')
		first--;
	const float top = Top(first);

	std::vector<Line> lines;
	float height = 0;
	int32 position = LineStart(first);
	int32 old = first + 1;
	while (true) {
		if (!lines.empty()) {
			// At the end there is one more line only behind a line break.
			const bool atEnd = position >= length
				&& (lines.back().offset == length || fModel.Buffer().ByteAt(length - 1) != '\n');
			if (atEnd) {
				old = oldCount;
				break;
			}
			while (old < oldCount
				&& (LineStart(old) < offset + removed || LineStart(old) + delta < position))
				old++;
			// The empty line at the end looks like what stands before it, so it is made anew.
			if (old < oldCount && LineStart(old) + delta == position && position < length)
				break;
		}
		float width;
		const int32 end = _FindEnd(position, &width);
		float lineHeight;
		lines.push_back(_MakeLine(position, end, width, &lineHeight));
		lines.back().top = top + height;
		height += lineHeight;
		position = end;
	}

	const Difference difference { first, old - first, static_cast<int32>(lines.size()),
		height - (Top(old) - top) };
	_MoveStep(old);
	const int32 shared = std::min(difference.oldCount, difference.newCount);
	std::copy_n(lines.begin(), shared, fLines.begin() + first);
	if (difference.newCount > shared) {
		fLines.insert(fLines.begin() + first + shared, lines.begin() + shared, lines.end());
	} else if (difference.oldCount > shared) {
		fLines.erase(fLines.begin() + first + shared, fLines.begin() + old);
	}
	fStepLine = first + difference.newCount;
	fStepOffset += delta;
	fStepTop += difference.heightDelta;
	return difference;
}


int32
TextLayout::LineStart(int32 line) const
{
	return fLines[line].offset + (line >= fStepLine ? fStepOffset : 0);
}


float
TextLayout::Top(int32 line) const
{
	return fLines[line].top + (line >= fStepLine ? fStepTop : 0);
}


int32
TextLayout::VisibleEnd(int32 line) const
{
	const int32 end = LineEnd(line);
	if (end > LineStart(line) && fModel.Buffer().ByteAt(end - 1) == '\n')
		return end - 1;
	return end;
}


float
TextLayout::Width(int32 line) const
{
	if (fLines[line].width < 0)
		fLines[line].width = _Measure(line);
	return fLines[line].width;
}


float
TextLayout::KnownWidth() const
{
	const int32 count = CountLines();
	float widest = 0;
	for (int32 i = 0; i < count; i++) {
		if (count <= kMeasureAllLines)
			Width(i);
		widest = std::max(widest, fLines[i].width);
	}
	return widest;
}


int32
TextLayout::LineAtOffset(int32 offset) const
{
	int32 low = 0;
	int32 high = CountLines() - 1;
	while (low < high) {
		const int32 middle = (low + high + 1) / 2;
		if (LineStart(middle) <= offset)
			low = middle;
		else
			high = middle - 1;
	}
	return low;
}


int32
TextLayout::LineAtY(float y) const
{
	int32 low = 0;
	int32 high = CountLines() - 1;
	while (low < high) {
		const int32 middle = (low + high + 1) / 2;
		if (Top(middle) <= y)
			low = middle;
		else
			high = middle - 1;
	}
	return low;
}


void
TextLayout::_MoveStep(int32 line)
{
	for (; fStepLine < line; fStepLine++) {
		fLines[fStepLine].offset += fStepOffset;
		fLines[fStepLine].top += fStepTop;
	}
	for (; fStepLine > line; fStepLine--) {
		fLines[fStepLine - 1].offset -= fStepOffset;
		fLines[fStepLine - 1].top -= fStepTop;
	}
}


// Where the line that starts there ends; behind its line break if it has one. The width is
// negative when it was not needed.
int32
TextLayout::_FindEnd(int32 start, float* _width)
{
	const int32 length = fModel.Length();
	if (fWrapWidth < 0) {
		*_width = -1;
		const int32 found = fModel.Buffer().Find('\n', start);
		return found < 0 ? length : found + 1;
	}

	Walker walker(*this, start);
	float x = 0;
	int32 lastBreak = -1;
	float lastBreakX = 0;
	while (walker.Offset() < length) {
		const int32 offset = walker.Offset();
		if (fModel.Buffer().ByteAt(offset) == '\n') {
			*_width = x;
			return offset + 1;
		}
		const float step = walker.Step(x);
		const uint32 character = walker.Character();
		// Blanks may hang over the right edge.
		if (x + step > fWrapWidth && character != ' ' && character != '\t' && offset > start
			&& !is_mark_character(character)) {
			*_width = lastBreak > start ? lastBreakX : x;
			return lastBreak > start ? lastBreak : offset;
		}
		x += step;
		if (fView.CanEndLine(offset)) {
			lastBreak = walker.Offset();
			lastBreakX = x;
		}
	}
	*_width = x;
	return length;
}


TextLayout::Line
TextLayout::_MakeLine(int32 start, int32 end, float width, float* _height) const
{
	sLaidOut.fetch_add(1, std::memory_order_relaxed);
	Line line { start, 0, 0, width };
	*_height = 0;
	const int32 first = fModel.RunIndexAt(start);
	for (int32 i = first; i < static_cast<int32>(fModel.Runs().size()); i++) {
		if (i > first && fModel.Runs()[i].offset >= end)
			break;
		const GlyphWidths& widths = GlyphWidths::For(fModel.Runs()[i].style.font);
		line.ascent = std::max(line.ascent, widths.Ascent());
		*_height = std::max(*_height, widths.LineHeight());
	}
	return line;
}


} // namespace BPrivate
