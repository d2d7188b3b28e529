// BFont: texts that are cut to a width.
#include <Font.h>

#include <algorithm>
#include <numeric>
#include <string.h>
#include <string>
#include <string_view>
#include <vector>

#include <String.h>

#include "interface/private/FontAccess.h"
#include "server/paint/FontEngine.h"

using namespace BPrivate;

namespace {

// A text and where its characters begin and how far they reach.
class TextCutter {
public:
	TextCutter(const BFont& font, std::string_view text);

	std::string Cut(uint32 mode, float width) const;

private:
	size_t _CountFromStart(float width) const;
	size_t _CountFromEnd(float width) const;

	std::string_view fText;
	std::vector<size_t> fStarts; // and the text's length
	std::vector<float> fEnds; // of the first n characters together, n from 0
	float fEllipsis;
};


TextCutter::TextCutter(const BFont& font, std::string_view text) :
	fText(text), fEllipsis(font.StringWidth(B_UTF8_ELLIPSIS))
{
	for (size_t at = 0; at < text.size(); NextCharacter(text, &at))
		fStarts.push_back(at);
	fStarts.push_back(text.size());

	const auto run = FontEngine::Get().Run(ToFontSpec(font), text);
	fEnds.resize(fStarts.size());
	for (const PlacedGlyph& glyph : run->glyphs)
		fEnds[glyph.index + 1] = glyph.advance;
	std::partial_sum(fEnds.begin(), fEnds.end(), fEnds.begin());
}


std::string
TextCutter::Cut(uint32 mode, float width) const
{
	if (mode == B_NO_TRUNCATION || fEnds.back() <= width)
		return std::string(fText);
	const float room = width - fEllipsis;
	if (room < 0)
		return std::string();

	size_t head = 0;
	size_t tail = 0;
	if (mode == B_TRUNCATE_END)
		head = _CountFromStart(room);
	else if (mode == B_TRUNCATE_BEGINNING)
		tail = _CountFromEnd(room);
	else {
		head = _CountFromStart(room / 2);
		tail = _CountFromEnd(room - fEnds[head]);
	}
	const size_t count = fStarts.size() - 1;
	return std::string(fText.substr(0, fStarts[head])) + B_UTF8_ELLIPSIS
		+ std::string(fText.substr(fStarts[count - tail]));
}


size_t
TextCutter::_CountFromStart(float width) const
{
	return std::upper_bound(fEnds.begin(), fEnds.end(), width) - fEnds.begin() - 1;
}


size_t
TextCutter::_CountFromEnd(float width) const
{
	return fEnds.end() - std::lower_bound(fEnds.begin(), fEnds.end(), fEnds.back() - width) - 1;
}

} // namespace


void
BFont::TruncateString(BString* inOut, uint32 mode, float width) const
{
	if (inOut == NULL)
		return;
	const std::string_view text(inOut->String(), inOut->Length());
	inOut->SetTo(TextCutter(*this, text).Cut(mode, width).c_str());
}


void
BFont::GetTruncatedStrings(const char* stringArray[], int32 numStrings, uint32 mode, float width,
	BString resultArray[]) const
{
	if (stringArray == NULL || resultArray == NULL)
		return;
	for (int32 i = 0; i < numStrings; i++) {
		resultArray[i].SetTo(stringArray[i]);
		TruncateString(&resultArray[i], mode, width);
	}
}


void
BFont::GetTruncatedStrings(const char* stringArray[], int32 numStrings, uint32 mode, float width,
	char* resultArray[]) const
{
	if (stringArray == NULL || resultArray == NULL)
		return;
	for (int32 i = 0; i < numStrings; i++)
		strcpy(resultArray[i], TextCutter(*this, stringArray[i]).Cut(mode, width).c_str());
}
