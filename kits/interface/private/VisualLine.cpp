#include "interface/private/VisualLine.h"

#include <algorithm>
#include <cmath>
#include <string>

#include "interface/private/GlyphWidths.h"
#include "server/paint/TextOrder.h"

namespace BPrivate {


// Tabs part a line; the parts follow each other from the left.
VisualLine::VisualLine(const TextLayout& layout, TextModel& model, int32 line, bool startsAtRight) :
	fLayout(layout), fModel(model), fEnd(layout.VisibleEnd(line)), fStartsAtRight(startsAtRight)
{
	int32 from = layout.LineStart(line);
	for (int32 at = from; at < fEnd; at++) {
		if (model.Buffer().ByteAt(at) != '\t')
			continue;
		_AddPart(from, at);
		_AddTab(at);
		from = at + 1;
	}
	_AddPart(from, fEnd);
}


float
VisualLine::XAt(TextPlace place) const
{
	const size_t gap = _GapOf(place);
	return gap < fCells.size() ? fCells[gap].left : fWidth;
}


TextPlace
VisualLine::PlaceAtX(float x) const
{
	if (fCells.empty())
		return {};
	const auto after = std::find_if(
		fCells.begin(), std::prev(fCells.end()), [x](const Cell& cell) { return x < cell.right; });
	const bool isLeftHalf = x < (after->left + after->right) / 2;
	if (isLeftHalf == after->fromRight)
		return { after->end, true };
	return { after->start, false };
}


// Every step crosses one cell and stays at it.
bool
VisualLine::GetBeside(TextPlace place, bool toRight, TextPlace* _beside) const
{
	const size_t gap = _GapOf(place);
	if (toRight ? gap >= fCells.size() : gap == 0)
		return false;
	const Cell& crossed = fCells[toRight ? gap : gap - 1];
	if (toRight == crossed.fromRight)
		*_beside = { crossed.start, false };
	else
		*_beside = { crossed.end, true };
	return true;
}


void
VisualLine::GetSpans(int32 from, int32 to, std::vector<TextLayout::Span>& spans) const
{
	bool goesOn = false;
	for (const Cell& cell : fCells) {
		const bool isIn = cell.start >= from && cell.start < to;
		if (isIn && goesOn)
			spans.back().right = cell.right;
		else if (isIn)
			spans.push_back({ cell.left, cell.right });
		goesOn = isIn;
	}
}


// The cells in the order in which they are seen, then what can be drawn at once.
void
VisualLine::_AddPart(int32 from, int32 to)
{
	std::vector<uint32> characters;
	std::vector<Cell> cells; // that start at each character; without an end within one
	int32 end = from;
	for (int32 at = from; at < to; at = fModel.NextCharacter(at)) {
		const bool starts = at >= end;
		if (starts)
			end = std::min(fLayout.NextPlace(at), to);
		characters.push_back(fModel.CharacterAt(at));
		cells.push_back({ at, starts ? end : at, 0, 0, false });
	}

	size_t first = fCells.size();
	const LineStart side = fStartsAtRight ? LineStart::Right : LineStart::Left;
	const auto hasNoForms = [](uint32) { return false; };
	for (const OrderedCharacter& ordered : InDrawingOrder(characters, hasNoForms, side)) {
		Cell& cell = cells[ordered.index];
		cell.fromRight = ordered.fromRight;
		if (cell.end > cell.start)
			fCells.push_back(cell);
	}
	while (first < fCells.size()) {
		size_t next = first + 1;
		while (next < fCells.size() && _GoesOn(fCells[next - 1], fCells[next]))
			next++;
		_AddPiece(first, next);
		first = next;
	}
}


// Whether two cells beside each other are so in the text, too, and look alike.
bool
VisualLine::_GoesOn(const Cell& last, const Cell& next) const
{
	if (last.fromRight != next.fromRight)
		return false;
	return (last.fromRight ? next.end == last.start : last.end == next.start)
		&& fModel.RunIndexAt(last.start) == fModel.RunIndexAt(next.start);
}


void
VisualLine::_AddPiece(size_t first, size_t end)
{
	const bool fromRight = fCells[first].fromRight;
	const int32 from = fCells[fromRight ? end - 1 : first].start;
	const int32 to = fCells[fromRight ? first : end - 1].end;
	const TextStyle& style = fModel.StyleAt(from);
	const auto order = fromRight ? TextLayout::PieceOrder::AllFromTheRight
								 : TextLayout::PieceOrder::AllFromTheLeft;
	const std::string text = TextLayout::OrderMark(order) + fModel.Buffer().String(from, to - from);
	const std::vector<float> advances =
		GlyphWidths::For(style.font).Advances(text.data(), static_cast<int32>(text.size()));
	const float left = fWidth;
	size_t index = 1; // behind the mark
	for (size_t i = first; i < end; i++) {
		Cell& cell = fCells[fromRight ? first + end - 1 - i : i];
		for (int32 at = cell.start; at < cell.end && index < advances.size();
			 at = fModel.NextCharacter(at))
			cell.right += advances[index++];
	}
	for (size_t i = first; i < end; i++) {
		fCells[i].left = fWidth;
		fWidth += fCells[i].right;
		fCells[i].right = fWidth;
	}
	fPieces.push_back({ from, to, &style, left, fWidth - left, order });
}


void
VisualLine::_AddTab(int32 offset)
{
	const float step = fLayout.TabWidth();
	const float left = fWidth;
	if (step > 0)
		fWidth = (std::floor(fWidth / step) + 1) * step;
	fCells.push_back({ offset, offset + 1, left, fWidth, false });
}


size_t
VisualLine::_GapOf(TextPlace place) const
{
	const int32 offset = std::min(place.offset, fEnd);
	const auto behind = std::find_if(
		fCells.begin(), fCells.end(), [&](const Cell& cell) { return cell.end == offset; });
	const auto before = std::find_if(fCells.begin(), fCells.end(),
		[&](const Cell& cell) { return cell.start <= offset && offset < cell.end; });
	if (behind != fCells.end() && (place.behind || before == fCells.end()))
		return behind - fCells.begin() + (behind->fromRight ? 0 : 1);
	return before - fCells.begin() + (before != fCells.end() && before->fromRight ? 1 : 0);
}


} // namespace BPrivate
