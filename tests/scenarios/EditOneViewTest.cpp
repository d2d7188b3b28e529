// From a file on disk to a file on disk: one view of a design is edited, and nothing else changes.

#include <gtest/gtest.h>

#include "scenarios/Archway.h"
#include "scenarios/Differences.h"
#include "scenarios/RealScreen.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc";
const std::string kButton = "ARCV:2/_views[0]/_views[0]/_views[0]/_views[0]/_views[0]/_views[0]/"
							"_views[0]/_views[0]";

// What the script and the person do.
const std::map<std::string, std::string> kEdits = {
	{ kButton + "/_name", "colour" },
	{ kButton + "/_frame", "[7.0,16.0,52.0,47.0]" },
};


} // namespace


TEST(EditOneView, HeadlessEditChangesExactlyThatViewsFields)
{
	const ScratchFolder folder;
	const std::string file = folder.Copy(kDesign, "design.rsrc");

	const ProgramResult result = PlayScript("edit-a-nested-button.play", file);

	EXPECT_EQ(0, result.status) << result.errors;
	EXPECT_EQ(kEdits, DifferencesBetween(kDesign, file));
}


TEST(EditOneView, EditInRealWindowsChangesExactlyThatViewsFields)
{
	if (!RealScreen::IsAvailable())
		GTEST_SKIP() << "needs Xvfb, openbox, xdotool, xprop and import";
	const RealScreen screen;
	ASSERT_TRUE(screen.IsRunning());
	const ScratchFolder folder;
	const std::string file = folder.Copy(kDesign, "design.rsrc");

	const ProgramResult result =
		PlayScript("edit-a-nested-button.play", file, screen.Environment());

	EXPECT_EQ(0, result.status) << result.errors;
	EXPECT_EQ(kEdits, DifferencesBetween(kDesign, file));
}
