#include "storage/private/ResourceWriter.h"

#include <bit>
#include <errno.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <memory>

#include "storage/private/ResourceFormat.h"

namespace BPrivate {

namespace {

constexpr bool kHostIsBig = std::endian::native == std::endian::big;
constexpr uint64 kLargestSection = 0xffffffff;


// Bytes of the section's tables, in its byte order.
class SectionBytes {
public:
	explicit SectionBytes(bool bigEndian) : fBigEndian(bigEndian) {}

	void Put(uint64 number, size_t size)
	{
		for (size_t i = 0; i < size; i++) {
			const size_t shift = 8 * (fBigEndian ? size - 1 - i : i);
			bytes += static_cast<char>(number >> shift);
		}
	}

	void Word(uint32 number) { Put(number, 4); }

	// As far as the section offset `end`; the first byte of `bytes` is at section offset 0.
	void Fill(uint32 end)
	{
		while (bytes.size() < end)
			Word(FillerWord(bytes.size()));
	}

	std::string bytes;

private:
	const bool fBigEndian;
};


std::string
InfoTable(ResourceTable& table, bool bigEndian)
{
	SectionBytes infos(bigEndian);
	const int32 count = table.Count();
	for (int32 i = 0; i < count; i++) {
		const ResourceItem* item = table.At(i);
		if (i == 0 || table.At(i - 1)->type != item->type) {
			if (i > 0)
				infos.Put(~0ull, 8);
			infos.Word(item->type);
		}
		infos.Word(item->id);
		infos.Word(i + 1);
		const size_t nameSize = item->named ? item->name.size() + 1 : 0;
		infos.Put(nameSize, 2);
		infos.bytes.append(item->name.c_str(), nameSize);
	}
	infos.Put(~0ull, 8);
	infos.Word(
		InfoChecksum(reinterpret_cast<const uint8*>(infos.bytes.data()), infos.bytes.size()));
	infos.Word(0);
	return std::move(infos.bytes);
}


// Everything from the section's start to its first data.
std::string
SectionStart(ResourceTable& table, const ResourceFrame& frame, const std::vector<off_t>& offsets,
	uint32 infoOffset, uint32 infoSize)
{
	const uint32 count = table.Count();
	const uint32 indexSize = IndexSectionSize(count);
	SectionBytes section(frame.info.big_endian);
	section.Word(kResourceMagic);
	section.Word(count);
	section.Word(kIndexOffset);
	section.Word(kIndexOffset + indexSize);
	if (frame.extras.headerPadding.size() == kHeaderPaddingSize)
		section.bytes += frame.extras.headerPadding;
	else
		section.bytes.append(kHeaderPaddingSize, '\0');

	section.Word(kIndexOffset);
	section.Word(indexSize);
	section.Fill(section.bytes.size() + 4);
	section.Word(kIndexOffset + indexSize);
	section.Word(kUnknownSize);
	section.Fill(kIndexEntriesOffset - 12);
	section.Word(infoOffset);
	section.Word(infoSize);
	section.Fill(kIndexEntriesOffset);
	for (uint32 i = 0; i < count; i++) {
		section.Word(offsets[i]);
		section.Word(table.At(i)->size);
		section.Word(0);
	}
	section.Fill(kIndexOffset + indexSize);
	if (frame.extras.unknown.size() == kUnknownSize)
		section.bytes += frame.extras.unknown;
	else
		section.Fill(kIndexOffset + indexSize + kUnknownSize);
	return std::move(section.bytes);
}


status_t
WriteItem(AtomicFile& file, const ResourceItem& item, const ResourceSource& source, bool bigEndian)
{
	// Untouched bytes are copied as they are, so that they cannot change.
	const bool sameOrder = source.bigEndian == bigEndian || !IsSwapped(item.type);
	if (item.data == NULL && sameOrder)
		return file.CopyFrom(source.fd, item.offset, item.size);

	void* data = item.data;
	std::unique_ptr<void, void (*)(void*)> loaded(NULL, free);
	if (data == NULL) {
		loaded.reset(ReadResourceData(item, source));
		data = loaded.get();
		if (data == NULL)
			return B_IO_ERROR;
	}
	if (bigEndian == kHostIsBig || !IsSwapped(item.type))
		return file.Write(data, item.size);

	std::string swapped(static_cast<const char*>(data), item.size);
	SwapResource(item.type, swapped.data(), swapped.size());
	return file.Write(swapped.data(), swapped.size());
}


status_t
WritePrefix(AtomicFile& file, const ResourceFrame& frame, int oldFd)
{
	if (frame.info.kind == B_EMPTY_FILE)
		return file.Write("RS\0", kX86HeaderSize);
	const off_t there = std::min(frame.info.base, frame.size);
	const status_t status = file.CopyFrom(oldFd, 0, there);
	return status == B_OK ? file.Fill(frame.info.base - there) : status;
}

} // namespace


void*
ReadResourceData(const ResourceItem& item, const ResourceSource& source)
{
	// Also for no bytes, because a resource that is there has an address.
	char* data = static_cast<char*>(malloc(std::max<size_t>(item.size, 1)));
	for (size_t done = 0; data != NULL && done < item.size;) {
		const ssize_t step = pread(source.fd, data + done, item.size - done, item.offset + done);
		if (step < 0 && errno == EINTR)
			continue;
		if (step <= 0) {
			free(data);
			return NULL;
		}
		done += step;
	}
	if (data != NULL && source.bigEndian != kHostIsBig)
		SwapResource(item.type, data, item.size);
	return data;
}


status_t
WriteResourceFile(AtomicFile& file, const ResourceFrame& frame, int oldFd, ResourceTable& table,
	const ResourceSource& source, std::vector<off_t>* _offsets)
{
	const int32 count = table.Count();
	if (count > static_cast<int32>(kMostResources))
		return B_NOT_ALLOWED; // nobody could read it back

	const bool bigEndian = frame.info.big_endian;
	std::vector<off_t> offsets(count);
	uint64 place = kIndexOffset + uint64(IndexSectionSize(count)) + kUnknownSize;
	for (int32 i = 0; i < count; i++) {
		offsets[i] = place;
		place += table.At(i)->size;
	}
	const std::string infos = InfoTable(table, bigEndian);
	if (place + infos.size() > kLargestSection)
		return B_DEVICE_FULL;

	status_t status = WritePrefix(file, frame, oldFd);
	if (status == B_OK) {
		const std::string start = SectionStart(table, frame, offsets, place, infos.size());
		status = file.Write(start.data(), start.size());
	}
	for (int32 i = 0; status == B_OK && i < count; i++)
		status = WriteItem(file, *table.At(i), source, bigEndian);
	if (status == B_OK)
		status = file.Write(infos.data(), infos.size());
	if (status != B_OK)
		return status;

	for (off_t& offset : offsets)
		offset += frame.info.base;
	*_offsets = std::move(offsets);
	return B_OK;
}

} // namespace BPrivate
