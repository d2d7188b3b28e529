#include "interface/private/TextLayout.h"

#include <algorithm>
#include <atomic>
#include <cmath>

#include <TextView.h>

#include "interface/private/GlyphWidths.h"

namespace BPrivate {

namespace {

constexpr uint32 kBullet = 0x2022;
// A text with more lines is measured as far as it is shown.
constexpr int32 kMeasureAllLines = 2000;
constexpr int32 kLongestChunk = 96; // bytes of joining letters that are measured together

std::atomic<int64> sLaidOut = 0; // lines

} // namespace


// Goes through the text character by character and says how wide each is.
class TextLayout::Walker {
public:
	Walker(const TextLayout& layout, int32 offset) :
		fLayout(layout), fModel(layout.fModel), fRun(fModel.RunIndexAt(offset)), fOffset(offset)
	{
		_EnterRun();
	}

	int32 Offset() const { return fOffset; }
	int32 RunIndex() const { return fRun; }
	uint32 Character() const { return fCharacter; }

	// The width of the character at the offset, when the line has reached `x`; goes on behind it.
	float Step(float x)
	{
		const uchar byte = static_cast<uchar>(fModel.Buffer().ByteAt(fOffset));
		if (fOffset >= fRunEnd)
			_NextRun();
		if (fLayout.fHidden && byte != '\n')
			return _StepOver(fWidths->Width(kBullet));
		if (byte < 0x80) {
			fCharacter = byte;
			fOffset++;
			return byte == '\t' ? _TabWidth(x) : fWidths->Width(byte);
		}
		const uint32 character = fModel.CharacterAt(fOffset);
		if (is_simple_character(character)) {
			fCharacter = character;
			fOffset = fModel.NextCharacter(fOffset);
			return fWidths->Width(character);
		}
		return _StepInChunk();
	}

private:
	void _EnterRun()
	{
		fRunEnd = fModel.RunEnd(fRun);
		fWidths = &GlyphWidths::For(fModel.Runs()[fRun].style.font);
		fChunkEnd = -1;
	}

	void _NextRun()
	{
		while (fOffset >= fRunEnd && fRun + 1 < static_cast<int32>(fModel.Runs().size())) {
			fRun++;
			_EnterRun();
		}
	}

	float _StepOver(float width)
	{
		fCharacter = fModel.CharacterAt(fOffset);
		fOffset = fModel.NextCharacter(fOffset);
		return width;
	}

	float _TabWidth(float x) const
	{
		const float width = fLayout.fTabWidth;
		if (width <= 0)
			return 0;
		return (std::floor(x / width) + 1) * width - x;
	}

	// Letters that join are measured from where their group begins.
	float _StepInChunk()
	{
		if (fOffset >= fChunkEnd) {
			fChunkStart = fChunkEnd = fOffset;
			while (fChunkEnd < fRunEnd && fChunkEnd - fChunkStart < kLongestChunk
				&& !is_simple_character(fModel.CharacterAt(fChunkEnd)))
				fChunkEnd = fModel.NextCharacter(fChunkEnd);
			fChunkEnd = std::min(fChunkEnd, fRunEnd);
			fBefore = 0;
		}
		fCharacter = fModel.CharacterAt(fOffset);
		fOffset = std::min(fModel.NextCharacter(fOffset), fChunkEnd);
		const int32 length = fOffset - fChunkStart;
		const float width =
			fWidths->StringWidth(fModel.Buffer().Contiguous(fChunkStart, length), length);
		const float step = std::max(0.0f, width - fBefore);
		fBefore = std::max(fBefore, width);
		return step;
	}

	const TextLayout& fLayout;
	TextModel& fModel;
	const GlyphWidths* fWidths = nullptr;
	int32 fRun;
	int32 fRunEnd = 0;
	int32 fOffset;
	uint32 fCharacter = 0;
	int32 fChunkStart = 0;
	int32 fChunkEnd = -1;
	float fBefore = 0;
};


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
		fLines[line].width = XAt(line, VisibleEnd(line));
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


float
TextLayout::XAt(int32 line, int32 offset) const
{
	const int32 end = std::min(offset, VisibleEnd(line));
	Walker walker(*this, LineStart(line));
	float x = 0;
	while (walker.Offset() < end)
		x += walker.Step(x);
	return x;
}


int32
TextLayout::OffsetAtX(int32 line, float x) const
{
	const int32 start = LineStart(line);
	int32 end = VisibleEnd(line);
	// Behind the last character of a wrapped line is the start of the next.
	if (end == LineEnd(line) && line + 1 < CountLines())
		end = PreviousPlace(end);

	Walker walker(*this, start);
	int32 place = start;
	float left = 0;
	while (walker.Offset() < end) {
		const int32 next = std::min(NextPlace(walker.Offset()), end);
		float right = left;
		while (walker.Offset() < next)
			right += walker.Step(right);
		if (x < (left + right) / 2)
			return place;
		place = next;
		left = right;
	}
	return place;
}


void
TextLayout::GetPieces(int32 line, std::vector<Piece>& pieces) const
{
	pieces.clear();
	const int32 end = VisibleEnd(line);
	Walker walker(*this, LineStart(line));
	float x = 0;
	int32 run = -1;
	while (walker.Offset() < end) {
		const int32 offset = walker.Offset();
		const float width = walker.Step(x);
		const bool isTab = walker.Character() == '\t' && !fHidden;
		if (isTab) {
			run = -1;
		} else if (walker.RunIndex() != run) {
			run = walker.RunIndex();
			pieces.push_back({ offset, walker.Offset(), &fModel.Runs()[run].style, x, width });
		} else {
			pieces.back().end = walker.Offset();
			pieces.back().width += width;
		}
		x += width;
	}
	fLines[line].width = x;
}


int32
TextLayout::NextPlace(int32 offset) const
{
	const int32 length = fModel.Length();
	if (offset >= length)
		return length;
	bool joined = fModel.CharacterAt(offset) == 0x200d;
	int32 next = fModel.NextCharacter(offset);
	while (next < length) {
		const uint32 character = fModel.CharacterAt(next);
		if (!joined && !is_mark_character(character))
			break;
		joined = character == 0x200d;
		next = fModel.NextCharacter(next);
	}
	return next;
}


int32
TextLayout::PreviousPlace(int32 offset) const
{
	int32 previous = fModel.PreviousCharacter(offset);
	while (previous > 0
		&& (is_mark_character(fModel.CharacterAt(previous))
			|| fModel.CharacterAt(fModel.PreviousCharacter(previous)) == 0x200d))
		previous = fModel.PreviousCharacter(previous);
	return previous;
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
