// The items of a file as a whole: copied, renamed, removed, brought back.

#include <gtest/gtest.h>

#include <Resources.h>

#include "scenarios/Archway.h"
#include "scenarios/ScratchFolder.h"

namespace {


constexpr const char* kDesign = ARCHWAY_TEST_DATA "/resources/22-nestedboxes.rsrc"; // ARCV 1, 2, 3
constexpr const char* kOther = ARCHWAY_TEST_DATA "/resources/23-dialog.rsrc";
const std::string kSave = "key s with Command\nabsent window \"design.rsrc *\"\n";
const std::string kOpenAndMove = "click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\nclick "
								 "WorkView > \"button1\"\nkey Left\n";


struct Scene {
	void Play(const std::string& script, std::vector<std::string> environment = kHeadless)
	{
		environment.push_back("OTHER=" + other);
		const ProgramResult result = PlayText(script, file, environment);
		EXPECT_EQ(0, result.status) << result.errors << result.output;
	}

	ScratchFolder folder;
	std::string file = folder.Copy(kDesign, "design.rsrc");
	std::string other = folder.Copy(kOther, "other.rsrc");
};


// TYPE:ID "name" of each item, in the order of the file.
std::vector<std::string>
ItemsOf(const std::string& file)
{
	BResources resources(file.c_str());
	std::vector<std::string> items;
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		const char characters[] = { char(type >> 24), char(type >> 16), char(type >> 8), char(type),
			'\0' };
		items.push_back(std::string(characters) + ':' + std::to_string(id) + ' ' + name);
	}
	return items;
}


using Names = std::vector<std::string>;


} // namespace


TEST(Items, ADuplicateGetsTheNextFreeID)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\"\nkey d with Command\nexpect ItemList selection 3\n" + kSave);
	EXPECT_EQ((Names { "ARCV:1 r5", "ARCV:2 haiku nested", "ARCV:3 haiku managed", "ARCV:4 r5" }),
		ItemsOf(scene.file));
}


TEST(Items, ACopyHasWhatIsBeingTypedInTheEditor)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\n"
			   "click EditView > \"Name: \"\nkey a with Command\ntype \"typed\"\n"
			   "activate \"design.rsrc\"\nkey c with Command\nkey v with Command\n"
			   "click item \"ARCV:4\" times 2\nwait window \"ARCV 4\"\n"
			   "expect window \"ARCV 4\" > EditView > \"Name: \" text typed\nquit!\n");
}


TEST(Items, ArePastedIntoAnotherFile)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\"\nclick item \"ARCV:3\" with Shift\nkey c with Command\n"
			   "open "
		+ scene.other
		+ "\nwait window \"other.rsrc\"\n"
		  "activate \"other.rsrc\"\nkey v with Command\nexpect ItemList count 6\n"
		  "key s with Command\nclose \"other.rsrc\"\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
	EXPECT_EQ((Names { "ARCV:1 r5", "ARCV:2 haiku nested", "ARCV:3 haiku managed", "ARCV:4 r5",
				  "ARCV:5 haiku nested", "ARCV:6 haiku managed" }),
		ItemsOf(scene.other));
}


TEST(Items, WithoutBytesAreCutAndPasted)
{
	Scene scene;
	{
		BResources resources(scene.file.c_str());
		ASSERT_EQ(B_OK, resources.AddResource('NULL', 1, "", 0, "empty"));
	}
	scene.Play("click item \"ARCV:3\"\nclick item \"NULL:1\" with Shift\nkey x with Command\n"
			   "expect ItemList count 2\nkey v with Command\n"
		+ kSave);
	EXPECT_EQ(
		(Names { "ARCV:1 r5", "ARCV:2 haiku nested", "ARCV:3 haiku managed", "NULL:1 empty" }),
		ItemsOf(scene.file));
}


TEST(Items, ThatWereRemovedComeBackToTheirPlaces)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\"\nclick item \"ARCV:2\" with Shift\nkey Delete\n"
			   "expect ItemList count 1\nexpect ItemList selection 0\n"
			   "menu \"Edit\" \"Undo Delete\"\nexpect ItemList count 3\n"
			   "expect window \"design.rsrc\" label design.rsrc\n"
			   "click item \"ARCV:1\" at 60,8\nexpect ItemList selection 0\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
}


TEST(Items, OneThatIsRemovedClosesItsEditor)
{
	Scene scene;
	scene.Play(kOpenAndMove
		+ "activate \"design.rsrc\"\nkey Delete\nwindows 1\nkey z with Command\n"
		  "expect ItemList count 3\nquit!\n");
}


TEST(Items, GetAnotherTypeIDAndName)
{
	Scene scene;
	scene.Play("click item \"ARCV:2\"\nkey r with Command\nwait window \"Attributes\"\n"
			   "click \"Type:\"\nkey a with Command\ntype \"TEST\"\nkey Tab\ntype \"-7\"\nkey Tab\n"
			   "type \"a name\\n\"\nwindows 1\n"
		+ kSave + "expect ItemList > item \"TEST:-7\" screen 62,113,564,129\n");
	EXPECT_EQ(
		(Names { "ARCV:1 r5", "TEST:-7 a name", "ARCV:3 haiku managed" }), ItemsOf(scene.file));
}


TEST(Items, KeepTheirIDWhenTheNewOneIsTaken)
{
	Scene scene;
	scene.Play("click item \"ARCV:2\"\nkey r with Command\nwait window \"Attributes\"\n"
			   "click \"ID:\"\nkey a with Command\ntype \"3\\n\"\nanswer \"OK\"\nwindows 2\n"
			   "activate \"Attributes\"\nclick \"ID:\"\nkey a with Command\ntype \"x\\n\"\n"
			   "answer \"OK\"\nactivate \"Attributes\"\nclick \"ID:\"\nkey a with Command\n"
			   "type \"7\"\nclick \"Type:\"\nkey a with Command\ntype \"0x141524356\\n\"\n"
			   "answer \"OK\"\nactivate \"Attributes\"\nclick \"Cancel\"\nwindows 1\n"
			   "expect window \"design.rsrc\" label design.rsrc\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
}


TEST(Items, AnOpenEditorShowsItsItemsNewName)
{
	Scene scene;
	scene.Play("click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\nactivate \"design.rsrc\"\n"
			   "key r with Command\nwait window \"Attributes\"\ntype \"other name\\n\"\n"
			   "wait window \"ARCV 1 \\\"other name\\\"\"\nquit!\n");
}


TEST(Reverting, GoesBackToTheFileWhenTheUserAgrees)
{
	Scene scene;
	scene.Play(kOpenAndMove
		+ "activate \"design.rsrc\"\nmenu \"File\" \"Revert...\"\nanswer \"Cancel\"\nwindows 3\n"
		  "activate \"design.rsrc\"\nmenu \"File\" \"Revert...\"\nanswer \"Revert\"\nwindows 1\n"
		  "expect window \"design.rsrc\" label design.rsrc\n"
		  "click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\nclick WorkView > \"button1\"\n"
		  "expect WorkView > \"button1\" frame 4,14,54,38\n");
	EXPECT_EQ(BytesOf(kDesign), BytesOf(scene.file));
}


TEST(ChangedOnDisk, IsNoticedWhenTheWindowIsUsedAgain)
{
	Scene scene;
	scene.Play("menu \"File\" \"New\"\nwindows 2\nrun \"cp $OTHER $FILE\"\n"
			   "activate \"design.rsrc\"\nanswer \"Read Again\"\n"
			   "click item \"ARCV:1\" times 2\nwait window \"ARCV 1\"\n"
			   "wait WorkView > \"find\"\nquit!\n");
	EXPECT_EQ(BytesOf(kOther), BytesOf(scene.file));
}


TEST(ChangedOnDisk, AFileThatIsGoneIsWrittenAgain)
{
	Scene scene;
	scene.Play("click item \"ARCV:2\"\nkey Delete\nrun \"rm $FILE\"\n" + kSave);
	EXPECT_EQ((Names { "ARCV:1 r5", "ARCV:3 haiku managed" }), ItemsOf(scene.file));
}


TEST(RecentFiles, AreOpenedFromTheMenu)
{
	Scene scene;
	const std::vector<std::string> environment = { kHeadless[0],
		"XDG_CONFIG_HOME=" + scene.folder.Path("settings") };
	const std::string file = scene.file;
	scene.file = scene.other;
	scene.Play("windows 1\n", environment);
	scene.file = file;
	scene.Play("menu \"File\" \"Open Recent\" \"" + scene.other
			+ "\"\nwait window \"other.rsrc\"\n"
			  "windows 2\n",
		environment);
}
