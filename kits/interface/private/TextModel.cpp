#include "interface/private/TextModel.h"

#include <algorithm>
#include <cstring>

#include <TextView.h>

namespace BPrivate {

namespace {

constexpr int32 kMinimalGap = 32;
constexpr uint32 kReplacement = 0xfffd;


bool
is_continuation(char byte)
{
	return (byte & 0xc0) == 0x80;
}


// What the first byte announces; 1 for anything that starts no character.
int32
announced_length(uchar first)
{
	if (first >= 0xc2 && first <= 0xdf)
		return 2;
	if (first >= 0xe0 && first <= 0xef)
		return 3;
	if (first >= 0xf0 && first <= 0xf4)
		return 4;
	return 1;
}

} // namespace


int32
character_length(const char* text, int32 length)
{
	if (length <= 0)
		return 0;
	const int32 announced = announced_length(static_cast<uchar>(text[0]));
	if (announced > length)
		return 1;
	for (int32 i = 1; i < announced; i++) {
		if (!is_continuation(text[i]))
			return 1;
	}
	return announced;
}


uint32
decode_character(const char* text, int32 length)
{
	const int32 count = character_length(text, length);
	const auto byte = [text](int32 i) { return static_cast<uint32>(static_cast<uchar>(text[i])); };
	switch (count) {
		case 1:
			return byte(0) < 0x80 ? byte(0) : kReplacement;
		case 2:
			return (byte(0) & 0x1f) << 6 | (byte(1) & 0x3f);
		case 3:
			return (byte(0) & 0x0f) << 12 | (byte(1) & 0x3f) << 6 | (byte(2) & 0x3f);
		case 4:
			return (byte(0) & 0x07) << 18 | (byte(1) & 0x3f) << 12 | (byte(2) & 0x3f) << 6
				| (byte(3) & 0x3f);
		default:
			return 0;
	}
}


int32
encode_character(uint32 character, char* bytes)
{
	if (character < 0x80) {
		bytes[0] = static_cast<char>(character);
		return 1;
	}
	if (character < 0x800) {
		bytes[0] = static_cast<char>(0xc0 | character >> 6);
		bytes[1] = static_cast<char>(0x80 | (character & 0x3f));
		return 2;
	}
	if (character < 0x10000) {
		bytes[0] = static_cast<char>(0xe0 | character >> 12);
		bytes[1] = static_cast<char>(0x80 | (character >> 6 & 0x3f));
		bytes[2] = static_cast<char>(0x80 | (character & 0x3f));
		return 3;
	}
	bytes[0] = static_cast<char>(0xf0 | character >> 18);
	bytes[1] = static_cast<char>(0x80 | (character >> 12 & 0x3f));
	bytes[2] = static_cast<char>(0x80 | (character >> 6 & 0x3f));
	bytes[3] = static_cast<char>(0x80 | (character & 0x3f));
	return 4;
}


// Runs out of order, or beyond the text, are left out; a missing first one is filled in.
TextRuns
runs_from_array(const text_run_array* array, int32 length, const TextStyle& fallback)
{
	TextRuns runs;
	for (int32 i = 0; array != nullptr && i < array->count; i++) {
		const text_run& run = array->runs[i];
		if (run.offset < 0 || (run.offset >= length && run.offset > 0))
			continue;
		if (runs.empty() && run.offset > 0)
			runs.push_back({ 0, fallback });
		if (!runs.empty() && run.offset < runs.back().offset)
			continue;
		if (!runs.empty() && run.offset == runs.back().offset)
			runs.pop_back();
		runs.push_back({ run.offset, { run.font, run.color } });
	}
	if (runs.empty())
		runs.push_back({ 0, fallback });
	return runs;
}


bool
TextStyle::operator==(const TextStyle& other) const
{
	return font == other.font && color == other.color;
}


// #pragma mark - TextBuffer


void
TextBuffer::Copy(int32 offset, int32 length, char* to) const
{
	const int32 before = std::clamp<int32>(fGapStart - offset, 0, length);
	if (before > 0)
		memcpy(to, fBytes.data() + offset, before);
	if (length > before)
		memcpy(to + before, fBytes.data() + offset + before + fGapSize, length - before);
}


std::string
TextBuffer::String(int32 offset, int32 length) const
{
	std::string result(length, '\0');
	Copy(offset, length, result.data());
	return result;
}


void
TextBuffer::Replace(int32 offset, int32 removed, const char* bytes, int32 length)
{
	_MoveGap(offset);
	fGapSize += removed;
	fLength -= removed;
	_Reserve(length);
	if (length > 0)
		memcpy(fBytes.data() + fGapStart, bytes, length);
	fGapStart += length;
	fGapSize -= length;
	fLength += length;
}


const char*
TextBuffer::Contiguous(int32 offset, int32 length)
{
	if (offset < fGapStart && offset + length > fGapStart) {
		// Towards the nearer end of the part.
		if (fGapStart - offset < offset + length - fGapStart)
			_MoveGap(offset);
		else
			_MoveGap(offset + length);
	}
	if (fBytes.empty())
		return "";
	return fBytes.data() + (offset < fGapStart ? offset : offset + fGapSize);
}


const char*
TextBuffer::Text()
{
	_Reserve(1);
	_MoveGap(fLength);
	fBytes[fLength] = '\0';
	return fBytes.data();
}


int32
TextBuffer::Find(char byte, int32 from) const
{
	if (from < fGapStart) {
		const char* start = fBytes.data();
		const void* found = memchr(start + from, byte, fGapStart - from);
		if (found != nullptr)
			return static_cast<int32>(static_cast<const char*>(found) - start);
		from = fGapStart;
	}
	if (from >= fLength)
		return -1;
	const char* start = fBytes.data() + fGapSize;
	const void* found = memchr(start + from, byte, fLength - from);
	return found != nullptr ? static_cast<int32>(static_cast<const char*>(found) - start) : -1;
}


void
TextBuffer::_MoveGap(int32 offset)
{
	if (fGapSize > 0) {
		char* bytes = fBytes.data();
		if (offset < fGapStart)
			memmove(bytes + offset + fGapSize, bytes + offset, fGapStart - offset);
		else if (offset > fGapStart)
			memmove(bytes + fGapStart, bytes + fGapStart + fGapSize, offset - fGapStart);
	}
	fGapStart = offset;
}


// Makes the gap that large, growing by a share of the text so that typing seldom copies it.
void
TextBuffer::_Reserve(int32 length)
{
	if (fGapSize >= length)
		return;
	const int32 gap = length + kMinimalGap + fLength / 16;
	std::vector<char> bytes(fLength + gap);
	const auto behindGap = fBytes.begin() + fGapStart + fGapSize;
	std::copy(fBytes.begin(), fBytes.begin() + fGapStart, bytes.begin());
	std::copy(behindGap, behindGap + (fLength - fGapStart), bytes.begin() + fGapStart + gap);
	fBytes.swap(bytes);
	fGapSize = gap;
}


// #pragma mark - TextModel


TextModel::TextModel(const TextStyle& style) : fPendingStyle(style)
{
	fRuns.push_back({ 0, style });
}


void
TextModel::Insert(int32 offset, const char* text, int32 length, const TextRuns* runs)
{
	if (length <= 0)
		return;

	const bool wasEmpty = Length() == 0;
	TextRuns inserted;
	if (runs != nullptr && !runs->empty())
		inserted = *runs;
	else
		inserted.push_back({ 0, StyleForInsertion(offset) });
	const TextStyle after = StyleAt(offset);
	fPendingOffset = -1;

	fBuffer.Replace(offset, 0, text, length);
	if (wasEmpty) {
		fRuns = inserted;
		_MergeRuns(0, static_cast<int32>(fRuns.size()));
		return;
	}

	// The run at the offset goes on behind the new text, all later ones move.
	auto place = std::lower_bound(fRuns.begin(), fRuns.end(), offset,
		[](const TextRun& run, int32 value) { return run.offset < value; });
	const bool splits = place == fRuns.end() || place->offset != offset;
	for (auto run = place; run != fRuns.end(); ++run)
		run->offset += length;
	for (TextRun& run : inserted)
		run.offset += offset;
	if (splits && offset + length < Length())
		inserted.push_back({ offset + length, after });
	const int32 first = static_cast<int32>(place - fRuns.begin());
	fRuns.insert(place, inserted.begin(), inserted.end());
	_MergeRuns(first - 1, first + static_cast<int32>(inserted.size()) + 1);
}


void
TextModel::Remove(int32 from, int32 to)
{
	if (to <= from)
		return;
	fPendingOffset = -1;
	const TextStyle first = fRuns.front().style;
	const bool hasTail = to < Length();
	const TextStyle tail = hasTail ? StyleAt(to) : first;
	fBuffer.Replace(from, to - from, nullptr, 0);

	const auto before = [](const TextRun& run, int32 value) { return run.offset < value; };
	const auto begin = std::lower_bound(fRuns.begin(), fRuns.end(), from, before);
	const auto end = std::lower_bound(begin, fRuns.end(), to + 1, before);
	const int32 index = static_cast<int32>(begin - fRuns.begin());
	for (auto run = end; run != fRuns.end(); ++run)
		run->offset -= to - from;
	auto place = fRuns.erase(begin, end);
	if (hasTail)
		fRuns.insert(place, { from, tail });
	if (fRuns.empty())
		fRuns.push_back({ 0, first });
	_MergeRuns(index - 1, index + 2);
}


int32
TextModel::RunIndexAt(int32 offset) const
{
	const auto after = std::upper_bound(fRuns.begin(), fRuns.end(), offset,
		[](int32 value, const TextRun& run) { return value < run.offset; });
	return std::max<int32>(0, static_cast<int32>(after - fRuns.begin()) - 1);
}


const TextStyle&
TextModel::StyleForInsertion(int32 offset) const
{
	if (offset == fPendingOffset)
		return fPendingStyle;
	return StyleAt(offset > 0 ? offset - 1 : 0);
}


int32
TextModel::RunEnd(int32 index) const
{
	return index + 1 < static_cast<int32>(fRuns.size()) ? fRuns[index + 1].offset : Length();
}


TextRuns
TextModel::CopyRuns(int32 from, int32 to) const
{
	TextRuns result;
	for (int32 i = RunIndexAt(from); i < static_cast<int32>(fRuns.size()); i++) {
		if (fRuns[i].offset >= to && !result.empty())
			break;
		result.push_back({ std::max<int32>(0, fRuns[i].offset - from), fRuns[i].style });
	}
	return result;
}


void
TextModel::SetRuns(int32 from, int32 to, const TextRuns& runs)
{
	if (runs.empty())
		return;
	if (Length() == 0) {
		SetStyle(runs.front().style);
		return;
	}
	if (to <= from)
		return;

	TextRuns result;
	for (const TextRun& run : fRuns) {
		if (run.offset < from)
			result.push_back(run);
	}
	for (const TextRun& run : runs) {
		if (run.offset < to - from)
			result.push_back({ run.offset + from, run.style });
	}
	if (to < Length()) {
		result.push_back({ to, StyleAt(to) });
		for (const TextRun& run : fRuns) {
			if (run.offset > to)
				result.push_back(run);
		}
	}
	fRuns.swap(result);
	_MergeRuns(0, static_cast<int32>(fRuns.size()));
}


void
TextModel::SetStyle(const TextStyle& style)
{
	fPendingOffset = -1;
	fRuns.assign(1, { 0, style });
}


void
TextModel::SetPendingStyle(int32 offset, const TextStyle& style)
{
	if (Length() == 0) {
		SetStyle(style);
		return;
	}
	fPendingOffset = offset;
	fPendingStyle = style;
}


int32
TextModel::NextCharacter(int32 offset) const
{
	const int32 left = Length() - offset;
	if (left <= 0)
		return Length();
	char bytes[4];
	const int32 count = std::min<int32>(4, left);
	fBuffer.Copy(offset, count, bytes);
	return offset + character_length(bytes, count);
}


int32
TextModel::PreviousCharacter(int32 offset) const
{
	if (offset <= 0)
		return 0;
	for (int32 back = 1; back <= std::min<int32>(4, offset); back++) {
		if (!is_continuation(fBuffer.ByteAt(offset - back)))
			return NextCharacter(offset - back) == offset ? offset - back : offset - 1;
	}
	return offset - 1;
}


int32
TextModel::CharacterStart(int32 offset) const
{
	offset = std::clamp<int32>(offset, 0, Length());
	if (offset == Length() || !is_continuation(fBuffer.ByteAt(offset)))
		return offset;
	for (int32 back = 1; back <= std::min<int32>(3, offset); back++) {
		if (!is_continuation(fBuffer.ByteAt(offset - back)))
			return NextCharacter(offset - back) > offset ? offset - back : offset;
	}
	return offset;
}


uint32
TextModel::CharacterAt(int32 offset) const
{
	const int32 left = Length() - offset;
	if (offset < 0 || left <= 0)
		return 0;
	char bytes[4];
	const int32 count = std::min<int32>(4, left);
	fBuffer.Copy(offset, count, bytes);
	return decode_character(bytes, count);
}


// Joins equal neighbours among the runs from `first` up to, not including, `last`.
void
TextModel::_MergeRuns(int32 first, int32 last)
{
	first = std::max<int32>(first, 0);
	last = std::min<int32>(last, static_cast<int32>(fRuns.size()));
	if (last - first < 2)
		return;
	const auto begin = fRuns.begin() + first;
	const auto end = fRuns.begin() + last;
	fRuns.erase(std::unique(begin, end,
					[](const TextRun& a, const TextRun& b) { return a.style == b.style; }),
		end);
}


} // namespace BPrivate
