// The layout of the resource section: numbers that reader and writer share.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

// Section offsets and sizes in bytes; offsets count from the start of the section.
constexpr uint32 kResourceMagic = 0x444f1000;
constexpr uint32 kResourceHeaderSize = 0x44;
constexpr uint32 kHeaderPaddingOffset = 0x10;
constexpr uint32 kHeaderPaddingSize = 0x34;
constexpr uint32 kIndexOffset = kResourceHeaderSize;
constexpr uint32 kIndexHeaderSize = 0x84;
constexpr uint32 kIndexEntriesOffset = kIndexOffset + kIndexHeaderSize;
constexpr uint32 kIndexEntrySize = 12;
constexpr uint32 kIndexGranularity = 0x600;
constexpr uint32 kUnknownSize = 0x168;
constexpr uint32 kInfoSize = 10; // without the name
constexpr uint32 kBlockEnd = 0xffffffff;
constexpr uint32 kTableEndSize = 8; // checksum and a zero word
constexpr uint32 kX86HeaderSize = 4;
constexpr uint32 kPpcHeaderSize = 40;
constexpr uint32 kMostResources = 10000;

// The section was prefilled with three words over and over, in its own byte order.
constexpr uint32
FillerWord(uint32 sectionOffset)
{
	constexpr uint32 kWords[] = { 0xffffffff, 0x000003e9, 0x00000000 };
	return kWords[sectionOffset / 4 % 3];
}


constexpr uint32
IndexSectionSize(uint32 count)
{
	const uint32 size = kIndexHeaderSize + kIndexEntrySize * count;
	return (size + kIndexGranularity - 1) / kIndexGranularity * kIndexGranularity;
}


// Of the info table's bytes before the checksum.
uint32 InfoChecksum(const uint8* bytes, size_t size);

// Turns numbers of the resource's type around, as a message of that type would; others stay.
// Returns whether there was anything to do for such a type.
bool SwapResource(type_code type, void* data, size_t size);
bool IsSwapped(type_code type);

} // namespace BPrivate
