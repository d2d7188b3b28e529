// TextModel: the bytes of a text, cheap to change in the middle, and the looks of their parts.
#pragma once

#include <string>
#include <vector>

#include <Font.h>
#include <GraphicsDefs.h>

struct text_run_array;

namespace BPrivate {


struct TextStyle {
	BFont font;
	rgb_color color;

	bool operator==(const TextStyle& other) const;
};


// From here to the next run, or to the end.
struct TextRun {
	int32 offset; // bytes
	TextStyle style;
};

typedef std::vector<TextRun> TextRuns;


// Bytes with a gap where the last change was, so that a change costs the distance to it.
class TextBuffer {
public:
	int32 Length() const { return fLength; }
	char ByteAt(int32 offset) const
	{
		return fBytes[offset < fGapStart ? offset : offset + fGapSize];
	}
	void Copy(int32 offset, int32 length, char* to) const;
	std::string String(int32 offset, int32 length) const;
	void Replace(int32 offset, int32 removed, const char* bytes, int32 length);

	// The part in one piece; moves the gap out of its way.
	const char* Contiguous(int32 offset, int32 length);
	// Everything, with a final zero; valid until the next change.
	const char* Text();
	// The place of the byte at or after `from`, or -1.
	int32 Find(char byte, int32 from) const;

private:
	void _MoveGap(int32 offset);
	void _Reserve(int32 length);

	std::vector<char> fBytes;
	int32 fLength = 0;
	int32 fGapStart = 0;
	int32 fGapSize = 0;
};


// Run offsets grow strictly; the first is 0. There is always one run, also for an empty text.
class TextModel {
public:
	explicit TextModel(const TextStyle& style);

	TextBuffer& Buffer() { return fBuffer; }
	const TextBuffer& Buffer() const { return fBuffer; }
	int32 Length() const { return fBuffer.Length(); }

	// New text takes the look of the byte before it, or `runs` (offsets from its start).
	void Insert(int32 offset, const char* text, int32 length, const TextRuns* runs);
	void Remove(int32 from, int32 to);

	const TextRuns& Runs() const { return fRuns; }
	int32 RunIndexAt(int32 offset) const;
	const TextStyle& StyleAt(int32 offset) const { return fRuns[RunIndexAt(offset)].style; }
	// The look that text typed there takes.
	const TextStyle& StyleForInsertion(int32 offset) const;
	int32 RunEnd(int32 index) const;
	// Offsets from `from`.
	TextRuns CopyRuns(int32 from, int32 to) const;
	void SetRuns(int32 from, int32 to, const TextRuns& runs);
	void SetStyle(const TextStyle& style);
	// A look for what is typed next at the offset, where there is no text to carry it.
	void SetPendingStyle(int32 offset, const TextStyle& style);
	void ForgetPendingStyle() { fPendingOffset = -1; }

	// Steps by whole characters; stray continuation bytes count as one each.
	int32 NextCharacter(int32 offset) const;
	int32 PreviousCharacter(int32 offset) const;
	// The start of the character that the offset lies in.
	int32 CharacterStart(int32 offset) const;
	uint32 CharacterAt(int32 offset) const;

private:
	void _MergeRuns(int32 first, int32 last);

	TextBuffer fBuffer;
	TextRuns fRuns;
	int32 fPendingOffset = -1;
	TextStyle fPendingStyle;
};


// How many bytes the character at `text` has, at most `length`, at least 1 while length is.
int32 character_length(const char* text, int32 length);
// Decodes it; what is not UTF-8 comes out as 0xfffd.
uint32 decode_character(const char* text, int32 length);
// Writes at most four bytes and returns how many.
int32 encode_character(uint32 character, char* bytes);

TextRuns runs_from_array(const text_run_array* array, int32 length, const TextStyle& fallback);


} // namespace BPrivate
