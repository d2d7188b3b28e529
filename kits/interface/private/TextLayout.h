// TextLayout: where the lines of a text begin and how high they are.
#pragma once

#include <vector>

#include "interface/private/TextModel.h"

class BTextView;

namespace BPrivate {

class GlyphWidths;
class VisualLine;


// A place for a caret. Where letters run both ways, the end of one and the start of the next may
// be far apart: the place is then at the one or at the other.
struct TextPlace {
	int32 offset;
	bool behind; // at the end of the character before the offset

	TextPlace(int32 offset = 0, bool behind = false) : offset(offset), behind(behind) {}
};


// A line is what is shown as one: up to a line break of the text, or to the place where it was
// wrapped. x coordinates start at the line's left end, y coordinates at the top of the text. A
// change costs the lines that it touches; the places behind it are moved by a common step.
class TextLayout {
public:
	// What a change did to the lines: `oldCount` lines from `first` on became `newCount`.
	struct Difference {
		int32 first, oldCount, newCount;
		float heightDelta;
	};

	TextLayout(BTextView& view, TextModel& model);

	// Need LayOut() afterwards.
	void SetWrapWidth(float width) { fWrapWidth = width; } // negative: no wrapping
	void SetTabWidth(float width) { fTabWidth = width; }
	float TabWidth() const { return fTabWidth; }
	void SetHidden(bool hidden) { fHidden = hidden; } // every character is shown as a bullet

	float WrapWidth() const { return fWrapWidth; }
	bool IsHidden() const { return fHidden; }

	void LayOut();
	// After `removed` bytes at the offset were replaced by `inserted`.
	Difference Change(int32 offset, int32 removed, int32 inserted);

	int32 CountLines() const { return static_cast<int32>(fLines.size()) - 1; }
	// Both also for CountLines(), where the text ends.
	int32 LineStart(int32 line) const;
	float Top(int32 line) const;
	int32 LineEnd(int32 line) const { return LineStart(line + 1); }
	// Without the line break.
	int32 VisibleEnd(int32 line) const;
	float Height(int32 line) const { return Top(line + 1) - Top(line); }
	float TotalHeight() const { return Top(CountLines()); }
	float Ascent(int32 line) const { return fLines[line].ascent; }
	// Measured when first asked for.
	float Width(int32 line) const;
	// Of the widest line; of a long text only of the lines measured so far.
	float KnownWidth() const;

	int32 LineAtOffset(int32 offset) const;
	int32 LineAtY(float y) const;
	// Whether some of its letters run from the right.
	bool RunsBothWays(int32 line) const;
	bool StartsAtRight(int32 line) const;
	float XAt(int32 line, TextPlace place) const;
	// The nearest one.
	TextPlace PlaceAtX(int32 line, float x) const;
	// One character further to that side, as it is seen.
	TextPlace PlaceBeside(TextPlace place, bool toRight) const;

	// What a part of a line covers, from left to right. Its line break reaches to infinity.
	struct Span {
		float left, right;
	};
	void GetSpans(int32 line, int32 from, int32 to, std::vector<Span>& spans) const;

	// A part of a line in one look, without tabs, at `x`. Its letters run as drawing finds them to
	// run, or all to one side, whatever they are.
	enum class PieceOrder : uint8 { OfItself, AllFromTheLeft, AllFromTheRight };
	struct Piece {
		int32 start, end;
		const TextStyle* style;
		float x, width;
		PieceOrder order;
	};
	void GetPieces(int32 line, std::vector<Piece>& pieces) const;
	// What makes drawing take that order, when the text follows it. UTF-8.
	static const char* OrderMark(PieceOrder order);

	// How many lines the program has laid out so far; for tests of growth.
	static int64 CountLaidOut();

	// Steps over a character with its marks.
	int32 NextPlace(int32 offset) const;
	int32 PreviousPlace(int32 offset) const;

private:
	struct Line {
		int32 offset;
		float top;
		float ascent;
		mutable float width; // negative: not measured yet
	};
	class Walker;

	VisualLine _Visual(int32 line) const;
	float _WidthUpTo(int32 line, int32 offset) const;
	float _Measure(int32 line) const;
	void _MoveStep(int32 line);
	int32 _FindEnd(int32 start, float* _width);
	Line _MakeLine(int32 start, int32 end, float width, float* _height) const;

	BTextView& fView;
	TextModel& fModel;
	std::vector<Line> fLines; // the last marks the end of the text
	int32 fStepLine = 0; // lines from here on are further by the two below
	int32 fStepOffset = 0;
	float fStepTop = 0;
	float fWrapWidth = -1;
	float fTabWidth = 28;
	bool fHidden = false;
};


} // namespace BPrivate
