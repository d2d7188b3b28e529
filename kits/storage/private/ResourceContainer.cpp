#include "storage/private/ResourceContainer.h"

#include <string.h>

#include <algorithm>

#include <DataIO.h>

#include "storage/private/ResourceFormat.h"

namespace BPrivate {

namespace {

constexpr size_t kPefHeaderSize = 40;
constexpr size_t kPefSectionSize = 28;
constexpr uint32 kElfLargestAlignment = 10 * 1024 * 1024;
constexpr uint32 kElfSmallestAlignment = 32;
constexpr uint32 kElf64Alignment = 8;


// Reads numbers of one byte order out of a part of the file.
class Numbers {
public:
	Numbers(BPositionIO& file, off_t fileSize, bool bigEndian) :
		fFile(file), fFileSize(fileSize), fBigEndian(bigEndian)
	{
	}

	bool Load(uint64 offset, size_t size)
	{
		if (!Fits(offset, size))
			return false;
		fBytes.resize(size);
		return fFile.ReadAt(offset, fBytes.data(), size) == static_cast<ssize_t>(size);
	}

	bool Fits(uint64 offset, uint64 size) const
	{
		const uint64 limit = fFileSize;
		return offset <= limit && size <= limit - offset;
	}

	uint64 Get(size_t offset, size_t size) const
	{
		uint64 number = 0;
		for (size_t i = 0; i < size; i++)
			number = number << 8 | fBytes[offset + (fBigEndian ? i : size - 1 - i)];
		return number;
	}

private:
	BPositionIO& fFile;
	off_t fFileSize;
	bool fBigEndian;
	std::vector<uint8> fBytes;
};


status_t
FindInPef(
	BPositionIO& file, off_t fileSize, resource_file_info* _info, ResourceDamageReport& report)
{
	Numbers numbers(file, fileSize, true);
	_info->big_endian = true;
	if (!numbers.Load(0, kPefHeaderSize))
		return report.Refuse(0, "the PEF header is cut off", B_ERROR);
	if (numbers.Get(8, 4) != 'pwpc')
		return report.Refuse(8, "the PEF file is not for a PowerPC", B_IO_ERROR);
	const uint64 count = numbers.Get(32, 2);
	if (!numbers.Load(kPefHeaderSize, count * kPefSectionSize))
		return report.Refuse(32, "the PEF section headers are cut off", B_ERROR);

	uint64 end = kPefHeaderSize + count * kPefSectionSize;
	for (uint64 i = 0; i < count; i++) {
		const size_t header = i * kPefSectionSize;
		end = std::max(end, numbers.Get(header + 20, 4) + numbers.Get(header + 16, 4));
	}
	_info->base = end;
	return B_OK;
}


// The places of one class's fields: 32 or 64 bits.
struct ElfLayout {
	size_t word; // bytes of an address or offset
	size_t headerSize, programOffset, sectionOffset, headerSizeField, programEntry;
	size_t programHeaderSize, segmentOffset, segmentSize, segmentAlign;
	size_t sectionHeaderSize, partOffset, partSize;
};

constexpr ElfLayout kElf32 = { 4, 52, 28, 32, 40, 42, 32, 4, 16, 28, 40, 16, 20 };
constexpr ElfLayout kElf64 = { 8, 64, 32, 40, 52, 54, 56, 8, 32, 48, 64, 24, 32 };


class ElfEnd {
public:
	ElfEnd(BPositionIO& file, off_t fileSize, bool bigEndian, const ElfLayout& layout,
		ResourceDamageReport& report) :
		fNumbers(file, fileSize, bigEndian),
		fLayout(layout), fReport(report)
	{
	}

	status_t Find(uint64* _end, uint64* _alignment)
	{
		if (!fNumbers.Load(0, fLayout.headerSize))
			return fReport.Refuse(0, "the ELF header is cut off", B_ERROR);
		const uint64 headerSize = fNumbers.Get(fLayout.headerSizeField, 2);
		if (headerSize < fLayout.headerSize || !fNumbers.Fits(0, headerSize))
			return fReport.Refuse(
				fLayout.headerSizeField, "the size of the ELF header is wrong", B_IO_ERROR);
		fEnd = headerSize;

		// All of the header's numbers, before the tables take its place in memory.
		const Table segments = _Table(fLayout.programOffset, fLayout.programEntry);
		const Table sections = _Table(fLayout.sectionOffset, fLayout.programEntry + 4);
		status_t status = _Walk(segments, fLayout.programHeaderSize, true);
		if (status == B_OK)
			status = _Walk(sections, fLayout.sectionHeaderSize, false);
		*_end = fEnd;
		*_alignment = fAlignment;
		return status;
	}

private:
	struct Table {
		uint64 offset, entrySize, count;
		size_t field; // where the header gives the offset
	};

	Table _Table(size_t offsetField, size_t entryField) const
	{
		return { fNumbers.Get(offsetField, fLayout.word), fNumbers.Get(entryField, 2),
			fNumbers.Get(entryField + 2, 2), offsetField };
	}

	status_t _Walk(const Table& table, size_t leastSize, bool segments)
	{
		if (table.offset == 0 || table.count == 0)
			return B_OK;
		if (table.entrySize < leastSize)
			return fReport.Refuse(table.field, "an ELF table's entries are too small", B_IO_ERROR);
		if (!fNumbers.Fits(table.offset, table.entrySize * table.count)
			|| !fNumbers.Load(table.offset, table.entrySize * table.count))
			return fReport.Refuse(
				table.field, "an ELF table passes the end of the file", B_IO_ERROR);
		fEnd = std::max(fEnd, table.offset + table.entrySize * table.count);

		for (uint64 i = 0; i < table.count; i++) {
			const size_t entry = i * table.entrySize;
			const bool counts = segments ? _CountSegment(entry) : _CountSection(entry);
			if (!counts)
				return fReport.Refuse(table.offset + entry,
					"a part of the ELF data passes the end of the file", B_IO_ERROR);
		}
		return B_OK;
	}

	bool _CountSegment(size_t entry)
	{
		constexpr uint32 kNullSegment = 0;
		if (fNumbers.Get(entry, 4) == kNullSegment)
			return true;
		fAlignment = std::max(fAlignment, fNumbers.Get(entry + fLayout.segmentAlign, fLayout.word));
		return _CountPart(entry + fLayout.segmentOffset, entry + fLayout.segmentSize);
	}

	bool _CountSection(size_t entry)
	{
		constexpr uint32 kNullSection = 0;
		constexpr uint32 kNoBits = 8;
		const uint64 type = fNumbers.Get(entry + 4, 4);
		return type == kNullSection || type == kNoBits
			|| _CountPart(entry + fLayout.partOffset, entry + fLayout.partSize);
	}

	bool _CountPart(size_t offsetField, size_t sizeField)
	{
		const uint64 offset = fNumbers.Get(offsetField, fLayout.word);
		const uint64 size = fNumbers.Get(sizeField, fLayout.word);
		if (!fNumbers.Fits(offset, size))
			return false;
		fEnd = std::max(fEnd, offset + size);
		return true;
	}

	Numbers fNumbers;
	const ElfLayout& fLayout;
	ResourceDamageReport& fReport;
	uint64 fEnd = 0;
	uint64 fAlignment = kElfSmallestAlignment;
};


status_t
FindInElf(BPositionIO& file, off_t fileSize, const uint8* identity, resource_file_info* _info,
	ResourceDamageReport& report)
{
	const uint8 elfClass = identity[4];
	const uint8 encoding = identity[5];
	if (elfClass != 1 && elfClass != 2)
		return report.Refuse(4, "the ELF class is unknown", B_UNSUPPORTED);
	if (encoding != 1 && encoding != 2)
		return report.Refuse(5, "the ELF data encoding is unknown", B_UNSUPPORTED);
	if (identity[6] != 1)
		return report.Refuse(6, "the ELF version is unknown", B_UNSUPPORTED);

	_info->big_endian = encoding == 2;
	uint64 end = 0;
	uint64 alignment = 0;
	const bool wide = elfClass == 2;
	ElfEnd finder(file, fileSize, _info->big_endian, wide ? kElf64 : kElf32, report);
	const status_t status = finder.Find(&end, &alignment);
	if (status != B_OK)
		return status;
	if (wide)
		alignment = kElf64Alignment;
	else if (alignment > kElfLargestAlignment)
		return report.Refuse(kElf32.programOffset, "the ELF alignment is too large", B_IO_ERROR);
	_info->base = (end + alignment - 1) / alignment * alignment;
	return B_OK;
}

} // namespace


status_t
ResourceDamageReport::Refuse(off_t offset, const char* reason, status_t status)
{
	damages.push_back({ offset, reason, true });
	return status;
}


status_t
FindResourceSection(
	BPositionIO& file, off_t fileSize, resource_file_info* _info, ResourceDamageReport& report)
{
	*_info = { B_EMPTY_FILE, false, false, kX86HeaderSize };
	if (fileSize == 0)
		return B_OK;

	_info->kind = B_NO_RESOURCE_FILE;
	uint8 start[16] = {};
	const ssize_t read = file.ReadAt(0, start, std::min<off_t>(fileSize, sizeof(start)));
	if (read < 0)
		return report.Refuse(0, "the file cannot be read", read);
	if (read < 4)
		return report.Refuse(0, "the file is too short for a resource file", B_IO_ERROR);

	status_t status = B_OK;
	if (start[0] == 'R' && start[1] == 'S') {
		_info->kind = B_X86_RESOURCE_FILE;
	} else if (memcmp(start, "Joy!resf", 8) == 0) {
		_info->kind = B_PPC_RESOURCE_FILE;
		_info->big_endian = true;
		_info->base = kPpcHeaderSize;
	} else if (memcmp(start, "Joy!peff", 8) == 0) {
		_info->kind = B_PEF_FILE;
		status = FindInPef(file, fileSize, _info, report);
	} else if (memcmp(start,
				   "\x7f"
				   "ELF",
				   4)
		== 0) {
		_info->kind = B_ELF_FILE;
		status = FindInElf(file, fileSize, start, _info, report);
	} else
		return report.Refuse(0, "this is not a kind of file that holds resources", B_IO_ERROR);

	const bool executable = _info->kind == B_PEF_FILE || _info->kind == B_ELF_FILE;
	if (status != B_OK)
		_info->base = 0; // nobody knows where the executable ends
	_info->has_section = status == B_OK && (!executable || _info->base < fileSize);
	return status;
}

} // namespace BPrivate
