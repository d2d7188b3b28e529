// The design that is edited has menus of its own. Their shortcuts are part of the design only.

#include <gtest/gtest.h>

#include "scenarios/Archway.h"
#include "scenarios/Differences.h"
#include "scenarios/ScratchFolder.h"

namespace {


// Has a radio menu whose item "Colour 0" is chosen by Command and B.
constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/menu-shortcut.rsrc";
const std::string kOpen = "click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\n";
const std::string kSave = "key s with Command\nabsent window \"design.rsrc *\"\n";


std::map<std::string, std::string>
WhatChanges(const std::string& script)
{
	const ScratchFolder folder;
	const std::string file = folder.Copy(kDesign, "design.rsrc");
	const ProgramResult result = PlayText(kOpen + script + kSave, file);
	EXPECT_EQ(0, result.status) << result.errors << result.output;
	return DifferencesBetween(kDesign, file);
}


} // namespace


TEST(Shortcuts, OfTheDesignDoNothingInTheEditor)
{
	EXPECT_TRUE(WhatChanges("key b with Command\n").empty());
}


TEST(Shortcuts, OfTheEditorReachTheFieldThatHasTheKeyboard)
{
	const std::map<std::string, std::string> renamed = { { "ARCV:1/_name", "typed" } };
	EXPECT_EQ(renamed,
		WhatChanges("click EditView > \"Name: \"\n"
					"menu \"Edit\" \"Select All\"\n"
					"key x with Command\n"
					"type \"typed\"\n"));
}
