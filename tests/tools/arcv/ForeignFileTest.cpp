// What a person is told about a file that belongs to somebody else.

#include <grp.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include "Program.h"
#include "kits/storage/TemporaryFolder.h"

namespace {

constexpr uid_t kOwner = 4001;
constexpr uid_t kOther = 4002;


// Runs the program as another user and keeps what it says.
int
RunAs(uid_t user, const std::vector<std::string>& arguments, const std::string& errors)
{
	const pid_t child = fork();
	if (child == 0) {
		if (setgroups(0, nullptr) != 0 || setgid(user) != 0 || setuid(user) != 0)
			_exit(100);
		const ProgramResult result = RunArcv(arguments);
		WriteFile(errors, result.errors);
		_exit(result.status);
	}
	int state = 0;
	EXPECT_EQ(child, waitpid(child, &state, 0));
	EXPECT_TRUE(WIFEXITED(state));
	return WEXITSTATUS(state);
}

} // namespace


TEST(ForeignFile, IsLeftAloneAndTheReasonIsTold)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "only the administrator may be somebody else";
	TemporaryFolder folder;
	if (RunAs(kOther, { "--help" }, "/dev/null") != 0)
		GTEST_SKIP() << "the program lies where nobody else may go";
	ASSERT_EQ(0, chmod(folder.Path().c_str(), 0777));
	const std::string path = folder / "theirs.rsrc";
	const std::string before = ReadFile(ARCHWAY_TEST_DATA "/resources/51-ids-and-names.rsrc");
	WriteFile(path, before);
	WriteFile(folder / "data", "data");
	ASSERT_EQ(0, chown(path.c_str(), kOwner, kOwner));
	ASSERT_EQ(0, chmod(path.c_str(), 0666));

	EXPECT_EQ(3, RunAs(kOther, { "insert", path, "NEW!:1", folder / "data" }, folder / "errors"));
	EXPECT_EQ(
		"arcv: " + path + ": the file is read-only, or its owner and group could not be kept\n",
		ReadFile(folder / "errors"));
	EXPECT_TRUE(before == ReadFile(path));
	struct stat stat;
	ASSERT_EQ(0, ::stat(path.c_str(), &stat));
	EXPECT_EQ(kOwner, stat.st_uid);
	EXPECT_EQ(3u, folder.Count());
}
