// VisualLine: a line whose letters run both ways, as it is seen.
#pragma once

#include <vector>

#include "interface/private/TextLayout.h"

namespace BPrivate {


// A copy of what the text says now; made when it is asked for.
class VisualLine {
public:
	VisualLine(const TextLayout& layout, TextModel& model, int32 line, bool startsAtRight);

	bool StartsAtRight() const { return fStartsAtRight; }
	float Width() const { return fWidth; }
	// From left to right.
	const std::vector<TextLayout::Piece>& Pieces() const { return fPieces; }

	float XAt(TextPlace place) const;
	TextPlace PlaceAtX(float x) const;
	// False at the side of the line.
	bool GetBeside(TextPlace place, bool toRight, TextPlace* _beside) const;
	void GetSpans(int32 from, int32 to, std::vector<TextLayout::Span>& spans) const;

private:
	// A character with its marks, or a tab.
	struct Cell {
		int32 start, end;
		float left, right;
		bool fromRight;
	};

	void _AddPart(int32 from, int32 to);
	void _AddPiece(size_t first, size_t end);
	void _AddTab(int32 offset);
	bool _GoesOn(const Cell& last, const Cell& next) const;
	// Between how many cells: 0 is left of all.
	size_t _GapOf(TextPlace place) const;

	const TextLayout& fLayout; // borrowed while this lives
	TextModel& fModel; // borrowed while this lives
	std::vector<Cell> fCells; // from left to right
	std::vector<TextLayout::Piece> fPieces;
	float fWidth = 0;
	int32 fEnd; // without the line break
	bool fStartsAtRight;
};


} // namespace BPrivate
