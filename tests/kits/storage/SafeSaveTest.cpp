// Saves over files of other people and of other kinds: all or nothing, and told in time.
#include <grp.h>
#include <signal.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/types.h>
#include <sys/wait.h>
#include <unistd.h>

#include <functional>

#include <File.h>
#include <ResourceForm.h>
#include <Resources.h>

#include "TemporaryFolder.h"

namespace {

constexpr uid_t kOwner = 4001;
constexpr uid_t kOther = 4002;
constexpr gid_t kGroup = 4003;


std::string
MakeFile(const std::string& path)
{
	WriteFile(path, "");
	BResources resources(path.c_str());
	EXPECT_EQ(B_OK, resources.AddResource('TEXT', 1, "old", 3));
	EXPECT_EQ(B_OK, resources.Sync());
	return ReadFile(path);
}


struct stat
StatOf(const std::string& path)
{
	struct stat stat = {};
	EXPECT_EQ(0, lstat(path.c_str(), &stat));
	return stat;
}


status_t
SaveInto(const std::string& path)
{
	BResources resources(path.c_str());
	const status_t status = resources.AddResource('TEXT', 2, "new", 3);
	return status == B_OK ? resources.Sync() : status;
}


// What `work` answers when another user does it, in a process of its own.
status_t
AsUser(uid_t user, const std::function<status_t()>& work)
{
	int ends[2];
	EXPECT_EQ(0, pipe(ends));
	const pid_t child = fork();
	if (child == 0) {
		status_t status = B_ERROR;
		if (setgroups(0, nullptr) == 0 && setgid(kGroup) == 0 && setuid(user) == 0)
			status = work();
		const bool told = write(ends[1], &status, sizeof(status)) == sizeof(status);
		_exit(told ? 0 : 1);
	}
	close(ends[1]);
	status_t status = B_ERROR;
	EXPECT_EQ(ssize_t(sizeof(status)), read(ends[0], &status, sizeof(status)));
	close(ends[0]);
	int state = 0;
	EXPECT_EQ(child, waitpid(child, &state, 0));
	EXPECT_EQ(0, state);
	return status;
}

} // namespace


TEST(SafeSave, TheOwnerAndTheGroupStay)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "only the administrator may give files away";
	TemporaryFolder folder;
	const std::string path = folder / "theirs";
	MakeFile(path);
	ASSERT_EQ(0, chown(path.c_str(), kOwner, kGroup));
	ASSERT_EQ(0, chmod(path.c_str(), 04755));
	ASSERT_EQ(B_OK, SaveInto(path));
	const struct stat stat = StatOf(path);
	EXPECT_EQ(kOwner, stat.st_uid);
	EXPECT_EQ(kGroup, stat.st_gid);
	EXPECT_EQ(04755u, stat.st_mode & 07777);
}


TEST(SafeSave, AFileWhoseOwnerWouldChangeIsLeftAlone)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "only the administrator may be somebody else";
	TemporaryFolder folder;
	ASSERT_EQ(0, chmod(folder.Path().c_str(), 0777));
	const std::string path = folder / "theirs";
	const std::string before = MakeFile(path);
	ASSERT_EQ(0, chown(path.c_str(), kOwner, kGroup));
	ASSERT_EQ(0, chmod(path.c_str(), 0666));
	const ino_t node = StatOf(path).st_ino;

	EXPECT_EQ(B_NOT_ALLOWED, AsUser(kOther, [&] { return SaveInto(path); }));
	EXPECT_TRUE(before == ReadFile(path));
	EXPECT_EQ(node, StatOf(path).st_ino);
	EXPECT_EQ(1u, folder.Count());
}


TEST(SafeSave, AFolderThatTakesNoFileLeavesTheOldOne)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "only the administrator may be somebody else";
	TemporaryFolder folder;
	const std::string path = folder / "theirs";
	const std::string before = MakeFile(path);
	ASSERT_EQ(0, chown(path.c_str(), kOther, kGroup));
	ASSERT_EQ(0, chmod(folder.Path().c_str(), 0755));
	EXPECT_EQ(B_PERMISSION_DENIED, AsUser(kOther, [&] { return SaveInto(path); }));
	EXPECT_TRUE(before == ReadFile(path));
	EXPECT_EQ(1u, folder.Count());
}


TEST(SafeSave, AnyFileCanBeReplacedInOneStep)
{
	TemporaryFolder folder;
	WriteFile(folder / "text", "this is text");
	ASSERT_EQ(0, chmod((folder / "text").c_str(), 0640));
	BResources resources;
	ASSERT_EQ(B_OK, resources.AddResource('TEXT', 1, "one", 3));
	BFile text((folder / "text").c_str(), B_READ_WRITE);
	ASSERT_EQ(B_OK, write_resources_over(&resources, &text));
	EXPECT_EQ(0640u, StatOf(folder / "text").st_mode & 07777);
	BResources again((folder / "text").c_str());
	EXPECT_TRUE(again.HasResource('TEXT', 1));

	// A damaged resource file too, whose own parts are no longer believed.
	std::string damaged = ReadFile(folder / "text");
	damaged.resize(damaged.size() - 5);
	WriteFile(folder / "damaged", damaged);
	BFile file((folder / "damaged").c_str(), B_READ_WRITE);
	ASSERT_EQ(B_OK, write_resources_over(&resources, &file));
	EXPECT_TRUE(ReadFile(folder / "text") == ReadFile(folder / "damaged"));
}


TEST(SafeSave, AProgramKeepsItsOwnPart)
{
	TemporaryFolder folder;
	// The smallest 64-bit header that says of itself that nothing follows.
	std::string elf("\x7f"
					"ELF\x02\x01\x01",
		7);
	elf.resize(67, 'x');
	std::fill(elf.begin() + 16, elf.begin() + 64, '\0');
	elf[52] = 64;
	WriteFile(folder / "program", elf);
	BResources resources;
	ASSERT_EQ(B_OK, resources.AddResource('TEXT', 1, "one", 3));
	BFile program((folder / "program").c_str(), B_READ_WRITE);
	ASSERT_EQ(B_OK, write_resources_over(&resources, &program));
	EXPECT_EQ(elf.substr(0, 64), ReadFile(folder / "program").substr(0, 64));

	// Of one that is cut off nobody knows where it ends.
	WriteFile(folder / "cut", elf.substr(0, 20));
	BFile cut((folder / "cut").c_str(), B_READ_WRITE);
	EXPECT_NE(B_OK, write_resources_over(&resources, &cut));
	EXPECT_EQ(elf.substr(0, 20), ReadFile(folder / "cut"));
}


TEST(SafeSave, AFailedSyncIsNotTriedAgainAtTheEnd)
{
	TemporaryFolder folder;
	const std::string path = folder / "file";
	const std::string before = MakeFile(path);
	struct rlimit limit;
	ASSERT_EQ(0, getrlimit(RLIMIT_FSIZE, &limit));
	const struct rlimit none = { 0, limit.rlim_max };
	const auto handler = signal(SIGXFSZ, SIG_IGN);
	{
		BResources resources(path.c_str());
		resources.AddResource('TEXT', 2, "new", 3);
		ASSERT_EQ(0, setrlimit(RLIMIT_FSIZE, &none));
		EXPECT_NE(B_OK, resources.Sync());
		ASSERT_EQ(0, setrlimit(RLIMIT_FSIZE, &limit));
	}
	EXPECT_TRUE(before == ReadFile(path));
	{
		BResources resources(path.c_str());
		resources.AddResource('TEXT', 2, "new", 3);
		ASSERT_EQ(0, setrlimit(RLIMIT_FSIZE, &none));
		EXPECT_NE(B_OK, resources.Sync());
		ASSERT_EQ(0, setrlimit(RLIMIT_FSIZE, &limit));
		EXPECT_EQ(B_OK, resources.Sync()) << "but may be tried again by hand";
	}
	EXPECT_FALSE(before == ReadFile(path));
	signal(SIGXFSZ, handler);
}


TEST(SafeSave, AFailedWritingIsNotTriedAgain)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "only the administrator may be somebody else";
	TemporaryFolder folder;
	const std::string path = folder / "file";
	const std::string before = MakeFile(path);
	ASSERT_EQ(0, chown(path.c_str(), kOther, kGroup));
	ASSERT_EQ(0, chmod(folder.Path().c_str(), 0755));
	const status_t status = AsUser(kOther, [&] {
		BFile file(path.c_str(), B_READ_WRITE);
		BResources resources;
		resources.AddResource('TEXT', 3, "three", 5);
		const status_t written = resources.WriteTo(&file);
		return written != B_OK && resources.File().InitCheck() == B_OK ? B_ERROR : written;
	});
	EXPECT_EQ(B_PERMISSION_DENIED, status);
	EXPECT_TRUE(before == ReadFile(path));
}
