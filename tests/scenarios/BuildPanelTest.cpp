// A whole panel built from nothing, saved and opened again; and each entry of the palette, from the
// palette through a file.

#include <algorithm>
#include <regex>

#include <gtest/gtest.h>

#include "scenarios/Archway.h"
#include "scenarios/RealScreen.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kReopen = R"(
click window "new.rsrc" > item "ARCV:1" times 2
wait window "ARCV 1"
tree WorkView > "The View"
)";


// A description of views without the places that they have on the screen.
std::string
WithoutScreen(const std::string& tree)
{
	std::string lines;
	const std::regex place(" screen [-0-9.,]+");
	const std::regex line("^ *\\w+ .*\\bframe [-0-9.,]+ screen .*$");
	for (size_t at = 0; at < tree.size();) {
		const size_t end = std::min(tree.find('\n', at), tree.size());
		const std::string text = tree.substr(at, end - at);
		if (std::regex_match(text, line))
			lines += std::regex_replace(text, place, "") + '\n';
		at = end + 1;
	}
	return lines;
}


// What the script prints about views, while the program's own traces go elsewhere.
std::string
Played(const ScratchFolder& folder, bool fromFile, const std::string& script,
	std::vector<std::string> environment)
{
	const std::string output = folder.Path("tree.txt");
	environment.push_back("ARCHWAY_PLAY_OUT=" + output);
	const std::string file = folder.Path("new.rsrc");
	const ProgramResult result =
		fromFile ? PlayScript(script, file, environment) : PlayText(script, file, environment);
	EXPECT_EQ(0, result.status) << result.errors;
	return WithoutScreen(BytesOf(output));
}


void
BuildAndReopen(const std::vector<std::string>& environment)
{
	const ScratchFolder folder;
	folder.Write("new.rsrc", "");
	const std::string built = Played(folder, true, "build-preferences.play", environment);
	EXPECT_EQ(18, std::count(built.begin(), built.end(), '\n')) << built;
	EXPECT_EQ(built, Played(folder, false, kReopen, environment));
}


} // namespace


TEST(BuildPanel, ByTheMouseAndFindItAgain)
{
	BuildAndReopen(kHeadless);
}


TEST(BuildPanel, ByTheMouseInRealWindowsAndFindItAgain)
{
	if (!RealScreen::IsAvailable())
		GTEST_SKIP() << "needs Xvfb, openbox, xdotool, xprop and import";
	const RealScreen screen;
	ASSERT_TRUE(screen.IsRunning());
	BuildAndReopen(screen.Environment());
}
