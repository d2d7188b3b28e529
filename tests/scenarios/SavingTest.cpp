// What is saved, and what is asked before work is lost.

#include <gtest/gtest.h>

#include "scenarios/Archway.h"
#include "scenarios/Differences.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc";
const std::string kButton = "ARCV:1/_views/_views/_views/_views/_views/_views/_views/_views";
const std::string kOpen = "click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\n";
const std::string kSelect = kOpen + "click WorkView > \"button1\"\n";
// The name is typed, but nothing confirms it.
const std::string kTypeName =
	kSelect + "click EditView > \"Name: \"\nkey a with Command\ntype \"typed\"\n";


// A copy of the design, and what a play script makes of it.
struct Scene {
	void Play(const std::string& script)
	{
		const ProgramResult result = PlayText(script, file);
		EXPECT_EQ(0, result.status) << result.errors << result.output;
	}

	std::map<std::string, std::string> Differences() const
	{
		std::map<std::string, std::string> differences;
		for (const auto& [path, value] : DifferencesBetween(kDesign, file)) {
			std::string plain = path;
			for (size_t at; (at = plain.find("[0]")) != std::string::npos;)
				plain.erase(at, 3);
			differences[plain] = value;
		}
		return differences;
	}

	ScratchFolder folder;
	std::string file = folder.Copy(kDesign, "design.rsrc");
};


const std::map<std::string, std::string> kTyped = { { kButton + "/_name", "typed" } };
const std::map<std::string, std::string> kNothing;


} // namespace


TEST(Saving, TakesOverTheNameThatIsBeingTyped)
{
	Scene scene;
	scene.Play(kTypeName
		+ "key s with Command\n"
		  "expect EditView > \"Name: \" text typed\n"
		  "expect EditView > \"Name: \" > _BTextInput_ focus true\n"
		  "absent window \"design.rsrc *\"\n");
	EXPECT_EQ(kTyped, scene.Differences());
}


TEST(Saving, ClosingTheEditorKeepsTheNameThatIsBeingTyped)
{
	Scene scene;
	scene.Play(kTypeName + "close \"ARCV 1\"\nwindows 1\nkey s with Command\n");
	EXPECT_EQ(kTyped, scene.Differences());
}


TEST(Saving, AViewMovedAndMovedBackGivesTheOriginalBytes)
{
	Scene scene;
	scene.Play(kSelect + "key Left times 5\nkey s with Command\nrun \"! cmp -s $FILE " + kDesign
		+ "\"\nkey Right times 5\nclose \"ARCV 1\"\nkey s with Command\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
}


TEST(Saving, LookingAtEveryItemWritesNothing)
{
	Scene scene;
	const auto before = std::filesystem::last_write_time(scene.file);
	std::string script;
	for (const char* id : { "1", "2", "3" }) {
		const std::string title = "\"ARCV " + std::string(id) + '"';
		script += "click item \"ARCV:" + std::string(id) + "\" times 2\nwait window " + title
			+ "\nclick window " + title + " > WorkView > \"button1\"\nclose " + title + '\n';
	}
	scene.Play(script + "expect window \"design.rsrc\" label design.rsrc\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
	EXPECT_EQ(before, std::filesystem::last_write_time(scene.file));
}


TEST(Closing, AsksAboutUnsavedWorkAndCancelKeepsIt)
{
	Scene scene;
	scene.Play(kSelect
		+ "key Left\nclose \"design.rsrc\"\nanswer \"Cancel\"\nwindows 3\n"
		  "expect WorkView > \"button1\" frame 3,14,53,38\nquit!\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
}


TEST(Closing, WithoutSavingLeavesTheFileAlone)
{
	Scene scene;
	scene.Play(kSelect + "key Left\nquit\nanswer \"Don't Save\"\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
}


TEST(Closing, SavesWhenTold)
{
	Scene scene;
	scene.Play(kSelect + "key Left\nquit\nanswer \"Save\"\n");
	const std::map<std::string, std::string> moved = {
		{ kButton + "/_frame", "[3.0,14.0,53.0,38.0]" },
	};
	EXPECT_EQ(moved, scene.Differences());
}


TEST(Opening, WorksFromTheListByTheKeyboardAlone)
{
	Scene scene;
	scene.Play("key Down\nkey Return\nwait window \"ARCV 2\"\nkey w with Command\n"
			   "windows 1\nkey Down\nkey Return\nwait window \"ARCV 3\"\n"
			   "expect EditView > \"Name: \" text level 0\n");
	EXPECT_EQ(kNothing, scene.Differences());
}
