// TextWalker: goes through the text character by character and says how wide each is.
#pragma once

#include <algorithm>
#include <cmath>

#include "interface/private/GlyphWidths.h"
#include "interface/private/TextLayout.h"

namespace BPrivate {


// In the text's order, whichever way the letters run.
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
	static constexpr uint32 kBullet = 0x2022;
	static constexpr int32 kLongestChunk = 96; // bytes of joining letters measured together

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

	// Letters that join are measured together with their group.
	float _StepInChunk()
	{
		if (fOffset >= fChunkEnd) {
			fChunkStart = fChunkEnd = fOffset;
			while (fChunkEnd < fRunEnd && fChunkEnd - fChunkStart < kLongestChunk
				&& !is_simple_character(fModel.CharacterAt(fChunkEnd)))
				fChunkEnd = fModel.NextCharacter(fChunkEnd);
			fChunkEnd = std::min(fChunkEnd, fRunEnd);
			const int32 length = fChunkEnd - fChunkStart;
			fAdvances = fWidths->Advances(fModel.Buffer().Contiguous(fChunkStart, length), length);
			fNext = 0;
		}
		fCharacter = fModel.CharacterAt(fOffset);
		fOffset = std::min(fModel.NextCharacter(fOffset), fChunkEnd);
		return fNext < fAdvances.size() ? fAdvances[fNext++] : 0;
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
	std::vector<float> fAdvances; // of the characters of the group
	size_t fNext = 0;
};


} // namespace BPrivate
