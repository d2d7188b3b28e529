#include "storage/private/ResourceReader.h"

#include <string.h>

#include <algorithm>

#include <DataIO.h>
#include <TypeConstants.h>

#include "storage/private/ResourceFormat.h"

namespace BPrivate {

namespace {

constexpr size_t kBlockSize = 64 * 1024;
// Items may lie anywhere, also in each other, but so many bytes are more than a file can mean.
constexpr off_t kMostOverlap = 2;

} // namespace


ResourceReader::ResourceReader(BPositionIO& file, bool tolerant) :
	fFile(file), fTolerant(tolerant), fFileSize(0), fStatus(B_OK), fInfo(), fCount(0),
	fIndexSize(0), fInfoOffset(0), fInfoTableSize(0), fLostInfos(false)
{
}


status_t
ResourceReader::Read()
{
	fStatus = fFile.GetSize(&fFileSize);
	if (fStatus != B_OK)
		return fStatus;
	fStatus = FindResourceSection(fFile, fFileSize, &fInfo, fReport);
	if (fStatus != B_OK && fTolerant)
		_FindMagic();
	if (fInfo.has_section)
		_ReadSection();
	std::erase(fItems, nullptr);
	return fStatus;
}


// #pragma mark - helpers


bool
ResourceReader::_Stop(bool wrong, off_t offset, const char* reason, status_t status)
{
	if (!wrong)
		return false;
	fReport.Refuse(offset, reason, status);
	if (fStatus == B_OK)
		fStatus = status;
	return !fTolerant;
}


bool
ResourceReader::_ReadAt(off_t offset, size_t size, std::string* _bytes)
{
	_bytes->clear();
	if (offset < 0 || offset > fFileSize)
		return false;
	const size_t there = std::min<off_t>(size, fFileSize - offset);
	_bytes->resize(there);
	const ssize_t read = fFile.ReadAt(offset, _bytes->data(), there);
	_bytes->resize(std::max<ssize_t>(read, 0));
	return _bytes->size() == size;
}


uint32
ResourceReader::_Word(const char* bytes) const
{
	const uint8* byte = reinterpret_cast<const uint8*>(bytes);
	if (fInfo.big_endian)
		return static_cast<uint32>(byte[0]) << 24 | byte[1] << 16 | byte[2] << 8 | byte[3];
	return static_cast<uint32>(byte[3]) << 24 | byte[2] << 16 | byte[1] << 8 | byte[0];
}


uint16
ResourceReader::_Half(const char* bytes) const
{
	const uint8* byte = reinterpret_cast<const uint8*>(bytes);
	return fInfo.big_endian ? byte[0] << 8 | byte[1] : byte[1] << 8 | byte[0];
}


bool
ResourceReader::_IsFiller(
	const std::string& bytes, size_t start, uint32 sectionOffset, size_t size) const
{
	for (size_t i = 0; i + 4 <= size; i += 4) {
		if (_Word(bytes.data() + start + i) != FillerWord(sectionOffset + i))
			return false;
	}
	return true;
}


// #pragma mark - section


void
ResourceReader::_ReadSection()
{
	if (!_ReadHeader() || !_ReadIndex() || !_ReadEntries())
		return;
	fItems.resize(fEntries.size());
	if (!_ReadInfoTable())
		fItems.clear();
	_KeepLostEntries();
	_ReadUnknown();
}


// For a file whose start is damaged: the section has a magic number of its own.
void
ResourceReader::_FindMagic()
{
	std::string block;
	for (off_t start = 0; start + 4 <= fFileSize; start += kBlockSize - 4) {
		_ReadAt(start, kBlockSize, &block);
		for (size_t i = 0; i + 4 <= block.size(); i++) {
			fInfo.big_endian = block[i] == 'D';
			if (block[i] != 'D' && block[i] != '\0')
				continue;
			if (_Word(block.data() + i) == kResourceMagic) {
				fInfo.base = start + i;
				fInfo.has_section = true;
				return;
			}
		}
	}
	fInfo.has_section = false;
}


// The magic number tells the truth when it disagrees with the file's kind.
bool
ResourceReader::_FindByteOrder(const char* start)
{
	for (int32 attempt = 0; attempt < 2; attempt++) {
		if (_Word(start) == kResourceMagic)
			return true;
		fInfo.big_endian = !fInfo.big_endian;
	}
	return false;
}


bool
ResourceReader::_ReadHeader()
{
	std::string header;
	if (_Stop(!_ReadAt(fInfo.base, kResourceHeaderSize, &header), fInfo.base + header.size(),
			"the resources header is cut off", B_ERROR)
		|| header.size() < kResourceHeaderSize)
		return false;

	if (!_FindByteOrder(header.data())) {
		if (_Stop(true, fInfo.base, "there is no resource section here", B_IO_ERROR))
			return false;
		_FindMagic();
		if (!fInfo.has_section || !_ReadAt(fInfo.base, kResourceHeaderSize, &header))
			return false;
	}

	fCount = _Word(header.data() + 4);
	if (_Stop(fCount > kMostResources, fInfo.base + 4, "there are too many resources", B_IO_ERROR)
		|| _Stop(_Word(header.data() + 8) != kIndexOffset, fInfo.base + 8,
			"the index is not where it belongs", B_IO_ERROR))
		return false;
	fIndexSize = _Word(header.data() + 12) - kIndexOffset;
	const std::string padding = header.substr(kHeaderPaddingOffset, kHeaderPaddingSize);
	if (padding.find_first_not_of('\0') != std::string::npos)
		fExtras.headerPadding = padding;
	return true;
}


bool
ResourceReader::_ReadIndex()
{
	const off_t start = fInfo.base + kIndexOffset;
	std::string index;
	if (_Stop(!_ReadAt(start, kIndexHeaderSize, &index), start + index.size(),
			"the index is cut off", B_ERROR)
		|| index.size() < kIndexHeaderSize)
		return false;

	// The header says twice how large the index is, and the count has to fit in.
	const uint32 size = _Word(index.data() + 4);
	const uint64 needed = kIndexHeaderSize + uint64(kIndexEntrySize) * fCount;
	if (_Stop(
			_Word(index.data()) != kIndexOffset, start, "the index names a wrong place", B_IO_ERROR)
		|| _Stop(fIndexSize != size, start + 4, "the sizes of the index do not agree", B_IO_ERROR)
		|| _Stop(size < needed || size % 4 != 0, start + 4,
			"the index is too small for its resources", B_IO_ERROR)
		|| _Stop(_Word(index.data() + 12) != kIndexOffset + size, start + 12,
			"the section behind the index is not where it belongs", B_IO_ERROR)
		|| _Stop(_Word(index.data() + 16) != kUnknownSize, start + 16,
			"the section behind the index has a wrong size", B_IO_ERROR))
		return false;
	fIndexSize = size;
	fInfoOffset = _Word(index.data() + 0x78);
	fInfoTableSize = _Word(index.data() + 0x7c);
	return true;
}


// Entries go on behind the count: some writers left deleted ones there.
bool
ResourceReader::_ReadEntries()
{
	const off_t start = fInfo.base + kIndexEntriesOffset;
	off_t end = fInfo.base + kIndexOffset + static_cast<off_t>(fIndexSize);
	if (fStatus != B_OK) // then the size may be wrong; what the file has limits it
		end = std::max(end, start + static_cast<off_t>(fCount) * kIndexEntrySize);
	end = std::min(end, fFileSize);
	if (end > start)
		fEntries.reserve(std::min<off_t>(fCount, (end - start) / kIndexEntrySize));

	std::string block;
	for (off_t place = start; place + kIndexEntrySize <= end;) {
		const size_t entries = std::min<off_t>(end - place, kBlockSize) / kIndexEntrySize;
		if (!_ReadAt(place, entries * kIndexEntrySize, &block))
			break;
		for (size_t i = 0; i < entries; i++, place += kIndexEntrySize) {
			const char* bytes = block.data() + i * kIndexEntrySize;
			const bool counted = fEntries.size() < fCount;
			if (!counted && fEntries.size() >= kMostResources)
				return true;
			if (_IsFiller(block, i * kIndexEntrySize, place - fInfo.base, kIndexEntrySize)) {
				if (_Stop(counted, place, "the index has fewer entries than the count says",
						B_IO_ERROR))
					return false;
				return true;
			}
			if (!_AddEntry(bytes, place))
				return counted ? fTolerant : true;
		}
	}
	return !_Stop(fEntries.size() < fCount, end, "the index is cut off", B_ERROR);
}


// False when the reading of the index ends here.
bool
ResourceReader::_AddEntry(const char* bytes, off_t place)
{
	const IndexEntry entry = { _Word(bytes), _Word(bytes + 4), place, false };
	const off_t end = fInfo.base + static_cast<off_t>(entry.offset) + entry.size;
	if (end > fFileSize) {
		if (fEntries.size() >= fCount)
			return false;
		if (_Stop(true, place, "a resource's data pass the end of the file", B_IO_ERROR))
			return false;
	}
	fEntries.push_back(entry);
	return true;
}


void
ResourceReader::_ReadUnknown()
{
	const uint32 offset = kIndexOffset + fIndexSize;
	std::string unknown;
	if (fStatus == B_OK && _ReadAt(fInfo.base + offset, kUnknownSize, &unknown)
		&& !_IsFiller(unknown, 0, offset, kUnknownSize))
		fExtras.unknown = unknown;
}


// #pragma mark - info table


bool
ResourceReader::_ReadInfoTable()
{
	const off_t field = fInfo.base + kIndexOffset + 0x78;
	off_t start = fInfo.base + static_cast<off_t>(fInfoOffset);
	if (_Stop(start + static_cast<off_t>(fInfoTableSize) > fFileSize, field,
			"the info table passes the end of the file", B_IO_ERROR)
		|| _Stop(
			fInfoTableSize < kTableEndSize, field + 4, "the info table is too small", B_IO_ERROR))
		return false;
	fLostInfos = start + static_cast<off_t>(fInfoTableSize) > fFileSize;

	std::string table;
	const bool whole = _ReadAt(start, fInfoTableSize, &table);
	if (_Stop(!whole && !fLostInfos, start, "the info table cannot be read", B_ERROR))
		return false;
	size_t size = table.size();
	if (whole && size >= kTableEndSize) {
		// Without the final zero there is no checksum.
		size -= kTableEndSize;
		const uint8* bytes = reinterpret_cast<const uint8*>(table.data());
		if (_Word(table.data() + size + 4) == 0
			&& _Stop(_Word(table.data() + size) != InfoChecksum(bytes, size), start + size,
				"the checksum of the info table does not match", B_IO_ERROR))
			return false;
		if (_Word(table.data() + size + 4) != 0)
			size += kTableEndSize;
	}
	return _ReadInfos(table, size) && _CheckTotal();
}


bool
ResourceReader::_ReadInfos(const std::string& table, size_t size)
{
	const off_t start = fInfo.base + static_cast<off_t>(fInfoOffset);
	const auto isEnd = [&](size_t place) {
		return place + 8 <= size && _Word(table.data() + place) == kBlockEnd
			&& _Word(table.data() + place + 4) == kBlockEnd;
	};

	// Only the first block can be empty: a table of nothing has just its mark.
	size_t place = 0;
	if (isEnd(0))
		place = 8;
	while (place < size) {
		if (_Stop(place + 4 > size, start + place, "the info table has bytes left over", B_IO_ERROR)
			|| place + 4 > size)
			break;
		const type_code type = _Word(table.data() + place);
		place += 4;
		while (!isEnd(place)) {
			if (!_ReadInfo(table, size, &place, type)) {
				fLostInfos = true;
				return fTolerant;
			}
		}
		place += 8;
	}
	return fStatus == B_OK || fTolerant;
}


// False when the table cannot be read any further.
bool
ResourceReader::_ReadInfo(const std::string& table, size_t size, size_t* _place, type_code type)
{
	const off_t start = fInfo.base + static_cast<off_t>(fInfoOffset) + *_place;
	if (*_place + kInfoSize > size) {
		_Stop(true, start, "the info table breaks off", B_IO_ERROR);
		return false;
	}
	const char* info = table.data() + *_place;
	const int32 id = static_cast<int32>(_Word(info));
	const uint32 index = _Word(info + 4);
	const uint16 nameSize = _Half(info + 8);
	if (*_place + kInfoSize + nameSize > size) {
		_Stop(true, start + 8, "a name passes the end of the info table", B_IO_ERROR);
		return false;
	}
	*_place += kInfoSize + nameSize;

	// An index that names no entry belongs to nothing.
	if (index == 0 || index > fEntries.size())
		return true;
	if (fEntries[index - 1].used)
		return !_Stop(true, start + 4, "two infos belong to one resource", B_IO_ERROR);
	fEntries[index - 1].used = true;
	const char* name = info + kInfoSize;
	_AddItem(index - 1, type, id, std::string(name, strnlen(name, nameSize)), nameSize > 0);
	return true;
}


void
ResourceReader::_AddItem(
	size_t index, type_code type, int32 id, const std::string& name, bool named)
{
	auto item = std::make_unique<ResourceItem>();
	item->type = type;
	item->id = id;
	item->name = name;
	item->named = named;
	item->size = fEntries[index].size;
	item->offset = fInfo.base + static_cast<off_t>(fEntries[index].offset);
	fItems[index] = std::move(item);
}


// An entry without an info is normally a deleted resource. When infos were lost it may be one that
// somebody misses.
void
ResourceReader::_KeepLostEntries()
{
	if (!fTolerant || (!fLostInfos && fStatus == B_OK))
		return;
	fItems.resize(fEntries.size());
	for (size_t i = 0; i < fEntries.size(); i++) {
		if (!fEntries[i].used && i < fCount) {
			_AddItem(i, B_RAW_TYPE, static_cast<int32>(i + 1), std::string(), false);
			fReport.damages.push_back(
				{ fEntries[i].place, "type, id and name of this resource are lost", false });
		}
	}
}


bool
ResourceReader::_CheckTotal()
{
	off_t total = 0;
	for (const auto& item : fItems) {
		if (item != nullptr)
			total += item->size;
	}
	if (!_Stop(total > kMostOverlap * fFileSize, fInfo.base + kIndexEntriesOffset,
			"the resources are larger than the file", B_IO_ERROR))
		return true;
	return false;
}

} // namespace BPrivate
