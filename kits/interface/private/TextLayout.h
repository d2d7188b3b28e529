// TextLayout: where the lines of a text begin and how high they are.
#pragma once

#include <vector>

#include "interface/private/TextModel.h"

class BTextView;

namespace BPrivate {

class GlyphWidths;


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
	float XAt(int32 line, int32 offset) const;
	// The offset whose place is nearest.
	int32 OffsetAtX(int32 line, float x) const;

	// A part of a line in one look and without tabs, at `x`.
	struct Piece {
		int32 start, end;
		const TextStyle* style;
		float x, width;
	};
	void GetPieces(int32 line, std::vector<Piece>& pieces) const;

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
