// A save that fails, or ends the program, at each of the calls that it makes.

#include <errno.h>
#include <signal.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <set>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Program.h"
#include "kits/storage/TemporaryFolder.h"

using testing::HasSubstr;

namespace {

const std::string kFile = ARCHWAY_TEST_DATA "/resources/51-ids-and-names.rsrc";
constexpr int kMostCalls = 2000;

struct Interruption {
	TemporaryFolder folder;
	std::string before = ReadFile(kFile);
	std::string after;
	int points = 0; // calls that failed

	Interruption()
	{
		WriteFile(folder / "data", std::string(3000, 'd'));
		const std::string target = _Prepare();
		EXPECT_EQ(0, _Save(target, {}).status);
		after = ReadFile(target);
		EXPECT_FALSE(before == after);
	}

	// Saves with call after call failing, until a save comes to its end before that call.
	void Run(const std::string& how)
	{
		for (int call = 1; call < kMostCalls; call++) {
			const std::string target = _Prepare();
			const ProgramResult result = _SaveWith(target, call, how);
			const std::string report = ReadFile(folder / "report");
			if (report.empty())
				return;
			points++;
			_Judge(target, how, report, result);
			if (testing::Test::HasFailure())
				return;
		}
		ADD_FAILURE() << "the saves have no end";
	}

	// Saves with the call of that name failing; the file is old and has its attribute then.
	ProgramResult FailAt(const std::string& name, int error)
	{
		for (int call = 1; call < kMostCalls; call++) {
			const std::string target = _Prepare();
			const ProgramResult result = _SaveWith(target, call, std::to_string(error));
			const std::string report = ReadFile(folder / "report");
			if (report == name) {
				EXPECT_TRUE(ReadFile(target) == before);
				char value[8] = {};
				EXPECT_EQ(5, getxattr(target.c_str(), "user.test", value, sizeof(value)));
				EXPECT_STREQ("value", value);
				return result;
			}
			if (report.empty())
				break;
		}
		ADD_FAILURE() << "no save calls " << name;
		return {};
	}

	// Whether the file system of the tests has such attributes at all.
	bool HasAttributes()
	{
		const std::string target = _Prepare();
		return getxattr(target.c_str(), "user.test", NULL, 0) == 5;
	}

private:
	// What is loaded before the program anyway stays so.
	static std::string _Preload()
	{
		const char* others = getenv("LD_PRELOAD");
		const std::string own = "LD_PRELOAD=" ARCHWAY_FAILING_CALLS;
		return others != NULL && others[0] != '\0' ? own + ":" + others : own;
	}

	// The address sanitizer minds libraries that are loaded before its own, unless it is told.
	static std::string _SanitizerOptions()
	{
		const char* others = getenv("ASAN_OPTIONS");
		const std::string own = "ASAN_OPTIONS=verify_asan_link_order=0";
		return others != NULL && others[0] != '\0' ? own + ":" + others : own;
	}

	// A folder with nothing but the file in it.
	std::string _Prepare()
	{
		std::filesystem::remove_all(folder / "place");
		std::filesystem::create_directory(folder / "place");
		WriteFile(folder / "place/file.rsrc", before);
		setxattr((folder / "place/file.rsrc").c_str(), "user.test", "value", 5, 0);
		return folder / "place/file.rsrc";
	}

	ProgramResult _Save(const std::string& target, const std::vector<std::string>& environment)
	{
		return RunArcv({ "insert", target, "NEW!:1", folder / "data" }, environment);
	}

	ProgramResult _SaveWith(const std::string& target, int call, const std::string& how)
	{
		unlink((folder / "report").c_str());
		return _Save(target,
			{ _Preload(), _SanitizerOptions(), "FAILING_CALL=" + std::to_string(call),
				"FAILING_HOW=" + how, "FAILING_REPORT=" + (folder / "report") });
	}

	void _Judge(const std::string& target, const std::string& how, const std::string& call,
		const ProgramResult& result)
	{
		SCOPED_TRACE(how + " at " + call + ", the failure number " + std::to_string(points));
		const std::string now = ReadFile(target);
		EXPECT_TRUE(now == before || now == after);
		// What can be done again or continued is no failure. Other calls are never interrupted.
		const std::set<std::string> repeatable = { "open", "openat", "read", "pread", "write",
			"fsync" };
		if (how == "short" || (how == std::to_string(EINTR) && repeatable.count(call) != 0)) {
			EXPECT_EQ(0, result.status) << result.errors;
		}
		EXPECT_TRUE(result.status == 0 || result.status == 3 || result.status == 128 + SIGKILL)
			<< result.status << result.errors;
		if (result.status == 0) {
			EXPECT_TRUE(now == after);
		} else if (result.status == 3) {
			EXPECT_FALSE(result.errors.empty());
		}
		// Only what cannot be cleaned up may stay.
		size_t names = 0;
		for (const auto& entry : std::filesystem::directory_iterator(folder / "place")) {
			(void)entry;
			names++;
		}
		if (how != "kill" && call != "unlinkat") {
			EXPECT_EQ(1u, names);
		}
	}
};

} // namespace


TEST(InterruptedSave, KilledAtAnyCallTheFileIsOldOrNew)
{
	Interruption interruption;
	interruption.Run("kill");
	EXPECT_GT(interruption.points, 30);
	RecordProperty("points", interruption.points);
}


TEST(InterruptedSave, WithoutSpaceTheFileIsOldOrNew)
{
	Interruption interruption;
	interruption.Run(std::to_string(ENOSPC));
	EXPECT_GT(interruption.points, 30);
	RecordProperty("points", interruption.points);
}


TEST(InterruptedSave, WithBrokenHardwareTheFileIsOldOrNew)
{
	Interruption interruption;
	interruption.Run(std::to_string(EIO));
	EXPECT_GT(interruption.points, 30);
	RecordProperty("points", interruption.points);
}


TEST(InterruptedSave, InterruptedCallsAreRepeated)
{
	Interruption interruption;
	interruption.Run(std::to_string(EINTR));
	EXPECT_GT(interruption.points, 30);
	RecordProperty("points", interruption.points);
}


TEST(InterruptedSave, ShortTransfersAreContinued)
{
	Interruption interruption;
	interruption.Run("short");
	EXPECT_GT(interruption.points, 30);
	RecordProperty("points", interruption.points);
}


// As on file systems, or for files, that take no attributes from this user.
TEST(InterruptedSave, AttributesThatCannotBeKeptAreToldAndTheFileIsLeftAlone)
{
	Interruption interruption;
	if (!interruption.HasAttributes())
		GTEST_SKIP() << "the file system has no attributes";
	for (const int error : { EPERM, EACCES, ENOTSUP }) {
		SCOPED_TRACE(error);
		const ProgramResult result = interruption.FailAt("fsetxattr", error);
		EXPECT_EQ(3, result.status);
		EXPECT_EQ("arcv: " + (interruption.folder / "place/file.rsrc")
				+ ": the file's attributes could not be kept\n",
			result.errors);
	}
	EXPECT_THAT(interruption.FailAt("fsetxattr", ENOSPC).errors, HasSubstr("no space is left"));
}
