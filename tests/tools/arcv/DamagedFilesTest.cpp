// The program on damaged files: an answer with a reason, never a crash, and nothing written.

#include <random>

#include <gtest/gtest.h>

#include "Program.h"
#include "kits/storage/TemporaryFolder.h"

namespace {

constexpr int kCases = 200;


std::string
Damage(std::string bytes, int number)
{
	std::mt19937 random(number);
	// The interesting places are the tables at both ends, and the messages behind the first.
	const size_t regions[][2] = { { 0, 400 }, { 1968, bytes.size() },
		{ bytes.size() - 300, bytes.size() } };
	const auto& region = regions[number % 3];
	const size_t place = region[0] + random() % (region[1] - region[0]);
	switch (number % 5) {
		case 0:
			bytes.resize(place);
			break;
		case 1:
			bytes[place] = static_cast<char>(random());
			break;
		case 2:
			bytes[place] ^= static_cast<char>(1 << random() % 8);
			break;
		case 3:
			bytes.replace(place, 4, random() % 2 == 0 ? "\xff\xff\xff\xff" : "\xff\xff\xff\x7f");
			break;
		default:
			bytes.insert(place, 1 + random() % 40, static_cast<char>(random()));
			break;
	}
	return bytes;
}


void
ExpectAnswer(const std::vector<std::string>& arguments)
{
	const ProgramResult result = RunArcv(arguments);
	EXPECT_TRUE(result.status == 0 || result.status == 1 || result.status == 3)
		<< arguments[0] << ": " << result.status << " " << result.errors;
	if (result.status == 3) {
		EXPECT_EQ(0u, result.errors.find("arcv: ")) << result.errors;
	}
}

} // namespace


TEST(DamagedFiles, EveryCommandAnswers)
{
	const std::string whole = ReadFile(ARCHWAY_TEST_DATA "/resources/50-many-types.rsrc");
	ASSERT_GT(whole.size(), 4000u);
	TemporaryFolder folder;
	const std::string path = folder / "file";
	for (int i = 0; i < kCases && !HasFailure(); i++) {
		SCOPED_TRACE(i);
		const std::string damaged = Damage(whole, i);
		WriteFile(path, damaged);
		ExpectAnswer({ "check", path });
		ExpectAnswer({ i % 2 == 0 ? "dump" : "rdef", path });
		if (i % 10 == 0) {
			ExpectAnswer({ "render", path, "-o", folder / "picture" });
			ExpectAnswer({ "diff", path, ARCHWAY_TEST_DATA "/resources/50-many-types.rsrc" });
			ExpectAnswer({ "convert", "--form", "haiku", path, "-o", folder / "converted" });
		}
		EXPECT_TRUE(damaged == ReadFile(path));
	}
}
