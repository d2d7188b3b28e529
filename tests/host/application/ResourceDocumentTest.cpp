#include "host/application/ResourceDocument.h"

#include <sys/stat.h>

#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>

#include <gtest/gtest.h>

#include "host/library/ResourceAddonBase.h"

using namespace BResEditor;

namespace {


std::string
PathOf(const char* name)
{
	return testing::TempDir() + "archway-document-" + name;
}


std::string
BytesOf(const std::string& path)
{
	std::ifstream file(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}


BResourceHandle
Add(ResourceDocument& document, int32 id, const std::string& data)
{
	BResourceAddonBase user(BResourceAddonArgs { &document });
	BResourceHandle handle;
	BResourceCollection* collection = user.WriteLock("Add");
	collection->AddItem(&handle, 'TEXT', id, "name", data.data(), data.size());
	user.WriteUnlock(collection);
	return handle;
}


std::string
DataOf(const ResourceDocument& document, int32 id)
{
	const BResourceItem* item = document.Item(document.FindItem('TEXT', id));
	return item != nullptr ? std::string(static_cast<const char*>(item->Data()), item->Size())
						   : "none";
}


} // namespace


TEST(ResourceDocument, ComesBackAsItWasSaved)
{
	const std::string path = PathOf("saved.rsrc");
	remove(path.c_str());
	ResourceDocument document;
	Add(document, 1, "one");
	Add(document, 2, "");
	EXPECT_TRUE(document.IsModified());
	EXPECT_EQ(B_NO_INIT, document.Save());
	ASSERT_EQ(B_OK, document.SaveAs(path.c_str()));
	EXPECT_FALSE(document.IsModified());

	ResourceDocument again;
	ASSERT_EQ(B_OK, again.Load(path.c_str()));
	EXPECT_EQ(2, again.CountItems());
	EXPECT_EQ("one", DataOf(again, 1));
	EXPECT_EQ("", DataOf(again, 2));
	EXPECT_FALSE(again.IsModified());
	EXPECT_FALSE(again.IsChangedOnDisk());
}


TEST(ResourceDocument, SavingOverAnotherFileReplacesItsItems)
{
	const std::string path = PathOf("other.rsrc");
	remove(path.c_str());
	ResourceDocument other;
	Add(other, 7, "theirs");
	ASSERT_EQ(B_OK, other.SaveAs(path.c_str()));

	ResourceDocument document;
	Add(document, 1, "ours");
	ASSERT_EQ(B_OK, document.SaveAs(path.c_str()));
	ResourceDocument again;
	ASSERT_EQ(B_OK, again.Load(path.c_str()));
	EXPECT_EQ(1, again.CountItems());
	EXPECT_EQ("ours", DataOf(again, 1));
	EXPECT_TRUE(other.IsChangedOnDisk());
}


TEST(ResourceDocument, SavingOverAnyFileReplacesIt)
{
	const std::string path = PathOf("notes.txt");
	std::ofstream(path, std::ios::binary) << "no resources, but somebody's notes";
	chmod(path.c_str(), 0640);
	ResourceDocument document;
	Add(document, 1, "ours");
	ASSERT_EQ(B_OK, document.SaveAs(path.c_str()));
	EXPECT_FALSE(document.IsModified());
	ResourceDocument again;
	ASSERT_EQ(B_OK, again.Load(path.c_str()));
	EXPECT_EQ("ours", DataOf(again, 1));
	struct stat stat;
	ASSERT_EQ(0, ::stat(path.c_str(), &stat));
	EXPECT_EQ(0640u, stat.st_mode & 07777);
}


// Where an executable ends that is cut off, nobody knows: nothing may be written over it.
TEST(ResourceDocument, AFailedSaveLeavesTheOtherFileAlone)
{
	const std::string path = PathOf("program");
	const std::string program = "\177ELF\002\001\001, cut off";
	std::ofstream(path, std::ios::binary) << program;
	ResourceDocument document;
	Add(document, 1, "ours");
	EXPECT_NE(B_OK, document.SaveAs(path.c_str()));
	EXPECT_EQ(program, BytesOf(path));
	EXPECT_NE(B_OK, document.SaveAs("/nowhere/at all/file.rsrc"));
	EXPECT_TRUE(document.IsModified());
}


TEST(ResourceDocument, UndoesAndRedoesSteps)
{
	ResourceDocument document;
	const BResourceHandle handle = Add(document, 1, "one");
	EXPECT_STREQ("Add", document.UndoName());
	{
		BResourceAddonBase user(BResourceAddonArgs { &document });
		BResourceCollection* collection = user.WriteLock("Change");
		collection->WriteItem(handle)->SetData("two", 3);
		user.WriteUnlock(collection);
	}
	EXPECT_STREQ("Change", document.UndoName());
	EXPECT_TRUE(document.Undo());
	EXPECT_EQ("one", DataOf(document, 1));
	EXPECT_STREQ("Change", document.RedoName());
	EXPECT_TRUE(document.Undo());
	EXPECT_EQ("none", DataOf(document, 1));
	EXPECT_FALSE(document.Undo());
	EXPECT_TRUE(document.Redo());
	EXPECT_TRUE(document.Redo());
	EXPECT_EQ("two", DataOf(document, 1));
	EXPECT_EQ(handle, document.FindItem('TEXT', 1));
	EXPECT_FALSE(document.Redo());
}
