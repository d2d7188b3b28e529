// Resource files with anything in them: an error or a sane table, never more.

#include <string.h>
#include <sys/mman.h>
#include <unistd.h>

#include <DataIO.h>
#include <File.h>
#include <ResourceForm.h>
#include <Resources.h>

#include "TemporaryFolder.h"

namespace {

const std::string kFolder = ARCHWAY_TEST_DATA "/resources/";


// A small file with several types, names and an empty item.
std::string
SmallBytes()
{
	TemporaryFolder folder;
	const std::string path = folder / "file";
	WriteFile(path, "");
	{
		BResources resources(path.c_str());
		resources.AddResource('ARCV', 1, "first", 5, "zetka");
		resources.AddResource('ARCV', -2, "second", 6, "a name");
		resources.AddResource('CSTR', 3, "", 0);
		resources.AddResource('LONG', 4, "\1\2\3\4", 4, "");
	}
	return ReadFile(path);
}


// Files by the hundred thousand live in memory.
class MemoryFile {
public:
	MemoryFile() : fFd(memfd_create("resources", 0)), fPath("/proc/self/fd/" + std::to_string(fFd))
	{
	}

	~MemoryFile() { close(fFd); }

	const char* Write(const std::string& bytes)
	{
		if (pwrite(fFd, bytes.data(), bytes.size(), 0) != static_cast<ssize_t>(bytes.size())
			|| ftruncate(fFd, bytes.size()) != 0)
			abort();
		return fPath.c_str();
	}

private:
	const int fFd;
	const std::string fPath;
};


// Reads the file in every way; the answer of SetTo().
status_t
ReadEverything(MemoryFile& file, const std::string& bytes)
{
	BFile opened(file.Write(bytes), B_READ_ONLY);
	BResources resources;
	const status_t status = resources.SetTo(&opened);
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	size_t total = 0;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		EXPECT_LE(size, bytes.size());
		total += size;
		size_t loaded = 0;
		const void* data = resources.LoadResource(type, id, &loaded);
		EXPECT_NE(nullptr, data);
		// Every byte is ours to read.
		if (data != NULL && loaded > 0) {
			EXPECT_NE(
				nullptr, memmem(data, loaded, static_cast<const char*>(data) + loaded - 1, 1));
		}
	}
	EXPECT_LE(total, 2 * bytes.size());
	if (status != B_OK) {
		EXPECT_FALSE(resources.GetResourceInfo(0, NULL, NULL, NULL, NULL));
	}

	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	std::vector<resource_damage> damages;
	std::vector<resource_place> places;
	BResources readable;
	EXPECT_EQ(status, examine_resource_file(&stream, NULL, &places, &damages, &readable));
	EXPECT_EQ(status != B_OK, !damages.empty());
	EXPECT_LE(places.size(), bytes.size());
	for (const resource_damage& damage : damages) {
		EXPECT_GE(damage.offset, 0);
		EXPECT_NE(nullptr, damage.reason);
	}
	return status;
}

} // namespace


TEST(DamagedResources, EveryTruncationIsAnError)
{
	const std::string bytes = SmallBytes();
	MemoryFile file;
	for (size_t size = 1; size < bytes.size() && !HasFailure(); size++) {
		SCOPED_TRACE(size);
		EXPECT_NE(B_OK, ReadEverything(file, bytes.substr(0, size)));
	}
	EXPECT_EQ(B_OK, ReadEverything(file, bytes));
}


TEST(DamagedResources, EveryTruncationOfASampleIsAnError)
{
	const std::string bytes = ReadFile(kFolder + "70-in-elf.bin");
	ASSERT_FALSE(bytes.empty());
	MemoryFile file;
	int refused = 0;
	for (size_t size = 1; size < bytes.size() && !HasFailure(); size += 7) {
		SCOPED_TRACE(size);
		// A program without resources is no damage.
		refused += ReadEverything(file, bytes.substr(0, size)) != B_OK;
	}
	EXPECT_GT(refused, 100);
}


TEST(DamagedResources, EveryChangedByteIsAnErrorOrHarmless)
{
	const std::string bytes = SmallBytes();
	MemoryFile file;
	for (size_t place = 0; place < bytes.size() && !HasFailure(); place++) {
		// The filler is nobody's: one of its bytes in forty shows as much as all.
		const bool filler = place > 4 + 0xc8 + 4 * 12 + 24 && place < 4 + 0x7ac;
		if (filler && place % 40 != 0)
			continue;
		SCOPED_TRACE(place);
		const uint8 old = bytes[place];
		std::vector<uint8> values = { 0, 255, static_cast<uint8>(old + 1) };
		for (int bit = 0; bit < 8; bit++)
			values.push_back(old ^ (1 << bit));
		for (const uint8 value : values) {
			std::string damaged = bytes;
			damaged[place] = static_cast<char>(value);
			ReadEverything(file, damaged);
		}
	}
}


TEST(DamagedResources, ExtremeNumbersAreErrorsOrHarmless)
{
	const std::string bytes = SmallBytes();
	MemoryFile file;
	for (size_t place = 4; place + 4 <= bytes.size() && !HasFailure(); place += 4) {
		if (place > 4 + 0x100 && place < 4 + 0x7a0)
			continue;
		for (const uint32 value : { 0x7fffffffu, 0x80000000u, 0xffffffffu, 0xfffffff0u, 10001u,
				 0x10000u, 1u, static_cast<uint32>(bytes.size()) }) {
			SCOPED_TRACE(place);
			std::string damaged = bytes;
			memcpy(damaged.data() + place, &value, sizeof(value));
			ReadEverything(file, damaged);
		}
	}
}


TEST(DamagedResources, ItemsThatOverlapTooOftenAreRefused)
{
	TemporaryFolder folder;
	const std::string path = folder / "file";
	WriteFile(path, "");
	{
		BResources resources(path.c_str());
		for (int32 i = 0; i < 1000; i++)
			resources.AddResource('AAAA', i, "x", 1);
	}
	std::string bytes = ReadFile(path);
	const uint32 size = static_cast<uint32>(bytes.size()) - 64;
	for (int32 i = 0; i < 1000; i++) {
		const uint32 entry[] = { 0, size };
		memcpy(bytes.data() + 4 + 0xc8 + 12 * i, entry, sizeof(entry));
	}
	MemoryFile file;
	EXPECT_EQ(B_IO_ERROR, ReadEverything(file, bytes));
}


TEST(DamagedResources, WhatCanBeReadIsFoundWithItsPlace)
{
	std::string bytes = SmallBytes();
	bytes[bytes.size() - 8] ^= 1; // the checksum
	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	resource_file_info info;
	std::vector<resource_place> places;
	std::vector<resource_damage> damages;
	BResources readable;
	EXPECT_EQ(B_IO_ERROR, examine_resource_file(&stream, &info, &places, &damages, &readable));
	EXPECT_EQ(B_X86_RESOURCE_FILE, info.kind);
	EXPECT_EQ(4, info.base);
	ASSERT_EQ(4u, places.size());
	EXPECT_STREQ("a name", places[1].name.String());
	EXPECT_EQ("second", bytes.substr(places[1].offset, places[1].size));
	ASSERT_EQ(1u, damages.size());
	EXPECT_EQ(static_cast<off_t>(bytes.size() - 8), damages[0].offset);
	EXPECT_TRUE(readable.HasResource('LONG', 4));
}


TEST(DamagedResources, ItemsWithoutTheirInfosAreKeptAsBytes)
{
	const std::string whole = SmallBytes();
	const std::string bytes = whole.substr(0, whole.size() - 60); // the infos break off
	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	std::vector<resource_place> places;
	BResources readable;
	EXPECT_EQ(B_IO_ERROR, examine_resource_file(&stream, NULL, &places, NULL, &readable));
	ASSERT_EQ(4u, places.size());
	EXPECT_EQ(type_code('ARCV'), places[0].type);
	EXPECT_EQ(type_code('RAWT'), places[3].type);
	size_t size = 0;
	EXPECT_NE(nullptr, readable.LoadResource('RAWT', places[3].id, &size));
	EXPECT_EQ(4u, size);
}


TEST(DamagedResources, ASectionBehindADamagedStartIsFound)
{
	std::string bytes = SmallBytes();
	bytes.replace(0, 4, "what is this? ");
	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	std::vector<resource_place> places;
	EXPECT_EQ(B_IO_ERROR, examine_resource_file(&stream, NULL, &places, NULL));
	ASSERT_EQ(4u, places.size());
	EXPECT_EQ("first", bytes.substr(places[0].offset, places[0].size));
}
