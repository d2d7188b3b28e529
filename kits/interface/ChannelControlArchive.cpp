// BChannelControl: the fields of its archives.
#include <ChannelControl.h>

#include <algorithm>

#include <Message.h>

#include "interface/private/ControlArchive.h"
#include "interface/private/ViewArchive.h"

namespace {

// How many channels an archive is believed to have that says nothing about each of them.
constexpr int32 kBelievedChannels = 32;
constexpr int32 kDefaultMinimum = 0;
constexpr int32 kDefaultMaximum = 100;


int32
CountEntries(const BMessage& archive, const char* name)
{
	type_code type;
	int32 count;
	const bool found = archive.GetInfo(name, &type, &count) == B_OK && type == B_INT32_TYPE;
	return found ? count : 0;
}


// A number costs nothing to write, so it alone asks for no room.
int32
ReadCount(const BMessage& archive)
{
	int32 count;
	if (archive.FindInt32("be:_m_channel_count", &count) != B_OK)
		return 0;
	int32 entries = kBelievedChannels;
	for (const char* name : { "be:_m_channel_min", "be:_m_channel_max", "be:_m_channel_val" })
		entries = std::max(entries, CountEntries(archive, name));
	return std::clamp<int32>(count, 0, entries);
}


int32
ReadCurrent(const BMessage& archive, int32 count)
{
	int32 channel;
	const bool valid = archive.FindInt32("be:_m_value_channel", &channel) == B_OK && channel >= 0
		&& channel < count;
	return valid ? channel : 0;
}


int32
ReadNumber(const BMessage& archive, const char* name, int32 index, int32 absent)
{
	int32 number;
	return archive.FindInt32(name, index, &number) == B_OK ? number : absent;
}


// Whether the numbers of as many channels are those that were read.
bool
IsSame(const BMessage& archive, const char* name, const int32* numbers, int32 count, int32 absent)
{
	for (int32 i = 0; i < count; i++) {
		if (numbers[i] != ReadNumber(archive, name, i, absent))
			return false;
	}
	return true;
}

} // namespace


void
BChannelControl::_ReadArchive(BMessage* archive)
{
	_SetRoom(ReadCount(*archive));
	fCurrentChannel = ReadCurrent(*archive, fChannelCount);
	fMinLabel = BPrivate::read_text(archive, "be:_m_min_label");
	fMaxLabel = BPrivate::read_text(archive, "be:_m_max_label");

	int32 number;
	for (int32 i = 0; i < fChannelCount; i++) {
		if (archive->FindInt32("be:_m_channel_min", i, &number) == B_OK)
			fMinimums[i] = number;
		if (archive->FindInt32("be:_m_channel_max", i, &number) == B_OK)
			fMaximums[i] = number;
		if (archive->FindInt32("be:_m_channel_val", i, &number) == B_OK)
			fValues[i] = number;
	}
	fModificationMessage = BPrivate::read_message(archive, "_mod_msg");
}


// For the archive constructor of a class that has fewer channels at most. No change of what was read.
void
BChannelControl::_LimitRevived(int32 maximum)
{
	if (fChannelCount > maximum)
		_SetRoom(maximum);
	if (fCurrentChannel >= fChannelCount)
		fCurrentChannel = 0;
}


status_t
BChannelControl::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BControl::Archive(archive, deep);
	if (status != B_OK)
		return status;
	BPrivate::ArchiveWriter writer(archive);
	const BMessage& source = writer.Source();

	// More than the class's maximum was never taken.
	const int32 count = std::min(ReadCount(source), MaxChannelCount());
	const bool sameCount = count == fChannelCount;
	if (!writer.Keep("be:_m_channel_count", sameCount))
		archive->AddInt32("be:_m_channel_count", fChannelCount);
	if (!writer.Keep("be:_m_value_channel", ReadCurrent(source, count) == fCurrentChannel))
		archive->AddInt32("be:_m_value_channel", fCurrentChannel);
	if (!writer.Keep(
			"be:_m_min_label", BPrivate::read_text(&source, "be:_m_min_label") == fMinLabel))
		archive->AddString("be:_m_min_label", fMinLabel.c_str());
	if (!writer.Keep(
			"be:_m_max_label", BPrivate::read_text(&source, "be:_m_max_label") == fMaxLabel))
		archive->AddString("be:_m_max_label", fMaxLabel.c_str());

	const auto keep = [&](const char* name, const int32* numbers, int32 absent) {
		return writer.Keep(name, sameCount && IsSame(source, name, numbers, fChannelCount, absent));
	};
	const bool keptMinimums = keep("be:_m_channel_min", fMinimums.get(), kDefaultMinimum);
	const bool keptMaximums = keep("be:_m_channel_max", fMaximums.get(), kDefaultMaximum);
	const bool keptValues = keep("be:_m_channel_val", fValues.get(), kDefaultMinimum);
	for (int32 i = 0; i < fChannelCount; i++) {
		if (!keptMinimums)
			archive->AddInt32("be:_m_channel_min", fMinimums[i]);
		if (!keptMaximums)
			archive->AddInt32("be:_m_channel_max", fMaximums[i]);
		if (!keptValues)
			archive->AddInt32("be:_m_channel_val", fValues[i]);
	}
	BPrivate::write_message(writer, archive, "_mod_msg", fModificationMessage.get());
	return writer.Status();
}
