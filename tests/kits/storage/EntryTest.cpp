#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <set>

#include <Directory.h>
#include <Entry.h>
#include <File.h>
#include <FindDirectory.h>
#include <Path.h>
#include <SymLink.h>
#include <TypeConstants.h>
#include <Volume.h>
#include <VolumeRoster.h>

#include "TemporaryFolder.h"

TEST(BEntry, ExistsOrNotItHasAPath)
{
	TemporaryFolder folder;
	BEntry entry((folder / "none").c_str());
	ASSERT_EQ(B_OK, entry.InitCheck());
	EXPECT_FALSE(entry.Exists());
	BPath path;
	ASSERT_EQ(B_OK, entry.GetPath(&path));
	EXPECT_EQ(folder / "none", path.Path());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, entry.SetTo((folder / "none/deeper").c_str()));
	EXPECT_EQ(B_BAD_VALUE, entry.SetTo((const char*)NULL));
	EXPECT_EQ(B_NAME_TOO_LONG, entry.SetTo((folder / std::string(256, 'n')).c_str()));
}


TEST(BEntry, RefsLeadBackToTheFile)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path((folder / "file").c_str(), &ref));
	EXPECT_STREQ("file", ref.name);
	entry_ref copy(ref);
	EXPECT_TRUE(copy == ref);
	const BEntry entry(&copy);
	EXPECT_TRUE(entry.Exists());
	const BPath path(&copy);
	EXPECT_EQ(folder / "file", path.Path());
	BFile file(&copy, B_READ_ONLY);
	EXPECT_EQ(B_OK, file.InitCheck());
	copy.set_name("other");
	EXPECT_TRUE(copy != ref);
	EXPECT_TRUE(ref < copy);
	const entry_ref unknown(1, 1, "x");
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BEntry(&unknown).InitCheck());
	copy.set_name("../x");
	EXPECT_EQ(B_BAD_VALUE, BEntry(&copy).InitCheck());
}


TEST(BEntry, StaysValidWhenItsDirectoryMoves)
{
	TemporaryFolder folder;
	mkdir((folder / "a").c_str(), 0700);
	WriteFile(folder / "a/file", "bytes");
	BEntry entry((folder / "a/file").c_str());
	ASSERT_EQ(0, rename((folder / "a").c_str(), (folder / "b").c_str()));
	EXPECT_TRUE(entry.Exists());
	BPath path;
	ASSERT_EQ(B_OK, entry.GetPath(&path));
	EXPECT_EQ(folder / "b/file", path.Path());
}


TEST(BEntry, LinksAreFollowedOnlyWhenAsked)
{
	TemporaryFolder folder;
	WriteFile(folder / "file", "bytes");
	ASSERT_EQ(0, symlink("file", (folder / "one").c_str()));
	ASSERT_EQ(0, symlink((folder / "one").c_str(), (folder / "two").c_str()));
	ASSERT_EQ(0, symlink("loop", (folder / "loop").c_str()));
	EXPECT_TRUE(BEntry((folder / "two").c_str()).IsSymLink());
	BEntry entry((folder / "two").c_str(), true);
	EXPECT_TRUE(entry.IsFile());
	char name[B_FILE_NAME_LENGTH + 1];
	ASSERT_EQ(B_OK, entry.GetName(name));
	EXPECT_STREQ("file", name);
	EXPECT_EQ(B_LINK_LIMIT, entry.SetTo((folder / "loop").c_str(), true));
}


TEST(BEntry, ParentsGoUpToTheRoot)
{
	TemporaryFolder folder;
	BEntry entry((folder / "file").c_str());
	BEntry parent;
	ASSERT_EQ(B_OK, entry.GetParent(&parent));
	BPath path;
	ASSERT_EQ(B_OK, parent.GetPath(&path));
	EXPECT_EQ(folder.Path(), path.Path());
	int steps = 0;
	while (entry.GetParent(&entry) == B_OK)
		steps++;
	EXPECT_EQ(3, steps);
	BEntry root("/");
	char name[B_FILE_NAME_LENGTH + 1];
	ASSERT_EQ(B_OK, root.GetName(name));
	EXPECT_STREQ("/", name);
	BDirectory directory;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, root.GetParent(&directory));
	entry_ref ref;
	ASSERT_EQ(B_OK, root.GetRef(&ref));
	EXPECT_EQ(B_OK, BEntry(&ref).GetPath(&path));
	EXPECT_STREQ("/", path.Path());
}


TEST(BEntry, RenameSparesWhatIsThere)
{
	TemporaryFolder folder;
	WriteFile(folder / "a", "a");
	WriteFile(folder / "b", "b");
	BEntry entry((folder / "a").c_str());
	EXPECT_EQ(B_FILE_EXISTS, entry.Rename("b"));
	EXPECT_EQ("b", ReadFile(folder / "b"));
	EXPECT_EQ(B_OK, entry.Rename("b", true));
	EXPECT_EQ("a", ReadFile(folder / "b"));
	mkdir((folder / "d").c_str(), 0700);
	BDirectory directory((folder / "d").c_str());
	EXPECT_EQ(B_OK, entry.MoveTo(&directory));
	EXPECT_EQ("a", ReadFile(folder / "d/b"));
	BEntry full((folder / "d").c_str());
	EXPECT_EQ(B_DIRECTORY_NOT_EMPTY, full.Remove());
	EXPECT_EQ(B_OK, entry.Remove());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, entry.Remove());
	EXPECT_EQ(B_OK, full.Remove());
}


TEST(BDirectory, EntriesAreListed)
{
	TemporaryFolder folder;
	for (const char* name : { "a", "b", ".hidden" })
		WriteFile(folder / name, "x");
	BDirectory directory(folder.Path().c_str());
	EXPECT_EQ(3, directory.CountEntries());
	std::set<std::string> names;
	entry_ref ref;
	while (directory.GetNextRef(&ref) == B_OK) {
		names.insert(ref.name);
		EXPECT_TRUE(BEntry(&ref).Exists());
	}
	EXPECT_EQ((std::set<std::string> { "a", "b", ".hidden" }), names);
	BEntry entry;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, directory.GetNextEntry(&entry));
	ASSERT_EQ(B_OK, directory.Rewind());
	EXPECT_EQ(B_OK, directory.GetNextEntry(&entry));
	ASSERT_EQ(B_OK, directory.Rewind());
	char buffer[4096];
	int32 count = 0;
	int32 step;
	while (
		(step = directory.GetNextDirents(reinterpret_cast<struct dirent*>(buffer), 64, INT32_MAX))
		> 0)
		count += step;
	EXPECT_EQ(0, step);
	EXPECT_EQ(5, count); // with "." and ".."
}


TEST(BDirectory, ContainsKnowsFlavors)
{
	TemporaryFolder folder;
	mkdir((folder / "d").c_str(), 0700);
	WriteFile(folder / "d/file", "x");
	BDirectory directory(folder.Path().c_str());
	EXPECT_TRUE(directory.Contains("d"));
	EXPECT_TRUE(directory.Contains("d", B_DIRECTORY_NODE));
	EXPECT_FALSE(directory.Contains("d", B_FILE_NODE));
	EXPECT_TRUE(directory.Contains("d/file", B_FILE_NODE));
	EXPECT_FALSE(directory.Contains("none"));
	const BEntry outside("/proc/self/exe");
	EXPECT_FALSE(directory.Contains(&outside));
	BEntry found;
	EXPECT_EQ(B_OK, directory.FindEntry("d/file", &found));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, directory.FindEntry("none", &found));
	struct stat stat;
	EXPECT_EQ(B_OK, directory.GetStatFor("d/file", &stat));
	EXPECT_EQ(1, stat.st_size);
	EXPECT_TRUE(BDirectory("/").IsRootDirectory());
	EXPECT_FALSE(directory.IsRootDirectory());
}


TEST(BDirectory, MakesWhatIsAsked)
{
	TemporaryFolder folder;
	BDirectory directory(folder.Path().c_str());
	BDirectory made;
	ASSERT_EQ(B_OK, directory.CreateDirectory("d", &made));
	EXPECT_EQ(B_FILE_EXISTS, directory.CreateDirectory("d", NULL));
	BFile file;
	ASSERT_EQ(B_OK, made.CreateFile("file", &file));
	EXPECT_EQ(2, file.Write("xy", 2));
	EXPECT_EQ(B_FILE_EXISTS, made.CreateFile("file", NULL, true));
	EXPECT_EQ("xy", ReadFile(folder / "d/file"));
	EXPECT_EQ(B_OK, made.CreateFile("file", NULL));
	EXPECT_EQ("", ReadFile(folder / "d/file"));
	BSymLink link;
	ASSERT_EQ(B_OK, made.CreateSymLink("link", "file", &link));
	EXPECT_TRUE(link.IsSymLink());
	ASSERT_EQ(B_OK, create_directory((folder / "x/y/z").c_str(), 0700));
	EXPECT_EQ(B_OK, create_directory((folder / "x/y/z").c_str(), 0700));
	EXPECT_NE(B_OK, create_directory((folder / "d/file/z").c_str(), 0700));
	EXPECT_EQ(B_NOT_A_DIRECTORY, BDirectory((folder / "d/file").c_str()).InitCheck());
}


TEST(BPath, IsTidiedAndTakenApart)
{
	BPath path("/a//b/./c/../d/");
	EXPECT_STREQ("/a/b/d", path.Path());
	EXPECT_STREQ("d", path.Leaf());
	ASSERT_EQ(B_OK, path.Append("e/f"));
	EXPECT_STREQ("/a/b/d/e/f", path.Path());
	BPath parent;
	ASSERT_EQ(B_OK, path.GetParent(&parent));
	EXPECT_STREQ("/a/b/d/e", parent.Path());
	EXPECT_EQ(B_BAD_VALUE, path.Append("/absolute"));
	EXPECT_EQ(NULL, path.Path());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BPath("/").GetParent(&parent));
	EXPECT_EQ(B_BAD_VALUE, BPath("").InitCheck());
	EXPECT_TRUE(BPath("/..") == "/");
	const std::string relative = BPath("some/file").Path();
	char current[4096];
	EXPECT_EQ(std::string(getcwd(current, sizeof(current))) + "/some/file", relative);
}


TEST(BPath, NormalizingFollowsLinksOfTheFolder)
{
	TemporaryFolder folder;
	mkdir((folder / "real").c_str(), 0700);
	ASSERT_EQ(0, symlink("real", (folder / "link").c_str()));
	EXPECT_EQ(folder / "real/file", BPath((folder / "link/file").c_str(), NULL, true).Path());
	EXPECT_EQ(folder / "link/file", BPath((folder / "link/file").c_str()).Path());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BPath((folder / "none/file").c_str(), NULL, true).InitCheck());
}


TEST(BPath, FlattensToARef)
{
	TemporaryFolder folder;
	const BPath path((folder / "file").c_str());
	std::string bytes(path.FlattenedSize(), '\0');
	ASSERT_EQ(B_OK, path.Flatten(bytes.data(), bytes.size()));
	BPath again;
	ASSERT_EQ(B_OK, again.Unflatten(B_REF_TYPE, bytes.data(), bytes.size()));
	EXPECT_TRUE(path == again);
	for (size_t size = 0; size < bytes.size(); size++) {
		if (size == 12)
			continue; // the form of an unset path
		EXPECT_NE(B_OK, again.Unflatten(B_REF_TYPE, bytes.data(), size)) << size;
	}
	EXPECT_EQ(B_BAD_VALUE, again.Unflatten(B_STRING_TYPE, bytes.data(), bytes.size()));
}


TEST(FindDirectory, FollowsTheDesktopsConventions)
{
	TemporaryFolder folder;
	setenv("XDG_CONFIG_HOME", (folder / "config").c_str(), 1);
	BPath path;
	ASSERT_EQ(B_OK, find_directory(B_USER_SETTINGS_DIRECTORY, &path));
	EXPECT_EQ(folder / "config/archway", path.Path());
	EXPECT_FALSE(std::filesystem::exists(path.Path()));
	ASSERT_EQ(B_OK, find_directory(B_USER_SETTINGS_DIRECTORY, &path, true));
	EXPECT_TRUE(std::filesystem::is_directory(path.Path()));
	char small[4];
	EXPECT_EQ(
		B_NAME_TOO_LONG, find_directory(B_USER_SETTINGS_DIRECTORY, 0, false, small, sizeof(small)));
	EXPECT_EQ(B_UNSUPPORTED, find_directory(B_COMMON_SERVERS_DIRECTORY, &path));
	unsetenv("XDG_CONFIG_HOME");
}


TEST(BVolume, TellsAboutTheFileSystem)
{
	BVolume volume;
	ASSERT_EQ(B_OK, BNode("/").GetVolume(&volume));
	EXPECT_GT(volume.Capacity(), 0);
	EXPECT_LE(volume.FreeBytes(), volume.Capacity());
	BDirectory root;
	EXPECT_EQ(B_OK, volume.GetRootDirectory(&root));
	EXPECT_EQ(B_BAD_VALUE, BVolume(static_cast<dev_t>(-2)).InitCheck());
}


TEST(BVolumeRoster, GivesEachVolumeOnce)
{
	BVolumeRoster roster;
	BVolume boot;
	ASSERT_EQ(B_OK, roster.GetBootVolume(&boot));
	std::set<dev_t> devices;
	BVolume volume;
	while (roster.GetNextVolume(&volume) == B_OK) {
		EXPECT_EQ(B_OK, volume.InitCheck());
		EXPECT_TRUE(devices.insert(volume.Device()).second);
	}
	EXPECT_EQ(1u, devices.count(boot.Device()));
	EXPECT_EQ(B_BAD_VALUE, roster.GetNextVolume(&volume));
	roster.Rewind();
	EXPECT_EQ(B_OK, roster.GetNextVolume(&volume));
	EXPECT_EQ(B_BAD_VALUE, roster.GetNextVolume(NULL));
	EXPECT_EQ(B_BAD_VALUE, roster.GetBootVolume(NULL));
}
