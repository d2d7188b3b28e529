#include <sys/stat.h>
#include <unistd.h>

#include <set>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <Node.h>
#include <NodeInfo.h>
#include <Path.h>
#include <String.h>
#include <SymLink.h>
#include <TypeConstants.h>

#include "TemporaryFolder.h"

TEST(BNode, AttributesKeepTypeAndBytes)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	BNode node((folder / "file").c_str());
	ASSERT_EQ(B_OK, node.InitCheck());
	const int32 number = 42;
	EXPECT_EQ(4, node.WriteAttr("number", B_INT32_TYPE, 0, &number, 4));
	EXPECT_EQ(6, node.WriteAttr("text", B_STRING_TYPE, 0, "hello", 6));

	BNode again((folder / "file").c_str());
	attr_info info;
	ASSERT_EQ(B_OK, again.GetAttrInfo("number", &info));
	EXPECT_EQ(static_cast<uint32>(B_INT32_TYPE), info.type);
	EXPECT_EQ(4, info.size);
	int32 read = 0;
	EXPECT_EQ(4, again.ReadAttr("number", B_INT32_TYPE, 0, &read, 4));
	EXPECT_EQ(42, read);
	char text[3] = {};
	EXPECT_EQ(2, again.ReadAttr("text", B_STRING_TYPE, 3, text, 2));
	EXPECT_STREQ("lo", text);
	EXPECT_EQ(0, again.ReadAttr("text", B_STRING_TYPE, 99, text, 2));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, again.ReadAttr("none", B_STRING_TYPE, 0, text, 2));
	EXPECT_EQ(B_BAD_VALUE, again.ReadAttr(NULL, B_STRING_TYPE, 0, text, 2));
	EXPECT_EQ(B_NAME_TOO_LONG, again.RemoveAttr(std::string(300, 'n').c_str()));
}


TEST(BNode, WritingAttributesAtAnOffsetKeepsTheRest)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "");
	BNode node((folder / "file").c_str());
	ASSERT_EQ(6, node.WriteAttr("text", B_RAW_TYPE, 0, "abcdef", 6));
	ASSERT_EQ(2, node.WriteAttr("text", B_RAW_TYPE, 2, "XY", 2));
	ASSERT_EQ(1, node.WriteAttr("text", B_RAW_TYPE, 8, "Z", 1));
	char text[10] = {};
	EXPECT_EQ(9, node.ReadAttr("text", B_RAW_TYPE, 0, text, 10));
	EXPECT_EQ(std::string("abXYef\0\0Z", 9), std::string(text, 9));
	ASSERT_EQ(2, node.WriteAttr("text", B_RAW_TYPE, 0, "no", 2));
	EXPECT_EQ(2, node.ReadAttr("text", B_RAW_TYPE, 0, text, 10));
}


TEST(BNode, AttributesAreListedRenamedAndRemoved)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "");
	BNode node((folder / "file").c_str());
	for (const char* name : { "a", "b", "BEOS:TYPE" })
		ASSERT_EQ(1, node.WriteAttr(name, B_RAW_TYPE, 0, "x", 1));
	ASSERT_EQ(B_OK, node.RenameAttr("b", "c"));
	ASSERT_EQ(B_OK, node.RemoveAttr("a"));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.RemoveAttr("a"));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.RenameAttr("a", "d"));
	std::set<std::string> names;
	char name[B_ATTR_NAME_LENGTH + 1];
	while (node.GetNextAttrName(name) == B_OK)
		names.insert(name);
	EXPECT_EQ((std::set<std::string> { "c", "BEOS:TYPE" }), names);
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.GetNextAttrName(name));
	ASSERT_EQ(B_OK, node.RewindAttrs());
	EXPECT_EQ(B_OK, node.GetNextAttrName(name));

	BString text;
	const BString hello("hello");
	ASSERT_EQ(B_OK, node.WriteAttrString("string", &hello));
	ASSERT_EQ(B_OK, node.ReadAttrString("string", &text));
	EXPECT_STREQ("hello", text.String());
}


TEST(BNode, ALinkIsNotFollowed)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	ASSERT_EQ(0, symlink("file", (folder / "link").c_str()));
	const BNode node((folder / "link").c_str());
	EXPECT_TRUE(node.IsSymLink());
	BSymLink link((folder / "link").c_str());
	char text[3];
	EXPECT_EQ(4, link.ReadLink(text, sizeof(text)));
	EXPECT_STREQ("fi", text);
	EXPECT_FALSE(link.IsAbsolute());
	BPath path;
	EXPECT_LT(0, link.MakeLinkedPath(folder.Path().c_str(), &path));
	EXPECT_EQ(folder / "file", path.Path());
	const BFile file((folder / "link").c_str(), B_READ_ONLY);
	EXPECT_TRUE(file.IsFile());
}


TEST(BNode, LockKeepsOthersOut)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	BFile first((folder / "file").c_str(), B_READ_WRITE);
	BFile second((folder / "file").c_str(), B_READ_WRITE);
	ASSERT_EQ(B_OK, first.Lock());
	EXPECT_EQ(B_BUSY, second.Lock());
	ASSERT_EQ(B_OK, first.Unlock());
	EXPECT_EQ(B_OK, second.Lock());
}


TEST(BNode, IsLockedAndUnlockedOnce)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	BNode node((folder / "file").c_str());
	EXPECT_EQ(B_BAD_VALUE, node.Unlock());
	EXPECT_EQ(B_OK, node.Lock());
	EXPECT_EQ(B_BUSY, node.Lock());
	EXPECT_EQ(B_OK, node.Unlock());
	EXPECT_EQ(B_BAD_VALUE, node.Unlock());
	EXPECT_EQ(B_OK, node.Lock());
}


TEST(BNode, WithoutAFileNothingCanBeDone)
{
	BNode node;
	BString text;
	char buffer[B_ATTR_NAME_LENGTH + 1];
	attr_info info;
	EXPECT_EQ(B_FILE_ERROR, node.Lock());
	EXPECT_EQ(B_FILE_ERROR, node.Unlock());
	EXPECT_EQ(B_FILE_ERROR, node.Sync());
	EXPECT_EQ(B_FILE_ERROR, node.WriteAttr("a", B_RAW_TYPE, 0, "x", 1));
	EXPECT_EQ(B_FILE_ERROR, node.ReadAttr("a", B_RAW_TYPE, 0, buffer, 1));
	EXPECT_EQ(B_FILE_ERROR, node.RemoveAttr("a"));
	EXPECT_EQ(B_FILE_ERROR, node.RenameAttr("a", "b"));
	EXPECT_EQ(B_FILE_ERROR, node.GetAttrInfo("a", &info));
	EXPECT_EQ(B_FILE_ERROR, node.GetNextAttrName(buffer));
	EXPECT_EQ(B_FILE_ERROR, node.RewindAttrs());
	EXPECT_EQ(B_FILE_ERROR, node.ReadAttrString("a", &text));
	EXPECT_EQ(B_BAD_VALUE, node.SetTo((const char*)NULL));

	BDirectory directory;
	entry_ref ref;
	EXPECT_EQ(B_FILE_ERROR, directory.GetNextRef(&ref));
	EXPECT_EQ(B_FILE_ERROR, directory.Rewind());
	EXPECT_EQ(B_FILE_ERROR, directory.CountEntries());
}


TEST(BNode, StatFieldsCanBeSet)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	BNode node((folder / "file").c_str());
	EXPECT_EQ(B_OK, node.SetPermissions(0640));
	mode_t mode = 0;
	EXPECT_EQ(B_OK, node.GetPermissions(&mode));
	EXPECT_EQ(0640u, mode);
	EXPECT_EQ(B_OK, node.SetModificationTime(1000000));
	time_t time = 0;
	EXPECT_EQ(B_OK, node.GetModificationTime(&time));
	EXPECT_EQ(1000000, time);
	EXPECT_EQ(B_UNSUPPORTED, node.SetCreationTime(5));
	off_t size = 0;
	EXPECT_EQ(B_OK, node.GetSize(&size));
	EXPECT_EQ(5, size);
	EXPECT_EQ(B_BAD_VALUE, node.GetSize(NULL));
	BNode same((folder / "file").c_str());
	EXPECT_TRUE(node == same);
	EXPECT_TRUE(node != BNode(folder.Path().c_str()));
}


TEST(BNode, ErrorsSayWhatIsWrong)
{
	TemporaryFolder folder;
	BNode node;
	EXPECT_EQ(B_NO_INIT, node.InitCheck());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, node.SetTo((folder / "none").c_str()));
	EXPECT_EQ(B_BAD_VALUE, node.SetTo((const BEntry*)NULL));
	struct stat stat;
	EXPECT_EQ(B_BAD_VALUE, node.GetStat(&stat));
	EXPECT_EQ(B_BAD_VALUE, node.InitCheck());
}


TEST(BFile, ReadsAndWritesAtItsPosition)
{
	TemporaryFolder folder;
	BFile file((folder / "file").c_str(), B_READ_WRITE | B_CREATE_FILE);
	ASSERT_EQ(B_OK, file.InitCheck());
	EXPECT_EQ(10, file.Write("0123456789", 10));
	EXPECT_EQ(10, file.Position());
	EXPECT_EQ(2, file.Seek(2, SEEK_SET));
	char buffer[20] = {};
	EXPECT_EQ(3, file.Read(buffer, 3));
	EXPECT_STREQ("234", buffer);
	EXPECT_EQ(2, file.WriteAt(4, "XY", 2));
	EXPECT_EQ(5, file.Position());
	EXPECT_EQ(10, file.ReadAt(0, buffer, 20));
	EXPECT_STREQ("0123XY6789", buffer);
	EXPECT_EQ(B_OK, file.SetSize(3));
	EXPECT_EQ(0, file.Read(buffer, 5));
	EXPECT_EQ(B_BAD_VALUE, file.ReadAt(-1, buffer, 5));
	EXPECT_EQ("012", ReadFile(folder / "file"));
}


TEST(BFile, OpenModesDecide)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	const std::string path = folder / "file";
	BFile file(path.c_str(), B_READ_ONLY);
	EXPECT_TRUE(file.IsReadable());
	EXPECT_FALSE(file.IsWritable());
	EXPECT_EQ(B_NOT_ALLOWED, file.Write("x", 1));
	EXPECT_EQ(B_NOT_ALLOWED, file.WriteAt(0, "x", 1));
	EXPECT_EQ(
		B_FILE_EXISTS, file.SetTo(path.c_str(), B_WRITE_ONLY | B_CREATE_FILE | B_FAIL_IF_EXISTS));
	EXPECT_EQ(B_OK, file.SetTo(path.c_str(), B_WRITE_ONLY | B_OPEN_AT_END));
	EXPECT_EQ(1, file.Write("!", 1));
	EXPECT_EQ("bytes!", ReadFile(path));
	char byte;
	EXPECT_EQ(B_NOT_ALLOWED, file.Read(&byte, 1));
	EXPECT_EQ(B_NOT_ALLOWED, file.ReadAt(0, &byte, 1));
	BDirectory directory(folder.Path().c_str());
	EXPECT_EQ(B_OK, file.SetTo(&directory, "file", B_READ_WRITE | B_ERASE_FILE));
	EXPECT_EQ("", ReadFile(path));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, file.SetTo((folder / "none").c_str(), B_READ_WRITE));
	EXPECT_EQ(B_IS_A_DIRECTORY, file.SetTo(folder.Path().c_str(), B_READ_WRITE));
}


TEST(BFile, CopiesShareTheFile)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	BFile copy;
	{
		BFile file((folder / "file").c_str(), B_READ_ONLY);
		copy = file;
	}
	char buffer[8] = {};
	EXPECT_EQ(5, copy.Read(buffer, 8));
	EXPECT_STREQ("bytes", buffer);
}


TEST(BNodeInfo, TypeIsAnAttribute)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	BFile file((folder / "file").c_str(), B_READ_WRITE);
	BNodeInfo info(&file);
	ASSERT_EQ(B_OK, info.SetType("application/x-tamvex-resource"));
	char type[B_MIME_TYPE_LENGTH + 1];
	ASSERT_EQ(B_OK, info.GetType(type));
	EXPECT_STREQ("application/x-tamvex-resource", type);
	attr_info attribute;
	ASSERT_EQ(B_OK, file.GetAttrInfo("BEOS:TYPE", &attribute));
	EXPECT_EQ(static_cast<uint32>('MIMS'), attribute.type);
	EXPECT_EQ(B_OK, info.SetType(NULL));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, file.GetAttrInfo("BEOS:TYPE", &attribute));
	EXPECT_EQ(B_BAD_VALUE, info.SetType(std::string(300, 't').c_str()));
	EXPECT_EQ(B_BAD_VALUE, BNodeInfo(NULL).InitCheck());
}


TEST(BNodeInfo, PreferredAppAndHintAreKept)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	WriteFile(folder / "app", "bytes");
	BNode node((folder / "file").c_str());
	BNodeInfo info(&node);
	char signature[B_MIME_TYPE_LENGTH + 1];
	EXPECT_EQ(B_ENTRY_NOT_FOUND, info.GetPreferredApp(signature));
	ASSERT_EQ(B_OK, info.SetPreferredApp("application/x-vnd.Some-App"));
	ASSERT_EQ(B_OK, info.GetPreferredApp(signature));
	EXPECT_STREQ("application/x-vnd.Some-App", signature);
	entry_ref app;
	ASSERT_EQ(B_OK, get_ref_for_path((folder / "app").c_str(), &app));
	ASSERT_EQ(B_OK, info.SetAppHint(&app));
	entry_ref hint;
	ASSERT_EQ(B_OK, info.GetAppHint(&hint));
	EXPECT_TRUE(app == hint);
}
