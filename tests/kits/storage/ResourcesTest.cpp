#include <string.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <tuple>
#include <vector>

#include <ByteOrder.h>
#include <DataIO.h>
#include <File.h>
#include <ResourceForm.h>
#include <Resources.h>
#include <TypeConstants.h>

#include "TemporaryFolder.h"

namespace {

const std::string kData = ARCHWAY_TEST_DATA "/resources/";

using Row = std::tuple<type_code, int32, std::string, std::string>;


std::vector<Row>
RowsOf(BResources& resources)
{
	std::vector<Row> rows;
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		size_t loaded = 0;
		const void* data = resources.LoadResource(type, id, &loaded);
		rows.push_back(Row(type, id, name,
			data != NULL ? std::string(static_cast<const char*>(data), loaded) : "(none)"));
	}
	return rows;
}


void
Add(BResources& resources, type_code type, int32 id, const std::string& data,
	const char* name = NULL)
{
	ASSERT_EQ(B_OK, resources.AddResource(type, id, data.data(), data.size(), name));
}


std::string
EmptyFile(const TemporaryFolder& folder, const char* name = "file")
{
	WriteFile(folder / name, "");
	return folder / name;
}


// A resource file with a few items.
std::string
SmallFile(const TemporaryFolder& folder, const char* name = "file")
{
	const std::string path = EmptyFile(folder, name);
	BResources resources(path.c_str());
	Add(resources, 'ARCV', 1, "first", "zetka");
	Add(resources, 'CSTR', 2, std::string("hello\0", 6));
	Add(resources, 'LONG', -7, "\x01\x02\x03\x04", "minus");
	return path;
}

} // namespace


TEST(BResources, FileWithTheSameContentsIsWrittenByteForByte)
{
	TemporaryFolder folder;
	const std::string path = EmptyFile(folder);
	{
		// The bytes of the message in the file are an R5 archive without fields but "count".
		BResources resources(path.c_str());
		Add(resources, 'ARCV', 1,
			std::string("1BOF{et\x8d\x22\0\0\0ktez\x01\x0fGNOL\x04\x05"
						"count\x05\0\0\0\0",
				34),
			"zetka");
		Add(resources, 'CSTR', 2, std::string("hello\0", 6));
	}
	const std::string bytes = ReadFile(path);
	ASSERT_EQ(2066u, bytes.size());
	EXPECT_EQ(std::string("RS\0\0\x00\x10\x4f\x44\x02\0\0\0\x44\0\0\0\x44\x06\0\0", 20),
		bytes.substr(0, 20));
	EXPECT_EQ(std::string("\xe9\x03\0\0\x44\x06\0\0\x68\x01\0\0\xe9\x03\0\0", 16),
		bytes.substr(0x50, 16));
	EXPECT_EQ(std::string("\xd4\x07\0\0\x3a\0\0\0\xe9\x03\0\0", 12), bytes.substr(0xc0, 12));
	EXPECT_EQ(std::string("\xe4\x80\x05\x29\0\0\0\0", 8), bytes.substr(0x80a));
}


TEST(BResources, EmptyResourceFileHas1984Bytes)
{
	TemporaryFolder folder;
	const std::string path = EmptyFile(folder);
	BResources resources;
	ASSERT_EQ(B_OK, resources.SetTo(path.c_str()));
	EXPECT_TRUE(0u == ReadFile(path).size());
	ASSERT_EQ(B_OK, resources.Sync());
	EXPECT_TRUE(1984u == ReadFile(path).size());
	EXPECT_EQ(1u, folder.Count());
}


TEST(BResources, WrittenFileReadsBackInOrder)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	const std::vector<Row> expected = { Row('ARCV', 1, "zetka", "first"),
		Row('CSTR', 2, "", std::string("hello\0", 6)),
		Row('LONG', -7, "minus", "\x01\x02\x03\x04") };
	EXPECT_EQ(expected, RowsOf(resources));
}


TEST(BResources, IndexSectionGrowsWithTheCount)
{
	TemporaryFolder folder;
	for (const int32 count : { 117, 118, 1000 }) {
		const std::string path = EmptyFile(folder);
		{
			BResources resources(path.c_str());
			for (int32 i = 0; i < count; i++)
				Add(resources, 'TEST' + i % 3, i, std::to_string(i));
		}
		const std::string bytes = ReadFile(path);
		const uint32 indexSize = (132 + 12 * count + 0x5ff) / 0x600 * 0x600;
		EXPECT_EQ(indexSize, *reinterpret_cast<const uint32*>(bytes.data() + 4 + 0x48));
		BResources again(path.c_str());
		const std::vector<Row> rows = RowsOf(again);
		ASSERT_EQ(static_cast<size_t>(count), rows.size());
		EXPECT_EQ(std::to_string(count - 1), std::get<3>(rows.back()));
	}
}


TEST(BResources, AddingAKnownKeyReplacesAndMovesToTheEnd)
{
	BResources resources;
	Add(resources, 'AAAA', 1, "one", "n");
	Add(resources, 'AAAA', 2, "two");
	Add(resources, 'AAAA', 1, "three", "m");
	const std::vector<Row> expected = { Row('AAAA', 2, "", "two"), Row('AAAA', 1, "m", "three") };
	EXPECT_EQ(expected, RowsOf(resources));
}


TEST(BResources, AnItemMayBeReplacedByItsOwnBytes)
{
	BResources resources;
	Add(resources, 'AAAA', 1, "some bytes");
	size_t size = 0;
	const void* data = resources.LoadResource('AAAA', 1, &size);
	ASSERT_EQ(B_OK, resources.AddResource('AAAA', 1, data, size, "again"));
	EXPECT_EQ(std::vector<Row> { Row('AAAA', 1, "again", "some bytes") }, RowsOf(resources));
}


TEST(BResources, WriteResourceGrowsWithZerosAndNeverShrinks)
{
	BResources resources;
	Add(resources, 'AAAA', 1, "abcdef");
	ASSERT_EQ(B_OK, resources.WriteResource('AAAA', 1, "XY", 1, 2));
	ASSERT_EQ(B_OK, resources.WriteResource('AAAA', 1, "Z", 8, 1));
	EXPECT_EQ(std::string("aXYdef\0\0Z", 9), std::get<3>(RowsOf(resources)[0]));
	EXPECT_EQ(B_BAD_VALUE, resources.WriteResource('AAAA', 2, "Z", 0, 1));
	EXPECT_EQ(B_BAD_VALUE, resources.WriteResource('AAAA', 1, "Z", -1, 1));
	EXPECT_EQ(B_BAD_VALUE, resources.WriteResource('AAAA', 1, NULL, 0, 0));
	EXPECT_EQ(B_BAD_VALUE, resources.WriteResource('AAAA', 1, "Z", 1ll << 40, 1));
}


TEST(BResources, ReadResourceReadsWhatThereIs)
{
	BResources resources;
	Add(resources, 'AAAA', 1, "abcdef");
	char buffer[8] = "-------";
	EXPECT_EQ(B_OK, resources.ReadResource('AAAA', 1, buffer, 4, 4));
	EXPECT_STREQ("ef-----", buffer);
	EXPECT_EQ(B_OK, resources.ReadResource('AAAA', 1, buffer, 100, 4));
	EXPECT_STREQ("ef-----", buffer);
	EXPECT_EQ(B_BAD_VALUE, resources.ReadResource('AAAA', 2, buffer, 0, 4));
	EXPECT_EQ(B_BAD_VALUE, resources.ReadResource('AAAA', 1, NULL, 0, 4));
	EXPECT_EQ(B_BAD_VALUE, resources.ReadResource('AAAA', 1, buffer, -1, 4));
}


TEST(BResources, LookingForNothingChangesNoAnswer)
{
	BResources resources;
	Add(resources, 'AAAA', 1, "", NULL);
	size_t size = 77;
	EXPECT_EQ(NULL, resources.LoadResource('AAAA', (int32)2, &size));
	EXPECT_EQ(77u, size);
	EXPECT_EQ(NULL, resources.FindResource('AAAA', (int32)2, &size));
	EXPECT_EQ(0u, size);
	EXPECT_NE(nullptr, resources.LoadResource('AAAA', (int32)1, &size));
	int32 id = 99;
	EXPECT_FALSE(resources.GetResourceInfo('AAAA', "name", &id, NULL));
	EXPECT_EQ(99, id);
	EXPECT_TRUE(resources.HasResource('AAAA', ""));
	EXPECT_FALSE(resources.HasResource('AAAA', (const char*)NULL));
	EXPECT_FALSE(resources.GetResourceInfo(-1, NULL, NULL, NULL, NULL));
	EXPECT_FALSE(resources.GetResourceInfo(1, NULL, NULL, NULL, NULL));
}


TEST(BResources, InfoIsFoundByTypeIndexNameAndPointer)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	int32 id = 0;
	const char* name = NULL;
	size_t size = 0;
	type_code type = 0;
	ASSERT_TRUE(resources.GetResourceInfo('LONG', (int32)0, &id, &name, &size));
	EXPECT_EQ(-7, id);
	EXPECT_STREQ("minus", name);
	ASSERT_TRUE(resources.GetResourceInfo('ARCV', "zetka", &id, &size));
	EXPECT_EQ(1, id);
	EXPECT_EQ(5u, size);
	const void* data = resources.LoadResource('CSTR', 2, NULL);
	ASSERT_TRUE(resources.GetResourceInfo(data, &type, &id, &size, &name));
	EXPECT_EQ(type_code('CSTR'), type);
	EXPECT_EQ(2, id);
	EXPECT_STREQ("", name);
	EXPECT_EQ(B_OK, resources.RemoveResource(data));
	EXPECT_FALSE(resources.HasResource('CSTR', 2));
	EXPECT_FALSE(resources.GetResourceInfo(data, &type, &id, &size, &name));
	EXPECT_EQ(B_BAD_VALUE, resources.RemoveResource((const void*)NULL));
}


TEST(BResources, RemovalClosesTheGap)
{
	BResources resources;
	for (int32 i = 0; i < 6; i++)
		Add(resources, i % 2 == 0 ? 'EVEN' : 'ODD ', i, std::to_string(i));
	ASSERT_EQ(B_OK, resources.RemoveResource('EVEN', 2));
	ASSERT_EQ(B_OK, resources.RemoveResource('ODD ', 1));
	ASSERT_EQ(B_OK, resources.RemoveResource('EVEN', 0));
	EXPECT_EQ(B_BAD_VALUE, resources.RemoveResource('EVEN', 0));
	Add(resources, 'EVEN', 0, "new");
	const std::vector<Row> expected = { Row('ODD ', 3, "", "3"), Row('EVEN', 4, "", "4"),
		Row('ODD ', 5, "", "5"), Row('EVEN', 0, "", "new") };
	EXPECT_EQ(expected, RowsOf(resources));
	int32 id = 0;
	ASSERT_TRUE(resources.GetResourceInfo('ODD ', (int32)1, &id, NULL, NULL));
	EXPECT_EQ(5, id);
}


TEST(BResources, SetToAnswersWhatIsWrong)
{
	TemporaryFolder folder;
	BResources resources;
	EXPECT_EQ(B_OK, resources.SetTo((const BFile*)NULL));
	EXPECT_EQ(B_BAD_VALUE, resources.SetTo((const char*)NULL));
	EXPECT_EQ(B_BAD_VALUE, resources.SetTo((const entry_ref*)NULL));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, resources.SetTo((folder / "missing").c_str()));
	BFile unset;
	EXPECT_EQ(B_NO_INIT, resources.SetTo(&unset));
	const std::pair<const char*, status_t> cases[] = { { "R", B_IO_ERROR }, { "abc", B_IO_ERROR },
		{ "this is text", B_IO_ERROR }, { "RS", B_IO_ERROR } };
	for (const auto& [bytes, status] : cases) {
		WriteFile(folder / "bad", bytes);
		EXPECT_EQ(status, resources.SetTo((folder / "bad").c_str())) << bytes;
		EXPECT_TRUE(bytes == ReadFile(folder / "bad"));
	}
	WriteFile(folder / "bad", std::string("RS\0\0", 4));
	EXPECT_EQ(B_ERROR, resources.SetTo((folder / "bad").c_str()));
	EXPECT_EQ(B_OK, resources.InitCheck());
	EXPECT_EQ(B_NO_INIT, resources.Sync());
}


TEST(BResources, ClobberEmptiesAnyFileAtOnce)
{
	TemporaryFolder folder;
	WriteFile(folder / "text", "this is text");
	BResources resources;
	ASSERT_EQ(B_OK, resources.SetTo((folder / "text").c_str(), true));
	EXPECT_TRUE(1984u == ReadFile(folder / "text").size());
	const std::string path = SmallFile(folder);
	ASSERT_EQ(B_OK, resources.SetTo(path.c_str(), true));
	EXPECT_TRUE(1984u == ReadFile(path).size());
	EXPECT_FALSE(resources.HasResource('ARCV', 1));
}


TEST(BResources, ClobberSparesAReadOnlyFile)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	const std::string before = ReadFile(path);
	BFile file(path.c_str(), B_READ_ONLY);
	BResources resources;
	ASSERT_EQ(B_OK, resources.SetTo(&file, true));
	EXPECT_TRUE(resources.HasResource('ARCV', 1));
	EXPECT_EQ(B_NOT_ALLOWED, resources.AddResource('ARCV', 2, "x", 1));
	EXPECT_EQ(B_NOT_ALLOWED, resources.RemoveResource('ARCV', 1));
	EXPECT_EQ(B_NOT_ALLOWED, resources.WriteResource('ARCV', 1, "x", 0, 1));
	EXPECT_EQ(B_NOT_ALLOWED, resources.Sync());
	EXPECT_TRUE(before == ReadFile(path));
}


TEST(BResources, ElfPartStaysAsItIs)
{
	TemporaryFolder folder;
	// The smallest 64-bit header that says of itself that nothing follows.
	std::string elf("\x7f"
					"ELF\x02\x01\x01",
		7);
	elf.resize(67, 'x');
	elf[52] = 64;
	for (const int at : { 32, 40 })
		elf.replace(at, 8, 8, '\0');
	elf.replace(52, 2, std::string("\x40\0", 2));
	WriteFile(folder / "program", elf.substr(0, 64));
	{
		BResources resources((folder / "program").c_str());
		Add(resources, 'AAAA', 1, "data");
	}
	const std::string bytes = ReadFile(folder / "program");
	EXPECT_EQ(elf.substr(0, 64), bytes.substr(0, 64));
	EXPECT_EQ(std::string("\x00\x10\x4f\x44", 4), bytes.substr(64, 4));
	{
		BResources resources((folder / "program").c_str());
		EXPECT_EQ(std::vector<Row> { Row('AAAA', 1, "", "data") }, RowsOf(resources));
		ASSERT_EQ(B_OK, resources.SetTo((folder / "program").c_str(), true));
		EXPECT_TRUE(RowsOf(resources).empty());
	}
	EXPECT_EQ(elf.substr(0, 64), ReadFile(folder / "program").substr(0, 64));
	// What follows an executable and is no resource section is nobody's to overwrite.
	WriteFile(folder / "program", elf.substr(0, 64) + "something else that is long enough for it");
	BResources resources;
	EXPECT_NE(B_OK, resources.SetTo((folder / "program").c_str()));
}


TEST(BResources, PpcFileKeepsItsByteOrder)
{
	TemporaryFolder folder;
	const std::string ppc = std::string("Joy!resf") + std::string(32, 'g');
	// A section of the other order, from a little-endian file, is believed too.
	const std::string path = SmallFile(folder);
	WriteFile(folder / "ppc", ppc + ReadFile(path).substr(4));
	{
		BResources resources((folder / "ppc").c_str());
		EXPECT_EQ(3u, RowsOf(resources).size());
		Add(resources, 'SHRT', 1, std::string("\x05\0", 2));
	}
	EXPECT_TRUE(ppc == ReadFile(folder / "ppc").substr(0, 40));

	// An empty big-endian section.
	const std::string little = ReadFile(EmptyFile(folder, "empty"));
	std::string big = ppc;
	{
		BResources empty((folder / "empty").c_str());
		empty.Sync();
	}
	const std::string section = ReadFile(folder / "empty").substr(4);
	for (size_t i = 0; i < section.size(); i += 4)
		big += std::string(
			section.rbegin() + (section.size() - i - 4), section.rbegin() + (section.size() - i));
	// The table's sum is taken over bytes that read the same both ways: all ones.
	WriteFile(folder / "ppc", big);
	{
		BResources resources((folder / "ppc").c_str());
		const int32 number = 0x01020304;
		ASSERT_EQ(B_OK, resources.AddResource(B_INT32_TYPE, 1, &number, 4));
		Add(resources, 'CSTR', 1, "abcd");
	}
	const std::string bytes = ReadFile(folder / "ppc");
	EXPECT_EQ(std::string("\x44\x4f\x10\x00", 4), bytes.substr(40, 4));
	EXPECT_EQ("\x01\x02\x03\x04"
			  "abcd",
		bytes.substr(40 + 0x7ac, 8));
	BResources again((folder / "ppc").c_str());
	const void* data = again.LoadResource(B_INT32_TYPE, (int32)1, NULL);
	ASSERT_NE(nullptr, data);
	EXPECT_EQ(0x01020304, *static_cast<const int32*>(data));
}


TEST(BResources, UnknownPartsOfAFileAreKept)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	std::string bytes = ReadFile(path);
	bytes[4 + 0x10] = 'p'; // the header's padding
	bytes[4 + 0x644 + 5] = 'u'; // the section behind the index
	bytes[2] = 'v'; // the file's own number
	WriteFile(path, bytes);
	{
		BResources resources(path.c_str());
		Add(resources, 'AAAA', 1, "data");
		ASSERT_EQ(B_OK, resources.RemoveResource('AAAA', 1));
	}
	EXPECT_TRUE(bytes == ReadFile(path));
}


TEST(BResources, EmptyNameAndNoNameStayApart)
{
	TemporaryFolder folder;
	const std::string path = EmptyFile(folder);
	{
		BResources resources(path.c_str());
		Add(resources, 'AAAA', 1, "x", "");
		Add(resources, 'AAAA', 2, "x");
	}
	const std::string bytes = ReadFile(path);
	BResources resources(path.c_str());
	ASSERT_EQ(B_OK, resources.Sync());
	EXPECT_TRUE(bytes == ReadFile(path));
}


TEST(BResources, DuplicatesOfAKeyAreKeptAndTheFirstIsFound)
{
	TemporaryFolder folder;
	const std::string path = EmptyFile(folder);
	{
		BResources resources(path.c_str());
		Add(resources, 'AAAA', 0x11, "one");
		Add(resources, 'AAAA', 0x22, "two");
		Add(resources, 'AAAA', 0x33, "three");
	}
	// Give all three the same id, and let no checksum stand.
	std::string bytes = ReadFile(path);
	for (const char id : { '\x22', '\x33' })
		bytes[bytes.rfind(std::string(1, id) + std::string(3, '\0'))] = 0x11;
	bytes[bytes.size() - 4] = 1;
	bytes[bytes.size() - 8] = bytes[bytes.size() - 8];
	bytes.replace(bytes.size() - 8, 8, "");
	bytes[4 + 0xc0] -= 8;
	// Now the table ends with its mark, whose last word is not 0.
	WriteFile(path, bytes);
	BResources resources;
	ASSERT_EQ(B_OK, resources.SetTo(path.c_str()));
	const auto load = [&] {
		size_t size = 0;
		const void* data = resources.LoadResource('AAAA', (int32)0x11, &size);
		return data != NULL ? std::string(static_cast<const char*>(data), size) : "(none)";
	};
	EXPECT_EQ("one", load());
	ASSERT_EQ(B_OK, resources.RemoveResource('AAAA', 0x11));
	EXPECT_EQ("two", load());
	ASSERT_EQ(B_OK, resources.RemoveResource('AAAA', 0x11));
	EXPECT_EQ("three", load());
	ASSERT_EQ(B_OK, resources.RemoveResource('AAAA', 0x11));
	EXPECT_EQ("(none)", load());
}


// #pragma mark - saving


TEST(BResources, TheCallersFileFollowsASave)
{
	TemporaryFolder folder;
	const std::string path = EmptyFile(folder);
	BFile file(path.c_str(), B_READ_WRITE);
	{
		BResources resources(&file, true);
		Add(resources, 'AAAA', 1, "data");
	}
	off_t size = 0;
	ASSERT_EQ(B_OK, file.GetSize(&size));
	EXPECT_EQ(static_cast<off_t>(ReadFile(path).size()), size);
	ASSERT_EQ(4, file.WriteAttr("test", 'CSTR', 0, "abc", 4));
	char buffer[4];
	BNode node(path.c_str());
	ASSERT_EQ(4, node.ReadAttr("test", 'CSTR', 0, buffer, 4));
	EXPECT_STREQ("abc", buffer);
}


TEST(BResources, TheCallerMayCloseHisFile)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources;
	{
		BFile file(path.c_str(), B_READ_WRITE);
		ASSERT_EQ(B_OK, resources.SetTo(&file));
	}
	EXPECT_EQ(3u, RowsOf(resources).size());
	Add(resources, 'AAAA', 1, "data");
	ASSERT_EQ(B_OK, resources.Sync());
	BResources again(path.c_str());
	EXPECT_EQ(4u, RowsOf(again).size());
}


TEST(BResources, SaveKeepsPermissionsAttributesAndLinks)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder, "real");
	ASSERT_EQ(0, chmod(path.c_str(), 0640));
	const bool attributes = setxattr(path.c_str(), "user.other", "value", 5, 0) == 0;
	ASSERT_EQ(0, symlink("real", (folder / "link").c_str()));
	{
		BResources resources((folder / "link").c_str());
		Add(resources, 'AAAA', 1, "data");
		ASSERT_EQ(B_OK, resources.Sync());
	}
	struct stat stat;
	ASSERT_EQ(0, lstat((folder / "link").c_str(), &stat));
	EXPECT_TRUE(S_ISLNK(stat.st_mode));
	ASSERT_EQ(0, lstat(path.c_str(), &stat));
	EXPECT_EQ(0640u, stat.st_mode & 07777);
	char value[6] = {};
	if (attributes) {
		EXPECT_EQ(5, getxattr(path.c_str(), "user.other", value, 5));
		EXPECT_STREQ("value", value);
	}
	BResources again(path.c_str());
	EXPECT_TRUE(again.HasResource('AAAA', 1));
	EXPECT_EQ(2u, folder.Count());
}


TEST(BResources, ItemsThatWereNotLoadedSurviveSavesOfOthers)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	for (int32 i = 0; i < 3; i++) {
		Add(resources, 'NEW ', i, std::string(1000 * i, 'n'));
		ASSERT_EQ(B_OK, resources.Sync());
	}
	size_t size = 0;
	const void* data = resources.LoadResource('ARCV', 1, &size);
	ASSERT_NE(nullptr, data);
	EXPECT_EQ("first", std::string(static_cast<const char*>(data), size));
}


TEST(BResources, AFileThatWasOverwrittenIsNotReadWithOldPlaces)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	WriteFile(path, std::string(5000, 'z'));
	size_t size = 0;
	EXPECT_EQ(NULL, resources.LoadResource('ARCV', 1, &size));
	EXPECT_EQ(-3, resources.PreloadResourceType());
	Add(resources, 'AAAA', 1, "data");
	EXPECT_EQ(B_IO_ERROR, resources.Sync());
	EXPECT_EQ(std::string(5000, 'z'), ReadFile(path));
}


TEST(BResources, AFileThatWasReplacedIsReadAsItWasAndSavedUnderItsName)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	SmallFile(folder, "other");
	ASSERT_EQ(0, rename((folder / "other").c_str(), path.c_str()));
	Add(resources, 'AAAA', 1, "data");
	ASSERT_EQ(B_OK, resources.Sync());
	BResources again(path.c_str());
	EXPECT_EQ(4u, RowsOf(again).size());
	ASSERT_EQ(0, unlink(path.c_str()));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, resources.Sync());
	EXPECT_EQ(0u, folder.Count());
}


TEST(BResources, SaveFollowsAMovedFile)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	ASSERT_EQ(0, rename(path.c_str(), (folder / "moved").c_str()));
	Add(resources, 'AAAA', 1, "data");
	ASSERT_EQ(B_OK, resources.Sync());
	EXPECT_EQ(1u, folder.Count());
	BResources again((folder / "moved").c_str());
	EXPECT_TRUE(again.HasResource('AAAA', 1));
}


TEST(BResources, WriteToMovesToTheOtherFile)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	const std::string before = ReadFile(path);
	const std::string other = SmallFile(folder, "other");
	BResources resources(path.c_str());
	BFile file(other.c_str(), B_READ_WRITE);
	Add(resources, 'ZERO', 1, "");
	ASSERT_EQ(B_OK, resources.RemoveResource('CSTR', 2));
	EXPECT_EQ(B_BAD_VALUE, resources.WriteTo(NULL));
	ASSERT_EQ(B_OK, resources.WriteTo(&file));
	EXPECT_TRUE(before == ReadFile(path));
	Add(resources, 'MORE', 1, "more");
	ASSERT_EQ(B_OK, resources.Sync());
	EXPECT_TRUE(before == ReadFile(path));
	BResources again(other.c_str());
	EXPECT_EQ(RowsOf(resources), RowsOf(again));
	EXPECT_EQ(4u, RowsOf(again).size());

	BFile readOnly(path.c_str(), B_READ_ONLY);
	EXPECT_EQ(B_NOT_ALLOWED, resources.WriteTo(&readOnly));
	WriteFile(folder / "text", "this is text");
	BFile text((folder / "text").c_str(), B_READ_WRITE);
	EXPECT_EQ(B_IO_ERROR, resources.WriteTo(&text));
}


TEST(BResources, DetachedResourcesCanBeWritten)
{
	TemporaryFolder folder;
	BResources resources;
	Add(resources, 'ZERO', 1, "");
	EXPECT_EQ(B_NO_INIT, resources.Sync());
	BFile file((folder / "new").c_str(), B_READ_WRITE | B_CREATE_FILE);
	ASSERT_EQ(B_OK, resources.WriteTo(&file));
	BResources again((folder / "new").c_str());
	EXPECT_EQ(std::vector<Row> { Row('ZERO', 1, "", "") }, RowsOf(again));
}


TEST(BResources, MergeReplacesKnownKeysAndMovesThemToTheEnd)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources;
	Add(resources, 'CSTR', 2, "old");
	Add(resources, 'MINE', 1, "mine");
	BFile file(path.c_str(), B_READ_ONLY);
	ASSERT_EQ(B_OK, resources.MergeFrom(&file));
	const std::vector<Row> expected = { Row('MINE', 1, "", "mine"),
		Row('ARCV', 1, "zetka", "first"), Row('CSTR', 2, "", std::string("hello\0", 6)),
		Row('LONG', -7, "minus", "\x01\x02\x03\x04") };
	EXPECT_EQ(expected, RowsOf(resources));
	EXPECT_EQ(B_BAD_VALUE, resources.MergeFrom(NULL));
}


TEST(BResources, SetToWritesPendingChangesFirst)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	BResources resources(path.c_str());
	Add(resources, 'AAAA', 1, "data");
	ASSERT_EQ(B_OK, resources.SetTo(path.c_str()));
	EXPECT_TRUE(resources.HasResource('AAAA', 1));

	BFile file(path.c_str(), B_READ_WRITE);
	Add(resources, 'BBBB', 1, "data");
	ASSERT_EQ(B_OK, resources.SetTo(&file));
	EXPECT_TRUE(resources.HasResource('BBBB', 1));
}


TEST(BResources, OpeningAndClosingWritesNothing)
{
	TemporaryFolder folder;
	const std::string path = SmallFile(folder);
	struct stat before;
	ASSERT_EQ(0, stat(path.c_str(), &before));
	{
		BResources resources(path.c_str());
		EXPECT_EQ(B_OK, resources.PreloadResourceType());
		EXPECT_EQ(3u, RowsOf(resources).size());
	}
	struct stat after;
	ASSERT_EQ(0, stat(path.c_str(), &after));
	EXPECT_EQ(before.st_ino, after.st_ino);
	EXPECT_EQ(before.st_mtim.tv_nsec, after.st_mtim.tv_nsec);
}


TEST(BResources, MoreThanTenThousandAreRefused)
{
	BResources resources;
	for (int32 i = 0; i < 10000; i++)
		ASSERT_EQ(B_OK, resources.AddResource('MANY', i, "x", 1));
	EXPECT_EQ(B_NOT_ALLOWED, resources.AddResource('MANY', 10000, "x", 1));
	EXPECT_EQ(B_OK, resources.AddResource('MANY', 0, "y", 1));
	for (int32 i = 0; i < 10000; i++)
		ASSERT_EQ(B_OK, resources.RemoveResource('MANY', i));
	EXPECT_FALSE(resources.GetResourceInfo(0, NULL, NULL, NULL, NULL));
}


// #pragma mark - two resources of one type and id


namespace {

// A file whose second resource claims the first one's id.
std::string
TwinBytes()
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "");
	{
		BResources resources((folder / "file").c_str());
		resources.AddResource('TWIN', 1, "one", 3, "first");
		resources.AddResource('TWIN', 2, "the other", 9, "second");
	}
	std::string bytes = ReadFile(folder / "file");
	constexpr size_t kBase = 4;
	const auto word = [&](size_t at) {
		uint32 value;
		memcpy(&value, bytes.data() + at, 4);
		return value;
	};
	const size_t table = kBase + word(kBase + 0x44 + 0x78);
	const size_t size = word(kBase + 0x44 + 0x7c) - 8;
	// The type, the first info with its name, the second info.
	const size_t second = table + 4 + 10 + sizeof("first");
	EXPECT_EQ(2u, word(second));
	bytes[second] = 1;
	uint32 sum = 0;
	for (size_t i = 0; i < size; i += 4) {
		uint32 number = 0;
		for (size_t k = i; k < i + 4 && k < size; k++)
			number = number << 8 | static_cast<uint8>(bytes[table + k]);
		sum += number;
	}
	memcpy(bytes.data() + table + size, &sum, sizeof(sum));
	return bytes;
}

} // namespace


TEST(Resources, TheSecondOfTwoWithOneIdIsFoundByItsIndex)
{
	TemporaryFolder folder;
	WriteFile(folder / "twins", TwinBytes());
	BResources resources((folder / "twins").c_str());
	ASSERT_EQ(B_OK, resources.InitCheck());
	size_t size = 0;
	const char* name = NULL;
	EXPECT_TRUE(resources.GetResourceInfo(1, NULL, NULL, &name, &size));
	EXPECT_STREQ("second", name);
	EXPECT_EQ(9u, size);
	EXPECT_EQ(0, memcmp("one", resources.LoadResource('TWIN', 1, &size), 3));
	EXPECT_EQ(3u, size);
	const void* data = load_resource(&resources, 1, &size);
	ASSERT_NE(nullptr, data);
	ASSERT_EQ(9u, size);
	EXPECT_EQ(0, memcmp("the other", data, 9));
	EXPECT_EQ(NULL, load_resource(&resources, 2, &size));
	EXPECT_EQ(NULL, load_resource(&resources, -1, &size));
}


TEST(Resources, ASalvagedTwinGetsAnIdOfItsOwn)
{
	const std::string bytes = TwinBytes();
	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	BResources readable;
	EXPECT_EQ(B_OK, examine_resource_file(&stream, NULL, NULL, NULL, &readable));
	size_t size = 0;
	const void* data = readable.LoadResource('TWIN', "second", &size);
	ASSERT_NE(nullptr, data);
	EXPECT_EQ(9u, size);
	EXPECT_TRUE(readable.HasResource('TWIN', 1));
	EXPECT_TRUE(readable.HasResource('TWIN', 2));
}
