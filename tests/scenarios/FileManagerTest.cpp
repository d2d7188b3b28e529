// Drags between the editor and a real file manager, in real windows, by a mouse from outside.

#include <chrono>
#include <filesystem>

#include <gtest/gtest.h>

#include <Node.h>
#include <NodeInfo.h>

#include "scenarios/RealScreen.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/01-view.rsrc";

// Where things are in the windows' contents.
struct Place {
	int x, y;
};
constexpr Place kButtonEntry = { 60, 98 };
constexpr Place kFolderGround = { 330, 250 };
constexpr Place kFirstIcon = { 206, 97 };
constexpr Place kView = { 500, 60 };

constexpr std::chrono::seconds kPatience(10);
constexpr int kAttempts = 5;
constexpr int kSteps = 8;


class FileManager : public testing::Test {
protected:
	void SetUp() override
	{
		if (!RealScreen::IsAvailable() || ::Run({ "sh", "-c", "command -v pcmanfm" }).status != 0)
			GTEST_SKIP() << "needs Xvfb, openbox, xdotool, xprop, import and pcmanfm";
		screen = std::make_unique<RealScreen>();
		ASSERT_TRUE(screen->IsRunning());
		target = folder.Path("target");
		std::filesystem::create_directory(target);
		design = folder.Copy(kDesign, "design.rsrc");
	}

	void Start()
	{
		std::vector<std::string> environment = screen->Environment();
		for (const char* variable : { "HOME=", "XDG_CONFIG_HOME=", "XDG_RUNTIME_DIR=" })
			environment.push_back(variable + folder.Path(""));
		manager = std::make_unique<RunningProgram>(
			std::vector<std::string> { "pcmanfm", "--no-desktop", target }, environment);
		folderWindow = screen->WaitForWindow("^target$");
		screen->Do({ "windowsize", "--sync", folderWindow, "640", "480" });
		screen->Do({ "windowmove", "--sync", folderWindow, "950", "0" });
		archway = std::make_unique<RunningProgram>(
			std::vector<std::string> { ARCHWAY_BINARIES "/archway", "--open", "ARCV:1", design },
			environment);
		editor = screen->WaitForWindow("ARCV 1");
		palette = screen->WaitForWindow("^Widgets$");
		screen->Do({ "windowmove", "--sync", palette, "950", "560" });
	}

	void PointAt(const std::string& window, Place place)
	{
		screen->Do({ "mousemove", "--sync", "--window", window, std::to_string(place.x),
			std::to_string(place.y) });
	}

	// Who is dragged over decides in its own time whether it takes what comes; a person would try
	// again. True as soon as the condition holds.
	template<class Condition>
	bool DragUntil(const std::string& from, Place start, const std::string& to, Place goal,
		const Condition& condition)
	{
		for (int attempt = 1; attempt <= kAttempts; attempt++) {
			// The palette is there while its program is active.
			screen->Do({ "windowactivate", "--sync", editor });
			PointAt(from, start);
			screen->Do({ "mousedown", "1" });
			PointAt(from, { start.x + 8, start.y + 8 });
			PointAt(from, { start.x + 20, start.y + 16 });
			for (int i = kSteps * attempt; i >= 0; i--)
				PointAt(to, { goal.x - i % 12, goal.y - i % 7 });
			screen->Do({ "mouseup", "1" });
			const auto end = std::chrono::steady_clock::now() + kPatience;
			do {
				if (condition())
					return true;
				screen->Do({ "getmouselocation" });
			} while (std::chrono::steady_clock::now() < end);
		}
		return false;
	}

	bool DragToFolder()
	{
		const std::filesystem::path file = target + "/DragMe Success";
		return DragUntil(palette, kButtonEntry, folderWindow, kFolderGround, [&file] {
			std::error_code error;
			return std::filesystem::file_size(file, error) > 0 && !error;
		});
	}

	bool DragToDesign(const std::string& expected)
	{
		return DragUntil(folderWindow, kFirstIcon, editor, kView, [&] {
			screen->Do({ "windowactivate", "--sync", editor });
			screen->Do({ "key", "ctrl+s" });
			return Dump(design).find(expected) != std::string::npos;
		});
	}

	static std::string Dump(const std::string& file)
	{
		return ::Run({ ARCHWAY_BINARIES "/arcv", "dump", "--json", file }).output;
	}

	ScratchFolder folder;
	std::string target, design;
	std::unique_ptr<RealScreen> screen;
	std::unique_ptr<RunningProgram> manager, archway;
	std::string folderWindow, editor, palette;
};


} // namespace


TEST_F(FileManager, TakesAWidgetAsAFileAndGivesItBack)
{
	Start();
	ASSERT_TRUE(DragToFolder());
	const std::string file = target + "/DragMe Success";
	const std::string dump = Dump(file);
	EXPECT_NE(std::string::npos,
		dump.find("\"type\": \"ARCV\",\n      \"id\": 1,\n      \"name\": \"zetka\""))
		<< dump.substr(0, 200);
	EXPECT_NE(std::string::npos, dump.find("\"BButton\""));
	BNode node(file.c_str());
	BNodeInfo info(&node);
	char type[B_MIME_TYPE_LENGTH];
	ASSERT_EQ(B_OK, info.GetType(type));
	EXPECT_STREQ("application/x-tamvex-resource", type);

	EXPECT_EQ(std::string::npos, Dump(design).find("\"BButton\""));
	EXPECT_TRUE(DragToDesign("\"BButton\""));
}


TEST_F(FileManager, GivesAPictureThatBecomesABitmapView)
{
	std::filesystem::copy_file(
		ARCHWAY_SOURCES "/docs/pictures/gallery.png", target + "/a picture.png");
	Start();
	EXPECT_TRUE(DragToDesign("\"BitmapView\""));
	EXPECT_NE(std::string::npos, Dump(design).find("\"a picture.png\""));
}
