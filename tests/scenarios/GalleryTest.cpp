// Every control is used without a mouse, and a replicant with one.

#include <gtest/gtest.h>

#include "scenarios/Program.h"
#include "scenarios/RealScreen.h"

namespace {


const std::string kGallery = ARCHWAY_BINARIES "/gallery";
const std::string kScript = "ARCHWAY_PLAY=" ARCHWAY_PLAYS "/gallery-keyboard.play";
const std::string kReplicants = "ARCHWAY_PLAY=" ARCHWAY_PLAYS "/gallery-replicants.play";


} // namespace


TEST(Gallery, DragsAReplicantIntoItsShelf)
{
	const ProgramResult result = ::Run(
		{ kGallery }, { "ARCHWAY_BACKEND=headless", "QT_QPA_PLATFORM=offscreen", kReplicants });

	EXPECT_EQ(0, result.status) << result.errors;
}


TEST(Gallery, IsUsedByTheKeyboardAlone)
{
	const ProgramResult result =
		::Run({ kGallery }, { "ARCHWAY_BACKEND=headless", "QT_QPA_PLATFORM=offscreen", kScript });

	EXPECT_EQ(0, result.status) << result.errors;
}


TEST(Gallery, IsUsedByTheKeyboardAloneInRealWindows)
{
	if (!RealScreen::IsAvailable())
		GTEST_SKIP() << "needs Xvfb, openbox, xdotool, xprop and import";
	const RealScreen screen;
	ASSERT_TRUE(screen.IsRunning());
	std::vector<std::string> environment = screen.Environment();
	environment.push_back(kScript);

	const ProgramResult result = ::Run({ kGallery }, environment);

	EXPECT_EQ(0, result.status) << result.errors;
}
