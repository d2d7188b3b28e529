// TextLayout: where characters are in their lines.
#include "interface/private/TextLayout.h"

#include <algorithm>
#include <limits>

#include "interface/private/TextWalker.h"
#include "interface/private/VisualLine.h"
#include "server/paint/TextOrder.h"

namespace BPrivate {


bool
TextLayout::RunsBothWays(int32 line) const
{
	if (fHidden)
		return false;
	const int32 end = VisibleEnd(line);
	for (int32 at = LineStart(line); at < end;) {
		// Nothing from the right is below U+0590 in UTF-8.
		if (static_cast<uchar>(fModel.Buffer().ByteAt(at)) < 0xd6) {
			at++;
			continue;
		}
		if (RunsFromTheRight(fModel.CharacterAt(at)))
			return true;
		at = fModel.NextCharacter(at);
	}
	return false;
}


bool
TextLayout::StartsAtRight(int32 line) const
{
	return RunsBothWays(line) && _Visual(line).StartsAtRight();
}


float
TextLayout::XAt(int32 line, TextPlace place) const
{
	if (RunsBothWays(line))
		return _Visual(line).XAt(place);
	return _WidthUpTo(line, place.offset);
}


TextPlace
TextLayout::PlaceAtX(int32 line, float x) const
{
	const bool isWrapped = VisibleEnd(line) == LineEnd(line) && line + 1 < CountLines();
	if (RunsBothWays(line)) {
		const VisualLine visual = _Visual(line);
		const TextPlace place = visual.PlaceAtX(x);
		// Behind the last character of a wrapped line is the start of the next.
		if (isWrapped && place.offset >= LineEnd(line))
			return { PreviousPlace(place.offset), false };
		return place;
	}

	const int32 end = isWrapped ? PreviousPlace(VisibleEnd(line)) : VisibleEnd(line);
	Walker walker(*this, LineStart(line));
	int32 offset = walker.Offset();
	float left = 0;
	while (walker.Offset() < end) {
		const int32 next = std::min(NextPlace(walker.Offset()), end);
		float right = left;
		while (walker.Offset() < next)
			right += walker.Step(right);
		if (x < (left + right) / 2)
			break;
		offset = next;
		left = right;
	}
	return { offset, false };
}


TextPlace
TextLayout::PlaceBeside(TextPlace place, bool toRight) const
{
	const int32 line = LineAtOffset(place.offset);
	if (!RunsBothWays(line))
		return { toRight ? NextPlace(place.offset) : PreviousPlace(place.offset), false };

	const VisualLine visual = _Visual(line);
	TextPlace beside;
	if (visual.GetBeside(place, toRight, &beside))
		return beside;
	const bool forward = toRight != visual.StartsAtRight();
	if (forward)
		return line + 1 < CountLines() ? TextPlace { LineEnd(line), false } : place;
	return line > 0 ? TextPlace { PreviousPlace(LineStart(line)), false } : place;
}


void
TextLayout::GetSpans(int32 line, int32 from, int32 to, std::vector<Span>& spans) const
{
	spans.clear();
	const bool goesOn = to > VisibleEnd(line) || (to == LineEnd(line) && line + 1 < CountLines());
	from = std::max(from, LineStart(line));
	to = std::min(to, VisibleEnd(line));
	if (RunsBothWays(line)) {
		const VisualLine visual = _Visual(line);
		visual.GetSpans(from, to, spans);
		if (goesOn)
			spans.push_back({ visual.Width(), visual.Width() });
	} else
		spans.push_back({ _WidthUpTo(line, from), _WidthUpTo(line, to) });
	if (goesOn)
		spans.back().right = std::numeric_limits<float>::infinity();
}


void
TextLayout::GetPieces(int32 line, std::vector<Piece>& pieces) const
{
	pieces.clear();
	if (RunsBothWays(line)) {
		const VisualLine visual = _Visual(line);
		pieces = visual.Pieces();
		fLines[line].width = visual.Width();
		return;
	}
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
			pieces.push_back({ offset, walker.Offset(), &fModel.Runs()[run].style, x, width,
				PieceOrder::OfItself });
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


const char*
TextLayout::OrderMark(PieceOrder order)
{
	if (order == PieceOrder::OfItself)
		return "";
	return order == PieceOrder::AllFromTheLeft ? "\u202d" : "\u202e";
}


VisualLine
TextLayout::_Visual(int32 line) const
{
	// The paragraph decides where its lines start.
	int32 first = line;
	while (first > 0 && fModel.Buffer().ByteAt(LineStart(first) - 1) != '\n')
		first--;
	bool startsAtRight = false;
	const int32 end = VisibleEnd(line);
	for (int32 at = LineStart(first); at < end; at = fModel.NextCharacter(at)) {
		const BPrivate::LineStart side = SideOf(fModel.CharacterAt(at));
		if (side != BPrivate::LineStart::OfItself) {
			startsAtRight = side == BPrivate::LineStart::Right;
			break;
		}
	}
	return VisualLine(*this, fModel, line, startsAtRight);
}


float
TextLayout::_WidthUpTo(int32 line, int32 offset) const
{
	const int32 end = std::min(offset, VisibleEnd(line));
	Walker walker(*this, LineStart(line));
	float x = 0;
	while (walker.Offset() < end)
		x += walker.Step(x);
	return x;
}


float
TextLayout::_Measure(int32 line) const
{
	return RunsBothWays(line) ? _Visual(line).Width() : _WidthUpTo(line, VisibleEnd(line));
}


} // namespace BPrivate
