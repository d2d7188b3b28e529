// The editor in its real windows, used by mouse and keys from outside of the program.

#include <gtest/gtest.h>

#include "scenarios/Differences.h"
#include "scenarios/RealScreen.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc";
const std::string kButton = "ARCV:2/_views[0]/_views[0]/_views[0]/_views[0]/_views[0]/_views[0]/"
							"_views[0]/_views[0]";
const std::string kBlue = "#0000FF";

// Where things are in the windows' contents.
struct Place {
	int x, y;
};
constexpr Place kSecondRow = { 40, 61 };
constexpr Place kButtonLeftTop = { 466, 137 };
constexpr Place kButtonSize = { 50, 24 };
constexpr Place kNameField = { 200, 46 };


class Person {
public:
	explicit Person(const RealScreen& screen) : fScreen(screen) {}

	void PointAt(const std::string& window, Place place)
	{
		fScreen.Do({ "mousemove", "--sync", "--window", window, std::to_string(place.x),
			std::to_string(place.y) });
	}

	void Click(const std::string& window, Place place, const char* times = "1")
	{
		PointAt(window, place);
		fScreen.Do({ "click", "--repeat", times, "--delay", "40", "1" });
	}

	void Keys(std::vector<std::string> keys)
	{
		keys.insert(keys.begin(), "key");
		fScreen.Do(keys);
	}

	// From the corner of the selected view, with the button held.
	void Pull(const std::string& window, Place from, Place by)
	{
		PointAt(window, from);
		fScreen.Do({ "mousedown", "1" });
		PointAt(window, { from.x + by.x / 2, from.y + by.y / 2 });
		PointAt(window, { from.x + by.x, from.y + by.y });
		fScreen.Do({ "mouseup", "1" });
	}

private:
	const RealScreen& fScreen;
};


// The corner triangle's middle.
constexpr Place
CornerOf(Place leftTop, Place size)
{
	return { leftTop.x + size.x - 3, leftTop.y + size.y - 3 };
}


} // namespace


TEST(Person, EditsOneViewByMouseAndKeys)
{
	if (!RealScreen::IsAvailable())
		GTEST_SKIP() << "needs Xvfb, openbox, xdotool, xprop and import";
	const RealScreen screen;
	ASSERT_TRUE(screen.IsRunning());
	const ScratchFolder folder;
	const std::string file = folder.Copy(kDesign, "design.rsrc");
	RunningProgram archway({ ARCHWAY_BINARIES "/archway", file }, screen.Environment());
	Person person(screen);

	const std::string list = screen.WaitForWindow("^design.rsrc$");
	person.Click(list, kSecondRow, "2");
	const std::string editor = screen.WaitForWindow("ARCV 2");

	const Place leftTop = kButtonLeftTop;
	person.Click(editor, { leftTop.x + 25, leftTop.y + 12 });
	const Place corner = CornerOf(leftTop, kButtonSize);
	ASSERT_TRUE(screen.WaitForPixel(editor, leftTop.x, leftTop.y + 12, kBlue));
	ASSERT_TRUE(screen.WaitForPixel(editor, corner.x, corner.y, kBlue));

	person.Keys({ "Right", "Right", "Right", "Down", "Down" });
	const Place moved = { leftTop.x + 3, leftTop.y + 2 };
	const Place movedCorner = CornerOf(moved, kButtonSize);
	ASSERT_TRUE(screen.WaitForPixel(editor, movedCorner.x, movedCorner.y, kBlue));

	person.Pull(editor, movedCorner, { -5, 7 });
	const Place resized = CornerOf(moved, { kButtonSize.x - 5, kButtonSize.y + 7 });
	ASSERT_TRUE(screen.WaitForPixel(editor, resized.x, resized.y, kBlue));

	person.Click(editor, kNameField);
	person.Keys({ "ctrl+a" });
	screen.Do({ "type", "colour" });
	person.Keys({ "Return" });
	person.Keys({ "alt+F4" });
	screen.WaitForWindow("^design.rsrc \\*$");
	screen.Do({ "windowactivate", "--sync", list });
	person.Keys({ "ctrl+s" });
	screen.WaitForWindow("^design.rsrc$");
	person.Keys({ "alt+F4" });

	EXPECT_EQ(0, archway.Finish().status);
	const std::map<std::string, std::string> edits = {
		{ kButton + "/_name", "colour" },
		{ kButton + "/_frame", "[7.0,16.0,52.0,47.0]" },
	};
	EXPECT_EQ(edits, DifferencesBetween(kDesign, file));
}
