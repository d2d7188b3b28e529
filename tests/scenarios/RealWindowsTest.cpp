// Menus and drags in real windows, by a mouse and keys from outside of the program.

#include <gtest/gtest.h>

#include "scenarios/RealScreen.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kMenu = "^menu$";

// Where things are in the windows' contents.
struct Place {
	int x, y;
};
constexpr Place kAlerts = { 70, 8 };
constexpr Place kStates = { 112, 8 };
constexpr Place kSecondAlert = { 75, 36 }; // in the open menu
const std::string kSelected = "#B4B4B4";
constexpr Place kBesideMenus = { 300, 380 };


class RealWindows : public testing::Test {
protected:
	void SetUp() override
	{
		if (!RealScreen::IsAvailable())
			GTEST_SKIP() << "needs Xvfb, openbox, xdotool, xprop and import";
		screen = std::make_unique<RealScreen>();
		ASSERT_TRUE(screen->IsRunning());
	}

	// What the program had to say is told with a failure.
	void TearDown() override
	{
		if (!HasFailure() || program == nullptr)
			return;
		const bool wasRunning = program->IsRunning();
		const ProgramResult end = program->Finish(0);
		ADD_FAILURE() << (wasRunning ? "still running" : "ended by itself") << ", " << end.status
					  << '\n'
					  << end.errors << screen->Do({ "search", "--name", "." });
	}

	void Start(const std::vector<std::string>& command)
	{
		program = std::make_unique<RunningProgram>(command, screen->Environment());
	}

	void PointAt(const std::string& window, Place place)
	{
		screen->Do({ "mousemove", "--sync", "--window", window, std::to_string(place.x),
			std::to_string(place.y) });
	}

	void Click(const std::string& window, Place place)
	{
		PointAt(window, place);
		screen->Do({ "click", "1" });
	}

	void Keys(const std::vector<std::string>& keys)
	{
		std::vector<std::string> command = { "key" };
		command.insert(command.end(), keys.begin(), keys.end());
		screen->Do(command);
	}

	// Where it is on the screen.
	Place Pointer()
	{
		const std::string place = screen->Do({ "getmouselocation", "--shell" });
		const auto number = [&place](const char* name) {
			const size_t at = place.find(name);
			return at != std::string::npos ? std::stoi(place.substr(at + 2)) : 0;
		};
		return { number("X="), number("Y=") };
	}

	void StartGallery()
	{
		Start({ ARCHWAY_BINARIES "/gallery" });
		gallery = screen->WaitForWindow("^Gallery$");
	}

	std::unique_ptr<RealScreen> screen;
	std::unique_ptr<RunningProgram> program;
	std::string gallery;
};


} // namespace


TEST_F(RealWindows, AMenuIsUsedByTheMouse)
{
	StartGallery();
	Click(gallery, kAlerts);
	EXPECT_TRUE(screen->WaitForCount(kMenu, 1));
	Click(gallery, kSecondAlert);
	EXPECT_TRUE(screen->WaitForCount(kMenu, 0));
	screen->WaitForWindow("^Alert$");
	Keys({ "Return" });
	EXPECT_TRUE(screen->WaitForCount("^Alert$", 0));
}


TEST_F(RealWindows, AMenuIsUsedByOneGesture)
{
	StartGallery();
	PointAt(gallery, kAlerts);
	screen->Do({ "mousedown", "1" });
	EXPECT_TRUE(screen->WaitForCount(kMenu, 1));
	PointAt(gallery, { kSecondAlert.x, kSecondAlert.y - 4 });
	PointAt(gallery, kSecondAlert);
	screen->Do({ "mouseup", "1" });
	screen->WaitForWindow("^Alert$");
	EXPECT_TRUE(screen->WaitForCount(kMenu, 0));
}


TEST_F(RealWindows, SubmenusOpenAndCloseByKeys)
{
	StartGallery();
	Click(gallery, kStates);
	EXPECT_TRUE(screen->WaitForCount(kMenu, 1));
	Keys({ "Down", "Down", "Right" });
	EXPECT_TRUE(screen->WaitForCount(kMenu, 2));
	Keys({ "Left" });
	EXPECT_TRUE(screen->WaitForCount(kMenu, 1));
	Keys({ "Escape" });
	EXPECT_TRUE(screen->WaitForCount(kMenu, 0));
}


TEST_F(RealWindows, AClickBesideClosesAllMenus)
{
	StartGallery();
	Click(gallery, kStates);
	EXPECT_TRUE(screen->WaitForCount(kMenu, 1));
	Keys({ "Down", "Down", "Right" });
	EXPECT_TRUE(screen->WaitForCount(kMenu, 2));
	Click(gallery, kBesideMenus);
	EXPECT_TRUE(screen->WaitForCount(kMenu, 0));
}


TEST_F(RealWindows, ADragToAnotherWindowShowsItsPictureUnderThePointer)
{
	const ScratchFolder folder;
	const std::string file =
		folder.Copy(ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc", "design.rsrc");
	Start({ ARCHWAY_BINARIES "/archway", "--open", "ARCV:2", file });
	const std::string editor = screen->WaitForWindow("ARCV 2");
	const std::string palette = screen->WaitForWindow("^Widgets$");
	screen->Do({ "windowmove", "--sync", editor, "60", "60" });
	screen->Do({ "windowmove", "--sync", palette, "1000", "500" });

	// Free ground of the work area, with nothing of the design near.
	constexpr Place kGoal = { 600, 330 };
	PointAt(editor, kGoal);
	const Place goal = Pointer();
	const std::string ground = screen->PixelOfScreen(goal.x - 8, goal.y);
	const std::string far = screen->PixelOfScreen(goal.x + 120, goal.y);

	PointAt(palette, { 40, 28 });
	screen->Do({ "mousedown", "1" });
	ASSERT_TRUE(screen->WaitForPixel(palette, 150, 28, kSelected));
	PointAt(palette, { 50, 28 });
	PointAt(palette, { 60, 40 });
	PointAt(editor, kGoal);
	EXPECT_TRUE(screen->WaitForChange(goal.x - 8, goal.y, ground));
	EXPECT_EQ(far, screen->PixelOfScreen(goal.x + 120, goal.y));
	screen->Do({ "mouseup", "1" });
	// The work area has the drop: it asks about views that are not dropped on another.
	screen->WaitForWindow("^Warning!$");
	Keys({ "Return" });
	EXPECT_TRUE(screen->WaitForCount("^Warning!$", 0));
}


// Nobody tells of a release that no window of the program is under, but for the one of the press.
TEST_F(RealWindows, ADragEndsWhenItsWindowWasClosedMeanwhile)
{
	const ScratchFolder folder;
	const std::string file =
		folder.Copy(ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc", "design.rsrc");
	Start({ ARCHWAY_BINARIES "/archway", "--open", "ARCV:2", file });
	const std::string editor = screen->WaitForWindow("ARCV 2");
	const std::string palette = screen->WaitForWindow("^Widgets$");
	screen->Do({ "windowmove", "--sync", palette, "1000", "500" });
	screen->Do({ "windowactivate", "--sync", editor });
	const std::string ground = screen->PixelOfScreen(1300, 900);

	PointAt(palette, { 40, 28 });
	screen->Do({ "mousedown", "1" });
	ASSERT_TRUE(screen->WaitForPixel(palette, 150, 28, kSelected));
	PointAt(palette, { 50, 28 });
	PointAt(palette, { 60, 40 });
	const Place pointer = Pointer();
	Keys({ "ctrl+w" });
	ASSERT_TRUE(screen->WaitForCount("^Widgets$", 0));
	// Beside the pointer, for the picture has a hole there.
	const std::string picture = screen->PixelOfScreen(pointer.x - 8, pointer.y);
	ASSERT_NE(ground, picture);
	screen->Do({ "mouseup", "1" });
	EXPECT_TRUE(screen->WaitForChange(pointer.x - 8, pointer.y, picture));
	EXPECT_EQ(ground, screen->PixelOfScreen(pointer.x - 8, pointer.y));
}


TEST_F(RealWindows, ThePaletteLeavesWithItsProgramAndComesBackToItsPlace)
{
	const ScratchFolder folder;
	const std::string file =
		folder.Copy(ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc", "design.rsrc");
	Start({ ARCHWAY_BINARIES "/archway", "--open", "ARCV:2", file });
	const std::string editor = screen->WaitForWindow("ARCV 2");
	const std::string palette = screen->WaitForWindow("^Widgets$");
	screen->Do({ "windowmove", "--sync", palette, "1000", "500" });
	const std::string place = screen->Do({ "getwindowgeometry", palette });

	const RunningProgram other({ ARCHWAY_BINARIES "/gallery" }, screen->Environment());
	screen->WaitForWindow("^Gallery$");
	EXPECT_TRUE(screen->WaitForCount("^Widgets$", 0));
	screen->Do({ "windowactivate", "--sync", editor });
	const std::string again = screen->WaitForWindow("^Widgets$");
	const auto position = [](const std::string& geometry) {
		return geometry.substr(geometry.find("Position"));
	};
	EXPECT_EQ(position(place), position(screen->Do({ "getwindowgeometry", again })));
	EXPECT_EQ(editor, screen->Do({ "getactivewindow" })) << "the keyboard stays where it is";
}
